// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of the number lists of records to arrays of items. Numbers are decoded directly into the items' memory.
#pragma once

#include <memory>
#include <type_traits>

#include <fbxsdk/FbxColor.h>
#include <fbxsdk/FbxPlainArray.h>
#include <fbxsdk/FbxVector2.h>
#include <fbxsdk/FbxVector4.h>

#include "container/ByteOrder.h"
#include "container/NumberDecoding.h"
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

/// Whether the packed numbers of an array have the layout of items, and justify a window to the file. The result is the
/// same for all types of items that consist of doubles.
template <class Item>
[[nodiscard]] inline bool holdsLargeItems(const StoredArray& array) {
    using Element = StoredArray::Element;
    constexpr Element kElement = std::is_same_v<Item, int> ? Element::int32 : Element::float64;
    constexpr std::size_t kLeastBytes = std::size_t{1} << 14;
    return !std::is_same_v<Item, bool> && array.element == kElement && array.stride == 0 &&
           !needsSwap(array.bigEndian) && array.count * elementSize(kElement) >= kLeastBytes;
}

class ArraysAhead;

/// How items are read on the first access.
enum class LateReading {
    shown, ///< items in the layout of memory, compressed or not, stay in the file while only values are
           ///< read
    whole  ///< all items at once
};

/// The same on the first access to the array. Shares ownership of the document until then. Vectors may have their
/// fourth numbers in a record of their own; they are 1 where there is none, and where it is corrupt: the other three
/// are usable without them. An array that was inflated in advance is not inflated again.
template <class Item>
void readLate(std::shared_ptr<const Document> document, const Record& record, PlainArray<Item>& items,
              LateReading reading = LateReading::shown, const Record* fourth = nullptr,
              std::shared_ptr<ArraysAhead> ahead = nullptr);

extern template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<FbxVector4>&, LateReading,
                              const Record*, std::shared_ptr<ArraysAhead>);
extern template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<FbxVector2>&, LateReading,
                              const Record*, std::shared_ptr<ArraysAhead>);
extern template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<FbxColor>&, LateReading,
                              const Record*, std::shared_ptr<ArraysAhead>);
extern template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<int>&, LateReading,
                              const Record*, std::shared_ptr<ArraysAhead>);
extern template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<double>&, LateReading,
                              const Record*, std::shared_ptr<ArraysAhead>);
extern template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<bool>&, LateReading,
                              const Record*, std::shared_ptr<ArraysAhead>);

} // namespace detail
FBXSDK_NAMESPACE_END
