// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Which stack and which frames are read, and the placement of objects.
#include "FaithfulFixture.h"

#include "FbxFaithful.h"
#include "TnFbxError.h"
#include "TnFbxLimits.h"

#include <memory>
#include <utility>

namespace Tarnell::Fbx::test {
namespace {

constexpr auto kX = TnFbxTransform::kFbxTransformPositionX;
constexpr auto kTurnX = TnFbxTransform::kFbxTransformRotationX;
constexpr auto kTurnZ = TnFbxTransform::kFbxTransformRotationZ;

TnFbxReadInfo stackNamed(const char* name) {
    TnFbxReadInfo info = faithfulRead(fixture("two_stacks_7400_ascii.fbx"));
    info.setAnimationStackName(name);
    return info;
}

TEST(FaithfulReading, TakesTheStackOfTheName) {
    const TnFbxTime walk = FacadeRead<TnFbxNull>(stackNamed("walk"))["node"].getTransformTime(kX);
    const TnFbxTime run = FacadeRead<TnFbxNull>(stackNamed("run"))["node"].getTransformTime(kX);
    EXPECT_EQ(walk.getStartFrame(), 1001);
    EXPECT_EQ(run.getStartFrame(), 0);
}

TEST(FaithfulReading, TakesTheFirstStackWhenNoneIsNamed) {
    EXPECT_EQ(FacadeRead<TnFbxNull>(stackNamed(""))["node"].getTransformTime(kX).getStartFrame(), 1001);
}

TEST(FaithfulReading, FailsForAStackThatIsNotThereAndSaysWhichAre) {
    TnFbxReadInfo info = stackNamed("jump");
    TnFbxNull* nulls = nullptr;
    int count = 7;
    EXPECT_FALSE(Fbx().getNulls(info, &nulls, count));
    EXPECT_EQ(count, 0);
    EXPECT_EQ(nulls, nullptr);
    EXPECT_THAT(lastError(), testing::HasSubstr("two_stacks_7400_ascii.fbx"));
    EXPECT_THAT(lastError(), testing::HasSubstr("\"walk\", \"run\""));
}

std::unique_ptr<TnFbxNull[]> nullsOf(FbxFaithful& file) {
    TnFbxNull* nulls = nullptr;
    int count = 0;
    EXPECT_TRUE(file.readAll(&nulls, count)) << lastError();
    EXPECT_GT(count, 0);
    return std::unique_ptr<TnFbxNull[]>(nulls);
}

TEST(FaithfulReading, SelectsOneStackAfterTheOtherOfALoadedFile) {
    for (const auto& [first, second] : {std::pair("walk", "run"), std::pair("run", "walk")}) {
        FbxFaithful file;
        EXPECT_FALSE(file.select(stackNamed(first))) << "nothing is loaded";
        ASSERT_TRUE(file.load(stackNamed(first))) << lastError();
        for (const char* const name : {first, second, first}) {
            ASSERT_TRUE(file.select(stackNamed(name))) << lastError();
            const auto nulls = nullsOf(file);
            const FacadeRead<TnFbxNull> expected(stackNamed(name));
            EXPECT_EQ(file.getFirstFrame(), expected.objects[0].getTransformTime(kX).getStartFrame());
            EXPECT_EQ(nulls[0].getTransformTime(kX).getStartFrame(),
                      expected.objects[0].getTransformTime(kX).getStartFrame());
            for (const float frame : {0.0f, 5.0f, 1001.0f, 1010.0f})
                EXPECT_EQ(nulls[0].getTransformValueAt(kX, frame), expected.objects[0].getTransformValueAt(kX, frame));
        }
    }
}

TEST(FaithfulReading, KeepsTheStackAndTheFramesWhenOthersCannotBeSelected) {
    FbxFaithful file;
    ASSERT_TRUE(file.load(stackNamed("walk"))) << lastError();
    TnFbxReadInfo nowhere = stackNamed("run");
    nowhere.setFrame(std::numeric_limits<float>::quiet_NaN());
    for (const TnFbxReadInfo& info : {stackNamed("jump"), nowhere}) {
        EXPECT_FALSE(file.select(info));
        EXPECT_EQ(file.getFirstFrame(), 1001);
        EXPECT_EQ(nullsOf(file)[0].getTransformTime(kX).getStartFrame(), 1001);
    }
}

TEST(FaithfulReading, FailsForAnInvalidSampleRateOrFrame) {
    TnFbxReadInfo info = stackNamed("");
    TnFbxNull* nulls = nullptr;
    int count = 0;
    info.setUseSampleFPS(true);
    info.setSampleFPS(-5.0f);
    EXPECT_FALSE(Fbx().getNulls(info, &nulls, count));
    info = stackNamed("");
    info.setFrame(std::numeric_limits<float>::quiet_NaN());
    EXPECT_FALSE(Fbx().getNulls(info, &nulls, count));
}

TEST(FaithfulReading, SamplesAtTheRequestedRateAtTheTrueTimes) {
    TestScene scene(0, 24);
    scene.key(scene.addNode("mover")->LclTranslation, "X", {{0, 0.0f}, {24, 24.0f}}); // one a frame of 24 per second
    const SavedScene saved(scene);
    TnFbxReadInfo info = saved.info();
    info.setUseSampleFPS(true);
    info.setSampleFPS(12.0f);
    info.setFrame(6.0f); // half a second
    FacadeRead<TnFbxNull> read(info);
    const TnFbxNull& mover = read["mover"];
    expectRange(mover.getTransformTime(kX), 0, 12, 12.0f);
    EXPECT_FLOAT_EQ(mover.getTransformValueAt(kX, 3.0f), 6.0f);
    EXPECT_FLOAT_EQ(mover.getTransformValue(kX), 12.0f);
}

TEST(FaithfulReading, SamplesAtTheExactRateOfTheFile) {
    const FacadeRead<TnFbxNull> film(faithfulRead(fixture("film_rate_7400_ascii.fbx")));
    const TnFbxTime time = film.objects[0].getTransformTime(kX);
    expectRange(time, 1001, 1003, static_cast<float>(24000.0 / 1001.0));
    const FacadeRead<TnFbxNull> custom(faithfulRead(fixture("custom_rate_7400_ascii.fbx")));
    expectRange(custom.objects[0].getTransformTime(kX), 2, 5, 12.5f);
}

TEST(FaithfulReading, SamplesTheSpanOfTheStackAndTheKeysBeyondIt) {
    TestScene scene(0, 4);
    scene.key(scene.addNode("mover")->LclTranslation, "X", {{-2, 0.0f}, {10, 12.0f}});
    expectRange(readFaithfully<TnFbxNull>(scene)["mover"].getTransformTime(kX), -2, 10, 24.0f);
}

TEST(FaithfulReading, TakesWhatIsKeyedButStillForNotAnimated) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.addNode("still");
    scene.key(node->LclTranslation, "X", {{0, 3.0f}, {10, 3.0f}});
    scene.key(node->LclTranslation, "Y", {{0, 3.0f}, {10, 4.0f}});
    auto read = readFaithfully<TnFbxNull>(scene);
    EXPECT_FALSE(read["still"].getTransformAnimated(kX));
    EXPECT_EQ(read["still"].getTransformValue(kX), 3.0f);
    EXPECT_TRUE(read["still"].getTransformAnimated(TnFbxTransform::kFbxTransformPositionY));
}

TEST(FaithfulReading, KeepsTheTurnsOfANodeThatItsOwnAnglesTurn) {
    TestScene scene(0, 2);
    scene.key(scene.addNode("wheel")->LclRotation, "Z", {{0, 0.0f}, {2, 1080.0f}}); // one and a half turns a frame
    EXPECT_THAT(samplesOf(readFaithfully<TnFbxNull>(scene)["wheel"], kTurnZ), isNear({0.0f, 540.0f, 1080.0f}));
}

TEST(FaithfulReading, GoesOnFromFrameToFrameWhereAParentTurns) {
    TestScene scene(0, 36);
    fbxsdk::FbxNode* parent = scene.addNode("parent");
    scene.key(parent->LclRotation, "X", {{0, 0.0f}, {36, 720.0f}});
    fbxsdk::FbxNode* child = scene.addNode("child", parent);
    child->LclRotation.Set(fbxsdk::FbxDouble3(0.0, 40.0, 20.0));
    const auto samples = samplesOf(readFaithfully<TnFbxNull>(scene)["child"], kTurnX);
    ASSERT_EQ(samples.size(), 37u);
    for (std::size_t i = 1; i < samples.size(); ++i)
        EXPECT_LT(std::abs(samples[i] - samples[i - 1]), 90.0f) << i;
}

TEST(FaithfulReading, ReturnsAMirroredScaleAndTheOrderInForce) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.addNode("mirrored");
    node->LclScaling.Set(fbxsdk::FbxDouble3(1.0, 1.0, -2.0));
    node->LclRotation.Set(fbxsdk::FbxDouble3(10.0, 20.0, 30.0));
    node->SetRotationActive(true);
    node->SetRotationOrder(fbxsdk::FbxNode::eSourcePivot, fbxsdk::FbxEuler::eOrderYZX);
    auto read = readFaithfully<TnFbxNull>(scene);
    const TnFbxNull& null = read["mirrored"];
    EXPECT_THAT(scaleOf(null), isNear({1.0f, 1.0f, -2.0f}));
    EXPECT_THAT(rotationOf(null), isNear({10.0f, 20.0f, 30.0f}));
    EXPECT_EQ(null.getTransformRotationOrder(), TnFbxTransform::kFbxRotationOrderYZX);
}

TEST(FaithfulReading, PutsTheShearOfScaledParentsIntoTheSkew) {
    TestScene scene;
    fbxsdk::FbxNode* parent = scene.addNode("parent");
    parent->LclScaling.Set(fbxsdk::FbxDouble3(2.0, 1.0, 1.0));
    fbxsdk::FbxNode* child = scene.addNode("child", parent);
    child->LclRotation.Set(fbxsdk::FbxDouble3(0.0, 0.0, 45.0));
    child->SetTransformationInheritType(fbxsdk::FbxTransform::eInheritRSrs);
    auto read = readFaithfully<TnFbxNull>(scene);
    EXPECT_NEAR(static_cast<double>(read["child"].getTransformValue(TnFbxTransform::kFbxTransformSkewX)), -0.75, 1e-5);
}

TEST(FaithfulReading, FoldsPreAndPostRotationIntoLocalTransforms) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.addNode("node", scene.addNode("parent"));
    node->SetRotationActive(true);
    node->SetPreRotation(fbxsdk::FbxNode::eSourcePivot, {0.0, 0.0, 90.0});
    node->SetRotationPivot(fbxsdk::FbxNode::eSourcePivot, {1.0, 0.0, 0.0});
    TnFbxReadInfo info;
    const SavedScene saved(scene);
    info = saved.info();
    info.setGlobalTransform(false);
    FacadeRead<TnFbxNull> read(info);
    EXPECT_THAT(rotationOf(read["node"]), isNear({0.0f, 0.0f, 90.0f}));
    EXPECT_THAT(positionOf(read["node"]), isNear({1.0f, -1.0f, 0.0f}));
}

TEST(FaithfulReading, ListsEveryNodeAsATransformAndNoProducerCamera) {
    const FacadeRead<TnFbxCamera> cameras(faithfulRead(fixture("producer_cameras_6100_ascii.fbx")));
    EXPECT_EQ(cameras.count, 0);
    TestScene scene;
    scene.add<fbxsdk::FbxSkeleton>("bone");
    scene.add<fbxsdk::FbxCamera>("camera");
    scene.add<fbxsdk::FbxLight>("light");
    addTriangle(scene, "mesh");
    EXPECT_THAT(readFaithfully<TnFbxTransform>(scene).names(), testing::ElementsAre("bone", "camera", "light", "mesh"));
}

TEST(FaithfulReading, ReadsTheFirstNodeOfAName) {
    TestScene scene;
    scene.addNode("a")->LclTranslation.Set(fbxsdk::FbxDouble3(1.0, 0.0, 0.0));
    scene.addNode("a")->LclTranslation.Set(fbxsdk::FbxDouble3(2.0, 0.0, 0.0));
    const SavedScene saved(scene);
    TnFbxReadInfo info = saved.info();
    info.setAllObjects(false);
    info.setObjectName("a");
    FacadeRead<TnFbxNull> read(info);
    ASSERT_EQ(read.count, 1);
    EXPECT_EQ(read.objects[0].getTransformValue(kX), 1.0f);
    info.setObjectName("b");
    EXPECT_EQ(FacadeRead<TnFbxNull>(info).count, 0);
}

TEST(FaithfulReading, FailsBeyondTheMemoryLimitAndSaysWhatWasNeeded) {
    TestScene scene(0, 100'000);
    scene.key(scene.addNode("mover")->LclTranslation, "X", {{0, 0.0f}, {100'000, 1.0f}});
    const SavedScene saved(scene);
    TnFbxReadInfo info = saved.info();
    setMemoryLimit(1 << 18); // the one channel that changes takes more
    TnFbxNull* nulls = nullptr;
    int count = 0;
    EXPECT_FALSE(Fbx().getNulls(info, &nulls, count));
    setMemoryLimit(0);
    delete[] nulls;
    EXPECT_THAT(lastError(), testing::HasSubstr("391.6 KiB"));
}

TEST(FaithfulReading, FailsForMoreFramesThanAChannelHolds) {
    TestScene scene(0, 20'000'000);
    scene.key(scene.addNode("mover")->LclTranslation, "X", {{0, 0.0f}, {20'000'000, 1.0f}});
    const SavedScene saved(scene);
    TnFbxReadInfo info = saved.info();
    TnFbxNull* nulls = nullptr;
    int count = 0;
    EXPECT_FALSE(Fbx().getNulls(info, &nulls, count));
    delete[] nulls;
    EXPECT_THAT(lastError(), testing::HasSubstr("20000001 frames"));
}

} // namespace
} // namespace Tarnell::Fbx::test
