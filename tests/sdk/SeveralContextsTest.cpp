// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Contexts share nothing, and files that are loaded into one context add up.
#include "support/MemoryLimitScope.h"
#include "support/TemporaryFolder.h"

#include "Fbx.h"
#include "FbxSdk.h"
#include "TnFbxError.h"
#include "TnFbxNull.h"
#include "TnFbxReadInfo.h"

#include <gtest/gtest.h>

#include <memory>

namespace Tarnell::Fbx {
namespace {

constexpr std::int64_t kTicksPerSecond = 46'186'158'000;

std::string property(const std::string& name, const std::string& type, const std::string& value) {
    return "P: \"" + name + "\", \"" + type + "\", \"\", \"\"," + value + "\n";
}

/// A file with one null, keyed along X at the first and the last second.
std::string animatedNull(const std::string& timeSettings, std::int64_t seconds) {
    const std::string end = std::to_string(seconds * kTicksPerSecond);
    return "; FBX 7.4.0 project file\nGlobalSettings: { Properties70: {\n" + timeSettings +
           "} }\nObjects: {\nModel: 1, \"Model::locator\", \"Null\" { }\n"
           "AnimationStack: 2, \"AnimStack::Take 001\", \"\" { Properties70: {\n" +
           property("LocalStop", "KTime", end) +
           "} }\nAnimationLayer: 3, \"AnimLayer::Base\", \"\" { }\n"
           "AnimationCurveNode: 4, \"AnimCurveNode::T\", \"\" { Properties70: {\n" +
           property("d|X", "Number", "0") + "} }\nAnimationCurve: 5, \"AnimCurve::\", \"\" { KeyTime: *2 { a: 0," +
           end +
           " }\nKeyValueFloat: *2 { a: 1,3 }\nKeyAttrFlags: *1 { a: 4 }\nKeyAttrRefCount: *1 { a: 2 } }\n}\n"
           "Connections: {\nC: \"OO\",1,0\nC: \"OO\",3,2\nC: \"OO\",4,3\n"
           "C: \"OP\",4,1,\"Lcl Translation\"\nC: \"OP\",5,4,\"d|X\"\n}\n";
}

/// The time record of the null's X position, read locally.
TnFbxTime timeOfNull(FbxSdk& sdk) {
    TnFbxReadInfo info;
    info.setGlobalTransform(false);
    TnFbxNull null;
    EXPECT_TRUE(sdk.getNulls(info, &null, 1)) << lastError();
    EXPECT_TRUE(null.getTransformAnimated(TnFbxTransform::kFbxTransformPositionX));
    return null.getTransformChannel(TnFbxTransform::kFbxTransformPositionX)->getTime();
}

TEST(SeveralContexts, CountFramesAtTheRateOfTheirOwnScene) {
    const support::TemporaryFolder folder;
    const std::string slow = folder.write(
        "slow.fbx",
        animatedNull(property("TimeMode", "enum", "14") + property("CustomFrameRate", "double", "12.5"), 2));
    const std::string fast = folder.write(
        "fast.fbx", animatedNull(property("TimeMode", "enum", "14") + property("CustomFrameRate", "double", "50"), 2));
    FbxSdk first, second;
    ASSERT_TRUE(first.initFbxSdkManager() && first.loadScene(slow, /*convertGeometry*/ false)) << lastError();
    ASSERT_TRUE(second.initFbxSdkManager() && second.loadScene(fast, /*convertGeometry*/ false)) << lastError();

    TnFbxTime time;
    EXPECT_TRUE(first.getGlobalAnimationStackTime(time, 0.0f, false, 0.0f));
    EXPECT_EQ(time.getFrameRate(), 12.5f);
    EXPECT_EQ(time.getEndFrame(), 25);

    EXPECT_EQ(timeOfNull(second).getFrameRate(), 50.0f);
    EXPECT_EQ(timeOfNull(second).getEndFrame(), 100);
    EXPECT_EQ(timeOfNull(first).getFrameRate(), 12.5f);
    EXPECT_EQ(timeOfNull(first).getEndFrame(), 25);
}

TEST(SeveralFilesInOneContext, KeepTheAnimationOfTheFirst) {
    const support::TemporaryFolder folder;
    constexpr std::int64_t kSeconds = 500'000;
    const std::string settings = property("TimeMode", "enum", "11");
    const std::string longClip =
        folder.write("long.fbx", animatedNull(settings, kSeconds) + ";" + std::string(10'000, '-') + "\n");
    const std::string shortClip = folder.write("short.fbx", "; FBX 7.4.0 project file\nObjects: { }\n");
    FbxSdk sdk;
    ASSERT_TRUE(sdk.initFbxSdkManager());
    ASSERT_TRUE(sdk.loadScene(longClip, /*convertGeometry*/ false)) << lastError();
    ASSERT_TRUE(sdk.loadScene(shortClip, /*convertGeometry*/ false)) << lastError();

    EXPECT_EQ(timeOfNull(sdk).getEndFrame(), 24 * kSeconds);
}

TEST(ReadsOverTheMemoryLimit, HandOutTheArrayAndNameTheFileTheFramesAndTheLimit) {
    const support::MemoryLimitScope limit(1 << 16);
    const support::TemporaryFolder folder;
    const std::string file = folder.write("long.fbx", animatedNull(property("TimeMode", "enum", "11"), 1000));
    TnFbxReadInfo info;
    info.setFileName(file);
    info.setAnimationStackName("any");

    for (const bool global : {false, true}) {
        info.setGlobalTransform(global);
        TnFbxNull* nulls = nullptr;
        int count = 0;
        EXPECT_FALSE(Fbx().getNulls(info, &nulls, count));
        const std::unique_ptr<TnFbxNull[]> owner(nulls);
        ASSERT_EQ(count, 1);
        ASSERT_NE(nulls, nullptr);
        EXPECT_FALSE(nulls[0].getTransformAnimated(TnFbxTransform::kFbxTransformPositionX));
        for (const std::string& part : {file, std::string("frames 0 to 24000 at 24"), std::string("64.0 KiB")})
            EXPECT_NE(lastError().find(part), std::string::npos) << part << " in " << lastError();
    }
}

} // namespace
} // namespace Tarnell::Fbx
