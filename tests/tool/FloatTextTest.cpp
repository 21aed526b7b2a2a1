// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Floats as text, character by character as the standard library writes them.
#include "FloatText.h"

#include <gtest/gtest.h>

#include <bit>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <limits>
#include <random>
#include <string>

namespace {

std::string textOf(float value) {
    char text[tool::kFloatRoom];
    return {text, tool::writeShortest(text, value)};
}

std::string standardTextOf(float value) {
    char text[tool::kFloatRoom];
    return {text, std::to_chars(text, text + sizeof text, value).ptr};
}

float floatOf(std::uint32_t bits) { return std::bit_cast<float>(bits); }

TEST(FloatText, IsTheShortestThatReadsBack) {
    EXPECT_EQ(textOf(0.1F), "0.1");
    EXPECT_EQ(textOf(-33.333332F), "-33.333332");
    EXPECT_EQ(textOf(0.0F), "0");
    EXPECT_EQ(textOf(-0.0F), "-0");
    EXPECT_EQ(textOf(99999.0F), "99999");
    EXPECT_EQ(textOf(100000.0F), "1e+05");
    EXPECT_EQ(textOf(99999.99F), "99999.99");
    EXPECT_EQ(textOf(0.001F), "0.001");
    EXPECT_EQ(textOf(0.0005F), "5e-04");
}

TEST(FloatText, IsThatOfTheStandardLibraryAroundAllPowersOfTwoAndTen) {
    for (std::uint32_t exponent = 0; exponent < 255; ++exponent)
        for (std::uint32_t offset = 0; offset < 64; ++offset)
            for (const std::uint32_t bits : {(exponent << 23U) + offset, (exponent << 23U) - offset - 1}) {
                const float value = floatOf(bits & 0x7FFFFFFFU);
                ASSERT_EQ(textOf(-value), standardTextOf(-value));
            }
    for (int power = -6; power <= 8; ++power)
        for (int i = -1000; i <= 1000; ++i) {
            const auto middle = std::bit_cast<std::uint32_t>(static_cast<float>(std::pow(10.0, power)));
            const float value = floatOf(middle + static_cast<std::uint32_t>(i));
            ASSERT_EQ(textOf(value), standardTextOf(value));
        }
}

TEST(FloatText, IsThatOfTheStandardLibraryForDecimalsAndRandomNumbers) {
    for (int i = 0; i < 300'000; ++i)
        for (const double step : {1e-4, 1e-3, 0.01, 0.5, 1.0 / 3.0}) {
            const auto value = static_cast<float>(i * step);
            ASSERT_EQ(textOf(value), standardTextOf(value));
        }
    std::mt19937 random(3);
    for (int i = 0; i < 1'000'000; ++i) {
        const float value = floatOf(static_cast<std::uint32_t>(random()));
        ASSERT_EQ(textOf(value), standardTextOf(value));
        // In the range that is computed here: three of four floats are outside.
        const auto usual =
            static_cast<float>(std::ldexp(1.0 + static_cast<double>(random()) / 4294967296.0, i % 27 - 10));
        ASSERT_EQ(textOf(usual), standardTextOf(usual));
    }
}

} // namespace
