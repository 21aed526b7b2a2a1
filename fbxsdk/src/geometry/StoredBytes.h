// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Packed items that are looked at where a file has them, or where they were inflated to.
#pragma once

#include <memory>

#include "container/MappedFile.h"
#include "container/PageMemory.h"
#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

class StoredBytes {
public:
    StoredBytes() = default;
    StoredBytes(const StoredBytes&) = delete;
    StoredBytes& operator=(const StoredBytes&) = delete;
    virtual ~StoredBytes() = default;

    [[nodiscard]] virtual std::span<const char> bytes() const = 0;
    /// These of the bytes need not be in memory. Before any of them is read again, restore must have been called.
    virtual void release(std::span<const char> part) = 0;
    /// All bytes are there again.
    virtual void restore() = 0;
};

/// An array that the file has just so. Released pages come back by themselves.
class MappedBytes final : public StoredBytes {
public:
    MappedBytes(std::shared_ptr<const MappedFile> file, const StoredArray& array)
        : mFile(std::move(file)), mBytes(array.bytes) {}

    [[nodiscard]] std::span<const char> bytes() const override { return mBytes; }
    void release(std::span<const char> part) override { mFile->release(part); }
    void restore() override {}

private:
    std::shared_ptr<const MappedFile> mFile;
    std::span<const char> mBytes;
};

/// A compressed array. It is inflated when it is made, and a second time when it is restored; then it stays, so that
/// nobody pays more than twice for reading again and again.
class InflatedBytes final : public StoredBytes {
public:
    /// Throws std::bad_alloc when there is no memory.
    InflatedBytes(std::shared_ptr<const MappedFile> file, const StoredArray& array);

    /// False when the array is corrupt. All bytes are zero then.
    [[nodiscard]] bool isSound() const { return mSound; }

    [[nodiscard]] std::span<const char> bytes() const override { return mMemory.bytes(); }
    void release(std::span<const char> part) override;
    void restore() override;

private:
    void inflate();

    std::shared_ptr<const MappedFile> mFile;
    std::span<const char> mStream;
    PageMemory mMemory;
    bool mSound = false;
    bool mIncomplete = false; ///< some bytes were released
    bool mStays = false;
};

} // namespace detail
FBXSDK_NAMESPACE_END
