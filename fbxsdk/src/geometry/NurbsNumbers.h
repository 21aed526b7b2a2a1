// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The numbers common to curves and surfaces of splines in files: points, counts and steps.
#pragma once

#include <cstdint>

#include <fbxsdk/FbxPlainArray.h>
#include <fbxsdk/FbxVector4.h>

#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// More points are invalid: counts and sums of a few of them fit in an int.
inline constexpr std::int64_t kMostPoints = 1 << 29;
/// Subdivisions of a span where a file states none.
inline constexpr int kUsualStep = 4;

/// The value at an index, wherever the record has it: as one of its values or in its array.
[[nodiscard]] std::int64_t integerAt(const Record* record, std::size_t index, std::int64_t fallback);
/// A step from a file as an int; less than one counts as one.
[[nodiscard]] int stepOf(std::int64_t step);

/// Exactly `count` points of three or four numbers each from the record Points. False, and no points, when the file has
/// another count, or corrupt ones.
[[nodiscard]] bool readPoints(PlainArray<FbxVector4>& points, const Record& body, std::int64_t count,
                              int numbersPerPoint);

} // namespace detail
FBXSDK_NAMESPACE_END
