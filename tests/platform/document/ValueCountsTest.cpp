// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Property lines that hold more numbers than their type has, and files that end between two sections.
#include "DocumentFromText.h"

namespace fbxsdk::detail {
namespace {

std::string errorOf(const std::string& text) {
    FbxStatus status;
    return tryDocument(text, &status) ? "" : status.GetErrorString();
}

std::string newFile(const std::string& line) {
    return "; FBX 7.4.0 project file\nObjects: {\n Model: 1, \"Model::m\", \"Null\" {\n  Properties70: {\n" + line +
           "\n } } }\n";
}
std::string oldFile(const std::string& line) {
    return "; FBX 6.1.0 project file\nObjects: {\n Model: \"Model::m\", \"Null\" {\n  Properties60: {\n" + line +
           "\n } } }\n";
}

TEST(ValueCounts, OfALineWithTooManyNumbersAreAnError) {
    EXPECT_EQ(errorOf(newFile(R"(P: "Lcl Translation", "Lcl Translation", "", "A",35,5,0,0)")),
              "test.fbx: line 5: the property \"Lcl Translation\" has more numbers than its type allows");
    EXPECT_EQ(errorOf(newFile(R"(P: "Size", "double", "Number", "",35,5)")),
              "test.fbx: line 5: the property \"Size\" has more numbers than its type allows");
    EXPECT_EQ(errorOf(oldFile(R"(Property: "Size", "double", "",35,5)")),
              "test.fbx: line 5: the property \"Size\" has more numbers than its type allows");
    EXPECT_EQ(errorOf("; FBX 7.4.0\nGlobalSettings: { Properties70: {\n"
                      "P: \"UnitScaleFactor\", \"double\", \"Number\", \"\",2,54\n} }\n"),
              "test.fbx: line 3: the property \"UnitScaleFactor\" has more numbers than its type allows");
}

TEST(ValueCounts, OfSoundLinesAreNone) {
    for (const char* line :
         {R"(P: "Lcl Translation", "Lcl Translation", "", "A",35.5,0,0)", R"(P: "Size", "double", "Number", "",35)",
          R"(P: "Choice", "enum", "", "",1, "a~b")", R"(P: "Own", "Number", "", "A+U",1,0,10)",
          R"(P: "Unknown", "matrix", "", "",1,2,3,4,5,6,7,8,9,10,11,12,13,14,15,16)",
          R"(P: "Short", "Vector3D", "", "")"})
        EXPECT_EQ(errorOf(newFile(line)), "") << line;
    EXPECT_EQ(errorOf(oldFile(R"(Property: "Own", "Number", "A+U",1,0,10)")), "");
}

TEST(CutOffFiles, AreRefusedWhereNothingElseShowsIt) {
    const std::string head = "; FBX 7.4.0\nDefinitions: { Count: 2\n ObjectType: \"GlobalSettings\" { Count: 1 }\n";
    const std::string models = head + " ObjectType: \"Model\" { Count: 1 } }\n";
    const std::string objects = "Objects: { Model: 1, \"Model::m\", \"Null\" { } }\n";
    EXPECT_EQ(errorOf("; FBX 7.4.0\nObjects:"), "test.fbx: the file ends before its objects");
    EXPECT_EQ(errorOf("; FBX 7.4.0\n" + objects + "Connections:  \n"),
              "test.fbx: the file ends before its connections");
    EXPECT_EQ(errorOf(models), "test.fbx: the file ends before its objects");
    EXPECT_EQ(errorOf(models + objects), "test.fbx: the file ends before its connections");
    EXPECT_EQ(errorOf(models + objects + "Connections: { }\n"), "");
    EXPECT_EQ(errorOf(head + "}\n"), "");
    EXPECT_EQ(errorOf("; FBX 7.4.0\n" + objects), "");
}

} // namespace
} // namespace fbxsdk::detail
