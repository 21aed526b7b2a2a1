// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Memory that goes back to the system page by page, before its owner is done with all of it.
#pragma once

#include <span>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Gives back the pages of a mapping that lie wholly within the bytes. Read again, they come from the file that is
/// mapped there, or as zeros where there is none.
void releasePages(std::span<const char> bytes);

/// Memory that will soon be filled as a whole takes large pages, where the system has some: most of the time of small
/// ones goes into getting them one by one.
void preferLargePages(std::span<char> bytes);

// Under the address sanitizer whoever looks at bytes that are not there yet is caught; elsewhere these do nothing.

/// Bytes that nobody may look at until they are said to be there.
void forbid(std::span<const char> bytes);
/// Bytes that are there.
void allow(std::span<const char> bytes);

/// Zeroed memory of its own pages.
class PageMemory {
public:
    /// Throws std::bad_alloc when there is not as much.
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
