// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What faithful calls refuse, with the reason, and what they replace, with a warning.
#include "FaithfulFile.h"

#include "FbxFaithful.h"
#include "TnFbxError.h"

#include "support/MemoryLimitScope.h"

#include <filesystem>
#include <limits>
#include <memory>
#include <string>
#include <vector>

namespace Tarnell::Fbx::test {
namespace {

using testing::HasSubstr;
using Transform = TnFbxTransform;

/// The reason for which a read fails.
template <class Object>
std::string reasonOf(TnFbxReadInfo info) {
    Object* objects = nullptr;
    int count = 0;
    EXPECT_FALSE((Fbx().*FacadeReader<Object>::kRead)(info, &objects, count));
    const std::unique_ptr<Object[]> owned(objects); // also after a failure
    return lastError();
}

TEST(FaithfulLimits, OfFilesThatAreNotThereNameTheFile) {
    EXPECT_THAT(reasonOf<Transform>(faithfulRead("there is no such file.fbx")), HasSubstr("there is no such file.fbx"));
    FbxFaithful file;
    EXPECT_FALSE(file.load(faithfulRead("there is no such file.fbx")));
    EXPECT_THAT(lastError(), HasSubstr("there is no such file.fbx"));
    EXPECT_EQ(file.getScene(), nullptr);
    EXPECT_FALSE(file.select(TnFbxReadInfo()));
    EXPECT_THAT(lastError(), HasSubstr("no file is loaded"));
}

TEST(FaithfulLimits, OfMemoryHoldForPoints) {
    TestScene scene;
    std::vector<fbxsdk::FbxVector4> points(20000);
    fillMesh(*scene.add<fbxsdk::FbxMesh>("mesh")->GetMesh(), points, {{0, 1, 2}});
    const SavedScene saved(scene);
    EXPECT_EQ(FacadeRead<TnFbxMesh>(saved.info())["mesh"].getNumberOfControlPoints(), 20000);
    const support::MemoryLimitScope limit(20000 * 3 * sizeof(float) - 1);
    EXPECT_THAT(reasonOf<TnFbxMesh>(saved.info()), HasSubstr("scene.fbx: "));
}

TEST(FaithfulLimits, OfMemoryHoldForFurtherSetsOfPoints) {
    TestScene scene;
    std::vector<fbxsdk::FbxVector4> points(20000);
    fillMesh(*scene.add<fbxsdk::FbxMesh>("mesh")->GetMesh(), points, {{0, 1, 2}});
    const SavedScene saved(scene);
    const support::MemoryLimitScope limit(20000 * 3 * sizeof(float) * 5 / 2); // two sets and a half
    FbxFaithful file;
    TnFbxMesh mesh;
    ASSERT_TRUE(file.load(saved.info()) && file.makeMeshes()) << lastError();
    fbxsdk::FbxNode& node = *file.getScene()->GetRootNode()->GetChild(0);
    ASSERT_TRUE(file.read(node, mesh) && file.readPoints(node, mesh)) << lastError();
    EXPECT_FALSE(file.readPoints(node, mesh));
    EXPECT_THAT(lastError(), HasSubstr("scene.fbx: "));
    EXPECT_EQ(mesh.getNumberOfControlPointSets(), 2);
}

/// A camera whose place and focal length change over 200,001 frames.
struct LongScene : TestScene {
    explicit LongScene(bool place, bool lens) : TestScene(0, 200000) {
        fbxsdk::FbxNode* node = add<fbxsdk::FbxCamera>("camera");
        if (place)
            key(node->LclTranslation, "X", {{0, 0.0f}, {200000, 1.0f}});
        node->GetCamera()->SetApertureMode(fbxsdk::FbxCamera::eFocalLength);
        if (lens)
            key(node->GetCamera()->FocalLength, nullptr, {{0, 10.0f}, {200000, 20.0f}});
    }
};

TEST(FaithfulLimits, OfMemoryHoldForSamples) {
    for (const bool place : {true, false}) {
        LongScene scene(place, !place);
        const SavedScene saved(scene);
        const support::MemoryLimitScope limit(200001 * sizeof(float) - 1);
        EXPECT_THAT(reasonOf<TnFbxCamera>(saved.info()), HasSubstr("scene.fbx: "));
    }
}

TEST(FaithfulLimits, OfFramesHoldForEveryChannel) {
    LongScene scene(/*place*/ false, /*lens*/ true);
    const SavedScene saved(scene);
    TnFbxReadInfo info = saved.info();
    info.setUseSampleFPS(true);
    info.setSampleFPS(2400.0f); // 20,000,001 frames
    EXPECT_THAT(reasonOf<TnFbxCamera>(info), HasSubstr("20000001 frames"));
}

TEST(FaithfulLimits, OfMemoryHoldForKeysOfChannelsThatAreFarApart) {
    FaithfulFile file;
    TnFbxCamera camera;
    camera.setName("camera");
    camera.setValueAt(TnFbxCamera::kFbxCameraFocalLength, timeOf(0, 2), {35.0f, 50.0f});
    camera.setValueAt(TnFbxCamera::kFbxCameraApertureWidth, timeOf(3000000, 2), {1.0f, 2.0f});
    const support::MemoryLimitScope limit(100 * 1024 * 1024); // the lens would have three million keys
    EXPECT_FALSE(Fbx().writeFile(file.info, {&camera}, {}, {}, {}, {}));
    EXPECT_THAT(lastError(), HasSubstr("keys"));
    EXPECT_FALSE(std::filesystem::exists(file.info.getFileName()));
}

TEST(FaithfulLimits, AddPointsToMeshesOfAsManyPointsOnly) {
    TestScene scene;
    addTriangle(scene, "three");
    fillMesh(*scene.add<fbxsdk::FbxMesh>("four")->GetMesh(), std::vector<fbxsdk::FbxVector4>(4), {{0, 1, 2, 3}});
    const SavedScene saved(scene);
    FbxFaithful file;
    TnFbxMesh mesh;
    ASSERT_TRUE(file.load(saved.info()) && file.makeMeshes()) << lastError();
    fbxsdk::FbxNode& root = *file.getScene()->GetRootNode();
    ASSERT_TRUE(file.read(*root.GetChild(0), mesh)) << lastError();
    EXPECT_FALSE(file.readPoints(*root.GetChild(1), mesh));
    EXPECT_THAT(lastError(), HasSubstr("\"four\" has a different number of control points than before"));
    EXPECT_EQ(mesh.getNumberOfControlPointSets(), 1);
}

TEST(FaithfulLimits, OfRatesThatAreNoneAreTwentyFourFramesWithAWarning) {
    for (const float rate :
         {0.0f, -25.0f, std::numeric_limits<float>::infinity(), std::numeric_limits<float>::quiet_NaN()}) {
        FaithfulFile file;
        file.info.setFPS(rate);
        TnFbxNull null;
        null.setName("null");
        null.setTransformValueAt(Transform::kFbxTransformPositionX, timeOf(1, 3), {1.0f, 2.0f, 4.0f});
        file.write({{}, {}, {}, {&null}, {}});
        EXPECT_THAT(file.warningText(), HasSubstr("frames per second is not a valid frame rate")) << rate;
        auto read = file.read<TnFbxNull>();
        const TnFbxTime time = read["null"].getTransformTime(Transform::kFbxTransformPositionX);
        expectRange(time, 1, 3, 24.0f);
        EXPECT_THAT(samplesOf(read["null"], Transform::kFbxTransformPositionX), isNear({1.0f, 2.0f, 4.0f})) << rate;
    }
}

TEST(FaithfulLimits, OfRatesThatAreNoneMakeAReadFail) {
    TestScene scene(0, 4);
    scene.key(scene.addNode("node")->LclTranslation, "X", {{0, 0.0f}, {4, 4.0f}});
    const SavedScene saved(scene);
    TnFbxReadInfo info = saved.info();
    info.setUseSampleFPS(true);
    for (const float rate :
         {0.0f, -25.0f, std::numeric_limits<float>::infinity(), std::numeric_limits<float>::quiet_NaN()}) {
        info.setSampleFPS(rate);
        EXPECT_THAT(reasonOf<Transform>(info), HasSubstr("frames per second is not valid")) << rate;
    }
}

TEST(FaithfulLimits, OfStacksWithoutASpanAreThoseOfTheirKeys) {
    TestScene scene(5, 5);
    scene.key(scene.addNode("node")->LclTranslation, "X", {{2, 0.0f}, {6, 4.0f}});
    const SavedScene saved(scene);
    FbxFaithful file;
    ASSERT_TRUE(file.load(saved.info())) << lastError();
    EXPECT_EQ(file.getFrameRate(), 24.0);
    EXPECT_EQ(file.getFirstFrame(), 2);
    EXPECT_EQ(file.getLastFrame(), 6);
}

TEST(FaithfulLimits, OfSurfacesWithoutPointsAreWarnedOf) {
    TestScene scene;
    scene.add<fbxsdk::FbxNurbsSurface>("surface");
    addTriangle(scene, "mesh");
    EXPECT_EQ(readFaithfully<TnFbxMesh>(scene).names(), std::vector<std::string>{"mesh"});
    EXPECT_THAT(lastWarnings(),
                testing::ElementsAre(HasSubstr("the surface of \"surface\" cannot be converted to a mesh")));
}

} // namespace
} // namespace Tarnell::Fbx::test
