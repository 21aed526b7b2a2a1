// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The limit on the memory of one call's results, and the account that is checked against it.
#include "calls/MemoryLimit.h"

#include "TnFbxLimits.h"

#include <gtest/gtest.h>

#include <cstdint>

namespace Tarnell::Fbx {
namespace {

struct MemoryLimit : testing::Test {
    ~MemoryLimit() override { setMemoryLimit(0); }
};

TEST_F(MemoryLimit, IsAtFirstAndAgainWithZeroHalfOfTheMachine) {
    const std::uint64_t half = memoryLimit();
    EXPECT_GT(half, std::uint64_t{64} << 20U);
    setMemoryLimit(1000);
    EXPECT_EQ(memoryLimit(), 1000U);
    setMemoryLimit(0);
    EXPECT_EQ(memoryLimit(), half);
}

TEST_F(MemoryLimit, GrantsUpToTheLimitAndCountsOnBeyondIt) {
    setMemoryLimit(3 * 1024);
    detail::MemoryAccount account;
    account.begin();
    EXPECT_TRUE(account.take(2048));
    EXPECT_TRUE(account.take(1024));
    EXPECT_FALSE(account.take(1024));
    EXPECT_FALSE(account.take(1024));
    EXPECT_EQ(account.describe(), "5.0 KiB of samples and points would be needed; the limit is 3.0 KiB");
    account.begin();
    EXPECT_FALSE(account.exceeded());
}

TEST_F(MemoryLimit, HasNoEffectOnAnAccountThatHasBegun) {
    detail::MemoryAccount account;
    account.begin();
    setMemoryLimit(1);
    EXPECT_TRUE(account.take(1024));
}

TEST_F(MemoryLimit, CountsNoFurtherThanThereAreBytes) {
    setMemoryLimit(16);
    detail::MemoryAccount account;
    account.begin();
    EXPECT_FALSE(account.take(UINT64_MAX));
    EXPECT_FALSE(account.take(UINT64_MAX));
    EXPECT_EQ(account.describe(), "16.0 EiB of samples and points would be needed; the limit is 16 bytes");
}

} // namespace
} // namespace Tarnell::Fbx
