// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An array whose copies share its elements until one of them is changed.
#pragma once

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
        if (mHeld != nullptr) {
            mHeld->holders.fetch_add(1, std::memory_order_relaxed);
        }
    }
    SharedArray(SharedArray&& other) noexcept : mHeld(std::exchange(other.mHeld, nullptr)) {}
    SharedArray& operator=(SharedArray other) noexcept {
        std::swap(mHeld, other.mHeld);
        return *this;
    }
    ~SharedArray() {
        if (mHeld != nullptr && mHeld->holders.fetch_sub(1, std::memory_order_acq_rel) == 1) {
            delete mHeld;
        }
    }

    std::size_t size() const noexcept { return mHeld != nullptr ? mHeld->elements.size() : 0; }
    /// May be null when the array is empty.
    const Element* data() const noexcept { return mHeld != nullptr ? mHeld->elements.data() : nullptr; }

    /// Whether another array shares the elements.
    bool isShared() const noexcept { return mHeld != nullptr && !isOwn(); }

    /// The elements, for changing them: owned by this array alone afterwards, a copy where others share them.
    std::vector<Element>& own() {
        if (mHeld == nullptr) {
            mHeld = new Held;
        } else if (!isOwn()) {
            *this = SharedArray(mHeld->elements);
        }
        return mHeld->elements;
    }

    /// Removes all elements. The memory is kept, unless others share it.
    void clear() noexcept {
        if (isShared()) {
            *this = SharedArray();
        } else if (mHeld != nullptr) {
            mHeld->elements.clear();
        }
    }

private:
    struct Held {
        std::atomic<std::size_t> holders{1};
        std::vector<Element> elements;
    };

    explicit SharedArray(const std::vector<Element>& elements) : mHeld(new Held{{1}, elements}) {}

    /// Acquire: the last reader elsewhere is done with the elements before this array changes them.
    bool isOwn() const noexcept { return mHeld->holders.load(std::memory_order_acquire) == 1; }

    Held* mHeld = nullptr;
};

} // namespace Tarnell::Fbx::detail
