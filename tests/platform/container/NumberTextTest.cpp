// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Numbers as text: what is one, where it ends, and its value in any locale.
#include "container/NumberText.h"

#include <clocale>
#include <cmath>
#include <limits>
#include <random>
#include <string>

#include <gtest/gtest.h>

#include "support/RecordText.h"

using namespace fbxsdk::detail;

namespace {

std::size_t plainLength(std::string_view text) {
    return static_cast<std::size_t>(plainNumberEnd(text.data(), text.data() + text.size()) - text.data());
}

TEST(NumberText, FindsTheEndOfAPlainNumber) {
    for (const char* const number : {"0", "-0", "+5", "12345678", "123456789012345678901234567890", "1.", ".5", "-.5",
                                     "1.5", "1e5", "1.e5", "1E-005", "-1.25e+10", "12345678.12345678e12345678"}) {
        const std::string_view text(number);
        EXPECT_EQ(plainLength(text), text.size()) << text;
        for (const char* const behind : {",1", " ", "\n", "}", ";", "x", ".#"}) {
            if (text.find('.') == std::string_view::npos && text.find('e') == std::string_view::npos && *behind == '.')
                continue; // a point would belong to the number
            EXPECT_EQ(plainLength(std::string(text) + behind), text.size()) << text << behind;
        }
    }
}

TEST(NumberText, FindsNoPlainNumberWhereNoneIs) {
    for (const char* const text :
         {"", "-", "+", ".", "-.", "e5", "-e5", ".e5", "1e", "1e+", "1.5e-", "x", "inf", "nan", " 1"})
        EXPECT_EQ(plainLength(text), 0U) << text;
}

TEST(NumberText, CountsDigitsAtEveryAlignmentAndLength) {
    for (std::size_t length = 0; length < 40; ++length) {
        for (int c = 0; c < 256; ++c) {
            const std::string text = std::string(length, '9') + static_cast<char>(c) + "0123456789";
            const bool isDigit = c >= '0' && c <= '9';
            const char* const end = skipDigits(text.data(), text.data() + text.size());
            ASSERT_EQ(static_cast<std::size_t>(end - text.data()), isDigit ? text.size() : length) << c;
        }
    }
}

TEST(NumberText, ReadsBackEveryDoubleItIsGiven) {
    std::mt19937_64 random(20240901);
    for (int i = 0; i < 100'000; ++i) {
        const auto number = std::bit_cast<double>(random());
        if (std::isfinite(number)) {
            const std::string text = realText(number);
            ASSERT_EQ(std::bit_cast<std::uint64_t>(parseReal(text).value()), std::bit_cast<std::uint64_t>(number))
                << text;
            ASSERT_EQ(plainLength(text), text.size()) << text;
        }
    }
}

TEST(NumberText, RoundsToTheNearestFloatWithoutADetour) {
    // Just above the middle between two floats; the nearest double is the middle itself, whose nearest float is lower.
    EXPECT_EQ(parseFloat("1.00000005960464477540"), 1.0F + std::numeric_limits<float>::epsilon());
    EXPECT_EQ(parseFloat("3.4028235e38"), std::numeric_limits<float>::max());
    EXPECT_EQ(parseFloat("3.5e38"), std::numeric_limits<float>::infinity());
    EXPECT_EQ(parseFloat("-3.5e38"), -std::numeric_limits<float>::infinity());
    EXPECT_EQ(parseFloat("1e-60"), 0.0F);
}

TEST(NumberText, ReadsNumbersOutOfRangeAsTheirLimits) {
    const double infinity = std::numeric_limits<double>::infinity();
    EXPECT_EQ(parseReal("1e400"), infinity);
    EXPECT_EQ(parseReal("-1e400"), -infinity);
    EXPECT_EQ(parseReal("1" + std::string(400, '0')), infinity);
    EXPECT_EQ(parseReal("1" + std::string(400, '0') + "e-400"), 1.0);
    EXPECT_EQ(parseReal("0." + std::string(400, '0') + "1e401"), 1.0);
    EXPECT_EQ(parseReal("0." + std::string(400, '0') + "1"), 0.0);
    EXPECT_EQ(parseReal("0e999999999999999999999"), 0.0);
    EXPECT_EQ(parseReal("1e-999999999999999999999"), 0.0);
    EXPECT_EQ(parseReal("1e999999999999999999999"), infinity);
    EXPECT_TRUE(std::signbit(parseReal("-1e-400").value()));
    EXPECT_EQ(parseReal("4.9406564584124654e-324"), std::numeric_limits<double>::denorm_min());
}

TEST(NumberText, KeepsTheSignOfInfinities) {
    EXPECT_EQ(parseNonFinite("-inf"), -std::numeric_limits<double>::infinity());
    EXPECT_EQ(parseNonFinite("-1.#INF"), -std::numeric_limits<double>::infinity());
    EXPECT_EQ(parseNonFinite("+1.#INF"), std::numeric_limits<double>::infinity());
}

TEST(NumberText, RefusesRelativesOfInfinity) {
    for (const char* const text :
         {"",         "i",       "in",    "infi",     "infty",  "infinit",  "infinityy", "na",    "nan(",
          "nan)",     "nan())",  "nan((", "nan(a b)", "Nan((",  "snan",     "ind",       "1.#",   "1.#IN",
          "1.#INDIE", "1.#NOPE", ".#INF", "1#INF",    "x.#INF", "1.#INF1x", "--inf",     "+-inf", "- inf"}) {
        EXPECT_FALSE(parseNonFinite(text)) << text;
        EXPECT_FALSE(parseReal(text)) << text;
    }
}

TEST(NumberText, ReadsWholeNumbersOnlyWhereNothingIsLost) {
    EXPECT_EQ(parseInteger("+12"), 12);
    EXPECT_EQ(parseInteger("-012"), -12);
    EXPECT_EQ(parseInteger("9223372036854775807"), std::numeric_limits<std::int64_t>::max());
    EXPECT_EQ(parseInteger("-9223372036854775808"), std::numeric_limits<std::int64_t>::min());
    for (const char* const text :
         {"", "+", "-", "+-1", "-+1", "++1", "1.0", "1e2", "-0", "-00", "9223372036854775808", "x", "1x"})
        EXPECT_FALSE(parseInteger(text)) << text;
}

TEST(NumberText, DoesNotDependOnTheLocale) {
    const std::string before = std::setlocale(LC_ALL, nullptr);
    for (const char* const name : {"de_DE.UTF-8", "fr_FR.UTF-8", "C.UTF-8"}) {
        if (std::setlocale(LC_ALL, name) != nullptr) {
            EXPECT_EQ(parseReal("1.5"), 1.5) << name;
            EXPECT_FALSE(parseReal("1,5")) << name;
        }
    }
    std::setlocale(LC_ALL, before.c_str());
}

} // namespace
