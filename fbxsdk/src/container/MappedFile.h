// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A file as read-only memory.
#pragma once

#include <memory>
#include <span>
#include <string>

#include <fbxsdk/FbxArch.h>
#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The bytes of a file for as long as the object lives. Whoever shortens the file meanwhile takes the pages away: the
/// usual contract of mapped files.
class MappedFile {
public:
    MappedFile(const MappedFile&) = delete;
    MappedFile& operator=(const MappedFile&) = delete;
    ~MappedFile();

    /// Null when the file cannot be opened, is no regular file, or is empty; the status then says which.
    [[nodiscard]] static std::shared_ptr<const MappedFile> open(const std::string& fileName, FbxStatus& status);

    [[nodiscard]] std::span<const char> bytes() const { return mBytes; }

    /// Whether the bytes are some of these.
    [[nodiscard]] bool contains(std::span<const char> bytes) const;
    /// These bytes are done with for now: the pages that lie wholly within them give their memory back, and come again
    /// from the file for whoever reads them after all. Bytes outside of the file are left alone.
    void release(std::span<const char> bytes) const;

private:
    MappedFile() = default;

    std::span<const char> mBytes;
};

} // namespace detail
FBXSDK_NAMESPACE_END
