// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Packed items of a file, in memory as long as somebody looks at them.
#pragma once

#include <memory>

#include "container/FileBytes.h"
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

    /// The places of all bytes. Whoever reads some asks for a look at them.
    [[nodiscard]] virtual std::span<const char> bytes() const = 0;
    /// Some of the bytes, until the next look. Throws FileFault.
    [[nodiscard]] virtual const char* look(std::span<const char> part) { return part.data(); }
    /// These of the bytes need not be in memory. Before any of them is read again, restore must have been called.
    virtual void release(std::span<const char> part) = 0;
    /// All bytes are there again.
    virtual void restore() = 0;
};

/// An array that the file has just so. Each look reads it.
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
    std::span<const char> mLast; ///< of the last look
};

/// A compressed array. It is inflated when it is made, and a second time when it is restored; then it stays, so that
/// nobody pays more than twice for reading again and again.
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
