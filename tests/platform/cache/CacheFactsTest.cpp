// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The inspection of caches that state excessive counts: its time and memory grow with the file only.
#include <fbxsdk/extensions/CacheFacts.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "cache/MayaCacheData.h"
#include "support/TemporaryFolder.h"

using namespace fbxsdk;

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

std::string dataOf(const std::vector<detail::MayaCacheWriteBlock>& blocks) {
    const std::int32_t ticks = 0;
    return detail::mayaCacheHeader(/*wide=*/false, 0, 1) + detail::mayaCacheFrame(/*wide=*/false, &ticks, blocks);
}

extensions::CacheFacts factsOf(const std::string& file) {
    extensions::CacheFacts facts;
    FbxStatus status;
    EXPECT_TRUE(extensions::readCacheFacts(file.c_str(), /*verify=*/true, facts, status)) << status.GetErrorString();
    return facts;
}

TEST(CacheFacts, DistinguishesAHundredThousandChannels) {
    constexpr std::size_t kChannels = 100'000; // a separate search for each would take a minute
    const std::vector<double> point = {1, 2, 3};
    std::vector<std::string> names;
    for (std::size_t i = 0; i < kChannels; ++i)
        names.push_back("channel" + std::to_string(i));
    std::vector<detail::MayaCacheWriteBlock> blocks;
    for (const std::string& name : names)
        blocks.push_back({name, point});
    const support::TemporaryFolder folder;

    const auto facts = factsOf(folder.write("many.mc", dataOf(blocks)));

    EXPECT_EQ(facts.channelNames, names);
    EXPECT_TRUE(facts.faults.empty());
}

TEST(CacheFacts, ListsAThousandFaultsAndSaysThatThereAreMore) {
    const std::vector<double> point = {kNaN, 2, 3};
    const std::string longName(1'000'000, 'n'); // repeated in each of the faults it would be gigabytes
    const std::vector<detail::MayaCacheWriteBlock> blocks(5000, {"a", point});
    const support::TemporaryFolder folder;
    std::string data = dataOf(blocks);
    data +=
        detail::mayaCacheFrame(/*wide=*/false, nullptr, std::vector<detail::MayaCacheWriteBlock>{{longName, point}});

    const auto facts = factsOf(folder.write("bad.mc", data));

    ASSERT_EQ(facts.faults.size(), 1000U);
    EXPECT_THAT(facts.faults.front().reason, testing::EndsWith("channel a: a number that is not finite"));
    EXPECT_THAT(facts.faults.back().reason, testing::EndsWith("further ones are not listed"));
}

TEST(CacheFacts, NamesAHeaderThatIsCutOff) {
    const support::TemporaryFolder folder;

    const auto facts = factsOf(folder.write("short.pc2", std::string("POINTCACHE2\0\1\0\0\0", 16)));

    ASSERT_EQ(facts.faults.size(), 1U);
    EXPECT_EQ(facts.faults.front().offset, 16U);
    EXPECT_EQ(facts.format, FbxCache::eMaxPointCacheV2);
}

TEST(CacheFacts, OfTheFileOfAFrameAreThoseOfItsCache) {
    const std::vector<double> point = {1, 2, 3};
    const support::TemporaryFolder folder;
    folder.write("ball.xml", "<Autodesk_Cache_File><cacheType Type=\"OneFilePerFrame\" Format=\"mcc\"/>"
                             "<time Range=\"250-250\"/><cacheTimePerFrame TimePerFrame=\"250\"/><Channels>"
                             "<channel0 ChannelName=\"a\" StartTime=\"250\" EndTime=\"250\"/></Channels>"
                             "</Autodesk_Cache_File>");

    const auto facts = factsOf(folder.write("ballFrame1.mc", dataOf({{"a", point}})));

    EXPECT_EQ(facts.description, folder.file("ball.xml"));
    EXPECT_FALSE(facts.oneFile);
    ASSERT_EQ(facts.samples.size(), 1U);
    EXPECT_EQ(facts.samples.front().frame, 1.0);
    EXPECT_TRUE(facts.faults.empty());
}

TEST(CacheFacts, ShortensLongNamesInFaultsOnly) {
    const std::vector<double> point = {kNaN, 2, 3};
    const std::string longName(1'000'000, 'n');
    const support::TemporaryFolder folder;

    const auto facts = factsOf(folder.write("long.mc", dataOf({{longName, point}})));

    ASSERT_EQ(facts.faults.size(), 1U);
    EXPECT_LT(facts.faults.front().reason.size(), 300U);
    EXPECT_THAT(facts.channelNames, testing::ElementsAre(longName));
}

} // namespace
