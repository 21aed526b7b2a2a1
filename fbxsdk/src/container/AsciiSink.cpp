// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// ASCII files: a record per line, a tab per level, and a block in braces.
#include "container/AsciiSink.h"

#include <algorithm>
#include <bit>
#include <cassert>
#include <charconv>
#include <cmath>
#include <type_traits>

#include "container/FileFormat.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Bytes that are passed on at a time.
constexpr std::size_t kFlushBytes = std::size_t{1} << 16;
/// Text after arrays that other threads write is in memory, up to this size.
constexpr std::size_t kMostTextAfter = std::size_t{1} << 20;
/// Shorter arrays are written faster than they are passed to another thread …
constexpr std::size_t kFewestPending = 256;
/// … and longer ones are passed in pieces.
constexpr std::size_t kPieceElements = 4096;
/// Lines of arrays are broken behind the first comma beyond this length …
constexpr std::size_t kArrayLine = 2000;
/// … and lists of single values, in the older layout, before the first one beyond this.
constexpr std::size_t kListLine = 115;
constexpr std::string_view kListContinuation = "\n             ";

void appendBase64(std::string& text, std::span<const char> bytes) {
    constexpr std::string_view kDigits = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    for (std::size_t i = 0; i < bytes.size(); i += 3) {
        const std::size_t count = std::min<std::size_t>(3, bytes.size() - i);
        std::uint32_t bits = 0;
        for (std::size_t j = 0; j < 3; ++j)
            bits = bits << 8U | (j < count ? static_cast<unsigned char>(bytes[i + j]) : 0U);
        for (std::size_t j = 0; j < 4; ++j)
            text += j <= count ? kDigits[bits >> (18U - 6U * j) & 63U] : '=';
    }
}

/// Longer than any number as text.
constexpr std::size_t kMostDigits = 32;

template <class Number>
char* printNumber(char* place, Number value) {
    if constexpr (std::is_floating_point_v<Number>) {
        if (!std::isfinite(value))
            value = 0;
    }
    return std::to_chars(place, place + kMostDigits, value).ptr;
}

/// Elements separated by commas. A comma behind the last one, too, when others follow.
template <class Number>
void printElements(std::string& text, std::span<const Number> values, bool othersFollow) {
    text.resize(values.size() * (kMostDigits + 1));
    char* end = text.data();
    for (const Number value : values) {
        end = printNumber(end, value);
        *end++ = ',';
    }
    if (!othersFollow)
        --end;
    text.resize(static_cast<std::size_t>(end - text.data()));
}

/// Appends elements, and breaks the line behind the first comma beyond the length of one. `line` is the length of the
/// last one.
void appendLines(std::string& text, std::string_view elements, std::size_t& line) {
    while (!elements.empty()) {
        const std::size_t comma = elements.find(',', line < kArrayLine ? kArrayLine - line : 0);
        const std::size_t length = comma == std::string_view::npos ? elements.size() : comma + 1;
        text += elements.substr(0, length);
        line += length;
        elements.remove_prefix(length);
        if (comma != std::string_view::npos) {
            text += '\n';
            line = 0;
        }
    }
}

/// Calls with each piece of an array, and whether others follow.
template <class Number, class Use>
void eachPiece(std::span<const Number> values, const Use& use) {
    while (!values.empty()) {
        const std::size_t size = std::min(values.size(), kPieceElements);
        use(values.first(size), size < values.size());
        values = values.subspan(size);
    }
}

} // namespace

AsciiSink::AsciiSink(ByteOutput& output, std::uint32_t version) : mOutput(output), mVersion(version) {
    mText.reserve(2 * kFlushBytes);
    const std::uint32_t digits[] = {version / 1000, version / 100 % 10, version / 10 % 10};
    mText = "; FBX ";
    for (const std::uint32_t digit : digits)
        mText += std::to_string(digit) + '.';
    mText.back() = ' ';
    mText += "project file\n; ----------------------------------------------------\n\n";
    mLineStart = mText.size();
}

AsciiSink::AsciiSink(ByteOutput& output, const AsciiSink& whole)
    : mOutput(output), mVersion(whole.mVersion), mOpen(whole.mOpen) {}

void AsciiSink::indent() { mText.append(mOpen.size(), '\t'); }

void AsciiSink::endLine() {
    mText += '\n';
    mLineStart = mText.size();
    flushWhenLong();
}

void AsciiSink::flushWhenLong() {
    if (mText.size() >= kFlushBytes)
        flush();
}

void AsciiSink::flush() {
    while (mPending.isFirstDue() || (!mPending.isEmpty() && mPending.last().after.size() > kMostTextAfter))
        settleFirst();
    if (mPending.isEmpty())
        mOutput.write(mText);
    else
        mPending.last().after += mText;
    mText.clear();
    mLineStart = 0;
}

/// Writes the first pending piece of an array and what follows it.
void AsciiSink::settleFirst() {
    const PendingArray first = mPending.takeFirst();
    mLines.clear();
    appendLines(mLines, first.bytes, mPendingLine);
    mOutput.write(mLines);
    mOutput.write(first.after);
    if (!first.bytes.ends_with(',')) // the end of the array
        mPendingLine = 0;
}

void AsciiSink::beginRecord(std::string_view name) {
    assert(mOpen.empty() || mOpen.back().hasBlock);
    indent();
    mText += name;
    mText += ": ";
    mOpen.emplace_back();
}

void AsciiSink::beginBlock() {
    assert(!mOpen.empty() && !mOpen.back().hasBlock);
    mOpen.back().hasBlock = true;
    mText += " {";
    endLine();
}

void AsciiSink::endRecord() {
    assert(!mOpen.empty());
    const bool hasBlock = mOpen.back().hasBlock;
    mOpen.pop_back();
    if (hasBlock) {
        indent();
        mText += '}';
    }
    endLine();
}

void AsciiSink::separate(bool beforeText) {
    assert(!mOpen.empty() && !mOpen.back().hasBlock);
    if (mOpen.back().valueCount++ == 0)
        return;
    if (mVersion < kFirstVersionWithArrays && mText.size() - mLineStart > kListLine) {
        flushWhenLong();
        mLineStart = mText.size() + 1;
        mText += kListContinuation;
    }
    mText += ',';
    if (beforeText)
        mText += ' ';
}

template <class Number>
void AsciiSink::number(Number value) {
    separate(/*beforeText*/ false);
    char digits[kMostDigits];
    mText.append(digits, printNumber(digits, value));
}

void AsciiSink::byte(std::uint8_t value) { number(int{value}); }
void AsciiSink::shortInteger(std::int16_t value) { number(value); }
void AsciiSink::integer(std::int32_t value) { number(value); }
void AsciiSink::longInteger(std::int64_t value) { number(value); }
void AsciiSink::singleReal(float value) { number(value); }
void AsciiSink::real(double value) { number(value); }

void AsciiSink::letter(char value) {
    separate(/*beforeText*/ false);
    mText += value;
}

void AsciiSink::appendEscaped(std::string_view text) {
    for (const char c : text) {
        const auto* const row = std::find_if(std::begin(kEntities), std::end(kEntities),
                                             [c](const auto& each) { return each.character == c; });
        if (row != std::end(kEntities))
            mText += row->spelling;
        else
            mText += c;
    }
}

void AsciiSink::text(std::string_view value) {
    separate(/*beforeText*/ true);
    mText += '"';
    appendEscaped(value);
    mText += '"';
}

void AsciiSink::raw(std::span<const char> bytes) {
    // Bytes are on a line of their own, behind a comma that separates nothing.
    separate(/*beforeText*/ false);
    mText += ",\n \"";
    appendBase64(mText, bytes);
    mText += '"';
}

void AsciiSink::objectName(std::string_view className, std::string_view name) {
    separate(/*beforeText*/ true);
    mText += '"';
    mText += className;
    mText += kAsciiNameSeparator;
    appendEscaped(name);
    mText += '"';
}

template <class Number>
void AsciiSink::arrayOf(std::span<const Number> values) {
    if (mVersion < kFirstVersionWithArrays) {
        for (const Number value : values)
            number(value);
        return;
    }
    separate(/*beforeText*/ false);
    mText += '*' + std::to_string(values.size()) + " {\n";
    indent();
    mText += "a: ";
    if (values.size() < kFewestPending || !mPending.hasThreads())
        writeElements(values);
    else
        passElements(values);
    mText += '\n';
    mText.append(mOpen.size() - 1, '\t');
    mText += "} ";
}

template <class Number>
void AsciiSink::writeElements(std::span<const Number> values) {
    std::size_t line = 0;
    eachPiece(values, [&](std::span<const Number> piece, bool othersFollow) {
        printElements(mElements, piece, othersFollow);
        appendLines(mText, mElements, line);
        flushWhenLong();
    });
}

/// To other threads.
template <class Number>
void AsciiSink::passElements(std::span<const Number> values) {
    eachPiece(
        values,
        [&](std::span<const Number> piece, bool othersFollow) {
            flush();
            mPending.add(
                piece.size() * kMostDigits,
                [copy = std::vector<Number>(piece.begin(), piece.end()), othersFollow](std::size_t) {
                    std::string text;
                    printElements(text, std::span<const Number>(copy), othersFollow);
                    return text;
                });
        });
}

void AsciiSink::array(std::span<const double> values) { arrayOf(values); }
void AsciiSink::array(std::span<const float> values) { arrayOf(values); }
void AsciiSink::array(std::span<const std::int32_t> values) { arrayOf(values); }
void AsciiSink::array(std::span<const std::int64_t> values) { arrayOf(values); }

void AsciiSink::array(std::span<const std::uint8_t> values) {
    arrayOf(std::span<const std::int32_t>(std::vector<std::int32_t>(values.begin(), values.end())));
}

void AsciiSink::floatBits(std::span<const std::uint32_t> words) {
    if (mVersion >= kFirstVersionWithBitPatterns) {
        std::vector<std::int32_t> numbers(words.size());
        std::transform(words.begin(), words.end(), numbers.begin(),
                       [](auto word) { return std::bit_cast<std::int32_t>(word); });
        array(numbers);
        return;
    }
    std::vector<float> numbers(words.size());
    std::transform(words.begin(), words.end(), numbers.begin(), [](auto word) { return std::bit_cast<float>(word); });
    array(numbers);
}

RecordSink::EncodedRecords AsciiSink::encoded(const Part& part) const {
    MemoryOutput output;
    AsciiSink fragment(output, *this);
    part(fragment);
    output.write(fragment.mText);
    return {output.takeBytes(), {}};
}

void AsciiSink::repeat(const EncodedRecords& records) {
    mText += records.bytes;
    mLineStart = mText.size();
    flushWhenLong();
}

void AsciiSink::heading(std::string_view title) {
    assert(mOpen.empty());
    mText += "\n; ";
    mText += title;
    mText += "\n;------------------------------------------------------------------\n";
    endLine();
}

void AsciiSink::finish() {
    assert(mOpen.empty());
    flush();
    while (!mPending.isEmpty())
        settleFirst();
}

} // namespace detail
FBXSDK_NAMESPACE_END
