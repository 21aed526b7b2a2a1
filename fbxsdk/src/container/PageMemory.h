// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Memory that is released page by page, before its owner is done with all of it.
#pragma once

#include <cstddef>
#include <span>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Size of a large page in bytes.
inline constexpr std::size_t kLargePage = std::size_t{1} << 21;

/// Releases the pages of a mapping that lie wholly within the bytes. Read again, they come from the file that is
/// mapped there, or as zeros where there is none.
void releasePages(std::span<const char> bytes);
/// The same for large pages: the system would have to split one that is released in part.
void releaseLargePages(std::span<const char> bytes);

/// Uses large pages for memory that will soon be filled completely, where the system has some: most of the time of
/// small ones is spent getting them one by one.
void preferLargePages(std::span<char> bytes);

// The address sanitizer reports accesses to bytes that are not read yet; without it these do nothing.

/// Marks bytes that must not be accessed yet.
void forbid(std::span<const char> bytes);
/// Marks bytes that may be accessed.
void allow(std::span<const char> bytes);

/// Zeroed memory in pages of its own.
class PageMemory {
public:
    /// Throws std::bad_alloc when the system has not enough.
    explicit PageMemory(std::size_t size);
    PageMemory(const PageMemory&) = delete;
    PageMemory& operator=(const PageMemory&) = delete;
    ~PageMemory();

    [[nodiscard]] std::span<char> bytes() const { return mBytes; }

private:
    std::span<char> mBytes;
};

} // namespace detail
FBXSDK_NAMESPACE_END
