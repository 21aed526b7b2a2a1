// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// UTF-8, as strictly as in RFC 3629: no overlong forms, no surrogates, nothing above U+10FFFF.
#include "Utf8.h"

#include <algorithm>
#include <iterator>

namespace tool {
namespace {

struct CodeRange {
    char32_t first, last;
};

bool isIn(const CodeRange* begin, const CodeRange* end, char32_t code) {
    return std::any_of(
        begin, end, [=](const CodeRange& range) { return code >= range.first && code <= range.last; });
}

/// The blocks that names are likely to use; a table of all characters would be disproportionate.
constexpr CodeRange kWide[] = {{0x1100, 0x115F},   {0x2E80, 0x303E},   {0x3041, 0x33FF},  {0x3400, 0x4DBF},
                               {0x4E00, 0x9FFF},   {0xA000, 0xA4CF},   {0xAC00, 0xD7A3},  {0xF900, 0xFAFF},
                               {0xFE30, 0xFE6F},   {0xFF00, 0xFF60},   {0xFFE0, 0xFFE6},  {0x1F300, 0x1F64F},
                               {0x1F900, 0x1F9FF}, {0x20000, 0x2FFFD}, {0x30000, 0x3FFFD}};
constexpr CodeRange kCombining[] = {
    {0x0300, 0x036F}, {0x200B, 0x200F}, {0x20D0, 0x20FF}, {0xFE00, 0xFE0F}, {0xFE20, 0xFE2F}};

std::size_t columnsOf(char32_t code) {
    if (isIn(std::begin(kCombining), std::end(kCombining), code))
        return 0;
    return isIn(std::begin(kWide), std::end(kWide), code) ? 2 : 1;
}

/// The number of bytes by the first byte; 0 when it begins no character.
std::size_t announcedSize(unsigned char lead) {
    if (lead < 0x80)
        return 1;
    if (lead >= 0xC2 && lead <= 0xDF)
        return 2;
    if (lead >= 0xE0 && lead <= 0xEF)
        return 3;
    return lead >= 0xF0 && lead <= 0xF4 ? 4 : 0;
}

} // namespace

Utf8Character utf8At(std::string_view text, std::size_t at) {
    const auto lead = static_cast<unsigned char>(text[at]);
    const std::size_t size = announcedSize(lead);
    if (size == 0 || size > text.size() - at)
        return {lead, 1, false};
    if (size == 1)
        return {lead, 1, true};
    auto code = static_cast<char32_t>(lead & (0x7FU >> size));
    for (std::size_t i = 1; i < size; ++i) {
        const auto byte = static_cast<unsigned char>(text[at + i]);
        if ((byte & 0xC0U) != 0x80U)
            return {lead, 1, false};
        code = (code << 6U) | (byte & 0x3FU);
    }
    constexpr char32_t kSmallest[] = {0, 0, 0x80, 0x800, 0x10000};
    const bool isSurrogate = code >= 0xD800 && code <= 0xDFFF;
    if (code < kSmallest[size] || code > 0x10FFFF || isSurrogate)
        return {lead, 1, false};
    return {code, size, true};
}

std::size_t displayWidth(std::string_view text) {
    std::size_t columns = 0;
    for (std::size_t at = 0; at < text.size();) {
        const Utf8Character character = utf8At(text, at);
        columns += columnsOf(character.code);
        at += character.size;
    }
    return columns;
}

std::string fitted(std::string_view text, std::size_t columns) {
    if (displayWidth(text) <= columns)
        return std::string(text);
    std::size_t at = 0, taken = 1; // the dots take one
    while (at < text.size()) {
        const Utf8Character character = utf8At(text, at);
        taken += columnsOf(character.code);
        if (taken > columns)
            break;
        at += character.size;
    }
    return columns == 0 ? std::string() : std::string(text.substr(0, at)) + "…";
}

} // namespace tool
