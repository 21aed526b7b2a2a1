// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Blocks of numbers hold what a look at each number finds.
#include "container/NumberBlocks.h"

#include <random>
#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include "container/NumberText.h"

namespace fbxsdk::detail {
namespace {

#ifdef __SSE2__

bool isDigit(char c) { return chars::is(chars::digit, c); }

/// Whether blocks accept the number: each point has a digit on both sides.
bool isPlainInBlocks(std::string_view token) {
    if (token.empty() || plainNumberEnd(token.data(), token.data() + token.size()) != token.data() + token.size())
        return false;
    const std::size_t point = token.find('.');
    return point == token.npos ||
           (point > 0 && isDigit(token[point - 1]) && point + 1 < token.size() && isDigit(token[point + 1]));
}

/// The same as skipNumberBlocks(), a number at a time.
NumberBlocks skipSingly(std::string_view text) {
    const std::string_view blocks = text.substr(0, text.size() / 64 * 64);
    NumberBlocks numbers;
    for (std::size_t start = 0;;) {
        while (start < blocks.size() && chars::is(chars::blank, blocks[start]))
            ++start;
        const std::size_t comma = blocks.find(',', start);
        if (comma == blocks.npos || !isPlainInBlocks(blocks.substr(start, comma - start)))
            return numbers;
        ++numbers.count;
        numbers.lastComma = blocks.data() + comma;
        start = comma + 1;
    }
}

void expectTheSame(const std::string& text) {
    const NumberBlocks expected = skipSingly(text);
    const NumberBlocks actual = skipNumberBlocks(text.data(), text.data() + text.size());
    ASSERT_EQ(actual.count, expected.count) << text;
    ASSERT_EQ(actual.lastComma, expected.lastComma) << text;
}

std::string randomNumber(std::mt19937& random) {
    const auto digits = [&](unsigned most) {
        std::string text;
        for (auto i = random() % most + 1; i > 0; --i)
            text += static_cast<char>('0' + random() % 10);
        return text;
    };
    std::string text = random() % 3 == 0 ? "-" : "";
    text += digits(random() % 20 == 0 ? 150 : 4);
    if (random() % 2 == 0)
        text += '.' + digits(random() % 20 == 0 ? 150 : 17);
    if (random() % 5 == 0)
        text += std::string(random() % 2 == 0 ? "e" : "E") + (random() % 2 == 0 ? "-" : "+") + digits(3);
    return text;
}

std::string randomList(std::mt19937& random, int numbers) {
    std::string text;
    for (int i = 0; i < numbers; ++i) {
        text += randomNumber(random) + ',';
        if (random() % 8 == 0)
            text += random() % 2 == 0 ? "\r\n\t" : " ";
    }
    return text;
}

TEST(NumberBlocks, CountsNumbersOfAllSpellings) {
    std::mt19937 random(3);
    for (int i = 0; i < 500; ++i) {
        const std::string text = randomList(random, 40);
        expectTheSame(text);
        EXPECT_GE(skipNumberBlocks(text.data(), text.data() + text.size()).lastComma,
                  text.data() + text.size() / 64 * 64 - 320)
            << "all that whole blocks hold";
    }
}

TEST(NumberBlocks, StopsBeforeTheFirstCharacterOutOfPlace) {
    std::mt19937 random(5);
    using std::string_view_literals::operator""sv; // with the zero
    constexpr auto kCharacters = "0123456789,,,...+-eE \n\r\t;:{}a\"\0\x80\xff/"sv;
    for (int i = 0; i < 20'000; ++i) {
        std::string text = randomList(random, 40);
        for (auto count = random() % 3 + 1; count > 0; --count)
            text[random() % text.size()] = kCharacters[random() % kCharacters.size()];
        expectTheSame(text);
    }
}

TEST(NumberBlocks, HoldsAnyMixtureOfItsCharacters) {
    std::mt19937 random(7);
    constexpr std::string_view kCharacters("0123456789012345678901234567890123456789,,,,.e- ");
    for (int i = 0; i < 20'000; ++i) {
        std::string text(192, '0');
        for (char& c : text)
            c = kCharacters[random() % kCharacters.size()];
        expectTheSame(text);
    }
}

TEST(NumberBlocks, FollowsMarksFromBlockToBlock) {
    for (std::size_t distance = 1; distance < 200; ++distance) {
        const std::string digits(distance, '7');
        for (const char* const mark : {".", "e", "E-", "e+"})
            for (const char* const next : {".", "e", ",", "-", " "})
                for (std::size_t start = 1; start < 66; start += 13)
                    expectTheSame("1," + std::string(start, '3') + mark + digits + next + std::string(200, '5') +
                                  ",1,");
    }
}

TEST(NumberBlocks, FindsNothingInLessThanABlock) {
    const std::string text(63, ',');
    EXPECT_EQ(skipNumberBlocks(text.data(), text.data()).count, 0U);
    const std::string numbers = "1,2,3,";
    EXPECT_EQ(skipNumberBlocks(numbers.data(), numbers.data() + numbers.size()).lastComma, nullptr);
}

#endif

} // namespace
} // namespace fbxsdk::detail
