// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A file is there completely or not at all, whatever fails.
#include "container/OutputFile.h"

#include <cerrno>
#include <filesystem>
#include <string>
#include <thread>
#include <vector>

#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include "support/TemporaryFolder.h"

namespace fbxsdk::detail {
namespace {

namespace fs = std::filesystem;
using support::TemporaryFolder;

std::span<const char> span(const std::string& text) { return {text.data(), text.size()}; }

std::vector<std::string> filesIn(const TemporaryFolder& folder) {
    std::vector<std::string> names;
    for (const auto& entry : fs::directory_iterator(folder.path())) {
        names.push_back(entry.path().filename());
    }
    return names;
}

bool writeFile(const std::string& name, const std::string& content, FbxStatus& status) {
    OutputFile file(name);
    if (!file.open(status)) {
        return false;
    }
    file.write(span(content));
    return file.commit(status);
}

bool writeFile(const std::string& name, const std::string& content) {
    FbxStatus status;
    const bool written = writeFile(name, content, status);
    EXPECT_EQ(written, !status.Error()) << status.GetErrorString();
    return written;
}

/// Runs as nobody, who owns nothing, for what a superuser would be allowed to do.
class AsNobody {
public:
    AsNobody() { mChanged = ::geteuid() == 0 && ::seteuid(kNobody) == 0; }
    AsNobody(const AsNobody&) = delete;
    AsNobody& operator=(const AsNobody&) = delete;
    ~AsNobody() {
        if (mChanged) {
            EXPECT_EQ(::seteuid(0), 0);
        }
    }

private:
    static constexpr uid_t kNobody = 65534;
    bool mChanged = false;
};

TEST(OutputFile, AppearsWithItsContent) {
    const TemporaryFolder folder;

    EXPECT_TRUE(writeFile(folder.file("a.fbx"), "content"));

    EXPECT_EQ(folder.read("a.fbx"), "content");
    EXPECT_EQ(filesIn(folder), std::vector<std::string>{"a.fbx"});
}

TEST(OutputFile, ReplacesWhatStoodThere) {
    const TemporaryFolder folder;
    folder.write("a.fbx", "a longer content than the new one");

    EXPECT_TRUE(writeFile(folder.file("a.fbx"), "new"));

    EXPECT_EQ(folder.read("a.fbx"), "new");
}

TEST(OutputFile, IsNotThereBeforeItIsComplete) {
    const TemporaryFolder folder;
    FbxStatus status;
    OutputFile file(folder.file("a.fbx"));

    ASSERT_TRUE(file.open(status));
    file.write(span(std::string(1 << 20, 'x')));

    EXPECT_FALSE(fs::exists(folder.file("a.fbx")));
}

TEST(OutputFile, LeavesNothingWhenItIsGivenUp) {
    const TemporaryFolder folder;
    folder.write("a.fbx", "old");
    {
        FbxStatus status;
        OutputFile file(folder.file("a.fbx"));
        ASSERT_TRUE(file.open(status));
        file.write(span(std::string(1 << 20, 'x')));
    }

    EXPECT_EQ(folder.read("a.fbx"), "old");
    EXPECT_EQ(filesIn(folder), std::vector<std::string>{"a.fbx"});
}

TEST(OutputFile, ChangesBytesThatAreOnTheMediumInTheBufferAndAcross) {
    const TemporaryFolder folder;
    std::string expected;
    FbxStatus status;
    OutputFile file(folder.file("a.fbx"));
    ASSERT_TRUE(file.open(status));
    const auto change = [&](std::size_t offset, const std::string& bytes) {
        file.overwrite(offset, span(bytes));
        expected.replace(offset, bytes.size(), bytes);
    };

    for (int i = 0; i < 70; ++i) { // beyond the buffer, in pieces that do not divide it
        const std::string piece(10007, static_cast<char>('a' + i % 26));
        file.write(span(piece));
        expected += piece;
        if (expected.size() > (1 << 18) && expected.size() < (1 << 18) + 20000) {
            for (std::size_t offset = (1 << 18) - 20000; offset < expected.size() - 100; offset += 97) {
                change(offset, "0123456789");
            }
        }
    }
    change(0, "first");
    change(expected.size() - 4, "last");
    const std::string large(1 << 20, 'L');
    file.write(span(large));
    expected += large;
    change(expected.size() - 4, "last");

    EXPECT_EQ(file.size(), expected.size());
    ASSERT_TRUE(file.commit(status)) << status.GetErrorString();
    EXPECT_TRUE(folder.read("a.fbx") == expected);
}

TEST(OutputFile, KeepsThePermissionsOfTheFileItReplaces) {
    const TemporaryFolder folder;
    folder.write("a.fbx", "old");
    fs::permissions(folder.file("a.fbx"), fs::perms(0640));

    EXPECT_TRUE(writeFile(folder.file("a.fbx"), "new"));

    EXPECT_EQ(fs::status(folder.file("a.fbx")).permissions(), fs::perms(0640));
}

TEST(OutputFile, HasThePermissionsThatTheProcessGivesNewFiles) {
    const TemporaryFolder folder;
    const mode_t before = ::umask(027);

    EXPECT_TRUE(writeFile(folder.file("a.fbx"), "new"));

    ::umask(before);
    EXPECT_EQ(fs::status(folder.file("a.fbx")).permissions(), fs::perms(0640));
}

TEST(OutputFile, ReplacesTheFileBehindALinkAndLeavesTheLink) {
    const TemporaryFolder folder;
    folder.write("real/a.fbx", "old");
    fs::create_symlink("real/a.fbx", folder.file("link.fbx"));

    EXPECT_TRUE(writeFile(folder.file("link.fbx"), "new"));

    EXPECT_TRUE(fs::is_symlink(folder.file("link.fbx")));
    EXPECT_EQ(folder.read("real/a.fbx"), "new");
}

TEST(OutputFile, MakesTheFileThatALinkLeadsTo) {
    const TemporaryFolder folder;
    fs::create_symlink("later.fbx", folder.file("link.fbx"));

    EXPECT_TRUE(writeFile(folder.file("link.fbx"), "new"));

    EXPECT_EQ(folder.read("later.fbx"), "new");
}

TEST(OutputFile, RefusesLinksThatLeadToEachOther) {
    const TemporaryFolder folder;
    fs::create_symlink("b", folder.file("a"));
    fs::create_symlink("a", folder.file("b"));
    FbxStatus status;

    EXPECT_FALSE(writeFile(folder.file("a"), "new", status));
    EXPECT_TRUE(status.Error());
}

TEST(OutputFile, WorksWithTheLongestNameThereIs) {
    const TemporaryFolder folder;
    const std::string name(255, 'n');

    EXPECT_TRUE(writeFile(folder.file(name), "content"));

    EXPECT_EQ(folder.read(name), "content");
}

TEST(OutputFile, WorksInTheCurrentFolder) {
    const TemporaryFolder folder;
    const fs::path before = fs::current_path();
    fs::current_path(folder.path());

    EXPECT_TRUE(writeFile("plain.fbx", "content"));

    fs::current_path(before);
    EXPECT_EQ(folder.read("plain.fbx"), "content");
    EXPECT_EQ(filesIn(folder).size(), 1U);
}

TEST(OutputFile, RefusesAFolder) {
    const TemporaryFolder folder;
    FbxStatus status;

    EXPECT_FALSE(writeFile(folder.path(), "content", status));
    EXPECT_NE(std::string(status.GetErrorString()).find(folder.path()), std::string::npos);
}

TEST(OutputFile, RefusesAFolderThatIsNotThere) {
    const TemporaryFolder folder;
    FbxStatus status;

    EXPECT_FALSE(writeFile(folder.file("none/a.fbx"), "content", status));
    EXPECT_TRUE(status.Error());
    EXPECT_TRUE(filesIn(folder).empty());
}

TEST(OutputFile, RefusesAFolderThatCannotBeWrittenTo) {
    const TemporaryFolder folder;
    folder.write("a.fbx", "old");
    fs::permissions(folder.path(), fs::perms(0555));
    FbxStatus status;
    {
        const AsNobody nobody;
        EXPECT_FALSE(writeFile(folder.file("a.fbx"), "new", status));
    }
    EXPECT_TRUE(status.Error());
    EXPECT_EQ(folder.read("a.fbx"), "old");
}

TEST(OutputFile, RefusesAFileThatIsLocked) {
    const TemporaryFolder folder;
    folder.write("a.fbx", "old");
    fs::permissions(folder.path(), fs::perms(0777));
    fs::permissions(folder.file("a.fbx"), fs::perms(0444));
    FbxStatus status;
    {
        const AsNobody nobody;
        EXPECT_FALSE(writeFile(folder.file("a.fbx"), "new", status));
    }
    EXPECT_EQ(folder.read("a.fbx"), "old");
}

TEST(OutputFile, FailsWhenItsFolderVanishes) {
    const TemporaryFolder folder;
    fs::create_directory(folder.file("sub"));
    FbxStatus status;
    OutputFile file(folder.file("sub/a.fbx"));
    ASSERT_TRUE(file.open(status));
    file.write(span("content"));

    fs::remove_all(folder.file("sub"));

    EXPECT_FALSE(file.commit(status));
    EXPECT_TRUE(status.Error());
    EXPECT_TRUE(filesIn(folder).empty());
}

TEST(OutputFile, FailsOnAMediumThatIsFull) {
    FbxStatus status;

    EXPECT_FALSE(writeFile("/dev/full", "content", status));

    EXPECT_NE(std::string(status.GetErrorString()).find("No space left"), std::string::npos) << status.GetErrorString();
}

TEST(OutputFile, FailsAtTheLargestSizeAFileMayHave) {
    const TemporaryFolder folder;
    folder.write("a.fbx", "old");
    rlimit before{};
    ASSERT_EQ(::getrlimit(RLIMIT_FSIZE, &before), 0);
    const rlimit small{1 << 16, before.rlim_max};
    const auto signalBefore = ::signal(SIGXFSZ, SIG_IGN);
    ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &small), 0);
    FbxStatus status;

    const bool written = writeFile(folder.file("a.fbx"), std::string(1 << 20, 'x'), status);

    ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &before), 0);
    ::signal(SIGXFSZ, signalBefore);
    EXPECT_FALSE(written);
    EXPECT_TRUE(status.Error());
    EXPECT_EQ(folder.read("a.fbx"), "old");
    EXPECT_EQ(filesIn(folder).size(), 1U);
}

TEST(OutputFile, SendsEverythingThroughAPipe) {
    const TemporaryFolder folder;
    const std::string pipe = folder.file("pipe");
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    std::string received;
    std::thread reader([&] { received = folder.read("pipe"); });
    FbxStatus status;
    OutputFile file(pipe);
    ASSERT_TRUE(file.open(status));
    file.write(span(std::string(1 << 20, 'x')));

    file.overwrite(3, span("abc"));

    EXPECT_TRUE(file.commit(status)) << status.GetErrorString();
    reader.join();
    EXPECT_EQ(received.size(), std::size_t{1} << 20);
    EXPECT_EQ(received.substr(0, 8), "xxxabcxx");
    EXPECT_TRUE(fs::is_fifo(pipe));
}

TEST(OutputFile, FailsWithoutASignalWhenAPipeBreaks) {
    const TemporaryFolder folder;
    const std::string pipe = folder.file("pipe");
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    std::thread reader([&] {
        const int end = ::open(pipe.c_str(), O_RDONLY | O_CLOEXEC);
        char byte = 0;
        EXPECT_EQ(::read(end, &byte, 1), 1);
        ::close(end);
    });
    FbxStatus status;

    const bool written = writeFile(pipe, std::string(1 << 22, 'x'), status);

    reader.join();
    EXPECT_FALSE(written);
    EXPECT_NE(std::string(status.GetErrorString()).find("Broken pipe"), std::string::npos) << status.GetErrorString();
}

/// Fails at the operation whose turn it is.
class FailingOperations final : public FileOperations {
public:
    explicit FailingOperations(int failAt) : mFailAt(failAt) {}

    int create(const std::string& path, unsigned permissions, int& file) override {
        return fails() ? EIO : FileOperations::create(path, permissions, file);
    }
    int write(int file, std::span<const char> bytes) override {
        return fails() ? ENOSPC : FileOperations::write(file, bytes);
    }
    int writeAt(int file, std::uint64_t offset, std::span<const char> bytes) override {
        return fails() ? EIO : FileOperations::writeAt(file, offset, bytes);
    }
    int flush(int file) override { return fails() ? EIO : FileOperations::flush(file); }
    int close(int file) override {
        const int error = FileOperations::close(file);
        return fails() ? EIO : error;
    }
    int rename(const std::string& from, const std::string& to) override {
        return fails() ? EACCES : FileOperations::rename(from, to);
    }
    [[nodiscard]] int calls() const { return mCalls; }

private:
    bool fails() { return mCalls++ == mFailAt; }

    int mFailAt;
    int mCalls = 0;
};

bool writeLargeFile(const std::string& name, FileOperations& operations, FbxStatus& status) {
    OutputFile file(name, operations);
    if (!file.open(status)) {
        return false;
    }
    for (int i = 0; i < 10; ++i) {
        file.write(span(std::string(100000, 'x')));
    }
    file.overwrite(5, span("head"));
    file.write(span(std::string(1 << 20, 'y')));
    return file.commit(status);
}

TEST(OutputFile, SurvivesAFaultInEverySingleOperation) {
    const TemporaryFolder folder;
    FbxStatus status;
    FailingOperations none(-1);
    ASSERT_TRUE(writeLargeFile(folder.file("a.fbx"), none, status));
    const std::string complete = folder.read("a.fbx");
    ASSERT_GE(none.calls(), 8);
    folder.write("a.fbx", "old");

    for (int failAt = 0; failAt < none.calls(); ++failAt) {
        FailingOperations operations(failAt);
        status.Clear();

        EXPECT_FALSE(writeLargeFile(folder.file("a.fbx"), operations, status)) << failAt;

        EXPECT_TRUE(status.Error()) << failAt;
        EXPECT_NE(std::string(status.GetErrorString()).find("a.fbx"), std::string::npos) << failAt;
        EXPECT_EQ(folder.read("a.fbx"), "old") << failAt;
        EXPECT_EQ(filesIn(folder).size(), 1U) << failAt;
    }
}

TEST(OutputFile, TakesAnotherNameWhenSomebodyElseWritesInTheFolder) {
    const TemporaryFolder folder;
    FbxStatus status;
    OutputFile first(folder.file("a.fbx")), second(folder.file("a.fbx"));
    ASSERT_TRUE(first.open(status));
    ASSERT_TRUE(second.open(status));
    first.write(span("first"));
    second.write(span("second"));

    EXPECT_TRUE(first.commit(status));
    EXPECT_TRUE(second.commit(status));

    EXPECT_EQ(folder.read("a.fbx"), "second");
    EXPECT_EQ(filesIn(folder).size(), 1U);
}

} // namespace
} // namespace fbxsdk::detail
