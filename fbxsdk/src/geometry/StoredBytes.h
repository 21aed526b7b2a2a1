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

    [[nodiscard]] virtual std::span<const char> bytes() const = 0;
    /// These of the bytes need not be in memory. Before any of them is read again, restore must have been called.
    virtual void release(std::span<const char> part) = 0;
    /// All bytes are there again.
    virtual void restore() = 0;
};

/// An array of a file. It is read, and inflated if need be, when it is made, and a second time when it is restored;
/// then it stays, so that nobody pays more than twice for reading again and again.
class LoadedBytes final : public StoredBytes {
public:
    /// Throws std::bad_alloc when there is no memory, and FileFault when the file was changed.
    LoadedBytes(std::shared_ptr<const FileBytes> file, const StoredArray& array);

    /// False when the array is corrupt. All bytes are zero then.
    [[nodiscard]] bool isSound() const { return mSound; }

    [[nodiscard]] std::span<const char> bytes() const override { return mMemory.bytes(); }
    void release(std::span<const char> part) override;
    /// Throws as the constructor does, and may be called again.
    void restore() override;

private:
    void load();

    std::shared_ptr<const FileBytes> mFile;
    StoredArray mArray;
    PageMemory mMemory;
    bool mSound = false;
    bool mIncomplete = false; ///< some bytes were released
    bool mStays = false;
};

} // namespace detail
FBXSDK_NAMESPACE_END
