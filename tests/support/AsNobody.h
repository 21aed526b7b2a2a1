// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Permissions that hold for a superuser too.
#pragma once

#include <unistd.h>

#include <gtest/gtest.h>

namespace support {

/// Runs as nobody, who owns nothing, for what a superuser would be allowed to do.
class AsNobody {
public:
    AsNobody() { mChanged = ::geteuid() == 0 && ::seteuid(kNobody) == 0; }
    AsNobody(const AsNobody&) = delete;
    AsNobody& operator=(const AsNobody&) = delete;
    ~AsNobody() {
        if (mChanged) {
            EXPECT_EQ(::seteuid(0), 0);
        }
    }

private:
    static constexpr uid_t kNobody = 65534;
    bool mChanged = false;
};

} // namespace support
