// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Numbers of everyday size have an exact product with a power of ten as a double: the nearest whole number to it is the
// number's digits, as long as it lies within half a unit in the last place of the float.
#include "FloatText.h"

#include <array>
#include <bit>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstring>

namespace tool {
namespace {

constexpr int kMantissaBits = 23;
constexpr int kMostDecimals = 10; // of numbers from 0.001 on
constexpr std::array<double, kMostDecimals + 1> kPowersOfTen = {1, 1e1, 1e2, 1e3, 1e4, 1e5, 1e6, 1e7, 1e8, 1e9, 1e10};

constexpr std::array<char, 200> kPairs = [] {
    std::array<char, 200> pairs{};
    for (std::size_t i = 0; i < 100; ++i) {
        pairs[2 * i] = static_cast<char>('0' + i / 10);
        pairs[2 * i + 1] = static_cast<char>('0' + i % 10);
    }
    return pairs;
}();

void writePair(char* to, std::uint32_t number) { std::memcpy(to, &kPairs[std::size_t{2} * number], 2); }

/// Of positive numbers below 2⁵¹; halves to even ones.
double nearestWhole(double value) {
    constexpr double kNoFractions = 6755399441055744.0; // 3 · 2⁵¹
    return value + kNoFractions - kNoFractions;
}

double powerOfTwo(int exponent) {
    constexpr int kBias = 1023, kFractionBits = 52;
    return std::bit_cast<double>(static_cast<std::uint64_t>(exponent + kBias) << kFractionBits);
}

/// A positive float that is no power of two, so that its two neighbours are equally far.
class Decimal {
public:
    Decimal(double value, int exponent, bool isEven)
        : mValue(value), mHalfUnit(powerOfTwo(exponent - kMantissaBits - 1)), mIsEven(isEven),
          mDecimals((kMantissaBits - exponent) * 1233 / 4096 + 1) { // a unit is at least one in the last decimal
        mDigits = nearestWhole(mValue * kPowersOfTen[static_cast<std::size_t>(mDecimals)]);
        while (mDecimals > 0 && shorten()) {
        }
    }

    [[nodiscard]] std::uint32_t digits() const { return static_cast<std::uint32_t>(mDigits); }
    [[nodiscard]] int decimals() const { return mDecimals; }

private:
    /// Removes a decimal if the rest still reads back as the number.
    bool shorten() {
        const double power = kPowersOfTen[static_cast<std::size_t>(mDecimals) - 1];
        const double exact = mValue * power;
        const double digits = nearestWhole(exact);
        const double distance = std::abs(digits - exact);
        if (distance > mHalfUnit * power || (distance == mHalfUnit * power && !mIsEven))
            return false;
        mDigits = digits;
        --mDecimals;
        return true;
    }

    double mValue, mHalfUnit;
    bool mIsEven; ///< numbers halfway to a neighbour read back as the even one
    int mDecimals;
    double mDigits;
};

/// Numbers with decimals, less than 100,000.
char* write(char* to, const Decimal& decimal, std::uint32_t whole) {
    constexpr std::size_t kDigits = 16;
    char digits[2 * kDigits] = "000000";
    const std::uint32_t lower = decimal.digits() % 100'000'000;
    writePair(digits + 6, decimal.digits() / 100'000'000);
    writePair(digits + 8, lower / 1'000'000);
    writePair(digits + 10, lower / 10'000 % 100);
    writePair(digits + 12, lower / 100 % 100);
    writePair(digits + 14, lower % 100);

    const int before = 1 + (whole >= 10) + (whole >= 100) + (whole >= 1000) + (whole >= 10'000);
    const char* const point = digits + kDigits - decimal.decimals();
    std::memcpy(to, point - before, 8); // of constant length: that is one instruction
    to += before;
    *to++ = '.';
    std::memcpy(to, point, kDigits);
    return to + decimal.decimals();
}

} // namespace

char* writeShortest(char* first, float value) {
    constexpr float kLeast = 0.001F, kMost = 99999.0F; // outside exponents may be shorter
    const float size = std::abs(value);
    const auto bits = std::bit_cast<std::uint32_t>(size);
    if (!(size <= kMost))
        return std::to_chars(first, first + kFloatRoom, value).ptr;
    const auto whole = static_cast<std::uint32_t>(size);
    const bool isWhole = static_cast<float>(whole) == size;
    const bool isPowerOfTwo = (bits & ((1U << kMantissaBits) - 1)) == 0;
    if (!isWhole && (size < kLeast || isPowerOfTwo))
        return std::to_chars(first, first + kFloatRoom, value).ptr;
    if (std::signbit(value))
        *first++ = '-';
    if (isWhole)
        return std::to_chars(first, first + kFloatRoom, whole).ptr;
    const int exponent = static_cast<int>(bits >> kMantissaBits) - 127;
    return write(first, Decimal(static_cast<double>(size), exponent, bits % 2 == 0), whole);
}

} // namespace tool
