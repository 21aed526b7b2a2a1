// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The table of well-formed byte sequences (Unicode, chapter 3, table 3-7).
#include "Utf8.h"

namespace conformance {
namespace {

struct Sequence {
    unsigned char firstLow, firstHigh;   ///< range of the first byte
    unsigned char secondLow, secondHigh; ///< of the second; further ones are 80..BF
    std::size_t length;
};

constexpr Sequence kSequences[] = {
    {0x00, 0x7F, 0x00, 0x00, 1}, {0xC2, 0xDF, 0x80, 0xBF, 2}, {0xE0, 0xE0, 0xA0, 0xBF, 3},
    {0xE1, 0xEC, 0x80, 0xBF, 3}, {0xED, 0xED, 0x80, 0x9F, 3}, {0xEE, 0xEF, 0x80, 0xBF, 3},
    {0xF0, 0xF0, 0x90, 0xBF, 4}, {0xF1, 0xF3, 0x80, 0xBF, 4}, {0xF4, 0xF4, 0x80, 0x8F, 4},
};

bool within(std::string_view text, std::size_t at, unsigned char low, unsigned char high) {
    const auto byte = static_cast<unsigned char>(text[at]);
    return low <= byte && byte <= high;
}

/// The length of the character at the start of the text; 0 when there is none.
std::size_t characterLength(std::string_view text) {
    for (const Sequence& row : kSequences) {
        if (!within(text, 0, row.firstLow, row.firstHigh) || text.size() < row.length)
            continue;
        bool wellFormed = row.length < 2 || within(text, 1, row.secondLow, row.secondHigh);
        for (std::size_t i = 2; i < row.length; ++i)
            wellFormed = wellFormed && within(text, i, 0x80, 0xBF);
        if (wellFormed)
            return row.length;
    }
    return 0;
}

} // namespace

std::string withoutInvalidUtf8(std::string_view text) {
    constexpr std::string_view kReplacement = "\xEF\xBF\xBD";
    std::string result;
    while (!text.empty()) {
        const std::size_t length = characterLength(text);
        result += length == 0 ? kReplacement : text.substr(0, length);
        text.remove_prefix(length == 0 ? 1 : length);
    }
    return result;
}

} // namespace conformance
