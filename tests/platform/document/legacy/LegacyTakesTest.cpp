// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Takes of files before 7.x.
#include "platform/document/DocumentFromText.h"

namespace fbxsdk::detail {
namespace {

std::string keyed(const std::string& axis, double value) {
    return "Channel: \"" + axis + "\" { Default: " + std::to_string(value) + "\nKeyVer: 4005\nKeyCount: 1\nKey: 0," +
           std::to_string(value) + ",L }\n";
}
std::string still(const std::string& axis, double value) {
    return "Channel: \"" + axis + "\" { Default: " + std::to_string(value) + " }\n";
}

const std::string kObjects = R"(
    Objects: {
        Model: "Model::m", "Null" { Properties60: {
            Property: "Lcl Translation", "Lcl Translation", "A",1,2,3
            Property: "Lcl Rotation", "Lcl Rotation", "A",0,0,0
            Property: "mine", "Number", "AU",4
            Property: "Visibility", "Visibility", "A",1 } }
        Model: "Model::lamp", "Light" { Properties60: {
            Property: "Color", "Color", "AN",1,1,1
            Property: "Cone angle", "Number", "AN",45
            Property: "Intensity", "Number", "AN",100 } }
        Material: "Material::red", "" { Properties60: { Property: "DiffuseColor", "Color", "A",1,0,0 } }
    }
)";

std::unique_ptr<Document> documentWithTake(const std::string& channels) {
    return documentOf("6.1.0", kObjects + "Takes: { Current: \"t\"\nTake: \"t\" { LocalTime: 1,2\n" + channels + "} }");
}

TEST(LegacyTakes, BecomeStacksWithOneLayerEach) {
    const auto document = documentOf("6.1.0", kObjects + R"(Takes: { Current: "b"
        Take: "b" { LocalTime: 10,20
                    ReferenceTime: 30,40 }
        Take: "a" { } })");
    EXPECT_EQ(document->activeStackName, "b");
    const DocumentObject* stack = objectNamed(*document, "AnimationStack", "b");
    ASSERT_NE(stack, nullptr);
    EXPECT_EQ(numbersOf(stack, "LocalStart"), (Numbers{10}));
    EXPECT_EQ(numbersOf(stack, "LocalStop"), (Numbers{20}));
    EXPECT_EQ(numbersOf(stack, "ReferenceStart"), (Numbers{30}));
    EXPECT_EQ(numbersOf(stack, "ReferenceStop"), (Numbers{40}));
    EXPECT_EQ(stack->property("LocalStart")->typeName, "KTime");
    EXPECT_EQ(sourceNames(*document, stack->id, "AnimationLayer"), Names{"BaseLayer"});
    Names stacks;
    for (const DocumentObject& object : document->objects)
        if (object.record == "AnimationStack")
            stacks.emplace_back(object.name);
    EXPECT_EQ(stacks, (Names{"b", "a"}));
}

TEST(LegacyTakes, TransformChannelsDriveTheModel) {
    const auto document = documentWithTake(R"(Model: "Model::m" { Channel: "Transform" { Channel: "T" { )" +
                                           keyed("X", 7) + still("Y", 8) + keyed("Z", 9) + R"(LayerType: 1 } } })");
    const DocumentObject* node = objectNamed(*document, "AnimationCurveNode", "T");
    ASSERT_NE(node, nullptr);
    EXPECT_TRUE(isConnected(*document, node->id, idOf(*document, "Model", "m"), "Lcl Translation"));
    EXPECT_TRUE(isConnected(*document, node->id, idOf(*document, "AnimationLayer", "BaseLayer")));
    EXPECT_EQ(numbersOf(node, "d|X"), (Numbers{7}));
    EXPECT_EQ(numbersOf(node, "d|Y"), (Numbers{8}));
    ASSERT_EQ(document->legacyCurves.size(), 2U);
    std::vector<std::string> labels;
    for (const DocumentConnection& edge : document->connections)
        if (edge.destination == node->id)
            labels.emplace_back(edge.destinationProperty);
    EXPECT_EQ(labels, (Names{"d|X", "d|Z"}));
}

TEST(LegacyTakes, CurvesAreReadThroughTheirObjects) {
    const auto document = documentWithTake(R"(Model: "Model::m" { )" + keyed("Visibility", 0.5) + "}");
    const DocumentObject* curve = objectNamed(*document, "AnimationCurve", "");
    ASSERT_NE(curve, nullptr);
    EXPECT_EQ(curve->legacyCurve, 0);
    EXPECT_EQ(readCurve(*document, *curve).values, std::vector<float>{0.5F});
}

TEST(LegacyTakes, AttributeChannelsDriveTheAttribute) {
    const auto document =
        documentWithTake(R"(Model: "Model::lamp" { Channel: "Color" { )" + keyed("X", 1) + still("Y", 0) +
                         still("Z", 0) + "}\n" + keyed("Intensity", 50) + keyed("Cone angle", 30) + "}");
    const std::int64_t lamp = idOf(*document, "Model", "lamp");
    const DocumentObject* light = objectNamed(*document, "NodeAttribute", "", "Light");
    ASSERT_TRUE(light);
    EXPECT_TRUE(isConnected(*document, light->id, lamp));
    EXPECT_TRUE(isConnected(*document, idOf(*document, "AnimationCurveNode", "Color"), light->id, "Color"));
    EXPECT_TRUE(isConnected(*document, idOf(*document, "AnimationCurveNode", "Intensity"), light->id, "Intensity"));
    const DocumentObject* cone = objectNamed(*document, "AnimationCurveNode", "OuterAngle");
    ASSERT_TRUE(cone);
    EXPECT_TRUE(isConnected(*document, cone->id, light->id, "OuterAngle"));
    EXPECT_EQ(numbersOf(cone, "d|OuterAngle"), (Numbers{30}));
}

TEST(LegacyTakes, UsersChannelsDriveTheModel) {
    const auto document = documentWithTake(R"(Model: "Model::m" { )" + keyed("mine", 5) + "}");
    EXPECT_TRUE(
        isConnected(*document, idOf(*document, "AnimationCurveNode", "mine"), idOf(*document, "Model", "m"), "mine"));
}

TEST(LegacyTakes, OtherObjectsCanBeDrivenToo) {
    const auto document =
        documentWithTake(R"(Material: "Material::red" { Channel: "DiffuseColor" { )" + keyed("X", 1) + "} }");
    EXPECT_TRUE(isConnected(*document, idOf(*document, "AnimationCurveNode", "DiffuseColor"),
                            idOf(*document, "Material", "red"), "DiffuseColor"));
}

TEST(LegacyTakes, AChannelThatSaysNothingNewIsLeftOut) {
    const auto document = documentWithTake(R"(Model: "Model::m" { Channel: "Transform" { Channel: "T" { )" +
                                           still("X", 1) + still("Y", 2) + still("Z", 3.0000001) + "} } }");
    EXPECT_EQ(objectNamed(*document, "AnimationCurveNode", "T"), nullptr);
}

TEST(LegacyTakes, AStillChannelThatDiffersFromThePropertyIsKept) {
    const auto document = documentWithTake(R"(Model: "Model::m" { Channel: "Transform" { Channel: "T" { )" +
                                           still("X", 1) + still("Y", 2) + still("Z", 5) + "} } }");
    const DocumentObject* node = objectNamed(*document, "AnimationCurveNode", "T");
    ASSERT_NE(node, nullptr);
    EXPECT_EQ(numbersOf(node, "d|Z"), (Numbers{5}));
    EXPECT_TRUE(document->legacyCurves.empty());
}

TEST(LegacyTakes, AComponentMayBeTheOnlyOne) {
    const auto document =
        documentWithTake(R"(Model: "Model::m" { Channel: "Transform" { Channel: "R" { )" + keyed("Y", 4) + "} } }");
    const DocumentObject* node = objectNamed(*document, "AnimationCurveNode", "R");
    ASSERT_NE(node, nullptr);
    EXPECT_EQ(node->properties.size(), 1U);
    EXPECT_EQ(numbersOf(node, "d|Y"), (Numbers{4}));
}

TEST(LegacyTakes, WithoutDefaultTheFirstKeyIsUsed) {
    const auto document = documentWithTake(R"(Model: "Model::m" { Channel: "Visibility" { KeyCount: 1
        Key: 0,0.75,L } })");
    EXPECT_EQ(numbersOf(objectNamed(*document, "AnimationCurveNode", "Visibility"), "d|Visibility"), (Numbers{0.75}));
}

TEST(LegacyTakes, UnknownObjectsAreIgnored) {
    const auto document = documentWithTake(R"(Model: "Model::gone" { )" + keyed("Visibility", 1) + "}");
    EXPECT_TRUE(document->legacyCurves.empty());
}

TEST(LegacyTakes, OnlyTheOutermostTransformCounts) {
    std::string nested = R"(Channel: "T" { )" + keyed("X", 7) + "}\n";
    for (int depth = 0; depth < 20; ++depth)
        nested = "Channel: \"Transform\" {\n" + nested + "}\n";
    const auto document = documentWithTake("Model: \"Model::m\" { Channel: \"Transform\" { Channel: \"T\" { " +
                                           keyed("X", 1) + "}\n" + nested + "} }");
    ASSERT_EQ(document->legacyCurves.size(), 1U);
    EXPECT_EQ(document->legacyCurves[0].values, std::vector<float>{1});
}

TEST(LegacyTakes, TheFirstOfTwoChannelsForOnePropertyWins) {
    const auto document =
        documentWithTake(R"(Model: "Model::m" { )" + keyed("Visibility", 0.5) + keyed("Visibility", 0.25) + "}");
    EXPECT_EQ(numbersOf(objectNamed(*document, "AnimationCurveNode", "Visibility"), "d|Visibility"), (Numbers{0.5}));
    EXPECT_EQ(document->legacyCurves.size(), 1U);
}

} // namespace
} // namespace fbxsdk::detail
