// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The value of a keyed curve at any time: a pure function over plain arrays.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

#include <fbxsdk/FbxTime.h>

#include "document/CurveKeys.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A cubic segment as a Bézier curve, ready to be evaluated.
struct CubicSegment {
    static constexpr std::size_t kNone = static_cast<std::size_t>(-1);

    std::size_t key = kNone;           ///< the key at its start
    double ticks = 0.0;                ///< its length
    double right = 0.0, left = 0.0;    ///< the weights of its two handles
    std::array<double, 4> values = {}; ///< of both ends, and between them of both handles
};

/// The place of a curve's last evaluation. Samples usually come in order of time and several to a segment: with a
/// cursor each takes the same time, however many keys there are, and slopes are computed once per segment. To be
/// discarded when the keys change.
struct CurveCursor {
    std::size_t segment = 0;
    CubicSegment cubic;
};

/// The value at a time. Any times, values and attributes give a value (NaN only where keys are NaN or infinite), also
/// unsorted times, though no meaningful one. The cursor makes it faster and has no other effect.
[[nodiscard]] float evaluate(const CurveKeys& keys, std::int64_t ticks, CurveCursor* cursor = nullptr);

/// The values at many times, each the same as `evaluate` gives.
void evaluate(const CurveKeys& keys, const FbxTime* times, int count, float* values);

/// The slope, per second, with which the curve leaves a key to the right, by its interpolation. The last key of
/// a curve has the tangent it would have if the curve continued. The key must exist.
[[nodiscard]] double rightSlope(const CurveKeys& keys, std::size_t key);
/// The slope, per second, with which the curve reaches a key from the left.
[[nodiscard]] double leftSlope(const CurveKeys& keys, std::size_t key);

/// Multiplies the whole curve by a factor, negative ones included: values, default value, and of the numbers kept with
/// the keys those that are slopes. An auto key whose slope does not follow the values (a bias beyond 500) becomes a
/// user key.
void multiplyValues(CurveKeys& keys, float factor);

/// The keys as files before 7.0 can hold them: tangents without a letter in them, automatic ones that are clamped,
/// broken or biased, are converted to slopes.
[[nodiscard]] CurveKeys legacyKeys(const CurveKeys& keys);

} // namespace detail
FBXSDK_NAMESPACE_END
