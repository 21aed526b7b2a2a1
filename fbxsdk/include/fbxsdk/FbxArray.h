// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <algorithm>
#include <cassert>
#include <cstddef>
#include <type_traits>
#include <vector>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

/// A growing array with the API's `int` indices. Element indices are checked by assertions only. References to
/// elements are valid until the count grows.
template <typename T>
class FbxArray {
    static_assert(!std::is_same<T, bool>::value, "elements are handed out by reference; packed bits cannot be");

public:
    FbxArray() = default; ///< No elements.
    /// Capacity for that many elements; the array is empty.
    explicit FbxArray(int pCapacity) { Reserve(pCapacity); }

    [[nodiscard]] int GetCount() const { return static_cast<int>(mItems.size()); } ///< How many elements there are.
    [[nodiscard]] int Size() const { return GetCount(); }                          ///< The same.

    T& operator[](int pIndex) { return mItems[checked(pIndex)]; }               ///< The element must exist.
    const T& operator[](int pIndex) const { return mItems[checked(pIndex)]; }   ///< The element must exist.
    [[nodiscard]] T GetAt(int pIndex) const { return mItems[checked(pIndex)]; } ///< A copy; the element must exist.
    void SetAt(int pIndex, const T& pElement) { mItems[checked(pIndex)] = pElement; } ///< The element must exist.
    [[nodiscard]] T GetFirst() const { return GetAt(0); }                             ///< The array must not be empty.
    [[nodiscard]] T GetLast() const { return GetAt(GetCount() - 1); }                 ///< The array must not be empty.
    [[nodiscard]] T* GetArray() { return mItems.data(); } ///< All elements, contiguous; valid until the count grows.
    [[nodiscard]] const T* GetArray() const { return mItems.data(); } ///< The same for reading.

    /// The index of the first equal element at or after the start; -1 when there is none.
    [[nodiscard]] int Find(const T& pElement, int pStartIndex = 0) const {
        if (pStartIndex < 0 || pStartIndex >= GetCount())
            return -1;
        const auto found = std::find(mItems.begin() + pStartIndex, mItems.end(), pElement);
        return found == mItems.end() ? -1 : static_cast<int>(found - mItems.begin());
    }

    /// Appends; the result is the new element's index.
    int Add(const T& pElement) {
        mItems.push_back(pElement);
        return GetCount() - 1;
    }
    /// Appends the element unless an equal one exists; its index in both cases.
    int AddUnique(const T& pElement) {
        const int found = Find(pElement);
        return found >= 0 ? found : Add(pElement);
    }
    /// An index beyond the end appends; a negative one does nothing and gives -1.
    int InsertAt(int pIndex, const T& pElement) {
        if (pIndex < 0)
            return -1;
        const int index = std::min(pIndex, GetCount());
        mItems.insert(mItems.begin() + index, pElement);
        return index;
    }
    /// Removes the element and returns it; it must exist.
    T RemoveAt(int pIndex) {
        const T removed = GetAt(pIndex);
        mItems.erase(mItems.begin() + pIndex);
        return removed;
    }
    /// Removes the last element and returns it; the array must not be empty.
    T RemoveLast() { return RemoveAt(GetCount() - 1); }

    /// Reserves capacity for that many more elements without reallocation; the count stays. Negative counts as 0.
    void Reserve(int pCapacity) { mItems.reserve(static_cast<size_t>(std::max(pCapacity, 0))); }
    /// New elements are value-initialised. Negative counts as 0.
    void Resize(int pCount) { mItems.resize(static_cast<size_t>(std::max(pCount, 0))); }
    void Clear() { mItems.clear(); } ///< Removes all elements.

    [[nodiscard]] auto begin() { return mItems.begin(); }       ///< For loops over all elements.
    [[nodiscard]] auto end() { return mItems.end(); }           ///< For loops over all elements.
    [[nodiscard]] auto begin() const { return mItems.begin(); } ///< The same for reading.
    [[nodiscard]] auto end() const { return mItems.end(); }     ///< The same for reading.

    /// As many elements, equal one by one.
    bool operator==(const FbxArray& pOther) const { return mItems == pOther.mItems; }
    bool operator!=(const FbxArray& pOther) const { return !(*this == pOther); } ///< The opposite.

private:
    [[nodiscard]] size_t checked(int pIndex) const {
        assert(pIndex >= 0 && pIndex < GetCount());
        return static_cast<size_t>(pIndex);
    }

    std::vector<T> mItems;
};

FBXSDK_NAMESPACE_END
