// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The scan over lists of numbers, of which ASCII files mostly consist.
#pragma once

#include <cstdint>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A run of numbers with commas between them.
struct NumberRun {
    std::uint64_t count = 0;
    const char* numbersEnd = nullptr; ///< behind the last number
    const char* next = nullptr;       ///< where something else follows
    bool afterComma = false;          ///< with a comma before it
};

/// Counts the numbers of a run and checks the spelling of each, so that decoding them later cannot fail. The run ends
/// where no number follows, or the name of the next record. Where words count, any word is accepted as a number.
[[nodiscard]] NumberRun scanNumbers(const char* text, const char* end, bool wordsCount);

} // namespace detail
FBXSDK_NAMESPACE_END
