// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The table of property types, and which row a file's two type strings mean.
#pragma once

#include <cstddef>
#include <string_view>

#include <fbxsdk/FbxDataType.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A blob for type strings that are not in the table: such a property keeps no value.
[[nodiscard]] FbxDataType dataTypeOf(std::string_view typeName, std::string_view subTypeName);

/// The second type string that goes with the first one, which files before 7.0 do not have: "double" gives "Number".
[[nodiscard]] std::string_view subTypeOf(std::string_view typeName);

/// How many numbers a value of the type is; 1 of those that are none as well.
[[nodiscard]] std::size_t componentCount(EFbxType type);

} // namespace detail
FBXSDK_NAMESPACE_END
