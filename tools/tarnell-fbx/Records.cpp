// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx records: the records of a file, with the place of each.
#include <algorithm>
#include <memory>
#include <string_view>
#include <vector>

#include <fbxsdk/extensions/RecordFile.h>

#include "Commands.h"
#include "SceneFacts.h"
#include "SceneFile.h"
#include "ShowFiles.h"
#include "TerminalText.h"
#include "Utf8.h"

namespace tool {
namespace {

using extensions::FileRecord;
using extensions::RecordFile;
using extensions::RecordValue;

constexpr std::size_t kLongestText = 100; ///< columns of a text value on a text page

std::vector<std::string> pathParts(const std::string& path) {
    std::vector<std::string> parts;
    for (std::size_t start = 0; start < path.size();) {
        const std::size_t end = std::min(path.find('/', start), path.size());
        if (end > start)
            parts.push_back(path.substr(start, end - start));
        start = end + 1;
    }
    return parts;
}

int childCount(const FileRecord& record) {
    int count = 0;
    for (FileRecord child = record.firstChild(); child; child = child.nextSibling())
        ++count;
    return count;
}

/// The first numbers of a list as texts: whole ones without a point, those of floats as short as floats go.
std::vector<std::string> listNumbers(const FileRecord& record, const RecordValue& list, std::size_t count) {
    std::vector<std::string> texts;
    std::vector<double> reals(count);
    if (!record.readNumbers(reals.data(), count))
        return texts;
    std::vector<std::int64_t> integers(count);
    const bool isReal = list.element == RecordValue::eFloat32 || list.element == RecordValue::eFloat64;
    const bool hasIntegers = !isReal && record.readNumbers(integers.data(), count);
    for (std::size_t i = 0; i < count; ++i) {
        if (hasIntegers && static_cast<double>(integers[i]) == reals[i]) {
            texts.push_back(std::to_string(integers[i]));
        } else {
            texts.push_back(list.element == RecordValue::eFloat32 ? exactText(static_cast<float>(reals[i]))
                                                                  : exactText(reals[i]));
        }
    }
    return texts;
}

std::string hexadecimal(std::string_view bytes) {
    constexpr const char* kDigits = "0123456789abcdef";
    std::string text;
    for (const char byte : bytes) {
        text += kDigits[static_cast<unsigned char>(byte) >> 4U];
        text += kDigits[static_cast<unsigned char>(byte) & 0xFU];
    }
    return text;
}

// ---- One file ----

class RecordPage {
public:
    RecordPage(RecordFile& file, const RecordsOptions& options)
        : mFile(file), mOptions(options), mPath(pathParts(options.path)) {}

    /// Whether there is any record at the requested path.
    [[nodiscard]] bool any() const { return mPath.empty() || finds(mFile.first(), 0); }

    void printText(Page& page) {
        std::ostream& out = page.begin();
        mTerminal = &page.terminal();
        out << mTerminal->paint(Ink::heading, spoken(page.file())) << "  version " << mFile.version() << ", "
            << (mFile.isAscii() ? "ASCII, lines" : "binary, byte offsets")
            << (mFile.isBigEndian() ? ", big-endian" : "") << ", " << sizeText(mFile.size()) << '\n';
        mColumn = std::to_string(mFile.size()).size() + 2;
        printTexts(mFile.first(), 0, out);
    }

    void printJson(JsonWriter& json) {
        json.integer("version", mFile.version());
        json.text("encoding", mFile.isAscii() ? "ascii" : "binary");
        json.text("byteOrder", mFile.isBigEndian() ? "big" : "little");
        json.integer("bytes", static_cast<long long>(mFile.size()));
        json.key("records");
        json.beginArray();
        printObjects(mFile.first(), 0, json);
        json.endArray();
    }

private:
    /// Whether the record is an ancestor of the requested one, or below it.
    [[nodiscard]] bool isOnPath(const FileRecord& record, std::size_t level) const {
        return level >= mPath.size() || record.name() == mPath[level];
    }
    [[nodiscard]] bool isWanted(std::size_t level) const { return level + 1 >= mPath.size(); }
    [[nodiscard]] bool isFolded(std::size_t level) const {
        const std::size_t first = mPath.empty() ? 0 : mPath.size() - 1;
        return mOptions.depth > 0 && level >= first + static_cast<std::size_t>(mOptions.depth) - 1;
    }
    [[nodiscard]] bool finds(FileRecord record, std::size_t level) const {
        for (; record; record = record.nextSibling())
            if (isOnPath(record, level) && (isWanted(level) || finds(record.firstChild(), level + 1)))
                return true;
        return false;
    }
    [[nodiscard]] std::size_t shown(std::uint64_t count) const {
        const auto most = static_cast<std::uint64_t>(mOptions.values);
        return static_cast<std::size_t>(most == 0 ? count : std::min(count, most));
    }

    // Text output. The reader of the file limits the number of levels.

    void printTexts(FileRecord record, std::size_t level, std::ostream& out) {
        for (; record; record = record.nextSibling()) {
            if (!isOnPath(record, level))
                continue;
            const bool folded = isWanted(level) && isFolded(level);
            if (isWanted(level))
                printLine(record, level, folded, out);
            if (!folded)
                printTexts(record.firstChild(), level + 1, out);
        }
    }

    void printLine(const FileRecord& record, std::size_t level, bool folded, std::ostream& out) const {
        const std::string place = std::to_string(mFile.isAscii() ? mFile.lineOf(record) : record.location());
        const std::size_t depth = level + 1 - std::min(level + 1, std::max<std::size_t>(mPath.size(), 1));
        const std::string blanks(mColumn - std::min(mColumn, place.size()), ' ');
        out << blanks << mTerminal->paint(Ink::faint, place) << std::string(2 + depth * 2, ' ')
            << mTerminal->paint(Ink::name, terminalText(record.name()));
        for (std::size_t i = 0; i < record.valueCount(); ++i)
            out << "  " << valueText(record, record.value(i));
        const int below = folded ? childCount(record) : 0;
        if (below > 0)
            out << mTerminal->paint(Ink::faint, "  { … " + std::to_string(below) + " }");
        out << '\n';
    }

    [[nodiscard]] std::string valueText(const FileRecord& record, const RecordValue& value) const {
        const std::string code = value.code == 0 ? std::string() : std::string(1, value.code);
        const std::string head = code.empty() ? code : mTerminal->paint(Ink::faint, code) + ' ';
        switch (value.type) {
        case RecordValue::eInteger:
            return head + std::to_string(value.integer);
        case RecordValue::eReal:
            return head + (value.code == 'F' ? exactText(static_cast<float>(value.real)) : exactText(value.real));
        case RecordValue::eText:
            return head + '"' + fitted(terminalText(value.text), kLongestText) + '"';
        case RecordValue::eWord:
            return head + terminalText(value.text);
        case RecordValue::eBytes:
            return mTerminal->paint(Ink::faint, code + '[' + std::to_string(value.text.size()) + ']') + ' ' +
                   hexadecimal(value.text.substr(0, shown(value.text.size()))) +
                   (shown(value.text.size()) < value.text.size() ? " …" : "");
        case RecordValue::eList:
            break;
        }
        return mTerminal->paint(Ink::faint, code + '[' + std::to_string(value.count) + ']') + listText(record, value);
    }

    [[nodiscard]] std::string listText(const FileRecord& record, const RecordValue& value) const {
        const std::size_t count = shown(value.count);
        const std::vector<std::string> numbers = listNumbers(record, value, count);
        std::string text;
        for (const std::string& number : numbers)
            text += ' ' + number;
        if (numbers.size() < count)
            text += " damaged: the values cannot be read";
        else if (count < value.count)
            text += " …";
        if (value.compressed)
            text += mTerminal->paint(Ink::faint, "  (deflated, " + sizeText(value.storedBytes) + ")");
        return text;
    }

    // JSON output.

    void printObjects(FileRecord record, std::size_t level, JsonWriter& json) {
        for (; record; record = record.nextSibling()) {
            if (!isOnPath(record, level))
                continue;
            if (isWanted(level))
                printObject(record, level, json);
            else
                printObjects(record.firstChild(), level + 1, json);
        }
    }

    void printObject(const FileRecord& record, std::size_t level, JsonWriter& json) {
        json.beginObject();
        json.text("name", record.name());
        if (mFile.isAscii()) {
            json.integer("line", static_cast<long long>(mFile.lineOf(record)));
        } else {
            json.integer("offset", static_cast<long long>(record.location()));
            json.integer("end", static_cast<long long>(mFile.endOf(record)));
        }
        json.key("values");
        json.beginArray();
        for (std::size_t i = 0; i < record.valueCount(); ++i)
            printValue(record, record.value(i), json);
        json.endArray();
        json.key("records");
        if (!record.hasBlock()) {
            json.null();
        } else if (isFolded(level)) {
            json.integer(childCount(record));
        } else {
            json.beginArray();
            printObjects(record.firstChild(), level + 1, json);
            json.endArray();
        }
        json.endObject();
    }

    void printValue(const FileRecord& record, const RecordValue& value, JsonWriter& json) const {
        json.beginObject();
        if (value.code != 0)
            json.text("code", std::string_view(&value.code, 1));
        switch (value.type) {
        case RecordValue::eInteger:
            json.integer("integer", value.integer);
            break;
        case RecordValue::eReal:
            json.real("real", value.real);
            break;
        case RecordValue::eText:
            json.text("text", value.text);
            break;
        case RecordValue::eWord:
            json.text("word", value.text);
            break;
        case RecordValue::eBytes:
            json.text("bytes", hexadecimal(value.text.substr(0, shown(value.text.size()))));
            json.integer("count", static_cast<long long>(value.text.size()));
            break;
        case RecordValue::eList:
            printList(record, value, json);
            break;
        }
        json.endObject();
    }

    void printList(const FileRecord& record, const RecordValue& value, JsonWriter& json) const {
        const std::size_t count = shown(value.count);
        std::vector<double> reals(count);
        const bool readable = record.readNumbers(reals.data(), count);
        json.key("list");
        if (readable) {
            json.beginArray();
            for (const std::string& number : listNumbers(record, value, count))
                json.digits(number);
            json.endArray();
        } else {
            json.null();
        }
        json.integer("count", static_cast<long long>(value.count));
        json.integer("storedBytes", static_cast<long long>(value.storedBytes));
        json.boolean("deflated", value.compressed);
    }

    RecordFile& mFile;
    const RecordsOptions& mOptions;
    std::vector<std::string> mPath;
    const Terminal* mTerminal = nullptr;
    std::size_t mColumn = 0;
};

} // namespace

int records(const RecordsOptions& options) {
    return showFiles(
        options, "records",
        [&options](Page& page) -> int {
            FbxStatus status;
            const std::unique_ptr<RecordFile> file = RecordFile::open(page.file().c_str(), status);
            if (!file)
                throw Unreadable(status.GetErrorString());
            RecordPage content(*file, options);
            if (!content.any())
                throw Unreadable("there is no record " + options.path);
            if (page.isJson())
                page.json(
                    "records", [&](JsonWriter& json) { content.printJson(json); });
            else
                content.printText(page);
            return kSuccess;
        });
}

} // namespace tool
