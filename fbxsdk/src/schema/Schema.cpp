// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Types for the tables, in addition to the public ones.
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

constinit const PropertyTypeInfo kAnimatableBoolInfo{eFbxBool, "Bool", "Bool", ""};
constinit const PropertyTypeInfo kAnimatableIntInfo{eFbxInt, "Integer", "Integer", ""};

} // namespace

constinit const FbxDataType kAnimatableBoolType{&kAnimatableBoolInfo};
constinit const FbxDataType kAnimatableIntType{&kAnimatableIntInfo};

int rowIndex(std::span<const PropertyRow> rows, std::string_view name) {
    for (std::size_t i = 0; i < rows.size(); ++i)
        if (name == rows[i].name)
            return static_cast<int>(i);
    return -1;
}

} // namespace detail
FBXSDK_NAMESPACE_END
