// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The arrays of geometry: contiguous items of plain types that can grow without being initialised, so that a file's
// numbers are decoded straight into place.
//
// Arrays are lazy: an array of a file has a source instead of items until an item or their number is accessed. Items
// that the file stores in their layout in memory, compressed or not, stay in the source even then, as long as only
// their values are read.
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

/// How many bytes of an item a file has; the others are those of a new item.
template <class T>
inline constexpr std::size_t kStoredBytes = sizeof(T);
template <>
inline constexpr std::size_t kStoredBytes<FbxVector4> = 3 * sizeof(double);

/// The item whose bytes these are.
template <class T>
[[nodiscard]] inline T storedItem(const char* pBytes) {
    T item{};
    std::memcpy(static_cast<void*>(&item), pBytes, kStoredBytes<T>);
    return item;
}
/// Number by number: a wider load of bytes that were stored in narrower parts stalls the processor.
template <>
[[nodiscard]] inline FbxVector4 storedItem<FbxVector4>(const char* pBytes) {
    double numbers[3];
    std::memcpy(numbers, pBytes, sizeof(numbers));
    return {numbers[0], numbers[1], numbers[2]};
}

/// Consecutive items of an array as bytes, one after another.
struct ItemRun {
    const char* bytes = nullptr; ///< of the first one
    int first = 0;               ///< the index of the first one
    int count = 0;
    std::size_t itemBytes = 0; ///< from one item to the next one

    [[nodiscard]] bool contains(int pIndex) const {
        return static_cast<unsigned>(pIndex - first) < static_cast<unsigned>(count);
    }
    [[nodiscard]] const char* at(int pIndex) const {
        return bytes + static_cast<std::size_t>(pIndex - first) * itemBytes;
    }
};

/// The source of the items of an array until they are in memory. Shown items are accessed through a sliding window.
///
/// Functions that read throw when the file has been changed, and std::bad_alloc. The source is unchanged then.
class FBXSDK_DLL ItemSource {
public:
    ItemSource() = default;
    ItemSource(const ItemSource&) = delete;
    ItemSource& operator=(const ItemSource&) = delete;
    virtual ~ItemSource();

    [[nodiscard]] virtual int count() const = 0;
    [[nodiscard]] virtual std::size_t itemSize() const = 0; ///< in memory
    /// Prepares to show items. False when they can only be read, are corrupt, or none.
    [[nodiscard]] virtual bool show() = 0;
    /// Reads all items into the memory, shown or not. False when they are corrupt.
    [[nodiscard]] virtual bool read(void* pItems) = 0;

    [[nodiscard]] bool hasInWindow(int pIndex) const {
        return static_cast<unsigned>(pIndex - mWindowStart) < static_cast<unsigned>(mWindowSize);
    }
    /// The packed bytes of an item in the window, until the window is moved.
    [[nodiscard]] const char* at(int pIndex, std::size_t pItemBytes) const {
        return mWindow + static_cast<std::size_t>(pIndex - mWindowStart) * pItemBytes;
    }
    /// The items in the window, until it is moved.
    [[nodiscard]] ItemRun window(std::size_t pItemBytes) const {
        return {mWindow, mWindowStart, mWindowSize, pItemBytes};
    }
    /// Moves the window to an item that exists. Items must be shown.
    virtual void moveWindow(int pIndex) = 0;

protected:
    const char* mWindow = nullptr; ///< the first item of the window
    int mWindowStart = 0;
    int mWindowSize = 0;
};

/// Items of one size, passed to every call; independent of their type.
class FBXSDK_DLL PlainStorage {
public:
    PlainStorage();
    PlainStorage(const PlainStorage&) = delete;
    PlainStorage& operator=(const PlainStorage&) = delete;
    ~PlainStorage();

    [[nodiscard]] int count() const {
        if (isPending())
            open();
        return mCount;
    }
    [[nodiscard]] bool contains(int pIndex) const {
        return static_cast<unsigned>(pIndex) < static_cast<unsigned>(mCount) ||
               (isPending() && pIndex >= 0 && pIndex < count());
    }
    /// Whether the items are still to be read from the source.
    [[nodiscard]] bool isPending() const { return mCount == 0 && mSource; }
    /// Replaces all items by those of the source, which are read on demand.
    void setSource(std::unique_ptr<ItemSource> pSource);

protected:
    [[nodiscard]] void* items() const { return mItems; }
    /// Null when the items are in memory, which they never are as long as there is a source.
    [[nodiscard]] ItemSource* source() const { return mSource.get(); }
    /// Brings an item into the window of the source; false when all items are in memory now.
    bool reach(int pIndex) const;
    void ensureInMemory() const {
        if (mSource)
            readSource();
    }
    void clearItems();

    /// Reserves capacity for that many items. Throws std::bad_alloc on failure; the items are untouched then.
    void reserveItems(int pCapacity, std::size_t pItemSize);
    /// New items are uninitialised.
    void resizeItems(int pCount, std::size_t pItemSize);
    /// Moves the items from the index on up by one, and returns the index.
    void* openSlot(int pIndex, std::size_t pItemSize);
    /// Appends an item.
    void* addSlot(std::size_t pItemSize) {
        if (mCount == mCapacity)
            return openSlot(mCount, pItemSize);
        return static_cast<std::byte*>(mItems) + static_cast<std::size_t>(mCount++) * pItemSize;
    }
    void closeSlots(int pIndex, int pCount, std::size_t pItemSize);

private:
    void open() const;
    void readSource() const;
    void allocate(int pCapacity, std::size_t pItemSize) const;

    // Reading the items from the source does not change the array's value. The count of an unread source is 0.
    mutable std::unique_ptr<ItemSource> mSource;
    mutable void* mItems = nullptr;
    mutable int mCapacity = 0;
    mutable int mCount = 0;
};

/// A growing array of a plain type. Negative counts mean none; the caller checks indices. All accesses other than
/// reading a value read all items into memory first.
template <class T>
class PlainArray : public PlainStorage {
    static_assert(std::is_trivially_copyable<T>::value, "items are moved as bytes");

public:
    [[nodiscard]] T* data() const {
        ensureInMemory();
        return static_cast<T*>(items());
    }
    [[nodiscard]] T value(int pIndex) const {
        return source() ? sourceItem(pIndex) : static_cast<const T*>(items())[pIndex];
    }
    /// Items around one that exists, for reading several of them: valid until the array is accessed in another way.
    /// Items of a source have kStoredBytes each.
    [[nodiscard]] ItemRun run(int pIndex) const {
        if (source() && (source()->hasInWindow(pIndex) || reach(pIndex)))
            return source()->window(kStoredBytes<T>);
        return {static_cast<const char*>(items()), 0, count(), kItemBytes};
    }
    [[nodiscard]] T& operator[](int pIndex) const { return data()[pIndex]; }
    [[nodiscard]] T* begin() const { return data(); }
    [[nodiscard]] T* end() const { return data() + count(); }

    void reserve(int pCapacity) {
        ensureInMemory();
        reserveItems(pCapacity, kItemBytes);
    }
    void resizeUninitialised(int pCount) {
        ensureInMemory();
        resizeItems(pCount, kItemBytes);
    }
    void resize(int pCount, const T& pNewItem) {
        const T item = pNewItem; // the argument may be an item of this array
        const int first = count();
        resizeUninitialised(pCount);
        if (count() > first)
            std::fill(data() + first, end(), item);
    }
    void add(const T& pItem) {
        const T item = pItem;
        ensureInMemory();
        *static_cast<T*>(addSlot(kItemBytes)) = item;
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
    void clear() { clearItems(); }

private:
    static constexpr std::size_t kItemBytes = sizeof(T); // NOLINT(bugprone-sizeof-expression): items can be pointers

    T sourceItem(int pIndex) const {
        if (!source()->hasInWindow(pIndex) && !reach(pIndex))
            return static_cast<const T*>(items())[pIndex];
        return storedItem<T>(source()->at(pIndex, kStoredBytes<T>));
    }
};

} // namespace detail
FBXSDK_NAMESPACE_END
