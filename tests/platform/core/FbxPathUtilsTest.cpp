// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Paths as text, and folders on disk.
#include <filesystem>
#include <fstream>
#include <string>

#include <gtest/gtest.h>

#include <fbxsdk/FbxPathUtils.h>

namespace {

using namespace fbxsdk;
namespace fs = std::filesystem;

struct TextRow {
    const char* path;
    const char* expected;
};

/// A folder for this test, removed at its end.
class TemporaryFolder {
public:
    TemporaryFolder() {
        const auto* const info = testing::UnitTest::GetInstance()->current_test_info();
        mPath = fs::path(testing::TempDir()) / (std::string(info->test_suite_name()) + "_" + info->name());
        fs::remove_all(mPath);
        fs::create_directories(mPath);
    }
    ~TemporaryFolder() {
        std::error_code error;
        fs::remove_all(mPath, error);
    }
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;

    [[nodiscard]] std::string operator/(const std::string& name) const { return (mPath / name).string(); }

private:
    fs::path mPath;
};

TEST(FbxPathUtils, CleansPaths) {
    const TextRow rows[] = {
        {"a\\b/c", "a/b/c"},
        {"a//b///c", "a/b/c"},
        {"./a/./b/.", "a/b"},
        {"a/b/../c", "a/c"},
        {"a/../../b", "../b"},
        {"../../a", "../../a"},
        {"/../a", "/a"},
        {"/a/b/", "/a/b"},
        {"/", "/"},
        {"///a", "/a"},
        {"//server/share/../x", "//server/x"},
        {"//server/../../x", "//server/x"},
        {"\\\\server\\share\\x", "//server/share/x"},
        {"C:\\shots\\..\\a.fbx", "C:/a.fbx"},
        {"C:/../a", "C:/a"},
        {"c:", "c:/"},
        {"a:b.fbx", "a:b.fbx"}, // a file name; a drive is followed by a separator
        {"a/..", "."},
        {".", "."},
        {"", ""},
        {"...", "..."},
        {"a/.../b", "a/.../b"},
        {"\xC3\xA9t\xC3\xA9/./\xE5\xB1\xB1", "\xC3\xA9t\xC3\xA9/\xE5\xB1\xB1"},
    };
    for (const auto& [path, expected] : rows) {
        EXPECT_STREQ(FbxPathUtils::Clean(path), expected) << path;
        EXPECT_STREQ(FbxPathUtils::Clean(expected), expected) << "cleaned again";
    }
    EXPECT_STREQ(FbxPathUtils::Clean(nullptr), "");
}

TEST(FbxPathUtils, GivesTheFolderOfAFile) {
    const TextRow rows[] = {
        {"/a/out/shot.fbx", "/a/out"}, {"a\\shot.fbx", "a"}, {"shot.fbx", ""},   {"/shot.fbx", "/"},
        {"C:/shot.fbx", "C:/"},        {"a/b/", "a/b"},      {"a//b.fbx", "a"},  {"", ""},
        {"//server/x", "//server"},    {"/", "/"},           {"../x.fbx", ".."},
    };
    for (const auto& [path, expected] : rows)
        EXPECT_STREQ(FbxPathUtils::GetFolderName(path), expected) << path;
}

TEST(FbxPathUtils, GivesTheNameOfAFile) {
    EXPECT_STREQ(FbxPathUtils::GetFileName("/a/shot.v2.fbx"), "shot.v2.fbx");
    EXPECT_STREQ(FbxPathUtils::GetFileName("/a/shot.v2.fbx", false), "shot.v2");
    EXPECT_STREQ(FbxPathUtils::GetFileName("C:\\a.b\\shot", false), "shot");
    EXPECT_STREQ(FbxPathUtils::GetFileName("shot"), "shot");
    EXPECT_STREQ(FbxPathUtils::GetFileName("a/"), "");
    EXPECT_STREQ(FbxPathUtils::GetFileName(nullptr), "");
}

TEST(FbxPathUtils, GivesAndChangesExtensions) {
    EXPECT_STREQ(FbxPathUtils::GetExtensionName("/a.b/shot.tar.fbx"), "fbx");
    EXPECT_STREQ(FbxPathUtils::GetExtensionName("/a.b/shot"), "");
    EXPECT_STREQ(FbxPathUtils::GetExtensionName("shot."), "");
    EXPECT_STREQ(FbxPathUtils::ChangeExtension("/a.b/shot.fbx", "xml"), "/a.b/shot.xml");
    EXPECT_STREQ(FbxPathUtils::ChangeExtension("/a.b/shot.fbx", ".xml"), "/a.b/shot.xml");
    EXPECT_STREQ(FbxPathUtils::ChangeExtension("/a.b/shot", "xml"), "/a.b/shot.xml");
    EXPECT_STREQ(FbxPathUtils::ChangeExtension("shot.fbx", ""), "shot");
    EXPECT_STREQ(FbxPathUtils::ChangeExtension("shot.fbx", nullptr), "shot");
}

TEST(FbxPathUtils, BindsRootAndFile) {
    EXPECT_STREQ(FbxPathUtils::Bind("/a", "b/../c.fbx"), "/a/c.fbx");
    EXPECT_STREQ(FbxPathUtils::Bind("/a/", "b/../c.fbx", /*pCleanPath*/ false), "/a/b/../c.fbx");
    EXPECT_STREQ(FbxPathUtils::Bind("/a", "/b/c.fbx"), "/b/c.fbx");
    EXPECT_STREQ(FbxPathUtils::Bind("/a", "D:\\c.fbx"), "D:/c.fbx");
    EXPECT_STREQ(FbxPathUtils::Bind("", "c.fbx"), "c.fbx");
    EXPECT_STREQ(FbxPathUtils::Bind(nullptr, nullptr), "");
}

TEST(FbxPathUtils, TellsRelativePaths) {
    for (const char* const path : {"a", "a/b", "../a", "", "a:b", "./a"})
        EXPECT_TRUE(FbxPathUtils::IsRelative(path)) << path;
    for (const char* const path : {"/a", "\\a", "C:/a", "C:\\a", "//server/a", "\\\\server\\a"})
        EXPECT_FALSE(FbxPathUtils::IsRelative(path)) << path;
}

TEST(FbxPathUtils, GivesAFileAsSeenFromARootFolder) {
    struct Row {
        const char* root;
        const char* file;
        const char* expected;
    };
    const Row rows[] = {
        {"/a/out/", "/a/out/shot_fpc/ball.xml", "shot_fpc/ball.xml"},
        {"/a/out", "/a/out/shot_fpc/ball.xml", "shot_fpc/ball.xml"},
        {"/a/out/", "/a/in/ball.xml", "../in/ball.xml"},
        {"/a/b/c", "/x.xml", "../../../x.xml"},
        {"/a/outer", "/a/out/x.xml", "../out/x.xml"},
        {"C:\\a\\", "c:\\a\\b\\x.xml", "b/x.xml"},
        {"C:/a", "D:/a/x.xml", "D:/a/x.xml"},
        {"/a", "C:/a/x.xml", "C:/a/x.xml"},
        {"//server/a", "//server/a/x.xml", "x.xml"},
        {"//server/a", "//other/a/x.xml", "//other/a/x.xml"},
        {"/a/./b/../", "/a/c/../x.xml", "x.xml"},
        {"out", "out/x.xml", "x.xml"},
    };
    for (const auto& [root, file, expected] : rows)
        EXPECT_STREQ(FbxPathUtils::GetRelativeFilePath(root, file), expected) << root << ' ' << file;
    EXPECT_STREQ(FbxPathUtils::GetRelativePath("/a/b", "/a/b"), ".");
    EXPECT_STREQ(FbxPathUtils::GetRelativePath("/a/b", "/a/c"), "../c");
}

TEST(FbxPathUtils, ResolvesAgainstTheCurrentDirectory) {
    const std::string here = fs::current_path().string();
    EXPECT_EQ(std::string(FbxPathUtils::Resolve("shot.fbx")), here + "/shot.fbx");
    EXPECT_EQ(std::string(FbxPathUtils::Resolve("a\\..\\shot.fbx")), here + "/shot.fbx");
    EXPECT_EQ(std::string(FbxPathUtils::GetFolderName(FbxPathUtils::Resolve("shot.fbx"))), here);
    EXPECT_STREQ(FbxPathUtils::Resolve("/not/there/../x"), "/not/x");
    EXPECT_STREQ(FbxPathUtils::Resolve("C:\\a\\b"), "C:/a/b");
}

TEST(FbxPathUtils, CreatesFoldersWithTheirParents) {
    const TemporaryFolder folder;
    const std::string path = folder / "one/zw\xC3\xB6lf/three";

    EXPECT_FALSE(FbxPathUtils::Exist(path.c_str()));
    EXPECT_TRUE(FbxPathUtils::Create(path.c_str()));
    EXPECT_TRUE(FbxPathUtils::Exist(path.c_str()));
    EXPECT_TRUE(FbxPathUtils::Create(path.c_str())) << "exists already";
    EXPECT_TRUE(FbxPathUtils::Create((path + "/").c_str()));
    EXPECT_TRUE(FbxPathUtils::Create((path + "\\..\\four").c_str()));
    EXPECT_TRUE(fs::is_directory(folder / "one/zw\xC3\xB6lf/four"));
}

TEST(FbxPathUtils, CreatesNoFolderWhereAFileExists) {
    const TemporaryFolder folder;
    const std::string file = folder / "file";
    std::ofstream(file) << "x";

    EXPECT_FALSE(FbxPathUtils::Create(file.c_str()));
    EXPECT_FALSE(FbxPathUtils::Create((file + "/below").c_str()));
    EXPECT_FALSE(FbxPathUtils::Exist(file.c_str()));
    EXPECT_FALSE(FbxPathUtils::Create(""));
    EXPECT_FALSE(FbxPathUtils::Create(nullptr));
    EXPECT_FALSE(FbxPathUtils::Exist(nullptr));
}

TEST(FbxPathUtils, DeletesEmptyFoldersOnly) {
    const TemporaryFolder folder;
    const std::string path = folder / "a";
    FbxPathUtils::Create((path + "/b").c_str());

    EXPECT_FALSE(FbxPathUtils::IsEmpty(path.c_str()));
    EXPECT_FALSE(FbxPathUtils::Delete(path.c_str()));
    EXPECT_TRUE(FbxPathUtils::IsEmpty((path + "/b").c_str()));
    EXPECT_TRUE(FbxPathUtils::Delete((path + "/b").c_str()));
    EXPECT_TRUE(FbxPathUtils::Delete(path.c_str()));
    EXPECT_FALSE(FbxPathUtils::Delete(path.c_str()));
    EXPECT_FALSE(FbxPathUtils::IsEmpty(path.c_str()));
}

TEST(FbxPathUtils, GeneratesNamesThatAreFree) {
    const TemporaryFolder folder;
    const std::string root = folder / "";
    const std::string first(FbxPathUtils::GenerateFileName(root.c_str(), "shot"));
    std::ofstream(first) << "x";
    const std::string second(FbxPathUtils::GenerateFileName(root.c_str(), "shot"));
    EXPECT_NE(first, second);
    EXPECT_FALSE(fs::exists(second));
    EXPECT_EQ(fs::path(second).filename().string().rfind("shot", 0), 0U);
}

} // namespace
