// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Maya caches: what is written is read back, samples between samples, and damage of every kind.
#include <array>
#include <random>

#include <gtest/gtest.h>

#include "cache/MayaCache.h"
#include "support/TemporaryFolder.h"

using namespace fbxsdk;
using namespace fbxsdk::detail;

namespace {

MayaCacheDescription oneChannel(bool wide, const char* type = "DoubleVectorArray") {
    MayaCacheDescription description;
    description.wide = wide;
    MayaCacheChannel channel;
    channel.name = "ball";
    channel.type = type;
    channel.interpretation = "Points";
    description.channels.push_back(channel);
    return description;
}

/// Two points at frames 10, 11 and 12 of 24 frames per second; point i of frame f is (f, i, -f).
std::string writeBall(const support::TemporaryFolder& folder, bool wide, const char* type = "DoubleVectorArray") {
    FbxStatus status;
    const std::string file = folder.file("ball.xml");
    auto writer = MayaCacheWriter::open(file, oneChannel(wide, type), status);
    EXPECT_TRUE(writer) << status.GetErrorString();
    for (int f = 10; f <= 12; ++f) {
        const std::array<double, 6> points = {double(f), 0, double(-f), double(f), 1, double(-f)};
        EXPECT_TRUE(writer->write(0, f / 24.0, points, status));
    }
    EXPECT_TRUE(writer->close(status)) << status.GetErrorString();
    return file;
}

std::array<double, 6> readAt(MayaCacheReader& reader, double seconds) {
    std::array<double, 6> points{};
    FbxStatus status;
    EXPECT_TRUE(reader.read("ball", seconds, points, status)) << status.GetErrorString();
    return points;
}

class MayaCacheLayouts : public testing::TestWithParam<std::tuple<bool, const char*>> {};

} // namespace

TEST_P(MayaCacheLayouts, GiveBackWhatWasWritten) {
    const support::TemporaryFolder folder;
    const std::string file = writeBall(folder, std::get<0>(GetParam()), std::get<1>(GetParam()));

    FbxStatus status;
    auto reader = MayaCacheReader::open(file, status);

    ASSERT_TRUE(reader) << status.GetErrorString();
    for (int f = 10; f <= 12; ++f) {
        const std::array<double, 6> expected = {double(f), 0, double(-f), double(f), 1, double(-f)};
        EXPECT_EQ(readAt(*reader, f / 24.0), expected);
    }
}

INSTANTIATE_TEST_SUITE_P(AllLayouts, MayaCacheLayouts,
                         testing::Combine(testing::Bool(), testing::Values("DoubleVectorArray", "FloatVectorArray")));

TEST(MayaCache, InterpolatesBetweenSamplesAndHoldsOutside) {
    const support::TemporaryFolder folder;
    FbxStatus status;
    auto reader = MayaCacheReader::open(writeBall(folder, true), status);
    ASSERT_TRUE(reader);

    EXPECT_DOUBLE_EQ(readAt(*reader, 10.5 / 24.0)[0], 10.5);
    EXPECT_DOUBLE_EQ(readAt(*reader, 11.25 / 24.0)[2], -11.25);
    EXPECT_EQ(readAt(*reader, 0.0)[0], 10.0);
    EXPECT_EQ(readAt(*reader, 100.0)[0], 12.0);
}

TEST(MayaCache, DescribesTimesInSixThousandthsOfASecond) {
    const support::TemporaryFolder folder;
    FbxStatus status;
    auto reader = MayaCacheReader::open(writeBall(folder, false), status);
    ASSERT_TRUE(reader);

    EXPECT_EQ(reader->description().start, 2500);
    EXPECT_EQ(reader->description().end, 3000);
    EXPECT_EQ(reader->description().ticksPerFrame, 250);
    std::int32_t first = 0, last = 0;
    ASSERT_TRUE(reader->sampleRange(first, last));
    EXPECT_EQ(first, 2500);
    EXPECT_EQ(last, 3000);
}

TEST(MayaCache, RefusesAnotherNumberOfPointsAndUnknownChannels) {
    const support::TemporaryFolder folder;
    FbxStatus status;
    auto reader = MayaCacheReader::open(writeBall(folder, true), status);
    ASSERT_TRUE(reader);
    std::array<double, 9> three{};
    std::array<double, 6> two{};

    EXPECT_FALSE(reader->read("ball", 0.5, three, status));
    EXPECT_TRUE(status.Error());
    EXPECT_FALSE(reader->read("cube", 0.5, two, status));
    EXPECT_FALSE(reader->read("ball", std::numeric_limits<double>::quiet_NaN(), two, status));
}

TEST(MayaCache, ReadsOneFilePerFrameInOrderAndSkipsMissingOnes) {
    const support::TemporaryFolder folder;
    MayaCacheDescription description = oneChannel(false);
    description.oneFile = false;
    FbxStatus status;
    folder.write("ball.xml", mayaCacheDescriptionText(description));
    const auto writeFrame = [&](const char* name, double x) {
        const std::array<double, 6> points = {x, 0, 0, x, 0, 0};
        const MayaCacheWriteBlock block{"ball", points, true};
        folder.write(name, mayaCacheHeader(false, 0, 0) + mayaCacheFrame(false, nullptr, {&block, 1}));
    };
    writeFrame("ballFrame10.mc", 100);
    writeFrame("ballFrame9.mc", 90);
    writeFrame("ballFrame12Tick125.mc", 125);
    writeFrame("ballFrameX.mc", 1);
    writeFrame("ballFrame3.mcx", 2);

    auto reader = MayaCacheReader::open(folder.file("ball.xml"), status);

    ASSERT_TRUE(reader) << status.GetErrorString();
    EXPECT_EQ(readAt(*reader, 9 / 24.0)[0], 90);
    EXPECT_DOUBLE_EQ(readAt(*reader, 9.5 / 24.0)[0], 95);
    EXPECT_DOUBLE_EQ(readAt(*reader, 11.25 / 24.0)[0], 112.5);
    std::int32_t first = 0, last = 0;
    ASSERT_TRUE(reader->sampleRange(first, last));
    EXPECT_EQ(first, 9 * 250);
    EXPECT_EQ(last, 12 * 250 + 125);
}

TEST(MayaCache, TakesDescriptionsAsTheyCome) {
    const support::TemporaryFolder folder;
    const std::string file =
        folder.write("odd.xml", "<?xml version='1.0'?><!DOCTYPE x><!-- a comment -->\n"
                                "<Autodesk_Cache_File><unknown><deeper/></unknown>\n"
                                "<time Range='-250-7500'/><cacheType Format='mcx' Type='OneFile'/>"
                                "<cacheTimePerFrame TimePerFrame='200'/><extra>a &lt; b &odd;</extra>"
                                "<Channels><channel0 EndTime='9' ChannelName='a&#65;&#x42;'/>"
                                "<channel1 ChannelName='second' SamplingType='Irregular'/></Channels>"
                                "</Autodesk_Cache_File>");
    MayaCacheDescription description;
    FbxStatus status;

    ASSERT_TRUE(readMayaCacheDescription(file, description, status)) << status.GetErrorString();
    EXPECT_TRUE(description.wide);
    EXPECT_EQ(description.start, -250);
    EXPECT_EQ(description.end, 7500);
    EXPECT_EQ(description.ticksPerFrame, 200);
    ASSERT_EQ(description.channels.size(), 2U);
    EXPECT_EQ(description.channels[0].name, "aAB");
    EXPECT_EQ(description.channels[0].end, 9);
    EXPECT_FALSE(description.channels[1].regular);
}

TEST(MayaCache, RefusesDescriptionsThatAreNone) {
    const support::TemporaryFolder folder;
    std::string deep = "<Autodesk_Cache_File>";
    for (int i = 0; i < 100000; ++i)
        deep += "<a>";
    std::string bomb = "<!DOCTYPE l [<!ENTITY a \"aaaaaaaaaa\"><!ENTITY b \"&a;&a;&a;&a;\">]><lolz>&b;</lolz>";
    std::string nested = "<Autodesk_Cache_File>";
    for (int i = 0; i < 50000; ++i)
        nested += "<a>";
    for (int i = 0; i < 50000; ++i)
        nested += "</a>";
    nested += "</Autodesk_Cache_File>";
    for (const std::string& content : {std::string("not xml"), std::string("<other/>"), deep, bomb, nested}) {
        MayaCacheDescription description;
        FbxStatus status;
        EXPECT_FALSE(readMayaCacheDescription(folder.write("bad.xml", content), description, status));
        EXPECT_TRUE(status.Error());
        EXPECT_NE(std::string(status.GetErrorString()).find("bad.xml"), std::string::npos);
    }
    MayaCacheDescription description;
    FbxStatus status;
    EXPECT_FALSE(readMayaCacheDescription(folder.file("missing.xml"), description, status));
}

TEST(MayaCache, RefusesDataThatIsCutOff) {
    const support::TemporaryFolder folder;
    const std::string file = writeBall(folder, true);
    const std::string whole = folder.read("ball.mcx");

    int opened = 0;
    for (std::size_t length = 0; length < whole.size(); ++length) {
        folder.write("ball.mcx", whole.substr(0, length));
        FbxStatus status;
        const auto reader = MayaCacheReader::open(file, status);
        opened += reader ? 1 : 0;
        EXPECT_EQ(status.Error(), !reader) << length;
    }
    EXPECT_EQ(opened, 2); // shortly after the first and the second sample
}

TEST(MayaCache, SaysWhereItsDataIsDamaged) {
    const support::TemporaryFolder folder;
    const std::string file = writeBall(folder, true);
    std::string data = folder.read("ball.mcx");
    const std::size_t header = mayaCacheHeader(true, 0, 1).size();
    const std::size_t second = header + (data.size() - header) / 3; // of three samples
    data[second] = 'f';
    folder.write("ball.mcx", data);

    FbxStatus status;
    EXPECT_FALSE(MayaCacheReader::open(file, status));

    EXPECT_STREQ(status.GetErrorString(),
                 (folder.file("ball.mcx") + ": offset " + std::to_string(second) + ": truncated or damaged").c_str());
}

TEST(MayaCache, AcceptsZerosAfterItsSamples) {
    const support::TemporaryFolder folder;
    const std::string file = writeBall(folder, true);
    folder.write("ball.mcx", folder.read("ball.mcx") + std::string(100, '\0'));

    FbxStatus status;
    auto reader = MayaCacheReader::open(file, status);

    ASSERT_TRUE(reader) << status.GetErrorString();
    EXPECT_EQ(readAt(*reader, 12 / 24.0)[0], 12.0);
}

TEST(MayaCache, SurvivesChangedBytes) {
    const support::TemporaryFolder folder;
    const std::string file = writeBall(folder, false);
    const std::string whole = folder.read("ball.mc");
    std::mt19937 random(7); // NOLINT: a fixed seed is the point

    for (int round = 0; round < 2000; ++round) {
        std::string damaged = whole;
        for (int i = 0; i < 3; ++i)
            damaged[random() % damaged.size()] = static_cast<char>(random());
        folder.write("ball.mc", damaged);
        FbxStatus status;
        auto reader = MayaCacheReader::open(file, status);
        std::array<double, 6> points{};
        if (reader)
            (void)reader->read("ball", 0.45, points, status);
    }
    SUCCEED();
}

TEST(MayaCache, SaysThatAFolderCannotBeWritten) {
    FbxStatus status;
    EXPECT_FALSE(MayaCacheWriter::open("/nonexistent-folder/ball.xml", oneChannel(true), status));
    EXPECT_TRUE(status.Error());
}

TEST(MayaCache, LaysChunksOutAsMayaDoes) {
    const std::string narrow = mayaCacheHeader(false, 0, 1);
    EXPECT_EQ(narrow.substr(0, 4), "FOR4");
    EXPECT_EQ(narrow.substr(4, 4), std::string("\0\0\0\x28", 4));
    EXPECT_EQ(narrow.size(), 8U + 40U);
    const std::string wide = mayaCacheHeader(true, 0, 1);
    EXPECT_EQ(wide.substr(8, 8), std::string("\0\0\0\0\0\0\0\x4C", 8));
    EXPECT_EQ(wide.size(), 16U + 76U);
}
