// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Arithmetic with the matrices of references, independent of the platform's.
#pragma once

#include "Reference.h"

#include <array>

namespace conformance {

using Point = std::array<double, 3>;

/// The point, moved by the matrix.
Point moved(const Matrix12& matrix, const Point& point);
/// The matrix that applies `inner` first, then `outer`.
Matrix12 product(const Matrix12& outer, const Matrix12& inner);
/// Without an inverse, as for a scale of zero: nothing.
std::optional<Matrix12> inverse(const Matrix12& matrix);

/// A rotation about X, then Y, then Z, in degrees.
Matrix12 turned(const Point& degrees);
Matrix12 scaled(const Point& factors);
Matrix12 shifted(const Point& offset);

/// Axes are compared by the size of the axes, the translation by its own.
bool sameMatrix(const Matrix12& actual, const Matrix12& expected, double tolerance);

} // namespace conformance
