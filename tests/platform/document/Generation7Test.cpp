// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files of the 7.x generation.
#include "DocumentFromText.h"

#include "document/TakeTimes.h"

#include "document/DocumentBuilder.h"

namespace fbxsdk::detail {
namespace {

TEST(Generation7, ReadsIdRecordSubClassAndNameOfAnObject) {
    const auto document = documentOf("7.5.0", R"(Objects: { Model: 12, "Model::cube", "Mesh" { Version: 232 } })");
    ASSERT_EQ(document->objects.size(), 1U);
    const DocumentObject& object = document->objects.front();
    EXPECT_EQ(object.id, 12);
    EXPECT_EQ(object.record, "Model");
    EXPECT_EQ(object.subClass, "Mesh");
    EXPECT_EQ(object.name, "cube");
    EXPECT_EQ(object.body->childValue("Version").toInteger(), 232);
}

TEST(Generation7, SplitsAsciiNamesAtTheFirstDoubleColon) {
    const auto document = documentOf("7.5.0", R"(Objects: { Model: 1, "Model::Cube::Model", "Null" { } })");
    EXPECT_EQ(document->objects.at(0).name, "Cube::Model");
}

TEST(Generation7, KeepsAnEmptyName) {
    const auto document = documentOf("7.5.0", R"(Objects: { Geometry: 1, "Geometry::", "Mesh" { } })");
    EXPECT_EQ(document->objects.at(0).name, "");
}

TEST(Generation7, TakesBinaryNamesUpToTheSeparator) {
    EXPECT_EQ(nameWithoutClass(std::string_view("pCube1\0\1Model", 13), /*ascii*/ false), "pCube1");
    EXPECT_EQ(nameWithoutClass(std::string_view("\0\1Geometry", 10), /*ascii*/ false), "");
    EXPECT_EQ(nameWithoutClass(std::string_view("a::b\0\1Model", 11), /*ascii*/ false), "a::b");
}

TEST(Generation7, KeepsABinaryNameWithoutSeparatorAsItIs) {
    EXPECT_EQ(nameWithoutClass("a::b", /*ascii*/ false), "a::b");
}

TEST(Generation7, ReadsPropertyLines) {
    const auto document = documentOf("7.5.0", R"(
        Objects: { Model: 1, "Model::a", "Null" { Properties70: {
            P: "Lcl Translation", "Lcl Translation", "", "A+",1,2.5,-3
            P: "UDP", "KString", "", "U", "text"
            P: "LookAtProperty", "object", "", ""
        } } })");
    const DocumentObject& object = document->objects.at(0);
    ASSERT_EQ(object.properties.size(), 3U);
    EXPECT_EQ(object.properties[0].typeName, "Lcl Translation");
    EXPECT_EQ(object.properties[0].flags, "A+");
    EXPECT_EQ(numbersOf(&object, "Lcl Translation"), (Numbers{1, 2.5, -3}));
    EXPECT_EQ(object.property("UDP")->values[0].toText(), "text");
    EXPECT_TRUE(object.property("LookAtProperty")->values.empty());
    EXPECT_EQ(object.property("lcl translation"), nullptr);
}

TEST(Generation7, FindsTheLastOfTwoPropertiesOfOneName) {
    const auto document = documentOf("7.5.0", R"(
        Objects: { Model: 1, "Model::a", "Null" { Properties70: {
            P: "Size", "double", "Number", "",1
            P: "Size", "double", "Number", "",2
        } } })");
    EXPECT_EQ(numbersOf(&document->objects.at(0), "Size"), (Numbers{2}));
}

TEST(Generation7, SkipsPropertyLinesWithoutName) {
    const auto document = documentOf("7.5.0", R"(
        Objects: { Model: 1, "Model::a", "Null" { Properties70: {
            P: 
            P: "", "double", "Number", "",1
            P: "Short"
        } } })");
    ASSERT_EQ(document->objects.at(0).properties.size(), 1U);
    EXPECT_EQ(document->objects.at(0).properties[0].name, "Short");
    EXPECT_TRUE(document->objects.at(0).properties[0].values.empty());
}

TEST(Generation7, KeepsTheFirstOfTwoObjectsWithOneId) {
    const auto document = documentOf("7.5.0", R"(
        Objects: { Model: 1, "Model::first", "Null" { }
                   Model: 2, "Model::other", "Null" { }
                   Model: 1, "Model::second", "Null" { } })");
    ASSERT_EQ(document->objects.size(), 2U);
    EXPECT_EQ(document->find(1)->name, "first");
    EXPECT_EQ(document->find(2)->name, "other");
    EXPECT_TRUE(warnsOf(*document, "1 objects have the id"));
}

TEST(Generation7, LeavesOutObjectsWithoutId) {
    const auto document = documentOf("7.5.0", R"(
        Objects: { Model: 0, "Model::root", "Null" { }
                   Model: "Model::named", "Null" { }
                   Model: 5, "Model::good", "Null" { } })");
    ASSERT_EQ(document->objects.size(), 1U);
    EXPECT_EQ(document->objects[0].name, "good");
    EXPECT_EQ(document->find(0), nullptr);
}

TEST(Generation7, AcceptsNegativeAndHugeIds) {
    const auto document = documentOf("7.5.0", R"(
        Objects: { Model: -5, "Model::a", "Null" { }
                   Model: 9223372036854775807, "Model::b", "Null" { }
                   Model: -9223372036854775808, "Model::c", "Null" { } }
        Connections: { C: "OO",-5,9223372036854775807 })");
    EXPECT_EQ(document->find(-5)->name, "a");
    EXPECT_EQ(document->find(INT64_MAX)->name, "b");
    EXPECT_EQ(document->find(INT64_MIN)->name, "c");
    EXPECT_TRUE(isConnected(*document, -5, INT64_MAX));
}

TEST(Generation7, ReadsTemplatesOfDefinitions) {
    const auto document = documentOf("7.5.0", R"(
        Definitions: { Version: 100
            Count: 2
            ObjectType: "GlobalSettings" { Count: 1 }
            ObjectType: "NodeAttribute" { Count: 1
                PropertyTemplate: "FbxLight" { Properties70: { P: "Intensity", "Number", "", "A",100 } } } }
        Objects: { })");
    ASSERT_EQ(document->templates.size(), 1U);
    EXPECT_EQ(document->templates[0].record, "NodeAttribute");
    EXPECT_EQ(document->templates[0].className, "FbxLight");
    EXPECT_EQ(numbersOf(&document->templates[0].properties.at(0)), (Numbers{100}));
}

TEST(Generation7, ReadsSettingsActiveStackAndCreator) {
    const auto document = documentOf("7.5.0", R"(
        Creator: "somebody"
        GlobalSettings: { Properties70: { P: "UpAxis", "int", "Integer", "",2 } }
        Documents: { Count: 1
            Document: 7, "", "Scene" { Properties70: { P: "ActiveAnimStackName", "KString", "", "", "walk" } } })");
    EXPECT_EQ(document->creator, "somebody");
    EXPECT_EQ(numbersOf(settingNamed(*document, "UpAxis")), (Numbers{2}));
    EXPECT_EQ(document->activeStackName, "walk");
}

TEST(Generation7, TakesCreatorAndActiveStackFromElsewhereWhenTheyAreMissing) {
    const auto document = documentOf("7.5.0", R"(
        FBXHeaderExtension: { Creator: "header" }
        Takes: { Current: "run" })");
    EXPECT_EQ(document->creator, "header");
    EXPECT_EQ(document->activeStackName, "run");
}

TEST(Generation7, GivesAStackWithoutTimesThoseOfItsTake) {
    const auto document = documentOf("7.1.0", R"(
        Objects: { AnimationStack: 1, "AnimStack::X", "" { }
                   AnimationStack: 2, "AnimStack::Y", "" { Properties70: { P: "LocalStop", "KTime", "Time", "",9 } } }
        Takes: { Current: "X"
            Take: "X" { LocalTime: 10,20
                        ReferenceTime: 30,40 }
            Take: "Y" { LocalTime: 50,60 } })");
    const DocumentObject* x = document->find(1);
    EXPECT_EQ(numbersOf(x, "LocalStart"), (Numbers{10}));
    EXPECT_EQ(numbersOf(x, "LocalStop"), (Numbers{20}));
    EXPECT_EQ(numbersOf(x, "ReferenceStop"), (Numbers{40}));
    EXPECT_EQ(numbersOf(document->find(2), "LocalStop"), (Numbers{9}));
    EXPECT_EQ(document->find(2)->property("LocalStart"), nullptr);
}

TEST(Generation7, ListsStacksWithTheirTimes) {
    const auto document = documentOf("7.1.0", R"(
        Objects: { AnimationStack: 1, "AnimStack::X", "" { Properties70: {
                       P: "Description", "KString", "", "","of X"
                       P: "ReferenceStop", "KTime", "Time", "",7 } } }
        Takes: { Current: "X"
            Take: "Y" { LocalTime: 50,60 }
            Take: "X" { LocalTime: 10,20
                        ReferenceTime: 30,40 } })");
    const std::vector<DocumentTake> takes = listTakes(*document);
    ASSERT_EQ(takes.size(), 1U);
    EXPECT_EQ(takes[0].name, "X");
    EXPECT_EQ(takes[0].description, "of X");
    EXPECT_EQ(takes[0].localStart, 10);
    EXPECT_EQ(takes[0].localStop, 20);
    EXPECT_EQ(takes[0].referenceStart, 0);
    EXPECT_EQ(takes[0].referenceStop, 7);
}

TEST(Generation7, ListsTheTakesOfAFileWithoutStacks) {
    const auto document = documentOf("7.1.0", R"(Takes: { Current: ""
        Take: "a" { LocalTime: 1,2 }
        Take: "b" { LocalTime: 3,4 } })");
    const std::vector<DocumentTake> takes = listTakes(*document);
    ASSERT_EQ(takes.size(), 2U);
    EXPECT_EQ(takes[1].name, "b");
    EXPECT_EQ(takes[1].localStop, 4);
}

TEST(Generation7, ReadsTakes) {
    const auto document = documentOf("7.1.0", R"(Takes: { Current: ""
        Take: "a b" { LocalTime: 1,2 }
        Take: "c" { ReferenceTime: 5
        } })");
    ASSERT_EQ(document->takes.size(), 2U);
    EXPECT_EQ(document->takes[0].name, "a b");
    EXPECT_TRUE(document->takes[0].hasLocal);
    EXPECT_EQ(document->takes[0].localStop, 2);
    EXPECT_FALSE(document->takes[0].hasReference);
    EXPECT_FALSE(document->takes[1].hasReference); // one number is no range
}

TEST(Generation7, RenamesOldPropertiesOfLights) {
    const auto document = documentOf("7.4.0", R"(
        Objects: { NodeAttribute: 1, "NodeAttribute::l", "Light" { Properties70: {
            P: "HotSpot", "Number", "", "A",10
            P: "Cone angle", "Number", "", "A",20
            P: "CastLight", "bool", "", "",1 } } })");
    const DocumentObject* light = document->find(1);
    EXPECT_EQ(numbersOf(light, "InnerAngle"), (Numbers{10}));
    EXPECT_EQ(numbersOf(light, "OuterAngle"), (Numbers{20}));
    EXPECT_EQ(numbersOf(light, "CastLightOnObject"), (Numbers{1}));
}

TEST(Generation7, LeavesAnOldPropertyAloneWhenTheNewOneIsThere) {
    const auto document = documentOf("7.4.0", R"(
        Objects: { NodeAttribute: 1, "NodeAttribute::l", "Light" { Properties70: {
            P: "HotSpot", "Number", "", "A",10
            P: "InnerAngle", "Number", "", "A",30 } } })");
    EXPECT_EQ(numbersOf(document->find(1), "InnerAngle"), (Numbers{30}));
    EXPECT_EQ(numbersOf(document->find(1), "HotSpot"), (Numbers{10}));
}

TEST(Generation7, RenamesNothingOnUsersProperties) {
    const auto document = documentOf("7.4.0", R"(
        Objects: { Model: 1, "Model::l", "Light" { Properties70: { P: "HotSpot", "Number", "", "AU",10 } } })");
    EXPECT_EQ(numbersOf(document->find(1), "HotSpot"), (Numbers{10}));
}

TEST(Generation7, AcceptsSectionsInAnyOrder) {
    const auto document = documentOf("7.5.0", R"(
        Takes: { Take: "X" { LocalTime: 10,20 } }
        Connections: { C: "OO",2,1 }
        Objects: { AnimationStack: 1, "AnimStack::X", "" { }
                   AnimationLayer: 2, "AnimLayer::L", "" { } })");
    EXPECT_TRUE(isConnected(*document, 2, 1));
    EXPECT_EQ(numbersOf(document->find(1), "LocalStop"), (Numbers{20}));
}

TEST(Generation7, KeepsObjectsInFileOrder) {
    const auto document = documentOf("7.5.0", R"(
        Objects: { AnimationStack: 9, "AnimStack::b", "" { }
                   AnimationStack: 3, "AnimStack::a", "" { }
                   AnimationStack: 5, "AnimStack::c", "" { } })");
    ASSERT_EQ(document->objects.size(), 3U);
    EXPECT_EQ(document->objects[0].name, "b");
    EXPECT_EQ(document->objects[1].name, "a");
    EXPECT_EQ(document->objects[2].name, "c");
}

TEST(Generation7, AnEmptyFileIsAnEmptyDocument) {
    const auto document = documentOf("7.5.0", "Objects: { }");
    EXPECT_TRUE(document->objects.empty());
    EXPECT_TRUE(document->connections.empty());
    EXPECT_TRUE(document->warnings.empty());
}

} // namespace
} // namespace fbxsdk::detail
