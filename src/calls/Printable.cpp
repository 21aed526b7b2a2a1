// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Printable.h"

#include <array>
#include <cstddef>

namespace Tarnell::Fbx {

namespace {

struct Character {
    char32_t code = 0;
    std::size_t size = 0; // 0: invalid UTF-8
};

/// The character at the front of the text, which is not empty.
Character frontOf(std::string_view text) {
    const auto byte = [text](std::size_t index) { return static_cast<unsigned char>(text[index]); };
    const unsigned first = byte(0);
    if (first < 0x80)
        return {first, 1};
    const std::size_t size = first >= 0xF0 ? 4 : first >= 0xE0 ? 3 : 2;
    constexpr std::array<char32_t, 5> kLeast = {0, 0, 0x80, 0x800, 0x10000};
    if (first < 0xC0 || first > 0xF4 || text.size() < size)
        return {};
    char32_t code = first & (0xFFU >> (size + 1));
    for (std::size_t i = 1; i < size; ++i) {
        if ((byte(i) & 0xC0U) != 0x80U)
            return {};
        code = code << 6U | (byte(i) & 0x3FU);
    }
    const bool isSurrogate = code >= 0xD800 && code <= 0xDFFF;
    return code < kLeast[size] || code > 0x10FFFF || isSurrogate ? Character() : Character{code, size};
}

bool isObeyed(char32_t code) {
    const bool isControl = code < 0x20 || (code >= 0x7F && code <= 0x9F);
    const bool turnsDirection = (code >= 0x202A && code <= 0x202E) || (code >= 0x2066 && code <= 0x2069);
    return isControl || turnsDirection || code == 0x2028 || code == 0x2029;
}

void appendHexadecimal(std::string& text, unsigned number, int digits) {
    while (digits-- > 0)
        text += "0123456789ABCDEF"[number >> (4 * digits) & 0xFU];
}

} // namespace

std::string detail::printable(std::string_view text, bool keepLines) {
    std::string result;
    while (!text.empty()) {
        const Character character = frontOf(text);
        const std::size_t size = character.size != 0 ? character.size : 1;
        const bool isLineEnd = keepLines && character.code == U'\n';
        if (character.size == 0 || (size == 1 && isObeyed(character.code) && !isLineEnd)) {
            result += "\\x";
            appendHexadecimal(result, static_cast<unsigned char>(text.front()), 2);
        } else if (size > 1 && isObeyed(character.code)) {
            result += "\\u";
            appendHexadecimal(result, static_cast<unsigned>(character.code), 4);
        } else {
            result += text.substr(0, size);
        }
        text.remove_prefix(size);
    }
    return result;
}

} // namespace Tarnell::Fbx
