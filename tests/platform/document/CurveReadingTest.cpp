// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The packed curves of 7.x files.
#include "DocumentFromText.h"

namespace fbxsdk::detail {
namespace {

using Times = std::vector<std::int64_t>;
using Floats = std::vector<float>;
using Indices = std::vector<std::uint32_t>;

CurveKeys curveOf(const std::string& records) {
    const auto document =
        documentOf("7.5.0", "Objects: { AnimationCurve: 1, \"AnimCurve::\", \"\" {\n" + records + "\n} }");
    return document->objects.empty() ? CurveKeys() : readCurve(*document, document->objects[0]);
}

const std::string kThreeKeys = "KeyTime: *3 { a: 10,20,30 }\nKeyValueFloat: *3 { a: 1,2,3 }\n";

TEST(CurveReading, ReadsTimesValuesAndDefault) {
    const CurveKeys curve = curveOf("Default: 1.5\n" + kThreeKeys);
    EXPECT_EQ(curve.defaultValue, 1.5);
    EXPECT_EQ(curve.times, (Times{10, 20, 30}));
    EXPECT_EQ(curve.values, (Floats{1, 2, 3}));
    EXPECT_EQ(curve.before.type, ExtrapolationType::constant);
    EXPECT_EQ(curve.after.count, -1);
}

TEST(CurveReading, UnpacksSlopes) {
    // 1065353216 is 1.0F, 3221225472 is -2.0F.
    const CurveKeys curve = curveOf(kThreeKeys + "KeyAttrFlags: *1 { a: 1032 }\n"
                                                 "KeyAttrDataFloat: *4 { a: 1065353216,-1073741824,218434821,0 }\n"
                                                 "KeyAttrRefCount: *1 { a: 3 }");
    ASSERT_EQ(curve.attributes.size(), 1U);
    EXPECT_EQ(curve.attributes[0].flags, 1032U);
    EXPECT_EQ(curve.attributes[0].data[0], 1.0F);
    EXPECT_EQ(curve.attributes[0].data[1], -2.0F);
    EXPECT_EQ(curve.attributes[0].data[2], 1.0F / 3);
    EXPECT_EQ(curve.attributes[0].data[3], 1.0F / 3);
}

TEST(CurveReading, UnpacksWeightsAndVelocitiesThatTheFlagsAnnounce) {
    // Word 2: 7668 right, 5401 next left. Word 3: -9999 right, 4999.5 is not possible, so 9999 next left.
    const std::uint32_t weights = 7668U | (5401U << 16U);
    const std::uint32_t velocities = static_cast<std::uint16_t>(-9999) | (9999U << 16U);
    const std::string words = std::to_string(static_cast<std::int32_t>(weights)) + "," +
                              std::to_string(static_cast<std::int32_t>(velocities));
    const CurveKeys all = curveOf(kThreeKeys + "KeyAttrFlags: *1 { a: 855639048 }\nKeyAttrDataFloat: *4 { a: 0,0," +
                                  words + " }\nKeyAttrRefCount: *1 { a: 3 }");
    ASSERT_EQ(all.attributes.at(0).flags, 0x33000408U);
    EXPECT_EQ(all.attributes[0].data[2], 7668 / 9999.0F);
    EXPECT_EQ(all.attributes[0].data[3], 5401 / 9999.0F);
    EXPECT_EQ(all.attributes[0].data[4], -1.0F);
    EXPECT_EQ(all.attributes[0].data[5], 1.0F);

    const CurveKeys none = curveOf(kThreeKeys + "KeyAttrFlags: *1 { a: 1032 }\nKeyAttrDataFloat: *4 { a: 0,0," + words +
                                   " }\nKeyAttrRefCount: *1 { a: 3 }");
    EXPECT_EQ(none.attributes.at(0).data[2], 1.0F / 3);
    EXPECT_EQ(none.attributes.at(0).data[4], 0.0F);
}

TEST(CurveReading, ReadsTensionContinuityAndBias) {
    const CurveKeys curve = curveOf(kThreeKeys + "KeyAttrFlags: *1 { a: 520 }\n"
                                                 "KeyAttrDataFloat: *4 { a: 1056964608,0,1065353216,0 }\n"
                                                 "KeyAttrRefCount: *1 { a: 3 }");
    EXPECT_EQ(curve.attributes.at(0).data[0], 0.5F);
    EXPECT_EQ(curve.attributes.at(0).data[1], 0.0F);
    EXPECT_EQ(curve.attributes.at(0).data[2], 1.0F);
}

TEST(CurveReading, SpreadsAttributesByTheirCounts) {
    const CurveKeys curve = curveOf(kThreeKeys + "KeyAttrFlags: *2 { a: 2,4 }\n"
                                                 "KeyAttrDataFloat: *8 { a: 0,0,0,0,0,0,0,0 }\n"
                                                 "KeyAttrRefCount: *2 { a: 1,2 }");
    EXPECT_EQ(curve.attributeOfKey, (Indices{0, 1, 1}));
}

TEST(CurveReading, RepeatsTheLastAttributeWhenTheCountsAreTooSmall) {
    const CurveKeys curve = curveOf(kThreeKeys + "KeyAttrFlags: *2 { a: 2,4 }\nKeyAttrRefCount: *1 { a: 1 }");
    EXPECT_EQ(curve.attributeOfKey, (Indices{0, 1, 1}));
}

TEST(CurveReading, IgnoresCountsBeyondTheKeysAndNegativeOnes) {
    const CurveKeys curve =
        curveOf(kThreeKeys + "KeyAttrFlags: *3 { a: 2,4,8 }\nKeyAttrRefCount: *3 { a: -5,2000000000,7 }");
    EXPECT_EQ(curve.attributeOfKey, (Indices{1, 1, 1}));
}

TEST(CurveReading, CurvesWithoutAttributesAreLinear) {
    const CurveKeys curve = curveOf(kThreeKeys);
    ASSERT_EQ(curve.attributes.size(), 1U);
    EXPECT_EQ(curve.attributes[0].flags, 4U);
    EXPECT_EQ(curve.attributeOfKey, (Indices{0, 0, 0}));
}

TEST(CurveReading, KeepsFlagsWhenTheirDataIsCutShort) {
    const CurveKeys curve = curveOf(kThreeKeys + "KeyAttrFlags: *2 { a: 1032,1032 }\n"
                                                 "KeyAttrDataFloat: *5 { a: 1065353216,0,0,0,1065353216 }\n"
                                                 "KeyAttrRefCount: *2 { a: 1,2 }");
    ASSERT_EQ(curve.attributes.size(), 2U);
    EXPECT_EQ(curve.attributes[0].data[0], 1.0F);
    EXPECT_EQ(curve.attributes[1].flags, 1032U);
    EXPECT_EQ(curve.attributes[1].data[0], 0.0F);
}

TEST(CurveReading, CutsToTheShorterOfTimesAndValues) {
    EXPECT_EQ(curveOf("KeyTime: *3 { a: 1,2,3 }\nKeyValueFloat: *2 { a: 4,5 }").times, (Times{1, 2}));
    EXPECT_EQ(curveOf("KeyTime: *1 { a: 1 }\nKeyValueFloat: *2 { a: 4,5 }").values, (Floats{4}));
    EXPECT_TRUE(curveOf("KeyTime: *1 { a: 1 }").times.empty());
}

TEST(CurveReading, SortsKeysWithTheirAttributes) {
    const CurveKeys curve = curveOf("KeyTime: *3 { a: 30,10,20 }\nKeyValueFloat: *3 { a: 3,1,2 }\n"
                                    "KeyAttrFlags: *3 { a: 2,4,8 }\nKeyAttrRefCount: *3 { a: 1,1,1 }");
    EXPECT_EQ(curve.times, (Times{10, 20, 30}));
    EXPECT_EQ(curve.values, (Floats{1, 2, 3}));
    EXPECT_EQ(curve.attributeOfKey, (Indices{1, 2, 0}));
}

TEST(CurveReading, OfKeysAtOneTimeTheLaterWins) {
    const CurveKeys curve = curveOf("KeyTime: *4 { a: 10,10,5,10 }\nKeyValueFloat: *4 { a: 1,2,3,4 }");
    EXPECT_EQ(curve.times, (Times{5, 10}));
    EXPECT_EQ(curve.values, (Floats{3, 4}));
}

TEST(CurveReading, ReadsExtrapolation) {
    const CurveKeys curve = curveOf(
        kThreeKeys + "Pre-Extrapolation: { Type: R\nRepetition: -1 }\nPost-Extrapolation: { Type: M\nRepetition: 3 }");
    EXPECT_EQ(curve.before.type, ExtrapolationType::repetition);
    EXPECT_EQ(curve.before.count, -1);
    EXPECT_EQ(curve.after.type, ExtrapolationType::mirrorRepetition);
    EXPECT_EQ(curve.after.count, 3);
}

TEST(CurveReading, UnknownExtrapolationIsConstant) {
    const CurveKeys curve = curveOf(kThreeKeys + "Pre-Extrapolation: { Type: X }\nPost-Extrapolation: { Type: \"\" }");
    EXPECT_EQ(curve.before.type, ExtrapolationType::constant);
    EXPECT_EQ(curve.after.type, ExtrapolationType::constant);
}

TEST(CurveReading, BoundsTheRepetitions) {
    const CurveKeys curve = curveOf(kThreeKeys + "Pre-Extrapolation: { Type: A\nRepetition: 99999999999999 }\n"
                                                 "Post-Extrapolation: { Type: K\nRepetition: -7 }");
    EXPECT_EQ(curve.before.count, 1'000'000'000);
    EXPECT_EQ(curve.after.count, -1);
}

TEST(CurveReading, AnObjectWithoutKeysHasNone) {
    const CurveKeys curve = curveOf("Default: 7");
    EXPECT_TRUE(curve.times.empty());
    EXPECT_EQ(curve.defaultValue, 7);
}

} // namespace
} // namespace fbxsdk::detail
