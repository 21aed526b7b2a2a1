// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The output of writers. A writer states what a record holds; the sink encodes it for a container. Both sinks,
// binary and ASCII, write the same tree, so that a reader does not depend on which one it was.
#pragma once

#include <cstdint>
#include <functional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A record is begun, gets its values, then perhaps a block of further records, and is ended:
///
///     sink.beginRecord("Layer"); sink.integer(0); sink.beginBlock(); …records…; sink.endRecord();
///
/// Nothing is reported in between: the first fault is kept, what follows it is ignored, and finish() returns it.
class RecordSink {
public:
    RecordSink() = default;
    RecordSink(const RecordSink&) = delete;
    RecordSink& operator=(const RecordSink&) = delete;
    virtual ~RecordSink() = default;

    [[nodiscard]] virtual bool isBinary() const = 0;

    virtual void beginRecord(std::string_view name) = 0;
    /// Opens the record's block; it is written even when nothing is put into it. At most once per record.
    virtual void beginBlock() = 0;
    virtual void endRecord() = 0;

    virtual void byte(std::uint8_t value) = 0;
    virtual void shortInteger(std::int16_t value) = 0;
    virtual void integer(std::int32_t value) = 0;
    virtual void longInteger(std::int64_t value) = 0;
    virtual void singleReal(float value) = 0;
    virtual void real(double value) = 0;
    /// A one-letter code, as in `Shading: T`.
    virtual void letter(char value) = 0;
    virtual void text(std::string_view value) = 0;
    /// Bytes that are not text.
    virtual void raw(std::span<const char> bytes) = 0;
    /// The name of an object together with the class before it: `Model::cube`.
    virtual void objectName(std::string_view className, std::string_view name) = 0;

    virtual void array(std::span<const double> values) = 0;
    virtual void array(std::span<const float> values) = 0;
    virtual void array(std::span<const std::int32_t> values) = 0;
    virtual void array(std::span<const std::int64_t> values) = 0;
    /// Booleans; each element is 0 or 1.
    virtual void array(std::span<const std::uint8_t> values) = 0;
    /// The same for a sink that may go on using the elements.
    virtual void array(std::vector<double>&& values) { array(std::span<const double>(values)); }
    virtual void array(std::vector<std::int32_t>&& values) { array(std::span<const std::int32_t>(values)); }
    /// 32-bit words that files store as the bits of floats: the packed data of keys.
    virtual void floatBits(std::span<const std::uint32_t> words) = 0;

    /// Writes whole records, one after the other.
    using Part = std::function<void(RecordSink& sink)>;
    /// Short records, less than 64 KiB in all, as the sink writes them, to be written many times.
    struct EncodedRecords {
        std::string bytes;
        std::vector<std::uint32_t> places; ///< of records in the bytes, where their position matters
    };
    /// The records that the part writes, encoded for the sink's current level. The part succeeds.
    [[nodiscard]] virtual EncodedRecords encoded(const Part& part) const = 0;
    /// Writes them at the level that they were encoded for.
    virtual void repeat(const EncodedRecords& records) = 0;

    /// A heading between top-level records, for human readers.
    virtual void heading(std::string_view) {}

    /// Whether a fault has occurred. Long loops check it, to stop early.
    [[nodiscard]] virtual bool failed() const = 0;
};

} // namespace detail
FBXSDK_NAMESPACE_END
