// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From the number lists of records to arrays of items. Numbers are decoded into the memory where the items stay.
#pragma once

#include <fbxsdk/FbxColor.h>
#include <fbxsdk/FbxPlainArray.h>
#include <fbxsdk/FbxVector2.h>
#include <fbxsdk/FbxVector4.h>

#include "document/Document.h"

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

/// The same for numbers of a document's tree, of which only the values may be asked for. Where a file has them in the
/// shape of items, compressed or not, they are not kept in memory until somebody asks for more.
template <class Item>
bool fetchItems(const Document& document, const Record& record, PlainArray<Item>& items);

/// The same for vectors that may have their fourth numbers in a record of its own. They are 1 where there is none, and
/// where it is corrupt: nobody needs them to use the other three.
bool fetchVectors(const Document& document, const Record& record, const Record* fourth, PlainArray<FbxVector4>& items);

extern template bool fetchItems(const Document&, const Record&, PlainArray<FbxVector4>&);
extern template bool fetchItems(const Document&, const Record&, PlainArray<FbxVector2>&);
extern template bool fetchItems(const Document&, const Record&, PlainArray<FbxColor>&);
extern template bool fetchItems(const Document&, const Record&, PlainArray<int>&);
extern template bool fetchItems(const Document&, const Record&, PlainArray<double>&);
extern template bool fetchItems(const Document&, const Record&, PlainArray<bool>&);

} // namespace detail
FBXSDK_NAMESPACE_END
