// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The bytes of a file, read when somebody wants to look at them.
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

/// Thrown where a file is not any more what it was when it was opened, or cannot be read any more. The text names the
/// file and says what happened.
class FileFault : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// What `work` returns; false when it meets such a file, and the status then has the reason.
template <class Work>
bool faultToStatus(FbxStatus& status, const Work& work) {
    try {
        return work();
    } catch (const FileFault& fault) {
        status.SetCode(FbxStatus::eFailure, "%s", fault.what());
        return false;
    }
}

/// A file that is open for as long as the object lives. Every byte has its place in memory from the start and comes
/// there when it is fetched; what was fetched stays as it was read.
///
/// Files are not mapped: whoever shortens a mapped file takes its pages away, and the next look at them ends the
/// process.
class FileBytes {
public:
    FileBytes(const FileBytes&) = delete;
    FileBytes& operator=(const FileBytes&) = delete;
    ~FileBytes();

    /// Pipes are read to their end, up to kMostPipeBytes. Null when the file cannot be opened, is neither a regular
    /// file nor a pipe, or is empty; the status then says which.
    [[nodiscard]] static std::shared_ptr<const FileBytes> open(const std::string& fileName, FbxStatus& status);

    /// All bytes in their places. Only those that were fetched may be looked at.
    [[nodiscard]] std::span<const char> bytes() const { return mMemory.first(mSize); }

    /// Whether the bytes are some of these.
    [[nodiscard]] bool contains(std::span<const char> part) const;

    /// Brings some of the bytes to their places. Throws FileFault; what was there before is then still there.
    void fetch(std::span<const char> part) const;
    /// Reads some of the bytes, given by their places, to somewhere else. Throws FileFault, also when the file was
    /// changed since it was opened: bytes of before and after do not belong together.
    void read(std::span<const char> part, char* destination) const;
    /// Throws FileFault when the file was changed since it was opened.
    void requireUnchanged() const;

private:
    FileBytes() = default;

    void copy(std::span<const char> part, char* destination) const;
    /// Memory behind what came through a pipe.
    [[nodiscard]] std::span<const char> tail() const;

    std::string mName;
    int mFile = -1; ///< none once all bytes are there
    timespec mModified{};
    std::span<char> mMemory;
    std::size_t mSize = 0;
};

/// Fetches what a reader comes by that goes through a file from front to back, somewhat more at a time the longer it
/// goes on without leaving anything out. Bytes of memory are there already.
class ReadAhead {
public:
    ReadAhead(std::span<const char> bytes, const FileBytes* file)
        : mBytes(bytes), mFile(file), mEnd(file ? 0 : bytes.size()) {}

    /// Before anybody looks at these bytes, which must be some of all. Throws FileFault.
    void need(std::size_t offset, std::size_t size) {
        if (size > mEnd || offset > mEnd - size)
            fetchUpTo(offset, offset + size);
    }
    void need(std::span<const char> part) { need(static_cast<std::size_t>(part.data() - mBytes.data()), part.size()); }

private:
    void fetchUpTo(std::size_t offset, std::size_t end);

    std::span<const char> mBytes;
    const FileBytes* mFile;
    std::size_t mEnd; ///< up to where bytes are there
    std::size_t mStep = 0;
};

} // namespace detail
FBXSDK_NAMESPACE_END
