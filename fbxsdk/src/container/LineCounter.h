// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <span>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The first such byte, or the end. Texts may be megabytes of encoded pictures.
[[nodiscard]] inline const char* findByte(const char* text, const char* end, char byte) {
    const void* const found = std::memchr(text, byte, static_cast<std::size_t>(end - text));
    return found != nullptr ? static_cast<const char*>(found) : end;
}

/// Line numbers, from 1 on. Continues from the last result where possible.
class LineCounter {
public:
    explicit LineCounter(std::span<const char> text) : mText(text) {}

    [[nodiscard]] std::uint64_t lineAt(std::size_t offset) {
        if (mEnd == '\0') {
            // A carriage return where a file has no line feed at all, as files of old Macintosh programs.
            const char* const end = mText.data() + mText.size();
            mEnd = findByte(mText.data(), end, '\n') != end ? '\n' : '\r';
        }
        if (offset < mOffset) {
            mOffset = 0;
            mLine = 1;
        }
        const char* const end = mText.data() + offset;
        // Lines are long where files are large, so that searching beats counting byte by byte.
        for (const char* text = mText.data() + mOffset; (text = findByte(text, end, mEnd)) != end; ++text)
            ++mLine;
        mOffset = offset;
        return mLine;
    }

private:
    std::span<const char> mText;
    char mEnd = '\0'; ///< of a line; 0 until the first call
    std::size_t mOffset = 0;
    std::uint64_t mLine = 1; ///< at the offset
};

} // namespace detail
FBXSDK_NAMESPACE_END
