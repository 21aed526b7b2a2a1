// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Long lists of plain numbers, checked 64 bytes at a time.
#pragma once

#include <cstdint>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Plain numbers with a comma directly behind each.
struct NumberBlocks {
    std::uint64_t count = 0;
    const char* lastComma = nullptr; ///< null when there is none
};

/// Skips numbers and their commas from the start of a number on, as far as whole blocks of 64 bytes before `stop`
/// consist of them. Accepts what plainNumberEnd() does, but for numbers without a digit on both sides of the point, and
/// blanks behind commas; stops before anything else. Does nothing on processors without SSE2.
[[nodiscard]] NumberBlocks skipNumberBlocks(const char* text, const char* stop);

} // namespace detail
FBXSDK_NAMESPACE_END
