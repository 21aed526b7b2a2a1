// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The scan over lists of numbers, of which ASCII files mostly consist.
#pragma once

#include <cstdint>
#include <span>
#include <vector>

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
/// where no number follows, or the name of the next record. Where words count, any word is accepted as a number. A
/// long run is scanned by several threads where they are allowed.
[[nodiscard]] NumberRun scanNumbers(const char* text, const char* end, bool wordsCount);

/// A part of a run.
struct NumberPiece {
    const char* text = nullptr; ///< the start, possibly blanks
    std::uint64_t first = 0;    ///< the index of its first number
    std::uint64_t count = 0;
};

/// Splits a run of `count` numbers into pieces for several threads. Empty when only one thread is allowed, the run is
/// short, or commas do not tell the index of a number: there are others than one between any two numbers.
[[nodiscard]] std::vector<NumberPiece> piecesOfRun(std::span<const char> run, std::uint64_t count);

} // namespace detail
FBXSDK_NAMESPACE_END
