// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Large and malicious documents: no recursion by the file's depth, no time beyond the file's size.
#include "DocumentFromText.h"

#include <chrono>

namespace fbxsdk::detail {
namespace {

constexpr int kMany = 100'000;

/// Generous: quadratic growth takes minutes.
constexpr std::chrono::seconds kLongest{20};

class Stopwatch {
public:
    ~Stopwatch() { EXPECT_LT(std::chrono::steady_clock::now() - mStart, kLongest); }

private:
    std::chrono::steady_clock::time_point mStart = std::chrono::steady_clock::now();
};

std::string number(int value) { return std::to_string(value); }

TEST(HostileDocument, AChainOfAHundredThousandModelsStaysAChain) {
    const Stopwatch watch;
    std::string objects = "Objects: {\n";
    std::string connections = "Connections: {\n";
    for (int i = 1; i <= kMany; ++i) {
        objects += "Model: " + number(i) + ", \"Model::m\", \"Null\" { }\n";
        connections += "C: \"OO\"," + number(i + 1) + "," + number(i) + "\n";
    }
    const auto document = documentOf("7.5.0", objects + "}\n" + connections + "}\n");
    EXPECT_EQ(document->objects.size(), static_cast<std::size_t>(kMany));
    EXPECT_EQ(document->connections.size(), static_cast<std::size_t>(kMany)); // the last one was dangling
    EXPECT_TRUE(isConnected(*document, 1, 0));
    EXPECT_TRUE(isConnected(*document, kMany, kMany - 1));
}

TEST(HostileDocument, ACycleOfAHundredThousandModelsIsCutOnce) {
    const Stopwatch watch;
    std::string objects = "Objects: {\n";
    std::string connections = "Connections: {\n";
    for (int i = 1; i <= kMany; ++i) {
        objects += "Model: " + number(i) + ", \"Model::m\", \"Null\" { }\n";
        connections += "C: \"OO\"," + number(i) + "," + number(i % kMany + 1) + "\n";
    }
    const auto document = documentOf("7.5.0", objects + "}\n" + connections + "}\n");
    EXPECT_EQ(sourceNames(*document, 0, "Model").size(), 1U);
    EXPECT_TRUE(isConnected(*document, 1, 0));
}

TEST(HostileDocument, AChainOfNamedModelsIsNoDeeperRecursion) {
    const Stopwatch watch;
    std::string text;
    for (int i = 0; i < kMany; ++i)
        text += "Model: \"Model::" + number(i) + "\" { Children: \"Model::" + number(i + 1) + "\" }\n";
    const auto document = documentOf("5.8.0", text);
    EXPECT_EQ(sourceNames(*document, 0, "Model"), Names{"0"});
}

TEST(HostileDocument, AHundredThousandEqualIdsLeaveOneObject) {
    const Stopwatch watch;
    std::string objects = "Objects: {\n";
    for (int i = 0; i < kMany; ++i)
        objects += "Model: 5, \"Model::" + number(i) + "\", \"Null\" { }\n";
    const auto document = documentOf("7.5.0", objects + "}");
    ASSERT_EQ(document->objects.size(), 1U);
    EXPECT_EQ(document->objects[0].name, "0");
    EXPECT_LE(document->warnings.size(), 101U);
}

TEST(HostileDocument, AHundredThousandEqualConnectionsAreOne) {
    const Stopwatch watch;
    std::string connections = "Connections: {\n";
    for (int i = 0; i < kMany; ++i)
        connections += "C: \"OO\",1,2\n";
    const auto document = documentOf("7.5.0", R"(Objects: { Model: 1, "Model::a", "Null" { }
        Model: 2, "Model::b", "Null" { } })"
                                              "\n" +
                                                  connections + "}");
    EXPECT_EQ(document->connections.size(), 2U);
}

TEST(HostileDocument, AHundredThousandTakesForOneStackAreQuick) {
    const Stopwatch watch;
    std::string objects = "Objects: {\n";
    std::string takes = "Takes: {\n";
    for (int i = 1; i <= kMany; ++i) {
        objects += "AnimationStack: " + number(i) + ", \"AnimStack::" + number(i) + "\", \"\" { }\n";
        takes += "Take: \"" + number(i) + "\" { LocalTime: 0," + number(i) + " }\n";
    }
    const auto document = documentOf("7.5.0", objects + "}\n" + takes + "}\n");
    EXPECT_EQ(numbersOf(document->find(kMany), "LocalStop"), (Numbers{kMany}));
}

TEST(HostileDocument, AHundredThousandShapesWithWeightsAreQuick) {
    const Stopwatch watch;
    constexpr int kShapes = 30'000;
    std::string shapes;
    std::string properties = "Properties60: {\n";
    std::string channels;
    for (int i = 0; i < kShapes; ++i) {
        shapes += "Shape: \"s" + number(i) + "\" { Indexes: 0 }\n";
        properties += "Property: \"s" + number(i) + "\", \"Number\", \"AN\"," + number(i) + "\n";
        channels += "Channel: \"s" + number(i) + "\" { KeyCount: 1\nKey: 0,1,L }\n";
    }
    const auto document =
        documentOf("6.1.0", "Objects: { Model: \"Model::m\", \"Mesh\" {\n" + properties + "}\n" + shapes +
                                "} }\nTakes: { Take: \"t\" { Model: \"Model::m\" {\n" + channels + "} } }");
    EXPECT_EQ(document->legacyCurves.size(), static_cast<std::size_t>(kShapes));
    EXPECT_EQ(numbersOf(objectNamed(*document, "Deformer", "s29999", "BlendShapeChannel"), "DeformPercent"),
              (Numbers{29999}));
}

TEST(HostileDocument, ChannelsForPropertiesThatTheAttributeHasManyOfAreQuick) {
    const Stopwatch watch;
    constexpr int kProperties = 30'000;
    std::string properties;
    std::string channels;
    for (int i = 0; i < kProperties; ++i) {
        properties += "Property: \"p" + number(i) + "\", \"Number\", \"AU\"," + number(i) + "\n";
        channels += "Channel: \"p" + number(i) + "\" { KeyCount: 1\nKey: 0,1,L }\n";
    }
    const auto document =
        documentOf("6.1.0", "Objects: { Model: \"Model::m\", \"Light\" { Properties60: {\n" + properties +
                                "} } }\nTakes: { Take: \"t\" { Model: \"Model::m\" {\n" + channels + "} } }");
    EXPECT_EQ(document->legacyCurves.size(), static_cast<std::size_t>(kProperties));
}

TEST(HostileDocument, EveryTruncationOfADocumentIsReadOrRefused) {
    const std::string text = R"(; FBX 6.1.0 project file
Objects: { Model: "Model::m", "Mesh" { Properties60: { Property: "Key", "Number", "AN",25 }
    Vertices: 0,0,0
    Shape: "Key" { Indexes: 0 }
    NodeAttributeName: "Geometry::g" }
    Pose: "Pose::p", "BindPose" { PoseNode: { Node: "Model::m" } } }
Connections: { Connect: "OO", "Model::m", "Model::Scene" }
Takes: { Take: "t" { Model: "Model::m" { Channel: "Key" { KeyCount: 2
    Key: 0,75,U,s,1,2,a,0.3,0.3,10,1,L } } } }
Version5: { Settings: { FrameRate: "24" } })";
    for (std::size_t length = 0; length <= text.size(); ++length) {
        FbxStatus status;
        const auto document = tryDocument(text.substr(0, length), &status);
        EXPECT_TRUE(document || status.Error()) << length;
    }
}

/// A document of those records either loads consistently or is refused with a reason.
void expectSoundOrRefused(const std::string& text) {
    FbxStatus status;
    const auto document = tryDocument(text, &status);
    EXPECT_TRUE(document || status.Error());
    if (!document)
        return;
    for (const DocumentObject& object : document->objects) {
        EXPECT_NE(object.body, nullptr);
        EXPECT_EQ(document->find(object.id), &object);
    }
    for (const DocumentConnection& edge : document->connections)
        EXPECT_TRUE(document->find(edge.source) && (edge.destination == 0 || document->find(edge.destination)));
}

constexpr const char* kSections[] = {
    "FBXHeaderExtension",
    "Creator",
    "GlobalSettings",
    "Documents",
    "Definitions",
    "Objects",
    "Takes",
    "Connections",
    "Version5",
    "Settings",
    "FogOptions",
    "Model",
    "RendererSetting",
    "AmbientRenderSettings",
    "SceneGenericPersistence",
};
constexpr const char* kInnerRecords[] = {
    "Properties70", "Properties60", "Limits",    "Children",          "Link",           "Shape",   "Material",
    "Texture",      "Normals",      "Materials", "GeometryUVInfo",    "Vertices",       "Channel", "Type",
    "TypeFlags",    "Properties",   "PoseNode",  "NodeAttributeName", "CameraAperture", "Key",     "KeyTime",
};
/// Prefixes and suffixes of the inner records.
constexpr std::pair<const char*, const char*> kPlaces[] = {
    {"Model: \"Model::m\" {", "}"},
    {"Objects: { Model: 1, \"Model::m\", \"Mesh\" {", "} }"},
    {"Objects: { Model: \"Model::m\", \"Mesh\" {", "} }"},
    {"Objects: { AnimationCurve: 1, \"AnimCurve::\", \"\" {", "} }"},
    {"Settings: { Camera: \"Producer Top\" {", "} }"},
    {"Takes: { Take: \"t\" {", "} }"},
};

TEST(HostileDocument, RecordsOfTheWrongShapeAreHarmless) {
    for (const char* version : {"5.8.0", "6.1.0", "7.5.0"}) {
        for (const char* values : {"", " \"x\"", " 1", " { }", " \"\", \"\", \"\" { }", " nan { }"}) {
            std::string sections;
            for (const char* section : kSections)
                sections += std::string(section) + ":" + values + "\n";
            for (const char* record : kInnerRecords)
                for (const auto& [begin, end] : kPlaces)
                    expectSoundOrRefused(std::string("; FBX ") + version + " project file\n" + sections + begin + "\n" +
                                         record + ":" + values + "\n" + record + ": \"a\" { Default: \"b\" }\n" + end +
                                         "\n");
        }
    }
}

} // namespace
} // namespace fbxsdk::detail
