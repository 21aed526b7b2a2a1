// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How far two numbers may be apart and still count as equal, each with the reason for its size.
#pragma once

#include <algorithm>
#include <cmath>

namespace conformance {

/// References print nine significant digits.
constexpr double kStoredTolerance = 1e-8;
/// The same for whole numbers, which are exact up to a hundred million then.
constexpr double kCountTolerance = 5e-9;
/// Curve values are floats (6e-8), and a channel is in degrees: a turn of 360° is off by 4e-7 radians, which the levers
/// of a dozen nested nodes multiply.
constexpr double kEvaluatedTolerance = 1e-5;
/// The library returns floats of such values.
constexpr double kHandedOutTolerance = 1e-5;
/// A tick is 2.2e-11 s; older files count time in coarser steps, and references print nine digits.
constexpr double kSecondsTolerance = 1e-7;

/// Equal within `tolerance` of the larger of 1 and `scale`. A number that is not finite in the reference must not be
/// finite here.
inline bool closeTo(double actual, double expected, double tolerance, double scale) {
    if (!std::isfinite(expected))
        return !std::isfinite(actual);
    return std::abs(actual - expected) <= tolerance * std::max(1.0, scale);
}

inline bool closeTo(double actual, double expected, double tolerance) {
    return closeTo(actual, expected, tolerance, std::abs(expected));
}

} // namespace conformance
