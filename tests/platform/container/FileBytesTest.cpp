// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files that are read in parts, and changed by others meanwhile.
#include "container/FileBytes.h"

#include <filesystem>
#include <fstream>
#include <string>
#include <thread>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include "support/TemporaryFolder.h"

namespace fbxsdk::detail {
namespace {

class FileBytesTest : public testing::Test {
protected:
    FileBytesTest() : mContent(kSize, '\0') {
        for (std::size_t i = 0; i < kSize; ++i)
            mContent[i] = static_cast<char>(i % 251);
    }
    std::shared_ptr<const FileBytes> open() {
        const std::string name = mFolder.write("file", mContent);
        FbxStatus status;
        auto file = FileBytes::open(name, status);
        EXPECT_TRUE(file) << status.GetErrorString();
        return file;
    }
    static std::string text(std::span<const char> bytes) { return {bytes.begin(), bytes.end()}; }
    template <class Work>
    static std::string faultOf(const Work& work) {
        try {
            work();
        } catch (const FileFault& fault) {
            const std::string sentence = fault.what();
            return sentence.substr(sentence.find(": ") + 2);
        }
        return {};
    }

    static constexpr std::size_t kSize = 300'000;
    support::TemporaryFolder mFolder;
    std::string mContent;
};

TEST_F(FileBytesTest, HoldsWhatWasFetched) {
    const auto file = open();
    const auto part = file->bytes().subspan(1000, 200'000);
    file->fetch(part);
    EXPECT_EQ(text(part), mContent.substr(1000, 200'000));
}

TEST_F(FileBytesTest, ReadsToSomewhereElse) {
    const auto file = open();
    std::string bytes(5000, ' ');
    file->read(file->bytes().last(5000), bytes.data());
    EXPECT_EQ(bytes, mContent.substr(kSize - 5000));
}

TEST_F(FileBytesTest, KeepsWhatWasFetchedWhenTheFileIsShortened) {
    const auto file = open();
    file->fetch(file->bytes().first(1000));
    std::filesystem::resize_file(mFolder.file("file"), 10);

    EXPECT_EQ(text(file->bytes().first(1000)), mContent.substr(0, 1000));
    std::string bytes(1000, ' ');
    EXPECT_EQ(faultOf([&] { file->fetch(file->bytes().last(1000)); }), "the file was changed while it was read");
    EXPECT_EQ(faultOf([&] { file->read(file->bytes().first(1000), bytes.data()); }),
              "the file was changed while it was read");
}

TEST_F(FileBytesTest, NoticesBytesThatWereWrittenOver) {
    const auto file = open();
    mFolder.write("file", std::string(kSize, 'x'));

    std::string bytes(1000, ' ');
    EXPECT_EQ(faultOf([&] { file->read(file->bytes().first(1000), bytes.data()); }),
              "the file was changed while it was read");
    EXPECT_EQ(faultOf([&] { file->requireUnchanged(); }), "the file was changed while it was read");
}

TEST_F(FileBytesTest, GoesOnWithAFileThatIsReplaced) {
    const auto file = open();
    mFolder.write("other", std::string(10, 'x'));
    std::filesystem::rename(mFolder.file("other"), mFolder.file("file"));

    std::string bytes(kSize, ' ');
    file->read(file->bytes(), bytes.data());
    EXPECT_EQ(bytes, mContent);
}

TEST_F(FileBytesTest, AreFetchedAheadOfAReader) {
    const auto file = open();
    ReadAhead ahead(file->bytes(), file.get());
    for (const std::size_t offset : {0UL, 27UL, 5000UL, 5001UL, 100'000UL, 250'000UL, kSize - 1}) {
        ahead.need(offset, 1);
        EXPECT_EQ(file->bytes()[offset], mContent[offset]) << offset;
    }
    ahead.need(kSize, 0);
    ReadAhead whole(file->bytes(), file.get());
    whole.need(file->bytes());
    EXPECT_EQ(text(file->bytes()), mContent);
}

TEST_F(FileBytesTest, ComeThroughPipes) {
    ASSERT_EQ(mkfifo(mFolder.file("pipe").c_str(), 0600), 0);
    const int both = ::open(mFolder.file("pipe").c_str(), O_RDWR | O_CLOEXEC); // the writer is opened before the reader
    std::jthread writer([&] {
        std::ofstream(mFolder.file("pipe"), std::ios::binary) << mContent;
        ::close(both);
    });
    FbxStatus status;
    const auto file = FileBytes::open(mFolder.file("pipe"), status);
    ASSERT_TRUE(file) << status.GetErrorString();

    EXPECT_EQ(text(file->bytes()), mContent);
    std::string bytes(1000, ' ');
    file->read(file->bytes().last(1000), bytes.data());
    EXPECT_EQ(bytes, mContent.substr(kSize - 1000));
    file->requireUnchanged();
}

TEST(SmallFileBytes, AreAllReadWhenTheFileIsOpened) {
    const support::TemporaryFolder folder;
    const std::string name = folder.write("file", "the old content");
    FbxStatus status;
    const auto file = FileBytes::open(name, status);
    ASSERT_NE(file, nullptr) << status.GetErrorString();
    EXPECT_TRUE(file->isComplete());
    (void)folder.write("file", "new");

    EXPECT_EQ(std::string(file->bytes().data(), file->bytes().size()), "the old content");
    file->requireUnchanged();

    const auto large = FileBytes::open(folder.write("large", std::string(70000, 'x')), status);
    ASSERT_NE(large, nullptr) << status.GetErrorString();
    EXPECT_FALSE(large->isComplete());
}

#if defined(__has_feature)
#if __has_feature(address_sanitizer)
TEST(FileBytesDeathTest, LetsTheSanitizerSeeALookAtBytesThatWereNotFetched) {
    const support::TemporaryFolder folder;
    FbxStatus status;
    const auto file = FileBytes::open(folder.write("file", std::string(100000, 'x')), status);
    ASSERT_NE(file, nullptr) << status.GetErrorString();
    file->fetch(file->bytes().first(100));

    const volatile char* const bytes = file->bytes().data();
    EXPECT_EQ(bytes[99], 'x');
    EXPECT_DEATH((void)(bytes[104] == 'x'), "use-after-poison");
}
#endif
#endif

} // namespace
} // namespace fbxsdk::detail
