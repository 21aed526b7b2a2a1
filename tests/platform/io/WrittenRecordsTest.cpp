// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The order of records, and how their values are stored: as in the files of the applications, because simple
// readers rely on both.
#include "io/SceneWriting.h"

#include <algorithm>
#include <cmath>
#include <memory>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxMarker.h>
#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxNurbsCurve.h>
#include <fbxsdk/FbxNurbsSurface.h>
#include <fbxsdk/FbxSkin.h>
#include <fbxsdk/FbxSurfaceMaterial.h>
#include <fbxsdk/FbxTrimNurbsSurface.h>

#include <gmock/gmock.h>

#include "ExportFixture.h"
#include "container/Record.h"
#include "schema/PropertyTypes.h"
#include "schema/Schema.h"

namespace {

using namespace fbxsdk;
using detail::Record;
using exporting::Layout;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::IsSupersetOf;
using testing::Not;
using Names = std::vector<std::string>;

constexpr Layout kOldText{"FBX201000", 1}, kOldBinary{"FBX201000", 0}, kNewText{"FBX201600", 1};

class WrittenRecords : public exporting::ExportFixture {
protected:
    /// Writes the scene and parses the file into its records.
    const Record& records(const Layout& layout) {
        write(layout);
        FbxStatus status;
        mTree = detail::readRecords(folder.file("out.fbx"), status);
        EXPECT_TRUE(mTree) << status.GetErrorString();
        return mTree->root;
    }

    /// The record below Objects whose first text after an id is that class and whose last one is that subclass.
    static const Record& object(const Record& root, std::string_view record, std::string_view subClass) {
        for (const Record& each : root.child("Objects")->children())
            if (each.name == record && !each.values.empty() && each.values.back().toText() == subClass)
                return each;
        ADD_FAILURE() << "no " << record << ' ' << subClass;
        return root;
    }

    static Names childNames(const Record& parent) {
        Names names;
        for (const Record& child : parent.children())
            names.emplace_back(child.name);
        return names;
    }

    /// The names of an object's properties.
    static Names propertyNames(const Record& object) {
        Names names;
        for (const std::string_view list : {"Properties60", "Properties70"}) {
            const Record* properties = object.child(list);
            for (const Record* property = properties ? properties->firstChild : nullptr; property;
                 property = property->nextSibling)
                names.emplace_back(property->value(0).toText());
        }
        return names;
    }

    /// A property's texts but the first, which is its name.
    static Names propertyTexts(const Record& object, std::string_view name) {
        for (const std::string_view list : {"Properties60", "Properties70"}) {
            const Record* properties = object.child(list);
            for (const Record* property = properties ? properties->firstChild : nullptr; property;
                 property = property->nextSibling) {
                if (property->value(0).toText() != name)
                    continue;
                Names texts;
                for (std::size_t i = 1;
                     i < property->values.size() && property->values[i].type == detail::Value::Type::text; ++i)
                    texts.emplace_back(property->values[i].toText());
                return texts;
            }
        }
        ADD_FAILURE() << "no property " << name;
        return {};
    }

    static void userProperty(FbxObject& object, const char* name, const FbxDataType& type, bool animatable) {
        FbxProperty property = FbxProperty::Create(&object, type, name, "");
        property.ModifyFlag(FbxPropertyFlags::eUserDefined, true);
        property.ModifyFlag(FbxPropertyFlags::eAnimatable, animatable);
    }

private:
    std::unique_ptr<detail::RecordTree> mTree;
};

TEST_F(WrittenRecords, SpellATypeByWhetherItMayBeAnimated) {
    struct Row {
        const FbxDataType& type;
        Names fixed, animatable;
    };
    const Row rows[] = {{FbxDoubleDT, {"double", "Number", "U"}, {"Number", "", "AU"}},
                        {FbxDouble3DT, {"Vector3D", "Vector", "U"}, {"Vector", "", "AU"}},
                        {FbxColor3DT, {"ColorRGB", "Color", "U"}, {"Color", "", "AU"}},
                        {FbxBoolDT, {"bool", "", "U"}, {"Bool", "", "AU"}},
                        {FbxIntDT, {"int", "Integer", "U"}, {"Integer", "", "AU"}},
                        {FbxEnumDT, {"enum", "", "U"}, {"Enum", "", "AU"}},
                        {FbxNumberDT, {"double", "Number", "U"}, {"Number", "", "AU"}},
                        {FbxShortDT, {"Short", "", "U"}, {"Short", "", "AU"}}};
    FbxNode* node = addNode("node", make<FbxNull>("null"));
    for (const Row& row : rows) {
        for (const bool animatable : {false, true}) {
            const std::string name = std::string(row.type.GetName()) + (animatable ? " moving" : " fixed");
            userProperty(*node, name.c_str(), row.type, animatable);
            EXPECT_EQ(propertyTexts(object(records(kNewText), "Model", "Null"), name),
                      animatable ? row.animatable : row.fixed);
        }
    }
}

TEST_F(WrittenRecords, GiveAnimatableTypesToAttributesThatFilesMadeAnimatable) {
    auto* camera = make<FbxCamera>("camera");
    addNode("node", camera);
    camera->FilmWidth.ModifyFlag(FbxPropertyFlags::eAnimatable, true);

    EXPECT_THAT(propertyTexts(object(records(kNewText), "NodeAttribute", "Camera"), "FilmWidth"),
                ElementsAre("Number", "", "A"));
    EXPECT_THAT(propertyTexts(object(records(kOldText), "Model", "Camera"), "FilmWidth"), ElementsAre("Number", "AN"));
}

TEST_F(WrittenRecords, KeepTheReachOfAnEffector) {
    auto* marker = make<FbxMarker>("effector");
    marker->SetType(FbxMarker::eEffectorIK);
    addNode("node", marker);
    for (const char* type : {"IK Reach Translation", "IK Reach Rotation"})
        FbxProperty::Create(marker, detail::dataTypeOf(type, ""), type, "").Set(62.5);

    for (const Layout& layout : {kOldText, kNewText}) {
        const Record& written = object(records(layout), layout.hasIds() ? "NodeAttribute" : "Model", "IKEffector");
        EXPECT_EQ(propertyTexts(written, "IK Reach Translation").front(), "IK Reach Translation");
        FbxNodeAttribute* back = read()->GetRootNode()->GetChild(0)->GetNodeAttribute();
        EXPECT_EQ(back->FindProperty("IK Reach Translation").Get<FbxDouble>(), 62.5);
        EXPECT_EQ(back->FindProperty("IK Reach Rotation").Get<FbxDouble>(), 62.5);
    }
}

TEST_F(WrittenRecords, PutTextureCoordinatesBetweenColoursAndMaterials) {
    auto* mesh = make<FbxMesh>("mesh");
    mesh->InitControlPoints(3);
    mesh->BeginPolygon();
    for (int i = 0; i < 3; ++i)
        mesh->AddPolygon(i);
    mesh->EndPolygon();
    FbxLayer& layer = *mesh->GetLayer(mesh->CreateLayer());
    layer.SetMaterials(FbxLayerElementMaterial::Create(mesh, ""));
    layer.SetSmoothing(FbxLayerElementSmoothing::Create(mesh, ""));
    layer.SetUVs(FbxLayerElementUV::Create(mesh, "map"));
    layer.SetVertexColors(FbxLayerElementVertexColor::Create(mesh, ""));
    layer.SetNormals(FbxLayerElementNormal::Create(mesh, ""));
    addNode("node", mesh);

    Names elements = childNames(object(records(kNewText), "Geometry", "Mesh"));
    std::erase_if(elements, [](const std::string& name) { return !name.starts_with("Layer"); });
    EXPECT_THAT(elements, ElementsAre("LayerElementNormal", "LayerElementColor", "LayerElementUV",
                                      "LayerElementSmoothing", "LayerElementMaterial", "Layer"));
}

TEST_F(WrittenRecords, PutTheDirectionOfNormalsBehindTheLayersOfASurface) {
    auto* surface = make<FbxNurbsSurface>("surface");
    surface->InitControlPoints(4, FbxNurbsSurfaceBase::eOpen, 4, FbxNurbsSurfaceBase::eOpen);
    surface->GetLayer(surface->CreateLayer())->SetMaterials(FbxLayerElementMaterial::Create(surface, ""));
    addNode("node", surface);

    const Names names = childNames(object(records(kNewText), "Geometry", "NurbsSurface"));
    EXPECT_EQ(names.back(), "FlipNormals");
    EXPECT_EQ(std::count(names.begin(), names.end(), "FlipNormals"), 1);
    EXPECT_THAT(names, IsSupersetOf({"Layer"}));
}

TEST_F(WrittenRecords, StateTheVersionOfATrimmedSurfaceFirst) {
    addNode("node", make<FbxTrimNurbsSurface>("trimmed"));

    EXPECT_THAT(childNames(object(records(kNewText), "Geometry", "TrimNurbsSurface")),
                ElementsAre("TrimmedNurbVersion", "Type", "FlipNormals"));
}

TEST_F(WrittenRecords, StateTheStepOfACurveOnlyWhereItIsUnusual) {
    auto* curve = make<FbxNurbsCurve>("curve");
    curve->InitControlPoints(4, FbxNurbsCurve::eOpen);
    addNode("node", curve);

    EXPECT_EQ(object(records(kNewText), "Geometry", "NurbsCurve").child("Step"), nullptr);
    curve->SetStep(9);
    EXPECT_EQ(object(records(kNewText), "Geometry", "NurbsCurve").childValue("Step").toInteger(), 9);
}

TEST_F(WrittenRecords, ListTheFourTimesOfAStackInOneOrder) {
    auto* stack = make<FbxAnimStack>("stack");
    stack->LocalStop.Set(FbxTime(1000)); // the start stays at its default

    EXPECT_THAT(propertyNames(object(records(kNewText), "AnimationStack", "")),
                ElementsAre("LocalStart", "LocalStop", "ReferenceStart", "ReferenceStop"));
}

TEST_F(WrittenRecords, NameAShadingModelOnce) {
    auto* material = make<FbxSurfacePhong>("material");
    material->ShadingModel.Set("phong");
    addNode("node", make<FbxNull>("null"))->AddMaterial(material);

    const Record& written = object(records(kNewText), "Material", "");
    EXPECT_EQ(written.childValue("ShadingModel").toText(), "phong");
    EXPECT_THAT(propertyNames(written), Not(testing::Contains("ShadingModel")));
    EXPECT_THAT(propertyNames(object(records(kOldText), "Material", "")), testing::Contains("ShadingModel"));
}

TEST_F(WrittenRecords, OfOldFilesAreInTheOrderOfTheirKinds) {
    auto* mesh = make<FbxMesh>("mesh");
    mesh->AddDeformer(make<FbxSkin>("skin"));
    addNode("mesh", mesh)->AddMaterial(make<FbxSurfacePhong>("material"));
    make<FbxCamera>("nowhere");
    addNode("curve", make<FbxNurbsCurve>("curve"));

    const Record& root = records(kOldText);

    EXPECT_THAT(childNames(*root.child("Objects")), ElementsAre("Model", "Model", "NodeAttribute", "Geometry",
                                                                "SceneInfo", "Material", "Deformer", "GlobalSettings"));
    Names counted;
    for (const Record& kind : root.child("Definitions")->children())
        if (kind.name == "ObjectType")
            counted.emplace_back(kind.value(0).toText());
    EXPECT_THAT(counted, ElementsAre("Model", "Material", "SceneInfo", "GlobalSettings", "NodeAttribute", "Geometry",
                                     "Deformer"));
}

TEST_F(WrittenRecords, OfAnAttributeByItselfAreItsPropertiesAndItsName) {
    make<FbxCamera>("nowhere");

    const Record& camera = object(records(kOldText), "NodeAttribute", "Camera");

    EXPECT_THAT(childNames(camera), ElementsAre("Properties60", "NodeAttributeName"));
    EXPECT_EQ(camera.childValue("NodeAttributeName").toText(), camera.value(0).toText());
}

TEST_F(WrittenRecords, OfOldFilesHaveNoNewerPropertyThatGoesWithoutSaying) {
    auto* light = make<FbxLight>("light");
    FbxNode* node = addNode("node", light);
    const auto newer = IsSupersetOf({"Visibility Inheritance", "LeftBarnDoor"});

    EXPECT_THAT(propertyNames(object(records(kOldText), "Model", "Light")), Not(testing::Contains("EnableBarnDoor")));
    EXPECT_THAT(propertyNames(object(records(kOldText), "Model", "Light")),
                Not(testing::Contains("Visibility Inheritance")));

    node->FindProperty("Visibility Inheritance").Set(false);
    light->FindProperty("LeftBarnDoor").Set(5.0);
    EXPECT_THAT(propertyNames(object(records(kOldText), "Model", "Light")), newer);
}

TEST_F(WrittenRecords, OfOldFilesListEveryPropertyWhicheverOfThemDiffer) {
    constexpr double kOther = 7.5;
    std::vector<const char*> numbers;
    for (const detail::PropertyRow& row : detail::kNodeRows)
        if (row.type->GetType() == eFbxDouble)
            numbers.push_back(row.name);
    ASSERT_GE(numbers.size(), 20U); // so that the lines in between are more runs than are kept
    const FbxNode* plain = addNode("plain");
    for (std::size_t first = 0; first < numbers.size(); ++first) {
        for (std::size_t second = first; second < numbers.size(); ++second) {
            FbxNode* node = addNode((std::to_string(first) + ' ' + std::to_string(second)).c_str());
            node->FindProperty(numbers[first]).Set(kOther);
            node->FindProperty(numbers[second]).Set(kOther);
        }
    }

    for (const Layout& layout : {kOldText, kOldBinary}) {
        FbxScene* copy = writeAndRead(layout);
        const Record& objects = *records(layout).child("Objects");
        const Names all = propertyNames(*objects.child("Model"));
        for (const Record& each : objects.children())
            ASSERT_TRUE(each.name != "Model" || propertyNames(each) == all) << each.value(0).toText();
        for (int i = 1; i < copy->GetRootNode()->GetChildCount(); ++i) {
            FbxNode* node = copy->GetRootNode()->GetChild(i);
            std::size_t first = 0, second = 0;
            std::istringstream(node->GetName()) >> first >> second;
            for (std::size_t number = 0; number < numbers.size(); ++number)
                ASSERT_EQ(node->FindProperty(numbers[number]).Get<FbxDouble>(),
                          number == first || number == second ? kOther
                                                              : plain->FindProperty(numbers[number]).Get<FbxDouble>())
                    << node->GetName();
        }
    }
}

TEST_F(WrittenRecords, OfOldFilesKeepNegativeZeros) {
    FbxNode* node = addNode("node");
    node->LclRotation.Set({1.0, 1.0, 1.0});
    node->LclRotation.Set({0.0, -0.0, 0.0});

    for (const Layout& layout : {kOldText, kOldBinary}) {
        const Record* property = records(layout).child("Objects")->child("Model")->child("Properties60")->firstChild;
        while (property && property->value(0).toText() != "Lcl Rotation")
            property = property->nextSibling;
        ASSERT_NE(property, nullptr);
        EXPECT_FALSE(std::signbit(property->value(3).toReal()));
        EXPECT_TRUE(std::signbit(property->value(4).toReal()));
    }
}

TEST_F(WrittenRecords, OfAnOldLightEndWithTheAngles) {
    addNode("node", make<FbxLight>("light"));

    const Names names = propertyNames(object(records(kOldText), "Model", "Light"));

    ASSERT_GE(names.size(), 2U);
    EXPECT_EQ(names[names.size() - 2], "HotSpot");
    EXPECT_EQ(names.back(), "Cone angle");
}

TEST_F(WrittenRecords, OfTheHeadAreThoseOfOldFiles) {
    const Record& head = *records(kOldBinary).child("FBXHeaderExtension");
    EXPECT_EQ(head.childValue("EncryptionType").type, detail::Value::Type::integer);
    EXPECT_EQ(head.child("CurrentCameraResolution")->childValue("CameraResolutionW").type, detail::Value::Type::real);

    EXPECT_EQ(records(kOldText).child("FBXHeaderExtension")->child("EncryptionType"), nullptr);
}

} // namespace
