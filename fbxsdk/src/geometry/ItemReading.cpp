// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Items that consist of doubles are decoded in place. Points have one double more than files store: theirs are
// decoded into the end of the array and moved apart from the front on:
//
//      [ . . . x y z x y z x y z ]   ->   [ x y z 1 x y z 1 x y z 1 ]
#include "geometry/ItemReading.h"

#include <climits>
#include <type_traits>
#include <vector>

#include "geometry/ArraysAhead.h"
#include "geometry/StoredItems.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

static_assert(sizeof(FbxVector4) == 4 * sizeof(double) && sizeof(FbxVector2) == 2 * sizeof(double) &&
              sizeof(FbxColor) == 4 * sizeof(double));

int itemCount(const Record& record, std::size_t numbersPerItem) {
    constexpr std::size_t kMost = INT_MAX / 4; // so that the total count of numbers also fits
    return static_cast<int>(std::min(record.numberCount() / numbersPerItem, kMost));
}

/// The count of numbers per item in a record.
template <class Item>
constexpr std::size_t kNumbersPerItem = kStoredBytes<Item> / sizeof(double);
template <>
constexpr std::size_t kNumbersPerItem<int> = 1;
template <>
constexpr std::size_t kNumbersPerItem<bool> = 1;

/// Item consists of doubles only.
template <class Item>
bool decodeInPlace(const Record& record, std::span<Item> items) {
    constexpr std::size_t kNumbers = sizeof(Item) / sizeof(double); // NOLINT(bugprone-sizeof-expression)
    return record.readNumbers(std::span(reinterpret_cast<double*>(items.data()), items.size() * kNumbers));
}

bool decode(const Record& record, std::span<FbxVector4> items) {
    auto* const numbers = reinterpret_cast<double*>(items.data());
    const std::span stored(numbers + items.size(), 3 * items.size());
    if (!record.readNumbers(stored))
        return false;
    const double* from = stored.data();
    for (std::size_t i = 0; i < items.size(); ++i, from += 3) {
        const double x = from[0], y = from[1], z = from[2]; // the last points overlap with their destination
        items[i] = FbxVector4(x, y, z, 1.0);
    }
    return true;
}

bool decode(const Record& record, std::span<FbxVector2> items) { return decodeInPlace(record, items); }
bool decode(const Record& record, std::span<FbxColor> items) { return decodeInPlace(record, items); }
bool decode(const Record& record, std::span<double> items) { return decodeInPlace(record, items); }
bool decode(const Record& record, std::span<int> items) { return record.readNumbers(items); }

bool decode(const Record& record, std::span<bool> items) {
    std::vector<std::int32_t> numbers(items.size());
    const bool decoded = record.readNumbers(numbers);
    std::transform(numbers.begin(), numbers.end(), items.begin(), [](std::int32_t number) { return number != 0; });
    return decoded;
}

template <class Item>
std::span<Item> resized(const Record& record, PlainArray<Item>& items, std::size_t numbersPerItem) {
    items.resizeUninitialised(itemCount(record, numbersPerItem));
    return {items.data(), static_cast<std::size_t>(items.count())};
}

template <class Item>
bool keptIf(bool decoded, PlainArray<Item>& items) {
    if (!decoded)
        items.clear();
    return decoded;
}

template <class Item>
bool decodeAll(const Record& record, PlainArray<Item>& items) {
    return keptIf(decode(record, resized(record, items, kNumbersPerItem<Item>)), items);
}

/// Null when the array is corrupt.
std::unique_ptr<StoredBytes> storedBytes(const std::shared_ptr<const FileBytes>& file, const StoredArray& array,
                                         ArraysAhead* ahead) {
    if (!array.compressed)
        return std::make_unique<FileWindow>(file, array);
    std::unique_ptr<InflatedBytes> inflated = ahead ? ahead->take(array) : nullptr;
    if (!inflated)
        inflated = std::make_unique<InflatedBytes>(file, array);
    return inflated->isSound() ? std::move(inflated) : nullptr;
}

struct FourthNumbers {
    std::unique_ptr<double[]> numbers;
    int count = 0;
};

/// None when all of them are 1, the usual case: the vectors can stay in the file then.
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

/// The array of a record.
template <class Item>
class RecordItems final : public StoredItems<Item> {
public:
    RecordItems(std::shared_ptr<const Document> document, const Record& record, LateReading reading,
                const Record* fourth, std::shared_ptr<ArraysAhead> ahead)
        : StoredItems<Item>(itemCount(record, kNumbersPerItem<Item>)), mDocument(std::move(document)), mRecord(record),
          mReading(reading), mFourth(fourth), mAhead(std::move(ahead)) {}

    [[nodiscard]] bool show() override {
        const StoredArray* const array = mRecord.array();
        const std::shared_ptr<const FileBytes>& file = mDocument->tree->file;
        if (mReading == LateReading::whole || !array || !file || !file->contains(array->bytes) ||
            !holdsLargeItems<Item>(*array) || unusualFourths(mFourth).count > 0)
            return false;
        this->setBytes(storedBytes(file, *array, mAhead.get()));
        if (this->hasBytes()) {
            mAhead.reset();
            mDocument.reset(); // the bytes depend only on the file
        }
        return this->hasBytes();
    }

    [[nodiscard]] bool read(void* items) override {
        if (this->hasBytes() || (mAhead && show()))
            return StoredItems<Item>::read(items);
        const std::span<Item> all(static_cast<Item*>(items), static_cast<std::size_t>(this->count()));
        if (!decode(mRecord, all))
            return false;
        if constexpr (std::is_same_v<Item, FbxVector4>) {
            const auto [numbers, count] = unusualFourths(mFourth);
            for (std::size_t i = 0; i < std::min(static_cast<std::size_t>(count), all.size()); ++i)
                all[i][3] = numbers[i];
        }
        return true;
    }

private:
    std::shared_ptr<const Document> mDocument;
    const Record& mRecord; ///< owned by the document
    LateReading mReading;
    const Record* mFourth;
    std::shared_ptr<ArraysAhead> mAhead; ///< destroyed before the document, which owns its arrays
};

} // namespace

bool readItems(const Record& record, PlainArray<FbxVector4>& items) { return decodeAll(record, items); }
bool readItems(const Record& record, PlainArray<FbxVector2>& items) { return decodeAll(record, items); }
bool readItems(const Record& record, PlainArray<FbxColor>& items) { return decodeAll(record, items); }
bool readItems(const Record& record, PlainArray<int>& items) { return decodeAll(record, items); }
bool readItems(const Record& record, PlainArray<double>& items) { return decodeAll(record, items); }
bool readItems(const Record& record, PlainArray<bool>& items) { return decodeAll(record, items); }

bool readWeightedPoints(const Record& record, PlainArray<FbxVector4>& items) {
    return keptIf(decodeInPlace(record, resized(record, items, 4)), items);
}

template <class Item>
void readLate(std::shared_ptr<const Document> document, const Record& record, PlainArray<Item>& items,
              LateReading reading, const Record* fourth, std::shared_ptr<ArraysAhead> ahead) {
    items.setSource(
        std::make_unique<RecordItems<Item>>(std::move(document), record, reading, fourth, std::move(ahead)));
}

template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<FbxVector4>&, LateReading,
                       const Record*, std::shared_ptr<ArraysAhead>);
template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<FbxVector2>&, LateReading,
                       const Record*, std::shared_ptr<ArraysAhead>);
template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<FbxColor>&, LateReading,
                       const Record*, std::shared_ptr<ArraysAhead>);
template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<int>&, LateReading, const Record*,
                       std::shared_ptr<ArraysAhead>);
template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<double>&, LateReading, const Record*,
                       std::shared_ptr<ArraysAhead>);
template void readLate(std::shared_ptr<const Document>, const Record&, PlainArray<bool>&, LateReading, const Record*,
                       std::shared_ptr<ArraysAhead>);

} // namespace detail
FBXSDK_NAMESPACE_END
