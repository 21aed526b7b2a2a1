// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <algorithm>
#include <cstddef>
#include <memory>
#include <new>
#include <utility>
#include <vector>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Creates and destroys values of one type. Their memory is allocated in blocks, reused, and released with the slab.
/// For one thread at a time. With the address sanitizer each value is an allocation of its own.
template <class T>
class Slab {
public:
    template <class... Arguments>
    [[nodiscard]] T* make(Arguments&&... arguments) {
        Cell* const cell = takeCell();
        try {
            return new (cell->bytes) T(std::forward<Arguments>(arguments)...);
        } catch (...) {
            giveBack(cell);
            throw;
        }
    }
    void free(T* value) noexcept {
        value->~T();
        giveBack(reinterpret_cast<Cell*>(value));
    }

private:
    union Cell {
        Cell* next;
        alignas(T) std::byte bytes[sizeof(T)];
    };
    static constexpr std::size_t kFirstBlock = 32, kLargestBlock = 512;

#ifdef __SANITIZE_ADDRESS__
    Cell* takeCell() { return new Cell; }
    void giveBack(Cell* cell) noexcept { delete cell; }
#else
    Cell* takeCell() {
        if (Cell* const cell = mFree) {
            mFree = cell->next;
            return cell;
        }
        if (mUsed == mSize)
            addBlock();
        return &mBlocks.back()[mUsed++];
    }
    void giveBack(Cell* cell) noexcept {
        cell->next = mFree;
        mFree = cell;
    }
    void addBlock() {
        const std::size_t size = std::clamp(2 * mSize, kFirstBlock, kLargestBlock);
        mBlocks.push_back(std::make_unique_for_overwrite<Cell[]>(size));
        mSize = size;
        mUsed = 0;
    }

    std::vector<std::unique_ptr<Cell[]>> mBlocks;
    Cell* mFree = nullptr;
    std::size_t mSize = 0, mUsed = 0; ///< of the last block
#endif
};

} // namespace detail
FBXSDK_NAMESPACE_END
