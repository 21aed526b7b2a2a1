// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How files spell the keys of curves: the bits of their flags, and the letters of the extrapolation. In
// files before 7.0 letters represent the flags, too.
#pragma once

#include <cstddef>
#include <cstdint>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The bits of a key's flags, as files store them (KeyAttrFlags).
namespace KeyFlag {
constexpr std::uint32_t constant = 0x2;
constexpr std::uint32_t linear = 0x4;
constexpr std::uint32_t cubic = 0x8;
constexpr std::uint32_t constantNext = 0x100; ///< with `constant`: the value of the next key is held
constexpr std::uint32_t tangentAuto = 0x100;  ///< with `cubic`
constexpr std::uint32_t tangentTcb = 0x200;
constexpr std::uint32_t tangentUser = 0x400;
constexpr std::uint32_t genericBreak = 0x800;
constexpr std::uint32_t genericClamp = 0x1000;
constexpr std::uint32_t genericTimeIndependent = 0x2000;
constexpr std::uint32_t genericClampProgressive = 0x4000;
constexpr std::uint32_t weightedRight = 0x1000000;
constexpr std::uint32_t weightedNextLeft = 0x2000000;
constexpr std::uint32_t velocityRight = 0x10000000;
constexpr std::uint32_t velocityNextLeft = 0x20000000;
} // namespace KeyFlag

/// Weights and velocities are stored as whole numbers of this unit.
inline constexpr float kPackedUnit = 9999.0F;
/// The number of words that hold the numbers of a key.
inline constexpr std::size_t kWordsPerAttribute = 4;

enum class ExtrapolationType : std::uint8_t {
    constant = 1,
    repetition = 2,
    mirrorRepetition = 3,
    keepSlope = 4,
    relativeRepetition = 5
};

struct ExtrapolationRow {
    char letter;
    ExtrapolationType type;
};
inline constexpr ExtrapolationRow kExtrapolations[] = {{'C', ExtrapolationType::constant},
                                                       {'R', ExtrapolationType::repetition},
                                                       {'M', ExtrapolationType::mirrorRepetition},
                                                       {'K', ExtrapolationType::keepSlope},
                                                       {'A', ExtrapolationType::relativeRepetition}};

// Before 7.0: time, value, the letter of the interpolation, and what that needs.
inline constexpr char kLegacyLinear = 'L', kLegacyConstant = 'C', kLegacyCubic = 'U';
/// After kLegacyConstant: whether the value of this key is held, or that of the next.
inline constexpr char kLegacyConstantThis = 's', kLegacyConstantNext = 'n';

/// After kLegacyCubic: the tangent's letter.
struct LegacyTangentRow {
    char letter;
    std::uint32_t flags;
    std::size_t numbers; ///< how many numbers follow …
    bool kept;           ///< … and whether they are the first of the key's; automatic tangents are recomputed
};
inline constexpr LegacyTangentRow kLegacyTangents[] = {
    {'s', KeyFlag::tangentUser, 2, true},                                     // right slope, left slope of the next key
    {'b', KeyFlag::tangentUser | KeyFlag::genericBreak, 2, true},             // the same, broken
    {'a', KeyFlag::tangentAuto, 0, false},                                    //
    {'p', KeyFlag::tangentAuto | KeyFlag::genericClampProgressive, 2, false}, // slopes
    {'q', KeyFlag::tangentAuto | KeyFlag::genericClamp, 2, false},            // slopes
    {'t', KeyFlag::tangentTcb, 3, true},                                      // tension, continuity, bias
    {'d', KeyFlag::tangentAuto | KeyFlag::genericBreak, 1, false},            // a slope
};

/// After the tangent: which weights follow, the right one first.
struct LegacyWeightRow {
    char letter;
    std::uint32_t flags;
};
inline constexpr LegacyWeightRow kLegacyWeights[] = {
    {'n', 0},
    {'a', KeyFlag::weightedRight | KeyFlag::weightedNextLeft},
    {'r', KeyFlag::weightedRight},
    {'l', KeyFlag::weightedNextLeft},
    {'c', 0},
};

} // namespace detail
FBXSDK_NAMESPACE_END
