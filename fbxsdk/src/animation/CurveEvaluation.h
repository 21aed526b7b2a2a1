// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The value of a keyed curve at any time: a pure function over plain arrays.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

#include "document/CurveKeys.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

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

/// The keys as files before 7.0 can hold them: tangents that they have no letter for, automatic ones that are clamped,
/// broken or biased, come out as the slopes that they have.
[[nodiscard]] CurveKeys legacyKeys(const CurveKeys& keys);

} // namespace detail
FBXSDK_NAMESPACE_END
