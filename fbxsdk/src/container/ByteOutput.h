// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The output of sinks: a growing sequence of bytes of which a written part may be changed once more.
#pragma once

#include <cassert>
#include <cstdint>
#include <cstring>
#include <span>
#include <string>
#include <utility>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// After a fault everything is ignored, so that callers need to check only occasionally, and at the end.
class ByteOutput {
public:
    ByteOutput() = default;
    ByteOutput(const ByteOutput&) = delete;
    ByteOutput& operator=(const ByteOutput&) = delete;
    virtual ~ByteOutput() = default;

    virtual void write(std::span<const char> bytes) = 0;
    /// Replaces bytes that were written before. The range must lie within them.
    virtual void overwrite(std::uint64_t offset, std::span<const char> bytes) = 0;
    /// Bytes written so far.
    [[nodiscard]] virtual std::uint64_t size() const = 0;
    [[nodiscard]] virtual bool failed() const = 0;
};

/// Bytes in memory.
class MemoryOutput final : public ByteOutput {
public:
    void write(std::span<const char> bytes) override { mBytes.append(bytes.data(), bytes.size()); }
    void overwrite(std::uint64_t offset, std::span<const char> bytes) override {
        assert(offset + bytes.size() <= mBytes.size());
        std::memcpy(mBytes.data() + offset, bytes.data(), bytes.size());
    }
    [[nodiscard]] std::uint64_t size() const override { return mBytes.size(); }
    [[nodiscard]] bool failed() const override { return false; }

    [[nodiscard]] const std::string& bytes() const { return mBytes; }
    /// Empties it.
    [[nodiscard]] std::string takeBytes() { return std::exchange(mBytes, {}); }

private:
    std::string mBytes;
};

} // namespace detail
FBXSDK_NAMESPACE_END
