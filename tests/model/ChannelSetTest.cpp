// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The check that a channel table is complete and in order. It runs at compile time; here its result is tested.
#include "model/ChannelSet.h"

#include <gtest/gtest.h>

namespace Tarnell::Fbx::detail {
namespace {

enum Fruit : int { kApple, kPear, kPlum };

constexpr ChannelRow<Fruit> kInOrder[] = {{kApple, "apple", 1.0f}, {kPear, "pear", 2.0f}, {kPlum, "plum", 3.0f}};
constexpr ChannelRow<Fruit> kSwapped[] = {{kPear, "pear", 2.0f}, {kApple, "apple", 1.0f}};
constexpr ChannelRow<Fruit> kRepeated[] = {{kApple, "apple", 1.0f}, {kApple, "apple", 1.0f}};
constexpr ChannelRow<Fruit> kWithAGap[] = {{kApple, "apple", 1.0f}, {kPlum, "plum", 3.0f}};

static_assert(inEnumeratorOrder(kInOrder));
static_assert(!inEnumeratorOrder(kSwapped));
static_assert(!inEnumeratorOrder(kRepeated));
static_assert(!inEnumeratorOrder(kWithAGap));

TEST(ChannelSet, TakesEveryFactFromItsTable) {
    using Fruits = ChannelSet<kInOrder>;
    Fruits::Array channels;

    Fruits::init(channels);

    EXPECT_EQ(channels.size(), 3u);
    EXPECT_EQ(Fruits::value(channels, kPlum), 3.0f);
    EXPECT_STREQ(Fruits::name(kPear), "pear");
    EXPECT_EQ(Fruits::name(static_cast<Fruit>(3)), nullptr);
}

} // namespace
} // namespace Tarnell::Fbx::detail
