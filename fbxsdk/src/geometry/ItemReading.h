// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of the number lists of records to arrays of items. Numbers are decoded directly into the items' memory.
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

/// How items are read on the first access.
enum class LateReading {
    shown, ///< items in the layout of memory, compressed or not, stay in the file while only values are
           ///< read
    whole  ///< all items at once
};

/// The same on the first access to the array. Shares ownership of the document until then. Vectors may have their
/// fourth numbers in a record of their own; they are 1 where there is none, and where it is corrupt: the other three
/// are usable without them.
template <class Item>
void readLate(std::shared_ptr<const Document> document, const Record& record, PlainArray<Item>& items,
              LateReading reading = LateReading::shown, const Record* fourth = nullptr);

extern template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<FbxVector4>&, LateReading,
                              const Record*);
extern template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<FbxVector2>&, LateReading,
                              const Record*);
extern template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<FbxColor>&, LateReading,
                              const Record*);
extern template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<int>&, LateReading,
                              const Record*);
extern template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<double>&, LateReading,
                              const Record*);
extern template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<bool>&, LateReading,
                              const Record*);

} // namespace detail
FBXSDK_NAMESPACE_END
