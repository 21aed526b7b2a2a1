// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The span of keys of a node, its attributes and its children on one layer.
#include <fbxsdk/FbxBlendShape.h>
#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxSurfaceMaterial.h>

#include "platform/animation/AnimationFixture.h"

namespace {

using namespace fbxsdk;

class AnimationIntervalTest : public AnimationFixture {
protected:
    /// Empty, as hosts pass it: from plus to minus infinity.
    FbxTimeSpan span{FBXSDK_TIME_INFINITE, FBXSDK_TIME_MINUS_INFINITE};

    void keyAt(FbxProperty property, std::int64_t ticks, FbxAnimLayer* on = nullptr) {
        FbxAnimCurve* curve = property.GetCurve(on ? on : layer, nullptr, nullptr, true);
        ASSERT_NE(curve, nullptr) << property.GetNameAsCStr();
        curve->KeyAdd(FbxTime(ticks));
    }
    void expectSpan(std::int64_t start, std::int64_t stop) const {
        EXPECT_EQ(span.GetStart().Get(), start);
        EXPECT_EQ(span.GetStop().Get(), stop);
    }
};

TEST_F(AnimationIntervalTest, IsNotFoundWhereNothingIsKeyed) {
    node->LclTranslation.GetCurve(layer, "X", true); // without keys

    EXPECT_FALSE(node->GetAnimationInterval(span, stack, 0));
    EXPECT_EQ(span.GetStart(), FBXSDK_TIME_INFINITE);
    EXPECT_EQ(span.GetStop(), FBXSDK_TIME_MINUS_INFINITE);
}

TEST_F(AnimationIntervalTest, SpansAllKeysOfTheNode) {
    keyAt(node->LclTranslation, 10);
    keyAt(node->LclTranslation, 30);
    keyAt(node->LclRotation, -5);
    keyAt(node->Visibility, 20);

    EXPECT_TRUE(node->GetAnimationInterval(span, stack, 0));
    expectSpan(-5, 30);
}

TEST_F(AnimationIntervalTest, WidensWhatItIsGiven) {
    keyAt(node->LclTranslation, 10);
    span = FbxTimeSpan(FbxTime(0), FbxTime(5));

    EXPECT_TRUE(node->GetAnimationInterval(span, stack, 0));
    expectSpan(0, 10);
}

TEST_F(AnimationIntervalTest, TakesTheCurrentStackWhereNoneIsGiven) {
    keyAt(node->LclTranslation, 10);

    EXPECT_TRUE(node->GetAnimationInterval(span));
    expectSpan(10, 10);
}

TEST_F(AnimationIntervalTest, KnowsOneLayerOnly) {
    FbxAnimLayer* second = addLayer();
    keyAt(node->LclTranslation, 10);
    keyAt(node->LclRotation, 99, second);

    EXPECT_TRUE(node->GetAnimationInterval(span, stack, 0));
    expectSpan(10, 10);
    span = FbxTimeSpan(FBXSDK_TIME_INFINITE, FBXSDK_TIME_MINUS_INFINITE);
    EXPECT_TRUE(node->GetAnimationInterval(span, stack, 1));
    expectSpan(99, 99);
}

TEST_F(AnimationIntervalTest, IsNotFoundOnALayerThatIsNotThere) {
    keyAt(node->LclTranslation, 10);

    for (const int index : {-1, 1, 1000})
        EXPECT_FALSE(node->GetAnimationInterval(span, stack, index)) << index;
    EXPECT_FALSE(node->GetAnimationInterval(span, FbxAnimStack::Create(scene, "bare"), 0));
    EXPECT_EQ(span.GetStart(), FBXSDK_TIME_INFINITE);
}

TEST_F(AnimationIntervalTest, IsNotFoundOutsideOfAnyScene) {
    FbxNode* loose = FbxNode::Create(manager, "loose");

    EXPECT_FALSE(loose->GetAnimationInterval(span));
    EXPECT_FALSE(loose->GetAnimationInterval(span, stack, 0));
}

TEST_F(AnimationIntervalTest, IncludesChildrenAtEveryDepth) {
    FbxNode* last = node;
    for (int i = 0; i < 1000; ++i) {
        FbxNode* child = FbxNode::Create(scene, "child");
        last->AddChild(child);
        last = child;
    }
    keyAt(last->LclTranslation, 77);

    EXPECT_TRUE(node->GetAnimationInterval(span, stack, 0));
    expectSpan(77, 77);
    EXPECT_TRUE(scene->GetRootNode()->GetAnimationInterval(span, stack, 0));
}

TEST_F(AnimationIntervalTest, IncludesAttributesButNotParents) {
    FbxCamera* camera = FbxCamera::Create(scene, "camera");
    FbxNode* child = FbxNode::Create(scene, "child");
    node->AddChild(child);
    child->SetNodeAttribute(camera);
    keyAt(node->LclTranslation, 1);
    keyAt(camera->FocalLength, 50);

    EXPECT_TRUE(child->GetAnimationInterval(span, stack, 0));
    expectSpan(50, 50);
}

TEST_F(AnimationIntervalTest, IncludesBlendShapesButNotMaterials) {
    FbxMesh* mesh = FbxMesh::Create(scene, "mesh");
    FbxBlendShape* shape = FbxBlendShape::Create(scene, "shape");
    FbxBlendShapeChannel* channel = FbxBlendShapeChannel::Create(scene, "channel");
    FbxSurfacePhong* material = FbxSurfacePhong::Create(scene, "material");
    node->SetNodeAttribute(mesh);
    mesh->AddDeformer(shape);
    shape->AddBlendShapeChannel(channel);
    node->AddMaterial(material);
    keyAt(channel->DeformPercent, 5);
    keyAt(material->Diffuse, 500);

    EXPECT_TRUE(node->GetAnimationInterval(span, stack, 0));
    expectSpan(5, 5);
}

} // namespace
