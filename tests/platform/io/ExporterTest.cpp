// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The settings of an exporter before it writes: file, format, version.
#include <fbxsdk/FbxExporter.h>

#include <climits>
#include <filesystem>
#include <string>

#include <fbxsdk/FbxIOPluginRegistry.h>

#include "platform/scene/SceneFixture.h"
#include "support/TemporaryFolder.h"

namespace {

using namespace fbxsdk;

class FbxExporterTest : public SceneFixture {
protected:
    FbxExporterTest() : exporter(FbxExporter::Create(manager, "exporter")) {}

    void expectRefused(const char* name, int format) {
        EXPECT_FALSE(exporter->Initialize(name, format));
        EXPECT_EQ(exporter->GetStatus().GetCode(), FbxStatus::eInvalidParameter);
        EXPECT_STRNE(exporter->GetStatus().GetErrorString(), "");
        EXPECT_EQ(exporter->GetFileFormat(), -1);
        EXPECT_FALSE(exporter->Export(scene));
    }

    support::TemporaryFolder folder;
    FbxExporter* exporter;
};

TEST_F(FbxExporterTest, HasNoFormatBeforeItIsInitialized) {
    EXPECT_EQ(exporter->GetFileFormat(), -1);
    EXPECT_FALSE(exporter->Export(scene));
    EXPECT_EQ(exporter->GetStatus().GetCode(), FbxStatus::eFailure);
}

TEST_F(FbxExporterTest, TakesTheFormatItIsGiven) {
    for (const int format : {0, 1}) {
        EXPECT_TRUE(exporter->Initialize(folder.file("out.fbx").c_str(), format));
        EXPECT_EQ(exporter->GetFileFormat(), format);
        EXPECT_FALSE(exporter->GetStatus().Error());
    }
    EXPECT_STREQ(exporter->GetFileName().Buffer(), folder.file("out.fbx").c_str());
}

TEST_F(FbxExporterTest, FindsTheFormatByExtensionAndElseTakesTheNativeOne) {
    for (const char* name : {"out.fbx", "OUT.FBX", "out", "out.bin"}) {
        EXPECT_TRUE(exporter->Initialize(folder.file(name).c_str())) << name;
        EXPECT_EQ(exporter->GetFileFormat(), manager->GetIOPluginRegistry()->GetNativeWriterFormat()) << name;
    }
}

TEST_F(FbxExporterTest, MakesNoFileBeforeItExports) {
    ASSERT_TRUE(exporter->Initialize(folder.file("out.fbx").c_str()));

    EXPECT_FALSE(std::filesystem::exists(folder.file("out.fbx")));
}

TEST_F(FbxExporterTest, RefusesANullOrEmptyName) {
    expectRefused(nullptr, -1);
    expectRefused("", -1);
}

TEST_F(FbxExporterTest, RefusesANumberThatIsNoWriter) {
    for (const int format : {-2, 2, INT_MIN, INT_MAX})
        expectRefused(folder.file("out.fbx").c_str(), format);
}

TEST_F(FbxExporterTest, RefusesAFolderThatIsNotThereAndMakesNone) {
    expectRefused(folder.file("missing/out.fbx").c_str(), 0);
    EXPECT_FALSE(std::filesystem::exists(folder.file("missing")));
}

TEST_F(FbxExporterTest, RefusesToReplaceAFolder) { expectRefused(folder.path().c_str(), 0); }

TEST_F(FbxExporterTest, ForgetsTheFileWhenTheNextOneIsRefused) {
    ASSERT_TRUE(exporter->Initialize(folder.file("out.fbx").c_str()));

    expectRefused(folder.file("missing/out.fbx").c_str(), -1);
}

TEST_F(FbxExporterTest, TakesTheVersionsOfTheRegistryBeforeOrAfterInitialize) {
    for (const char* version : {"FBX201000", "FBX201100", "FBX201200", "FBX201300", "FBX201400", "FBX201600"})
        EXPECT_TRUE(exporter->SetFileExportVersion(version)) << version;
    ASSERT_TRUE(exporter->Initialize(folder.file("out.fbx").c_str()));
    EXPECT_TRUE(exporter->SetFileExportVersion("FBX201100", FbxSceneRenamer::eNone));
}

TEST_F(FbxExporterTest, RefusesOtherVersions) {
    for (const char* version : {"", "FBX201500", "fbx201600", "FBX2016001", "7400"})
        EXPECT_FALSE(exporter->SetFileExportVersion(version)) << version;
    EXPECT_FALSE(exporter->SetFileExportVersion(FbxString()));
}

TEST_F(FbxExporterTest, ListsTheVersionsOfTheRegistry) {
    EXPECT_EQ(exporter->GetCurrentWritableVersions(), manager->GetIOPluginRegistry()->GetWritableVersions(0));
    ASSERT_NE(exporter->GetCurrentWritableVersions(), nullptr);
    EXPECT_STREQ(exporter->GetCurrentWritableVersions()[0], "FBX201000");
}

TEST_F(FbxExporterTest, ExportsScenesOnly) {
    ASSERT_TRUE(exporter->Initialize(folder.file("out.fbx").c_str()));

    EXPECT_FALSE(exporter->Export(nullptr));
    EXPECT_EQ(exporter->GetStatus().GetCode(), FbxStatus::eInvalidParameter);
    EXPECT_FALSE(exporter->Export(FbxDocument::Create(manager, "plain")));
    EXPECT_EQ(exporter->GetStatus().GetCode(), FbxStatus::eInvalidParameter);
}

} // namespace
