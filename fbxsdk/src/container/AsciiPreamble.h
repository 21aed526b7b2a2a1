// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How an ASCII file begins: an optional byte order mark, and comments, one of which should state a version.
#pragma once

#include <cstdint>
#include <span>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The content before the first record.
struct AsciiPreamble {
    std::uint32_t version = 0; ///< as the first comment that states one says; 0 when none does
    const char* versionComment = nullptr;
    const char* end = nullptr; ///< where the first record starts
};

[[nodiscard]] AsciiPreamble readPreamble(std::span<const char> bytes);

/// Whether the bytes look like an ASCII file: a comment that states a version, or a first record that starts one.
[[nodiscard]] bool isAscii(std::span<const char> bytes);
/// Whether bytes that do not look so could with more of the file behind them.
[[nodiscard]] bool mayBeginAscii(std::span<const char> bytes);

} // namespace detail
FBXSDK_NAMESPACE_END
