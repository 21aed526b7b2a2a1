// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The detection of ASCII files and of their version.
#include "container/AsciiPreamble.h"

#include <algorithm>
#include <string_view>

#include "container/NumberText.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";

/// Records that a file may begin with, for files without a comment that states a version.
constexpr std::string_view kFirstRecords[] = {
    "FBXHeaderExtension", "FBXVersion", "CreationTime", "Creator",    "FileId",
    "GlobalSettings",     "Document",   "Documents",    "References", "Definitions",
    "Connections",        "Takes",      "Objects",      "Relations",  "Media",
    "Switcher",           "Model",      "Version5",
};

/// The version in a comment like "; FBX 7.5.0 project file"; 0 when the comment is another one.
std::uint32_t versionOfComment(std::string_view comment) {
    const auto skipSpaces = [&] { comment.remove_prefix(std::min(comment.find_first_not_of(" \t"), comment.size())); };
    const auto digit = [&](std::size_t index) {
        return index < comment.size() && chars::is(chars::digit, comment[index]);
    };
    comment.remove_prefix(1);
    skipSpaces();
    if (!comment.starts_with("FBX"))
        return 0;
    comment.remove_prefix(3);
    skipSpaces();
    const bool isVersion = digit(0) && digit(2) && digit(4) && comment[1] == '.' && comment[3] == '.' && !digit(5);
    const auto number = [&](std::size_t index) { return static_cast<std::uint32_t>(comment[index] - '0'); };
    return isVersion ? number(0) * 1000 + number(2) * 100 + number(4) * 10 : 0;
}

} // namespace

AsciiPreamble readPreamble(std::span<const char> bytes) {
    const char* text = bytes.data();
    const char* const end = text + bytes.size();
    AsciiPreamble preamble;
    if (std::string_view(text, bytes.size()).starts_with(kByteOrderMark))
        text += kByteOrderMark.size();
    while (text != end) {
        if (chars::is(chars::blank, *text)) {
            ++text;
        } else if (*text == ';') {
            const char* const lineEnd = commentEnd(text, end);
            const std::string_view comment(text, static_cast<std::size_t>(lineEnd - text));
            if (const std::uint32_t version = versionOfComment(comment); version != 0 && preamble.version == 0) {
                preamble.version = version;
                preamble.versionComment = text;
            }
            text = lineEnd;
        } else {
            break;
        }
    }
    preamble.end = text;
    return preamble;
}

bool isAscii(std::span<const char> bytes) {
    const char* const end = bytes.data() + bytes.size();
    const AsciiPreamble preamble = readPreamble(bytes);
    if (preamble.version != 0)
        return true;
    const char* const nameEnd = tokenEnd(preamble.end, end);
    const char* const colon = skipBlanks(nameEnd, end);
    const std::string_view name(preamble.end, static_cast<std::size_t>(nameEnd - preamble.end));
    return colon != end && *colon == ':' &&
           std::find(std::begin(kFirstRecords), std::end(kFirstRecords), name) != std::end(kFirstRecords);
}

bool mayBeginAscii(std::span<const char> bytes) {
    constexpr std::ptrdiff_t kLongestName = 64;
    const char* const end = bytes.data() + bytes.size();
    const char* const name = readPreamble(bytes).end;
    const char* const nameEnd = tokenEnd(name, end);
    return nameEnd - name <= kLongestName && skipBlanks(nameEnd, end) == end;
}

} // namespace detail
FBXSDK_NAMESPACE_END
