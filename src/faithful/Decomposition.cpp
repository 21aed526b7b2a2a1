// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Decomposition.h"

#include <cmath>

namespace Tarnell::Fbx::faithful {

namespace {

using Matrix = fbxsdk::FbxAMatrix;

constexpr double kDegrees = 57.295779513082320877;
constexpr double kSmallestSkew = 1e-9; // less is rounding
constexpr double kGimbalCosine = 1e-7;
constexpr double kSameRotation = 1e-9;

double dot(const Vector& a, const Vector& b) { return a[0] * b[0] + a[1] * b[1] + a[2] * b[2]; }

Vector cross(const Vector& a, const Vector& b) {
    return {a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]};
}

Vector scaled(const Vector& a, double factor) { return {a[0] * factor, a[1] * factor, a[2] * factor}; }

/// a + b · factor
Vector plus(const Vector& a, const Vector& b, double factor) {
    return {a[0] + b[0] * factor, a[1] + b[1] * factor, a[2] + b[2] * factor};
}

double length(const Vector& a) { return std::sqrt(dot(a, a)); }

Vector axisOf(const Matrix& matrix, int axis) {
    return {matrix.Get(axis, 0), matrix.Get(axis, 1), matrix.Get(axis, 2)};
}

/// A unit vector perpendicular to a unit vector.
Vector perpendicularTo(const Vector& a) {
    const Vector other = std::fabs(a[0]) < 0.6 ? Vector{1.0, 0.0, 0.0} : Vector{0.0, 1.0, 0.0};
    const Vector across = cross(a, other);
    return scaled(across, 1.0 / length(across));
}

/// The first, second and third axis of a rotation, where `known` states whether they have a direction.
void completeAxes(std::array<Vector, 3>& axes, std::array<bool, 3> known) {
    for (std::size_t i = 0; i < 3; ++i) {
        const Vector& next = axes[(i + 1) % 3];
        const Vector& last = axes[(i + 2) % 3];
        if (!known[i] && known[(i + 1) % 3] && known[(i + 2) % 3]) {
            axes[i] = cross(next, last);
            return;
        }
    }
    for (std::size_t i = 0; i < 3; ++i) {
        if (known[i] && !known[(i + 1) % 3] && !known[(i + 2) % 3]) {
            axes[(i + 1) % 3] = perpendicularTo(axes[i]);
            axes[(i + 2) % 3] = cross(axes[i], axes[(i + 1) % 3]);
            return;
        }
    }
    if (!known[0])
        axes = {Vector{1.0, 0.0, 0.0}, Vector{0.0, 1.0, 0.0}, Vector{0.0, 0.0, 1.0}};
}

/// The axes of an order, in turn, and +1 where they are in the cyclic order of X, Y and Z.
struct OrderAxes {
    int first, second, third;
    double sign;
};

OrderAxes axesOf(RotationOrder order) {
    switch (order) {
    case TnFbxTransform::kFbxRotationOrderXYZ:
        return {0, 1, 2, 1.0};
    case TnFbxTransform::kFbxRotationOrderXZY:
        return {0, 2, 1, -1.0};
    case TnFbxTransform::kFbxRotationOrderYXZ:
        return {1, 0, 2, -1.0};
    case TnFbxTransform::kFbxRotationOrderYZX:
        return {1, 2, 0, 1.0};
    case TnFbxTransform::kFbxRotationOrderZXY:
        return {2, 0, 1, 1.0};
    case TnFbxTransform::kFbxRotationOrderZYX:
        return {2, 1, 0, -1.0};
    }
    return {2, 0, 1, 1.0};
}

Matrix turnAbout(int axis, double degrees) {
    fbxsdk::FbxVector4 angles(0.0, 0.0, 0.0);
    angles[axis] = degrees;
    Matrix matrix;
    matrix.SetR(angles);
    return matrix;
}

double nearestTurn(double angle, double other) { return angle + 360.0 * std::round((other - angle) / 360.0); }

double distance(const Vector& a, const Vector& b) {
    return std::fabs(a[0] - b[0]) + std::fabs(a[1] - b[1]) + std::fabs(a[2] - b[2]);
}

Vector nearestTurns(const Vector& angles, const Vector& near) {
    return {nearestTurn(angles[0], near[0]), nearestTurn(angles[1], near[1]), nearestTurn(angles[2], near[2])};
}

} // namespace

double handedness(const Matrix& matrix) {
    const double determinant = dot(cross(axisOf(matrix, 0), axisOf(matrix, 1)), axisOf(matrix, 2));
    return determinant > 0.0 ? 1.0 : determinant < 0.0 ? -1.0 : 0.0;
}

Parts decompose(const Matrix& matrix, const Vector& signs) {
    Vector sign = {signs[0] < 0.0 ? -1.0 : 1.0, signs[1] < 0.0 ? -1.0 : 1.0, signs[2] < 0.0 ? -1.0 : 1.0};
    const double hand = handedness(matrix);
    if (hand * sign[0] * sign[1] * sign[2] < 0.0)
        sign[0] = -sign[0];
    Parts parts;
    parts.position = axisOf(matrix, 3);
    const std::array<Vector, 3> axes = {axisOf(matrix, 0), axisOf(matrix, 1), axisOf(matrix, 2)};
    std::array<Vector, 3> unit{};
    std::array<bool, 3> known{};
    std::array<std::array<double, 3>, 3> along{}; // of the later axis on the earlier one
    for (std::size_t i = 0; i < 3; ++i) {
        Vector rest = axes[i];
        for (std::size_t j = 0; j < i; ++j) {
            along[i][j] = dot(axes[i], unit[j]);
            rest = plus(rest, unit[j], -along[i][j]);
        }
        const double size = length(rest);
        known[i] = size > 1e-12 * length(axes[i]) && size > 0.0;
        parts.scale[i] = known[i] ? size * sign[i] : 0.0;
        unit[i] = known[i] ? scaled(rest, sign[i] / size) : Vector{};
    }
    const auto skew = [&](std::size_t axis, std::size_t other) {
        const double value = known[axis] ? along[axis][other] / parts.scale[axis] : 0.0;
        return std::fabs(value) < kSmallestSkew ? 0.0 : value;
    };
    parts.skew = {skew(1, 0), skew(2, 0), skew(2, 1)};
    completeAxes(unit, known);
    for (int axis = 0; axis < 3; ++axis)
        for (int component = 0; component < 3; ++component)
            parts.rotation[axis][component] = unit[static_cast<std::size_t>(axis)][static_cast<std::size_t>(component)];
    return parts;
}

Matrix rotationOf(const Vector& angles, RotationOrder order) {
    const OrderAxes axes = axesOf(order);
    const auto turn = [&](int axis) { return turnAbout(axis, angles[static_cast<std::size_t>(axis)]); };
    return turn(axes.third) * turn(axes.second) * turn(axes.first);
}

Vector anglesNear(const Matrix& rotation, RotationOrder order, const Vector& near) {
    const auto [i, j, k, sign] = axesOf(order);
    const auto first = static_cast<std::size_t>(i);
    const auto second = static_cast<std::size_t>(j);
    const auto third = static_cast<std::size_t>(k);
    const auto at = [](const Matrix& matrix, int row, int column) { return matrix.Get(column, row); };

    const double sine = -sign * at(rotation, k, i);
    const double cosine = std::hypot(at(rotation, i, i), at(rotation, j, i));
    Vector angles{};
    angles[second] = std::atan2(sine, cosine) * kDegrees;
    if (cosine < kGimbalCosine) { // the first and the third rotate about the same axis: the first stays unchanged
        angles[first] = near[first];
        const Matrix rest = rotation * turnAbout(i, -near[first]);
        angles[third] = std::atan2(-sign * at(rest, i, j), at(rest, j, j)) * kDegrees;
        return nearestTurns(angles, near);
    }
    angles[first] = std::atan2(sign * at(rotation, k, j), at(rotation, k, k)) * kDegrees;
    angles[third] = std::atan2(sign * at(rotation, j, i), at(rotation, i, i)) * kDegrees;
    Vector other{};
    other[first] = angles[first] + 180.0;
    other[second] = 180.0 - angles[second];
    other[third] = angles[third] + 180.0;
    const Vector a = nearestTurns(angles, near);
    const Vector b = nearestTurns(other, near);
    return distance(b, near) + 1e-9 < distance(a, near) ? b : a;
}

bool turnsLike(const Matrix& rotation, const Parts& parts) {
    for (int axis = 0; axis < 3; ++axis) {
        if (parts.scale[static_cast<std::size_t>(axis)] == 0.0)
            continue;
        for (int component = 0; component < 3; ++component)
            if (!(std::fabs(rotation.Get(axis, component) - parts.rotation.Get(axis, component)) < kSameRotation))
                return false;
    }
    return true;
}

fbxsdk::FbxVector4 transformedNormal(const Matrix& matrix, const fbxsdk::FbxVector4& normal) {
    const Vector x = axisOf(matrix, 0);
    const Vector y = axisOf(matrix, 1);
    const Vector z = axisOf(matrix, 2);
    Vector sum = plus(plus(scaled(cross(y, z), normal[0]), cross(z, x), normal[1]), cross(x, y), normal[2]);
    const double size = length(sum);
    if (!(size > 0.0))
        return {0.0, 0.0, 0.0, normal[3]};
    sum = scaled(sum, (handedness(matrix) < 0.0 ? -1.0 : 1.0) / size);
    return {sum[0], sum[1], sum[2], normal[3]};
}

} // namespace Tarnell::Fbx::faithful
