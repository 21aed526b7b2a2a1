// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The end of an output in memory: records are small, and an output is written to in large pieces.
#pragma once

#include <algorithm>
#include <cassert>
#include <cstring>
#include <memory>
#include <span>

#include "container/ByteOutput.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Nothing else may write to the output while it has a window. What is in the window is lost unless it is flushed.
class OutputWindow {
public:
    explicit OutputWindow(ByteOutput& output)
        : mOutput(output), mStart(output.size()), mBytes(std::make_unique_for_overwrite<char[]>(kBytes)) {}

    /// Bytes of the output, those in the window included.
    [[nodiscard]] std::uint64_t size() const { return mStart + mUsed; }
    [[nodiscard]] bool failed() const { return mOutput.failed(); }

    /// Appends that many bytes, fewer than `kBytes`, for the caller to fill before the next call.
    [[nodiscard]] char* extend(std::size_t count) {
        if (count > kBytes - mUsed)
            flush();
        char* const place = mBytes.get() + mUsed;
        mUsed += count;
        return place;
    }

    void write(std::span<const char> bytes) {
        if (bytes.size() < kBytes)
            std::copy(bytes.begin(), bytes.end(), extend(bytes.size()));
        else
            writeLong(bytes);
    }

    void overwrite(std::uint64_t offset, std::span<const char> bytes) {
        assert(offset + bytes.size() <= size());
        if (offset >= mStart)
            std::memcpy(mBytes.get() + (offset - mStart), bytes.data(), bytes.size());
        else
            overwriteBefore(offset, bytes);
    }

    void flush() {
        mOutput.write({mBytes.get(), mUsed});
        mStart += mUsed;
        mUsed = 0;
    }

    static constexpr std::size_t kBytes = std::size_t{1} << 16;

private:
    void writeLong(std::span<const char> bytes) {
        flush();
        mOutput.write(bytes);
        mStart += bytes.size();
    }

    void overwriteBefore(std::uint64_t offset, std::span<const char> bytes) {
        const auto before = static_cast<std::size_t>(std::min<std::uint64_t>(mStart - offset, bytes.size()));
        mOutput.overwrite(offset, bytes.first(before));
        std::memcpy(mBytes.get(), bytes.data() + before, bytes.size() - before);
    }

    ByteOutput& mOutput;
    std::uint64_t mStart; ///< of the window in the output
    std::unique_ptr<char[]> mBytes;
    std::size_t mUsed = 0;
};

} // namespace detail
FBXSDK_NAMESPACE_END
