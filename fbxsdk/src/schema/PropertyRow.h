// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <array>

#include <fbxsdk/FbxDataType.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// One property of a class: a line of the class's property template.
struct PropertyRow {
    const char* name;
    const FbxDataType* type;
    const char* flags; ///< as in files: "A" animatable, "H" hidden, "U" user-defined
    std::array<double, 4> numbers{};
    const char* text = "";
};

} // namespace detail
FBXSDK_NAMESPACE_END
