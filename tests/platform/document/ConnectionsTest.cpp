// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Which connections are kept, and that the Models form a tree.
#include "DocumentFromText.h"

namespace fbxsdk::detail {
namespace {

/// Models named by their ids, and connections.
std::unique_ptr<Document> modelsAnd(const std::vector<int>& ids, const std::string& connections,
                                    const std::string& others = {}) {
    std::string text = "Objects: {\n";
    for (const int id : ids)
        text += "Model: " + std::to_string(id) + ", \"Model::m" + std::to_string(id) + "\", \"Null\" { }\n";
    return documentOf("7.5.0", text + others + "}\nConnections: {\n" + connections + "\n}");
}

TEST(Connections, ReadsAllFourKinds) {
    const auto document = modelsAnd({1, 2}, R"(
        C: "OO",1,2
        C: "OP",1,2, "in"
        C: "PO",1, "out",2
        C: "PP",1, "out",2, "in")");
    ASSERT_GE(document->connections.size(), 4U);
    const auto& edges = document->connections;
    EXPECT_TRUE(edges[0].sourceProperty.empty() && edges[0].destinationProperty.empty());
    EXPECT_TRUE(edges[1].sourceProperty.empty() && edges[1].destinationProperty == "in");
    EXPECT_TRUE(edges[2].sourceProperty == "out" && edges[2].destinationProperty.empty());
    EXPECT_TRUE(edges[3].sourceProperty == "out" && edges[3].destinationProperty == "in");
}

TEST(Connections, DropsThoseWithUnknownEnds) {
    const auto document = modelsAnd({1}, R"(
        C: "OO",1,0
        C: "OO",7,1
        C: "OO",1,7
        C: "OO",0,1)");
    EXPECT_EQ(document->connections.size(), 1U);
    EXPECT_TRUE(warnsOf(*document, "3 connections refer to objects that do not exist"));
}

TEST(Connections, DropsThoseFromAnObjectToItself) {
    const auto document = modelsAnd({1}, R"(
        C: "OO",1,0
        C: "OO",1,1
        C: "PP",1, "a",1, "b")");
    EXPECT_EQ(document->connections.size(), 1U);
    EXPECT_TRUE(warnsOf(*document, "2 connections link an object to itself"));
}

TEST(Connections, DropsUnknownKindsAndIncompleteOnes) {
    const auto document = modelsAnd({1, 2}, R"(
        C: "XX",1,2
        C: "OO",1
        C: 
        C: "OO","1","2")");
    EXPECT_EQ(document->connections.size(), 2U); // only those to the root that were added
    EXPECT_TRUE(isConnected(*document, 1, 0));
    EXPECT_TRUE(isConnected(*document, 2, 0));
}

TEST(Connections, KeepsTheFirstOfDoubledOnesAndTheOrder) {
    const auto document = modelsAnd({1, 2, 3}, R"(
        C: "OO",3,1
        C: "OO",2,1
        C: "OO",3,1
        C: "OP",2,1, "a"
        C: "OP",2,1, "b"
        C: "OP",2,1, "a"
        C: "OO",1,0)");
    ASSERT_EQ(document->connections.size(), 5U);
    EXPECT_EQ(document->connections[0].source, 3);
    EXPECT_EQ(document->connections[1].source, 2);
    EXPECT_EQ(document->connections[2].destinationProperty, "a");
    EXPECT_EQ(document->connections[3].destinationProperty, "b");
    EXPECT_EQ(document->connections[4].destination, 0);
}

TEST(Connections, KeepsTheFirstOfTwoParents) {
    const auto document = modelsAnd({1, 2, 3}, R"(
        C: "OO",1,0
        C: "OO",2,0
        C: "OO",3,2
        C: "OO",3,1
        C: "OO",3,0)");
    EXPECT_TRUE(isConnected(*document, 3, 2));
    EXPECT_FALSE(isConnected(*document, 3, 1));
    EXPECT_FALSE(isConnected(*document, 3, 0));
    EXPECT_TRUE(warnsOf(*document, "\"m3\" has more than one parent"));
}

TEST(Connections, AttachesModelsWithoutParentToTheRoot) {
    const auto document = modelsAnd({1, 2}, R"(C: "OO",2,1)");
    EXPECT_TRUE(isConnected(*document, 1, 0));
    EXPECT_FALSE(isConnected(*document, 2, 0));
}

TEST(Connections, AConnectionToAPropertyIsNoParent) {
    const auto document = modelsAnd({1, 2}, R"(C: "OP",1,2, "LookAtProperty")");
    EXPECT_TRUE(isConnected(*document, 1, 0));
    EXPECT_TRUE(isConnected(*document, 1, 2, "LookAtProperty"));
}

TEST(Connections, AConnectionToAnotherKindOfObjectIsNoParent) {
    const auto document = modelsAnd({1}, R"(C: "OO",1,9)", R"(Deformer: 9, "SubDeformer::c", "Cluster" { })");
    EXPECT_TRUE(isConnected(*document, 1, 9));
    EXPECT_TRUE(isConnected(*document, 1, 0));
}

TEST(Connections, LeavesUnconnectedViewsUnconnected) {
    const auto document = modelsAnd({}, R"(C: "OO",3,0)", R"(
        Model: 1, "Model::Producer Perspective", "Camera" { }
        Model: 2, "Model::Camera Switcher", "CameraSwitcher" { }
        Model: 3, "Model::Producer Top", "Camera" { }
        Model: 4, "Model::Producer Front", "Null" { }
        Model: 5, "Model::Producer", "Camera" { })");
    EXPECT_EQ(sourceNames(*document, 0, "Model"), (Names{"Producer Top", "Producer Front", "Producer"}));
}

TEST(Connections, BreaksACycleAtItsFirstModel) {
    const auto document = modelsAnd({1, 2, 3}, R"(
        C: "OO",1,2
        C: "OO",2,3
        C: "OO",3,1)");
    EXPECT_TRUE(isConnected(*document, 1, 0));
    EXPECT_TRUE(isConnected(*document, 2, 3));
    EXPECT_TRUE(isConnected(*document, 3, 1));
    EXPECT_TRUE(warnsOf(*document, "\"m1\" is its own ancestor"));
}

TEST(Connections, BreaksACycleWithDescendants) {
    const auto document = modelsAnd({1, 2, 3, 4}, R"(
        C: "OO",1,2
        C: "OO",2,3
        C: "OO",3,2
        C: "OO",4,0)");
    EXPECT_TRUE(isConnected(*document, 1, 2));
    EXPECT_TRUE(isConnected(*document, 2, 0));
    EXPECT_TRUE(isConnected(*document, 3, 2));
    EXPECT_EQ(document->connections.size(), 4U);
}

TEST(Connections, WithoutAnyAllModelsAreBelowTheRoot) {
    const auto document = documentOf("7.5.0", R"(Objects: { Model: 2, "Model::b", "Null" { }
                                                            Model: 1, "Model::a", "Null" { } })");
    EXPECT_EQ(sourceNames(*document, 0, "Model"), (Names{"b", "a"}));
}

} // namespace
} // namespace fbxsdk::detail
