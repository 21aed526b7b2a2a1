// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Items that are made of doubles alone are decoded in place. Points have one double more than files store: theirs are
// decoded into the end of the array and moved apart from the front on:
//
//      [ . . . x y z x y z x y z ]   ->   [ x y z 1 x y z 1 x y z 1 ]
#include "geometry/ItemReading.h"

#include <climits>
#include <vector>

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
    constexpr std::size_t kNumbersPerItem = sizeof(Item) / sizeof(double);
    const int count = itemCount(record, kNumbersPerItem);
    items.resizeUninitialised(count);
    const std::span numbers(reinterpret_cast<double*>(items.data()), static_cast<std::size_t>(count) * kNumbersPerItem);
    return keptIf(record.readNumbers(numbers), items);
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

} // namespace detail
FBXSDK_NAMESPACE_END
