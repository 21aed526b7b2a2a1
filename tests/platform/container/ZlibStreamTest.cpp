// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Streams in and out. Recent short ones are cached, which must not be observable.
#include "container/ZlibStream.h"

#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>

namespace {

using namespace fbxsdk::detail;

std::string contentOf(int number, std::size_t size = 1000) {
    std::string content(size, 'a');
    for (std::size_t i = 0; i < content.size(); ++i)
        content[i] = static_cast<char>('a' + (i / 16 + static_cast<std::size_t>(number)) % 20);
    return content;
}

std::string streamOf(const std::string& content) {
    Deflater deflater;
    const auto stream = deflater.deflated(content);
    return {stream.begin(), stream.end()};
}

/// Empty when the stream is damaged.
std::string inflated(const std::string& stream, std::size_t size) {
    std::string content(size, '?');
    return inflateExactly(stream, content) ? content : "";
}

TEST(ZlibStream, GivesEachOfManyStreamsItsContentHoweverOften) {
    std::vector<std::string> contents, streams;
    for (int i = 0; i < 20; ++i) {
        contents.push_back(contentOf(i));
        streams.push_back(streamOf(contents.back()));
    }
    for (const std::size_t step : {1U, 0U, 3U, 7U}) {
        for (std::size_t i = 0; i < 60; ++i) {
            const std::size_t number = i * step % streams.size();
            ASSERT_EQ(inflated(streams[number], 1000), contents[number]);
        }
    }
}

TEST(ZlibStream, GivesEachOfManyContentsItsStreamHoweverOften) {
    constexpr std::size_t kContents = 50; // more than are kept
    std::vector<std::string> contents, streams;
    for (std::size_t i = 0; i < kContents; ++i) {
        contents.push_back(contentOf(static_cast<int>(i), 1000 + i));
        streams.push_back(streamOf(contents.back()));
    }
    Deflater deflater;
    for (const std::size_t step : {1U, 0U, 3U, 7U}) {
        for (std::size_t i = 0; i < 3 * kContents; ++i) {
            const std::size_t number = i * step % kContents;
            const auto stream = deflater.deflated(contents[number]);
            ASSERT_EQ(std::string(stream.begin(), stream.end()), streams[number]);
        }
    }
}

TEST(ZlibStream, RefusesADamagedStreamBesideASoundOne) {
    const std::string content = contentOf(1), stream = streamOf(content);
    ASSERT_EQ(inflated(stream, content.size()), content);
    std::string damaged = stream;
    damaged.back() = static_cast<char>(damaged.back() ^ 1);
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(inflated(damaged, content.size()), "");
        EXPECT_EQ(inflated(stream, content.size()), content);
    }
}

TEST(ZlibStream, RefusesAnotherSizeThanTheStreamHas) {
    const std::string content = contentOf(1), stream = streamOf(content);
    ASSERT_EQ(inflated(stream, content.size()), content);
    EXPECT_EQ(inflated(stream, content.size() - 1), "");
    EXPECT_EQ(inflated(stream, content.size() + 1), "");
    EXPECT_EQ(inflated(stream, content.size()), content);
}

TEST(ZlibStream, InflatesLongStreams) {
    const std::string content = contentOf(1, 1'000'000), stream = streamOf(content);
    EXPECT_EQ(inflated(stream, content.size()), content);
    EXPECT_EQ(inflated(stream, content.size()), content);
}

TEST(ZlibStream, HasTheBytesOfContentsOfAnySize) {
    std::mt19937 random(11);
    Deflater deflater; // one for all: a stream begins where another one was given up
    for (std::size_t size = 1; size < 300'000; size += 1 + size / 9) {
        for (const unsigned kinds : {1U, 4U, 256U}) {
            std::string content(size, '\0');
            for (char& c : content)
                c = static_cast<char>(random() % kinds);
            const auto stream = deflater.deflated(content);
            ASSERT_LT(stream.size(), content.size());
            EXPECT_TRUE(kinds != 256 || stream.empty()) << size << ": noise does not become smaller";
            const bool mustShrink = kinds != 256 && size > 100;
            EXPECT_TRUE(!mustShrink || inflated({stream.begin(), stream.end()}, size) == content)
                << size << ' ' << kinds;
        }
    }
}

TEST(ZlibStream, IsTheSameWhateverWasDeflatedBefore) {
    const std::string content = contentOf(3, 400'000);
    Deflater deflater;
    for (int i = 0; i < 3; ++i) {
        const auto stream = deflater.deflated(content);
        EXPECT_TRUE(std::string(stream.begin(), stream.end()) == streamOf(content)) << i;
        static_cast<void>(deflater.deflated(contentOf(i, 5000)));
    }
}

} // namespace
