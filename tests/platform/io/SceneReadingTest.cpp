// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From documents to scenes: classes, properties, connections and animation as files state them, and files that are
// inconsistent.
#include <memory>
#include <string>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxMarker.h>
#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxSkeleton.h>
#include <fbxsdk/FbxSurfaceMaterial.h>
#include <fbxsdk/FbxTexture.h>

#include "io/SceneReading.h"
#include "object/ManagerData.h"
#include "platform/document/DocumentFromText.h"
#include "platform/scene/Animate.h"
#include "platform/scene/SceneFixture.h"
#include "schema/Schema.h"

namespace {

using namespace fbxsdk;
using animate::seconds;

constexpr const char* kSecond = "46186158000";

class SceneReadingTest : public SceneFixture {
protected:
    /// Reads the text of a 7.4 file into the scene.
    void read(const std::string& text) {
        FbxStatus status;
        std::shared_ptr<const detail::Document> document = detail::documentOf("7.4.0", text);
        EXPECT_TRUE(detail::readScene(document, *scene, status)) << status.GetErrorString();
    }
    /// The same from two sections.
    void read(const std::string& objects, const std::string& connections) {
        read("Objects: {\n" + objects + "\n}\nConnections: {\n" + connections + "\n}\n");
    }
    FbxNode* child(int index = 0) { return scene->GetRootNode()->GetChild(index); }
    FbxDouble3 translationAt(FbxNode* node, double time) { return node->LclTranslation.EvaluateValue(seconds(time)); }
};

std::string model(int id, const char* name, const char* properties = "") {
    return "Model: " + std::to_string(id) + ", \"Model::" + name + "\", \"Null\" { Version: 232\n Properties70: { " +
           properties + " } }\n";
}

/// A curve of two linear keys, at zero and at one second.
std::string curve(int id, double first, double second) {
    return "AnimationCurve: " + std::to_string(id) + R"(, "AnimCurve::", "" {
        Default: 0
        KeyVer: 4008
        KeyTime: *2 { a: 0,)" +
           kSecond + R"( }
        KeyValueFloat: *2 { a: )" +
           std::to_string(first) + "," + std::to_string(second) + R"( }
        KeyAttrFlags: *1 { a: 260 }
        KeyAttrDataFloat: *4 { a: 0,0,0,0 }
        KeyAttrRefCount: *1 { a: 2 }
    })" + "\n";
}

const char* const kStack = R"(AnimationStack: 900, "AnimStack::take", "" { }
AnimationLayer: 901, "AnimLayer::base", "" { }
)";

// Valid files.

constexpr const char* kTwoProperties = R"(P: "Lcl Translation", "Lcl Translation", "", "A",1,2,3
        P: "gain", "double", "Number", "U",0.5
)";

TEST_F(SceneReadingTest, ReadsPropertiesAtTheFirstQuestionWhicheverItIs) {
    read(model(1, "a", kTwoProperties) + model(2, "b", kTwoProperties) + model(3, "c", kTwoProperties) +
             model(4, "d", kTwoProperties) + model(5, "e", kTwoProperties),
         "C: \"OO\",1,0\nC: \"OO\",2,0\nC: \"OO\",3,0\nC: \"OO\",4,0\nC: \"OO\",5,0");
    ASSERT_EQ(scene->GetRootNode()->GetChildCount(), 5);

    EXPECT_EQ(child(0)->LclTranslation.Get(), FbxDouble3(1, 2, 3));
    EXPECT_EQ(child(1)->FindProperty("gain").Get<FbxDouble>(), 0.5);
    EXPECT_EQ(child(2)->FindProperty("GAIN", false).Get<FbxDouble>(), 0.5);
    EXPECT_EQ(child(3)->data().propertyCount(), static_cast<int>(detail::kNodeRows.size()) + 1);

    child(4)->LclScaling.Set(FbxDouble3(2, 2, 2));
    EXPECT_EQ(child(4)->LclTranslation.Get(), FbxDouble3(1, 2, 3));
    EXPECT_EQ(child(4)->LclScaling.Get(), FbxDouble3(2, 2, 2));
}

TEST_F(SceneReadingTest, AQuestionThatReadsPropertiesChangesNothing) {
    read(model(1, "a", kTwoProperties), "C: \"OO\",1,0");
    const std::uint64_t before = manager->data().revision;

    EXPECT_EQ(child()->LclTranslation.Get(), FbxDouble3(1, 2, 3));
    EXPECT_EQ(manager->data().revision, before);
}

TEST_F(SceneReadingTest, ANewPropertyFollowsThoseOfTheFile) {
    read(model(1, "a", kTwoProperties), "C: \"OO\",1,0");

    const FbxProperty made = FbxProperty::Create(child(), FbxIntDT, "made");
    EXPECT_EQ(made.index(), static_cast<int>(detail::kNodeRows.size()) + 1);
    EXPECT_EQ(child()->FindProperty("gain").index(), made.index() - 1);
    EXPECT_FALSE(FbxProperty::Create(child(), FbxDoubleDT, "gain").index() > made.index());
}

TEST_F(SceneReadingTest, AnObjectThatLeftItsSceneKeepsItsProperties) {
    read(model(1, "a", kTwoProperties), "C: \"OO\",1,0");
    FbxNode* node = child();
    scene->GetRootNode()->RemoveChild(node);
    scene->DisconnectSrcObject(node);
    scene->Destroy();

    EXPECT_EQ(node->LclTranslation.Get(), FbxDouble3(1, 2, 3));
}

TEST_F(SceneReadingTest, ParentsNodesInTheOrderOfTheirConnections) {
    read(model(1, "a") + model(2, "b") + model(3, "c"), "C: \"OO\",3,0\nC: \"OO\",1,0\nC: \"OO\",2,1");

    ASSERT_EQ(scene->GetRootNode()->GetChildCount(), 2);
    EXPECT_STREQ(child(0)->GetName(), "c");
    EXPECT_STREQ(child(1)->GetName(), "a");
    EXPECT_STREQ(child(1)->GetChild(0)->GetName(), "b");
    EXPECT_STREQ(scene->GetNode(1)->GetName(), "a"); // entered in the order of the objects
}

TEST_F(SceneReadingTest, MakesTheClassThatRecordAndSubClassName) {
    read(R"(
        NodeAttribute: 1, "NodeAttribute::", "Camera" { }
        NodeAttribute: 2, "NodeAttribute::", "Light" { }
        NodeAttribute: 3, "NodeAttribute::", "Null" { }
        NodeAttribute: 4, "NodeAttribute::", "LimbNode" { }
        Material: 5, "Material::phong", "" { ShadingModel: "phong" }
        Material: 6, "Material::lambert", "" { ShadingModel: "Lambert" }
        Material: 7, "Material::odd", "" { ShadingModel: "hairy" }
        Geometry: 8, "Geometry::", "Mesh" { }
        Nothing: 9, "Nothing::known", "" { })",
         "");

    EXPECT_EQ(scene->GetSrcObjectCount<FbxCamera>(), 1);
    EXPECT_EQ(scene->GetSrcObjectCount<FbxLight>(), 1);
    EXPECT_EQ(scene->GetSrcObjectCount<FbxNull>(), 1);
    ASSERT_EQ(scene->GetSrcObjectCount<FbxSkeleton>(), 1);
    EXPECT_EQ(scene->GetSrcObject<FbxSkeleton>()->GetSkeletonType(), FbxSkeleton::eLimbNode);
    EXPECT_EQ(scene->GetSrcObjectCount<FbxSurfacePhong>(), 1);
    EXPECT_EQ(scene->GetSrcObjectCount<FbxSurfaceLambert>(), 2);
    EXPECT_EQ(scene->GetSrcObjectCount<FbxSurfaceMaterial>(), 3);
    EXPECT_EQ(scene->GetSrcObjectCount<FbxMesh>(), 1);
}

TEST_F(SceneReadingTest, SetsPropertiesWhateverTypeTheWriterChose) {
    read(model(1, "a", R"(
        P: "Lcl Translation", "Vector3D", "Vector", "",1,2,3
        P: "Visibility", "bool", "", "",0
        P: "InheritType", "enum", "", "",2
        P: "RotationActive", "bool", "", "",1
        P: "mine", "double", "Number", "AU",5
        P: "text", "KString", "", "U", "hello")"),
         "C: \"OO\",1,0");

    FbxTransform::EInheritType inherit = FbxTransform::eInheritRrSs;
    child()->GetTransformationInheritType(inherit);
    EXPECT_EQ(child()->LclTranslation.Get(), FbxDouble3(1, 2, 3));
    EXPECT_EQ(child()->Visibility.Get(), 0.0);
    EXPECT_EQ(inherit, FbxTransform::eInheritRrs);
    EXPECT_TRUE(child()->GetRotationActive());
    const FbxProperty mine = child()->FindProperty("mine");
    EXPECT_EQ(mine.Get<FbxDouble>(), 5.0);
    EXPECT_TRUE(mine.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_TRUE(mine.GetFlag(FbxPropertyFlags::eUserDefined));
    EXPECT_STREQ(child()->FindProperty("text").Get<FbxString>().Buffer(), "hello");
}

TEST_F(SceneReadingTest, TakesTheFilesOwnDefaultsBeforeTheBuiltInOnes) {
    read(R"(
        Definitions: { ObjectType: "Model" { PropertyTemplate: "FbxNode" { Properties70: {
            P: "InheritType", "enum", "", "",1
            P: "Lcl Scaling", "Lcl Scaling", "", "A",2,2,2
        } } } }
        Objects: { )" +
         model(1, "a") + model(2, "b", R"(P: "Lcl Scaling", "Lcl Scaling", "", "A",1,1,1)") + R"( }
        Connections: { C: "OO",1,0
                       C: "OO",2,0 })");

    FbxTransform::EInheritType inherit = FbxTransform::eInheritRrSs;
    child(0)->GetTransformationInheritType(inherit);
    EXPECT_EQ(inherit, FbxTransform::eInheritRSrs);
    EXPECT_EQ(child(0)->LclScaling.Get(), FbxDouble3(2, 2, 2));
    EXPECT_EQ(child(1)->LclScaling.Get(), FbxDouble3(1, 1, 1)); // the built-in default, stated against the file's
}

TEST_F(SceneReadingTest, TakesTheLastOfTheFilesOwnDefaultsForEveryObject) {
    read(R"(
        Definitions: { ObjectType: "Model" { PropertyTemplate: "FbxNode" { Properties70: {
            P: "Lcl Scaling", "Lcl Scaling", "", "A",2,2,2
            P: "Lcl Translation", "Lcl Translation", "", "A",7,8,9
            P: "Lcl Scaling", "Lcl Scaling", "", "A",1,1,1
        } } } }
        Objects: { )" +
         model(1, "a", R"(P: "Lcl Translation", "Lcl Translation", "", "A",1,2,3)") + model(2, "b") + model(3, "c") +
         R"( }
        Connections: { C: "OO",1,0
                       C: "OO",2,0
                       C: "OO",3,0 })");

    EXPECT_EQ(child(0)->LclTranslation.Get(), FbxDouble3(1, 2, 3));
    for (int i = 1; i < 3; ++i)
        EXPECT_EQ(child(i)->LclTranslation.Get(), FbxDouble3(7, 8, 9));
    for (int i = 0; i < 3; ++i)
        EXPECT_EQ(child(i)->LclScaling.Get(), FbxDouble3(1, 1, 1));
}

TEST_F(SceneReadingTest, PutsRotationsInForceWhereAFileHasNoWordForIt) {
    read(model(1, "a"), "C: \"OO\",1,0");
    EXPECT_TRUE(child()->GetRotationActive());
}

TEST_F(SceneReadingTest, ConnectsTargetsTexturesAndMaterials) {
    read(model(1, "camera") + model(2, "target") + R"(
        Material: 3, "Material::m", "" { ShadingModel: "phong" }
        Texture: 4, "Texture::t", "" { FileName: "/a/b.png"
            RelativeFilename: "b.png" })",
         R"(C: "OO",1,0
            C: "OO",2,0
            C: "OP",2,1, "LookAtProperty"
            C: "OO",3,1
            C: "OP",4,3, "DiffuseColor")");

    EXPECT_EQ(child(0)->GetTarget(), child(1));
    ASSERT_EQ(child(0)->GetMaterialCount(), 1);
    auto* texture = child(0)->GetMaterial(0)->FindProperty("DiffuseColor").GetSrcObject<FbxFileTexture>();
    ASSERT_NE(texture, nullptr);
    EXPECT_STREQ(texture->GetFileName(), "/a/b.png");
}

TEST_F(SceneReadingTest, ReadsTheKeysOfACurveAlsoWhenItsSceneIsGone) {
    read(curve(1, 3, 5), "");
    auto* late = scene->GetSrcObject<FbxAnimCurve>();
    ASSERT_NE(late, nullptr);
    scene->DisconnectSrcObject(late);
    scene->Destroy();
    scene = nullptr;

    ASSERT_EQ(late->KeyGetCount(), 2);
    EXPECT_EQ(late->KeyGetValue(0), 3.0F);
    EXPECT_EQ(late->Evaluate(seconds(1)), 5.0F);
}

TEST_F(SceneReadingTest, ChangesTheKeysOfACurveThatWasNotAccessed) {
    read(curve(1, 3, 5), "");
    auto* changed = scene->GetSrcObject<FbxAnimCurve>();
    ASSERT_NE(changed, nullptr);
    EXPECT_EQ(changed->KeyAdd(seconds(0.5)), 1);
    changed->KeySetValue(1, -1.0F);

    ASSERT_EQ(changed->KeyGetCount(), 3);
    EXPECT_EQ(changed->KeyGetValue(2), 5.0F);
    EXPECT_EQ(changed->Evaluate(seconds(0.5)), -1.0F);
}

TEST_F(SceneReadingTest, PutsCurvesIntoTheirChannels) {
    read(model(1, "a") + kStack + R"(
        AnimationCurveNode: 10, "AnimCurveNode::T", "" { Properties70: {
            P: "d|X", "Number", "", "A",7
            P: "d|Y", "Number", "", "A",8
            P: "d|Z", "Number", "", "A",9 } })" +
             curve(11, 0, 100),
         R"(C: "OO",1,0
            C: "OO",901,900
            C: "OO",10,901
            C: "OP",10,1, "Lcl Translation"
            C: "OP",11,10, "d|Y")");

    EXPECT_EQ(translationAt(child(), 0.5), FbxDouble3(7, 50, 9));
    FbxAnimLayer* layer = scene->GetCurrentAnimationStack()->GetMember<FbxAnimLayer>();
    EXPECT_EQ(child()->LclTranslation.GetCurve(layer, "Y")->KeyGetCount(), 2);
    EXPECT_EQ(child()->LclTranslation.GetCurve(layer, "X"), nullptr);
}

TEST_F(SceneReadingTest, FindsComponentsByNameWhateverOrderTheirChannelsHave) {
    read(model(1, "a") + kStack + R"(
        AnimationCurveNode: 10, "AnimCurveNode::T", "" { Properties70: {
            P: "d|Z", "Number", "", "A",9
            P: "d|X", "Number", "", "A",7
            P: "d|Y", "Number", "", "A",8 } })" +
             curve(11, 0, 100),
         R"(C: "OO",1,0
            C: "OO",901,900
            C: "OO",10,901
            C: "OP",11,10, "d|Z"
            C: "OP",10,1, "Lcl Translation")");

    EXPECT_EQ(translationAt(child(), 0.5), FbxDouble3(7, 8, 50));
}

TEST_F(SceneReadingTest, TakesStaticValuesForChannelsThatAreNotThere) {
    read(model(1, "a", R"(P: "Lcl Scaling", "Lcl Scaling", "", "A",3,4,5)") + kStack +
             "AnimationCurveNode: 10, \"AnimCurveNode::S\", \"\" { }\n" + curve(11, 1, 2),
         R"(C: "OO",1,0
            C: "OO",901,900
            C: "OO",10,901
            C: "OP",10,1, "Lcl Scaling"
            C: "OP",11,10, "d|Y")");

    EXPECT_EQ(child()->LclScaling.EvaluateValue(seconds(1)), FbxDouble3(3, 2, 5));
}

TEST_F(SceneReadingTest, ConnectsACurveWithoutAChannelToTheFirst) {
    read(model(1, "a") + kStack + R"(
        AnimationCurveNode: 10, "AnimCurveNode::Visibility", "" { Properties70: {
            P: "d|Visibility", "Visibility", "", "A",1 } })" +
             curve(11, 0, 1),
         R"(C: "OO",1,0
            C: "OO",901,900
            C: "OO",10,901
            C: "OP",10,1, "Visibility"
            C: "OO",11,10)");

    EXPECT_EQ(child()->Visibility.EvaluateValue(seconds(0.5)), 0.5);
}

TEST_F(SceneReadingTest, SharesOneCurveBetweenManyChannels) {
    read(model(1, "a") + model(2, "b") + kStack + R"(
        AnimationCurveNode: 10, "AnimCurveNode::T", "" { }
        AnimationCurveNode: 20, "AnimCurveNode::T", "" { })" +
             "\n" + curve(11, 0, 100),
         R"(C: "OO",1,0
            C: "OO",2,0
            C: "OO",901,900
            C: "OO",10,901
            C: "OO",20,901
            C: "OP",10,1, "Lcl Translation"
            C: "OP",20,2, "Lcl Translation"
            C: "OP",11,10, "d|X"
            C: "OP",11,10, "d|Y"
            C: "OP",11,20, "d|Z")");

    EXPECT_EQ(translationAt(child(0), 0.5), FbxDouble3(50, 50, 0));
    EXPECT_EQ(translationAt(child(1), 0.5), FbxDouble3(0, 0, 50));
}

TEST_F(SceneReadingTest, TakesSpansFromTheTakeWhereTheStackHasNone) {
    read(R"(
        Objects: { AnimationStack: 900, "AnimStack::take", "" { }
                   AnimationStack: 910, "AnimStack::own", "" { Properties70: {
                       P: "LocalStop", "KTime", "Time", "",17 } } }
        Takes: { Take: "take" { LocalTime: 5,10
                                ReferenceTime: 3,12 }
                 Take: "own" { LocalTime: 5,10
                               ReferenceTime: 3,12 } })");

    auto* take = scene->GetSrcObject<FbxAnimStack>(0);
    auto* own = scene->GetSrcObject<FbxAnimStack>(1);
    EXPECT_EQ(take->GetLocalTimeSpan().GetStart(), FbxTime(5));
    EXPECT_EQ(take->GetLocalTimeSpan().GetStop(), FbxTime(10));
    EXPECT_EQ(take->GetReferenceTimeSpan().GetStop(), FbxTime(12));
    EXPECT_EQ(own->GetLocalTimeSpan().GetStart(), FbxTime(0));
    EXPECT_EQ(own->GetLocalTimeSpan().GetStop(), FbxTime(17));
    EXPECT_EQ(own->GetReferenceTimeSpan().GetStart(), FbxTime(3));
}

// deliberate: hosts sample the first stack, so transforms are evaluated with it too
TEST_F(SceneReadingTest, KeepsTheFirstStackCurrentWhateverTheFileCallsActive) {
    read(R"(
        Documents: { Document: 1, "", "Scene" { Properties70: {
            P: "ActiveAnimStackName", "KString", "", "", "second" } } }
        Objects: { AnimationStack: 900, "AnimStack::first", "" { }
                   AnimationStack: 910, "AnimStack::second", "" { } })");

    EXPECT_STREQ(scene->GetCurrentAnimationStack()->GetName(), "first");
    EXPECT_STREQ(scene->ActiveAnimStackName.Get().Buffer(), "second");
}

TEST_F(SceneReadingTest, SharesAnAttributeBetweenManyNodes) {
    read(model(1, "a") + model(2, "b") + "NodeAttribute: 3, \"NodeAttribute::\", \"Light\" { }",
         R"(C: "OO",1,0
            C: "OO",2,0
            C: "OO",3,1
            C: "OO",3,2)");

    ASSERT_NE(child(0)->GetLight(), nullptr);
    EXPECT_EQ(child(0)->GetLight(), child(1)->GetLight());
    EXPECT_EQ(child(0)->GetLight()->GetNodeCount(), 2);
    EXPECT_EQ(child(0)->GetLight()->GetNode(1), child(1));
}

TEST_F(SceneReadingTest, AddsASecondFileToTheScene) {
    read(model(1, "a"), "C: \"OO\",1,0");
    read(model(1, "b"), "C: \"OO\",1,0");

    ASSERT_EQ(scene->GetRootNode()->GetChildCount(), 2);
    EXPECT_STREQ(child(0)->GetName(), "a");
    EXPECT_STREQ(child(1)->GetName(), "b");
}

// Inconsistent files.

TEST_F(SceneReadingTest, BreaksCyclesOfNodes) {
    read(model(1, "a") + model(2, "b") + model(3, "c"), "C: \"OO\",1,2\nC: \"OO\",2,3\nC: \"OO\",3,1\nC: \"OO\",1,1");

    EXPECT_EQ(scene->GetNodeCount(), 4);
    for (int i = 0; i < scene->GetNodeCount(); ++i) {
        int depth = 0;
        for (FbxNode* each = scene->GetNode(i); each; each = each->GetParent())
            ASSERT_LT(++depth, 5);
        EXPECT_TRUE(scene->GetNode(i)->EvaluateGlobalTransform(seconds(1)).IsIdentity());
    }
}

TEST_F(SceneReadingTest, KeepsANodeBelowTheFirstOfTwoParents) {
    read(model(1, "a") + model(2, "b") + model(3, "c"), "C: \"OO\",1,0\nC: \"OO\",2,0\nC: \"OO\",3,1\nC: \"OO\",3,2");

    EXPECT_EQ(child(0)->GetChildCount(), 1);
    EXPECT_EQ(child(1)->GetChildCount(), 0);
}

TEST_F(SceneReadingTest, AddsAChannelThatACurveNames) {
    read(model(1, "a", R"(P: "Lcl Translation", "Lcl Translation", "", "A",1,2,3)") + kStack + R"(
        AnimationCurveNode: 10, "AnimCurveNode::T", "" { Properties70: {
            P: "d|X", "Number", "", "A",7 } })" +
             curve(11, 0, 100),
         R"(C: "OO",1,0
            C: "OO",901,900
            C: "OO",10,901
            C: "OP",10,1, "Lcl Translation"
            C: "OP",11,10, "d|Q"
            C: "OP",11,10, "nonsense")");

    EXPECT_EQ(translationAt(child(), 1), FbxDouble3(7, 2, 3));
}

TEST_F(SceneReadingTest, LeavesOutConnectionsToPropertiesThatAreNotThere) {
    read(model(1, "a") + kStack + "AnimationCurveNode: 10, \"AnimCurveNode::T\", \"\" { }\n",
         R"(C: "OO",1,0
            C: "OP",10,1, "No Such Property"
            C: "PO",1, "No Such Property",901
            C: "PP",1, "No Such Property",1, "Lcl Translation"
            C: "PP",1, "Lcl Rotation",901, "No Such Property")");

    EXPECT_EQ(child()->LclTranslation.GetSrcPropertyCount(), 0);
    EXPECT_EQ(scene->GetSrcObject<FbxAnimCurveNode>()->GetDstPropertyCount(), 0);
}

TEST_F(SceneReadingTest, ConnectsPropertiesWithObjectsAndProperties) {
    read(model(1, "a") + model(2, "b"), R"(C: "OO",1,0
                                           C: "OO",2,0
                                           C: "PO",1, "Lcl Rotation",2
                                           C: "PP",1, "Lcl Scaling",2, "Lcl Translation")");

    EXPECT_EQ(child(1)->GetSrcProperty(), child(0)->LclRotation);
    EXPECT_EQ(child(1)->LclTranslation.GetSrcProperty(), child(0)->LclScaling);
}

TEST_F(SceneReadingTest, SurvivesStacksWithoutLayersAndLayersWithoutStacks) {
    read(model(1, "a") + kStack + "AnimationCurveNode: 10, \"AnimCurveNode::T\", \"\" { }\n" + curve(11, 0, 100),
         R"(C: "OO",1,0
            C: "OO",10,901
            C: "OP",10,1, "Lcl Translation"
            C: "OP",11,10, "d|X")");
    FbxTimeSpan span;

    EXPECT_EQ(translationAt(child(), 1), FbxDouble3(0, 0, 0));
    EXPECT_FALSE(child()->GetAnimationInterval(span));
}

TEST_F(SceneReadingTest, SurvivesConnectionsBetweenWhateverObjects) {
    read(
        model(1, "a") + kStack + curve(11, 0, 1) +
            "AnimationCurveNode: 10, \"AnimCurveNode::T\", \"\" { }\nNodeAttribute: 3, \"NodeAttribute::\", \"Null\" { "
            "}\n",
        R"(C: "OO",1,0
            C: "OO",900,1
            C: "OO",1,900
            C: "OO",11,1
            C: "OP",11,1, "Lcl Translation"
            C: "OO",1,3
            C: "OO",3,11
            C: "OO",901,10
            C: "OO",10,901
            C: "OP",10,901, "Weight"
            C: "OO",3,0
            C: "OP",1,0, "Anything")");

    for (int i = 0; i < scene->GetNodeCount(); ++i)
        scene->GetNode(i)->EvaluateGlobalTransform(seconds(1));
    EXPECT_EQ(scene->GetNodeCount(), 2);
    scene->Destroy(true);
    scene = FbxScene::Create(manager, "another");
}

TEST_F(SceneReadingTest, SurvivesValuesOfTheWrongKind) {
    read(model(1, "a", R"(
        P: "Lcl Translation", "Lcl Translation", "", "A","x","y","z"
        P: "Lcl Rotation", "Lcl Rotation", "", "A"
        P: "Lcl Scaling", "Lcl Scaling", "", "A",2
        P: "RotationOrder", "enum", "", "",99
        P: "InheritType", "enum", "", "",-1
        P: "DefaultAttributeIndex", "int", "Integer", "",2147483647
        P: "Visibility", "Visibility", "", "A","no"
        P: "Lcl Translation|X", "Compound", "", "")"),
         "C: \"OO\",1,0");

    EXPECT_EQ(child()->LclTranslation.Get(), FbxDouble3(0, 0, 0));
    EXPECT_EQ(child()->LclRotation.Get(), FbxDouble3(0, 0, 0));
    EXPECT_EQ(child()->GetNodeAttribute(), nullptr);
    child()->EvaluateGlobalTransform(seconds(1));
}

TEST_F(SceneReadingTest, EvaluatesAChainOfTenThousandNodes) {
    std::string objects, connections;
    for (int i = 1; i <= 10'000; ++i) {
        objects += model(i, "n", R"(P: "Lcl Translation", "Lcl Translation", "", "A",1,0,0)");
        connections += "C: \"OO\"," + std::to_string(i) + "," + std::to_string(i - 1) + "\n";
    }
    read(objects, connections);

    EXPECT_EQ(scene->GetNode(10'000)->EvaluateGlobalTransform(seconds(1)).GetT()[0], 10'000.0);
    FbxTimeSpan span;
    EXPECT_FALSE(scene->GetRootNode()->GetAnimationInterval(span));
    scene->Destroy();
    scene = FbxScene::Create(manager, "another");
}

} // namespace
