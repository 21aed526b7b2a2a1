// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The value of a keyed curve at any time: a pure function over plain arrays.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The bits of a key's flags, as files store them (KeyAttrFlags).
namespace KeyFlag {
constexpr std::uint32_t constant = 0x2;
constexpr std::uint32_t linear = 0x4;
constexpr std::uint32_t cubic = 0x8;
constexpr std::uint32_t constantNext = 0x100; ///< with `constant`
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

/// The places of a key's numbers. "Right" belongs to the key itself, "next left" is the left side of the key after it.
namespace KeyData {
constexpr std::size_t rightSlope = 0;    ///< per second; auto tangent: bias in percent toward the right chord
constexpr std::size_t nextLeftSlope = 1; ///< per second; auto tangent: bias in percent toward the left chord
constexpr std::size_t tension = 0;       ///< of a TCB tangent
constexpr std::size_t continuity = 1;    ///< of a TCB tangent
constexpr std::size_t bias = 2;          ///< of a TCB tangent
constexpr std::size_t rightWeight = 2;   ///< part of the segment's length
constexpr std::size_t nextLeftWeight = 3;
constexpr std::size_t rightVelocity = 4; ///< kept for files, of no effect: slopes already contain it
constexpr std::size_t nextLeftVelocity = 5;
} // namespace KeyData

constexpr float kDefaultTangentWeight = 1.0F / 3.0F;

/// How a key leads to the next one. Many keys share one of these.
struct KeyAttributes {
    std::uint32_t flags = KeyFlag::cubic | KeyFlag::tangentAuto;
    std::array<float, 6> data = {0.0F, 0.0F, kDefaultTangentWeight, kDefaultTangentWeight, 0.0F, 0.0F};

    bool operator==(const KeyAttributes&) const = default;
};

enum class ExtrapolationType : std::uint8_t {
    constant = 1,
    repetition = 2,
    mirrorRepetition = 3,
    keepSlope = 4,
    relativeRepetition = 5
};

/// What a curve does on one side of its keys.
struct Extrapolation {
    ExtrapolationType type = ExtrapolationType::constant;
    std::int32_t count = -1; ///< repetitions; 0: none, the end value holds; below: without end

    bool operator==(const Extrapolation&) const = default;
};

/// A curve as plain arrays. `times` and `values` have one entry per key, `attributeOfKey` the key's index in
/// `attributes`; where that is missing or out of range, default attributes count.
struct CurveKeys {
    static inline const KeyAttributes kDefaultAttributes;
    /// The index of the default attributes, which need no place in the list.
    static constexpr std::uint32_t kDefault = 0xFFFFFFFF;

    std::vector<std::int64_t> times; ///< ticks, ascending; of several keys at one time the last counts
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
    /// The key must have its place in `attributeOfKey`.
    void setAttributes(std::size_t key, const KeyAttributes& keyAttributes);
};

/// A cubic segment as a Bézier curve, ready to be evaluated.
struct CubicSegment {
    static constexpr std::size_t kNone = static_cast<std::size_t>(-1);

    std::size_t key = kNone;           ///< where it begins
    double ticks = 0.0;                ///< its length
    double right = 0.0, left = 0.0;    ///< the weights of its two handles
    std::array<double, 4> values = {}; ///< of both ends, and between them of both handles
};

/// Where a curve was evaluated last. Samples mostly come in order of time and several to a segment: with a cursor each
/// costs the same, however many keys there are, and slopes are worked out once for all of a segment. To be forgotten
/// when the keys change.
struct CurveCursor {
    std::size_t segment = 0;
    CubicSegment cubic;
};

/// The value at a time. Any times, values and attributes give a value (NaN only where keys are NaN or infinite), also
/// unsorted times, though no sensible one. The cursor makes it faster and changes nothing else.
[[nodiscard]] float evaluate(const CurveKeys& keys, std::int64_t ticks, CurveCursor* cursor = nullptr);

/// The slope, per second, with which the curve leaves a key to the right, as its interpolation has it. The last key of
/// a curve has the tangent it would have if the curve went on. The key must exist.
[[nodiscard]] double rightSlope(const CurveKeys& keys, std::size_t key);
/// The slope, per second, with which the curve comes to a key from the left.
[[nodiscard]] double leftSlope(const CurveKeys& keys, std::size_t key);

/// Multiplies the whole curve by a factor, negative ones included: values, default value, and of the numbers kept with
/// the keys those that are slopes. An auto key whose slope does not follow the values (a bias beyond 500) becomes a
/// user key.
void multiplyValues(CurveKeys& keys, float factor);

} // namespace detail
FBXSDK_NAMESPACE_END
