// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deformed points: when there are any, and skins in their three modes.
#include "DeformationScenes.h"

#include <limits>

namespace Tarnell::Fbx {
namespace {

using namespace test;

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

    EXPECT_NEAR(points[0][0], 3.0, 1e-12); // (−1, 0) from the bone, rotated to (0, −1)
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
    cluster->AddControlPointIndex(0, threshold); // the total is the threshold: unchanged
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
    for (const int index : {1, -1, kHighest, -kHighest - 1})
        cluster->AddControlPointIndex(index, 1.0);
    cluster->AddControlPointIndex(0, 1.0);

    expectPoint(deformed(scene, node)[0], 4.0, 0.0, 0.0);
}

TEST(Skin, SurvivesWeightsThatAreNoNumbers) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 1);
    FbxCluster* cluster = addCluster(scene, addSkin(scene, node), {4.0, 0.0, 0.0});
    cluster->AddControlPointIndex(0, std::numeric_limits<double>::quiet_NaN());

    expectPoint(deformed(scene, node)[0], 0.0, 0.0, 0.0); // a total that is NaN is not above the threshold
}

} // namespace
} // namespace Tarnell::Fbx
