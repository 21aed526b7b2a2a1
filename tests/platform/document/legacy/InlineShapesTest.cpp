// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Shape records inside geometries become deformers, in every generation that has them.
#include "platform/document/DocumentFromText.h"

namespace fbxsdk::detail {
namespace {

const std::string kShapes71 = R"(
    Objects: {
        Geometry: 10, "Geometry::", "Mesh" {
            Properties70: { P: "TopH", "Number", "", "A+",40
                            P: "Color", "ColorRGB", "Color", "",1,1,1 }
            Vertices: *6 { a: 0,0,0,1,1,1 }
            Shape: "TopH" { Indexes: *1 { a: 1 }
                            Vertices: *3 { a: 0,0,2 } }
            Shape: "TopV" { Indexes: *1 { a: 0 }
                            Vertices: *3 { a: 0,3,0 } }
        }
        AnimationLayer: 20, "AnimLayer::L", "" { }
        AnimationCurveNode: 21, "AnimCurveNode::TopH", "" { Properties70: { P: "d|TopH", "Number", "", "A",40 } }
        AnimationCurve: 22, "AnimCurve::", "" { }
        Model: 1, "Model::m", "Mesh" { }
    }
    Connections: {
        C: "OO",10,1
        C: "OO",21,20
        C: "OP",21,10, "TopH"
        C: "OP",22,21, "d|TopH"
    })";

TEST(InlineShapes, MakeOneBlendShapeWithAChannelAndATargetEach) {
    const auto document = documentOf("7.1.0", kShapes71);
    const std::int64_t blendShape = idOf(*document, "Deformer", "", "BlendShape");
    EXPECT_TRUE(isConnected(*document, blendShape, 10));
    EXPECT_EQ(sourceNames(*document, blendShape, "Deformer"), (Names{"TopH", "TopV"}));
    const std::int64_t channel = idOf(*document, "Deformer", "TopV", "BlendShapeChannel");
    const DocumentObject* target = objectNamed(*document, "Geometry", "TopV", "Shape");
    ASSERT_NE(target, nullptr);
    EXPECT_TRUE(isConnected(*document, target->id, channel));
    EXPECT_EQ(numbersOf(target->body->child("Vertices")), (Numbers{0, 3, 0}));
    EXPECT_EQ(numbersOf(target->body->child("Indexes")), (Numbers{0}));
}

TEST(InlineShapes, MoveTheWeightToTheChannel) {
    const auto document = documentOf("7.1.0", kShapes71);
    const DocumentObject* channel = objectNamed(*document, "Deformer", "TopH", "BlendShapeChannel");
    EXPECT_EQ(numbersOf(channel, "DeformPercent"), (Numbers{40}));
    EXPECT_EQ(numbersOf(channel->body->child("DeformPercent")), (Numbers{40}));
    EXPECT_EQ(numbersOf(channel->body->child("FullWeights")), (Numbers{100}));
    EXPECT_EQ(document->find(10)->property("TopH"), nullptr);
    EXPECT_NE(document->find(10)->property("Color"), nullptr);
}

TEST(InlineShapes, WithoutWeightPropertyHaveWeightZero) {
    const auto document = documentOf("7.1.0", kShapes71);
    EXPECT_EQ(numbersOf(objectNamed(*document, "Deformer", "TopV", "BlendShapeChannel"), "DeformPercent"),
              (Numbers{0}));
}

TEST(InlineShapes, MoveTheAnimationToTheChannel) {
    const auto document = documentOf("7.1.0", kShapes71);
    const std::int64_t channel = idOf(*document, "Deformer", "TopH", "BlendShapeChannel");
    EXPECT_TRUE(isConnected(*document, 21, channel, "DeformPercent"));
    EXPECT_FALSE(isConnected(*document, 21, 10, "TopH"));
    EXPECT_TRUE(isConnected(*document, 22, 21, "d|DeformPercent"));
    EXPECT_EQ(document->find(21)->name, "DeformPercent");
    EXPECT_EQ(numbersOf(document->find(21), "d|DeformPercent"), (Numbers{40}));
}

TEST(InlineShapes, GetIdsThatNoOtherObjectHas) {
    const auto document = documentOf("7.1.0", R"(
        Objects: { Geometry: 1, "Geometry::", "Mesh" { Shape: "s" { } }
                   Model: 2, "Model::a", "Null" { }
                   Model: 4, "Model::b", "Null" { } })");
    EXPECT_EQ(document->objects.size(), 6U);
    EXPECT_EQ(document->idIndex.size(), 6U);
    EXPECT_EQ(document->find(2)->name, "a");
    EXPECT_EQ(document->find(3)->subClass, "BlendShape");
    EXPECT_EQ(document->find(5)->subClass, "BlendShapeChannel");
}

TEST(InlineShapes, AreTranslatedInFilesOf6ToO) {
    const auto document = documentOf("6.1.0", R"(
        Objects: { Model: "Model::m", "Mesh" {
            Properties60: { Property: "Key", "Number", "AN",25 }
            Vertices: 0,0,0,1,1,1
            Shape: "Key" { Indexes: 1
                           Vertices: 0,0,2 } } }
        Takes: { Take: "t" { Model: "Model::m" { Channel: "Key" { Default: 50
            KeyVer: 4005
            KeyCount: 1
            Key: 0,75,L } } } })");
    const DocumentObject* channel = objectNamed(*document, "Deformer", "Key", "BlendShapeChannel");
    ASSERT_NE(channel, nullptr);
    EXPECT_EQ(numbersOf(channel, "DeformPercent"), (Numbers{25}));
    const DocumentObject* node = objectNamed(*document, "AnimationCurveNode", "DeformPercent");
    ASSERT_NE(node, nullptr);
    EXPECT_TRUE(isConnected(*document, node->id, channel->id, "DeformPercent"));
    EXPECT_EQ(numbersOf(node, "d|DeformPercent"), (Numbers{50}));
    EXPECT_EQ(document->legacyCurves.at(0).values, std::vector<float>{75});
}

TEST(InlineShapes, InstancesShareThem) {
    const auto document = documentOf("6.1.0", R"(
        Objects: {
            Model: "Model::a", "Mesh" { Vertices: 0,0,0
                Shape: "s" { Indexes: 0 }
                NodeAttributeName: "Geometry::g" }
            Model: "Model::b", "Mesh" { Vertices: 0,0,0
                Shape: "s" { Indexes: 0 }
                NodeAttributeName: "Geometry::g" } }
        Takes: { Take: "t" {
            Model: "Model::a" { Channel: "s" { KeyCount: 1
                Key: 0,10,L } }
            Model: "Model::b" { Channel: "s" { KeyCount: 1
                Key: 0,20,L } } } })");
    const std::int64_t channel = idOf(*document, "Deformer", "s", "BlendShapeChannel");
    EXPECT_EQ(sourceNames(*document, channel, "AnimationCurveNode"), Names{"DeformPercent"}); // the first one
}

} // namespace
} // namespace fbxsdk::detail
