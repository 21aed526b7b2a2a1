// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The content of a scene is read back from a file of any version: nodes, properties, settings.
#include "io/SceneWriting.h"

#include <limits>
#include <string>
#include <vector>

#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxGlobalCameraSettings.h>
#include <fbxsdk/FbxGlobalLightSettings.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxNull.h>

#include "ExportFixture.h"
#include "io/SchemaClass.h"
#include "object/ManagerData.h"
#include "schema/Schema.h"

namespace {

using namespace fbxsdk;
using exporting::expectVector;

class SceneWriting : public exporting::EveryLayout {};

INSTANTIATE_TEST_SUITE_P(Versions, SceneWriting, testing::ValuesIn(exporting::allLayouts()));

/// L for each locked component, M for each muted one.
std::string componentFlags(const FbxProperty& property) {
    std::string text = ".... ....";
    for (unsigned component = 0; component < 4; ++component) {
        const auto isSet = [&](unsigned first) {
            return property.GetFlag(static_cast<FbxPropertyFlags::EFlags>(first << component));
        };
        if (isSet(FbxPropertyFlags::eLockedMember0))
            text[component] = 'L';
        if (isSet(FbxPropertyFlags::eMutedMember0))
            text[5 + component] = 'M';
    }
    return text;
}

TEST_P(SceneWriting, StatesTheVersion) {
    writeAndRead();

    const int number = static_cast<int>(detail::findVersion(GetParam().version)->version);
    EXPECT_EQ(version[0] * 1000 + version[1] * 100, number);
}

TEST_P(SceneWriting, WritesASceneWithoutAnything) {
    FbxScene* copy = writeAndRead();

    EXPECT_EQ(copy->GetRootNode()->GetChildCount(), 0);
    EXPECT_EQ(copy->GetCurrentAnimationStack(), nullptr);
}

TEST_P(SceneWriting, KeepsTheTreeAndTheOrderOfChildren) {
    FbxNode* b = addNode("b");
    FbxNode* a = addNode("a");
    FbxNode* inner2 = make<FbxNode>("inner2");
    FbxNode* inner1 = make<FbxNode>("inner1");
    a->AddChild(inner1);
    a->AddChild(inner2);
    inner2->AddChild(make<FbxNode>("leaf"));

    FbxScene* copy = writeAndRead();

    ASSERT_EQ(copy->GetRootNode()->GetChildCount(), 2);
    EXPECT_STREQ(childOf(copy, 0)->GetName(), b->GetName());
    EXPECT_STREQ(childOf(copy, 1)->GetName(), "a");
    ASSERT_EQ(childOf(copy, 1)->GetChildCount(), 2);
    EXPECT_STREQ(childOf(copy, 1)->GetChild(0)->GetName(), "inner1");
    ASSERT_EQ(childOf(copy, 1)->GetChild(1)->GetChildCount(), 1);
    EXPECT_STREQ(childOf(copy, 1)->GetChild(1)->GetChild(0)->GetName(), "leaf");
}

TEST_P(SceneWriting, KeepsEveryTransformPropertyOfANode) {
    FbxNode* node = addNode("node");
    node->LclTranslation.Set(FbxDouble3(1.25, -2.5, 1e-9));
    node->LclRotation.Set(FbxDouble3(10, 20, 30));
    node->LclScaling.Set(FbxDouble3(2, 1.0 / 3, -1));
    node->SetRotationOrder(FbxNode::eSourcePivot, FbxEuler::eOrderZYX);
    node->SetRotationActive(true);
    node->SetPreRotation(FbxNode::eSourcePivot, FbxVector4(1, 2, 3));
    node->SetPostRotation(FbxNode::eSourcePivot, FbxVector4(0, -90, 0));
    node->SetRotationPivot(FbxNode::eSourcePivot, FbxVector4(4, 5, 6));
    node->SetRotationOffset(FbxNode::eSourcePivot, FbxVector4(7, 8, 9));
    node->SetScalingPivot(FbxNode::eSourcePivot, FbxVector4(-1, -2, -3));
    node->SetScalingOffset(FbxNode::eSourcePivot, FbxVector4(-4, -5, -6));
    node->SetGeometricTranslation(FbxNode::eSourcePivot, FbxVector4(0.1, 0.2, 0.3));
    node->SetGeometricRotation(FbxNode::eSourcePivot, FbxVector4(40, 50, 60));
    node->SetGeometricScaling(FbxNode::eSourcePivot, FbxVector4(3, 4, 5));
    node->SetTransformationInheritType(FbxTransform::eInheritRrs);
    node->Visibility.Set(0.0);
    node->SetShadingMode(FbxNode::eTextureShading);

    FbxNode* back = childOf(writeAndRead());

    ASSERT_NE(back, nullptr);
    for (FbxProperty property = node->GetFirstProperty(); property.IsValid();
         property = node->GetNextProperty(property)) {
        if (property.GetName() == "DefaultAttributeIndex")
            continue;
        const auto expected = property.Get<FbxDouble4>();
        const auto actual = back->FindProperty(property.GetNameAsCStr()).Get<FbxDouble4>();
        for (int i = 0; i < 4; ++i)
            EXPECT_EQ(actual[i], expected[i]) << property.GetNameAsCStr();
    }
    EXPECT_EQ(back->GetShadingMode(), FbxNode::eTextureShading);
}

TEST_P(SceneWriting, KeepsEveryShadingMode) {
    constexpr FbxNode::EShadingMode kModes[] = {FbxNode::eHardShading,    FbxNode::eWireFrame,
                                                FbxNode::eFlatShading,    FbxNode::eLightShading,
                                                FbxNode::eTextureShading, FbxNode::eFullShading};
    for (const FbxNode::EShadingMode mode : kModes)
        addNode(std::to_string(mode).c_str())->SetShadingMode(mode);

    FbxScene* copy = writeAndRead();

    for (int i = 0; i < static_cast<int>(std::size(kModes)); ++i)
        EXPECT_EQ(childOf(copy, i)->GetShadingMode(), kModes[i]);
}

TEST_P(SceneWriting, KeepsNamesWithAnythingInThem) {
    const std::string names[] = {
        "plain",        "two words", "a \"quoted\" name", "Model::colons::", "line\nbreak", "return\r\nboth",
        "größe 寸法 🎥", "C:\\path",  "{ braces }",        "semicolon; end",  "&amp;",       std::string(5000, 'x')};
    for (const std::string& name : names)
        addNode(name.c_str());

    FbxScene* copy = writeAndRead();

    ASSERT_EQ(copy->GetRootNode()->GetChildCount(), static_cast<int>(std::size(names)));
    for (int i = 0; i < static_cast<int>(std::size(names)); ++i)
        EXPECT_STREQ(childOf(copy, i)->GetName(), names[i].c_str());
}

TEST_P(SceneWriting, KeepsAnEmptyName) {
    addNode("");

    FbxScene* copy = writeAndRead();

    ASSERT_EQ(copy->GetRootNode()->GetChildCount(), 1);
    EXPECT_STREQ(childOf(copy)->GetName(), "");
}

TEST_P(SceneWriting, DistinguishesNodesOfOneName) {
    addNode("same")->LclTranslation.Set(FbxDouble3(1, 0, 0));
    addNode("same")->LclTranslation.Set(FbxDouble3(2, 0, 0));
    addNode("same_ncl1_1")->LclTranslation.Set(FbxDouble3(3, 0, 0));
    addNode("Scene")->LclTranslation.Set(FbxDouble3(4, 0, 0)); // the name of the root in old files

    FbxScene* copy = writeAndRead();

    const std::vector<std::string> expected =
        GetParam().hasIds() ? std::vector<std::string>{"same", "same", "same_ncl1_1", "Scene"}
                            : std::vector<std::string>{"same", "same_ncl1_2", "same_ncl1_1", "Scene_ncl1_1"};
    ASSERT_EQ(copy->GetRootNode()->GetChildCount(), 4);
    for (int i = 0; i < 4; ++i) {
        EXPECT_EQ(childOf(copy, i)->GetName(), expected[static_cast<std::size_t>(i)]);
        EXPECT_EQ(childOf(copy, i)->LclTranslation.Get()[0], i + 1);
    }
}

TEST_P(SceneWriting, LeavesANodeWithoutAttributeWithoutOne) {
    addNode("empty");

    EXPECT_EQ(childOf(writeAndRead())->GetNodeAttribute(), nullptr);
}

TEST_P(SceneWriting, KeepsWhatANodeLooksAt) {
    FbxNode* target = addNode("target");
    FbxNode* up = addNode("up");
    FbxNode* camera = addNode("camera", make<FbxCamera>("camera"));
    camera->SetTarget(target);
    camera->SetTargetUp(up);

    FbxScene* copy = writeAndRead();

    EXPECT_EQ(childOf(copy, 2)->GetTarget(), childOf(copy, 0));
    EXPECT_EQ(childOf(copy, 2)->GetTargetUp(), childOf(copy, 1));
}

TEST_P(SceneWriting, KeepsUserProperties) {
    FbxNode* node = addNode("node");
    const auto add = [&](const FbxDataType& type, const char* name) {
        FbxProperty property = FbxProperty::Create(node, type, name);
        property.ModifyFlag(FbxPropertyFlags::eUserDefined, true);
        return property;
    };
    add(FbxBoolDT, "a bool").Set(true);
    add(FbxIntDT, "an int").Set(-7);
    add(FbxLongLongDT, "a long").Set(FbxLongLong{1} << 60);
    add(FbxFloatDT, "a float").Set(0.1F);
    add(FbxDoubleDT, "a double").Set(0.1);
    add(FbxDouble2DT, "a pair").Set(FbxDouble2(1.5, 2.5));
    add(FbxDouble3DT, "a vector").Set(FbxDouble3(1, 2, 3));
    add(FbxDouble4DT, "four").Set(FbxDouble4(1, 2, 3, 4));
    add(FbxColor3DT, "a colour").Set(FbxDouble3(0.1, 0.2, 0.3));
    add(FbxStringDT, "a text").Set("with \"quotes\"\nand lines");
    add(FbxTimeDT, "a time").Set(FbxTime(123456789012345));
    add(FbxEnumDT, "an enum").Set(FbxEnum{3});

    FbxNode* back = childOf(writeAndRead());

    EXPECT_EQ(back->FindProperty("a bool").Get<FbxBool>(), true);
    EXPECT_EQ(back->FindProperty("an int").Get<FbxInt>(), -7);
    EXPECT_EQ(back->FindProperty("a long").Get<FbxLongLong>(), FbxLongLong{1} << 60);
    EXPECT_EQ(back->FindProperty("a float").Get<FbxFloat>(), 0.1F);
    EXPECT_EQ(back->FindProperty("a double").Get<FbxDouble>(), 0.1);
    EXPECT_EQ(back->FindProperty("a pair").Get<FbxDouble2>()[1], 2.5);
    expectVector(back->FindProperty("a vector").Get<FbxDouble3>(), 1, 2, 3);
    EXPECT_EQ(back->FindProperty("four").Get<FbxDouble4>()[3], 4.0);
    expectVector(back->FindProperty("a colour").Get<FbxDouble3>(), 0.1, 0.2, 0.3);
    EXPECT_STREQ(back->FindProperty("a text").Get<FbxString>().Buffer(), "with \"quotes\"\nand lines");
    EXPECT_EQ(back->FindProperty("a time").Get<FbxTime>().Get(), 123456789012345);
    EXPECT_EQ(back->FindProperty("an enum").Get<FbxEnum>(), 3);
    for (FbxProperty property = back->FindProperty("a bool"); property.IsValid();
         property = back->GetNextProperty(property))
        EXPECT_TRUE(property.GetFlag(FbxPropertyFlags::eUserDefined)) << property.GetNameAsCStr();
}

TEST_P(SceneWriting, KeepsLockedAndMutedComponents) {
    FbxLight* light = make<FbxLight>("light");
    FbxNode* node = addNode("node", light);
    node->LclTranslation.ModifyFlag(FbxPropertyFlags::eLockedAll, true);
    node->LclTranslation.ModifyFlag(FbxPropertyFlags::eLockedMember3, false);
    node->LclRotation.ModifyFlag(FbxPropertyFlags::eLockedMember2, true);
    node->LclRotation.ModifyFlag(FbxPropertyFlags::eMutedMember0, true);
    light->Intensity.ModifyFlag(FbxPropertyFlags::eMutedMember0, true);
    FbxProperty four = FbxProperty::Create(node, FbxDouble4DT, "four");
    four.ModifyFlag(FbxPropertyFlags::eUserDefined, true);
    four.ModifyFlag(FbxPropertyFlags::eMutedAll, true);

    FbxNode* back = childOf(writeAndRead());

    EXPECT_EQ(componentFlags(back->LclTranslation), "LLL. ....");
    EXPECT_EQ(componentFlags(back->LclRotation), "..L. M...");
    EXPECT_EQ(componentFlags(back->LclScaling), ".... ....");
    EXPECT_EQ(componentFlags(back->GetLight()->Intensity), ".... M...");
    EXPECT_EQ(componentFlags(back->FindProperty("four")), ".... MMMM");
}

TEST_P(SceneWriting, LeavesOutWhatIsNotToBeSaved) {
    FbxNode* node = addNode("node");
    FbxProperty::Create(node, FbxIntDT, "secret").ModifyFlag(FbxPropertyFlags::eNotSavable, true);

    EXPECT_FALSE(childOf(writeAndRead())->FindProperty("secret").IsValid());
}

TEST_P(SceneWriting, KeepsTheSettings) {
    FbxGlobalSettings& settings = scene->GetGlobalSettings();
    settings.SetAxisSystem(FbxAxisSystem::MayaZUp);
    settings.SetOriginalUpAxis(FbxAxisSystem::MayaZUp);
    settings.SetSystemUnit(FbxSystemUnit::m);
    settings.SetTimeMode(FbxTime::ePAL);
    settings.SetTimelineDefaultTimeSpan(FbxTimeSpan(FbxTime(1847446320), FbxTime(184744632000)));
    scene->GlobalLightSettings().SetAmbientColor(FbxColor(0.25, 0.5, 0.75));
    scene->GlobalCameraSettings().SetDefaultCamera("Producer Top");

    FbxScene* copy = writeAndRead();

    const FbxGlobalSettings& back = copy->GetGlobalSettings();
    EXPECT_EQ(back.GetAxisSystem(), FbxAxisSystem::MayaZUp);
    EXPECT_EQ(back.GetOriginalUpAxis(), 2);
    EXPECT_EQ(back.GetSystemUnit(), FbxSystemUnit::m);
    EXPECT_EQ(back.GetTimeMode(), FbxTime::ePAL);
    FbxTimeSpan span;
    back.GetTimelineDefaultTimeSpan(span);
    EXPECT_EQ(span.GetStart().Get(), 1847446320);
    EXPECT_EQ(span.GetStop().Get(), 184744632000);
    EXPECT_EQ(copy->GlobalLightSettings().GetAmbientColor(), FbxColor(0.25, 0.5, 0.75));
    EXPECT_STREQ(copy->GlobalCameraSettings().GetDefaultCamera(), "Producer Top");
}

TEST_P(SceneWriting, KeepsFogOnlyWhereFilesHaveAPlaceForIt) {
    FbxGlobalLightSettings& lights = scene->GlobalLightSettings();
    lights.SetFogEnable(true);
    lights.SetFogMode(FbxGlobalLightSettings::eExponential);
    lights.SetFogDensity(0.5);
    lights.SetFogStart(1.5);
    lights.SetFogEnd(250.0);
    lights.SetFogColor(FbxColor(0.1, 0.2, 0.3, 0.4));

    FbxScene* copy = writeAndRead();

    const FbxGlobalLightSettings& back = copy->GlobalLightSettings();
    if (GetParam().hasIds()) {
        EXPECT_FALSE(back.GetFogEnable());
        EXPECT_EQ(back.GetFogEnd(), 1000.0);
        return;
    }
    EXPECT_TRUE(back.GetFogEnable());
    EXPECT_EQ(back.GetFogMode(), FbxGlobalLightSettings::eExponential);
    EXPECT_EQ(back.GetFogDensity(), 0.5);
    EXPECT_EQ(back.GetFogStart(), 1.5);
    EXPECT_EQ(back.GetFogEnd(), 250.0);
    EXPECT_EQ(back.GetFogColor(), FbxColor(0.1, 0.2, 0.3, 0.4));
}

TEST_P(SceneWriting, KeepsProducerCamerasOnlyWhereFilesHaveAPlaceForThem) {
    scene->GlobalCameraSettings().CreateProducerCameras();
    scene->GlobalCameraSettings().GetCameraProducerTop()->FarPlane.Set(777.0);
    addNode("own", make<FbxCamera>("own"));

    FbxScene* copy = writeAndRead();

    ASSERT_EQ(copy->GetRootNode()->GetChildCount(), 1);
    EXPECT_STREQ(childOf(copy)->GetName(), "own");
    FbxGlobalCameraSettings& back = copy->GlobalCameraSettings();
    if (GetParam().hasIds()) {
        EXPECT_EQ(back.GetCameraProducerTop(), nullptr);
        EXPECT_EQ(copy->GetSrcObjectCount<FbxCamera>(), 1);
        return;
    }
    ASSERT_NE(back.GetCameraProducerTop(), nullptr);
    EXPECT_EQ(back.GetCameraProducerTop()->FarPlane.Get(), 777.0);
    EXPECT_NE(back.GetCameraProducerPerspective(), nullptr);
    EXPECT_NE(back.GetCameraProducerBottom(), nullptr);
    EXPECT_NE(back.GetCameraSwitcher(), nullptr);
}

TEST_P(SceneWriting, ListsOnlyPropertiesThatDiffer) {
    addNode("node", make<FbxCamera>("camera"));
    addNode("other", make<FbxNull>("null"));

    const std::string bytes = write();

    // Once in a template where there are templates, else on each object.
    std::size_t count = 0;
    for (std::size_t at = bytes.find("2D Magnifier Zoom"); at != std::string::npos;
         at = bytes.find("2D Magnifier Zoom", at + 1))
        ++count;
    EXPECT_EQ(count, 1U);
}

TEST_P(SceneWriting, GivesTheSameBytesForTheSameSceneAndTime) {
    setenv("SOURCE_DATE_EPOCH", "1585690463", 1);
    addNode("b", make<FbxCamera>("camera"));
    addNode("a", make<FbxLight>("light"));

    const std::string first = exporting::ExportFixture::write(GetParam(), "first.fbx");
    const std::string second = exporting::ExportFixture::write(GetParam(), "another name.fbx");
    FbxScene* const original = scene;
    scene = read("first.fbx");
    const std::string again = exporting::ExportFixture::write(GetParam(), "again.fbx");
    scene = original;
    unsetenv("SOURCE_DATE_EPOCH");

    EXPECT_TRUE(first == second);
    EXPECT_TRUE(first == again);
}

TEST_P(SceneWriting, StatesTheTimeItIsGiven) {
    setenv("SOURCE_DATE_EPOCH", "1585690463", 1); // 2020-03-31 21:34:23

    const std::string bytes = write();

    unsetenv("SOURCE_DATE_EPOCH");
    if (GetParam().format == 1) {
        EXPECT_NE(bytes.find("Year: 2020\n\t\tMonth: 3\n\t\tDay: 31\n\t\tHour: 21\n\t\tMinute: 34\n\t\tSecond: 23"),
                  std::string::npos);
    } else {
        EXPECT_NE(bytes.find("2020-03-31 21:34:23:000"), std::string::npos);
    }
    EXPECT_NE(bytes.find("31/03/2020 21:34:23.000"), std::string::npos);
}

TEST_P(SceneWriting, LeavesTheSceneAsItWas) {
    FbxNode* node = addNode("node", make<FbxCamera>("camera"));
    scene->GlobalCameraSettings().CreateProducerCameras();
    const int members = scene->GetSrcObjectCount();
    const int nodes = scene->GetNodeCount();

    write();

    EXPECT_EQ(scene->GetSrcObjectCount(), members);
    EXPECT_EQ(scene->GetNodeCount(), nodes);
    EXPECT_EQ(node->GetParent(), scene->GetRootNode());
}

TEST_P(SceneWriting, WritesUnparentedNodes) {
    make<FbxNode>("adrift");

    FbxScene* copy = writeAndRead();

    ASSERT_EQ(copy->GetRootNode()->GetChildCount(), 1); // readers put them below the root
    EXPECT_STREQ(childOf(copy)->GetName(), "adrift");
}

TEST_P(SceneWriting, WritesATreeOfAThousandLevels) {
    FbxNode* parent = scene->GetRootNode();
    for (int i = 0; i < 1000; ++i) {
        FbxNode* node = make<FbxNode>("n");
        parent->AddChild(node);
        parent = node;
    }

    FbxScene* copy = writeAndRead();

    int depth = 0;
    for (FbxNode* node = copy->GetRootNode(); node->GetChildCount() > 0; node = node->GetChild(0))
        ++depth;
    EXPECT_EQ(depth, 1000);
}

TEST_P(SceneWriting, WritesAPropertyThatIsStoredWithItsDefaultLikeOneThatWasNeverSet) {
    setenv("SOURCE_DATE_EPOCH", "1585690463", 1);
    std::vector<FbxObject*> objects;
    for (const detail::SchemaClass& row : detail::schemaClasses())
        if (row.info->construct)
            objects.push_back(detail::ManagerData::createObject(scene, row.classId(), "object"));
    const std::string untouched = write();

    for (FbxObject* object : objects)
        for (const detail::PropertyRow& row : object->data().info->rows)
            object->data().materialise(detail::rowIndex(object->data().info->rows, row.name));

    EXPECT_TRUE(write() == untouched);
    unsetenv("SOURCE_DATE_EPOCH");
}

} // namespace
