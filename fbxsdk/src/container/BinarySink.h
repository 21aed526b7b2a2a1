// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <deque>
#include <string>
#include <vector>

#include "container/FileId.h"
#include "container/OutputWindow.h"
#include "container/PendingArrays.h"
#include "container/RecordSink.h"
#include "container/ZlibStream.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The largest file with 32-bit record heads: many readers treat their offsets as signed.
inline constexpr std::uint64_t kMaxNarrowFileSize = 0x7FFFFFFF;

/// Records as binary files hold them.
class BinarySink final : public RecordSink {
public:
    /// Writes the file's header. Record heads are 64 bits wide from version 7500 on; below, a file that exceeds
    /// `maxNarrowSize` is a fault.
    BinarySink(ByteOutput& output, std::uint32_t version, std::uint64_t maxNarrowSize = kMaxNarrowFileSize);

    [[nodiscard]] bool isBinary() const override { return true; }
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
    void raw(std::span<const char> bytes) override;
    void objectName(std::string_view className, std::string_view name) override;

    void array(std::span<const double> values) override;
    void array(std::span<const float> values) override;
    void array(std::span<const std::int32_t> values) override;
    void array(std::span<const std::int64_t> values) override;
    void array(std::span<const std::uint8_t> values) override;
    void array(std::vector<double>&& values) override;
    void array(std::vector<std::int32_t>&& values) override;
    void floatBits(std::span<const std::uint32_t> words) override;

    [[nodiscard]] EncodedRecords encoded(const Part& part) const override;
    void repeat(const EncodedRecords& records) override;

    [[nodiscard]] bool failed() const override { return !mFault.empty() || mWindow.failed(); }
    /// What cannot be written in this version; empty when nothing but perhaps the output failed.
    [[nodiscard]] const std::string& fault() const { return mFault; }

    /// Bytes of the file up to the first array that another thread encodes.
    [[nodiscard]] std::uint64_t size() const { return mWindow.size(); }

    /// Ends the last list of records and writes the footer. All records must be ended.
    void finish(const CreationTime& time);

private:
    /// For records that will be inserted into the file of another sink.
    BinarySink(ByteOutput& output, const BinarySink& whole);

    struct OpenRecord {
        std::uint64_t valueCount = 0;
        bool hasBlock = false;
    };
    /// Where an open record is in the file, known once all arrays before it are encoded.
    struct RecordPlace {
        std::uint64_t start;
        std::uint64_t valuesStart;
        std::uint64_t valuesEnd = 0; ///< 0 until the block begins
    };

    [[nodiscard]] std::size_t headSize() const;
    void setFault(const std::string& fault);
    void checkSize(std::uint64_t size);
    [[nodiscard]] std::uint64_t place();
    [[nodiscard]] char* extend(std::size_t count);
    void write(std::span<const char> bytes);
    void mark(RecordMark::Kind kind, std::uint64_t place, std::uint64_t count = 0);
    void apply(const RecordMark& mark, std::uint64_t base);
    void patchHead(const RecordPlace& record, std::uint64_t end, std::uint64_t valueCount);
    void settleFirst();
    void settleAll();
    void moveHead(char* head, std::uint64_t distance) const;
    std::size_t storeOffset(char* bytes, std::uint64_t offset) const;
    void writeZeros(std::size_t count);
    template <class Number>
    void scalar(char code, Number value);
    void sizedBytes(char code, std::string_view first, std::string_view second = {}, std::string_view third = {});
    template <class Number>
    void arrayOf(char arrayCode, char scalarCode, std::span<const Number> values);
    template <class Number>
    void packedArray(char code, std::span<const Number> values);
    template <class Number>
    void ownedArray(char arrayCode, char scalarCode, std::vector<Number> values);
    [[nodiscard]] bool isPassedOn(std::size_t bytes);
    template <class Number>
    [[nodiscard]] bool beginPackedArray(std::span<const Number> values);
    template <class Number>
    void writeArray(char code, std::span<const Number> values);
    template <class Number>
    void passArray(char code, std::vector<Number> values);
    template <class Number>
    void scalarList(char code, std::span<const Number> values);

    OutputWindow mWindow;
    std::uint32_t mVersion;
    bool mWide;
    std::uint64_t mMaxSize;
    std::string mFault;
    std::vector<OpenRecord> mOpen;
    std::vector<RecordPlace> mPlaces; ///< of the open records that begin before the first pending array
    bool mIsFragment = false;
    std::vector<std::uint64_t> mHeads;  ///< of a fragment: where its records begin
    std::deque<Deflater> mDeflaters{1}; ///< one for each thread
    PendingArrays mPending;             ///< the last member: its threads use the deflaters
};

} // namespace detail
FBXSDK_NAMESPACE_END
