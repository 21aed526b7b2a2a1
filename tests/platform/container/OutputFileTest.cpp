// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A file is written completely or not at all, whatever fails.
#include "container/OutputFile.h"

#include <algorithm>
#include <array>
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

#include "support/AsNobody.h"
#include "support/FailingOperations.h"
#include "support/TemporaryFolder.h"

namespace fbxsdk::detail {
namespace {

namespace fs = std::filesystem;
using support::AsNobody;
using support::FailingOperations;
using support::TemporaryFolder;

std::span<const char> span(const std::string& text) { return {text.data(), text.size()}; }

bool writeFile(const std::string& name, const std::string& content, FbxStatus& status) {
    OutputFile file(name);
    if (!file.open(status))
        return false;
    file.write(span(content));
    return file.commit(status);
}

bool writeFile(const std::string& name, const std::string& content) {
    FbxStatus status;
    const bool written = writeFile(name, content, status);
    EXPECT_EQ(written, !status.Error()) << status.GetErrorString();
    return written;
}

TEST(OutputFile, AppearsWithItsContent) {
    const TemporaryFolder folder;

    EXPECT_TRUE(writeFile(folder.file("a.fbx"), "content"));

    EXPECT_EQ(folder.read("a.fbx"), "content");
    EXPECT_EQ(folder.files(), std::vector<std::string>{"a.fbx"});
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
    EXPECT_EQ(folder.files(), std::vector<std::string>{"a.fbx"});
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
        if (expected.size() > (1 << 18) && expected.size() < (1 << 18) + 20000)
            for (std::size_t offset = (1 << 18) - 20000; offset < expected.size() - 100; offset += 97)
                change(offset, "0123456789");
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
    EXPECT_EQ(folder.files().size(), 1U);
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
    EXPECT_TRUE(folder.files().empty());
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
    EXPECT_TRUE(folder.files().empty());
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
    EXPECT_EQ(folder.files().size(), 1U);
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

TEST(OutputFile, GivesUpAPipeWithoutAReader) {
    const TemporaryFolder folder;
    const std::string pipe = folder.file("pipe");
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    FbxStatus status;

    EXPECT_FALSE(writeFile(pipe, "content", status));

    EXPECT_EQ(std::string(status.GetErrorString()), pipe + ": cannot be written: no process reads the pipe");
    EXPECT_TRUE(fs::is_fifo(pipe));
}

TEST(OutputFile, WritesToAStreamWhoseLinkLeadsToNoName) {
    std::array<int, 2> ends{};
    ASSERT_EQ(::pipe2(ends.data(), O_CLOEXEC), 0);

    EXPECT_TRUE(writeFile("/proc/self/fd/" + std::to_string(ends[1]), "content"));

    std::array<char, 16> received{};
    EXPECT_EQ(::read(ends[0], received.data(), received.size()), 7);
    EXPECT_EQ(std::string(received.data()), "content");
    ::close(ends[0]);
    ::close(ends[1]);
}

TEST(OutputFile, WritesNothingToTheNullDevice) {
    EXPECT_TRUE(writeFile("/dev/null", "content"));
    EXPECT_TRUE(fs::is_character_file("/dev/null"));
}

TEST(OutputFile, IsOnTheMediumButNotUnderItsNameWhenItIsComplete) {
    const TemporaryFolder folder;
    folder.write("a.fbx", "old");
    FbxStatus status;
    OutputFile file(folder.file("a.fbx"));
    ASSERT_TRUE(file.open(status));
    file.write(span("new"));

    EXPECT_TRUE(file.complete(status));
    EXPECT_TRUE(file.complete(status)) << "once more changes nothing";

    EXPECT_EQ(folder.read("a.fbx"), "old");
    EXPECT_TRUE(file.commit(status)) << status.GetErrorString();
    EXPECT_EQ(folder.read("a.fbx"), "new");
    EXPECT_EQ(folder.files().size(), 1U);
}

bool writeLargeFile(const std::string& name, FileOperations& operations, FbxStatus& status) {
    OutputFile file(name, operations);
    if (!file.open(status))
        return false;
    for (int i = 0; i < 10; ++i)
        file.write(span(std::string(100000, 'x')));
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
        EXPECT_EQ(folder.files().size(), 1U) << failAt;
    }
}

TEST(OutputFile, ExtendsWithZeros) {
    const TemporaryFolder folder;
    FbxStatus status;
    OutputFile file(folder.file("a.fbx"));
    ASSERT_TRUE(file.open(status));
    std::string expected;

    for (const std::size_t size : {3U, 2U, 7U, (1U << 18) + 7, (1U << 20), (1U << 20) + 1}) {
        file.write(span("x"));
        expected += 'x';
        file.extend(size);
        expected.resize(std::max(size, expected.size()));
        EXPECT_EQ(file.size(), expected.size());
        file.overwrite(expected.size() / 2, span("y"));
        expected[expected.size() / 2] = 'y';
    }

    ASSERT_TRUE(file.commit(status)) << status.GetErrorString();
    EXPECT_TRUE(folder.read("a.fbx") == expected);
}

TEST(OutputFile, ExtendsBeyondWhatFitsInMemoryOrOnTheMedium) {
    const TemporaryFolder folder;
    constexpr std::uint64_t kSize = std::uint64_t{1} << 36U;
    FbxStatus status;
    OutputFile file(folder.file("a.fbx"));
    ASSERT_TRUE(file.open(status));

    file.extend(kSize);

    EXPECT_TRUE(file.commit(status)) << status.GetErrorString();
    EXPECT_EQ(fs::file_size(folder.file("a.fbx")), kSize);
}

/// Records the largest number of bytes that are passed at once.
class MeasuringOperations final : public FileOperations {
public:
    int write(int file, std::span<const char> bytes) override {
        mLargest = std::max(mLargest, bytes.size());
        return FileOperations::write(file, bytes);
    }
    [[nodiscard]] std::size_t largest() const { return mLargest; }

private:
    std::size_t mLargest = 0;
};

TEST(OutputFile, DoesNotGatherInMemoryWhatAPipeGets) {
    const TemporaryFolder folder;
    const std::string pipe = folder.file("pipe");
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    std::string received;
    std::thread reader([&] { received = folder.read("pipe"); });
    FbxStatus status;
    MeasuringOperations operations;
    OutputFile file(pipe, operations);
    ASSERT_TRUE(file.open(status));
    std::string expected;
    for (char c = 'a'; c <= 'z'; ++c) {
        file.write(span(std::string(100003, c)));
        expected.append(100003, c);
    }
    file.extend(expected.size() + (1 << 19));
    expected.resize(expected.size() + (1 << 19));
    file.overwrite(3, span("ABC"));
    expected.replace(3, 3, "ABC");

    EXPECT_TRUE(file.commit(status)) << status.GetErrorString();

    reader.join();
    EXPECT_TRUE(received == expected);
    EXPECT_LE(operations.largest(), std::size_t{1} << 18);
}

// ---- Files that belong together ----

bool writePair(const TemporaryFolder& folder, FbxStatus& status, FileOperations& operations,
               const char* secondName = "second") {
    OutputFile first(folder.file("first"), operations), second(folder.file(secondName), operations);
    if (!first.open(status) || !second.open(status))
        return false;
    first.write(span("new first"));
    second.write(span("new second"));
    OutputFile* const both[] = {&first, &second};
    return OutputFile::commitTogether(both, status);
}

TEST(OutputFilesTogether, AllAppear) {
    const TemporaryFolder folder;
    folder.write("second", "old");
    FbxStatus status;

    EXPECT_TRUE(writePair(folder, status, systemFileOperations())) << status.GetErrorString();
    EXPECT_TRUE(writePair(folder, status, systemFileOperations())) << status.GetErrorString();

    EXPECT_EQ(folder.read("first"), "new first");
    EXPECT_EQ(folder.read("second"), "new second");
    EXPECT_EQ(folder.files(), (std::vector<std::string>{"first", "second"}));
}

TEST(OutputFilesTogether, SurviveAFaultInEverySingleOperation) {
    for (const bool replacing : {false, true}) {
        const TemporaryFolder folder;
        FbxStatus status;
        const auto restore = [&] {
            for (const char* name : {"first", "second"}) {
                fs::remove(folder.file(name));
                if (replacing)
                    folder.write(name, std::string("old ") + name);
            }
        };
        restore();
        const std::vector<std::string> before = folder.files();
        FailingOperations none(-1);
        ASSERT_TRUE(writePair(folder, status, none));
        ASSERT_GE(none.calls(), 11); // create, write, flush, close and rename each, and a link

        for (int failAt = 0; failAt < none.calls(); ++failAt) {
            restore();
            FailingOperations operations(failAt);
            status.Clear();

            EXPECT_FALSE(writePair(folder, status, operations)) << failAt;

            EXPECT_TRUE(status.Error()) << failAt;
            EXPECT_EQ(folder.files(), before) << failAt;
            if (replacing) {
                EXPECT_EQ(folder.read("first"), "old first") << failAt;
                EXPECT_EQ(folder.read("second"), "old second") << failAt;
            }
        }
    }
}

TEST(OutputFilesTogether, OfOneNameAreTheLastOneOrWhatStoodThereBefore) {
    const TemporaryFolder folder;
    FbxStatus status;
    FailingOperations none(-1);
    ASSERT_TRUE(writePair(folder, status, none, "first")) << status.GetErrorString();
    EXPECT_EQ(folder.read("first"), "new second");
    for (const bool replacing : {false, true}) {
        for (int failAt = 0; failAt < none.calls(); ++failAt) {
            fs::remove(folder.file("first"));
            if (replacing)
                folder.write("first", "old");
            const std::vector<std::string> before = folder.files();
            FailingOperations operations(failAt);

            const bool written = writePair(folder, status, operations, "first");

            EXPECT_FALSE(written) << failAt;
            EXPECT_EQ(folder.files(), before) << failAt;
            EXPECT_EQ(folder.read("first"), replacing ? "old" : "") << failAt;
        }
    }
}

/// A file system without hard links.
class WithoutLinks final : public FileOperations {
public:
    int link(const std::string&, const std::string&) override { return EPERM; }
};

TEST(OutputFilesTogether, AppearWhereThereAreNoLinks) {
    const TemporaryFolder folder;
    folder.write("first", "old");
    FbxStatus status;
    WithoutLinks operations;

    EXPECT_TRUE(writePair(folder, status, operations)) << status.GetErrorString();

    EXPECT_EQ(folder.read("first"), "new first");
    EXPECT_EQ(folder.files(), (std::vector<std::string>{"first", "second"}));
}

TEST(OutputFile, TakesAnotherNameWhenAnotherProcessWritesInTheFolder) {
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
    EXPECT_EQ(folder.files().size(), 1U);
}

} // namespace
} // namespace fbxsdk::detail
