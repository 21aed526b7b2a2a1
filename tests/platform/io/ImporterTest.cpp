// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From a file to a scene: what is known before the import, what the import does, and the error when it fails.
#include <fbxsdk/FbxImporter.h>

#include <climits>
#include <string>

#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxNode.h>

#include "platform/scene/SceneFixture.h"
#include "support/TemporaryFolder.h"

namespace {

using namespace fbxsdk;

constexpr const char* kTwoStacks = R"(; FBX 7.4.0 project file
FBXHeaderExtension:  {
	FBXHeaderVersion: 1003
	FBXVersion: 7400
	Creator: "A hand"
}
GlobalSettings:  {
	Version: 1000
	Properties70:  {
		P: "UpAxis", "int", "Integer", "",2
		P: "FrontAxis", "int", "Integer", "",1
		P: "FrontAxisSign", "int", "Integer", "",-1
		P: "UnitScaleFactor", "double", "Number", "",100
		P: "AmbientColor", "ColorRGB", "Color", "",0.25,0.5,0.75
		P: "TimeMode", "enum", "", "",14
		P: "CustomFrameRate", "double", "Number", "",12.5
	}
}
Documents:  {
	Count: 1
	Document: 900, "", "Scene" {
		Properties70:  {
			P: "ActiveAnimStackName", "KString", "", "", "Walk"
		}
		RootNode: 0
	}
}
Objects:  {
	Model: 200, "Model::upper", "Null" {
		Version: 232
	}
	Model: 300, "Model::lower", "Null" {
		Version: 232
	}
	AnimationStack: 400, "AnimStack::Idle", "" {
		Properties70:  {
			P: "Description", "KString", "", "", "standing about"
			P: "LocalStop", "KTime", "Time", "",46186158000
		}
	}
	AnimationStack: 500, "AnimStack::Walk", "" {
	}
}
Connections:  {
	C: "OO",200,0
	C: "OO",300,200
}
Takes:  {
	Current: "Walk"
	Take: "Walk" {
		LocalTime: 46186158000,92372316000
		ReferenceTime: 0,138558474000
	}
}
)";

class FbxImporterTest : public SceneFixture {
protected:
    ~FbxImporterTest() override { FbxTime::SetGlobalTimeMode(FbxTime::eDefaultMode); }

    FbxImporter* opened(const std::string& file) {
        FbxImporter* importer = FbxImporter::Create(manager, "");
        EXPECT_TRUE(importer->Initialize(file.c_str())) << importer->GetStatus().GetErrorString();
        return importer;
    }
    FbxImporter* openedText(const char* text) { return opened(folder.write("scene.fbx", text)); }

    /// The importer must refuse the file, with the code and a message that names the file and contains the words.
    void expectRefused(const std::string& file, FbxStatus::EStatusCode code, const char* words) {
        FbxImporter* importer = FbxImporter::Create(manager, "");
        EXPECT_FALSE(importer->Initialize(file.c_str())) << file;
        EXPECT_EQ(importer->GetStatus().GetCode(), code) << file;
        const std::string sentence = importer->GetStatus().GetErrorString();
        EXPECT_NE(sentence.find(file), std::string::npos) << sentence;
        EXPECT_NE(sentence.find(words), std::string::npos) << sentence;
        EXPECT_FALSE(importer->IsFBX());
        EXPECT_FALSE(importer->Import(scene));
        EXPECT_EQ(scene->GetNodeCount(), 1);
    }

    support::TemporaryFolder folder;
};

TEST_F(FbxImporterTest, KnowsNothingBeforeAFileIsOpen) {
    FbxImporter* importer = FbxImporter::Create(manager, "importer");
    int major = 9, minor = 9, revision = 9;
    importer->GetFileVersion(major, minor, revision);

    EXPECT_FALSE(importer->IsFBX());
    EXPECT_EQ(importer->GetFileFormat(), -1);
    EXPECT_EQ(importer->GetAnimStackCount(), 0);
    EXPECT_EQ(importer->GetTakeInfo(0), nullptr);
    EXPECT_EQ(importer->GetFileHeaderInfo(), nullptr);
    EXPECT_STREQ(importer->GetFileName().Buffer(), "");
    EXPECT_STREQ(importer->GetActiveAnimStackName().Buffer(), "");
    EXPECT_EQ(major, 0);
    EXPECT_EQ(minor, 0);
    EXPECT_EQ(revision, 0);
    EXPECT_FALSE(importer->GetStatus().Error());
}

TEST_F(FbxImporterTest, TellsTheFactsOfTheFileBeforeTheImport) {
    const std::string file = folder.write("scene.fbx", kTwoStacks);
    FbxImporter* importer = opened(file);
    int major = 0, minor = 0, revision = 9;
    importer->GetFileVersion(major, minor, revision);

    EXPECT_TRUE(importer->IsFBX());
    EXPECT_STREQ(importer->GetFileName().Buffer(), file.c_str());
    EXPECT_EQ(major, 7);
    EXPECT_EQ(minor, 4);
    EXPECT_EQ(revision, 0);
    EXPECT_EQ(importer->GetFileFormat(), 1);
    EXPECT_STREQ(importer->GetActiveAnimStackName().Buffer(), "Walk");
    const FbxIOFileHeaderInfo* header = importer->GetFileHeaderInfo();
    ASSERT_NE(header, nullptr);
    EXPECT_EQ(header->mFileVersion, 7400);
    EXPECT_STREQ(header->mCreator.Buffer(), "A hand");
    EXPECT_TRUE(header->mASCII);
    EXPECT_TRUE(header->mWarnings.empty());
}

TEST_F(FbxImporterTest, ListsAnInfoForEveryStackOfTheFile) {
    FbxImporter* importer = openedText(kTwoStacks);
    ASSERT_EQ(importer->GetAnimStackCount(), 2);
    const FbxTakeInfo* idle = importer->GetTakeInfo(0);
    const FbxTakeInfo* walk = importer->GetTakeInfo(1);

    EXPECT_STREQ(idle->mName.Buffer(), "Idle");
    EXPECT_STREQ(idle->mImportName.Buffer(), "Idle");
    EXPECT_STREQ(idle->mDescription.Buffer(), "standing about");
    EXPECT_TRUE(idle->mSelect);
    EXPECT_EQ(idle->mLocalTimeSpan, FbxTimeSpan(FbxTime(0), FbxTime(FBXSDK_TC_SECOND)));
    EXPECT_STREQ(walk->mName.Buffer(), "Walk");
    EXPECT_EQ(walk->mLocalTimeSpan, FbxTimeSpan(FbxTime(FBXSDK_TC_SECOND), FbxTime(2 * FBXSDK_TC_SECOND)));
    EXPECT_EQ(walk->mReferenceTimeSpan, FbxTimeSpan(FbxTime(0), FbxTime(3 * FBXSDK_TC_SECOND)));
}

TEST_F(FbxImporterTest, HasNoInfoOutOfRange) {
    FbxImporter* importer = openedText(kTwoStacks);

    for (const int index : {-1, 2, INT_MIN, INT_MAX})
        EXPECT_EQ(importer->GetTakeInfo(index), nullptr) << index;
}

TEST_F(FbxImporterTest, FillsTheScene) {
    ASSERT_TRUE(openedText(kTwoStacks)->Import(scene));

    EXPECT_EQ(scene->GetNodeCount(), 3);
    ASSERT_EQ(scene->GetRootNode()->GetChildCount(), 1);
    FbxNode* upper = scene->GetRootNode()->GetChild(0);
    EXPECT_STREQ(upper->GetName(), "upper");
    ASSERT_EQ(upper->GetChildCount(), 1);
    EXPECT_STREQ(upper->GetChild(0)->GetName(), "lower");
    EXPECT_EQ(scene->GetSrcObjectCount<FbxAnimStack>(), 2);
}

TEST_F(FbxImporterTest, FillsTheGlobalSettings) {
    ASSERT_TRUE(openedText(kTwoStacks)->Import(scene));
    const FbxGlobalSettings& settings = scene->GetGlobalSettings();

    EXPECT_EQ(settings.GetAxisSystem(), FbxAxisSystem::Max);
    EXPECT_EQ(settings.GetSystemUnit(), FbxSystemUnit::m);
    EXPECT_EQ(settings.GetAmbientColor(), FbxColor(0.25, 0.5, 0.75));
    EXPECT_EQ(scene->GlobalLightSettings().GetAmbientColor(), FbxColor(0.25, 0.5, 0.75));
    EXPECT_EQ(settings.GetTimeMode(), FbxTime::eCustom);
    EXPECT_EQ(settings.GetCustomFrameRate(), 12.5);
}

TEST_F(FbxImporterTest, MakesTheScenesTimeModeTheGlobalOne) {
    FbxTime::SetGlobalTimeMode(FbxTime::ePAL);
    FbxImporter* importer = openedText(kTwoStacks);
    EXPECT_EQ(FbxTime::GetGlobalTimeMode(), FbxTime::ePAL);

    ASSERT_TRUE(importer->Import(scene));

    EXPECT_EQ(FbxTime::GetGlobalTimeMode(), FbxTime::eCustom);
    EXPECT_EQ(FbxTime::GetFrameRate(FbxTime::eDefaultMode), 12.5);
    EXPECT_EQ(FbxTime::GetFrameRate(FbxTime::eCustom), 12.5);
}

TEST_F(FbxImporterTest, KeepsTheFirstStackCurrentAndTellsWhichOneTheFileCallsActive) {
    ASSERT_TRUE(openedText(kTwoStacks)->Import(scene));

    ASSERT_NE(scene->GetCurrentAnimationStack(), nullptr);
    EXPECT_STREQ(scene->GetCurrentAnimationStack()->GetName(), "Idle");
    EXPECT_STREQ(scene->ActiveAnimStackName.Get().Buffer(), "Walk");
}

TEST_F(FbxImporterTest, LeavesTheFirstStackCurrentWhenTheActiveOneIsNotThere) {
    std::string text = kTwoStacks;
    const std::string active = R"("KString", "", "", "Walk")";
    text.replace(text.find(active), active.size(), R"("KString", "", "", "Gone")");
    ASSERT_TRUE(openedText(text.c_str())->Import(scene));

    ASSERT_NE(scene->GetCurrentAnimationStack(), nullptr);
    EXPECT_STREQ(scene->GetCurrentAnimationStack()->GetName(), "Idle");
    EXPECT_STREQ(scene->ActiveAnimStackName.Get().Buffer(), "Gone");
}

TEST_F(FbxImporterTest, AddsToTheSceneWhenItImportsAgain) {
    FbxImporter* importer = openedText(kTwoStacks);

    ASSERT_TRUE(importer->Import(scene));
    ASSERT_TRUE(importer->Import(scene));

    EXPECT_EQ(scene->GetRootNode()->GetChildCount(), 2);
    EXPECT_EQ(scene->GetNodeCount(), 5);
}

TEST_F(FbxImporterTest, LeavesASceneThatOutlivesIt) {
    FbxImporter* importer = openedText(kTwoStacks);
    ASSERT_TRUE(importer->Import(scene));

    importer->Destroy();

    EXPECT_STREQ(scene->GetNode(2)->GetName(), "lower");
}

TEST_F(FbxImporterTest, OpensOneFileAfterTheOther) {
    FbxImporter* importer = openedText(kTwoStacks);
    const std::string empty = folder.write("nothing.fbx", "; FBX 7.5.0 project file\nObjects:  {\n}\n");

    ASSERT_TRUE(importer->Initialize(empty.c_str())) << importer->GetStatus().GetErrorString();

    EXPECT_EQ(importer->GetAnimStackCount(), 0);
    EXPECT_EQ(importer->GetFileHeaderInfo()->mFileVersion, 7500);
    EXPECT_STREQ(importer->GetFileHeaderInfo()->mCreator.Buffer(), "");
    ASSERT_TRUE(importer->Import(scene));
    EXPECT_EQ(scene->GetNodeCount(), 1);
}

TEST_F(FbxImporterTest, ForgetsTheFileWhenTheNextOneFails) {
    FbxImporter* importer = openedText(kTwoStacks);

    EXPECT_FALSE(importer->Initialize(folder.file("missing.fbx").c_str()));

    EXPECT_FALSE(importer->IsFBX());
    EXPECT_EQ(importer->GetAnimStackCount(), 0);
    EXPECT_EQ(importer->GetFileHeaderInfo(), nullptr);
    EXPECT_FALSE(importer->Import(scene));
}

TEST_F(FbxImporterTest, TellsWhatWasRepaired) {
    FbxImporter* importer = openedText(R"(; FBX 7.4.0 project file
Objects:  {
	Model: 200, "Model::twice", "Null" {
	}
	Model: 200, "Model::again", "Null" {
	}
}
Connections:  {
	C: "OO",12345,200
}
)");

    EXPECT_FALSE(importer->GetFileHeaderInfo()->mWarnings.empty());
}

TEST_F(FbxImporterTest, AdoptsTheProducerCamerasOfAFile) {
    FbxImporter* importer = openedText(R"(; FBX 7.4.0 project file
Objects:  {
	NodeAttribute: 100, "NodeAttribute::Producer Top", "Camera" {
	}
	Model: 200, "Model::Producer Top", "Camera" {
	}
	NodeAttribute: 101, "NodeAttribute::Shot", "Camera" {
	}
	Model: 201, "Model::Producer Left", "Camera" {
	}
}
Connections:  {
	C: "OO",100,200
	C: "OO",101,201
	C: "OO",201,0
}
)");
    ASSERT_TRUE(importer->Import(scene));
    const FbxGlobalCameraSettings& settings = scene->GlobalCameraSettings();

    ASSERT_NE(settings.GetCameraProducerTop(), nullptr);
    EXPECT_STREQ(settings.GetCameraProducerTop()->GetNode(0)->GetName(), "Producer Top");
    EXPECT_EQ(settings.GetCameraProducerLeft(), nullptr); // that one is in the tree
    EXPECT_EQ(scene->GetRootNode()->GetChildCount(), 1);
}

TEST_F(FbxImporterTest, ImportsIntoScenesOnly) {
    FbxImporter* importer = openedText(kTwoStacks);

    for (FbxDocument* document : {static_cast<FbxDocument*>(nullptr), FbxDocument::Create(manager, "plain")}) {
        EXPECT_FALSE(importer->Import(document));
        EXPECT_EQ(importer->GetStatus().GetCode(), FbxStatus::eInvalidParameter);
        EXPECT_NE(std::string(importer->GetStatus().GetErrorString()).find("scene.fbx"), std::string::npos);
    }
    EXPECT_TRUE(importer->Import(scene));
    EXPECT_FALSE(importer->GetStatus().Error());
}

TEST_F(FbxImporterTest, ImportsNothingWithoutAFile) {
    FbxImporter* importer = FbxImporter::Create(manager, "");

    EXPECT_FALSE(importer->Import(scene));
    EXPECT_EQ(importer->GetStatus().GetCode(), FbxStatus::eFailure);
    EXPECT_STRNE(importer->GetStatus().GetErrorString(), "");
}

TEST_F(FbxImporterTest, RefusesANullOrEmptyName) {
    FbxImporter* importer = FbxImporter::Create(manager, "");

    for (const char* name : {static_cast<const char*>(nullptr), ""}) {
        EXPECT_FALSE(importer->Initialize(name));
        EXPECT_EQ(importer->GetStatus().GetCode(), FbxStatus::eInvalidParameter);
        EXPECT_STRNE(importer->GetStatus().GetErrorString(), "");
    }
}

TEST_F(FbxImporterTest, RefusesANumberThatIsNoReader) {
    const std::string file = folder.write("scene.fbx", kTwoStacks);
    FbxImporter* importer = FbxImporter::Create(manager, "");

    for (const int format : {-2, 2, INT_MIN, INT_MAX}) {
        EXPECT_FALSE(importer->Initialize(file.c_str(), format)) << format;
        EXPECT_EQ(importer->GetStatus().GetCode(), FbxStatus::eInvalidParameter) << format;
    }
    EXPECT_TRUE(importer->Initialize(file.c_str(), 0)); // the content decides, not the number
    EXPECT_EQ(importer->GetFileFormat(), 1);
}

TEST_F(FbxImporterTest, SaysThatAFileIsMissing) {
    expectRefused(folder.file("missing.fbx"), FbxStatus::eFailure, "cannot be opened");
}

TEST_F(FbxImporterTest, SaysThatAFolderIsNoFile) {
    FbxImporter* importer = FbxImporter::Create(manager, "");
    EXPECT_FALSE(importer->Initialize(folder.path().c_str()));
    EXPECT_NE(std::string(importer->GetStatus().GetErrorString()).find(folder.path()), std::string::npos);
}

TEST_F(FbxImporterTest, SaysThatAFileIsEmpty) {
    expectRefused(folder.write("empty.fbx", ""), FbxStatus::eInvalidFile, "empty");
}

TEST_F(FbxImporterTest, SaysThatAFileIsNoFbx) {
    expectRefused(folder.write("mesh.fbx", "solid cube\nfacet normal 0 0 1\n"), FbxStatus::eInvalidFile,
                  "neither a binary nor an ASCII FBX file");
}

TEST_F(FbxImporterTest, SaysWhichVersionIsNotSupported) {
    expectRefused(folder.write("future.fbx", "; FBX 9.0.0 project file\nObjects:  {\n}\n"),
                  FbxStatus::eInvalidFileVersion, "9000");
}

TEST_F(FbxImporterTest, SaysWhereABinaryFileEnds) {
    std::string header("Kaydara FBX Binary  \0\x1a\0", 23);
    header += std::string("\xe8\x1c\0\0", 4);
    expectRefused(folder.write("cut.fbx", header + std::string("\x20\0\0", 3)), FbxStatus::eInvalidFile, "offset");
}

TEST_F(FbxImporterTest, SaysInWhichLineAnAsciiFileBreaks) {
    expectRefused(folder.write("cut.fbx", "; FBX 7.4.0 project file\nObjects:  {\n\tModel: 1, \"Model::a\", \"Nu"),
                  FbxStatus::eInvalidFile, "line 3");
}

TEST_F(FbxImporterTest, OpensFilesWithNamesInAnyScript) {
    const std::string file = folder.write("Würfel 立方体.fbx", kTwoStacks);

    EXPECT_STREQ(opened(file)->GetFileName().Buffer(), file.c_str());
}

} // namespace
