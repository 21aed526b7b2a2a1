// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The bytes of a file, read on access.
#pragma once

#include <ctime>
#include <memory>
#include <span>
#include <stdexcept>
#include <string>

#include <fbxsdk/FbxArch.h>
#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Thrown when a file has changed since it was opened, or cannot be read any more. The text names the
/// file and says what happened.
class FileFault : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// What `work` returns; false when it throws FileFault, and the status then has the reason.
template <class Work>
bool faultToStatus(FbxStatus& status, const Work& work) {
    try {
        return work();
    } catch (const FileFault& fault) {
        status.SetCode(FbxStatus::eFailure, "%s", fault.what());
        return false;
    }
}

/// A file that is open for as long as the object lives. Every byte has a fixed address from the start and is read
/// there when it is fetched; fetched bytes do not change.
///
/// Files are not memory-mapped: shortening a mapped file removes its pages, and the next access to them ends the
/// process.
class FileBytes {
public:
    FileBytes(const FileBytes&) = delete;
    FileBytes& operator=(const FileBytes&) = delete;
    ~FileBytes();

    /// Pipes are read to their end, up to kMostPipeBytes. Null when the file cannot be opened, is neither a regular
    /// file nor a pipe, or is empty; the status then says which.
    [[nodiscard]] static std::shared_ptr<const FileBytes> open(const std::string& fileName, FbxStatus& status);

    /// All bytes at their addresses. Only those that were fetched may be accessed.
    [[nodiscard]] std::span<const char> bytes() const { return mMemory.first(mSize); }

    /// Whether all bytes are in memory, so that changes of the file have no effect.
    [[nodiscard]] bool isComplete() const { return mFile < 0; }
    /// Whether the bytes are part of these.
    [[nodiscard]] bool contains(std::span<const char> part) const;

    /// Reads some of the bytes to their addresses. Throws FileFault; bytes fetched before are still valid then.
    void fetch(std::span<const char> part) const;
    /// Reads some of the bytes, given by their addresses, to another place. Throws FileFault, also when the file was
    /// changed since it was opened: bytes from before and after the change are never mixed.
    void read(std::span<const char> part, char* destination) const;
    /// Throws FileFault when the file was changed since it was opened.
    void requireUnchanged() const;

private:
    FileBytes() = default;

    [[nodiscard]] bool reserveMemory(std::size_t size);
    /// Reads everything and closes the file.
    void fetchAll();
    void copy(std::span<const char> part, char* destination) const;
    /// The same on several threads. False when only one is allowed, the part is small, or a piece cannot be read.
    bool copyInPieces(std::span<const char> part, char* destination) const;
    /// The memory of a pipe's content.
    [[nodiscard]] std::span<const char> tail() const;

    std::string mName;
    int mFile = -1; ///< none once all bytes are in memory
    timespec mModified{};
    std::unique_ptr<char[]> mHeap; ///< the memory of a small file
    std::span<char> mMemory;
    std::size_t mSize = 0;
};

/// Fetches the bytes for a sequential reader, in portions that grow as long as it does not skip any.
/// Bytes in memory need no fetching.
class ReadAhead {
public:
    ReadAhead(std::span<const char> bytes, const FileBytes* file)
        : mBytes(bytes), mFile(file), mEnd(file && !file->isComplete() ? 0 : bytes.size()) {}

    /// To be called before these bytes are accessed, which must be part of the whole. Throws FileFault.
    void need(std::size_t offset, std::size_t size) {
        if (size > mEnd || offset > mEnd - size)
            fetchUpTo(offset, offset + size);
    }
    void need(std::span<const char> part) { need(static_cast<std::size_t>(part.data() - mBytes.data()), part.size()); }

private:
    void fetchUpTo(std::size_t offset, std::size_t end);

    std::span<const char> mBytes;
    const FileBytes* mFile;
    std::size_t mEnd; ///< the end of the fetched bytes
    std::size_t mStep = 0;
};

} // namespace detail
FBXSDK_NAMESPACE_END
