// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curves of files before 7.x: a channel record with one flat list of keys.
#pragma once

#include <optional>

#include "document/DocumentBuilder.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

// Bits of DocumentCurve::Attribute::flags.
inline constexpr std::uint32_t kKeyConstant = 0x2;
inline constexpr std::uint32_t kKeyLinear = 0x4;
inline constexpr std::uint32_t kKeyCubic = 0x8;
inline constexpr std::uint32_t kKeyAuto = 0x100;         ///< a tangent mode of cubic keys
inline constexpr std::uint32_t kKeyConstantNext = 0x100; ///< of constant keys: the value of the next key holds
inline constexpr std::uint32_t kKeyTcb = 0x200;
inline constexpr std::uint32_t kKeyUser = 0x400;
inline constexpr std::uint32_t kKeyBreak = 0x800;
inline constexpr std::uint32_t kKeyClamp = 0x1000;
inline constexpr std::uint32_t kKeyClampProgressive = 0x4000;
inline constexpr std::uint32_t kKeyWeightedRight = 0x1000000;
inline constexpr std::uint32_t kKeyWeightedNextLeft = 0x2000000;
inline constexpr std::uint32_t kKeyVelocityRight = 0x10000000;
inline constexpr std::uint32_t kKeyVelocityNextLeft = 0x20000000;

/// The curve of a channel; none when it has no keys or its key list does not add up (then with a warning).
[[nodiscard]] std::optional<DocumentCurve> readLegacyCurve(DocumentBuilder& builder, const Record& channel);

/// Reads the extrapolation block of that name; constant when there is none.
[[nodiscard]] DocumentCurve::Extrapolation readExtrapolation(const Record& owner, std::string_view name);

/// Puts the keys in order of time; of keys at the same time the one that stands last stays.
void sortKeys(DocumentCurve& curve);

/// Appends the index of an attribute, which becomes a new one unless it equals the last.
void appendAttribute(DocumentCurve& curve, const DocumentCurve::Attribute& attribute);

} // namespace detail
FBXSDK_NAMESPACE_END
