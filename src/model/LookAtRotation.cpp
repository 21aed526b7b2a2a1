// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Look-at to Euler angles. Precision and grouping are part of the result, so every step states where it is double.
#include "LookAtRotation.h"

#include <cmath>

namespace Tarnell::Fbx::detail {

namespace {

constexpr double kRollPi = 3.1416; // kept: four decimals, so a roll of 30 reads back as 30.00007
constexpr double kDegreesPerRadian = 57.29577951308232;
constexpr float kHalfPi = 1.5707964f;
constexpr float kPoleTolerance = 1e-5f; // how close to vertical still counts as straight up or down

/// The final camera axes: its direction, its right-hand side and its up, all of unit length.
struct Axes {
    Vector3 forward, side, up;
};

Vector3 subtract(const Vector3& a, const Vector3& b) { return {a.x - b.x, a.y - b.y, a.z - b.z}; }

Vector3 rolled(const Vector3& up, const Vector3& side, float rollDegrees) {
    const double angle = static_cast<double>(rollDegrees) * kRollPi / 180.0;
    const float s = static_cast<float>(std::sin(angle));
    const float c = static_cast<float>(std::cos(angle));
    return normalized({c * up.x + s * side.x, c * up.y + s * side.y, c * up.z + s * side.z});
}

bool looksStraightUpOrDown(const Vector3& forward) { return std::fabs(std::fabs(forward.y) - 1.0f) < kPoleTolerance; }

/// At the poles yaw and roll are one rotation, which is assigned to the roll.
Vector3 anglesAtPole(const Axes& axes) {
    const bool up = std::fabs(1.0f - axes.forward.y) < kPoleTolerance;
    return {up ? kHalfPi : -kHalfPi, 0.0f, std::atan2(-axes.up.x, axes.side.x)};
}

Vector3 anglesAwayFromPole(const Axes& axes) {
    const Vector3& forward = axes.forward;
    const float horizontal = std::sqrt(forward.x * forward.x + forward.z * forward.z);
    const float k = horizontal != 0.0f ? 1.0f / horizontal : 0.0f;
    return {std::atan2(forward.y, horizontal), std::atan2(-forward.x * k, -forward.z * k),
            std::atan2(axes.side.y * k, axes.up.y * k)};
}

float toDegrees(float radians) { return static_cast<float>(static_cast<double>(radians) * kDegreesPerRadian); }

} // namespace

Vector3 normalized(const Vector3& v) {
    const float length = std::sqrt(v.x * v.x + v.y * v.y + v.z * v.z);
    if (length == 0.0f || std::isnan(length))
        return v;
    return {v.x / length, v.y / length, v.z / length};
}

Vector3 cross(const Vector3& a, const Vector3& b) {
    return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
}

LookAtRotation rotationFromLookAt(const Vector3& position, const Vector3& lookAt, const Vector3& up,
                                  float rollDegrees) {
    const Vector3 direction = subtract(lookAt, position);
    const Vector3 forward = normalized(direction);

    const Vector3 side = normalized(cross(forward, up));
    const Vector3 orthogonalUp = normalized(cross(side, forward));
    const Vector3 rolledUp = rolled(orthogonalUp, side, rollDegrees);

    const Vector3 rolledSide = normalized(cross(forward, rolledUp));
    const Axes axes{forward, rolledSide, normalized(cross(rolledSide, forward))};
    const Vector3 angles = looksStraightUpOrDown(forward) ? anglesAtPole(axes) : anglesAwayFromPole(axes);
    return {direction, rolledUp, {toDegrees(angles.x), toDegrees(angles.y), toDegrees(angles.z)}};
}

} // namespace Tarnell::Fbx::detail
