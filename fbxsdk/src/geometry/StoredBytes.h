// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <memory>

#include "container/FileBytes.h"
#include "container/PageMemory.h"
#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Packed items of a file, in memory while they are accessed.
class StoredBytes {
public:
    StoredBytes() = default;
    StoredBytes(const StoredBytes&) = delete;
    StoredBytes& operator=(const StoredBytes&) = delete;
    virtual ~StoredBytes() = default;

    /// The addresses of all bytes. A caller requests a window before reading some of them.
    [[nodiscard]] virtual std::span<const char> bytes() const = 0;
    /// Some of the bytes, valid until the next window. Throws FileFault.
    [[nodiscard]] virtual const char* look(std::span<const char> part) { return part.data(); }
    /// Releases these bytes. Before any of them is read again, restore must be called.
    virtual void release(std::span<const char> part) = 0;
    /// Brings all bytes back to memory.
    virtual void restore() = 0;
};

/// An array that the file stores uncompressed in the layout of memory. Each window reads it.
class FileWindow final : public StoredBytes {
public:
    FileWindow(std::shared_ptr<const FileBytes> file, const StoredArray& array)
        : mFile(std::move(file)), mPlaces(array.bytes) {}

    [[nodiscard]] std::span<const char> bytes() const override { return mPlaces; }
    [[nodiscard]] const char* look(std::span<const char> part) override;
    void release(std::span<const char>) override {}
    void restore() override {}

private:
    std::shared_ptr<const FileBytes> mFile;
    std::span<const char> mPlaces;
    std::unique_ptr<char[]> mMemory;
    std::size_t mSize = 0;
    std::span<const char> mLast; ///< of the last window
};

/// A compressed array. It is inflated on construction, and a second time when it is restored; then it stays in memory,
/// so that repeated reading inflates it at most twice.
class InflatedBytes final : public StoredBytes {
public:
    /// Throws std::bad_alloc when there is no memory, and FileFault when the file was changed.
    InflatedBytes(std::shared_ptr<const FileBytes> file, const StoredArray& array);

    /// False when the array is corrupt. All bytes are zero then.
    [[nodiscard]] bool isSound() const { return mSound; }

    [[nodiscard]] std::span<const char> bytes() const override { return mMemory.bytes(); }
    void release(std::span<const char> part) override;
    /// Throws as the constructor does, and may be called again.
    void restore() override;

private:
    void inflate();

    std::shared_ptr<const FileBytes> mFile;
    StoredArray mArray;
    PageMemory mMemory;
    bool mSound = false;
    bool mIncomplete = false; ///< some bytes were released
    bool mStays = false;
};

} // namespace detail
FBXSDK_NAMESPACE_END
