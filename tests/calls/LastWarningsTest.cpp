// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The warnings of a call: kept in order, each once, and dropped by the next call.
#include "calls/LastError.h"

#include "TnFbxError.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace Tarnell::Fbx {
namespace {

TEST(LastWarnings, StartOverWithTheOutermostCallAndHaveNoDuplicates) {
    {
        const detail::CallScope facade;
        detail::warn("first");
        {
            const detail::CallScope adapter;
            detail::warn("second");
            detail::warn("first");
        }
    }
    EXPECT_EQ(lastWarnings(), (std::vector<std::string>{"first", "second"}));
    const detail::CallScope next;
    EXPECT_TRUE(lastWarnings().empty());
}

} // namespace
} // namespace Tarnell::Fbx
