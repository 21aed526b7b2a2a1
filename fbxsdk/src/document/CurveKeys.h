// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The keys of a curve, as read, evaluated and written.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "schema/KeySpellings.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The indices of a key's numbers. "Right" belongs to the key itself, "next left" is the left side of the key after it.
namespace KeyData {
constexpr std::size_t rightSlope = 0;    ///< per second; auto tangent: bias in percent toward the right chord
constexpr std::size_t nextLeftSlope = 1; ///< per second; auto tangent: bias in percent toward the left chord
constexpr std::size_t tension = 0;       ///< of a TCB tangent
constexpr std::size_t continuity = 1;    ///< of a TCB tangent
constexpr std::size_t bias = 2;          ///< of a TCB tangent
constexpr std::size_t rightWeight = 2;   ///< fraction of the segment's length
constexpr std::size_t nextLeftWeight = 3;
constexpr std::size_t rightVelocity = 4; ///< stored for files, of no effect: slopes already contain it
constexpr std::size_t nextLeftVelocity = 5;
} // namespace KeyData

constexpr float kDefaultTangentWeight = 1.0F / 3.0F;

/// How a key leads to the next one. Many keys share one record.
struct KeyAttributes {
    std::uint32_t flags = KeyFlag::cubic | KeyFlag::tangentAuto;
    std::array<float, 6> data = {0.0F, 0.0F, kDefaultTangentWeight, kDefaultTangentWeight, 0.0F, 0.0F};

    bool operator==(const KeyAttributes&) const = default;
};

/// The extrapolation of a curve on one side of its keys.
struct Extrapolation {
    ExtrapolationType type = ExtrapolationType::constant;
    std::int32_t count = -1; ///< repetitions; 0: none, the end value holds; negative: endless

    bool operator==(const Extrapolation&) const = default;
};

/// A curve as plain arrays. `times` and `values` have one entry per key, `attributeOfKey` the key's index in
/// `attributes`; where that is missing or out of range, default attributes are used.
struct CurveKeys {
    static inline const KeyAttributes kDefaultAttributes;
    /// The index of the default attributes, which need no entry in the list.
    static constexpr std::uint32_t kDefault = 0xFFFFFFFF;

    std::vector<std::int64_t> times; ///< ticks, ascending; of several keys at one time the last is used
    std::vector<float> values;
    std::vector<KeyAttributes> attributes;
    std::vector<std::uint32_t> attributeOfKey;
    Extrapolation before;
    Extrapolation after;
    float defaultValue = 0.0F; ///< without keys

    /// Keys that have both a time and a value.
    [[nodiscard]] std::size_t keyCount() const { return times.size() < values.size() ? times.size() : values.size(); }
    [[nodiscard]] const KeyAttributes& attributesOf(std::size_t key) const {
        const std::size_t index = key < attributeOfKey.size() ? attributeOfKey[key] : attributes.size();
        return index < attributes.size() ? attributes[index] : kDefaultAttributes;
    }
    /// Gives a key these attributes, sharing them with the key before or the latest ones added when those are equal.
    /// The key must already have its entry in `attributeOfKey`.
    void setAttributes(std::size_t key, const KeyAttributes& keyAttributes);
};

} // namespace detail
FBXSDK_NAMESPACE_END
