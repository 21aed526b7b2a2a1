// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The frame rate of the calling thread belongs to the host: every operation leaves it unchanged.
#include "FixtureFiles.h"
#include "support/FacadeReads.h"
#include "support/TemporaryFolder.h"

#include "FbxSdk.h"
#include "TnFbxWriteInfo.h"

#include <fbxsdk.h>

namespace Tarnell::Fbx {
namespace {

using namespace test;
using fbxsdk::FbxTime;

class TimeModeOfTheHost : public testing::TestWithParam<FbxTime::EMode> {
protected:
    TimeModeOfTheHost() {
        FbxTime::SetGlobalTimeMode(FbxTime::eCustom, 17.0);
        FbxTime::SetGlobalTimeMode(GetParam(), 17.0);
    }
    ~TimeModeOfTheHost() override {
        EXPECT_EQ(FbxTime::GetGlobalTimeMode(), GetParam());
        EXPECT_EQ(FbxTime::GetFrameRate(FbxTime::eCustom), 17.0);
        FbxTime::SetGlobalTimeMode(FbxTime::eCustom, 0.0);
        FbxTime::SetGlobalTimeMode(FbxTime::eDefaultMode);
    }
};
INSTANTIATE_TEST_SUITE_P(Modes, TimeModeOfTheHost, testing::Values(FbxTime::ePAL, FbxTime::eCustom));

TEST_P(TimeModeOfTheHost, StaysAfterAReadOfTheFacade) {
    FacadeRead<TnFbxNull> nulls(fixture("custom_rate_7400_ascii.fbx"));
    EXPECT_EQ(nulls["node"].getTransformTime(TnFbxTransform::kFbxTransformPositionX).getFrameRate(), 12.5f);
}

TEST_P(TimeModeOfTheHost, StaysAfterAReadOfPointCaches) {
    FacadeRead<TnFbxMesh> meshes(fixture("caches_7400_ascii.fbx"));
    EXPECT_GT(meshes.count, 0);
}

TEST_P(TimeModeOfTheHost, StaysAfterQuestionsAboutAFile) {
    float start = 0.0f, end = 0.0f;
    EXPECT_TRUE(Fbx().getAnimationFrameRange(fixture("custom_rate_7400_ascii.fbx").c_str(), start, end));
}

TEST_P(TimeModeOfTheHost, StaysAfterAFailure) {
    const support::TemporaryFolder folder;
    TnFbxReadInfo info = localRead(folder.write("a.fbx", "; FBX 7.4.0 project file\nObjects: {\n"));
    TnFbxNull* nulls = nullptr;
    int count = 0;
    EXPECT_FALSE(Fbx().getNulls(info, &nulls, count));
}

TEST_P(TimeModeOfTheHost, StaysAfterAWrite) {
    const support::TemporaryFolder folder;
    TnFbxNull null;
    null.setName("node");
    TnFbxWriteInfo info;
    info.setFileName(folder.file("a.fbx"));
    info.setAnimationStackName("any");
    info.setFPS(50.0f);
    EXPECT_TRUE(Fbx().writeFile(info, {}, {}, {}, {&null}, {})) << lastError();
}

TEST_P(TimeModeOfTheHost, StaysAfterEachOperationOfTheAdapter) {
    FbxSdk sdk;
    ASSERT_TRUE(Fbx().loadScene(fixture("custom_rate_7400_ascii.fbx"), sdk));
    EXPECT_EQ(FbxTime::GetGlobalTimeMode(), GetParam());
    TnFbxTime time;
    EXPECT_TRUE(sdk.getGlobalAnimationStackTime(time, 0.0f, false, 0.0f));
    EXPECT_EQ(time.getFrameRate(), 12.5f);
    EXPECT_EQ(FbxTime::GetGlobalTimeMode(), GetParam());
    TnFbxNull null;
    fbxsdk::FbxAMatrix geometric;
    EXPECT_TRUE(sdk.getNull(time, false, false, 0.0f, sdk.getScene()->GetRootNode()->GetChild(0), null, geometric));
    EXPECT_EQ(null.getTransformTime(TnFbxTransform::kFbxTransformPositionX).getFrameRate(), 12.5f);
}

} // namespace
} // namespace Tarnell::Fbx
