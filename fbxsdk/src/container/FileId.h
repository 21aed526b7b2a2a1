// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The time a file was made, and the two codes of binary files that are derived from it: the FileId record and the first
// bytes of the footer. Applications refuse files whose codes do not match their time.
#pragma once

#include <array>
#include <chrono>
#include <cstdint>
#include <string>
#include <string_view>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A date and time.
struct CreationTime {
    int year = 1970, month = 1, day = 1;
    int hour = 0, minute = 0, second = 0, millisecond = 0;

    /// "2020-03-31 21:34:23:150", the form that the codes are computed from.
    [[nodiscard]] std::string text() const;
    /// "31/03/2020 21:34:23.150", the form of the scene information.
    [[nodiscard]] std::string dayFirstText() const;
};

/// Years beyond 0 to 9999 are clipped: the text has four digits for them.
[[nodiscard]] CreationTime utcTime(std::chrono::system_clock::time_point moment);
[[nodiscard]] CreationTime localTime(std::chrono::system_clock::time_point moment);

using FileCode = std::array<std::uint8_t, 16>;

/// The content of the FileId record.
[[nodiscard]] FileCode fileId(const CreationTime& time);
/// The first bytes of the footer.
[[nodiscard]] FileCode footerCode(const CreationTime& time);

} // namespace detail
FBXSDK_NAMESPACE_END
