// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An array whose copies share its elements until one of them is changed. Equal elements at its end take no memory.
#pragma once

#include <algorithm>
#include <atomic>
#include <cstddef>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::detail {

/// Copying takes no memory and never fails. Copies may be read, changed and destroyed in different threads; a single
/// object belongs to one thread while it changes, as a vector does.
template <class Element>
class SharedArray {
public:
    SharedArray() = default;
    SharedArray(const SharedArray& other) noexcept : mHeld(other.mHeld) {
        if (mHeld != nullptr)
            mHeld->holders.fetch_add(1, std::memory_order_relaxed);
    }
    SharedArray(SharedArray&& other) noexcept : mHeld(std::exchange(other.mHeld, nullptr)) {}
    SharedArray& operator=(SharedArray other) noexcept {
        std::swap(mHeld, other.mHeld);
        return *this;
    }
    ~SharedArray() {
        if (mHeld != nullptr && mHeld->holders.fetch_sub(1, std::memory_order_acq_rel) == 1)
            delete mHeld;
    }

    std::size_t size() const noexcept { return mHeld != nullptr ? std::max(mHeld->elements.size(), mHeld->filled) : 0; }
    /// The element at an index below the size.
    const Element& operator[](std::size_t index) const noexcept {
        return index < mHeld->elements.size() ? mHeld->elements[index] : mHeld->filler;
    }

    /// The elements that take memory: all but equal ones at the end, from `fill`. May be null when there are none.
    const Element* stored() const noexcept { return mHeld != nullptr ? mHeld->elements.data() : nullptr; }
    std::size_t storedCount() const noexcept { return mHeld != nullptr ? mHeld->elements.size() : 0; }
    /// The value of the others, if any.
    const Element* filler() const noexcept { return storedCount() < size() ? &mHeld->filler : nullptr; }

    /// The same for arrays that share their elements, and for these only. Null for a new array.
    const void* identity() const noexcept { return mHeld; }
    /// Whether another array shares the elements.
    bool isShared() const noexcept { return mHeld != nullptr && !isOwn(); }

    /// Reserves memory for that many elements, so that changes up to there need no more. Throws std::bad_alloc.
    void reserve(std::size_t count) { ownAsStored().elements.reserve(count); }

    /// Appends elements with this value up to a count; existing ones stay. They take no memory until `own` is called.
    void fill(std::size_t count, const Element& value) {
        if (size() < count) {
            Held& held = size() > storedCount() ? (own(), *mHeld) : ownAsStored();
            held.filler = value;
            held.filled = count;
        }
    }

    /// All elements, for changing them: owned by this array alone afterwards, a copy where others share them. Throws
    /// std::bad_alloc; the array is unchanged then.
    std::vector<Element>& own() {
        Held& held = ownAsStored();
        if (held.elements.size() < held.filled)
            held.elements.resize(held.filled, held.filler);
        held.filled = 0;
        return held.elements;
    }

    /// Removes all elements. The memory is kept, unless others share it.
    void clear() noexcept {
        if (isShared()) {
            *this = SharedArray();
        } else if (mHeld != nullptr) {
            mHeld->elements.clear();
            mHeld->filled = 0;
        }
    }

private:
    struct Held {
        std::atomic<std::size_t> holders{1};
        std::vector<Element> elements;
        std::size_t filled = 0; ///< the size, if there are more elements than stored ones
        Element filler{};
    };

    explicit SharedArray(const Held& held) : mHeld(new Held{{1}, held.elements, held.filled, held.filler}) {}

    Held& ownAsStored() {
        if (mHeld == nullptr)
            mHeld = new Held;
        else if (!isOwn())
            *this = SharedArray(*mHeld);
        return *mHeld;
    }

    /// Acquire: the last reader elsewhere is done with the elements before this array changes them.
    bool isOwn() const noexcept { return mHeld->holders.load(std::memory_order_acquire) == 1; }

    Held* mHeld = nullptr;
};

} // namespace Tarnell::Fbx::detail
