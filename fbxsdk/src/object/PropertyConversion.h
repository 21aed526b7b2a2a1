// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of property values to and from the C++ types that callers use.
#pragma once

#include <array>

#include <fbxsdk/FbxTypes.h>

#include "object/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Stores numbers in a caller's variable of the type. False, and the variable untouched, for types that hold none.
bool convertNumbers(const std::array<double, 4>& numbers, void* target, EFbxType type);
/// A property's value in a caller's variable. False, and the variable untouched, when no conversion exists.
bool readPropertyValue(const PropertyValue& value, EFbxType from, void* target, EFbxType type);
/// Whether a caller's variable of the type `type` can be stored in a property of the type `to`.
[[nodiscard]] bool isWritable(EFbxType to, EFbxType type);
/// The other way round: a caller's variable becomes the property's value.
bool writePropertyValue(PropertyValue& value, EFbxType to, const void* source, EFbxType type);

} // namespace detail
FBXSDK_NAMESPACE_END
