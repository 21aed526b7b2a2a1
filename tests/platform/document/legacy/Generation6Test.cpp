// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files of the 6.x generation: one Model record becomes a Model and its attribute.
#include "platform/document/DocumentFromText.h"

namespace fbxsdk::detail {
namespace {

const DocumentObject* attributeOf(const Document& document, std::string_view model) {
    const std::int64_t id = idOf(document, "Model", model);
    for (const DocumentConnection& edge : document.connections)
        if (const DocumentObject* source = document.find(edge.source);
            edge.destination == id && source && (source->record == "NodeAttribute" || source->record == "Geometry"))
            return source;
    return nullptr;
}

TEST(Generation6, SplitsACameraIntoModelAndAttribute) {
    const auto document = documentOf("6.1.0", R"(
        Objects: { Model: "Model::cam", "Camera" {
            Properties60: {
                Property: "Lcl Translation", "Lcl Translation", "A",1,2,3
                Property: "note", "KString", "U", "mine"
                Property: "FocalLength", "Number", "A+N",35
                Property: "NearPlane", "double", "N",0.5
            }
            TypeFlags: "Camera"
            Position: 1,2,3
            NodeAttributeName: "NodeAttribute::cam_ncl1_1"
        } }
        Connections: { Connect: "OO", "Model::cam", "Model::Scene" })");
    const DocumentObject* model = objectNamed(*document, "Model", "cam");
    const DocumentObject* attribute = attributeOf(*document, "cam");
    ASSERT_TRUE(model && attribute);
    EXPECT_EQ(model->subClass, "Camera");
    EXPECT_EQ(numbersOf(model, "Lcl Translation"), (Numbers{1, 2, 3}));
    EXPECT_NE(model->property("note"), nullptr);
    EXPECT_EQ(model->property("FocalLength"), nullptr);
    EXPECT_EQ(attribute->record, "NodeAttribute");
    EXPECT_EQ(attribute->subClass, "Camera");
    EXPECT_EQ(attribute->name, "cam_ncl1_1");
    EXPECT_EQ(numbersOf(attribute, "FocalLength"), (Numbers{35}));
    EXPECT_EQ(attribute->property("FocalLength")->flags, "A+");
    EXPECT_EQ(attribute->property("NearPlane")->subTypeName, "Number");
    EXPECT_EQ(numbersOf(attribute->body->child("Position")), (Numbers{1, 2, 3}));
    EXPECT_TRUE(isConnected(*document, model->id, 0));
}

TEST(Generation6, FindsTheAttributesPropertiesWithoutFlags) {
    const auto document = documentOf("6.1.0", R"(
        Objects: { Model: "Model::lamp", "Light" {
            Properties60: {
                Property: "Lcl Rotation", "Lcl Rotation", "A+",1,2,3
                Property: "Intensity", "Intensity", "A+",70
                Property: "Cone angle", "Cone angle", "A+",30
                Property: "HotSpot", "HotSpot", "A+",20
            }
            TypeFlags: "Light"
        } })");
    const DocumentObject* attribute = attributeOf(*document, "lamp");
    EXPECT_EQ(numbersOf(attribute, "Intensity"), (Numbers{70}));
    EXPECT_EQ(numbersOf(attribute, "OuterAngle"), (Numbers{30}));
    EXPECT_EQ(numbersOf(attribute, "InnerAngle"), (Numbers{20}));
    EXPECT_NE(objectNamed(*document, "Model", "lamp")->property("Lcl Rotation"), nullptr);
}

TEST(Generation6, GivesOldCameraPropertiesTheirPresentNames) {
    const auto document = documentOf("6.1.0", R"(
        Objects: { Model: "Model::c", "Camera" { Properties60: {
            Property: "AspectW", "double", "",320
            Property: "ResolutionMode", "enum", "",2 } } })");
    EXPECT_EQ(numbersOf(attributeOf(*document, "c"), "AspectWidth"), (Numbers{320}));
    EXPECT_EQ(numbersOf(attributeOf(*document, "c"), "AspectRatioMode"), (Numbers{2}));
}

TEST(Generation6, MakesAGeometryOfAMesh) {
    const auto document = documentOf("6.1.0", R"(
        Objects: { Model: "Model::box", "Mesh" {
            Properties60: { Property: "Color", "ColorRGB", "N",0.8,0.8,0.8 }
            Vertices: 0,0,0,1,0,0,0,1,0
            PolygonVertexIndex: 0,1,-3
            LayerElementNormal: 0 { MappingInformationType: "ByPolygonVertex" }
        } })");
    const DocumentObject* geometry = attributeOf(*document, "box");
    ASSERT_NE(geometry, nullptr);
    EXPECT_EQ(geometry->record, "Geometry");
    EXPECT_EQ(geometry->subClass, "Mesh");
    EXPECT_EQ(geometry->body->child("Vertices")->numberCount(), 9U);
    EXPECT_NE(geometry->body->child("LayerElementNormal"), nullptr);
    EXPECT_EQ(numbersOf(geometry, "Color"), (Numbers{0.8, 0.8, 0.8}));
}

TEST(Generation6, ANullHasAnAttributeOnlyWhenTheFileSaysSo) {
    const auto document = documentOf("6.1.0", R"(
        Objects: {
            Model: "Model::plain", "Null" { Properties60: { Property: "Show", "bool", "",1 } }
            Model: "Model::flags", "Null" { TypeFlags: "Null" }
            Model: "Model::named", "Null" { NodeAttributeName: "NodeAttribute::n" }
            Model: "Model::size", "Null" { Properties60: { Property: "Size", "double", "N",5 } }
            Model: "Model::none", "" { }
            Model: "Model::typed", "" { TypeFlags: "Null" }
        })");
    EXPECT_EQ(attributeOf(*document, "plain"), nullptr);
    EXPECT_NE(attributeOf(*document, "flags"), nullptr);
    EXPECT_NE(attributeOf(*document, "named"), nullptr);
    EXPECT_NE(attributeOf(*document, "size"), nullptr);
    EXPECT_EQ(attributeOf(*document, "none"), nullptr);
    EXPECT_NE(attributeOf(*document, "typed"), nullptr);
}

TEST(Generation6, WithoutAttributeAllPropertiesAreTheModels) {
    const auto document = documentOf("6.1.0", R"(
        Objects: { Model: "Model::plain", "Null" { Properties60: { Property: "odd", "double", "",5 } } })");
    EXPECT_EQ(numbersOf(objectNamed(*document, "Model", "plain"), "odd"), (Numbers{5}));
}

TEST(Generation6, UsesTheGeometryOfARecordOfItsOwn) {
    const auto document = documentOf("6.1.0", R"(
        Objects: {
            Model: "Model::curve", "NurbsCurve" { }
            Geometry: "Geometry::curve", "NurbsCurve" { Order: 4 }
            Deformer: "Deformer::skin", "Skin" { }
        }
        Connections: {
            Connect: "OO", "Deformer::skin", "Model::curve"
            Connect: "OO", "Geometry::curve", "Model::curve"
        })");
    EXPECT_EQ(document->objects.size(), 3U);
    const std::int64_t geometry = idOf(*document, "Geometry", "curve");
    EXPECT_TRUE(isConnected(*document, geometry, idOf(*document, "Model", "curve")));
    EXPECT_TRUE(isConnected(*document, idOf(*document, "Deformer", "skin"), geometry));
}

const std::string kInstances = R"(
    Objects: {
        Model: "Model::a", "Mesh" { Version: 232
            Properties60: { Property: "Color", "ColorRGB", "N",1,0,0 }
            Shading: T
            Vertices: 0,0,0
            NodeAttributeName: "Geometry::shared" }
        Model: "Model::b", "Mesh" { Version: 232
            Properties60: { Property: "Lcl Translation", "Lcl Translation", "A",5,0,0
                            Property: "Color", "ColorRGB", "N",1,0,0 }
            Shading: Y
            Vertices: 0,0,0
            NodeAttributeName: "Geometry::shared" }
        Model: "Model::other points", "Mesh" { Version: 232
            Properties60: { Property: "Color", "ColorRGB", "N",1,0,0 }
            Vertices: 0,0,1
            NodeAttributeName: "Geometry::shared" }
        Model: "Model::other colour", "Mesh" { Version: 232
            Properties60: { Property: "Color", "ColorRGB", "N",0,0,0 }
            Vertices: 0,0,0
            NodeAttributeName: "Geometry::shared" }
        Model: "Model::other name", "Mesh" { Version: 232
            Properties60: { Property: "Color", "ColorRGB", "N",1,0,0 }
            Vertices: 0,0,0
            NodeAttributeName: "Geometry::own" }
        Model: "Model::skinned", "Mesh" { Version: 232
            Properties60: { Property: "Color", "ColorRGB", "N",1,0,0 }
            Vertices: 0,0,0
            NodeAttributeName: "Geometry::shared" }
        Deformer: "Deformer::s", "Skin" { }
    }
    Connections: { Connect: "OO", "Deformer::s", "Model::skinned" })";

TEST(Generation6, ModelsWithEqualAttributesOfOneNameAreInstances) {
    const auto document = documentOf("6.1.0", kInstances);
    EXPECT_EQ(attributeOf(*document, "a"), attributeOf(*document, "b"));
}

TEST(Generation6, ModelsWithDifferentAttributesOfOneNameAreNone) {
    const auto document = documentOf("6.1.0", kInstances);
    const DocumentObject* first = attributeOf(*document, "a");
    EXPECT_NE(attributeOf(*document, "other points"), first);
    EXPECT_NE(attributeOf(*document, "other colour"), first);
    EXPECT_NE(attributeOf(*document, "other name"), first);
    EXPECT_NE(attributeOf(*document, "skinned"), first);
    EXPECT_EQ(numbersOf(attributeOf(*document, "other points")->body->child("Vertices")), (Numbers{0, 0, 1}));
}

TEST(Generation6, LeadsDeformersToTheGeometryAndMaterialsToTheModel) {
    const auto document = documentOf("6.1.0", R"(
        Objects: {
            Model: "Model::m", "Mesh" { Vertices: 0,0,0 }
            Model: "Model::bone", "LimbNode" { }
            Material: "Material::red", "" { ShadingModel: "phong"
                Properties60: { Property: "DiffuseColor", "Color", "A",1,0,0 } }
            Deformer: "Deformer::Skin m", "Skin" { }
            Deformer: "SubDeformer::c", "Cluster" { Indexes: 0
                Weights: 1 }
        }
        Connections: {
            Connect: "OO", "Model::m", "Model::Scene"
            Connect: "OO", "Material::red", "Model::m"
            Connect: "OO", "Deformer::Skin m", "Model::m"
            Connect: "OO", "SubDeformer::c", "Deformer::Skin m"
            Connect: "OO", "Model::bone", "SubDeformer::c"
        })");
    const std::int64_t model = idOf(*document, "Model", "m");
    const std::int64_t skin = idOf(*document, "Deformer", "Skin m");
    const std::int64_t cluster = idOf(*document, "Deformer", "c");
    EXPECT_TRUE(isConnected(*document, skin, attributeOf(*document, "m")->id));
    EXPECT_FALSE(isConnected(*document, skin, model));
    EXPECT_TRUE(isConnected(*document, idOf(*document, "Material", "red"), model));
    EXPECT_TRUE(isConnected(*document, cluster, skin));
    EXPECT_TRUE(isConnected(*document, idOf(*document, "Model", "bone"), cluster));
    EXPECT_EQ(numbersOf(objectNamed(*document, "Material", "red"), "DiffuseColor"), (Numbers{1, 0, 0}));
}

TEST(Generation6, LeadsPropertyConnectionsToTheOwnerOfTheProperty) {
    const auto document = documentOf("6.1.0", R"(
        Objects: {
            Model: "Model::stereo", "CameraStereo" {
                Properties60: { Property: "LeftCamera", "object", "N"
                                Property: "LookAtProperty", "object", "" }
                NodeAttributeName: "NodeAttribute::rig" }
            Model: "Model::target", "Null" { }
            NodeAttribute: "NodeAttribute::left", "Camera" { Properties60: { Property: "FarPlane", "double", "N",9 } }
        }
        Connections: {
            Connect: "OP", "NodeAttribute::left", "Model::stereo", "LeftCamera"
            Connect: "OP", "Model::target", "Model::stereo", "LookAtProperty"
            Connect: "PP", "NodeAttribute::rig", "FarPlane", "NodeAttribute::left", "FarPlane"
            Connect: "PO", "NodeAttribute::left", "FarPlane", "Model::target"
        })");
    const std::int64_t rig = attributeOf(*document, "stereo")->id;
    const std::int64_t left = idOf(*document, "NodeAttribute", "left");
    EXPECT_TRUE(isConnected(*document, left, rig, "LeftCamera"));
    EXPECT_TRUE(isConnected(*document, idOf(*document, "Model", "target"), idOf(*document, "Model", "stereo"),
                            "LookAtProperty"));
    EXPECT_TRUE(isConnected(*document, rig, left, "FarPlane"));
    EXPECT_EQ(document->find(left)->property("FarPlane")->flags, "");
}

TEST(Generation6, KeepsTheFirstOfTwoObjectsOfOneName) {
    const auto document = documentOf("6.1.0", R"(
        Objects: { Model: "Model::m", "Mesh" { Vertices: 0,0,0 }
                   Model: "Model::m", "Light" { } })");
    EXPECT_EQ(document->objects.size(), 2U); // the mesh and its geometry
    EXPECT_EQ(objectNamed(*document, "Model", "m")->subClass, "Mesh");
    EXPECT_TRUE(warnsOf(*document, "\"Model::m\" already exists"));
}

TEST(Generation6, UnknownEndsAreNotTakenForTheRoot) {
    const auto document = documentOf("6.1.0", R"(
        Objects: { Model: "Model::a", "Null" { }
                   Model: "Model::b", "Null" { } }
        Connections: { Connect: "OO", "Model::a", "Model::gone"
                       Connect: "OO", "Model::gone", "Model::a"
                       Connect: "OO", "Model::b", "Model::Scene" })");
    EXPECT_EQ(sourceNames(*document, 0, "Model"), (Names{"b", "a"}));
    EXPECT_TRUE(warnsOf(*document, "2 connections refer to objects that do not exist"));
}

TEST(Generation6, ReadsSettingsFromObjectsAndTheTail) {
    const auto document = documentOf("6.1.0", R"(
        Objects: { GlobalSettings: { Properties60: { Property: "UpAxis", "int", "",1
                                                     Property: "TimeMode", "enum", "",11 } } }
        Version5: {
            AmbientRenderSettings: { AmbientLightColor: 0.1,0.2,0.3,1 }
            FogOptions: { FlogEnable: 1
                FogMode: 2
                FogDensity: 0.5
                FogStart: 3
                FogEnd: 4
                FogColor: 0.5,0.25,0,1 }
            Settings: { FrameRate: "30"
                TimeLineStopTime: 77 }
            RendererSetting: { DefaultCamera: "Producer Top" } })");
    EXPECT_EQ(numbersOf(settingNamed(*document, "UpAxis")), (Numbers{1}));
    EXPECT_EQ(numbersOf(settingNamed(*document, "TimeMode")), (Numbers{11}));
    EXPECT_EQ(settingNamed(*document, "DefaultCamera")->values[0].toText(), "Producer Top");
    EXPECT_EQ(numbersOf(settingNamed(*document, "TimeSpanStop")), (Numbers{77}));
    const DocumentLightSettings& light = document->lightSettings;
    EXPECT_TRUE(light.hasAmbient && light.hasFog && light.fogEnable);
    EXPECT_EQ(light.ambientColor[2], 0.3);
    EXPECT_EQ(light.fogMode, 2);
    EXPECT_EQ(light.fogDensity, 0.5);
    EXPECT_EQ(light.fogStart, 3);
    EXPECT_EQ(light.fogEnd, 4);
    EXPECT_EQ(light.fogColor[1], 0.25);
}

TEST(Generation6, AcceptsTheOtherSpellingOfTheFogSwitchAndClampsItsMode) {
    const auto document = documentOf("6.1.0", R"(
        Version5: { FogOptions: { FogEnable: 1
                                  FogMode: 77 } })");
    EXPECT_TRUE(document->lightSettings.fogEnable);
    EXPECT_EQ(document->lightSettings.fogMode, 2);
    EXPECT_EQ(document->lightSettings.fogDensity, 0.002);
    EXPECT_FALSE(document->lightSettings.hasAmbient);
}

TEST(Generation6, MakesATimeModeOfTheFrameRate) {
    const std::pair<const char*, double> kRates[] = {{"\"24\"", 11}, {"\"29.97\"", 9}, {"60", 3}, {"\"30\"", 6}};
    for (const auto& [rate, mode] : kRates) {
        const auto document =
            documentOf("6.1.0", std::string("Objects: { }\nVersion5: { Settings: { FrameRate: ") + rate + " } }");
        EXPECT_EQ(numbersOf(settingNamed(*document, "TimeMode")), (Numbers{mode})) << rate;
    }
}

TEST(Generation6, AnOddFrameRateIsACustomOne) {
    const auto document = documentOf("6.1.0", "Objects: { }\nVersion5: { Settings: { FrameRate: \"12.5\" } }");
    EXPECT_EQ(numbersOf(settingNamed(*document, "TimeMode")), (Numbers{14}));
    EXPECT_EQ(numbersOf(settingNamed(*document, "CustomFrameRate")), (Numbers{12.5}));
}

TEST(Generation6, IgnoresFrameRatesThatAreNone) {
    for (const char* rate : {"\"\"", "\"fast\"", "0", "-3", "\"nan\"", "\"inf\""}) {
        const auto document =
            documentOf("6.1.0", std::string("Objects: { }\nVersion5: { Settings: { FrameRate: ") + rate + " } }");
        EXPECT_EQ(settingNamed(*document, "TimeMode"), nullptr) << rate;
    }
}

TEST(Generation6, NumbersTheNodesOfAPose) {
    const auto document = documentOf("6.1.0", R"(
        Objects: { Pose: "Pose::bind", "BindPose" { NbPoseNodes: 2
                       PoseNode: { Node: "Model::m"
                                   Matrix: 1,0,0,0,0,1,0,0,0,0,1,0,0,0,0,1 }
                       PoseNode: { Node: "Model::gone" } }
                   Model: "Model::m", "Null" { } })");
    const DocumentObject* pose = objectNamed(*document, "Pose", "bind");
    const Record* node = pose->body->child("PoseNode");
    ASSERT_NE(node, nullptr);
    EXPECT_EQ(node->childValue("Node").toInteger(), idOf(*document, "Model", "m"));
    EXPECT_EQ(node->child("Matrix")->numberCount(), 16U);
    EXPECT_EQ(node->nextSibling->childValue("Node").toInteger(), 0);
    EXPECT_EQ(pose->body->childValue("NbPoseNodes").toInteger(), 2);
}

TEST(Generation6, LeavesTheViewsUnconnected) {
    const auto document = documentOf("6.1.0", R"(
        Objects: { Model: "Model::Camera Switcher", "CameraSwitcher" { CameraId: 0 }
                   Model: "Model::Producer Left", "Camera" { Position: -4000,0,0 }
                   Model: "Model::Camera", "Camera" { } })");
    EXPECT_EQ(sourceNames(*document, 0, "Model"), Names{"Camera"});
    EXPECT_EQ(numbersOf(attributeOf(*document, "Producer Left")->body->child("Position")), (Numbers{-4000, 0, 0}));
    EXPECT_EQ(attributeOf(*document, "Camera Switcher")->subClass, "CameraSwitcher");
}

} // namespace
} // namespace fbxsdk::detail
