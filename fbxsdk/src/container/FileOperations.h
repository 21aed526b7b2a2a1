// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The system's operations for writing a file. Tests substitute a class that fails at chosen places.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Each operation returns 0 or the system's error number.
class FileOperations {
public:
    virtual ~FileOperations() = default;

    /// Opens a file that must not be there yet, for reading too, with the usual permissions or, unless 0, with those
    /// given.
    virtual int create(const std::string& path, unsigned permissions, int& file);
    /// Opens a pipe or a device. Waits for a reader of a pipe, for a limited time.
    virtual int openExisting(const std::string& path, int& file);
    /// Writes all bytes. A closed reader is an error, not a signal.
    virtual int write(int file, std::span<const char> bytes);
    virtual int writeAt(int file, std::uint64_t offset, std::span<const char> bytes);
    /// Reads as many bytes as the buffer holds; fewer are an error.
    virtual int readAt(int file, std::uint64_t offset, std::span<char> bytes);
    /// Returns when the bytes are on the medium.
    virtual int flush(int file);
    virtual int close(int file);
    virtual int rename(const std::string& from, const std::string& to);
    /// Gives a file a second name that must not be there yet.
    virtual int link(const std::string& file, const std::string& secondName);
    virtual int remove(const std::string& path);
    /// Makes the names in a folder survive a power failure; without a result, since not every file system can.
    virtual void flushFolder(const std::string& path);
};

/// The system's own operations.
[[nodiscard]] FileOperations& systemFileOperations();

} // namespace detail
FBXSDK_NAMESPACE_END
