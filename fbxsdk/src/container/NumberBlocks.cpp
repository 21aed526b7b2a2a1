// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The bytes of a block become sets of bits, one for each kind of character; the grammar of a number is checked for all
// 64 at once. In order of appearance: each comma, point and exponent follows a digit, each sign a comma, blank or
// exponent, each blank a comma or blank, and in one number no point follows a point or an exponent, and no exponent an
// exponent.
#include "container/NumberBlocks.h"

#ifdef __SSE2__
#include <bit>

#include <emmintrin.h>
#endif

FBXSDK_NAMESPACE_BEGIN
namespace detail {

#ifdef __SSE2__

namespace {

constexpr int kBlockSize = 64;

/// Bit i is set where byte i is of that kind.
struct Kinds {
    std::uint64_t digit = 0, comma = 0, point = 0, sign = 0, exponent = 0, blank = 0;

    [[nodiscard]] std::uint64_t other() const { return ~(digit | comma | point | sign | exponent | blank); }
};

std::uint64_t bitsOf(__m128i bytes, int part) {
    return static_cast<std::uint64_t>(static_cast<unsigned>(_mm_movemask_epi8(bytes))) << (16 * part);
}

__m128i partOf(const char* block, int part) {
    return _mm_loadu_si128(static_cast<const __m128i*>(static_cast<const void*>(block)) + part);
}

__m128i equal(__m128i bytes, char c) { return _mm_cmpeq_epi8(bytes, _mm_set1_epi8(c)); }

std::uint64_t blanksOf(const char* block) {
    std::uint64_t blanks = 0;
    for (int part = 0; part < kBlockSize / 16; ++part) {
        const __m128i bytes = partOf(block, part);
        blanks |= bitsOf(_mm_or_si128(_mm_or_si128(equal(bytes, ' '), equal(bytes, '\t')),
                                      _mm_or_si128(equal(bytes, '\r'), equal(bytes, '\n'))),
                         part);
    }
    return blanks;
}

Kinds kindsOf(const char* block) {
    Kinds kinds;
    for (int part = 0; part < kBlockSize / 16; ++part) {
        const __m128i bytes = partOf(block, part);
        const __m128i value = _mm_sub_epi8(bytes, _mm_set1_epi8('0'));
        kinds.digit |= bitsOf(_mm_cmpeq_epi8(_mm_min_epu8(value, _mm_set1_epi8(9)), value), part);
        kinds.comma |= bitsOf(equal(bytes, ','), part);
        kinds.point |= bitsOf(equal(bytes, '.'), part);
        kinds.sign |= bitsOf(_mm_or_si128(equal(bytes, '-'), equal(bytes, '+')), part);
        kinds.exponent |= bitsOf(_mm_or_si128(equal(bytes, 'e'), equal(bytes, 'E')), part);
    }
    if (kinds.other() != 0) // a line has many blocks
        kinds.blank = blanksOf(block);
    return kinds;
}

/// What the last byte of a block, or the last mark in it, means for the next one: 0 or 1 each.
struct Before {
    std::uint64_t digit = 0, gap = 1, exponent = 0; ///< the last byte; a gap is a comma or blank
    std::uint64_t pastPoint = 0, pastExponent = 0;  ///< the last point or exponent of a number that has not ended
};

std::uint64_t shifted(std::uint64_t bits, std::uint64_t before) { return bits << 1 | before; }

/// The next of the marks after each of some of them. `open` tells whether one came before the block, and afterwards
/// whether one has none in it.
std::uint64_t nextMarks(std::uint64_t of, std::uint64_t marks, std::uint64_t& open) {
    // Adding the bit behind a mark to the bits between marks carries it to the next mark.
    const std::uint64_t behind = shifted(of, open);
    const std::uint64_t sum = behind + ~marks;
    const bool overflows = sum < behind;
    open = overflows ? 1 : of >> (kBlockSize - 1);
    return sum & marks;
}

/// Bytes that may not be where they are. What follows the first of them does not count.
std::uint64_t misplaced(const Kinds& kinds, Before& before) {
    const std::uint64_t gap = kinds.comma | kinds.blank;
    const std::uint64_t marks = kinds.point | kinds.exponent | kinds.comma;
    const std::uint64_t afterDigit = shifted(kinds.digit, before.digit);
    const std::uint64_t afterGap = shifted(gap, before.gap);
    const std::uint64_t afterExponent = shifted(kinds.exponent, before.exponent);
    const std::uint64_t afterPointMark = nextMarks(kinds.point, marks, before.pastPoint);
    const std::uint64_t afterExponentMark = nextMarks(kinds.exponent, marks, before.pastExponent);
    before.digit = kinds.digit >> (kBlockSize - 1);
    before.gap = gap >> (kBlockSize - 1);
    before.exponent = kinds.exponent >> (kBlockSize - 1);
    return kinds.other() | (marks & ~afterDigit) | (kinds.sign & ~(afterGap | afterExponent)) |
           (kinds.blank & ~afterGap) | (afterPointMark & kinds.point) |
           (afterExponentMark & (kinds.point | kinds.exponent));
}

} // namespace

NumberBlocks skipNumberBlocks(const char* text, const char* stop) {
    NumberBlocks numbers;
    Before before;
    std::uint64_t wrong = 0;
    for (; wrong == 0 && stop - text >= kBlockSize; text += kBlockSize) {
        const Kinds kinds = kindsOf(text);
        wrong = misplaced(kinds, before);
        const std::uint64_t commas = kinds.comma & (wrong == 0 ? ~std::uint64_t{0} : (wrong & (0 - wrong)) - 1);
        if (commas != 0) {
            numbers.count += static_cast<std::uint64_t>(std::popcount(commas));
            numbers.lastComma = text + (kBlockSize - 1 - std::countl_zero(commas));
        }
    }
    return numbers;
}

#else

NumberBlocks skipNumberBlocks(const char*, const char*) { return {}; }

#endif

} // namespace detail
FBXSDK_NAMESPACE_END
