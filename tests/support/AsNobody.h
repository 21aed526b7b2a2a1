// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Permissions that apply to a superuser too.
#pragma once

#include <unistd.h>

#include <gtest/gtest.h>

namespace support {

/// Runs as the user "nobody", who owns nothing, for operations that a superuser would be allowed to do.
class AsNobody {
public:
    AsNobody() { mChanged = ::geteuid() == 0 && ::seteuid(kNobody) == 0; }
    AsNobody(const AsNobody&) = delete;
    AsNobody& operator=(const AsNobody&) = delete;
    ~AsNobody() { EXPECT_TRUE(!mChanged || ::seteuid(0) == 0); }

private:
    static constexpr uid_t kNobody = 65534;
    bool mChanged = false;
};

} // namespace support
