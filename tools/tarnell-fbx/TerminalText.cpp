// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "TerminalText.h"

#include <unistd.h>

#include "Utf8.h"

namespace tool {
namespace {

std::string hexadecimal(unsigned number, int digits) {
    std::string text;
    for (int shift = (digits - 1) * 4; shift >= 0; shift -= 4)
        text += "0123456789abcdef"[number >> static_cast<unsigned>(shift) & 0xFU];
    return text;
}

/// Bidirectional marks, and separators of lines.
bool isInvisibleControl(char32_t character) {
    return (character >= 0x80 && character < 0xA0) || character == 0x2028 || character == 0x2029 ||
           (character >= 0x202A && character <= 0x202E) || (character >= 0x2066 && character <= 0x2069);
}

std::string spelt(char32_t character) {
    switch (character) {
    case '\n':
        return "\\n";
    case '\t':
        return "\\t";
    case '\r':
        return "\\r";
    default:
        return character < 0x80 ? "\\x" + hexadecimal(character, 2) : "\\u" + hexadecimal(character, 4);
    }
}

} // namespace

std::string terminalText(std::string_view text) {
    std::string shown;
    shown.reserve(text.size());
    for (std::size_t at = 0; at < text.size();) {
        const Utf8Character character = utf8At(text, at);
        if (!character.valid)
            shown += "\\x" + hexadecimal(static_cast<unsigned char>(text[at]), 2);
        else if (character.code < 0x20 || character.code == 0x7F || isInvisibleControl(character.code))
            shown += spelt(character.code);
        else
            shown += text.substr(at, character.size);
        at += character.size;
    }
    return shown;
}

bool isTerminal(std::FILE* stream) { return isatty(fileno(stream)) == 1; }

} // namespace tool
