// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Records as ASCII files hold them.
#pragma once

#include <string>
#include <vector>

#include "container/ByteOutput.h"
#include "container/PendingArrays.h"
#include "container/RecordSink.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The layout is the usual one including blanks: some readers parse by lines. Numbers are written in the shortest form
/// that reads back the same; NaN and infinity are written as 0, since hardly any reader accepts another spelling.
class AsciiSink final : public RecordSink {
public:
    /// Writes the comment that states the version.
    AsciiSink(ByteOutput& output, std::uint32_t version);

    [[nodiscard]] bool isBinary() const override { return false; }
    void beginRecord(std::string_view name) override;
    void beginBlock() override;
    void endRecord() override;

    void byte(std::uint8_t value) override;
    void shortInteger(std::int16_t value) override;
    void integer(std::int32_t value) override;
    void longInteger(std::int64_t value) override;
    void singleReal(float value) override;
    void real(double value) override;
    void letter(char value) override;
    void text(std::string_view value) override;
    /// As Base64.
    void raw(std::span<const char> bytes) override;
    void objectName(std::string_view className, std::string_view name) override;

    using RecordSink::array;
    void array(std::span<const double> values) override;
    void array(std::span<const float> values) override;
    void array(std::span<const std::int32_t> values) override;
    void array(std::span<const std::int64_t> values) override;
    void array(std::span<const std::uint8_t> values) override;
    void floatBits(std::span<const std::uint32_t> words) override;

    [[nodiscard]] EncodedRecords encoded(const Part& part) const override;
    void repeat(const EncodedRecords& records) override;
    void heading(std::string_view title) override;
    [[nodiscard]] bool failed() const override { return mOutput.failed(); }

    /// All records must be ended.
    void finish();

private:
    /// For records that will be inserted into the text of another sink.
    AsciiSink(ByteOutput& output, const AsciiSink& whole);

    struct OpenRecord {
        std::size_t valueCount = 0;
        bool hasBlock = false;
    };

    void indent();
    void endLine();
    void separate(bool beforeText);
    template <class Number>
    void number(Number value);
    void appendEscaped(std::string_view text);
    template <class Number>
    void arrayOf(std::span<const Number> values);
    template <class Number>
    void writeElements(std::span<const Number> values);
    template <class Number>
    void passElements(std::span<const Number> values);
    void flush();
    void flushWhenLong();
    void settleFirst();

    ByteOutput& mOutput;
    std::uint32_t mVersion;
    std::vector<OpenRecord> mOpen;
    std::string mText;          ///< not passed on yet, behind the pending arrays
    std::size_t mLineStart = 0; ///< of the line being written, within mText
    PendingArrays mPending;
    std::string mElements, mLines; ///< reused for each piece of an array
    std::size_t mPendingLine = 0;  ///< length of the last line of the pieces that are written
};

} // namespace detail
FBXSDK_NAMESPACE_END
