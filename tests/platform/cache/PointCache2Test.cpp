// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Max point caches: layout, frames, and damage.
#include <array>
#include <cstring>

#include <gtest/gtest.h>

#include "cache/PointCache2.h"
#include "support/TemporaryFolder.h"

using namespace fbxsdk;
using namespace fbxsdk::detail;

namespace {

/// One point at frames 10, 11 and 12: (f, 0, -f).
std::string writeThree(const support::TemporaryFolder& folder) {
    FbxStatus status;
    const std::string file = folder.file("ball.pc2");
    auto writer = PointCacheWriter::open(file, {1, 10.0, 1.0, 3}, status);
    EXPECT_TRUE(writer) << status.GetErrorString();
    for (int f = 10; f <= 12; ++f) {
        const std::array<double, 3> point = {double(f), 0, double(-f)};
        EXPECT_TRUE(writer->write(f, point.data(), status));
    }
    EXPECT_TRUE(writer->close(status));
    return file;
}

double xAt(const PointCacheReader& reader, double frame) {
    std::array<double, 3> point{};
    EXPECT_TRUE(reader.read(frame, point));
    return point[0];
}

} // namespace

TEST(PointCache2, HoldsExactlyItsSamples) {
    const support::TemporaryFolder folder;
    writeThree(folder);

    const std::string bytes = folder.read("ball.pc2");

    ASSERT_EQ(bytes.size(), 32U + 3U * 12U);
    EXPECT_EQ(bytes.substr(0, 12), std::string("POINTCACHE2\0", 12));
    EXPECT_EQ(bytes.substr(12, 8), std::string("\1\0\0\0\1\0\0\0", 8));
    float start = 0, rate = 0;
    std::memcpy(&start, bytes.data() + 20, 4);
    std::memcpy(&rate, bytes.data() + 24, 4);
    EXPECT_EQ(start, 10.0F);
    EXPECT_EQ(rate, 1.0F);
}

TEST(PointCache2, FindsSamplesByAbsoluteFrame) {
    const support::TemporaryFolder folder;
    FbxStatus status;
    auto reader = PointCacheReader::open(writeThree(folder), status);
    ASSERT_TRUE(reader) << status.GetErrorString();

    EXPECT_EQ(xAt(*reader, 10), 10.0);
    EXPECT_EQ(xAt(*reader, 12), 12.0);
    EXPECT_EQ(xAt(*reader, 10.5), 10.5);
    EXPECT_EQ(xAt(*reader, 3), 10.0);
    EXPECT_EQ(xAt(*reader, 99), 12.0);
}

TEST(PointCache2, RefusesFramesOutsideItsSamplesWhenWriting) {
    const support::TemporaryFolder folder;
    FbxStatus status;
    auto writer = PointCacheWriter::open(folder.file("ball.pc2"), {1, 10.0, 1.0, 3}, status);
    ASSERT_TRUE(writer);
    const std::array<double, 3> point{};

    EXPECT_FALSE(writer->write(9, point.data(), status));
    EXPECT_FALSE(writer->write(13, point.data(), status));
    EXPECT_TRUE(writer->write(11, point.data(), status));
    EXPECT_TRUE(writer->close(status));
    EXPECT_EQ(folder.read("ball.pc2").size(), 32U + 3U * 12U);
}

TEST(PointCache2, RefusesAnotherNumberOfPoints) {
    const support::TemporaryFolder folder;
    FbxStatus status;
    auto reader = PointCacheReader::open(writeThree(folder), status);
    ASSERT_TRUE(reader);
    std::array<double, 6> two{};

    EXPECT_FALSE(reader->read(10, two));
}

TEST(PointCache2, RefusesFilesShorterThanTheirHeaderPromises) {
    const support::TemporaryFolder folder;
    const std::string file = writeThree(folder);
    const std::string whole = folder.read("ball.pc2");

    for (std::size_t length = 0; length < whole.size(); ++length) {
        folder.write("ball.pc2", whole.substr(0, length));
        FbxStatus status;
        EXPECT_FALSE(PointCacheReader::open(file, status)) << length;
        EXPECT_TRUE(status.Error());
    }
}

TEST(PointCache2, RefusesCountsThatLie) {
    const support::TemporaryFolder folder;
    const std::string file = writeThree(folder);
    for (const std::size_t field : {std::size_t{16}, std::size_t{28}}) {
        for (const std::int32_t lie : {0, -1, 1000, INT32_MAX, INT32_MIN}) {
            writeThree(folder);
            std::string bytes = folder.read("ball.pc2");
            std::memcpy(bytes.data() + field, &lie, 4);
            folder.write("ball.pc2", bytes);
            FbxStatus status;
            EXPECT_FALSE(PointCacheReader::open(file, status)) << field << " " << lie;
        }
    }
}
