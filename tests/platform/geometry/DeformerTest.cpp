// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deformers and their connections.
#include "GeometryFixture.h"

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxBlendShape.h>
#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxCache.h>
#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxShape.h>
#include <fbxsdk/FbxSkin.h>
#include <fbxsdk/FbxVertexCacheDeformer.h>

using namespace fbxsdk;
using testing::ElementsAre;

namespace {

class Deformers : public GeometryFixture {
protected:
    /// A blend shape of the mesh with one channel of that many targets each.
    FbxBlendShape* addBlendShape(FbxMesh& mesh, std::initializer_list<int> targetCounts) {
        auto* blendShape = make<FbxBlendShape>();
        for (const int count : targetCounts) {
            auto* channel = make<FbxBlendShapeChannel>();
            for (int i = 0; i < count; ++i)
                channel->AddTargetShape(make<FbxShape>());
            blendShape->AddBlendShapeChannel(channel);
        }
        mesh.AddDeformer(blendShape);
        return blendShape;
    }
};

std::vector<double> fullWeightsOf(FbxBlendShapeChannel& channel) {
    const double* weights = channel.GetTargetShapeFullWeights();
    return {weights, weights + channel.GetTargetShapeCount()};
}

} // namespace

TEST_F(Deformers, AreListedInOrderOfConnection) {
    FbxMesh* mesh = make<FbxMesh>();
    auto* skin = make<FbxSkin>();
    auto* blendShape = make<FbxBlendShape>();
    auto* second = make<FbxSkin>();

    EXPECT_EQ(mesh->AddDeformer(skin), 0);
    EXPECT_EQ(mesh->AddDeformer(blendShape), 1);
    EXPECT_TRUE(mesh->ConnectSrcObject(second));

    EXPECT_EQ(mesh->GetDeformerCount(), 3);
    EXPECT_EQ(mesh->GetDeformer(1), blendShape);
    EXPECT_EQ(mesh->GetDeformerCount(FbxDeformer::eSkin), 2);
    EXPECT_EQ(mesh->GetDeformer(1, FbxDeformer::eSkin), second);
    EXPECT_EQ(mesh->GetDeformer(0, FbxDeformer::eBlendShape), blendShape);
}

TEST_F(Deformers, AreListedOnce) {
    FbxMesh* mesh = make<FbxMesh>();
    auto* skin = make<FbxSkin>();

    EXPECT_EQ(mesh->AddDeformer(skin), 0);
    EXPECT_EQ(mesh->AddDeformer(skin), 0);

    EXPECT_EQ(mesh->GetDeformerCount(), 1);
}

TEST_F(Deformers, AreNullOutOfRange) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->AddDeformer(make<FbxSkin>());
    FbxStatus status;

    EXPECT_EQ(mesh->GetDeformer(1, &status), nullptr);
    EXPECT_TRUE(status.Error());
    EXPECT_NE(mesh->GetDeformer(0, &status), nullptr);
    EXPECT_FALSE(status.Error());
    EXPECT_EQ(mesh->GetDeformer(-1), nullptr);
    EXPECT_EQ(mesh->GetDeformer(0, FbxDeformer::eVertexCache, &status), nullptr);
    EXPECT_TRUE(status.Error());
    EXPECT_EQ(mesh->GetDeformer(-1, FbxDeformer::eSkin), nullptr);
    EXPECT_EQ(mesh->AddDeformer(nullptr), -1);
    EXPECT_EQ(mesh->RemoveDeformer(5), nullptr);
}

TEST_F(Deformers, LeaveTheListWhenTheyAreRemovedOrDestroyed) {
    FbxMesh* mesh = make<FbxMesh>();
    auto* skin = make<FbxSkin>();
    auto* blendShape = make<FbxBlendShape>();
    mesh->AddDeformer(skin);
    mesh->AddDeformer(blendShape);

    EXPECT_EQ(mesh->RemoveDeformer(0), skin);
    EXPECT_EQ(mesh->GetDeformer(0), blendShape);
    EXPECT_EQ(skin->GetGeometry(), nullptr);

    blendShape->Destroy();
    EXPECT_EQ(mesh->GetDeformerCount(), 0);
}

TEST_F(Deformers, KnowTheirTypes) {
    EXPECT_EQ(make<FbxSkin>()->GetDeformerType(), FbxDeformer::eSkin);
    EXPECT_EQ(make<FbxBlendShape>()->GetDeformerType(), FbxDeformer::eBlendShape);
    EXPECT_EQ(make<FbxVertexCacheDeformer>()->GetDeformerType(), FbxDeformer::eVertexCache);
    EXPECT_EQ(make<FbxCluster>()->GetSubDeformerType(), FbxSubDeformer::eCluster);
    EXPECT_EQ(make<FbxBlendShapeChannel>()->GetSubDeformerType(), FbxSubDeformer::eBlendShapeChannel);
}

TEST_F(Deformers, ASkinListsItsClusters) {
    auto* skin = make<FbxSkin>();
    auto* first = make<FbxCluster>();
    auto* second = make<FbxCluster>();

    EXPECT_TRUE(skin->AddCluster(first));
    EXPECT_TRUE(skin->AddCluster(second));
    EXPECT_FALSE(skin->AddCluster(first));
    EXPECT_FALSE(skin->AddCluster(nullptr));

    EXPECT_EQ(skin->GetClusterCount(), 2);
    EXPECT_EQ(skin->GetCluster(1), second);
    EXPECT_EQ(skin->GetCluster(2), nullptr);
    EXPECT_EQ(skin->GetCluster(-1), nullptr);

    EXPECT_EQ(skin->RemoveCluster(first), first);
    EXPECT_EQ(skin->RemoveCluster(first), nullptr);
    EXPECT_EQ(skin->GetCluster(0), second);
    second->Destroy();
    EXPECT_EQ(skin->GetClusterCount(), 0);
}

TEST_F(Deformers, ASkinMovesFromOneGeometryToAnother) {
    FbxMesh* from = make<FbxMesh>();
    FbxMesh* to = make<FbxMesh>();
    auto* skin = make<FbxSkin>();
    EXPECT_EQ(skin->GetGeometry(), nullptr);

    EXPECT_TRUE(skin->SetGeometry(from));
    EXPECT_TRUE(skin->SetGeometry(to));

    EXPECT_EQ(skin->GetGeometry(), to);
    EXPECT_EQ(from->GetDeformerCount(), 0);
    EXPECT_EQ(to->GetDeformer(0), skin);
    EXPECT_TRUE(skin->SetGeometry(to));
    EXPECT_EQ(to->GetDeformerCount(), 1);
}

TEST_F(Deformers, AClusterFollowsItsLink) {
    auto* cluster = make<FbxCluster>();
    auto* bone = make<FbxNode>();
    auto* other = make<FbxNode>();
    EXPECT_EQ(cluster->GetLink(), nullptr);

    cluster->SetLink(bone);
    EXPECT_EQ(cluster->GetLink(), bone);
    EXPECT_TRUE(cluster->IsConnectedSrcObject(bone));

    cluster->SetLink(other);
    EXPECT_EQ(cluster->GetLink(), other);
    EXPECT_FALSE(cluster->IsConnectedSrcObject(bone));

    cluster->SetLink(nullptr);
    EXPECT_EQ(cluster->GetLink(), nullptr);
}

TEST_F(Deformers, AClusterTakesTheFirstNodeForItsLink) {
    auto* cluster = make<FbxCluster>();
    auto* first = make<FbxNode>();
    auto* second = make<FbxNode>();
    cluster->ConnectSrcObject(first);
    cluster->ConnectSrcObject(second);
    EXPECT_EQ(cluster->GetLink(), first);

    first->Destroy();
    EXPECT_EQ(cluster->GetLink(), second);
}

TEST_F(Deformers, AClusterLosesALinkThatIsDestroyed) {
    auto* cluster = make<FbxCluster>();
    auto* bone = make<FbxNode>();
    cluster->SetLink(bone);

    bone->Destroy();

    EXPECT_EQ(cluster->GetLink(), nullptr);
}

TEST_F(Deformers, AClusterHasAnAssociateModelBesideItsLink) {
    auto* cluster = make<FbxCluster>();
    auto* bone = make<FbxNode>();
    auto* associate = make<FbxNode>();
    EXPECT_EQ(cluster->GetAssociateModel(), nullptr);

    cluster->SetAssociateModel(associate);
    cluster->SetLink(bone);
    EXPECT_EQ(cluster->GetAssociateModel(), associate);
    EXPECT_EQ(cluster->GetLink(), bone);

    cluster->SetAssociateModel(nullptr);
    EXPECT_EQ(cluster->GetAssociateModel(), nullptr);
    EXPECT_EQ(cluster->GetLink(), bone);
}

TEST_F(Deformers, AClusterKeepsPointsAndWeights) {
    auto* cluster = make<FbxCluster>();
    EXPECT_EQ(cluster->GetControlPointIndices(), nullptr);
    EXPECT_EQ(cluster->GetControlPointWeights(), nullptr);

    cluster->AddControlPointIndex(4, 0.25);
    cluster->AddControlPointIndex(-7, 2);

    ASSERT_EQ(cluster->GetControlPointIndicesCount(), 2);
    EXPECT_EQ(cluster->GetControlPointIndices()[0], 4);
    EXPECT_EQ(cluster->GetControlPointIndices()[1], -7);
    EXPECT_EQ(cluster->GetControlPointWeights()[0], 0.25);
    EXPECT_EQ(cluster->GetControlPointWeights()[1], 2);
}

TEST_F(Deformers, AClusterKeepsItsMatrices) {
    auto* cluster = make<FbxCluster>();
    const FbxAMatrix moved(FbxVector4(1, 2, 3), FbxVector4(0, 90, 0), FbxVector4(1, 1, 1));
    FbxAMatrix matrix = moved;
    EXPECT_TRUE(cluster->GetTransformMatrix(matrix).IsIdentity());
    EXPECT_TRUE(cluster->GetTransformLinkMatrix(matrix).IsIdentity());
    EXPECT_TRUE(cluster->GetTransformAssociateModelMatrix(matrix).IsIdentity());
    EXPECT_FALSE(cluster->IsTransformParentSet());

    cluster->SetTransformMatrix(moved);
    cluster->SetTransformLinkMatrix(moved.Inverse());
    cluster->SetTransformParentMatrix(moved);

    EXPECT_EQ(cluster->GetTransformMatrix(matrix), moved);
    EXPECT_EQ(matrix, moved) << "the argument is filled as well";
    EXPECT_EQ(cluster->GetTransformLinkMatrix(matrix), moved.Inverse());
    EXPECT_TRUE(cluster->GetTransformAssociateModelMatrix(matrix).IsIdentity());
    EXPECT_TRUE(cluster->IsTransformParentSet());
    EXPECT_EQ(cluster->GetTransformParentMatrix(matrix), moved);
}

TEST_F(Deformers, AClusterNormalizesAtFirst) {
    auto* cluster = make<FbxCluster>();
    EXPECT_EQ(cluster->GetLinkMode(), FbxCluster::eNormalize);

    cluster->SetLinkMode(FbxCluster::eTotalOne);
    EXPECT_EQ(cluster->GetLinkMode(), FbxCluster::eTotalOne);
}

TEST_F(Deformers, ShapesAreCountedOverAllChannels) {
    FbxMesh* mesh = make<FbxMesh>();
    EXPECT_EQ(mesh->GetShapeCount(), 0);
    mesh->AddDeformer(make<FbxSkin>());
    addBlendShape(*mesh, {1, 0, 3});
    addBlendShape(*mesh, {2});

    EXPECT_EQ(mesh->GetShapeCount(), 6);
}

TEST_F(Deformers, ABlendShapeListsItsChannels) {
    FbxMesh* mesh = make<FbxMesh>();
    FbxBlendShape* blendShape = addBlendShape(*mesh, {1, 1});
    FbxBlendShapeChannel* second = blendShape->GetBlendShapeChannel(1);

    EXPECT_EQ(blendShape->GetGeometry(), mesh);
    EXPECT_EQ(blendShape->GetBlendShapeChannelCount(), 2);
    EXPECT_EQ(second->GetBlendShapeDeformer(), blendShape);
    EXPECT_EQ(blendShape->GetBlendShapeChannel(2), nullptr);
    EXPECT_FALSE(blendShape->AddBlendShapeChannel(second));

    blendShape->GetBlendShapeChannel(0)->Destroy();
    EXPECT_EQ(blendShape->GetBlendShapeChannel(0), second);
    EXPECT_EQ(blendShape->RemoveBlendShapeChannel(second), second);
    EXPECT_EQ(second->GetBlendShapeDeformer(), nullptr);
}

TEST_F(Deformers, AChannelListsItsTargets) {
    auto* channel = make<FbxBlendShapeChannel>();
    auto* first = make<FbxShape>();
    auto* second = make<FbxShape>();

    EXPECT_TRUE(channel->AddTargetShape(first, 30));
    EXPECT_TRUE(channel->AddTargetShape(second, 80));
    EXPECT_FALSE(channel->AddTargetShape(first, 90));
    EXPECT_FALSE(channel->AddTargetShape(nullptr));

    EXPECT_EQ(channel->GetTargetShapeCount(), 2);
    EXPECT_EQ(channel->GetTargetShape(1), second);
    EXPECT_EQ(channel->GetTargetShape(2), nullptr);
    EXPECT_EQ(channel->GetTargetShapeIndex(second), 1);
    EXPECT_EQ(channel->GetTargetShapeIndex(nullptr), -1);
    EXPECT_THAT(fullWeightsOf(*channel), ElementsAre(30, 80));
}

TEST_F(Deformers, ATargetTakesItsFullWeightWithIt) {
    auto* channel = make<FbxBlendShapeChannel>();
    auto* first = make<FbxShape>();
    channel->AddTargetShape(first, 30);
    channel->AddTargetShape(make<FbxShape>(), 80);

    EXPECT_EQ(channel->RemoveTargetShape(first), first);

    EXPECT_THAT(fullWeightsOf(*channel), ElementsAre(80));
}

TEST_F(Deformers, TargetsWithoutFullWeightsDivideTheWayEvenly) {
    auto* channel = make<FbxBlendShapeChannel>();
    EXPECT_EQ(channel->GetTargetShapeFullWeights(), nullptr);

    channel->ConnectSrcObject(make<FbxShape>());
    EXPECT_THAT(fullWeightsOf(*channel), ElementsAre(100));

    auto* four = make<FbxBlendShapeChannel>();
    for (int i = 0; i < 4; ++i)
        four->ConnectSrcObject(make<FbxShape>());
    EXPECT_THAT(fullWeightsOf(*four), ElementsAre(25, 50, 75, 100));
}

TEST_F(Deformers, FullWeightsCanBeWritten) {
    auto* channel = make<FbxBlendShapeChannel>();
    channel->SetFullWeightsCount(2);
    channel->GetTargetShapeFullWeights()[0] = 40;
    channel->GetTargetShapeFullWeights()[1] = 90;
    channel->ConnectSrcObject(make<FbxShape>());
    channel->ConnectSrcObject(make<FbxShape>());

    EXPECT_THAT(fullWeightsOf(*channel), ElementsAre(40, 90));
    channel->SetFullWeightsCount(-1);
    EXPECT_THAT(fullWeightsOf(*channel), ElementsAre(50, 100));
}

TEST_F(Deformers, AChannelsPercentageIsZeroAtFirst) {
    const auto* channel = make<FbxBlendShapeChannel>();

    EXPECT_TRUE(channel->DeformPercent.IsValid());
    EXPECT_EQ(channel->DeformPercent.Get(), 0);
}

TEST_F(Deformers, TheCurveOfAChannelIsThatOfItsPercentage) {
    FbxMesh* mesh = make<FbxMesh>();
    FbxBlendShape* blendShape = addBlendShape(*mesh, {1, 1});
    auto* layer = make<FbxAnimLayer>();
    EXPECT_EQ(mesh->GetShapeChannel(0, 1, layer), nullptr);

    FbxAnimCurve* curve = mesh->GetShapeChannel(0, 1, layer, true);

    ASSERT_NE(curve, nullptr);
    EXPECT_EQ(mesh->GetShapeChannel(0, 1, layer), curve);
    EXPECT_EQ(blendShape->GetBlendShapeChannel(1)->DeformPercent.GetCurve(layer), curve);
    EXPECT_EQ(mesh->GetShapeChannel(0, 0, layer), nullptr);
}

TEST_F(Deformers, ThereIsNoCurveForBadIndices) {
    FbxMesh* mesh = make<FbxMesh>();
    addBlendShape(*mesh, {1});
    auto* layer = make<FbxAnimLayer>();
    FbxStatus status;

    EXPECT_EQ(mesh->GetShapeChannel(1, 0, layer, true, &status), nullptr);
    EXPECT_TRUE(status.Error());
    EXPECT_EQ(mesh->GetShapeChannel(0, 1, layer, true, &status), nullptr);
    EXPECT_TRUE(status.Error());
    EXPECT_EQ(mesh->GetShapeChannel(-1, -1, layer, true), nullptr);
    EXPECT_EQ(mesh->GetShapeChannel(0, 0, nullptr, true), nullptr);
}

TEST_F(Deformers, ACacheDeformerHasTheDefaultsOfItsClass) {
    const auto* deformer = make<FbxVertexCacheDeformer>();

    EXPECT_TRUE(deformer->Active.Get());
    EXPECT_STREQ(deformer->Channel.Get().Buffer(), "");
    EXPECT_STREQ(deformer->CacheSet.Get().Buffer(), "FbxCacheExport");
    EXPECT_EQ(deformer->Type.Get(), FbxVertexCacheDeformer::ePositions);
    EXPECT_EQ(deformer->GetCache(), nullptr);
}

TEST_F(Deformers, ACacheDeformerHasOneCache) {
    auto* deformer = make<FbxVertexCacheDeformer>();
    auto* first = make<FbxCache>();
    auto* second = make<FbxCache>();

    deformer->SetCache(first);
    EXPECT_EQ(deformer->GetCache(), first);

    deformer->SetCache(second);
    EXPECT_EQ(deformer->GetCache(), second);
    EXPECT_FALSE(deformer->IsConnectedSrcObject(first));

    deformer->SetCache(nullptr);
    EXPECT_EQ(deformer->GetCache(), nullptr);
}

TEST_F(Deformers, CanBeDestroyedInAnyOrder) {
    FbxMesh* mesh = make<FbxMesh>();
    FbxBlendShape* blendShape = addBlendShape(*mesh, {2});
    FbxBlendShapeChannel* channel = blendShape->GetBlendShapeChannel(0);

    mesh->Destroy();
    EXPECT_EQ(blendShape->GetGeometry(), nullptr);
    blendShape->Destroy();
    EXPECT_EQ(channel->GetBlendShapeDeformer(), nullptr);
    channel->Destroy(true);
}
