// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The memory behind geometry: contiguous items of plain types that can grow without being initialised, so that a file's
// numbers are decoded straight into place.
#pragma once

#include <algorithm>
#include <cstddef>
#include <type_traits>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Items of one size, given with every call; knows nothing of their type.
class FBXSDK_DLL PlainStorage {
public:
    PlainStorage() = default;
    PlainStorage(const PlainStorage&) = delete;
    PlainStorage& operator=(const PlainStorage&) = delete;
    ~PlainStorage();

    [[nodiscard]] int count() const { return mCount; }
    [[nodiscard]] bool contains(int pIndex) const { return pIndex >= 0 && pIndex < mCount; }

protected:
    [[nodiscard]] void* items() const { return mItems; }
    /// Room for that many items. Throws std::bad_alloc when there is none; the items are untouched then.
    void reserveItems(int pCapacity, std::size_t pItemSize);
    /// New items hold whatever was there.
    void resizeItems(int pCount, std::size_t pItemSize);
    /// Moves the items from the index on up by one place, and returns that place.
    void* openSlot(int pIndex, std::size_t pItemSize);
    void closeSlots(int pIndex, int pCount, std::size_t pItemSize);

private:
    void* mItems = nullptr;
    int mCount = 0;
    int mCapacity = 0;
};

/// A growing array of a plain type. Negative counts mean none; indices are the caller's to check.
template <class T>
class PlainArray : public PlainStorage {
    static_assert(std::is_trivially_copyable<T>::value, "items are moved as bytes");

public:
    [[nodiscard]] T* data() const { return static_cast<T*>(items()); }
    [[nodiscard]] T& operator[](int pIndex) const { return data()[pIndex]; }
    [[nodiscard]] T* begin() const { return data(); }
    [[nodiscard]] T* end() const { return data() + count(); }

    void reserve(int pCapacity) { reserveItems(pCapacity, sizeof(T)); }
    void resizeUninitialised(int pCount) { resizeItems(pCount, sizeof(T)); }
    void resize(int pCount, const T& pNewItem) {
        const T item = pNewItem; // it may be one of ours
        const int first = count();
        resizeUninitialised(pCount);
        if (count() > first)
            std::fill(data() + first, end(), item);
    }
    void add(const T& pItem) {
        const T item = pItem;
        *static_cast<T*>(openSlot(count(), sizeof(T))) = item;
    }
    void insert(int pIndex, const T& pItem) {
        const T item = pItem;
        *static_cast<T*>(openSlot(pIndex, sizeof(T))) = item;
    }
    void remove(int pIndex, int pCount = 1) { closeSlots(pIndex, pCount, sizeof(T)); }
    void clear() { resizeUninitialised(0); }
};

} // namespace detail
FBXSDK_NAMESPACE_END
