// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Items that are made of doubles alone are decoded in place. Points have one double more than files store: theirs are
// decoded into the end of the array and moved apart from the front on:
//
//      [ . . . x y z x y z x y z ]   ->   [ x y z 1 x y z 1 x y z 1 ]
#include "geometry/ItemReading.h"

#include <climits>
#include <type_traits>
#include <vector>

#include "container/ByteOrder.h"
#include "container/NumberDecoding.h"
#include "geometry/StoredBytes.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

static_assert(sizeof(FbxVector4) == 4 * sizeof(double) && sizeof(FbxVector2) == 2 * sizeof(double) &&
              sizeof(FbxColor) == 4 * sizeof(double));

int itemCount(const Record& record, std::size_t numbersPerItem) {
    constexpr std::size_t kMost = INT_MAX / 4; // so that also the numbers of all items can be counted
    return static_cast<int>(std::min(record.numberCount() / numbersPerItem, kMost));
}

template <class Item>
bool keptIf(bool decoded, PlainArray<Item>& items) {
    if (!decoded)
        items.clear();
    return decoded;
}

/// Item consists of doubles and nothing else.
template <class Item>
bool readInPlace(const Record& record, PlainArray<Item>& items) {
    constexpr std::size_t kNumbersPerItem = sizeof(Item) / sizeof(double); // NOLINT(bugprone-sizeof-expression)
    const int count = itemCount(record, kNumbersPerItem);
    items.resizeUninitialised(count);
    const std::span numbers(reinterpret_cast<double*>(items.data()), static_cast<std::size_t>(count) * kNumbersPerItem);
    return keptIf(record.readNumbers(numbers), items);
}

/// Smaller arrays are not worth a window to the file.
constexpr std::size_t kLeastStoredBytes = std::size_t{1} << 14;

/// Whether the packed numbers of an array are items.
template <class Item>
bool holdsItems(const StoredArray& array) {
    using Element = StoredArray::Element;
    constexpr Element kElement = std::is_same_v<Item, int> ? Element::int32 : Element::float64;
    return !std::is_same_v<Item, bool> && array.element == kElement && array.stride == 0 &&
           !needsSwap(array.bigEndian) && array.count * elementSize(kElement) >= kLeastStoredBytes;
}

/// Null when the array is corrupt.
std::unique_ptr<StoredBytes> storedBytes(const std::shared_ptr<const FileBytes>& file, const StoredArray& array) {
    if (!array.compressed)
        return std::make_unique<FileWindow>(file, array);
    auto inflated = std::make_unique<InflatedBytes>(file, array);
    return inflated->isSound() ? std::move(inflated) : nullptr;
}

struct FourthNumbers {
    std::unique_ptr<double[]> numbers;
    int count = 0;
};

/// None when all of them are 1, as nearly always: the vectors can stay in the file then.
FourthNumbers unusualFourths(const Record* record) {
    const int count = record ? itemCount(*record, 1) : 0;
    if (count == 0)
        return {};
    const auto size = static_cast<std::size_t>(count);
    auto numbers = std::make_unique_for_overwrite<double[]>(size);
    const std::span all(numbers.get(), size);
    const bool usual =
        !record->readNumbers(all) || std::all_of(all.begin(), all.end(), [](double number) { return number == 1.0; });
    return usual ? FourthNumbers{} : FourthNumbers{std::move(numbers), count};
}

} // namespace

bool readItems(const Record& record, PlainArray<FbxVector4>& items) {
    const int count = itemCount(record, 3);
    const auto points = static_cast<std::size_t>(count);
    items.resizeUninitialised(count);
    auto* const numbers = reinterpret_cast<double*>(items.data());
    const std::span stored(numbers + points, 3 * points);
    if (!keptIf(record.readNumbers(stored), items))
        return false;
    const double* from = stored.data();
    for (std::size_t i = 0; i < points; ++i, from += 3) {
        const double x = from[0], y = from[1], z = from[2]; // the last points overlap with where they go
        items.data()[i] = FbxVector4(x, y, z, 1.0);
    }
    return true;
}

bool readWeightedPoints(const Record& record, PlainArray<FbxVector4>& items) { return readInPlace(record, items); }
bool readItems(const Record& record, PlainArray<FbxVector2>& items) { return readInPlace(record, items); }
bool readItems(const Record& record, PlainArray<FbxColor>& items) { return readInPlace(record, items); }
bool readItems(const Record& record, PlainArray<double>& items) { return readInPlace(record, items); }

bool readItems(const Record& record, PlainArray<int>& items) {
    items.resizeUninitialised(itemCount(record, 1));
    return keptIf(record.readNumbers(std::span<std::int32_t>(items.data(), static_cast<std::size_t>(items.count()))),
                  items);
}

bool readItems(const Record& record, PlainArray<bool>& items) {
    PlainArray<int> numbers;
    const bool decoded = readItems(record, numbers);
    items.resizeUninitialised(numbers.count());
    std::transform(numbers.begin(), numbers.end(), items.begin(), [](int number) { return number != 0; });
    return decoded;
}

template <class Item>
bool fetchItems(const Document& document, const Record& record, PlainArray<Item>& items) {
    const StoredArray* const array = record.array();
    const std::shared_ptr<const FileBytes>& file = document.tree->file;
    if (!array || !file || !file->contains(array->bytes) || !holdsItems<Item>(*array))
        return readItems(record, items);
    std::unique_ptr<StoredBytes> bytes = storedBytes(file, *array);
    items.clear();
    if (!bytes)
        return false;
    constexpr std::size_t kNumberBytes = std::is_same_v<Item, int> ? sizeof(std::int32_t) : sizeof(double);
    const int count = itemCount(record, kStoredBytes<Item> / kNumberBytes);
    items.keepStored(std::make_unique<StoredItems>(std::move(bytes), count, kStoredBytes<Item>), count);
    return true;
}

bool fetchVectors(const Document& document, const Record& record, const Record* fourth, PlainArray<FbxVector4>& items) {
    const auto [numbers, count] = unusualFourths(fourth);
    if (!fetchItems(document, record, items))
        return false;
    for (int i = 0; i < std::min(count, items.count()); ++i)
        items[i][3] = numbers[static_cast<std::size_t>(i)];
    return true;
}

template bool fetchItems(const Document&, const Record&, PlainArray<FbxVector4>&);
template bool fetchItems(const Document&, const Record&, PlainArray<FbxVector2>&);
template bool fetchItems(const Document&, const Record&, PlainArray<FbxColor>&);
template bool fetchItems(const Document&, const Record&, PlainArray<int>&);
template bool fetchItems(const Document&, const Record&, PlainArray<double>&);
template bool fetchItems(const Document&, const Record&, PlainArray<bool>&);

} // namespace detail
FBXSDK_NAMESPACE_END
