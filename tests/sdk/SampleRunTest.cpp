// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Samples that are added in blocks: the same run as one by one, wherever a block ends.
#include "access/SampleRun.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <limits>
#include <vector>

namespace Tarnell::Fbx {
namespace {

using detail::SampleRun;

SampleRun runOf(const std::vector<float>& values, std::size_t blockSize) {
    SampleRun run;
    run.begin(values.size());
    for (std::size_t done = 0; done < values.size(); done += blockSize)
        run.add(values.data() + done, std::min(blockSize, values.size() - done));
    return run;
}

TEST(SampleRun, IsTheSameInBlocksOfAnySize) {
    const float nan = std::numeric_limits<float>::quiet_NaN();
    const std::vector<std::vector<float>> lists = {
        {1, 1, 1, 1, 1, 1, 1, 1, 1},
        {1, 1, 1, 1, 1, 1, 1, 1, 2},
        {2, 1, 1, 1, 1, 1, 1, 1, 1},
        {0, 0, 0, -0.0f, 0, 0},
        {nan, nan, nan, nan, nan},
        {nan, nan, nan, -nan, nan},
        {5},
    };
    for (const std::vector<float>& values : lists) {
        bool isOneValue = true;
        for (const float& value : values)
            isOneValue = isOneValue && std::memcmp(&value, &values[0], sizeof value) == 0;
        for (std::size_t size = 1; size <= values.size(); ++size) {
            SampleRun run = runOf(values, size);
            EXPECT_TRUE(run.isComplete());
            EXPECT_EQ(run.isOneValue(), isOneValue) << values.size() << ' ' << size;
            const std::vector<float> all = run.takeAll();
            ASSERT_EQ(all.size(), values.size());
            EXPECT_EQ(std::memcmp(all.data(), values.data(), all.size() * sizeof(float)), 0) << size;
        }
    }
}

TEST(SampleRun, SpreadsWithTheFirstBlockThatHasAnotherValue) {
    const float values[] = {3, 3, 3, 4};
    SampleRun run;
    run.begin(10);
    EXPECT_FALSE(run.spreadsWith(values, 3)); // nothing before it
    EXPECT_TRUE(run.spreadsWith(values, 4));
    run.add(values, 3);
    EXPECT_FALSE(run.spreadsWith(values, 3));
    EXPECT_TRUE(run.spreadsWith(values + 1, 3));
    run.add(values, 4);
    EXPECT_FALSE(run.spreadsWith(values, 4)); // each takes memory already
    EXPECT_FALSE(run.isComplete());
}

} // namespace
} // namespace Tarnell::Fbx
