// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// ASCII files:
//
//     file   := { record }
//     record := name ':' [ value { ',' value } ] [ '{' { record } '}' ]
//     value  := text | number | word | '*' count '{' 'a' ':' number { ',' number } '}'
//
// Blanks, line ends and comments (from ';' to the end of the line) may occur between any two tokens, and surplus commas
// are ignored. So the values of a record end where a token follows that is a brace or has a colon behind it.
#include "container/AsciiReader.h"

#include <algorithm>
#include <limits>
#include <string>
#include <string_view>
#include <vector>

#include "container/AsciiPreamble.h"
#include "container/FileFormat.h"
#include "container/LineCounter.h"
#include "container/NumberRun.h"
#include "container/NumberText.h"
#include "container/ReadLimits.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

/// Larger than any valid count: represents a count beyond all whole numbers.
constexpr std::int64_t kMostNumbers = std::numeric_limits<std::int64_t>::max();

std::string decodeEntities(std::string_view text) {
    std::string decoded;
    decoded.reserve(text.size());
    while (!text.empty()) {
        const auto* const entity = std::find_if(std::begin(kEntities), std::end(kEntities),
                                                [&](const Entity& row) { return text.starts_with(row.spelling); });
        if (entity != std::end(kEntities)) {
            decoded += entity->character;
            text.remove_prefix(entity->spelling.size());
        } else {
            // The next entity starts at an ampersand, if there is one.
            const std::size_t plain = std::min(text.find('&', 1), text.size());
            decoded += text.substr(0, plain);
            text.remove_prefix(plain);
        }
    }
    return decoded;
}

/// Where the text ends: disks and tools fill the rest of a block with zeros.
const char* endOfText(std::span<const char> bytes) {
    const char* end = bytes.data() + bytes.size();
    while (end != bytes.data() && end[-1] == '\0')
        --end;
    return end;
}

/// A record whose block is being read.
struct OpenBlock {
    Record* record = nullptr;
    Record* lastChild = nullptr;
};

class AsciiReader {
public:
    AsciiReader(std::span<const char> bytes, RecordTree& tree, FbxStatus& status)
        : mStart(bytes.data()), mEnd(endOfText(bytes)), mNext(mStart), mTree(tree), mStatus(status) {
        mTree.source = {mStart, mEnd};
    }

    bool read() { return readVersion() && readRecords(); }

private:
    [[gnu::cold]] bool fail(const char* place, const std::string& what,
                            FbxStatus::EStatusCode code = FbxStatus::eInvalidFile) {
        mStatus.SetCode(code, "%s: line %s: %s", mTree.fileName.c_str(), lineOf(place).c_str(), what.c_str());
        return false;
    }
    [[gnu::cold]] bool failUnexpected(const char* place, const std::string& expected);
    bool refuseZeros(std::string_view token);

    [[nodiscard]] std::string lineOf(const char* place) const {
        return std::to_string(LineCounter(mTree.source).lineAt(static_cast<std::size_t>(place - mStart)));
    }

    [[nodiscard]] bool nextIs(char c) const { return mNext != mEnd && *mNext == c; }
    [[nodiscard]] const char* itemEnd() const;
    [[nodiscard]] const char* nameColon(const char* end) const;
    std::string_view readToken();
    bool readQuoted(const char* end, std::string_view& text);
    bool readName(std::string_view& name);

    bool readVersion();
    bool readRecords();
    bool readRecord();
    bool openBlock(Record& record);
    Record& appendRecord(std::string_view name);
    void noteVersion(const Record& record);

    bool readValues(Record& record);
    [[nodiscard]] bool isListed(const char* token) const;
    bool readNumberList(Record& record);
    bool readValue(const Record& record, const char* end, Value& value);
    bool readBareValue(const char* end, Value& value);
    bool readArray(const Record& record, Value& value);
    StoredArray& keepArray(const char* start, const NumberRun& run);
    void keepValues(Record& record);

    const char* mStart;
    const char* mEnd;
    const char* mNext;
    RecordTree& mTree;
    FbxStatus& mStatus;
    std::uint32_t mArrayVersion = 0; ///< the interpretation of arrays
    std::vector<OpenBlock> mOpen;
    std::vector<Value> mValues; ///< of the current record
};

bool AsciiReader::failUnexpected(const char* place, const std::string& expected) {
    if (place == mEnd)
        return fail(place, "the file ends where " + expected + " is expected");
    constexpr std::ptrdiff_t kShown = 40;
    const char* const end = std::max(tokenEnd(place, mEnd), place + 1);
    const std::string token(place, std::min(end, place + kShown));
    return fail(place, "expected " + expected + " instead of '" + token + "'");
}

/// A zero byte within a name or word comes from a damaged disk or copy; the original content is lost. False when there
/// is one.
bool AsciiReader::refuseZeros(std::string_view token) {
    const std::size_t zero = token.find('\0');
    return zero == std::string_view::npos || fail(token.data() + zero, "unexpected zero byte");
}

/// The end of the quoted text or the token that comes next; null for a text without a closing quote.
const char* AsciiReader::itemEnd() const {
    if (!nextIs('"'))
        return tokenEnd(mNext, mEnd);
    const char* const quote = findByte(mNext + 1, mEnd, '"');
    return quote != mEnd ? quote + 1 : nullptr;
}

/// The colon behind what comes next and ends there: a record starts, where a value could follow otherwise. Null when
/// there is none.
const char* AsciiReader::nameColon(const char* end) const {
    if (end == nullptr || end == mNext)
        return nullptr;
    const char* const colon = skipBlanks(end, mEnd);
    return colon != mEnd && *colon == ':' ? colon : nullptr;
}

std::string_view AsciiReader::readToken() {
    const char* const start = mNext;
    mNext = tokenEnd(start, mEnd);
    return {start, static_cast<std::size_t>(mNext - start)};
}

/// The text that ends there, behind its closing quote.
bool AsciiReader::readQuoted(const char* end, std::string_view& text) {
    if (end == nullptr)
        return fail(mNext, "a string has no closing quote");
    text = {mNext + 1, end - 1};
    if (text.find('&') != std::string_view::npos)
        text = mTree.keepText(decodeEntities(text));
    mNext = end;
    return true;
}

bool AsciiReader::readVersion() {
    const AsciiPreamble preamble = readPreamble({mStart, mEnd});
    mNext = preamble.end;
    mTree.version = mArrayVersion = preamble.version;
    if (preamble.version != 0 && !isSupportedVersion(preamble.version)) {
        return fail(preamble.versionComment, "unsupported version " + std::to_string(preamble.version),
                    FbxStatus::eInvalidFileVersion);
    }
    return true;
}

bool AsciiReader::readRecords() {
    mOpen.push_back({&mTree.root, nullptr});
    while (true) {
        mNext = skipSeparators(mNext, mEnd);
        if (mNext == mEnd) {
            const Record& open = *mOpen.back().record;
            return mOpen.size() == 1 || fail(mEnd, "the file ends within the block of '" + std::string(open.name) +
                                                       "' that starts in line " + lineOf(mStart + open.location));
        }
        if (nextIs('}') && mOpen.size() > 1) {
            mOpen.pop_back();
            ++mNext;
        } else if (!readRecord()) {
            return false;
        }
    }
}

Record& AsciiReader::appendRecord(std::string_view name) {
    OpenBlock& block = mOpen.back();
    Record& record = mTree.newRecord(name);
    (block.lastChild != nullptr ? block.lastChild->nextSibling : block.record->firstChild) = &record;
    block.lastChild = &record;
    return record;
}

bool AsciiReader::readRecord() {
    const char* const start = mNext;
    std::string_view name;
    if (!readName(name))
        return false;
    Record& record = appendRecord(name);
    record.location = static_cast<std::uint64_t>(start - mStart);
    if (!readValues(record))
        return false;
    noteVersion(record);
    mNext = skipBlanks(mNext, mEnd);
    return !nextIs('{') || openBlock(record);
}

/// With its colon.
bool AsciiReader::readName(std::string_view& name) {
    const char* const end = itemEnd();
    const bool quoted = nextIs('"');
    if (!quoted && !refuseZeros({mNext, end}))
        return false;
    const char* const colon = nameColon(end);
    if (colon == nullptr)
        return failUnexpected(mNext, "a name with a colon");
    if (!quoted)
        name = {mNext, end};
    else if (!readQuoted(end, name))
        return false;
    mNext = colon + 1;
    return true;
}

bool AsciiReader::openBlock(Record& record) {
    if (mOpen.size() > kMaxDepth)
        return fail(mNext, "records are nested deeper than " + std::to_string(kMaxDepth) + " levels");
    record.hasBlock = true;
    mOpen.push_back({&record, nullptr});
    ++mNext;
    return true;
}

/// The tree's version stays that of the comment; the interpretation of arrays must be known before the document is.
void AsciiReader::noteVersion(const Record& record) {
    if (mTree.version == 0 && record.name == "FBXVersion" && mOpen.back().record->name == "FBXHeaderExtension") {
        mArrayVersion =
            static_cast<std::uint32_t>(std::clamp<std::int64_t>(record.value(0).toInteger(), 0, kFirstUnknownVersion));
    }
}

bool AsciiReader::readValues(Record& record) {
    mNext = skipSeparators(mNext, mEnd);
    if (readNumberList(record))
        return true;
    mValues.clear();
    while (mNext != mEnd && !nextIs('{') && !nextIs('}')) {
        const char* const end = itemEnd();
        if (nameColon(end) != nullptr)
            break;
        Value value;
        if (!readValue(record, end, value))
            return false;
        mValues.push_back(value);
        mNext = skipBlanks(mNext, mEnd);
        if (!nextIs(','))
            break;
        mNext = skipSeparators(mNext, mEnd);
    }
    keepValues(record);
    return true;
}

/// Whether a comma follows the token: most records without a text have one value.
bool AsciiReader::isListed(const char* token) const {
    const char* const next = skipBlanks(tokenEnd(token, mEnd), mEnd);
    return next != mEnd && *next == ',';
}

/// Takes the values as one array if they are many and all numbers. Otherwise leaves them to be read singly.
bool AsciiReader::readNumberList(Record& record) {
    const char* const start = mNext;
    if (start == mEnd || *start == '"' || *start == '*' || !isListed(start))
        return false;
    const NumberRun run = scanNumbers(start, mEnd, /*wordsCount*/ false);
    if (run.count < kShortestList)
        return false;
    mNext = run.next;
    if (run.afterComma && mNext != mEnd && !nextIs('{') && !nextIs('}') && nameColon(itemEnd()) == nullptr) {
        mNext = start;
        return false;
    }
    mValues.assign(1, Value::ofArray(keepArray(start, run)));
    keepValues(record);
    return true;
}

/// The value that ends there, unless it is an array.
bool AsciiReader::readValue(const Record& record, const char* end, Value& value) {
    if (nextIs('*'))
        return readArray(record, value);
    if (!nextIs('"'))
        return readBareValue(end, value);
    std::string_view text;
    if (!readQuoted(end, text))
        return false;
    value = Value::ofText(text);
    return true;
}

bool AsciiReader::readBareValue(const char* end, Value& value) {
    const char* const start = mNext;
    const std::string_view token(start, end);
    if (token.empty())
        return failUnexpected(start, "a value");
    mNext = end;
    if (const std::optional<std::int64_t> integer = parseInteger(token)) {
        value = Value::ofInteger(*integer);
        return true;
    }
    if (!refuseZeros(token))
        return false;
    if (const std::optional<double> real = parseReal(token)) {
        value = Value::ofReal(*real);
        return true;
    }
    if (chars::is(chars::digit, token.front()) || std::string_view("+-.").find(token.front()) != token.npos)
        return failUnexpected(start, "a number");
    // A word behind a text is a name that lost its quotes; its end cannot be determined.
    if (token.size() > 1 && !mValues.empty() && mValues.back().type == Value::Type::text)
        return failUnexpected(start, "a quoted string");
    value = Value::ofWord(token);
    return true;
}

/// The count behind the asterisk is not needed, and lists that are shorter are read as they are. A list that is longer
/// is inconsistent: with the decimal comma of some countries each number counts as two.
bool AsciiReader::readArray(const Record& record, Value& value) {
    ++mNext;
    const std::string_view count = readToken();
    mNext = skipBlanks(mNext, mEnd);
    if (count.empty() || skipDigits(count.data(), count.data() + count.size()) != count.data() + count.size() ||
        !nextIs('{'))
        return failUnexpected(mNext, "a count and '{'");
    mNext = skipBlanks(mNext + 1, mEnd);
    if (!nextIs('}')) {
        const char* const colon = nameColon(itemEnd());
        if (colon == nullptr || std::string_view(mNext, tokenEnd(mNext, mEnd)) != "a")
            return failUnexpected(mNext, "'a:'");
        mNext = skipSeparators(colon + 1, mEnd);
    }
    const char* const start = mNext;
    const NumberRun run = scanNumbers(start, mEnd, /*wordsCount*/ true);
    mNext = run.next;
    if (!nextIs('}'))
        return failUnexpected(mNext, "a number or '}'");
    ++mNext;
    if (const auto stated = static_cast<std::uint64_t>(parseInteger(count).value_or(kMostNumbers));
        run.count > stated) {
        return fail(start, "the list of '" + std::string(record.name) + "' holds " + std::to_string(run.count) +
                               " numbers, but its count is " + std::to_string(stated));
    }
    StoredArray& array = keepArray(start, run);
    array.bitPatterns = mArrayVersion >= kFirstVersionWithBitPatterns && record.name == "KeyAttrDataFloat";
    value = Value::ofArray(array);
    return true;
}

StoredArray& AsciiReader::keepArray(const char* start, const NumberRun& run) {
    StoredArray& array = mTree.newArray();
    array.element = StoredArray::Element::text;
    array.count = run.count;
    array.bytes = {start, run.numbersEnd};
    return array;
}

void AsciiReader::keepValues(Record& record) {
    const std::span<Value> values = mTree.newValues(mValues.size());
    std::copy(mValues.begin(), mValues.end(), values.begin());
    record.values = values;
}

} // namespace

bool readAscii(std::span<const char> bytes, RecordTree& tree, FbxStatus& status) {
    return AsciiReader(bytes, tree, status).read();
}

} // namespace detail
FBXSDK_NAMESPACE_END
