// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Numbers and blanks as ASCII files spell them. std::from_chars does the arithmetic; it does not handle
// leading plus signs, old runtimes' spellings of infinity, and numbers out of range.
#include "container/NumberText.h"

#include <algorithm>
#include <charconv>
#include <limits>
#include <system_error>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

bool isSign(char c) { return c == '+' || c == '-'; }

bool isLetterOrDigit(char c) { return chars::is(chars::digit, c) || chars::is(chars::letter, c) || c == '_'; }

bool allDigits(std::string_view text) {
    return std::all_of(
        text.begin(), text.end(), [](char c) { return chars::is(chars::digit, c); });
}

/// ASCII letters only; `word` is in lower case.
bool consumeWord(std::string_view& text, std::string_view word) {
    const auto sameLetter = [](char a, char b) { return (a >= 'A' && a <= 'Z' ? a - 'A' + 'a' : a) == b; };
    if (text.size() < word.size() || !std::equal(word.begin(), word.end(), text.begin(),
                                                 [&](char expected, char c) { return sameLetter(c, expected); }))
        return false;
    text.remove_prefix(word.size());
    return true;
}

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNotANumber = std::numeric_limits<double>::quiet_NaN();

/// The spellings of newer runtimes: `inf`, `infinity`, `nan`, `nan(letters)`.
std::optional<double> parseWordForm(std::string_view text) {
    if (consumeWord(text, "inf"))
        return text.empty() || (consumeWord(text, "inity") && text.empty()) ? std::optional(kInfinity) : std::nullopt;
    if (!consumeWord(text, "nan"))
        return std::nullopt;
    const bool plain = text.empty();
    const bool tagged = text.size() >= 2 && text.front() == '(' && text.back() == ')' &&
                        std::all_of(text.begin() + 1, text.end() - 1, isLetterOrDigit);
    return plain || tagged ? std::optional(kNotANumber) : std::nullopt;
}

/// The spellings of old Microsoft runtimes: digits, `.#`, a word, digits.
std::optional<double> parseHashForm(std::string_view text) {
    struct Row {
        std::string_view word;
        double value;
    };
    static constexpr Row kWords[] = {
        {"inf", kInfinity}, {"ind", kNotANumber}, {"nan", kNotANumber}, {"qnan", kNotANumber}, {"snan", kNotANumber}};

    const std::size_t hash = text.find(".#");
    if (hash == 0 || hash == std::string_view::npos || !allDigits(text.substr(0, hash)))
        return std::nullopt;
    for (const Row& row : kWords) {
        std::string_view rest = text.substr(hash + 2);
        if (consumeWord(rest, row.word) && allDigits(rest))
            return row.value;
    }
    return std::nullopt;
}

/// The value of a plain number that no floating-point type can represent: infinite or zero. The power of ten of its
/// first non-zero digit decides, and out of range that is far from zero.
template <class Real>
Real outOfRange(std::string_view number) {
    const bool negative = number.front() == '-';
    const std::size_t mark = number.find_first_of("eE");
    const std::string_view mantissa = number.substr(0, mark);
    const std::size_t point = std::min(mantissa.find('.'), mantissa.size());
    const std::size_t first = std::min(mantissa.find_first_of("123456789"), mantissa.size());

    std::int64_t exponent = 0;
    if (mark != std::string_view::npos) {
        std::string_view digits = number.substr(mark + 1);
        const bool down = digits.front() == '-';
        digits.remove_prefix(isSign(digits.front()) ? 1 : 0);
        const auto result = std::from_chars(digits.data(), digits.data() + digits.size(), exponent);
        if (result.ec != std::errc())
            exponent = std::numeric_limits<std::int64_t>::max() / 2;
        exponent = down ? -exponent : exponent;
        exponent = std::clamp(exponent, -(std::int64_t{1} << 60), std::int64_t{1} << 60);
    }
    const auto power = exponent + static_cast<std::int64_t>(point) - static_cast<std::int64_t>(first);
    const Real size = power > 0 ? std::numeric_limits<Real>::infinity() : Real{0};
    return negative ? -size : size;
}

template <class Real>
std::optional<Real> parse(std::string_view token) {
    if (!token.empty() && token.front() == '+') {
        token.remove_prefix(1);
        if (!token.empty() && isSign(token.front()))
            return std::nullopt;
    }
    if (token.empty())
        return std::nullopt;
    const char* const end = token.data() + token.size();
    Real number = 0;
    const auto result = std::from_chars(token.data(), end, number);
    if (result.ptr != end || result.ec == std::errc::invalid_argument) {
        const std::optional<double> special = parseNonFinite(token);
        return special ? std::optional(static_cast<Real>(*special)) : std::nullopt;
    }
    return result.ec == std::errc::result_out_of_range ? outOfRange<Real>(token) : number;
}

} // namespace

const char* commentEnd(const char* text, const char* end) {
    return std::find_if(
        text, end, [](char c) { return c == '\n' || c == '\r'; });
}

const char* skipComments(const char* text, const char* end) {
    while (text != end && *text == ';') {
        text = commentEnd(text, end);
        while (text != end && chars::is(chars::blank, *text))
            ++text;
    }
    return text;
}

std::optional<double> parseNonFinite(std::string_view token) {
    const bool negative = !token.empty() && token.front() == '-';
    if (!token.empty() && isSign(token.front()))
        token.remove_prefix(1);
    std::optional<double> value = parseWordForm(token);
    if (!value)
        value = parseHashForm(token);
    return value && negative ? std::optional(-*value) : value;
}

std::optional<double> parseReal(std::string_view token) { return parse<double>(token); }

std::optional<float> parseFloat(std::string_view token) { return parse<float>(token); }

std::optional<std::int64_t> parseInteger(std::string_view token) {
    if (token.size() > 1 && token.front() == '+' && !isSign(token[1]))
        token.remove_prefix(1);
    // Most are short; those cannot overflow.
    constexpr std::size_t kFits = 18;
    if (!token.empty() && token.size() <= kFits && token.front() != '-') {
        std::int64_t number = 0;
        for (const char c : token) {
            if (!chars::is(chars::digit, c))
                return std::nullopt;
            number = 10 * number + (c - '0');
        }
        return number;
    }
    const char* const end = token.data() + token.size();
    std::int64_t number = 0;
    const auto result = std::from_chars(token.data(), end, number);
    if (result.ec != std::errc() || result.ptr != end || (number == 0 && token.front() == '-'))
        return std::nullopt;
    return number;
}

} // namespace detail
FBXSDK_NAMESPACE_END
