// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversions between a property of one type and a caller's variable of another.
#include <cmath>
#include <cstdint>
#include <limits>
#include <string>

#include <fbxsdk/FbxProperty.h>

#include "platform/scene/SceneFixture.h"

namespace {

using namespace fbxsdk;

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

class PropertyConversionTest : public SceneFixture {
protected:
    FbxProperty property(const FbxDataType& type) {
        return FbxProperty::Create(FbxObject::Create(manager, ""), type, "value");
    }

    /// A property of the type to which a value was written; the writing must succeed.
    template <class T>
    FbxProperty holding(const FbxDataType& type, const T& value) {
        FbxProperty made = property(type);
        EXPECT_TRUE(made.Set(value)) << type.GetName();
        return made;
    }
};

TEST_F(PropertyConversionTest, KeepsEveryTypeOfNumberExactly) {
    EXPECT_EQ(holding(FbxBoolDT, true).Get<FbxBool>(), true);
    EXPECT_EQ(holding(FbxShortDT, FbxShort{-32768}).Get<FbxShort>(), -32768);
    EXPECT_EQ(holding(FbxUByteDT, FbxUChar{255}).Get<FbxUChar>(), 255);
    EXPECT_EQ(holding(FbxIntDT, INT32_MIN).Get<FbxInt>(), INT32_MIN);
    EXPECT_EQ(holding(FbxEnumDT, 17).Get<FbxEnum>(), 17);
    EXPECT_EQ(holding(FbxLongLongDT, FbxLongLong{INT64_MAX}).Get<FbxLongLong>(), INT64_MAX);
    EXPECT_EQ(holding(FbxLongLongDT, FbxLongLong{INT64_MIN}).Get<FbxLongLong>(), INT64_MIN);
    EXPECT_EQ(holding(FbxULongLongDT, FbxULongLong{UINT64_MAX}).Get<FbxULongLong>(), UINT64_MAX);
    EXPECT_EQ(holding(FbxFloatDT, 0.1F).Get<FbxFloat>(), 0.1F);
    EXPECT_EQ(holding(FbxDoubleDT, 0.1).Get<FbxDouble>(), 0.1);
}

TEST_F(PropertyConversionTest, KeepsVectorsTextAndTimes) {
    EXPECT_EQ(holding(FbxDouble2DT, FbxDouble2(1, 2)).Get<FbxDouble2>(), FbxDouble2(1, 2));
    EXPECT_EQ(holding(FbxDouble3DT, FbxDouble3(1, 2, 3)).Get<FbxDouble3>(), FbxDouble3(1, 2, 3));
    EXPECT_EQ(holding(FbxDouble4DT, FbxDouble4(1, 2, 3, 4)).Get<FbxDouble4>(), FbxDouble4(1, 2, 3, 4));
    EXPECT_EQ(holding(FbxStringDT, FbxString("Öl")).Get<FbxString>(), FbxString("Öl"));
    EXPECT_EQ(holding(FbxUrlDT, FbxString("a/b")).Get<FbxString>(), FbxString("a/b"));
    EXPECT_EQ(holding(FbxDateTimeDT, FbxString("1/1/2000")).Get<FbxString>(), FbxString("1/1/2000"));
    EXPECT_EQ(holding(FbxTimeDT, FBXSDK_TIME_INFINITE).Get<FbxTime>(), FBXSDK_TIME_INFINITE);
    EXPECT_EQ(holding(FbxTimeDT, FBXSDK_TIME_MINUS_INFINITE).Get<FbxTime>(), FBXSDK_TIME_MINUS_INFINITE);
}

TEST_F(PropertyConversionTest, TakesTextHoweverItIsGiven) {
    FbxProperty text = property(FbxStringDT);

    EXPECT_TRUE(text.Set("plain"));
    EXPECT_EQ(text.Get<FbxString>(), FbxString("plain"));
    EXPECT_TRUE(text.Set(FbxString("other")));
    EXPECT_EQ(text.Get<FbxString>(), FbxString("other"));
    EXPECT_TRUE(text.Set(static_cast<const char*>(nullptr)));
    EXPECT_EQ(text.Get<FbxString>().GetLen(), 0U);
}

TEST_F(PropertyConversionTest, ReadsWholeNumbersAsAnyNumber) {
    const FbxProperty five = holding(FbxIntDT, 5);

    EXPECT_EQ(five.Get<FbxBool>(), true);
    EXPECT_EQ(five.Get<FbxChar>(), 5);
    EXPECT_EQ(five.Get<FbxUShort>(), 5);
    EXPECT_EQ(five.Get<FbxUInt>(), 5U);
    EXPECT_EQ(five.Get<FbxLongLong>(), 5);
    EXPECT_EQ(five.Get<FbxFloat>(), 5.0F);
    EXPECT_EQ(five.Get<FbxDouble>(), 5.0);
    EXPECT_EQ(holding(FbxBoolDT, true).Get<FbxDouble>(), 1.0);
    EXPECT_EQ(holding(FbxEnumDT, 3).Get<FbxInt>(), 3);
}

TEST_F(PropertyConversionTest, TruncatesRealsTowardZero) {
    EXPECT_EQ(holding(FbxDoubleDT, 2.9).Get<FbxInt>(), 2);
    EXPECT_EQ(holding(FbxDoubleDT, -2.9).Get<FbxInt>(), -2);
    EXPECT_EQ(holding(FbxIntDT, 2.9).Get<FbxDouble>(), 2.0);
    EXPECT_EQ(holding(FbxEnumDT, 2.9F).Get<FbxEnum>(), 2);
}

TEST_F(PropertyConversionTest, TakesEverythingButZeroAndNaNForTrue) {
    for (const double value : {0.5, -1e-300, 7.0, kInfinity}) {
        EXPECT_TRUE(holding(FbxDoubleDT, value).Get<FbxBool>()) << value;
        EXPECT_TRUE(holding(FbxBoolDT, value).Get<FbxBool>()) << value;
    }
    for (const double value : {0.0, -0.0, kNaN}) {
        EXPECT_FALSE(holding(FbxDoubleDT, value).Get<FbxBool>()) << value;
        EXPECT_FALSE(holding(FbxBoolDT, value).Get<FbxBool>()) << value;
    }
    EXPECT_EQ(holding(FbxBoolDT, 256).Get<FbxInt>(), 1);
}

TEST_F(PropertyConversionTest, HoldsWhatIsTooFarAtTheEdgeOfTheType) {
    EXPECT_EQ(holding(FbxDoubleDT, 1e300).Get<FbxInt>(), INT32_MAX);
    EXPECT_EQ(holding(FbxDoubleDT, -kInfinity).Get<FbxInt>(), INT32_MIN);
    EXPECT_EQ(holding(FbxDoubleDT, kInfinity).Get<FbxLongLong>(), INT64_MAX);
    EXPECT_EQ(holding(FbxDoubleDT, 1e300).Get<FbxULongLong>(), UINT64_MAX);
    EXPECT_EQ(holding(FbxDoubleDT, -1.0).Get<FbxULongLong>(), 0U);
    EXPECT_EQ(holding(FbxLongLongDT, FbxLongLong{INT64_MIN}).Get<FbxInt>(), INT32_MIN);
    EXPECT_EQ(holding(FbxIntDT, 300).Get<FbxUChar>(), 255);
    EXPECT_EQ(holding(FbxIntDT, -1).Get<FbxUInt>(), 0U);
    EXPECT_EQ(holding(FbxUByteDT, 300).Get<FbxInt>(), 255);
    EXPECT_EQ(holding(FbxShortDT, -1e9).Get<FbxInt>(), -32768);
    EXPECT_EQ(holding(FbxIntDT, FbxLongLong{1} << 40).Get<FbxLongLong>(), INT32_MAX);
    EXPECT_EQ(holding(FbxULongLongDT, -5).Get<FbxInt>(), 0);
    EXPECT_EQ(holding(FbxLongLongDT, FbxULongLong{UINT64_MAX}).Get<FbxLongLong>(), INT64_MAX);
}

TEST_F(PropertyConversionTest, ReadsTheLargestUnsignedNumbersAsWhatTheyAre) {
    const FbxProperty largest = holding(FbxULongLongDT, FbxULongLong{UINT64_MAX});

    EXPECT_EQ(largest.Get<FbxDouble>(), 18446744073709551615.0);
    EXPECT_EQ(largest.Get<FbxLongLong>(), INT64_MAX);
    EXPECT_EQ(largest.Get<FbxInt>(), INT32_MAX);
}

TEST_F(PropertyConversionTest, TakesNaNForZeroInWholeNumbersAndKeepsItInReals) {
    EXPECT_EQ(holding(FbxDoubleDT, kNaN).Get<FbxInt>(), 0);
    EXPECT_EQ(holding(FbxIntDT, kNaN).Get<FbxInt>(), 0);
    EXPECT_EQ(holding(FbxDouble3DT, FbxDouble3(kNaN, 0, 0)).Get<FbxLongLong>(), 0);
    EXPECT_TRUE(std::isnan(holding(FbxDoubleDT, kNaN).Get<FbxDouble>()));
    EXPECT_TRUE(std::isnan(holding(FbxDoubleDT, kNaN).Get<FbxFloat>()));
}

TEST_F(PropertyConversionTest, KeepsInAFloatNoMoreThanAFloat) {
    EXPECT_EQ(holding(FbxFloatDT, 0.1).Get<FbxDouble>(), static_cast<double>(0.1F));
    EXPECT_EQ(holding(FbxFloatDT, 1e300).Get<FbxFloat>(), std::numeric_limits<float>::infinity());
}

TEST_F(PropertyConversionTest, ReadsVectorsByComponents) {
    const FbxProperty three = holding(FbxDouble3DT, FbxDouble3(1.5, 2, 3));

    EXPECT_EQ(three.Get<FbxDouble2>(), FbxDouble2(1.5, 2));
    EXPECT_EQ(three.Get<FbxDouble4>(), FbxDouble4(1.5, 2, 3, 0));
    EXPECT_EQ(three.Get<FbxColor>(), FbxColor(1.5, 2, 3, 1)); // the default alpha of a colour
    EXPECT_EQ(three.Get<FbxVector4>(), FbxVector4(1.5, 2, 3, 1));
    EXPECT_EQ(three.Get<FbxDouble>(), 1.5);
    EXPECT_EQ(three.Get<FbxInt>(), 1);
    EXPECT_EQ(holding(FbxDoubleDT, 7.0).Get<FbxDouble3>(), FbxDouble3(7, 0, 0));
    EXPECT_EQ(holding(FbxIntDT, 7).Get<FbxDouble2>(), FbxDouble2(7, 0));
}

TEST_F(PropertyConversionTest, WritesVectorsByComponentsAndLeavesTheOthers) {
    FbxProperty four = holding(FbxDouble4DT, FbxDouble4(1, 2, 3, 4));

    EXPECT_TRUE(four.Set(FbxDouble3(5, 6, 7)));
    EXPECT_EQ(four.Get<FbxDouble4>(), FbxDouble4(5, 6, 7, 4));
    EXPECT_TRUE(four.Set(8.0));
    EXPECT_EQ(four.Get<FbxDouble4>(), FbxDouble4(8, 6, 7, 4));
    EXPECT_TRUE(four.Set(9));
    EXPECT_EQ(four.Get<FbxDouble4>(), FbxDouble4(9, 6, 7, 4));
    EXPECT_EQ(holding(FbxDoubleDT, FbxDouble3(5, 6, 7)).Get<FbxDouble>(), 5.0);
    EXPECT_EQ(holding(FbxIntDT, FbxDouble2(5.9, 6)).Get<FbxInt>(), 5);
}

TEST_F(PropertyConversionTest, DropsComponentsThatTheTypeDoesNotHave) {
    const FbxProperty two = holding(FbxDouble2DT, FbxDouble4(1, 2, 3, 4));

    EXPECT_EQ(two.Get<FbxDouble4>(), FbxDouble4(1, 2, 0, 0));
}

TEST_F(PropertyConversionTest, TakesColoursForVectors) {
    EXPECT_EQ(holding(FbxColor3DT, FbxColor(0.1, 0.2, 0.3, 0.4)).Get<FbxDouble3>(), FbxDouble3(0.1, 0.2, 0.3));
    EXPECT_EQ(holding(FbxColor4DT, FbxColor(0.1, 0.2, 0.3, 0.4)).Get<FbxColor>(), FbxColor(0.1, 0.2, 0.3, 0.4));
    EXPECT_EQ(holding(FbxDouble3DT, FbxVector4(1, 2, 3, 9)).Get<FbxDouble3>(), FbxDouble3(1, 2, 3));
    EXPECT_EQ(holding(FbxDouble2DT, FbxVector2(1, 2)).Get<FbxVector2>(), FbxVector2(1, 2));
}

TEST_F(PropertyConversionTest, ExchangesTimesWithWholeNumbersAsTicks) {
    EXPECT_EQ(holding(FbxTimeDT, FbxTime(46186158000)).Get<FbxLongLong>(), 46186158000);
    EXPECT_EQ(holding(FbxTimeDT, FbxTime(46186158000)).Get<FbxInt>(), INT32_MAX);
    EXPECT_EQ(holding(FbxTimeDT, FbxLongLong{7}).Get<FbxTime>(), FbxTime(7));
    EXPECT_EQ(holding(FbxLongLongDT, FbxTime(-7)).Get<FbxLongLong>(), -7);
    EXPECT_EQ(holding(FbxLongLongDT, FbxLongLong{-7}).Get<FbxTime>(), FbxTime(-7));
}

TEST_F(PropertyConversionTest, HasNoneBetweenTimesAndReals) {
    FbxProperty time = holding(FbxTimeDT, FbxTime(5));
    FbxProperty real = holding(FbxDoubleDT, 5.0);

    EXPECT_EQ(time.Get<FbxDouble>(), 0.0);
    EXPECT_EQ(time.Get<FbxDouble3>(), FbxDouble3(0, 0, 0));
    EXPECT_EQ(real.Get<FbxTime>(), FbxTime(0));
    EXPECT_FALSE(time.Set(1.0));
    EXPECT_FALSE(time.Set(FbxDouble3(1, 2, 3)));
    EXPECT_FALSE(real.Set(FbxTime(1)));
    EXPECT_EQ(time.Get<FbxTime>(), FbxTime(5));
    EXPECT_EQ(real.Get<FbxDouble>(), 5.0);
}

TEST_F(PropertyConversionTest, HasNoneBetweenTextAndNumbers) {
    FbxProperty text = holding(FbxStringDT, FbxString("12"));
    FbxProperty number = holding(FbxIntDT, 12);

    EXPECT_EQ(text.Get<FbxInt>(), 0);
    EXPECT_EQ(text.Get<FbxTime>(), FbxTime(0));
    EXPECT_EQ(number.Get<FbxString>(), FbxString());
    EXPECT_FALSE(text.Set(12));
    EXPECT_FALSE(text.Set(FbxTime(12)));
    EXPECT_FALSE(number.Set(FbxString("13")));
    EXPECT_FALSE(number.Set("13"));
    EXPECT_EQ(text.Get<FbxString>(), FbxString("12"));
    EXPECT_EQ(number.Get<FbxInt>(), 12);
}

TEST_F(PropertyConversionTest, HasNoneForPropertiesThatHoldNoValue) {
    for (const FbxDataType& type : {FbxCompoundDT, FbxReferenceDT, FbxBlobDT}) {
        FbxProperty empty = property(type);
        EXPECT_TRUE(empty.IsValid()) << type.GetName();
        EXPECT_FALSE(empty.Set(1)) << type.GetName();
        EXPECT_FALSE(empty.Set("text")) << type.GetName();
        EXPECT_FALSE(empty.Set(FbxTime(1))) << type.GetName();
        EXPECT_FALSE(empty.Set(FbxDouble3(1, 2, 3))) << type.GetName();
        EXPECT_EQ(empty.Get<FbxInt>(), 0) << type.GetName();
        EXPECT_EQ(empty.Get<FbxString>(), FbxString()) << type.GetName();
    }
}

TEST_F(PropertyConversionTest, OfARefusedValueLeavesNothingBehind) {
    FbxProperty upAxis = scene->GetGlobalSettings().FindProperty("UpAxis");

    EXPECT_FALSE(upAxis.Set("Z"));

    EXPECT_EQ(upAxis.Get<FbxInt>(), 1);
}

} // namespace
