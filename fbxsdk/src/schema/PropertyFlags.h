// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How files spell the flags of a property: letters, and the locked and muted components as numbers behind theirs.
//
//     A+U     animatable, animated, user-defined
//     AL4M1   animatable, Z locked, X muted
#pragma once

#include <array>
#include <string>
#include <string_view>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The letters of single flags. The index in the table is the bit of FbxPropertyFlags::EFlags; 0 has no letter.
inline constexpr std::array<char, 6> kFlagLetters = {0, 'A', '+', 0, 'U', 'H'};

inline constexpr char kUserFlagLetter = kFlagLetters[4];

/// The flags that exist once for each component: the bit of the first one.
struct ComponentFlagRow {
    char letter;
    unsigned firstBit;
};
inline constexpr ComponentFlagRow kComponentFlags[] = {{'L', 7}, {'M', 11}};
inline constexpr unsigned kComponentMask = 0xF;

/// Before 7.0: the property is one of the node attribute, which has no record of its own there.
inline constexpr char kAttributeFlagLetter = 'N';

/// The bits of FbxPropertyFlags::EFlags that a file states. Letters without a meaning are ignored.
[[nodiscard]] unsigned propertyFlags(std::string_view text);

/// The letters of the flags that files state.
[[nodiscard]] std::string propertyFlagText(unsigned flags);

} // namespace detail
FBXSDK_NAMESPACE_END
