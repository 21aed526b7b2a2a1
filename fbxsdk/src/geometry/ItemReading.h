// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From the number lists of records to arrays of items. Numbers are decoded into the memory where the items stay.
#pragma once

#include <fbxsdk/FbxColor.h>
#include <fbxsdk/FbxPlainArray.h>
#include <fbxsdk/FbxVector2.h>
#include <fbxsdk/FbxVector4.h>

#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

// Each fills the array with as many whole items as the record has numbers for. A list that cannot be decoded leaves the
// array empty, and the result is then false.

/// Three numbers each; w becomes 1.
bool readItems(const Record& record, PlainArray<FbxVector4>& items);
/// Four numbers each.
bool readWeightedPoints(const Record& record, PlainArray<FbxVector4>& items);
bool readItems(const Record& record, PlainArray<FbxVector2>& items);
bool readItems(const Record& record, PlainArray<FbxColor>& items);
bool readItems(const Record& record, PlainArray<int>& items);
bool readItems(const Record& record, PlainArray<double>& items);
bool readItems(const Record& record, PlainArray<bool>& items);

} // namespace detail
FBXSDK_NAMESPACE_END
