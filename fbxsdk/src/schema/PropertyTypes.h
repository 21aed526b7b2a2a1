// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The table of property types, and the row that a file's two type strings refer to.
#pragma once

#include <cstddef>
#include <string_view>

#include <fbxsdk/FbxDataType.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A blob for type strings that are not in the table: such a property has no value.
[[nodiscard]] FbxDataType dataTypeOf(std::string_view typeName, std::string_view subTypeName);

/// The second type string that belongs to the first one, which files before 7.0 do not have: "double" gives "Number".
[[nodiscard]] std::string_view subTypeOf(std::string_view typeName);

/// The number of numbers in a value of the type; 1 also for types that are not numbers.
[[nodiscard]] std::size_t componentCount(EFbxType type);

} // namespace detail
FBXSDK_NAMESPACE_END
