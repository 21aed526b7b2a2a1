// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Blend shapes: which targets are used at a percentage, and their effect on points.
#include "sdk/BlendShapeWeights.h"

#include "DeformationScenes.h"

namespace Tarnell::Fbx {
namespace {

using namespace test;

TEST(ShapeTargets, AreSelectedBetweenTheFullWeights) {
    const double weights[] = {30.0, 80.0, 100.0};
    const auto target = [&weights](int step, double weight) { return detail::targetOfStep(step, weight, weights, 3); };

    for (int step = 0; step < 3; ++step) {
        EXPECT_EQ(target(step, 10.0), 0) << "every step selects the first target below the first full weight";
        EXPECT_EQ(target(step, 0.0), std::nullopt);
        EXPECT_EQ(target(step, -1.0), std::nullopt);
        EXPECT_EQ(target(step, 30.0), std::nullopt);
        EXPECT_EQ(target(step, 80.0), std::nullopt);
        EXPECT_EQ(target(step, 100.0), std::nullopt);
        EXPECT_EQ(target(step, 150.0), std::nullopt);
        EXPECT_EQ(target(step, std::numeric_limits<double>::quiet_NaN()), std::nullopt);
    }
    EXPECT_EQ(target(0, 50.0), 1);
    EXPECT_EQ(target(1, 50.0), std::nullopt);
    EXPECT_EQ(target(1, 90.0), 2);
    EXPECT_EQ(target(2, 90.0), std::nullopt);
}

TEST(ShapeTargets, PreferTheStepsOwnWhenFullWeightsAreOutOfOrder) {
    const double weights[] = {90.0, 20.0, 60.0};

    EXPECT_EQ(detail::targetOfStep(0, 50.0, weights, 3), 0);
    EXPECT_EQ(detail::targetOfStep(1, 50.0, weights, 3), 2);
}

/// A mesh of one point with blend shapes.
struct ShapeScene : TestScene {
    ShapeScene() : TestScene(0, 10) {
        node = addPoints(*this, 2);
        deformer = fbxsdk::FbxBlendShape::Create(scene, "shapes");
        node->GetMesh()->AddDeformer(deformer);
    }

    fbxsdk::FbxBlendShapeChannel* addChannel() {
        auto* channel = fbxsdk::FbxBlendShapeChannel::Create(scene, "channel");
        deformer->AddBlendShapeChannel(channel);
        return channel;
    }

    /// A target that moves every point by an offset along Y.
    fbxsdk::FbxShape* addTarget(fbxsdk::FbxBlendShapeChannel* channel, double offset, double fullWeight = 100.0,
                                int pointCount = 2) {
        auto* shape = fbxsdk::FbxShape::Create(scene, "shape");
        shape->InitControlPoints(pointCount);
        for (int i = 0; i < pointCount; ++i)
            shape->SetControlPointAt(FbxVector4(static_cast<double>(i), offset, 0.0), i);
        channel->AddTargetShape(shape, fullWeight);
        return shape;
    }

    void setWeight(fbxsdk::FbxBlendShapeChannel* channel, float weight, fbxsdk::FbxAnimLayer* on = nullptr) {
        key(channel->DeformPercent, nullptr, {{0, weight}}, on);
    }

    fbxsdk::FbxNode* node;
    fbxsdk::FbxBlendShape* deformer;
};

TEST(BlendShapes, MultiplyTheWholeDifferenceByThePercentage) {
    ShapeScene scene;
    fbxsdk::FbxBlendShapeChannel* channel = scene.addChannel();
    scene.addTarget(channel, 2.0);
    scene.setWeight(channel, 50.0f);

    const Points points = deformed(scene, scene.node);

    EXPECT_TRUE(scene.sdk.getDeformation(scene.node->GetMesh()));
    expectPoint(points[0], 0.0, 100.0, 0.0);
    expectPoint(points[1], 1.0, 100.0, 0.0);
}

TEST(BlendShapes, DoNothingAtTheFullWeight) {
    ShapeScene scene;
    fbxsdk::FbxBlendShapeChannel* channel = scene.addChannel();
    scene.addTarget(channel, 2.0);
    scene.setWeight(channel, 100.0f);

    expectPoint(deformed(scene, scene.node)[0], 0.0, 0.0, 0.0);
}

TEST(BlendShapes, FollowTheCurveThroughTime) {
    ShapeScene scene;
    fbxsdk::FbxBlendShapeChannel* channel = scene.addChannel();
    scene.addTarget(channel, 1.0);
    scene.key(channel->DeformPercent, nullptr, {{0, 10.0f}, {10, 60.0f}});

    expectPoint(deformed(scene, scene.node, 2)[0], 0.0, 20.0, 0.0);
}

TEST(BlendShapes, DoNothingForAPercentageThatIsNotAnimated) {
    ShapeScene scene;
    fbxsdk::FbxBlendShapeChannel* channel = scene.addChannel();
    scene.addTarget(channel, 1.0);
    channel->DeformPercent.Set(50.0);

    EXPECT_TRUE(scene.sdk.getDeformation(scene.node->GetMesh()));
    expectPoint(deformed(scene, scene.node)[0], 0.0, 0.0, 0.0);
}

TEST(BlendShapes, ApplyTheFirstTargetOncePerTargetBelowTheFirstFullWeight) {
    ShapeScene scene;
    fbxsdk::FbxBlendShapeChannel* channel = scene.addChannel();
    scene.addTarget(channel, 1.0, 30.0);
    scene.addTarget(channel, 5.0, 80.0);
    scene.addTarget(channel, 7.0, 100.0);
    scene.setWeight(channel, 10.0f);

    expectPoint(deformed(scene, scene.node)[0], 0.0, 30.0, 0.0); // three times 10 × 1
}

TEST(BlendShapes, ApplyTheTargetAboveTheFullWeightAlone) {
    ShapeScene scene;
    fbxsdk::FbxBlendShapeChannel* channel = scene.addChannel();
    scene.addTarget(channel, 1.0, 30.0);
    scene.addTarget(channel, 5.0, 80.0);
    scene.addTarget(channel, 7.0, 100.0);
    scene.setWeight(channel, 90.0f);

    expectPoint(deformed(scene, scene.node)[0], 0.0, 630.0, 0.0); // 90 × 7
}

TEST(BlendShapes, AddUpOverChannelsAndLayersFromTheSameBase) {
    ShapeScene scene;
    fbxsdk::FbxAnimLayer* second = scene.addLayer();
    fbxsdk::FbxBlendShapeChannel* first = scene.addChannel();
    scene.addTarget(first, 1.0);
    scene.setWeight(first, 10.0f);
    scene.setWeight(first, 20.0f, second);
    fbxsdk::FbxBlendShapeChannel* other = scene.addChannel();
    scene.addTarget(other, 2.0);
    scene.setWeight(other, 30.0f);

    expectPoint(deformed(scene, scene.node)[0], 0.0, 10.0 + 20.0 + 60.0, 0.0);
}

TEST(BlendShapes, WithoutTargetsOrWithTooFewPointsChangeWhatTheyCan) {
    ShapeScene scene;
    fbxsdk::FbxBlendShapeChannel* empty = scene.addChannel();
    scene.setWeight(empty, 50.0f);
    fbxsdk::FbxBlendShapeChannel* small = scene.addChannel();
    scene.addTarget(small, 1.0, 100.0, /*pointCount*/ 1);
    scene.setWeight(small, 50.0f);
    fbxsdk::FbxBlendShapeChannel* large = scene.addChannel();
    scene.addTarget(large, 1.0, 100.0, /*pointCount*/ 20);
    scene.setWeight(large, 1.0f);

    const Points points = deformed(scene, scene.node);

    expectPoint(points[0], 0.0, 51.0, 0.0);
    expectPoint(points[1], 1.0, 1.0, 0.0);
}

TEST(BlendShapes, ComeBeforeTheSkin) {
    ShapeScene scene;
    fbxsdk::FbxBlendShapeChannel* channel = scene.addChannel();
    scene.addTarget(channel, 0.5);
    scene.setWeight(channel, 2.0f);
    FbxCluster* cluster = addCluster(scene, addSkin(scene, scene.node), {10.0, 0.0, 0.0});
    cluster->GetLink()->LclScaling.Set({3.0, 3.0, 3.0});
    cluster->AddControlPointIndex(0, 1.0);

    expectPoint(deformed(scene, scene.node)[0], 10.0, 3.0, 0.0);
}

TEST(BlendShapes, OfAMeshAreThoseOfTheFrameInSinglePrecision) {
    ShapeScene scene;
    fbxsdk::FbxBlendShapeChannel* channel = scene.addChannel();
    scene.addTarget(channel, 1.0);
    fbxsdk::FbxAnimCurve* curve =
        scene.key(channel->DeformPercent, nullptr, {{0, 5.0f}, {10, 20.0f}, {12, 30.0f}, {14, 40.0f}});
    for (int key = 0; key < 4; ++key)
        curve->KeySetInterpolation(key, fbxsdk::FbxAnimCurveDef::eInterpolationConstant);
    const auto heightAt = [&scene](float frame) {
        TnFbxReadInfo info = readAll();
        info.setTransformPoints(false);
        info.setFrame(frame);
        TnFbxMesh mesh;
        EXPECT_TRUE(scene.sdk.getMeshes(info, &mesh, 1));
        float x = 0.0f, y = 0.0f, z = 0.0f;
        EXPECT_TRUE(mesh.getControlPoint(0, x, y, z));
        return y;
    };

    EXPECT_EQ(heightAt(9.0f), 5.0f);
    EXPECT_EQ(heightAt(10.0f), 5.0f) << "10/24 s is less in single precision, and the key not yet reached";
    EXPECT_EQ(heightAt(12.0f), 30.0f) << "12/24 s is exact";
}

} // namespace
} // namespace Tarnell::Fbx
