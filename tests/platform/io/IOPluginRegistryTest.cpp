// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The list of formats, as hosts search it.
#include <fbxsdk/FbxIOPluginRegistry.h>

#include <climits>
#include <string>
#include <vector>

#include <fbxsdk/FbxString.h>

#include "platform/scene/SceneFixture.h"
#include "support/TemporaryFolder.h"

namespace {

using namespace fbxsdk;

class FbxIOPluginRegistryTest : public SceneFixture {
protected:
    [[nodiscard]] const FbxIOPluginRegistry& registry() const { return *manager->GetIOPluginRegistry(); }

    /// The first writer whose description contains the word; -1 without one. Hosts look for their encoding this way.
    [[nodiscard]] int firstWriterWith(const char* word) const {
        for (int i = 0; i < registry().GetWriterFormatCount(); ++i)
            if (registry().WriterIsFBX(i) && FbxString(registry().GetWriterFormatDescription(i)).Find(word) >= 0)
                return i;
        return -1;
    }
};

constexpr int kNoFormats[] = {-1, INT_MIN, 2, INT_MAX};

TEST_F(FbxIOPluginRegistryTest, IsOneForEachManager) {
    EXPECT_EQ(manager->GetIOPluginRegistry(), manager->GetIOPluginRegistry());
    FbxManager* other = FbxManager::Create();
    EXPECT_NE(other->GetIOPluginRegistry(), manager->GetIOPluginRegistry());
    other->Destroy();
}

TEST_F(FbxIOPluginRegistryTest, ListsBinaryBeforeAscii) {
    ASSERT_EQ(registry().GetWriterFormatCount(), 2);
    EXPECT_STREQ(registry().GetWriterFormatDescription(0), "FBX binary (*.fbx)");
    EXPECT_STREQ(registry().GetWriterFormatDescription(1), "FBX ascii (*.fbx)");
    EXPECT_EQ(firstWriterWith("binary"), 0);
    EXPECT_EQ(firstWriterWith("ascii"), 1);
}

TEST_F(FbxIOPluginRegistryTest, ReadsWhatItWrites) {
    ASSERT_EQ(registry().GetReaderFormatCount(), registry().GetWriterFormatCount());
    for (int i = 0; i < registry().GetReaderFormatCount(); ++i) {
        EXPECT_STREQ(registry().GetReaderFormatDescription(i), registry().GetWriterFormatDescription(i));
        EXPECT_STREQ(registry().GetReaderFormatExtension(i), "fbx");
        EXPECT_STREQ(registry().GetWriterFormatExtension(i), "fbx");
        EXPECT_TRUE(registry().ReaderIsFBX(i));
        EXPECT_TRUE(registry().WriterIsFBX(i));
    }
}

TEST_F(FbxIOPluginRegistryTest, HasBinaryForItsNativeFormat) {
    EXPECT_EQ(registry().GetNativeWriterFormat(), 0);
    EXPECT_EQ(registry().GetNativeReaderFormat(), 0);
}

TEST_F(FbxIOPluginRegistryTest, KnowsNoFormatOutOfRange) {
    for (const int format : kNoFormats) {
        EXPECT_STREQ(registry().GetWriterFormatDescription(format), "") << format;
        EXPECT_STREQ(registry().GetReaderFormatDescription(format), "") << format;
        EXPECT_STREQ(registry().GetWriterFormatExtension(format), "") << format;
        EXPECT_STREQ(registry().GetReaderFormatExtension(format), "") << format;
        EXPECT_FALSE(registry().WriterIsFBX(format)) << format;
        EXPECT_FALSE(registry().ReaderIsFBX(format)) << format;
        EXPECT_EQ(registry().GetWritableVersions(format), nullptr) << format;
    }
}

TEST_F(FbxIOPluginRegistryTest, FindsWritersByDescription) {
    EXPECT_EQ(registry().FindWriterIDByDescription("FBX binary (*.fbx)"), 0);
    EXPECT_EQ(registry().FindWriterIDByDescription("FBX ascii (*.fbx)"), 1);
    EXPECT_EQ(registry().FindWriterIDByDescription("FBX ASCII (*.fbx)"), -1);
    EXPECT_EQ(registry().FindWriterIDByDescription("ascii"), -1);
    EXPECT_EQ(registry().FindWriterIDByDescription(nullptr), -1);
}

TEST_F(FbxIOPluginRegistryTest, FindsTheNativeWriterByExtensionInAnyCase) {
    EXPECT_EQ(registry().FindWriterIDByExtension("fbx"), 0);
    EXPECT_EQ(registry().FindWriterIDByExtension("FBX"), 0);
    EXPECT_EQ(registry().FindWriterIDByExtension("obj"), -1);
    EXPECT_EQ(registry().FindWriterIDByExtension(""), -1);
    EXPECT_EQ(registry().FindWriterIDByExtension(nullptr), -1);
}

TEST_F(FbxIOPluginRegistryTest, ListsTheWritableVersionsOldestFirst) {
    const std::vector<std::string> expected = {"FBX201000", "FBX201100", "FBX201200",
                                               "FBX201300", "FBX201400", "FBX201600"};
    for (int format = 0; format < registry().GetWriterFormatCount(); ++format) {
        std::vector<std::string> versions;
        for (char const* const* each = registry().GetWritableVersions(format); *each; ++each)
            versions.emplace_back(*each);
        EXPECT_EQ(versions, expected);
    }
}

TEST_F(FbxIOPluginRegistryTest, DetectsReadersByContentWhateverTheName) {
    const support::TemporaryFolder folder;
    std::string binary("Kaydara FBX Binary  \0\x1a\0", 23);
    binary += std::string("\xe8\x1c\0\0", 4);
    int format = 7;

    EXPECT_TRUE(registry().DetectReaderFileFormat(folder.write("a.txt", binary).c_str(), format));
    EXPECT_EQ(format, 0);
    EXPECT_TRUE(registry().DetectReaderFileFormat(folder.write("b", "; FBX 7.4.0 project file\n").c_str(), format));
    EXPECT_EQ(format, 1);
}

TEST_F(FbxIOPluginRegistryTest, DetectsNoReaderForOtherFiles) {
    const support::TemporaryFolder folder;
    const std::string files[] = {folder.write("a.fbx", "solid cube\n"), folder.write("empty.fbx", ""),
                                 folder.file("missing.fbx"), folder.path()};
    for (const std::string& file : files) {
        int format = 7;
        EXPECT_FALSE(registry().DetectReaderFileFormat(file.c_str(), format)) << file;
        EXPECT_EQ(format, -1) << file;
    }
    int format = 7;
    EXPECT_FALSE(registry().DetectReaderFileFormat(nullptr, format));
    EXPECT_EQ(format, -1);
}

} // namespace
