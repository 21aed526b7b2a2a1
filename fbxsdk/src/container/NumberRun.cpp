// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The scan over lists of numbers, which takes nearly all the time of reading an ASCII file.
#include "container/NumberRun.h"

#include <string_view>

#include "container/NumberText.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

/// The end of the number that starts here, the start itself when there is none. Where words count, any word is one.
const char* numberEnd(const char* text, const char* end, bool wordsCount) {
    const char* const plainEnd = plainNumberEnd(text, end);
    if (plainEnd != text && (plainEnd == end || chars::is(chars::delimiter, *plainEnd))) {
        return plainEnd;
    }
    const char* const after = tokenEnd(text, end);
    const std::string_view token(text, static_cast<std::size_t>(after - text));
    const bool isWord = !token.empty() && chars::is(chars::letter, token.front());
    return (isWord && wordsCount) || parseNonFinite(token) ? after : text;
}

} // namespace

NumberRun scanNumbers(const char* text, const char* end, bool wordsCount) {
    NumberRun run{0, text, text, false};
    while (text != end) {
        const char* const after = numberEnd(text, end, wordsCount);
        const char* const next = after != end && *after == ',' ? after : skipBlanks(after, end);
        if (after == text || (next != end && *next == ':')) {
            break; // no number, or the name of the next record
        }
        ++run.count;
        run.numbersEnd = after;
        run.next = next;
        run.afterComma = next != end && *next == ',';
        if (!run.afterComma) {
            break;
        }
        text = next + 1;
        if (text != end && !chars::is(chars::digit, *text) && *text != '-') {
            text = skipSeparators(text, end);
        }
        run.next = text;
    }
    return run;
}

} // namespace detail
FBXSDK_NAMESPACE_END
