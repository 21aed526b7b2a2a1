// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deformed points: skins in their three modes, blend shapes, vertex caches, and which of them wins.
#include "sdk/BlendShapeWeights.h"

#include "support/SceneBuilders.h"
#include "support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <limits>
#include <memory>
#include <string>

namespace Tarnell::Fbx {
namespace {

using fbxsdk::FbxAMatrix;
using fbxsdk::FbxCache;
using fbxsdk::FbxCluster;
using fbxsdk::FbxVector4;
using test::TestScene;
using Points = std::vector<FbxVector4>;

FbxAMatrix translation(double x, double y, double z) {
    FbxAMatrix matrix;
    matrix.SetT(FbxVector4(x, y, z));
    return matrix;
}

/// A mesh of single points along X, (0,0,0), (1,0,0), …
fbxsdk::FbxNode* addPoints(TestScene& scene, int count) {
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxMesh>("mesh");
    Points points;
    for (int i = 0; i < count; ++i) {
        points.emplace_back(static_cast<double>(i), 0.0, 0.0);
    }
    test::fillMesh(*node->GetMesh(), points, {{0, 0, 0}});
    return node;
}

/// The deformed points of a node's mesh at a frame; empty when there are none.
Points deformed(TestScene& scene, fbxsdk::FbxNode* node, int frame = 0, FbxAMatrix globalPosition = {}) {
    fbxsdk::FbxTime time = test::timeOfFrame(frame);
    FbxVector4* made = nullptr;
    scene.sdk.getDeformedControlPoints(node, node->GetMesh(), time, globalPosition, &made);
    const std::unique_ptr<FbxVector4[]> owned(made);
    return made != nullptr ? Points(made, made + node->GetMesh()->GetControlPointsCount()) : Points();
}

fbxsdk::FbxSkin* addSkin(TestScene& scene, fbxsdk::FbxNode* node) {
    fbxsdk::FbxSkin* skin = fbxsdk::FbxSkin::Create(scene.scene, "skin");
    node->GetMesh()->AddDeformer(skin);
    return skin;
}

/// A cluster on a new bone, which was at the origin when it was bound.
FbxCluster* addCluster(TestScene& scene, fbxsdk::FbxSkin* skin, const FbxVector4& bonePosition,
                       FbxCluster::ELinkMode mode = FbxCluster::eNormalize) {
    fbxsdk::FbxNode* bone = scene.addNode("bone");
    bone->LclTranslation.Set({bonePosition[0], bonePosition[1], bonePosition[2]});
    FbxCluster* cluster = FbxCluster::Create(scene.scene, "cluster");
    cluster->SetLink(bone);
    cluster->SetLinkMode(mode);
    skin->AddCluster(cluster);
    return cluster;
}

void expectPoint(const FbxVector4& point, double x, double y, double z) {
    EXPECT_DOUBLE_EQ(point[0], x);
    EXPECT_DOUBLE_EQ(point[1], y);
    EXPECT_DOUBLE_EQ(point[2], z);
}

// ---- Matrices ----

TEST(MatrixElements, AreScaledAddedToAndAdded) {
    FbxSdk sdk;
    FbxAMatrix matrix = translation(1.0, 2.0, 3.0);
    FbxAMatrix other = translation(10.0, 20.0, 30.0);

    sdk.matrixScale(matrix, 2.0);
    EXPECT_EQ(matrix.Get(0, 0), 2.0);
    EXPECT_EQ(matrix.Get(3, 2), 6.0);
    EXPECT_EQ(matrix.Get(3, 3), 2.0);
    sdk.matrixAddToDiagonal(matrix, 0.5);
    EXPECT_EQ(matrix.Get(3, 3), 2.5);
    EXPECT_EQ(matrix.Get(3, 2), 6.0);
    EXPECT_EQ(matrix.Get(0, 1), 0.0);
    sdk.matrixAdd(matrix, other);
    EXPECT_EQ(matrix.Get(3, 0), 12.0);
    EXPECT_EQ(matrix.Get(1, 1), 3.5);
}

// ---- Whether there is anything to do ----

TEST(Deformation, IsNoneForNullAndForAPlainMesh) {
    TestScene scene;

    EXPECT_FALSE(scene.sdk.getDeformation(nullptr));
    EXPECT_FALSE(scene.sdk.getDeformation(addPoints(scene, 1)->GetMesh()));
}

TEST(Deformation, OfASkinWithoutClustersIsNone) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    fbxsdk::FbxSkin* skin = addSkin(scene, node);
    EXPECT_FALSE(scene.sdk.getDeformation(node->GetMesh()));

    addCluster(scene, skin, {});
    EXPECT_TRUE(scene.sdk.getDeformation(node->GetMesh()));
}

TEST(DeformedPoints, OfAPlainMeshAreACopy) {
    TestScene scene;
    const Points points = deformed(scene, addPoints(scene, 2));

    ASSERT_EQ(points.size(), 2u);
    EXPECT_EQ(points[1], FbxVector4(1.0, 0.0, 0.0));
}

TEST(DeformedPoints, ReplaceAndFreeTheArrayThatWasThere) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 2);
    fbxsdk::FbxTime time;
    FbxAMatrix identity;
    auto* points = new FbxVector4[50];

    scene.sdk.getDeformedControlPoints(node, node->GetMesh(), time, identity, &points);

    EXPECT_EQ(points[1], FbxVector4(1.0, 0.0, 0.0));
    delete[] points;
}

TEST(DeformedPoints, AreNotTouchedWithoutANodeAMeshAPlaceOrPoints) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    fbxsdk::FbxNode* empty = scene.add<fbxsdk::FbxMesh>("empty");
    fbxsdk::FbxTime time;
    FbxAMatrix identity;
    FbxVector4 here[1];
    FbxVector4* points = here;

    scene.sdk.getDeformedControlPoints(nullptr, node->GetMesh(), time, identity, &points);
    scene.sdk.getDeformedControlPoints(node, nullptr, time, identity, &points);
    scene.sdk.getDeformedControlPoints(node, node->GetMesh(), time, identity, nullptr);
    scene.sdk.getDeformedControlPoints(empty, empty->GetMesh(), time, identity, &points);

    EXPECT_EQ(points, here);
}

TEST(DeformedPoints, OfNullArgumentsOfTheStepsAreLeftAlone) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    fbxsdk::FbxTime time;
    FbxAMatrix identity;
    FbxVector4 point(5.0, 6.0, 7.0);

    scene.sdk.readVertexCacheData(nullptr, time, &point);
    scene.sdk.readVertexCacheData(node->GetMesh(), time, nullptr);
    scene.sdk.computeShapeDeformation(node, nullptr, time, &point);
    scene.sdk.computeShapeDeformation(node, node->GetMesh(), time, nullptr);
    scene.sdk.computeClusterDeformation(identity, nullptr, time, &point);
    scene.sdk.computeClusterDeformation(identity, node->GetMesh(), time, nullptr);

    EXPECT_EQ(point, FbxVector4(5.0, 6.0, 7.0));
}

// ---- Skins ----

TEST(Skin, MovesPointsWithTheirBone) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = addPoints(scene, 2);
    FbxCluster* cluster = addCluster(scene, addSkin(scene, node), {0.0, 5.0, 0.0});
    cluster->AddControlPointIndex(0, 1.0);

    const Points points = deformed(scene, node);

    expectPoint(points[0], 0.0, 5.0, 0.0);
    expectPoint(points[1], 1.0, 0.0, 0.0);
}

TEST(Skin, FollowsTheBoneThroughTime) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    FbxCluster* cluster = addCluster(scene, addSkin(scene, node), {});
    cluster->AddControlPointIndex(0, 1.0);
    scene.key(cluster->GetLink()->LclTranslation, "Z", {{0, 0.0f}, {10, 10.0f}});

    expectPoint(deformed(scene, node, 0)[0], 0.0, 0.0, 0.0);
    expectPoint(deformed(scene, node, 4)[0], 0.0, 0.0, 4.0);
}

TEST(Skin, CountsFromThePlaceOfTheBoneAtBinding) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 2);
    FbxCluster* cluster = addCluster(scene, addSkin(scene, node), {3.0, 0.0, 0.0});
    cluster->GetLink()->LclRotation.Set({0.0, 0.0, 90.0});
    cluster->SetTransformLinkMatrix(translation(1.0, 0.0, 0.0));
    cluster->AddControlPointIndex(0, 1.0);
    cluster->AddControlPointIndex(1, 1.0);

    const Points points = deformed(scene, node);

    EXPECT_NEAR(points[0][0], 3.0, 1e-12); // (−1, 0) from the bone, turned to (0, −1)
    EXPECT_NEAR(points[0][1], -1.0, 1e-12);
    expectPoint(points[1], 3.0, 0.0, 0.0);
}

TEST(Skin, TakesThePlaceOfTheMeshIntoAccount) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    FbxCluster* cluster = addCluster(scene, addSkin(scene, node), {0.0, 5.0, 0.0});
    cluster->SetTransformMatrix(translation(10.0, 0.0, 0.0));
    cluster->AddControlPointIndex(0, 1.0);

    // at binding the mesh was at x = 10, now it is at x = 4: its own space keeps the point 6 further on
    expectPoint(deformed(scene, node, 0, translation(4.0, 0.0, 0.0))[0], 6.0, 5.0, 0.0);
}

TEST(Skin, MultipliesTheGeometricOffsetOfTheMeshIntoItsPlaceAtBinding) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    node->SetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot, FbxVector4(0.0, 0.0, 2.0));
    FbxCluster* cluster = addCluster(scene, addSkin(scene, node), {});
    cluster->AddControlPointIndex(0, 1.0);

    expectPoint(deformed(scene, node)[0], 0.0, 0.0, 2.0);
}

TEST(SkinNormalize, AveragesTwoBonesOfEqualWeight) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    fbxsdk::FbxSkin* skin = addSkin(scene, node);
    addCluster(scene, skin, {4.0, 0.0, 0.0})->AddControlPointIndex(0, 0.5);
    addCluster(scene, skin, {0.0, 8.0, 0.0})->AddControlPointIndex(0, 0.5);

    expectPoint(deformed(scene, node)[0], 2.0, 4.0, 0.0);
}

TEST(SkinNormalize, DividesByTheSumOfTheWeights) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    fbxsdk::FbxSkin* skin = addSkin(scene, node);
    addCluster(scene, skin, {4.0, 0.0, 0.0})->AddControlPointIndex(0, 0.25);
    addCluster(scene, skin, {0.0, 8.0, 0.0})->AddControlPointIndex(0, 0.25);

    expectPoint(deformed(scene, node)[0], 2.0, 4.0, 0.0);
}

TEST(SkinTotalOne, KeepsTheRestOfTheWeightUndeformed) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 2);
    FbxCluster* cluster = addCluster(scene, addSkin(scene, node), {0.0, 8.0, 0.0}, FbxCluster::eTotalOne);
    cluster->AddControlPointIndex(1, 0.25);

    expectPoint(deformed(scene, node)[1], 1.0, 2.0, 0.0); // 0.25·(1, 8) + 0.75·(1, 0)
}

TEST(SkinAdditive, AppliesOneClusterAfterTheOther) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    fbxsdk::FbxSkin* skin = addSkin(scene, node);
    addCluster(scene, skin, {4.0, 0.0, 0.0}, FbxCluster::eAdditive)->AddControlPointIndex(0, 1.0);
    addCluster(scene, skin, {0.0, 8.0, 0.0}, FbxCluster::eAdditive)->AddControlPointIndex(0, 0.5);

    expectPoint(deformed(scene, node)[0], 4.0, 4.0, 0.0);
}

TEST(SkinAdditive, IsRelativeToItsAssociateModel) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    FbxCluster* cluster = addCluster(scene, addSkin(scene, node), {4.0, 0.0, 0.0}, FbxCluster::eAdditive);
    fbxsdk::FbxNode* associate = scene.addNode("associate");
    associate->LclTranslation.Set({1.0, 0.0, 0.0});
    associate->SetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot, FbxVector4(0.0, 0.0, 2.0));
    cluster->SetAssociateModel(associate);
    cluster->SetTransformAssociateModelMatrix(translation(0.0, 3.0, 0.0));
    cluster->SetTransformMatrix(translation(100.0, 100.0, 100.0)); // not used
    cluster->AddControlPointIndex(0, 1.0);

    // inverse(inverse(link) × associate × offset) × associate at binding
    expectPoint(deformed(scene, node)[0], 3.0, 3.0, -2.0);
}

TEST(SkinNormalize, IgnoresTheAssociateModel) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    FbxCluster* cluster = addCluster(scene, addSkin(scene, node), {4.0, 0.0, 0.0});
    fbxsdk::FbxNode* associate = scene.addNode("associate");
    associate->LclTranslation.Set({1.0, 0.0, 0.0});
    cluster->SetAssociateModel(associate);
    cluster->AddControlPointIndex(0, 1.0);

    expectPoint(deformed(scene, node)[0], 4.0, 0.0, 0.0);
}

TEST(Skin, TakesTheModeOfItsFirstClusterForAll) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    fbxsdk::FbxSkin* skin = addSkin(scene, node);
    addCluster(scene, skin, {4.0, 0.0, 0.0}, FbxCluster::eTotalOne)->AddControlPointIndex(0, 0.25);
    addCluster(scene, skin, {0.0, 8.0, 0.0}, FbxCluster::eAdditive)->AddControlPointIndex(0, 0.25);

    expectPoint(deformed(scene, node)[0], 1.0, 2.0, 0.0);
}

TEST(Skin, WhoseFirstClusterIsMissingIsNormalised) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    addSkin(scene, node); // empty
    addCluster(scene, addSkin(scene, node), {4.0, 0.0, 0.0}, FbxCluster::eTotalOne)->AddControlPointIndex(0, 0.25);

    expectPoint(deformed(scene, node)[0], 4.0, 0.0, 0.0);
}

TEST(Skin, AddsUpOverSeveralSkins) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    addCluster(scene, addSkin(scene, node), {4.0, 0.0, 0.0})->AddControlPointIndex(0, 0.5);
    addCluster(scene, addSkin(scene, node), {0.0, 8.0, 0.0})->AddControlPointIndex(0, 0.5);

    expectPoint(deformed(scene, node)[0], 2.0, 4.0, 0.0);
}

TEST(Skin, PassesOverClustersWithoutALink) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    fbxsdk::FbxSkin* skin = addSkin(scene, node);
    FbxCluster* loose = FbxCluster::Create(scene.scene, "loose");
    loose->AddControlPointIndex(0, 1.0);
    skin->AddCluster(loose);

    expectPoint(deformed(scene, node)[0], 0.0, 0.0, 0.0);
    EXPECT_TRUE(scene.sdk.getDeformation(node->GetMesh()));
}

TEST(Skin, IgnoresTinyWeights) {
    for (const auto mode : {FbxCluster::eNormalize, FbxCluster::eTotalOne, FbxCluster::eAdditive}) {
        SCOPED_TRACE(mode);
        TestScene scene;
        fbxsdk::FbxNode* node = addPoints(scene, 3);
        fbxsdk::FbxSkin* skin = addSkin(scene, node);
        FbxCluster* near = addCluster(scene, skin, {4.0, 0.0, 0.0}, mode);
        FbxCluster* far = addCluster(scene, skin, {1e6, 0.0, 0.0}, mode); // a millionth of it is a whole unit
        near->AddControlPointIndex(0, 1.0);
        far->AddControlPointIndex(0, 0.000001);
        near->AddControlPointIndex(1, 1.0);
        far->AddControlPointIndex(1, -0.000001);
        far->AddControlPointIndex(2, 0.000001);

        const Points points = deformed(scene, node);

        EXPECT_EQ(points[0], FbxVector4(4.0, 0.0, 0.0));
        EXPECT_EQ(points[1], FbxVector4(5.0, 0.0, 0.0));
        EXPECT_EQ(points[2], FbxVector4(2.0, 0.0, 0.0));
    }
}

TEST(Skin, AccumulatesAWeightAtTheThresholdThoughATotalThereDeformsNothing) {
    const auto threshold = static_cast<double>(1e-5f);
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 2);
    fbxsdk::FbxSkin* skin = addSkin(scene, node);
    FbxCluster* cluster = addCluster(scene, skin, {4.0, 0.0, 0.0});
    cluster->AddControlPointIndex(0, threshold); // the total is the threshold: left alone
    cluster->AddControlPointIndex(1, threshold); // two of them: deformed
    cluster->AddControlPointIndex(1, threshold);

    const Points points = deformed(scene, node);

    expectPoint(points[0], 0.0, 0.0, 0.0);
    EXPECT_NEAR(points[1][0], 5.0, 1e-12);
}

TEST(Skin, TakesNegativeWeightsAsTheyAre) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    fbxsdk::FbxSkin* skin = addSkin(scene, node);
    addCluster(scene, skin, {4.0, 0.0, 0.0}, FbxCluster::eTotalOne)->AddControlPointIndex(0, 1.5);
    addCluster(scene, skin, {2.0, 0.0, 0.0}, FbxCluster::eTotalOne)->AddControlPointIndex(0, -0.5);

    expectPoint(deformed(scene, node)[0], 5.0, 0.0, 0.0);
}

TEST(Skin, PassesOverIndicesThatNameNoPoint) {
    constexpr int kHighest = std::numeric_limits<int>::max();
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    FbxCluster* cluster = addCluster(scene, addSkin(scene, node), {4.0, 0.0, 0.0});
    for (const int index : {1, -1, kHighest, -kHighest - 1}) {
        cluster->AddControlPointIndex(index, 1.0);
    }
    cluster->AddControlPointIndex(0, 1.0);

    expectPoint(deformed(scene, node)[0], 4.0, 0.0, 0.0);
}

TEST(Skin, SurvivesWeightsThatAreNoNumbers) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    FbxCluster* cluster = addCluster(scene, addSkin(scene, node), {4.0, 0.0, 0.0});
    cluster->AddControlPointIndex(0, std::numeric_limits<double>::quiet_NaN());

    expectPoint(deformed(scene, node)[0], 0.0, 0.0, 0.0); // a total that is no number is not above the threshold
}

// ---- Blend shapes ----

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
        for (int i = 0; i < pointCount; ++i) {
            shape->SetControlPointAt(FbxVector4(static_cast<double>(i), offset, 0.0), i);
        }
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

// ---- Vertex caches ----

/// A mesh of two points with a cache file beside it that moves them along Z by the frame number.
struct CacheScene : TestScene {
    explicit CacheScene(FbxCache::EFileFormat format, bool active = true) : TestScene(0, 10) {
        scene->GetGlobalSettings().SetTimeMode(fbxsdk::FbxTime::eFrames24);
        fbxsdk::FbxTime::SetGlobalTimeMode(fbxsdk::FbxTime::eFrames24);
        node = addPoints(*this, 2);
        deformer = fbxsdk::FbxVertexCacheDeformer::Create(scene, "deformer");
        cache = FbxCache::Create(scene, "cache");
        const bool maya = format == FbxCache::eMayaCache;
        const std::string file = folder.file(maya ? "points.xml" : "points.pc2");
        cache->SetCacheFileFormat(format);
        cache->SetCacheFileName("", file.c_str());
        deformer->SetCache(cache);
        deformer->Channel.Set(fbxsdk::FbxString("ball"));
        deformer->Active.Set(active);
        node->GetMesh()->AddDeformer(deformer);
        maya ? writeMaya() : writeMax();
    }

    void writeMaya() {
        ASSERT_TRUE(cache->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "ball", FbxCache::eMCC));
        for (int frame = 1; frame <= 3; ++frame) {
            std::vector<double> buffer = pointsAt(frame);
            fbxsdk::FbxTime time = test::timeOfFrame(frame);
            cache->BeginWriteAt(time);
            ASSERT_TRUE(cache->Write(0, time, buffer.data(), 2));
            cache->EndWriteAt();
        }
        ASSERT_TRUE(cache->CloseFile());
    }

    void writeMax() {
        ASSERT_TRUE(cache->OpenFileForWrite(1.0, 24.0, 3u, 2u));
        for (unsigned int frame = 1; frame <= 3; ++frame) {
            std::vector<double> buffer = pointsAt(static_cast<int>(frame));
            ASSERT_TRUE(cache->Write(frame, buffer.data()));
        }
        ASSERT_TRUE(cache->CloseFile());
    }

    static std::vector<double> pointsAt(int frame) {
        const auto z = static_cast<double>(frame);
        return {10.0, 0.0, z, 20.0, 0.0, z};
    }

    support::TemporaryFolder folder;
    fbxsdk::FbxNode* node;
    fbxsdk::FbxVertexCacheDeformer* deformer;
    FbxCache* cache;
};

class VertexCache : public testing::TestWithParam<FbxCache::EFileFormat> {};
INSTANTIATE_TEST_SUITE_P(BothFormats, VertexCache, testing::Values(FbxCache::eMayaCache, FbxCache::eMaxPointCacheV2));

TEST_P(VertexCache, GivesThePointsOfTheFrameWhateverRateThisThreadCountsAt) {
    CacheScene scene(GetParam());
    ASSERT_TRUE(scene.sdk.openClosePointCacheData(scene.scene, true));
    fbxsdk::FbxTime::SetGlobalTimeMode(fbxsdk::FbxTime::eFrames60);

    const Points points = deformed(scene, scene.node, 2);

    EXPECT_EQ(points[0][2], 2.0);
    scene.sdk.openClosePointCacheData(scene.scene, false);
}

TEST_P(VertexCache, GivesThePointsOfTheFrame) {
    CacheScene scene(GetParam());
    EXPECT_TRUE(scene.sdk.getDeformation(scene.node->GetMesh()));
    EXPECT_TRUE(scene.sdk.openClosePointCacheData(scene.scene, true));
    EXPECT_TRUE(scene.cache->IsOpen());

    const Points points = deformed(scene, scene.node, 2);

    expectPoint(points[0], 10.0, 0.0, 2.0);
    expectPoint(points[1], 20.0, 0.0, 2.0);
    EXPECT_EQ(points[0][3], 1.0);
    EXPECT_TRUE(scene.sdk.openClosePointCacheData(scene.scene, false));
    EXPECT_FALSE(scene.cache->IsOpen());
}

TEST_P(VertexCache, IsReadThroughTheListOfMeshes) {
    CacheScene scene(GetParam());
    TnFbxReadInfo info = test::readAll();
    info.setTransformPoints(false);
    info.setFrame(3.0f);
    TnFbxMesh mesh;

    EXPECT_TRUE(scene.sdk.getMeshes(info, &mesh, 1));

    float x = 0.0f, y = 0.0f, z = 0.0f;
    EXPECT_TRUE(mesh.getControlPoint(1, x, y, z));
    EXPECT_EQ(x, 20.0f);
    EXPECT_EQ(z, 3.0f);
    EXPECT_FALSE(scene.cache->IsOpen());
}

/// Moves every point by 100 along Y: half of the difference to a target, in percent.
void addShape(TestScene& scene, fbxsdk::FbxNode& node) {
    fbxsdk::FbxGeometry& mesh = *node.GetGeometry();
    auto* deformer = fbxsdk::FbxBlendShape::Create(scene.scene, "shapes");
    auto* channel = fbxsdk::FbxBlendShapeChannel::Create(scene.scene, "channel");
    auto* target = fbxsdk::FbxShape::Create(scene.scene, "target");
    target->InitControlPoints(mesh.GetControlPointsCount());
    for (int i = 0; i < mesh.GetControlPointsCount(); ++i) {
        target->SetControlPointAt(mesh.GetControlPointAt(i) + FbxVector4(0.0, 2.0, 0.0), i);
    }
    mesh.AddDeformer(deformer);
    deformer->AddBlendShapeChannel(channel);
    channel->AddTargetShape(target, 100.0);
    scene.key(channel->DeformPercent, nullptr, {{0, 50.0f}});
}

TEST_P(VertexCache, ReplacesShapesAndSkin) {
    CacheScene scene(GetParam());
    addShape(scene, *scene.node);
    addCluster(scene, addSkin(scene, scene.node), {0.0, 100.0, 0.0})->AddControlPointIndex(0, 1.0);
    scene.sdk.openClosePointCacheData(scene.scene, true);

    expectPoint(deformed(scene, scene.node, 1)[0], 10.0, 0.0, 1.0);
    scene.sdk.openClosePointCacheData(scene.scene, false);
}

TEST_P(VertexCache, SwitchedOffLeavesTheSkin) {
    CacheScene scene(GetParam(), /*active*/ false);
    EXPECT_FALSE(scene.sdk.getDeformation(scene.node->GetMesh()));
    addCluster(scene, addSkin(scene, scene.node), {0.0, 100.0, 0.0})->AddControlPointIndex(0, 1.0);
    scene.sdk.openClosePointCacheData(scene.scene, true);

    EXPECT_FALSE(scene.cache->IsOpen());
    expectPoint(deformed(scene, scene.node, 1)[0], 0.0, 100.0, 0.0);
}

TEST_P(VertexCache, ThatDoesNotOpenIsSwitchedOff) {
    CacheScene scene(GetParam());
    scene.cache->SetCacheFileName("", "there is no such file");
    addCluster(scene, addSkin(scene, scene.node), {0.0, 100.0, 0.0})->AddControlPointIndex(0, 1.0);

    EXPECT_TRUE(scene.sdk.openClosePointCacheData(scene.scene, true));

    EXPECT_FALSE(scene.deformer->Active.Get());
    expectPoint(deformed(scene, scene.node, 1)[0], 0.0, 100.0, 0.0);
}

TEST_P(VertexCache, ThatDoesNotOpenLeavesShapesAndSkin) {
    CacheScene scene(GetParam());
    scene.cache->SetCacheFileName("", "there is no such file");
    addShape(scene, *scene.node);
    addCluster(scene, addSkin(scene, scene.node), {5.0, 0.0, 0.0})->AddControlPointIndex(0, 1.0);
    scene.sdk.openClosePointCacheData(scene.scene, true);

    const Points points = deformed(scene, scene.node, 1);

    expectPoint(points[0], 5.0, 100.0, 0.0);
    expectPoint(points[1], 1.0, 100.0, 0.0);
}

TEST_P(VertexCache, OfAnInstanceStaysOpenForBothNodes) {
    CacheScene scene(GetParam());
    scene.addNode("instance")->SetNodeAttribute(scene.node->GetMesh());

    EXPECT_TRUE(scene.sdk.openClosePointCacheData(scene.scene, true));

    EXPECT_TRUE(scene.deformer->Active.Get());
    EXPECT_TRUE(scene.cache->IsOpen());
    scene.sdk.openClosePointCacheData(scene.scene, false);
    EXPECT_FALSE(scene.cache->IsOpen());
}

TEST_P(VertexCache, ThatIsNotOpenLeavesThePointsAlone) {
    CacheScene scene(GetParam());

    expectPoint(deformed(scene, scene.node, 1)[1], 1.0, 0.0, 0.0);
}

TEST_P(VertexCache, WithAnotherNumberOfPointsLeavesThePointsAlone) {
    CacheScene scene(GetParam());
    test::fillMesh(*scene.node->GetMesh(), {{7.0, 0.0, 0.0}, {8.0, 0.0, 0.0}, {9.0, 0.0, 0.0}}, {});
    scene.sdk.openClosePointCacheData(scene.scene, true);

    expectPoint(deformed(scene, scene.node, 1)[2], 9.0, 0.0, 0.0);
    scene.sdk.openClosePointCacheData(scene.scene, false);
}

TEST(MayaCache, WithoutTheChannelLeavesThePointsAlone) {
    CacheScene scene(FbxCache::eMayaCache);
    scene.deformer->Channel.Set(fbxsdk::FbxString("another"));
    scene.sdk.openClosePointCacheData(scene.scene, true);

    expectPoint(deformed(scene, scene.node, 1)[1], 1.0, 0.0, 0.0);
    scene.sdk.openClosePointCacheData(scene.scene, false);
}

TEST(MayaCache, ExtendsTheTimeOfAStillScene) {
    CacheScene scene(FbxCache::eMayaCache);
    float start = 0.0f, end = 0.0f;

    EXPECT_TRUE(scene.sdk.getAnimationFrameRange(start, end));

    EXPECT_FLOAT_EQ(start, 1.0f / 24.0f);
    EXPECT_FLOAT_EQ(end, 3.0f / 24.0f);
    EXPECT_FALSE(scene.cache->IsOpen());
}

TEST(MayaCache, DoesNotWidenTheTimeOfKeys) {
    CacheScene scene(FbxCache::eMayaCache);
    scene.key(scene.node->LclTranslation, "X", {{0, 0.0f}, {1, 1.0f}});
    float start = 9.0f, end = 9.0f;

    EXPECT_TRUE(scene.sdk.getAnimationFrameRange(start, end));

    EXPECT_EQ(start, 0.0f);
    EXPECT_FLOAT_EQ(end, 1.0f / 24.0f);
}

TEST(MaxCache, SaysNothingAboutTheTimeOfAScene) {
    CacheScene scene(FbxCache::eMaxPointCacheV2);
    float start = 0.0f, end = 0.0f;

    EXPECT_FALSE(scene.sdk.getAnimationFrameRange(start, end));

    EXPECT_EQ(start, std::numeric_limits<float>::max());
}

TEST(PointCaches, CannotBeOpenedWithoutAScene) {
    FbxSdk sdk;

    EXPECT_FALSE(sdk.openClosePointCacheData(nullptr, true));
    EXPECT_FALSE(sdk.openClosePointCacheData(nullptr, false));
}

TEST(PointCaches, OfADeformerWithoutACacheAreNone) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 2);
    auto* deformer = fbxsdk::FbxVertexCacheDeformer::Create(scene.scene, "deformer");
    deformer->Active.Set(true);
    node->GetMesh()->AddDeformer(deformer);

    EXPECT_TRUE(scene.sdk.openClosePointCacheData(scene.scene, true));
    EXPECT_TRUE(deformer->Active.Get());
    EXPECT_TRUE(scene.sdk.getDeformation(node->GetMesh()));
    expectPoint(deformed(scene, node, 1)[1], 1.0, 0.0, 0.0);
}

} // namespace
} // namespace Tarnell::Fbx
