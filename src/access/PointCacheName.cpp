// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "PointCacheName.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace Tarnell::Fbx {

namespace {

constexpr char kHexDigits[] = "0123456789ABCDEF";
/// Of the 255 bytes of a file name, less the longest extension and what other programs append.
constexpr std::size_t kMostBytes = 240;

void appendEscaped(std::string& text, char letter) {
    const auto byte = static_cast<unsigned char>(letter);
    text += '%';
    text += kHexDigits[byte / 16];
    text += kHexDigits[byte % 16];
}

bool isHexDigit(char letter) {
    return (letter >= '0' && letter <= '9') || (letter >= 'A' && letter <= 'F') || (letter >= 'a' && letter <= 'f');
}

/// Separators, wildcards, quotes and control bytes, which are not allowed on every system.
bool isForbidden(char letter) {
    constexpr std::string_view kForbidden = "/\\:*?\"<>|\x7F";
    return static_cast<unsigned char>(letter) < 0x20 || kForbidden.find(letter) != std::string_view::npos;
}

bool looksEscaped(std::string_view text) {
    return text.size() >= 3 && text[0] == '%' && isHexDigit(text[1]) && isHexDigit(text[2]);
}

/// The length of the character at the front of the text in bytes; 0 when it is invalid.
std::size_t characterLength(std::string_view text) {
    const auto byte = [&](std::size_t i) { return i < text.size() ? static_cast<unsigned char>(text[i]) : 0U; };
    const unsigned first = byte(0), second = byte(1);
    const std::size_t length = first < 0x80   ? 1
                               : first < 0xC2 ? 0 // a continuation byte, or an overlong encoding
                               : first < 0xE0 ? 2
                               : first < 0xF0 ? 3
                               : first < 0xF5 ? 4
                                              : 0;
    for (std::size_t i = 1; i < length; ++i)
        if ((byte(i) & 0xC0U) != 0x80)
            return 0;
    const bool needless = (first == 0xE0 && second < 0xA0) || (first == 0xF0 && second < 0x90);
    const bool none = (first == 0xED && second >= 0xA0) || (first == 0xF4 && second >= 0x90);
    return needless || none ? 0 : length;
}

/// A device of that name exists in every folder of some systems, also with an extension.
bool isReserved(const std::string& name) {
    constexpr std::array<std::string_view, 4> kNames = {"CON", "PRN", "AUX", "NUL"};
    constexpr std::array<std::string_view, 2> kNumbered = {"COM", "LPT"};
    std::string stem = name.substr(0, name.find('.'));
    std::transform(stem.begin(), stem.end(), stem.begin(),
                   [](char c) { return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c; });
    const bool numbered = stem.size() == 4 && stem[3] >= '0' && stem[3] <= '9' &&
                          std::find(kNumbered.begin(), kNumbered.end(), stem.substr(0, 3)) != kNumbered.end();
    return numbered || std::find(kNames.begin(), kNames.end(), stem) != kNames.end();
}

std::string escaped(std::string_view name) {
    const std::size_t end = name.find_last_not_of(" .") + 1; // 0 when nothing else is left
    std::string text;
    for (std::size_t i = 0; i < name.size();) {
        const std::size_t length = characterLength(name.substr(i));
        if (length == 0 || i >= end || isForbidden(name[i]) || looksEscaped(name.substr(i))) {
            appendEscaped(text, name[i]);
            ++i;
        } else {
            text += name.substr(i, length);
            i += length;
        }
    }
    return text;
}

/// FNV-1a: the same in every build, unlike that of the standard library.
std::string hashOf(std::string_view name) {
    std::uint64_t hash = 0xCBF29CE484222325U;
    for (const char letter : name)
        hash = (hash ^ static_cast<unsigned char>(letter)) * 0x100000001B3U;
    std::string digits;
    for (int shift = 60; shift >= 0; shift -= 4)
        digits += kHexDigits[hash >> static_cast<unsigned>(shift) & 0xFU];
    return digits;
}

/// The beginning of the text, in whole characters and escapes.
std::string beginning(const std::string& text, std::size_t mostBytes) {
    std::size_t end = 0;
    while (end < mostBytes) {
        const std::string_view rest = std::string_view(text).substr(end);
        const std::size_t length = looksEscaped(rest) ? 3 : characterLength(rest);
        if (end + length > mostBytes)
            break;
        end += length;
    }
    return text.substr(0, end);
}

} // namespace

std::string detail::pointCacheName(const std::string& nodeName) {
    if (nodeName.empty())
        return "%00"; // no other name begins with the byte that ends names
    std::string name = escaped(nodeName);
    if (isReserved(name)) {
        name = name.substr(1);
        std::string first;
        appendEscaped(first, nodeName[0]);
        name = first + name;
    }
    return name.size() <= kMostBytes ? name : beginning(name, kMostBytes - 17) + '~' + hashOf(nodeName);
}

} // namespace Tarnell::Fbx
