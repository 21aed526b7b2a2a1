// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The data of nodes: properties, attributes, targets, materials and a shading mode.
#include <climits>

#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxGeometry.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxMarker.h>
#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxSkeleton.h>
#include <fbxsdk/FbxSurfaceMaterial.h>

#include "SceneFixture.h"
#include "schema/Spellings.h"

namespace {

using namespace fbxsdk;

class FbxNodeTest : public SceneFixture {
protected:
    FbxNode* node(const char* name = "") { return make<FbxNode>(name); }
};

TEST_F(FbxNodeTest, HasTheDefaultsOfFiles) {
    FbxNode* made = node("made");

    EXPECT_EQ(made->LclTranslation.Get(), FbxDouble3(0, 0, 0));
    EXPECT_EQ(made->LclRotation.Get(), FbxDouble3(0, 0, 0));
    EXPECT_EQ(made->LclScaling.Get(), FbxDouble3(1, 1, 1));
    EXPECT_EQ(made->Visibility.Get(), 1.0);
    EXPECT_EQ(made->GetParent(), nullptr);
    EXPECT_EQ(made->GetChildCount(), 0);
    EXPECT_EQ(made->GetNodeAttribute(), nullptr);
    EXPECT_EQ(made->GetMaterialCount(), 0);
    EXPECT_EQ(made->GetTarget(), nullptr);
    EXPECT_EQ(made->GetTargetUp(), nullptr);
    EXPECT_EQ(made->GetShadingMode(), FbxNode::eHardShading);
    EXPECT_EQ(made->FindProperty("DefaultAttributeIndex").Get<FbxInt>(), -1);
    EXPECT_TRUE(made->FindProperty("Show").Get<FbxBool>());
    EXPECT_EQ(made->FindProperty("AxisLen").Get<FbxDouble>(), 10.0);
}

TEST_F(FbxNodeTest, BindsItsMembersToTheFilesNames) {
    FbxNode* made = node();

    EXPECT_STREQ(made->LclTranslation.GetNameAsCStr(), "Lcl Translation");
    EXPECT_STREQ(made->LclRotation.GetNameAsCStr(), "Lcl Rotation");
    EXPECT_STREQ(made->LclScaling.GetNameAsCStr(), "Lcl Scaling");
    EXPECT_STREQ(made->Visibility.GetNameAsCStr(), "Visibility");
    EXPECT_TRUE(made->LclTranslation.GetFlag(FbxPropertyFlags::eAnimatable));
}

TEST_F(FbxNodeTest, ReturnsThePreviousAttributeWhenGivenAnother) {
    FbxNode* made = node();
    FbxNull* first = make<FbxNull>();
    FbxCamera* second = make<FbxCamera>();

    EXPECT_EQ(made->SetNodeAttribute(first), nullptr);
    EXPECT_EQ(made->GetNodeAttribute(), first);
    EXPECT_EQ(made->FindProperty("DefaultAttributeIndex").Get<FbxInt>(), 0);

    EXPECT_EQ(made->SetNodeAttribute(second), first);
    EXPECT_EQ(made->GetNodeAttribute(), second);
    EXPECT_EQ(made->GetNodeAttributeCount(), 1);
    EXPECT_EQ(first->GetNodeCount(), 0);
    EXPECT_EQ(second->GetNode(), made);

    EXPECT_EQ(made->SetNodeAttribute(second), second);
    EXPECT_EQ(made->GetNodeAttributeCount(), 1);

    EXPECT_EQ(made->SetNodeAttribute(nullptr), second);
    EXPECT_EQ(made->GetNodeAttribute(), nullptr);
    EXPECT_EQ(made->FindProperty("DefaultAttributeIndex").Get<FbxInt>(), -1);
}

TEST_F(FbxNodeTest, TakesTheAttributeThatTheIndexNamesElseTheFirst) {
    FbxNode* made = node();
    FbxNull* first = make<FbxNull>();
    FbxLight* second = make<FbxLight>();
    made->ConnectSrcObject(first);
    made->ConnectSrcObject(second);
    FbxProperty index = made->FindProperty("DefaultAttributeIndex");

    EXPECT_EQ(made->GetNodeAttribute(), first);
    index.Set(FbxInt{1});
    EXPECT_EQ(made->GetNodeAttribute(), second);
    for (const FbxInt wrong : {2, -1, INT_MIN, INT_MAX}) {
        index.Set(wrong);
        EXPECT_EQ(made->GetNodeAttribute(), first) << wrong;
    }
    EXPECT_EQ(made->GetNodeAttributeCount(), 2);
    EXPECT_EQ(made->GetNodeAttributeByIndex(1), second);
    EXPECT_EQ(made->GetNodeAttributeByIndex(2), nullptr);
    EXPECT_EQ(made->GetNodeAttributeByIndex(-1), nullptr);
}

TEST_F(FbxNodeTest, GivesTheAttributeOnlyAsWhatItIs) {
    FbxNode* made = node();

    made->SetNodeAttribute(make<FbxCamera>());
    EXPECT_NE(made->GetCamera(), nullptr);
    EXPECT_EQ(made->GetLight(), nullptr);
    EXPECT_EQ(made->GetNull(), nullptr);
    EXPECT_EQ(made->GetGeometry(), nullptr);

    made->SetNodeAttribute(make<FbxMesh>());
    EXPECT_NE(made->GetMesh(), nullptr);
    EXPECT_EQ(made->GetGeometry(), made->GetMesh());
    EXPECT_EQ(made->GetCamera(), nullptr);

    made->SetNodeAttribute(make<FbxLight>());
    EXPECT_NE(made->GetLight(), nullptr);
    made->SetNodeAttribute(make<FbxMarker>());
    EXPECT_NE(made->GetMarker(), nullptr);
    made->SetNodeAttribute(make<FbxSkeleton>());
    EXPECT_NE(made->GetSkeleton(), nullptr);
    made->SetNodeAttribute(make<FbxNull>());
    EXPECT_NE(made->GetNull(), nullptr);
}

TEST_F(FbxNodeTest, SharesAnAttributeAmongInstances) {
    FbxNode* first = node();
    FbxNode* second = node();
    FbxMesh* mesh = make<FbxMesh>();

    first->SetNodeAttribute(mesh);
    second->SetNodeAttribute(mesh);

    EXPECT_EQ(mesh->GetNodeCount(), 2);
    EXPECT_EQ(mesh->GetNode(0), first);
    EXPECT_EQ(mesh->GetNode(1), second);
    EXPECT_EQ(mesh->GetNode(2), nullptr);
    EXPECT_EQ(mesh->GetNode(-1), nullptr);

    first->Destroy();
    EXPECT_EQ(mesh->GetNodeCount(), 1);
    EXPECT_EQ(mesh->GetNode(), second);

    mesh->Destroy();
    EXPECT_EQ(second->GetNodeAttribute(), nullptr);
    EXPECT_EQ(second->GetNodeAttributeCount(), 0);
}

TEST_F(FbxNodeTest, KeepsItsTargets) {
    FbxNode* camera = node();
    FbxNode* target = node();
    FbxNode* up = node();

    camera->SetTarget(target);
    camera->SetTargetUp(up);
    EXPECT_EQ(camera->GetTarget(), target);
    EXPECT_EQ(camera->GetTargetUp(), up);
    EXPECT_EQ(camera->GetChildCount(), 0);
    EXPECT_EQ(target->GetParent(), nullptr);
    EXPECT_TRUE(camera->FindProperty("LookAtProperty").IsConnectedSrcObject(target));

    camera->SetTarget(up);
    EXPECT_EQ(camera->GetTarget(), up);
    EXPECT_EQ(camera->FindProperty("LookAtProperty").GetSrcObjectCount(), 1);

    camera->SetTarget(nullptr);
    EXPECT_EQ(camera->GetTarget(), nullptr);
    EXPECT_EQ(camera->GetTargetUp(), up);

    up->Destroy();
    EXPECT_EQ(camera->GetTargetUp(), nullptr);
}

TEST_F(FbxNodeTest, ReadsATargetFromTheConnectionOfAFile) {
    FbxNode* camera = node();
    FbxNode* target = node();

    camera->FindProperty("LookAtProperty").ConnectSrcObject(target);

    EXPECT_EQ(camera->GetTarget(), target);
    EXPECT_EQ(camera->GetTargetUp(), nullptr);
}

TEST_F(FbxNodeTest, KeepsMaterialsInTheOrderOfConnection) {
    FbxNode* made = node();
    FbxSurfacePhong* phong = make<FbxSurfacePhong>();
    FbxSurfaceMaterial* plain = make<FbxSurfaceMaterial>();
    FbxSurfaceLambert* lambert = make<FbxSurfaceLambert>();

    EXPECT_EQ(made->AddMaterial(phong), 0);
    EXPECT_EQ(made->AddMaterial(plain), 1);
    made->ConnectSrcObject(lambert);
    EXPECT_EQ(made->AddMaterial(phong), 0);
    EXPECT_EQ(made->AddMaterial(nullptr), -1);

    EXPECT_EQ(made->GetMaterialCount(), 3);
    EXPECT_EQ(made->GetMaterial(2), lambert);
    EXPECT_EQ(made->GetMaterial(3), nullptr);
    EXPECT_EQ(made->GetMaterial(-1), nullptr);

    plain->Destroy();
    EXPECT_EQ(made->GetMaterialCount(), 2);
    EXPECT_EQ(made->GetMaterial(1), lambert);
    EXPECT_EQ(made->GetNodeAttributeCount(), 0);
}

TEST_F(FbxNodeTest, KeepsItsShadingMode) {
    FbxNode* made = node();

    made->SetShadingMode(FbxNode::eTextureShading);

    EXPECT_EQ(made->GetShadingMode(), 4);
}

TEST(ShadingModes, HaveALetterEach) {
    const struct {
        FbxNode::EShadingMode mode;
        char letter;
    } cases[] = {{FbxNode::eHardShading, 'Y'},  {FbxNode::eWireFrame, 'W'},      {FbxNode::eFlatShading, 'F'},
                 {FbxNode::eLightShading, 'L'}, {FbxNode::eTextureShading, 'T'}, {FbxNode::eFullShading, 'U'}};
    for (const auto& each : cases) {
        EXPECT_EQ(detail::spellingOf(detail::kShadingModes, each.mode, FbxNode::eHardShading), each.letter);
        EXPECT_EQ(detail::numberOf(detail::kShadingModes, each.letter, -1), each.mode);
    }
}

TEST(ShadingModes, AreTheDefaultForWhatIsNoLetter) {
    for (const char letter : {'\0', 't', '?', '\xff'})
        EXPECT_EQ(detail::numberOf(detail::kShadingModes, letter, FbxNode::eHardShading), FbxNode::eHardShading);
    EXPECT_EQ(detail::spellingOf(detail::kShadingModes, 6, FbxNode::eHardShading), 'Y');
}

} // namespace
