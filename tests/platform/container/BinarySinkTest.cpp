// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Binary files, byte by byte.
#include "container/BinarySink.h"

#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <fbxsdk/extensions/Threads.h>

#include "support/RecordText.h"
#include "support/SinkOutput.h"

namespace fbxsdk::detail {
namespace {

using namespace std::string_literals;
using support::Container;
using support::sinkBytes;

constexpr std::size_t kHeaderSize = 27;

void emitCount(RecordSink& sink) {
    sink.beginRecord("Count");
    sink.integer(1);
    sink.endRecord();
}

std::string binaryBytes(std::uint32_t version, const support::Emit& emit) {
    return sinkBytes(Container::binary, version, emit);
}

std::size_t footerSize(std::size_t sizeBeforeFooter) {
    const std::size_t behindCode = sizeBeforeFooter + 16;
    return 16 + (16 - behindCode % 16) + 4 + 4 + 120 + 16;
}

TEST(BinarySink, BeginsWithTheHeader) {
    const std::string bytes = binaryBytes(7400, [](RecordSink&) {});

    EXPECT_EQ(bytes.substr(0, kHeaderSize), "Kaydara FBX Binary  \0\x1A\0\xE8\x1C\0\0"s);
}

TEST(BinarySink, WritesNarrowHeadsBelow7500) {
    const std::string bytes = binaryBytes(7400, emitCount);

    EXPECT_EQ(bytes.substr(kHeaderSize, 23), "\x32\0\0\0\1\0\0\0\5\0\0\0\5CountI\1\0\0\0"s);
    EXPECT_EQ(bytes.substr(kHeaderSize + 23, 13), std::string(13, '\0'));
}

TEST(BinarySink, WritesWideHeadsFrom7500On) {
    const std::string bytes = binaryBytes(7500, emitCount);

    EXPECT_EQ(bytes.substr(kHeaderSize, 35), "\x3E\0\0\0\0\0\0\0\1\0\0\0\0\0\0\0\5\0\0\0\0\0\0\0\5CountI\1\0\0\0"s);
    EXPECT_EQ(bytes.substr(kHeaderSize + 35, 25), std::string(25, '\0'));
}

TEST(BinarySink, EndsWithTheFooterOfItsTime) {
    const std::string bytes = binaryBytes(7400, [](RecordSink&) {});

    const std::size_t footer = kHeaderSize + 13;
    EXPECT_EQ(bytes.substr(footer, 16), "\xFA\xBC\xA9\x08\xD3\xCA\xD7\x65\xB0\x77\xF9\x84\x1B\xFC\x28\x7C"s);
    EXPECT_EQ(bytes.size(), footer + footerSize(footer));
    EXPECT_EQ(bytes.substr(bytes.size() - 140, 4), "\xE8\x1C\0\0"s);
    EXPECT_EQ(bytes.substr(bytes.size() - 144, 4), "\0\0\0\0"s);
    EXPECT_EQ(bytes.substr(bytes.size() - 16), "\xF8\x5A\x8C\x6A\xDE\xF5\xD9\x7E\xEC\xE9\x0C\xE3\x75\x8F\x29\x0B"s);
}

TEST(BinarySink, FillsUpToSixteenBytesAlsoWhenTheyAreFull) {
    // One text more or less moves the footer by a byte; one of sixteen sizes is aligned already.
    bool aligned = false;
    for (std::size_t length = 0; length < 16; ++length) {
        const std::string bytes = binaryBytes(7400, [&](RecordSink& sink) {
            sink.beginRecord("T");
            sink.text(std::string(length, 'x'));
            sink.endRecord();
        });
        const std::size_t footer = kHeaderSize + 13 + 1 + 5 + length + 13;
        aligned = aligned || footer % 16 == 0;
        EXPECT_EQ(bytes.size() % 16, 0U) << length;
        EXPECT_EQ(bytes.size(), footer + footerSize(footer)) << length;
    }
    EXPECT_TRUE(aligned);
}

TEST(BinarySink, CompressesArraysFrom1024BytesOn) {
    const auto headOf = [](std::size_t count) {
        const std::string bytes = binaryBytes(7400, [&](RecordSink& sink) {
            sink.beginRecord("A");
            sink.array(std::span<const double>(std::vector<double>(count, 2.5)));
            sink.endRecord();
        });
        return bytes.substr(kHeaderSize + 14, 9);
    };

    EXPECT_EQ(headOf(127), "d\x7F\0\0\0\0\0\0\0"s);
    EXPECT_EQ(headOf(128), "d\x80\0\0\0\1\0\0\0"s);
}

TEST(BinarySink, LeavesArraysRawThatDoNotShrink) {
    std::mt19937_64 random(1);
    std::vector<std::int64_t> noise(200);
    for (std::int64_t& number : noise)
        number = static_cast<std::int64_t>(random());

    const std::string bytes = binaryBytes(7400, [&](RecordSink& sink) {
        sink.beginRecord("A");
        sink.array(std::span<const std::int64_t>(noise));
        sink.endRecord();
    });

    EXPECT_EQ(bytes.substr(kHeaderSize + 14, 13), "l\xC8\0\0\0\0\0\0\0\x40\6\0\0"s);
}

TEST(BinarySink, GivesOlderVersionsAScalarPerElement) {
    const std::string bytes = binaryBytes(6100, [](RecordSink& sink) {
        sink.beginRecord("A");
        sink.array(std::span<const std::int32_t>(std::vector<std::int32_t>{1, -2}));
        sink.endRecord();
    });

    EXPECT_EQ(bytes.substr(kHeaderSize, 13 + 1 + 10), "\x33\0\0\0\2\0\0\0\x0A\0\0\0\1AI\1\0\0\0I\xFE\xFF\xFF\xFF"s);
}

TEST(BinarySink, RefusesAFileTooLargeForNarrowHeads) {
    MemoryOutput output;
    BinarySink sink(output, 7400, /*maxNarrowSize*/ 100);

    for (int i = 0; i < 4; ++i)
        emitCount(sink);

    EXPECT_TRUE(sink.failed());
    EXPECT_NE(sink.fault().find("7400"), std::string::npos) << sink.fault();
    EXPECT_NE(sink.fault().find("7500"), std::string::npos) << sink.fault();
}

TEST(BinarySink, RefusesAFileThatArraysOfOtherThreadsMakeTooLarge) {
    extensions::setMaximumThreads(3);
    MemoryOutput output;
    BinarySink sink(output, 7400, /*maxNarrowSize*/ 1000);

    const std::vector<std::int32_t> numbers(1000, 7);
    for (int i = 0; i < 30; ++i) {
        sink.beginRecord("Numbers");
        sink.array(std::span<const std::int32_t>(numbers));
        sink.endRecord();
    }
    sink.finish(support::kSampleTime);
    extensions::setMaximumThreads(1);

    EXPECT_TRUE(sink.failed());
    EXPECT_NE(sink.fault().find("7500"), std::string::npos) << sink.fault();
}

TEST(BinarySink, KeepsAnySizeWithWideHeads) {
    MemoryOutput output;
    BinarySink sink(output, 7500, /*maxNarrowSize*/ 100);

    for (int i = 0; i < 100; ++i)
        emitCount(sink);

    EXPECT_FALSE(sink.failed());
}

/// Discards its input.
class CountingOutput final : public ByteOutput {
public:
    void write(std::span<const char> bytes) override { mSize += bytes.size(); }
    void overwrite(std::uint64_t offset, std::span<const char> bytes) override {
        EXPECT_LE(offset + bytes.size(), mSize);
    }
    [[nodiscard]] std::uint64_t size() const override { return mSize; }
    [[nodiscard]] bool failed() const override { return false; }

private:
    std::uint64_t mSize = 0;
};

TEST(BinarySink, RefusesTheByteBehindTwoGibibytes) {
    constexpr std::size_t kTextSize = std::size_t{1} << 28;
    const std::string text(kTextSize, 'x');
    const auto sizeWithTail = [&](std::size_t tail) {
        CountingOutput output;
        BinarySink sink(output, 7400);
        for (int i = 0; i < 7; ++i) {
            sink.beginRecord("T");
            sink.text(text);
            sink.endRecord();
        }
        sink.beginRecord("T");
        sink.text(std::string_view(text).substr(0, tail));
        sink.endRecord();
        return std::pair(sink.size(), sink.failed());
    };
    const std::size_t rest = 0x7FFFFFFF - static_cast<std::size_t>(sizeWithTail(0).first);

    EXPECT_EQ(sizeWithTail(rest), std::pair(std::uint64_t{0x7FFFFFFF}, false));
    EXPECT_EQ(sizeWithTail(rest + 1), std::pair(std::uint64_t{0x80000000}, true));
}

} // namespace
} // namespace fbxsdk::detail
