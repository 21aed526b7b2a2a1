// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The two decompositions, directly from their definitions.
#include "Placement.h"

#include <cmath>

namespace conformance {
namespace {

constexpr double kDegrees = 57.295779513082320877;

using Rows = std::array<Point, 3>;

Rows rowsOf(const Matrix12& m) { return {{{m[0], m[1], m[2]}, {m[3], m[4], m[5]}, {m[6], m[7], m[8]}}}; }

double determinant(const Rows& r) {
    return r[0][0] * (r[1][1] * r[2][2] - r[1][2] * r[2][1]) - r[0][1] * (r[1][0] * r[2][2] - r[1][2] * r[2][0]) +
           r[0][2] * (r[1][0] * r[2][1] - r[1][1] * r[2][0]);
}

/// All negative when the axes are mirrored.
Point signedLengths(const Rows& rows) {
    const double sign = determinant(rows) < 0 ? -1.0 : 1.0;
    Point lengths{};
    for (std::size_t i = 0; i < lengths.size(); ++i)
        lengths[i] = sign * std::hypot(rows[i][0], rows[i][1], rows[i][2]);
    return lengths;
}

Point translationOf(const Matrix12& m) { return {m[9], m[10], m[11]}; }

} // namespace

Matrix12 rebuilt(const Placement& placement) {
    return product(shifted(placement.position), product(turned(placement.rotation), scaled(placement.scale)));
}

Placement placementBesideOrigin(const Matrix12& matrix) {
    Rows n = rowsOf(matrix);
    const Point lengths = signedLengths(n);
    for (std::size_t i = 0; i < n.size(); ++i)
        for (double& number : n[i])
            number /= lengths[i];
    constexpr double kGimbalLock = 16 * 1.1920929e-7;
    const double root = std::hypot(n[0][0], n[0][1]);
    const double y = std::atan2(-n[0][2], root);
    const bool locked = root <= kGimbalLock;
    const double x = locked ? std::atan2(-n[2][1], n[1][1]) : std::atan2(n[1][2], n[2][2]);
    const double z = locked ? 0.0 : std::atan2(n[0][1], n[0][0]);
    return {translationOf(matrix), {x * kDegrees, y * kDegrees, z * kDegrees}, lengths};
}

Placement placementAtOrigin(const Matrix12& matrix) {
    const auto m = [&](std::size_t row, std::size_t column) { return static_cast<float>(matrix[3 * row + column]); };
    constexpr float kTolerance = 1e-5f;
    const float s = m(2, 1);
    float x = 0, y = 0, z = 0;
    if (std::fabs(std::fabs(s) - 1.0f) < kTolerance) {
        x = std::copysign(static_cast<float>(90.0 / kDegrees), -s);
        z = std::atan2(-m(1, 0), m(0, 0));
    } else {
        const float h = std::sqrt(m(2, 2) * m(2, 2) + m(2, 0) * m(2, 0));
        const float factor = h > kTolerance ? 1.0f / h : h;
        x = std::atan2(-s, h);
        y = std::atan2(m(2, 0) * factor, m(2, 2) * factor);
        z = std::atan2(m(0, 1) * factor, m(1, 1) * factor);
    }
    return {translationOf(matrix),
            {static_cast<double>(x) * kDegrees, static_cast<double>(y) * kDegrees, static_cast<double>(z) * kDegrees},
            signedLengths(rowsOf(matrix))};
}

Matrix12 handedOut(const Matrix12& matrix, bool atOrigin) {
    if (atOrigin)
        return rebuilt(placementAtOrigin(matrix));
    const Point lengths = signedLengths(rowsOf(matrix));
    if (lengths[0] * lengths[1] * lengths[2] == 0)
        return matrix; // an axis without length has no direction to compare
    return rebuilt(placementBesideOrigin(matrix));
}

} // namespace conformance
