// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The key lists of files before 7.x, token by token.
#include "platform/document/DocumentFromText.h"

#include "document/legacy/LegacyKeys.h"

namespace fbxsdk::detail {
namespace {

/// The document keeps the tree alive; the curve is that of a channel on a Model's visibility.
std::unique_ptr<Document> documentWithKeys(int count, const std::string& keys, const std::string& more = {}) {
    return documentOf("6.1.0", R"(
        Objects: { Model: "Model::m", "Null" { Properties60: { Property: "Visibility", "Visibility", "A",1 } } }
        Takes: { Take: "t" { LocalTime: 0,100
            Model: "Model::m" { Channel: "Visibility" { Default: 0.25
                KeyVer: 4005
                KeyCount: )" + std::to_string(count) +
                                   "\nKey: " + keys + "\n" + more + "\n} } } }");
}

CurveKeys curveOf(int count, const std::string& keys, const std::string& more = {}) {
    const auto document = documentWithKeys(count, keys, more);
    EXPECT_EQ(document->legacyCurves.size(), 1U) << keys;
    return document->legacyCurves.empty() ? CurveKeys() : document->legacyCurves[0];
}

KeyAttributes attributeOf(const std::string& tokens) {
    const CurveKeys curve = curveOf(1, "0,1," + tokens);
    return curve.attributes.empty() ? KeyAttributes{.flags = 0xDEAD} : curve.attributes[0];
}

/// The flags of a key between two others.
std::uint32_t middleFlagsOf(const std::string& tokens) {
    const CurveKeys curve = curveOf(3, "0,1,L,1,1," + tokens + ",2,1,L");
    return curve.attributeOfKey.size() == 3 ? curve.attributes[curve.attributeOfKey[1]].flags : 0xDEAD;
}

TEST(LegacyKeys, ReadsTimesAndValues) {
    const CurveKeys curve = curveOf(2, "1924423250,-8.5,L,46186158000,2,L");
    EXPECT_EQ(curve.times, (std::vector<std::int64_t>{1924423250, 46186158000}));
    EXPECT_EQ(curve.values, (std::vector<float>{-8.5F, 2}));
    EXPECT_EQ(curve.attributes.size(), 1U);
    EXPECT_EQ(curve.attributeOfKey, (std::vector<std::uint32_t>{0, 0}));
    EXPECT_EQ(curve.defaultValue, 0.25);
}

TEST(LegacyKeys, ReadsLinearAndConstantKeys) {
    EXPECT_EQ(attributeOf("L").flags, KeyFlag::linear);
    EXPECT_EQ(attributeOf("C,s").flags, KeyFlag::constant);
    EXPECT_EQ(attributeOf("C,n").flags, KeyFlag::constant | KeyFlag::constantNext);
    EXPECT_EQ(attributeOf("C").flags, KeyFlag::constant);
}

TEST(LegacyKeys, ReadsTheSlopesOfUserKeys) {
    const KeyAttributes attribute = attributeOf("U,s,1.5,-2.5,n");
    EXPECT_EQ(attribute.flags, KeyFlag::cubic | KeyFlag::tangentUser);
    EXPECT_EQ(attribute.data[0], 1.5F);
    EXPECT_EQ(attribute.data[1], -2.5F);
    EXPECT_EQ(attribute.data[2], 1.0F / 3);
    EXPECT_EQ(attribute.data[3], 1.0F / 3);
}

TEST(LegacyKeys, ReadsBrokenKeys) {
    const KeyAttributes attribute = attributeOf("U,b,1,2,a,0.25,0.75");
    EXPECT_EQ(attribute.flags, KeyFlag::cubic | KeyFlag::tangentUser | KeyFlag::genericBreak | KeyFlag::weightedRight |
                                   KeyFlag::weightedNextLeft);
    EXPECT_EQ(attribute.data[2], 0.25F);
    EXPECT_EQ(attribute.data[3], 0.75F);
}

TEST(LegacyKeys, ReadsEveryKindOfWeight) {
    EXPECT_EQ(attributeOf("U,s,0,0,r,0.5").data[2], 0.5F);
    EXPECT_EQ(attributeOf("U,s,0,0,r,0.5").data[3], 1.0F / 3);
    EXPECT_EQ(attributeOf("U,s,0,0,r,0.5").flags, KeyFlag::cubic | KeyFlag::tangentUser | KeyFlag::weightedRight);
    EXPECT_EQ(attributeOf("U,s,0,0,l,0.5").data[2], 1.0F / 3);
    EXPECT_EQ(attributeOf("U,s,0,0,l,0.5").data[3], 0.5F);
    EXPECT_EQ(attributeOf("U,s,0,0,l,0.5").flags, KeyFlag::cubic | KeyFlag::tangentUser | KeyFlag::weightedNextLeft);
    EXPECT_EQ(attributeOf("U,s,0,0,c").flags, KeyFlag::cubic | KeyFlag::tangentUser);
}

TEST(LegacyKeys, ReadsAutomaticKeys) {
    EXPECT_EQ(middleFlagsOf("U,a,n"), KeyFlag::cubic | KeyFlag::tangentAuto);
    EXPECT_EQ(middleFlagsOf("U,a"), KeyFlag::cubic | KeyFlag::tangentAuto);
    EXPECT_EQ(attributeOf("U,a,a,0.5,0.6").data[3], 0.6F);
    EXPECT_EQ(attributeOf("U,p,1,2,n,n").flags,
              KeyFlag::cubic | KeyFlag::tangentAuto | KeyFlag::genericClampProgressive);
    EXPECT_EQ(attributeOf("U,p,1,2,n").flags, KeyFlag::cubic | KeyFlag::tangentAuto | KeyFlag::genericClampProgressive);
    EXPECT_EQ(attributeOf("U,q,1,2,n,n").flags, KeyFlag::cubic | KeyFlag::tangentAuto | KeyFlag::genericClamp);
    EXPECT_EQ(attributeOf("U,d,3,n").flags, KeyFlag::cubic | KeyFlag::tangentAuto | KeyFlag::genericBreak);
    EXPECT_EQ(attributeOf("U,p,1,2,n,n").data[0], 0.0F);
}

// The 7.5 files of the same scenes mark such keys so: the tangents of the first and the last one are clamped.
TEST(LegacyKeys, FlattensAutomaticKeysAtBothEnds) {
    constexpr std::uint32_t kAuto = KeyFlag::cubic | KeyFlag::tangentAuto,
                            kFlat = kAuto | KeyFlag::genericClampProgressive;
    const auto flagsOf = [](const CurveKeys& curve) {
        std::vector<std::uint32_t> flags;
        for (const std::uint32_t index : curve.attributeOfKey)
            flags.push_back(curve.attributes[index].flags);
        return flags;
    };
    EXPECT_EQ(flagsOf(curveOf(4, "0,0,U,a,n,1,1,U,a,n,2,1,U,a,n,3,0,U,a,n")),
              (std::vector<std::uint32_t>{kFlat, kAuto, kAuto, kFlat}));
    EXPECT_EQ(flagsOf(curveOf(3, "20,0,U,a,n,10,1,U,a,n,0,1,U,a,n")),
              (std::vector<std::uint32_t>{kFlat, kAuto, kFlat}));
    EXPECT_EQ(flagsOf(curveOf(2, "0,0,U,s,1,2,n,1,0,L")),
              (std::vector<std::uint32_t>{KeyFlag::cubic | KeyFlag::tangentUser, KeyFlag::linear}));
    EXPECT_EQ(flagsOf(curveOf(2, "0,0,U,q,1,2,n,1,0,U,d,3,n")),
              (std::vector<std::uint32_t>{kAuto | KeyFlag::genericClamp, kAuto | KeyFlag::genericBreak}));
}

TEST(LegacyKeys, ReadsTensionContinuityAndBias) {
    const KeyAttributes attribute = attributeOf("U,t,0.1,0.2,0.3");
    EXPECT_EQ(attribute.flags, KeyFlag::cubic | KeyFlag::tangentTcb);
    EXPECT_EQ(attribute.data[0], 0.1F);
    EXPECT_EQ(attribute.data[1], 0.2F);
    EXPECT_EQ(attribute.data[2], 0.3F);
}

TEST(LegacyKeys, ReadsUserKeysWithoutWeightsOfTheOldestVersions) {
    const CurveKeys curve = curveOf(2, "0,1,U,s,2,3,10,4,U,s,5,6");
    EXPECT_EQ(curve.values, (std::vector<float>{1, 4}));
    EXPECT_EQ(curve.attributes.at(1).data[1], 6.0F);
}

TEST(LegacyKeys, ReadsMixedLists) {
    const CurveKeys curve = curveOf(5, "0,0,U,s,0,2.717,a,0.333,0.333,10,-6.11,L,20,-3.87,C,s,30,-1.93,C,n,40,1,U,a,n");
    EXPECT_EQ(curve.times.size(), 5U);
    EXPECT_EQ(curve.attributes.size(), 5U);
}

TEST(LegacyKeys, ReadsExtrapolation) {
    const CurveKeys curve = curveOf(1, "0,1,L", "Post-Extrapolation: { Type: R\nRepetition: 2 }");
    EXPECT_EQ(curve.after.type, ExtrapolationType::repetition);
    EXPECT_EQ(curve.after.count, 2);
    EXPECT_EQ(curve.before.type, ExtrapolationType::constant);
}

TEST(LegacyKeys, SortsKeys) {
    const CurveKeys curve = curveOf(3, "20,2,L,10,1,C,s,20,3,C,n");
    EXPECT_EQ(curve.times, (std::vector<std::int64_t>{10, 20}));
    EXPECT_EQ(curve.values, (std::vector<float>{1, 3}));
}

TEST(LegacyKeys, DropsCurvesThatDoNotAddUp) {
    const std::pair<int, const char*> kLists[] = {
        {2, "0,1,L"},           // fewer keys than stated
        {1, "0,1,L,1,2,L"},     // more
        {1, "0,1"},             // no mode
        {1, "0"},               // no value
        {1, "0,1,X"},           // unknown mode
        {1, "0,1,U"},           // no tangents
        {1, "0,1,U,z,n"},       // unknown tangents
        {1, "0,1,U,s,1"},       // a slope is missing
        {1, "0,1,U,s,1,2,a,1"}, // a weight is missing
        {1, "0,1,U,s,1,2,y"},   // unknown weights
        {1, "0,1,C,z"},         // unknown constant
        {1, "L,0,1"},           // wrong order
        {1, "0,1,L,5"},         // something is left
        {-3, "0,1,L"},          // nonsense
    };
    for (const auto& [count, keys] : kLists) {
        const auto document = documentWithKeys(count, keys);
        EXPECT_TRUE(document->legacyCurves.empty()) << keys;
        EXPECT_TRUE(warnsOf(*document, "the key list is incomplete or does not match its key count")) << keys;
        EXPECT_EQ(objectNamed(*document, "AnimationCurve", ""), nullptr) << keys;
    }
}

TEST(LegacyKeys, AnEmptyKeyListIsNoCurve) {
    const auto document = documentWithKeys(0, "");
    EXPECT_TRUE(document->legacyCurves.empty());
    EXPECT_TRUE(document->warnings.empty());
}

} // namespace
} // namespace fbxsdk::detail
