// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From a file name to records: what cannot be opened, what is no FBX file, and what is kept in memory.
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <string>

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include "container/Record.h"
#include "support/BinaryRecordBuilder.h"
#include "support/RecordText.h"

using fbxsdk::FbxStatus;
using fbxsdk::detail::readRecords;

namespace {

/// A folder of its own for each test.
class ReadRecords : public testing::Test {
protected:
    ReadRecords()
        : mFolder(std::filesystem::temp_directory_path() /
                  ("tarnell-read-records-" + std::to_string(getpid()) + "-" +
                   testing::UnitTest::GetInstance()->current_test_info()->name())) {
        std::filesystem::create_directories(mFolder);
    }
    ~ReadRecords() override { std::filesystem::remove_all(mFolder); }

    [[nodiscard]] std::string path(const std::string& name) const { return mFolder / name; }
    std::string write(const std::string& name, std::string_view bytes) const {
        std::ofstream(path(name), std::ios::binary) << bytes;
        return path(name);
    }
    /// The message of a refusal, without the file name in front.
    [[nodiscard]] static std::string refusal(const std::string& fileName) {
        FbxStatus status;
        EXPECT_FALSE(readRecords(fileName, status));
        EXPECT_TRUE(status.Error());
        const std::string sentence = status.GetErrorString();
        EXPECT_TRUE(sentence.starts_with(fileName + ": ")) << sentence;
        return sentence.substr(std::min(sentence.size(), fileName.size() + 2));
    }

private:
    std::filesystem::path mFolder;
};

TEST_F(ReadRecords, SaysWhyAFileCannotBeOpened) {
    EXPECT_EQ(refusal(path("missing.fbx")), "cannot be opened: No such file or directory");
    EXPECT_EQ(refusal(path(".")), "cannot be opened: Is a directory");
    EXPECT_EQ(refusal(write("file", "x") + "/below.fbx"), "cannot be opened: Not a directory");
    EXPECT_EQ(refusal(""), "cannot be opened: No such file or directory");
    EXPECT_EQ(refusal("/dev/null"), "cannot be opened: neither a regular file nor a pipe");
}

TEST_F(ReadRecords, DoesNotWaitForAPipe) {
    ASSERT_EQ(mkfifo(path("pipe.fbx").c_str(), 0600), 0);

    EXPECT_EQ(refusal(path("pipe.fbx")), "the pipe is empty");
}

TEST_F(ReadRecords, SaysThatAFileMayNotBeRead) {
    const std::string name = write("secret.fbx", "; FBX 7.5.0\n");
    std::filesystem::permissions(name, std::filesystem::perms::none);
    if (access(name.c_str(), R_OK) == 0) {
        // Some users may read everything; then there is nothing to refuse.
        FbxStatus status;
        EXPECT_TRUE(readRecords(name, status));
        return;
    }
    EXPECT_EQ(refusal(name), "cannot be opened: Permission denied");
}

TEST_F(ReadRecords, RefusesAnEmptyFile) { EXPECT_EQ(refusal(write("empty.fbx", "")), "the file is empty"); }

TEST_F(ReadRecords, RefusesWhatIsNoFbxFile) {
    const std::string expected = "neither a binary nor an ASCII FBX file";
    EXPECT_EQ(refusal(write("a.fbx", "x")), expected);
    EXPECT_EQ(refusal(write("b.fbx", "{\"json\": 1}")), expected);
    EXPECT_EQ(refusal(write("c.fbx", "title: some other format\n")), expected);
    EXPECT_EQ(refusal(write("d.fbx", "; only a comment\n")), expected);
    EXPECT_EQ(refusal(write("e.fbx", std::string(100, '\0'))), expected);
    EXPECT_EQ(refusal(write("f.fbx", "Kaydara FBX Binary")), expected);
    EXPECT_EQ(refusal(write("g.fbx", "; FBX 7.5 project file\nA: 1")), expected);
    EXPECT_EQ(refusal(write("h.fbx", "; FBX 7.50.0 project file\nA: 1")), expected);
    EXPECT_EQ(refusal(write("i.fbx", "Objects { }")), expected);
}

TEST_F(ReadRecords, DetectsTheContainerByContentAlone) {
    FbxStatus status;
    const auto ascii = readRecords(write("scene.bin", "\xEF\xBB\xBF\r\n; made by hand\r\nObjects : {}"), status);
    ASSERT_TRUE(ascii) << status.GetErrorString();
    EXPECT_TRUE(ascii->ascii);

    const auto binary = readRecords(write("scene.txt", BinaryRecordBuilder(7400).begin("A").end().finish()), status);
    ASSERT_TRUE(binary) << status.GetErrorString();
    EXPECT_FALSE(binary->ascii);
}

TEST_F(ReadRecords, KeepsTheFileAliveWithTheTree) {
    const std::string name = write("scene.fbx", "; FBX 7.5.0\nA: \"text\", *2 { a: 1,2 }");
    FbxStatus status;
    const auto tree = readRecords(name, status);
    ASSERT_TRUE(tree) << status.GetErrorString();
    std::filesystem::remove(name);

    EXPECT_EQ(recordsText(tree->root), "A: \"text\", [1 2]");
    EXPECT_EQ(tree->fileName, name);
    EXPECT_EQ(tree->fileSize, 36U);
}

TEST_F(ReadRecords, ReadsAFileOfExactlyOnePage) {
    std::string text = "; FBX 7.5.0\nA: *1 { a: 1 }\nB: ";
    text += std::string(static_cast<std::size_t>(sysconf(_SC_PAGESIZE)) - text.size(), '7');
    FbxStatus status;

    const auto tree = readRecords(write("page.fbx", text), status);

    ASSERT_TRUE(tree) << status.GetErrorString();
    EXPECT_EQ(tree->root.childValue("B").type, fbxsdk::detail::Value::Type::real);
}

TEST_F(ReadRecords, ClearsAnOldFaultAfterSuccess) {
    FbxStatus status(FbxStatus::eFailure);

    ASSERT_TRUE(readRecords(write("scene.fbx", "; FBX 7.5.0"), status));

    EXPECT_FALSE(status.Error());
    EXPECT_STREQ(status.GetErrorString(), "");
}

TEST_F(ReadRecords, SurvivesFormatCharactersInNames) {
    EXPECT_EQ(refusal(path("100%s%n.fbx")), "cannot be opened: No such file or directory");
    EXPECT_EQ(readText("; FBX 7.5.0\nA: 1%s%n"), "test.fbx: line 2: expected a number instead of '1%s%n'");
}

TEST(ReadRecordsFromMemory, RefusesNothing) {
    EXPECT_EQ(readText(""), "test.fbx: neither a binary nor an ASCII FBX file");
}

} // namespace
