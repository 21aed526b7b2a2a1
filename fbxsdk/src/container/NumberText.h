// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Numbers and blanks as ASCII files spell them. The functions that scan megabytes of numbers are inline.
#pragma once

#include <array>
#include <bit>
#include <cstdint>
#include <optional>
#include <string_view>

#include <fbxsdk/FbxArch.h>

#include "container/ByteOrder.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace chars {

enum Kind : std::uint8_t { blank = 1, delimiter = 2, digit = 4, letter = 8 };

inline constexpr auto kKinds = [] {
    std::array<std::uint8_t, 256> kinds{};
    for (const char c : std::string_view(" \t\r\n"))
        kinds[static_cast<unsigned char>(c)] = blank | delimiter;
    for (const char c : std::string_view(",{};\":"))
        kinds[static_cast<unsigned char>(c)] = delimiter;
    for (char c = '0'; c <= '9'; ++c)
        kinds[static_cast<unsigned char>(c)] = digit;
    for (char c = 'a'; c <= 'z'; ++c) {
        kinds[static_cast<unsigned char>(c)] = letter;
        kinds[static_cast<unsigned char>(c - 'a' + 'A')] = letter;
    }
    return kinds;
}();

[[nodiscard]] constexpr bool is(Kind kind, char c) { return (kKinds[static_cast<unsigned char>(c)] & kind) != 0; }

} // namespace chars

/// The end of a number, name or word: the next blank, bracket, comma, quote, colon or comment.
[[nodiscard]] inline const char* tokenEnd(const char* text, const char* end) {
    while (text != end && !chars::is(chars::delimiter, *text))
        ++text;
    return text;
}

/// The end of a comment: a line feed, or a carriage return in files of systems that use it for line ends.
[[nodiscard]] const char* commentEnd(const char* text, const char* end);

/// Skips comments, and blanks after each.
[[nodiscard]] const char* skipComments(const char* text, const char* end);
/// Skips blanks and comments.
[[nodiscard]] inline const char* skipBlanks(const char* text, const char* end) {
    while (text != end && chars::is(chars::blank, *text))
        ++text;
    return text == end || *text != ';' ? text : skipComments(text, end);
}
/// Skips blanks, comments and commas: what separates two values. Surplus commas are ignored.
[[nodiscard]] inline const char* skipSeparators(const char* text, const char* end) {
    text = skipBlanks(text, end);
    while (text != end && *text == ',')
        text = skipBlanks(text + 1, end);
    return text;
}

/// How many of the eight bytes at `text` are digits before the first that is none.
[[nodiscard]] inline int digitsOfEight(const char* text) {
    constexpr std::uint64_t kOnes = 0x0101010101010101;
    const auto bytes = loadNumber<std::uint64_t>(text, needsSwap(/*bigEndian*/ false));
    // Digits become 0 to 9; adding carries everything larger into the top bit of its byte. A carry beyond that spoils
    // later bytes only.
    const std::uint64_t values = bytes ^ (kOnes * '0');
    const std::uint64_t others = ((values + kOnes * (0x80 - 10)) | values) & (kOnes * 0x80);
    return std::countr_zero(others) / 8;
}

/// Eight at a time where the text allows: meshes in ASCII consist mostly of digits.
[[nodiscard]] inline const char* skipDigits(const char* text, const char* end) {
    while (end - text >= 8) {
        const int count = digitsOfEight(text);
        text += count;
        if (count < 8)
            return text;
    }
    while (text != end && chars::is(chars::digit, *text))
        ++text;
    return text;
}

/// The end of the plain number (no infinity, no NaN) that starts here; the start itself when there is none.
[[nodiscard]] inline const char* plainNumberEnd(const char* start, const char* end) {
    const char* text = start;
    if (text != end && (*text == '-' || *text == '+'))
        ++text;
    const char* const whole = text;
    text = skipDigits(text, end);
    auto digits = text - whole;
    if (text != end && *text == '.') {
        const char* const fraction = ++text;
        text = skipDigits(text, end);
        digits += text - fraction;
    }
    if (digits == 0)
        return start;
    if (text != end && (*text == 'e' || *text == 'E')) {
        const char* exponent = text + 1;
        if (exponent != end && (*exponent == '-' || *exponent == '+'))
            ++exponent;
        text = skipDigits(exponent, end);
        if (text == exponent)
            return start;
    }
    return text;
}

/// The value of a token that spells an infinity or "not a number", in any of the ways that C libraries do:
/// `inf`, `infinity`, `nan`, `nan(…)`, `1.#INF`, `-1.#IND`, `1.#QNAN`, `2.#NAN0000` …; case does not matter.
[[nodiscard]] std::optional<double> parseNonFinite(std::string_view token);

/// A token as a number: plain or not finite; null otherwise. Does not depend on the locale. Too large numbers become
/// infinite, too small ones zero, as in strtod.
[[nodiscard]] std::optional<double> parseReal(std::string_view token);
[[nodiscard]] std::optional<float> parseFloat(std::string_view token);
/// A token that is only a sign and digits and fits; null otherwise, and for "-0", which only a floating-point type has.
[[nodiscard]] std::optional<std::int64_t> parseInteger(std::string_view token);

} // namespace detail
FBXSDK_NAMESPACE_END
