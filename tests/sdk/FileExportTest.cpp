// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Saving a scene: which writer and version are chosen, and what happens when a file cannot be written.
#include "support/TemporaryFolder.h"
#include "support/WritingBuilders.h"

#include "TnFbxError.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>

namespace Tarnell::Fbx {
namespace {

using support::TemporaryFolder;
using test::WrittenScene;
using testing::HasSubstr;
using testing::StartsWith;
using Version = TnFbxWriteInfo::eCompatibilityVersion;

constexpr Version kNewest = TnFbxWriteInfo::kFbxVersion2016;

/// A scene with one null and a folder to save it in.
struct SaveScene : WrittenScene {
    SaveScene() {
        null.setName("null");
        test::WrittenObjects objects;
        objects.nulls = {&null};
        EXPECT_TRUE(create(objects));
    }

    bool save(bool ascii, Version version = kNewest, bool embed = false) {
        return sdk.saveScene(manager, scene, folder.file("shot.fbx"), ascii, version, embed);
    }
    std::string saved() const { return folder.read("shot.fbx"); }

    TemporaryFolder folder;
    TnFbxNull null;
};

bool isBinary(const std::string& bytes) { return bytes.rfind("Kaydara FBX Binary", 0) == 0; }

/// The version in the header of a binary file.
int versionOf(const std::string& bytes) {
    int version = 0;
    for (std::size_t i = 4; bytes.size() >= 27 && i-- > 0;)
        version = version * 256 + static_cast<unsigned char>(bytes[23 + i]);
    return version;
}

TEST(FileExport, WritesTextForTheAsciiFlag) {
    SaveScene scene;

    EXPECT_TRUE(scene.save(/*ascii*/ true)) << lastError();

    EXPECT_THAT(scene.saved(), StartsWith("; FBX 7.5.0 project file"));
    EXPECT_TRUE(lastError().empty());
}

TEST(FileExport, WritesBinaryWithoutTheFlag) {
    SaveScene scene;

    EXPECT_TRUE(scene.save(/*ascii*/ false)) << lastError();

    EXPECT_TRUE(isBinary(scene.saved()));
}

TEST(FileExport, TakesTheNativeWriterForEmbeddedMediaWhateverTheFlag) {
    SaveScene scene;
    const auto* registry = scene.manager->GetIOPluginRegistry();
    ASSERT_THAT(registry->GetWriterFormatDescription(registry->GetNativeWriterFormat()), HasSubstr("binary"));

    EXPECT_TRUE(scene.save(/*ascii*/ true, kNewest, /*embed*/ true)) << lastError();
    EXPECT_TRUE(isBinary(scene.saved()));
    EXPECT_TRUE(scene.save(/*ascii*/ false, kNewest, /*embed*/ true)) << lastError();
    EXPECT_TRUE(isBinary(scene.saved()));
}

TEST(FileExport, WritesTheRequestedVersionAndTheNewestForAnInvalidOne) {
    const std::pair<int, int> versions[] = {{0, 6100}, {1, 7100}, {2, 7200},  {3, 7300},  {4, 7400},
                                            {5, 7500}, {6, 7500}, {17, 7500}, {-1, 7500}, {-2147483647, 7500}};
    for (const auto& [version, number] : versions) {
        SaveScene scene;
        EXPECT_TRUE(scene.save(/*ascii*/ false, static_cast<Version>(version))) << lastError();
        EXPECT_EQ(versionOf(scene.saved()), number) << version;
    }
}

TEST(FileExport, TakesNameFormatAndVersionFromTheOptions) {
    SaveScene scene;
    TnFbxWriteInfo info = test::writeInfo();
    info.setFileName(scene.folder.file("shot.fbx"));
    info.setFileFormat(false);
    info.setCompatibilityVersion(TnFbxWriteInfo::kFbxVersion2014);

    EXPECT_TRUE(scene.sdk.saveScene(info)) << lastError();
    EXPECT_TRUE(isBinary(scene.saved()));
    EXPECT_EQ(versionOf(scene.saved()), 7400);

    info.setFileFormat(true);
    EXPECT_TRUE(scene.sdk.saveScene(info)) << lastError();
    EXPECT_THAT(scene.saved(), StartsWith("; FBX 7.4.0 project file"));
}

TEST(FileExport, AttachesItsSettingsNowhere) {
    SaveScene scene;

    EXPECT_TRUE(scene.save(/*ascii*/ true)) << lastError();

    EXPECT_EQ(scene.manager->GetIOSettings(), nullptr);
}

TEST(FileExport, LeavesTheSceneAsItWas) {
    SaveScene scene;

    EXPECT_TRUE(scene.save(/*ascii*/ true)) << lastError();
    EXPECT_TRUE(scene.save(/*ascii*/ true)) << lastError();

    EXPECT_EQ(scene.childNames(), std::vector<std::string>{"null"});
}

TEST(FileExport, FailsWithoutAFileNameOrFolder) {
    SaveScene scene;

    testing::internal::CaptureStdout();
    EXPECT_FALSE(scene.sdk.saveScene(scene.manager, scene.scene, "", true, kNewest, false));
    EXPECT_FALSE(lastError().empty());
    const std::string nowhere = scene.folder.file("no folder/shot.fbx");
    EXPECT_FALSE(scene.sdk.saveScene(scene.manager, scene.scene, nowhere, true, kNewest, false));
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "");

    EXPECT_THAT(lastError(), StartsWith(nowhere + ": "));
}

TEST(FileExport, FailsForAFolderInThePlaceOfTheFile) {
    SaveScene scene;
    std::filesystem::create_directory(scene.folder.file("shot.fbx"));

    EXPECT_FALSE(scene.save(/*ascii*/ true));

    EXPECT_THAT(lastError(), HasSubstr("shot.fbx"));
}

TEST(FileExport, FailsWithoutAManagerOrADocument) {
    SaveScene scene;
    const std::string file = scene.folder.file("shot.fbx");
    FbxSdk fresh;

    EXPECT_FALSE(fresh.saveScene(test::writeInfo()));
    EXPECT_FALSE(lastError().empty());
    EXPECT_FALSE(scene.sdk.saveScene(nullptr, scene.scene, file, true, kNewest, false));
    EXPECT_THAT(lastError(), HasSubstr("shot.fbx"));
    EXPECT_FALSE(scene.sdk.saveScene(scene.manager, nullptr, file, true, kNewest, false));
    EXPECT_THAT(lastError(), HasSubstr("shot.fbx"));
    EXPECT_FALSE(std::filesystem::exists(file));
}

} // namespace
} // namespace Tarnell::Fbx
