// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The memory behind geometry: contiguous items of plain types that can grow without being initialised, so that a file's
// numbers are decoded straight into place. Items that a file holds just as they are, compressed or not, stay there as
// long as only their values are asked for.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstring>
#include <memory>
#include <type_traits>
#include <utility>

#include <fbxsdk/FbxVector4.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

class StoredBytes;

/// How many bytes of an item a file has; the others are those of a new item.
template <class T>
inline constexpr std::size_t kStoredBytes = sizeof(T);
template <>
inline constexpr std::size_t kStoredBytes<FbxVector4> = 3 * sizeof(double);

/// Items of a file, packed. Whoever reads them more or less in order sees them through a window that moves along, and
/// what lies before it takes no memory any more.
class FBXSDK_DLL StoredItems {
public:
    StoredItems(std::unique_ptr<StoredBytes> pSource, int pCount, std::size_t pItemBytes);
    StoredItems(const StoredItems&) = delete;
    StoredItems& operator=(const StoredItems&) = delete;
    ~StoredItems();

    /// The bytes of an item that exists.
    [[nodiscard]] const char* at(int pIndex, std::size_t pItemBytes) {
        if (static_cast<unsigned>(pIndex - mWindowStart) >= static_cast<unsigned>(mWindowSize))
            moveWindow(pIndex);
        return mWindow + static_cast<std::size_t>(pIndex - mWindowStart) * pItemBytes;
    }

private:
    void moveWindow(int pIndex);
    void releaseUpTo(int pEnd);

    std::unique_ptr<StoredBytes> mSource;
    const char* mWindow = nullptr; ///< the first item of the window
    std::size_t mItemBytes;
    int mCount;
    int mWindowStart = 0;
    int mWindowSize = 0;
};

/// Items of one size, given with every call; knows nothing of their type.
class FBXSDK_DLL PlainStorage {
public:
    PlainStorage();
    PlainStorage(const PlainStorage&) = delete;
    PlainStorage& operator=(const PlainStorage&) = delete;
    ~PlainStorage();

    [[nodiscard]] int count() const { return mCount; }
    [[nodiscard]] bool contains(int pIndex) const { return pIndex >= 0 && pIndex < mCount; }

protected:
    [[nodiscard]] void* items() const { return mItems; }
    /// Whether the items still stand in a file; there is no other memory behind them then.
    [[nodiscard]] bool isStored() const { return mStored != nullptr; }
    [[nodiscard]] StoredItems& stored() const { return *mStored; }
    /// Makes that many items of what a file holds. There must be no items yet.
    void store(std::unique_ptr<StoredItems> pItems, int pCount);
    /// The count remains, and memory for as many items has to be written to.
    [[nodiscard]] void* roomForStored(std::size_t pItemSize) const;
    void leaveFile() const;
    void forgetStored();

    /// Room for that many items. Throws std::bad_alloc when there is none; the items are untouched then.
    void reserveItems(int pCapacity, std::size_t pItemSize);
    /// New items hold whatever was there.
    void resizeItems(int pCount, std::size_t pItemSize);
    /// Moves the items from the index on up by one place, and returns that place.
    void* openSlot(int pIndex, std::size_t pItemSize);
    void closeSlots(int pIndex, int pCount, std::size_t pItemSize);

private:
    void allocate(int pCapacity, std::size_t pItemSize) const;

    // That items come out of the file is no change of the array.
    mutable std::unique_ptr<StoredItems> mStored;
    mutable void* mItems = nullptr;
    mutable int mCapacity = 0;
    int mCount = 0;
};

/// A growing array of a plain type. Negative counts mean none; indices are the caller's to check. Whoever asks for more
/// than values gets all items out of the file first.
template <class T>
class PlainArray : public PlainStorage {
    static_assert(std::is_trivially_copyable<T>::value, "items are moved as bytes");

public:
    [[nodiscard]] T* data() const {
        ensureInMemory();
        return static_cast<T*>(items());
    }
    [[nodiscard]] T value(int pIndex) const {
        return isStored() ? storedItem(stored(), pIndex) : static_cast<const T*>(items())[pIndex];
    }
    [[nodiscard]] T& operator[](int pIndex) const { return data()[pIndex]; }
    [[nodiscard]] T* begin() const { return data(); }
    [[nodiscard]] T* end() const { return data() + count(); }

    /// The items that a file's bytes are, kStoredBytes<T> each, in place of all that were there.
    void keepStored(std::unique_ptr<StoredItems> pItems, int pCount) {
        clear();
        store(std::move(pItems), pCount);
    }
    void reserve(int pCapacity) {
        ensureInMemory();
        reserveItems(pCapacity, kItemBytes);
    }
    void resizeUninitialised(int pCount) {
        ensureInMemory();
        resizeItems(pCount, kItemBytes);
    }
    void resize(int pCount, const T& pNewItem) {
        const T item = pNewItem; // it may be one of ours
        const int first = count();
        resizeUninitialised(pCount);
        if (count() > first)
            std::fill(data() + first, end(), item);
    }
    void add(const T& pItem) {
        const T item = pItem;
        ensureInMemory();
        *static_cast<T*>(openSlot(count(), kItemBytes)) = item;
    }
    void insert(int pIndex, const T& pItem) {
        const T item = pItem;
        ensureInMemory();
        *static_cast<T*>(openSlot(pIndex, kItemBytes)) = item;
    }
    void remove(int pIndex, int pCount = 1) {
        ensureInMemory();
        closeSlots(pIndex, pCount, kItemBytes);
    }
    void clear() {
        forgetStored();
        resizeUninitialised(0);
    }

private:
    static constexpr std::size_t kItemBytes = sizeof(T); // NOLINT(bugprone-sizeof-expression): items can be pointers

    static T storedItem(StoredItems& pItems, int pIndex) {
        T item{};
        std::memcpy(static_cast<void*>(&item), pItems.at(pIndex, kStoredBytes<T>), kStoredBytes<T>);
        return item;
    }
    void ensureInMemory() const {
        if (isStored())
            readStored();
    }
    void readStored() const {
        T* const to = static_cast<T*>(roomForStored(kItemBytes));
        for (int i = 0; i < count(); ++i)
            to[i] = storedItem(stored(), i);
        leaveFile(); // not before all of them are read: a file may have been changed
    }
};

} // namespace detail
FBXSDK_NAMESPACE_END
