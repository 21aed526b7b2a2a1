// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files before 6.0: everything is inside top-level Models.
#include "platform/document/DocumentFromText.h"

#include "document/DocumentBuilder.h"

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

std::string transform(double tx, double rz) {
    const auto axes = [](double x, double z, double rest) {
        return "Channel: \"X\" { Default: " + std::to_string(x) +
               " }\nChannel: \"Y\" { Default: " + std::to_string(rest) +
               " }\nChannel: \"Z\" { Default: " + std::to_string(z) + " }\n";
    };
    return "Channel: \"Transform\" { Channel: \"T\" { " + axes(tx, 0, 0) + "}\nChannel: \"R\" { " + axes(0, rz, 0) +
           "}\nChannel: \"S\" { " + axes(1, 1, 1) + "} }\n";
}

TEST(Generation5, ChildrenListsMakeTheTree) {
    const auto document = documentOf("5.8.0", R"(
        Model: "Model::a" { Children: "Model::c", "Model::b" }
        Model: "Model::b" { }
        Model: "Model::c" { }
        Model: "Model::d" { })");
    EXPECT_EQ(sourceNames(*document, idOf(*document, "Model", "a"), "Model"), (Names{"c", "b"}));
    EXPECT_EQ(sourceNames(*document, 0, "Model"), (Names{"a", "d"}));
}

TEST(Generation5, AnUnknownChildIsLeftOut) {
    const auto document = documentOf("5.8.0", R"(Model: "Model::a" { Children: "Model::gone" })");
    EXPECT_EQ(document->objects.size(), 1U);
    EXPECT_TRUE(warnsOf(*document, "the child Model \"Model::gone\" does not exist"));
}

TEST(Generation5, AnUnquotedChildIsAnError) {
    FbxStatus status;
    const auto document =
        tryDocument("; FBX 5.8.0 project file\n"
                    "Model: \"Model::a\" { Children: \"Model::b\", Unquoted }\nModel: \"Model::b\" { }",
                    &status);
    EXPECT_EQ(document, nullptr);
    EXPECT_EQ(status.GetCode(), FbxStatus::eInvalidFile);
    EXPECT_NE(std::string(status.GetErrorString()).find("test.fbx"), std::string::npos);
}

TEST(Generation5, TheModelsOwnChannelsAreItsPose) {
    const auto document = documentOf("5.0.0", "Model: \"Model::a\" { " + transform(5, 30) + R"(
        Channel: "Visibility" { Default: 100 } }
        Takes: { Take: "t" { Model: "Model::a" { )" +
                                                  transform(7, 60) + "} } }");
    const DocumentObject* model = objectNamed(*document, "Model", "a");
    EXPECT_EQ(numbersOf(model, "Lcl Translation"), (Numbers{5, 0, 0}));
    EXPECT_EQ(numbersOf(model, "Lcl Rotation"), (Numbers{0, 0, 30}));
    EXPECT_EQ(numbersOf(model, "Lcl Scaling"), (Numbers{1, 1, 1}));
    EXPECT_EQ(numbersOf(model, "Visibility"), (Numbers{1})); // from percent
}

TEST(Generation5, TheCurrentTakeGivesThePoseOtherwise) {
    const auto document = documentOf("5.8.0", R"(Model: "Model::a" { }
        Takes: { Current: "second"
            Take: "first" { Model: "Model::a" { )" +
                                                  transform(1, 2) + R"(} }
            Take: "second" { Model: "Model::a" { )" +
                                                  transform(3, 4) + "} } }");
    const DocumentObject* model = objectNamed(*document, "Model", "a");
    EXPECT_EQ(numbersOf(model, "Lcl Translation"), (Numbers{3, 0, 0}));
    // The other take still has its differences.
    EXPECT_EQ(numbersOf(objectNamed(*document, "AnimationCurveNode", "T"), "d|X"), (Numbers{1}));
}

TEST(Generation5, ScalesKeyedVisibilitiesFromPercent) {
    const auto document = documentOf("5.0.0", R"(Model: "Model::a" { }
        Takes: { Take: "t" { Model: "Model::a" { Channel: "Visibility" { Default: 100
            KeyVer: 4002
            KeyCount: 1
            Key: 0,50,U,s,10,20,n } } } })");
    const CurveKeys& curve = document->legacyCurves.at(0);
    EXPECT_EQ(curve.values, std::vector<float>{0.5F});
    EXPECT_EQ(curve.defaultValue, 1);
    EXPECT_FLOAT_EQ(curve.attributes.at(0).data[1], 0.2F);
    EXPECT_EQ(numbersOf(objectNamed(*document, "AnimationCurveNode", "Visibility"), "d|Visibility"), (Numbers{1}));
}

TEST(Generation5, LimitsBecomeThePostRotation) {
    const auto document = documentOf("5.8.0", R"(
        Model: "Model::cam" { Limits: { REnable: 0
                                        RYAxis: -90 } }
        Model: "Model::on" { Limits: { REnable: 1
                                       RXAxis: -90 } }
        Model: "Model::none" { Limits: { TAuto: 1 } })");
    EXPECT_EQ(numbersOf(objectNamed(*document, "Model", "cam"), "PostRotation"), (Numbers{0, -90, 0}));
    EXPECT_EQ(numbersOf(objectNamed(*document, "Model", "cam"), "RotationActive"), (Numbers{0}));
    EXPECT_EQ(numbersOf(objectNamed(*document, "Model", "on"), "PostRotation"), (Numbers{-90, 0, 0}));
    EXPECT_EQ(numbersOf(objectNamed(*document, "Model", "on"), "RotationActive"), (Numbers{1}));
    EXPECT_EQ(objectNamed(*document, "Model", "none")->property("PostRotation"), nullptr);
    EXPECT_EQ(numbersOf(objectNamed(*document, "Model", "none"), "InheritType"), (Numbers{1}));
}

TEST(Generation5, CameraRecordsBecomeProperties) {
    const auto document = documentOf("5.8.0", R"(
        Model: "Model::cam" { Type: "Camera"
            TypeFlags: "Camera"
            Position: 1,2,3
            Up: 0,0,1
            LookAt: 4,5,6
            Roll: 7
            Type: 1
            AspectType: 2
            AspectW: 320
            PixelRatio: 1.5
            NearPlane: 10
            FarPlane: 4000
            ApertureFormat: "35mm TV Projection"
            ApertureMode: 1
            CameraAperture: 1.5,0.5
            SqueezeRatio: 2
            FocalLength: 43
            Aperture: 45
            FieldOfViewXProperty: 40
            OpticalCenterYProperty: 8
        })");
    const DocumentObject* camera = attributeOf(*document, "cam");
    ASSERT_NE(camera, nullptr);
    EXPECT_EQ(camera->record, "NodeAttribute");
    EXPECT_EQ(camera->subClass, "Camera");
    EXPECT_EQ(objectNamed(*document, "Model", "cam")->subClass, "Camera");
    const std::pair<const char*, Numbers> kExpected[] = {
        {"Position", {1, 2, 3}},
        {"UpVector", {0, 0, 1}},
        {"InterestPosition", {4, 5, 6}},
        {"Roll", {7}},
        {"CameraProjectionType", {1}},
        {"AspectRatioMode", {2}},
        {"AspectWidth", {320}},
        {"PixelAspectRatio", {1.5}},
        {"NearPlane", {10}},
        {"FarPlane", {4000}},
        {"FilmFormatIndex", {4}},
        {"ApertureMode", {1}},
        {"FilmWidth", {1.5}},
        {"FilmHeight", {0.5}},
        {"FilmAspectRatio", {3}},
        {"FilmSqueezeRatio", {2}},
        {"FocalLength", {43}},
        {"FieldOfView", {45}},
        {"FieldOfViewX", {40}},
        {"OpticalCenterY", {8}},
    };
    for (const auto& [name, numbers] : kExpected)
        EXPECT_EQ(numbersOf(camera, name), numbers) << name;
}

TEST(Generation5, LightAndBoneRecordsBecomeProperties) {
    const auto document = documentOf("5.8.0", R"(
        Model: "Model::lamp" { Type: "Light"
            LightType: 2
            CastLight: 1
            Color: 0.5,0.25,1
            Intensity: 80
            HotSpot: 10
            ConeAngle: 45 }
        Model: "Model::bone" { TypeFlags: "Skeleton"
            Properties: { Size: 2.5
                          Color: 0.1,0.2,0.3 } })");
    const DocumentObject* light = attributeOf(*document, "lamp");
    EXPECT_EQ(numbersOf(light, "LightType"), (Numbers{2}));
    EXPECT_EQ(numbersOf(light, "CastLightOnObject"), (Numbers{1}));
    EXPECT_EQ(numbersOf(light, "Color"), (Numbers{0.5, 0.25, 1}));
    EXPECT_EQ(numbersOf(light, "Intensity"), (Numbers{80}));
    EXPECT_EQ(numbersOf(light, "InnerAngle"), (Numbers{10}));
    EXPECT_EQ(numbersOf(light, "OuterAngle"), (Numbers{45}));
    const DocumentObject* bone = attributeOf(*document, "bone");
    EXPECT_EQ(bone->subClass, "LimbNode");
    EXPECT_EQ(numbersOf(bone, "Size"), (Numbers{2.5}));
    EXPECT_EQ(numbersOf(bone, "Color"), (Numbers{0.1, 0.2, 0.3}));
}

TEST(Generation5, RecordsWithTooFewNumbersAreNoProperties) {
    const auto document = documentOf("5.8.0", R"(Model: "Model::lamp" { Type: "Light"
        Color: 0.5,0.25
        Intensity: "bright" })");
    EXPECT_EQ(attributeOf(*document, "lamp")->property("Color"), nullptr);
    EXPECT_EQ(attributeOf(*document, "lamp")->property("Intensity"), nullptr);
}

TEST(Generation5, MaterialsBecomeObjectsAndEqualOnesAreShared) {
    const auto document = documentOf("5.8.0", R"(
        Model: "Model::a" { Vertices: 0,0,0
            Material: "Material::red" { ShadingModel: "phong"
                Diffuse: 1,0,0
                Alpha: 0.5 }
            Material: "Material::blue" { Diffuse: 0,0,1 } }
        Model: "Model::b" { Vertices: 0,0,0
            Material: "Material::red" { ShadingModel: "phong"
                Diffuse: 1,0,0
                Alpha: 0.5 }
            Material: "Material::blue" { Diffuse: 0,0,0.5 } })");
    const std::int64_t a = idOf(*document, "Model", "a");
    const std::int64_t b = idOf(*document, "Model", "b");
    EXPECT_EQ(sourceNames(*document, a, "Material"), (Names{"red", "blue"}));
    EXPECT_EQ(sourceNames(*document, b, "Material"), (Names{"red", "blue"}));
    const DocumentObject* red = objectNamed(*document, "Material", "red");
    EXPECT_TRUE(isConnected(*document, red->id, a) && isConnected(*document, red->id, b));
    EXPECT_EQ(numbersOf(red, "DiffuseColor"), (Numbers{1, 0, 0}));
    EXPECT_EQ(numbersOf(red, "Opacity"), (Numbers{0.5}));
    EXPECT_EQ(red->body->childValue("ShadingModel").toText(), "phong");
    EXPECT_FALSE(isConnected(*document, idOf(*document, "Material", "blue"), b)); // b has its own
}

TEST(Generation5, LinksBecomeOneSkinWithClusters) {
    const auto document = documentOf("5.0.0", R"(
        Model: "Model::mesh" { Vertices: 0,0,0,1,1,1
            Link: "Model::bone" { Indexes: 0,1
                Weights: 1,0.5 }
            Link: "Model::gone" { Indexes: 1
                Weights: 0.5 } }
        Model: "Model::bone" { Type: "LimbNode" })");
    const std::int64_t skin = idOf(*document, "Deformer", "", "Skin");
    EXPECT_TRUE(isConnected(*document, skin, attributeOf(*document, "mesh")->id));
    EXPECT_EQ(sourceNames(*document, skin, "Deformer"), (Names{"bone", "gone"}));
    const DocumentObject* cluster = objectNamed(*document, "Deformer", "bone", "Cluster");
    EXPECT_TRUE(isConnected(*document, idOf(*document, "Model", "bone"), cluster->id));
    EXPECT_EQ(numbersOf(cluster->body->child("Weights")), (Numbers{1, 0.5}));
    EXPECT_TRUE(sourceNames(*document, idOf(*document, "Deformer", "gone"), "Model").empty());
}

TEST(Generation5, ShapesTakeTheirWeightFromTheirChannel) {
    const auto document = documentOf("5.0.0", R"x(
        Model: "Model::mesh" { Vertices: 0,0,0
            Shape: "fat" { Indexes: 0
                Vertices: 0,0,1 }
            Channel: "fat (Shape)" {
    Default:
        35.5 }
}
        Takes: { Take: "t" { Model: "Model::mesh" { Channel: "fat (Shape)" { Default: 1
            KeyCount: 1
            Key: 0,100,L } } } })x");
    const DocumentObject* channel = objectNamed(*document, "Deformer", "fat", "BlendShapeChannel");
    ASSERT_NE(channel, nullptr);
    EXPECT_EQ(numbersOf(channel, "DeformPercent"), (Numbers{35.5}));
    EXPECT_EQ(numbersOf(channel->body->child("DeformPercent")), (Numbers{35.5}));
    EXPECT_TRUE(
        isConnected(*document, idOf(*document, "AnimationCurveNode", "DeformPercent"), channel->id, "DeformPercent"));
}

TEST(Generation5, SettingsCamerasAreUnconnectedViews) {
    const auto document = documentOf("5.0.0", R"(
        Model: "Model::a" { }
        Settings: { FrameRate: "25"
            TimeMode: 3
            Camera: "Producer Top" { TypeFlags: "Camera"
                Shading: W
                Position: 0,4000,0
                Type: 1 } }
        AmbientRenderSettings: { AmbientLightColor: 0.5,0.5,0.5,1 }
        RendererSetting: { DefaultCamera: "Producer Top" })");
    EXPECT_EQ(sourceNames(*document, 0, "Model"), Names{"a"});
    const DocumentObject* camera = attributeOf(*document, "Producer Top");
    ASSERT_NE(camera, nullptr);
    EXPECT_EQ(numbersOf(camera, "Position"), (Numbers{0, 4000, 0}));
    EXPECT_EQ(numbersOf(camera, "CameraProjectionType"), (Numbers{1}));
    EXPECT_EQ(numbersOf(settingNamed(*document, "TimeMode")), (Numbers{10}));
    EXPECT_EQ(settingNamed(*document, "DefaultCamera")->values[0].toText(), "Producer Top");
    EXPECT_TRUE(document->lightSettings.hasAmbient);
}

TEST(Generation5, ReadsBareNamesOfOldBinaries) {
    auto tree = std::make_unique<RecordTree>();
    tree->version = 3000;
    DocumentBuilder maker(std::move(tree), 3000); // only for creating records
    ChildAppender top(maker.tree().root);
    Record& parent = maker.newRecord("Model", maker.keep({Value::ofText("a::b")}));
    ChildAppender(parent).add(maker.newRecord("Children", maker.keep({Value::ofText("Box01")})));
    top.add(parent);
    top.add(maker.newRecord("Model", maker.keep({Value::ofText("Box01")})));
    FbxStatus status;
    const auto document = readDocument(std::move(maker.document().tree), status);
    ASSERT_NE(document, nullptr);
    EXPECT_EQ(sourceNames(*document, idOf(*document, "Model", "a::b"), "Model"), Names{"Box01"});
}

TEST(Generation5, NormalsPerPointWhenTheirCountSaysSo) {
    const auto document = documentOf("5.8.0", R"(
        Model: "Model::m" { Vertices: 0,0,0,1,0,0,0,1,0,1,1,0
            PolygonVertexIndex: 0,1,-3,1,3,-3
            Normals: 0,0,1,0,0,1,0,0,1,0,0,1 })");
    const Record* normals = attributeOf(*document, "m")->body->child("LayerElementNormal");
    ASSERT_NE(normals, nullptr);
    EXPECT_EQ(normals->childValue("MappingInformationType").toText(), "ByVertice");
    EXPECT_EQ(normals->childValue("ReferenceInformationType").toText(), "Direct");
    EXPECT_EQ(normals->child("Normals")->numberCount(), 12U);
    EXPECT_EQ(attributeOf(*document, "m")->body->child("Normals"), nullptr);
}

TEST(Generation5, NormalsPerCornerOtherwise) {
    const auto document = documentOf("5.8.0", R"(
        Model: "Model::m" { Vertices: 0,0,0,1,0,0,0,1,0,1,1,0
            PolygonVertexIndex: 0,1,-3
            Normals: 0,0,1,0,0,1,0,0,1 })");
    EXPECT_EQ(
        attributeOf(*document, "m")->body->child("LayerElementNormal")->childValue("MappingInformationType").toText(),
        "ByPolygonVertex");
}

TEST(Generation5, AmbiguousNormalsAreThoseOfTheCornersExceptInVersion5000) {
    const std::string mesh = R"(Model: "Model::m" { Vertices: 0,0,0,1,0,0,0,1,0
        PolygonVertexIndex: 0,1,-3
        Normals: 0,0,1,0,0,1,0,0,1 })";
    const auto mapping = [](const Document& document) {
        return attributeOf(document, "m")
            ->body->child("LayerElementNormal")
            ->childValue("MappingInformationType")
            .toText();
    };
    EXPECT_EQ(mapping(*documentOf("5.8.0", mesh)), "ByPolygonVertex");
    EXPECT_EQ(mapping(*documentOf("5.0.0", mesh)), "ByVertice");
}

TEST(Generation5, UvsAndMaterialIndicesBecomeLayerElements) {
    const auto document = documentOf("5.8.0", R"(
        Model: "Model::m" { Vertices: 0,0,0,1,0,0,0,1,0
            PolygonVertexIndex: 0,1,-3
            MaterialAssignation: "AllSame"
            Materials: 1
            GeometryUVInfo: { Version: 240
                MappingInformationType: "ByPolygon"
                TextureUV: 0,0,1,0,0,1
                TextureUVVerticeIndex: 2,1,0 }
            GeometryUVInfo: { MappingInformationType: "ByPolygon"
                TextureUV: 0.5,0.5 } })");
    const Record& body = *attributeOf(*document, "m")->body;
    const Record* materials = body.child("LayerElementMaterial");
    EXPECT_EQ(materials->childValue("MappingInformationType").toText(), "AllSame");
    EXPECT_EQ(numbersOf(materials->child("Materials")), (Numbers{1}));
    const Record* uv = body.child("LayerElementUV");
    EXPECT_EQ(uv->childValue("MappingInformationType").toText(), "ByPolygonVertex");
    EXPECT_EQ(uv->childValue("ReferenceInformationType").toText(), "IndexToDirect");
    EXPECT_EQ(numbersOf(uv->child("UVIndex")), (Numbers{2, 1, 0}));
    EXPECT_EQ(uv->child("UV")->numberCount(), 6U);
    EXPECT_EQ(uv->nextSibling->name, "LayerElementUV");
    EXPECT_EQ(uv->nextSibling->childValue("ReferenceInformationType").toText(), "Direct");
    Names layers;
    for (const Record& record : body.children())
        if (record.name == "Layer")
            for (const Record& element : record.children())
                if (element.name == "LayerElement")
                    layers.push_back(std::to_string(record.value(0).toInteger()) + " " +
                                     std::string(element.childValue("Type").toText()));
    EXPECT_EQ(layers, (Names{"0 LayerElementMaterial", "0 LayerElementUV", "1 LayerElementUV"}));
}

TEST(Generation5, AMeshKeepsItsOtherRecords) {
    const auto document = documentOf("5.8.0", R"(
        Model: "Model::m" { GeometryVersion: 123
            Vertices: 0,0,0
            Channel: "Transform" { } })");
    const Record& body = *attributeOf(*document, "m")->body;
    EXPECT_EQ(body.childValue("GeometryVersion").toInteger(), 123);
    EXPECT_EQ(body.child("Channel"), nullptr);
    EXPECT_EQ(body.child("Layer"), nullptr);
    EXPECT_EQ(attributeOf(*document, "m")->record, "Geometry");
}

TEST(Generation5, PosesAreNumbered) {
    const auto document = documentOf("5.8.0", R"(
        Model: "Model::m" { }
        SceneGenericPersistence: { Pose: "Pose::p" { Type: "BindPose"
            PoseNode: { Node: "Model::m" } } })");
    const DocumentObject* pose = objectNamed(*document, "Pose", "p");
    ASSERT_NE(pose, nullptr);
    EXPECT_EQ(pose->subClass, "BindPose");
    EXPECT_EQ(pose->body->child("PoseNode")->childValue("Node").toInteger(), idOf(*document, "Model", "m"));
}

} // namespace
} // namespace fbxsdk::detail
