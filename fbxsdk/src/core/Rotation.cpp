// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Rotations in three representations. The conversions between angles and axes are written once, for a first, a middle
// and a last axis; orders whose axes are not cyclic (XZY, YXZ, ZYX) are the mirror image, with all angles negated. The
// extraction follows Shoemake, "Euler angle conversion", Graphics Gems IV.
#include "core/Rotation.h"

#include <algorithm>
#include <cfloat>
#include <cmath>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

using Vector3 = std::array<double, 3>;

struct OrderRow {
    EFbxRotationOrder order;
    size_t first;
    size_t middle;
    size_t last;
    double sign; ///< +1 when first, middle, last are x, y, z in cyclic order
};

constexpr OrderRow kOrders[] = {
    {FbxEuler::eOrderXYZ, 0, 1, 2, 1.0},        {FbxEuler::eOrderXZY, 0, 2, 1, -1.0},
    {FbxEuler::eOrderYZX, 1, 2, 0, 1.0},        {FbxEuler::eOrderYXZ, 1, 0, 2, -1.0},
    {FbxEuler::eOrderZXY, 2, 0, 1, 1.0},        {FbxEuler::eOrderZYX, 2, 1, 0, -1.0},
    {FbxEuler::eOrderSphericXYZ, 0, 1, 2, 1.0}, // evaluated like XYZ
};

constexpr bool inEnumeratorOrder() {
    for (int i = 0; i < static_cast<int>(std::size(kOrders)); ++i)
        if (kOrders[i].order != i)
            return false;
    return true;
}
static_assert(inEnumeratorOrder());

const OrderRow& rowOf(EFbxRotationOrder order) {
    const auto index = static_cast<size_t>(order); // numbers from files may be anything
    return index < std::size(kOrders) ? kOrders[index] : kOrders[0];
}

/// Below this cosine of the middle angle the first and the last axis are treated as parallel.
constexpr double kGimbalThreshold = 16.0 * FLT_EPSILON;

/// A smaller length is treated as zero: dividing by it would leave the range of doubles.
constexpr double kSmallestLength = DBL_MIN;

/// Two unit axes whose cross product is shorter are parallel.
constexpr double kParallel = 1.0e-12;

inline double dot(const Vector3& a, const Vector3& b) { return a[0] * b[0] + a[1] * b[1] + a[2] * b[2]; }

inline Vector3 cross(const Vector3& a, const Vector3& b) {
    return {a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]};
}

inline double length(const Vector3& v) {
    const double square = dot(v, v);
    // the plain sum is exact enough as long as the squares stay within the range of doubles
    const bool safe = square > 1.0e-280 && square < 1.0e280;
    return safe ? std::sqrt(square) : std::hypot(v[0], v[1], v[2]);
}

inline Vector3 divided(const Vector3& v, double divisor) { return {v[0] / divisor, v[1] / divisor, v[2] / divisor}; }

Vector3 coordinateAxis(size_t i) { return {i == 0 ? 1.0 : 0.0, i == 1 ? 1.0 : 0.0, i == 2 ? 1.0 : 0.0}; }

/// The coordinate axis i without its part along a unit vector; the next coordinate axis when nothing is left.
Vector3 perpendicularAxis(size_t i, const Vector3& unit) {
    Vector3 axis = coordinateAxis(i);
    if (std::abs(dot(axis, unit)) > 1.0 - kParallel)
        axis = coordinateAxis((i + 1) % 3);
    const double along = dot(axis, unit);
    const Vector3 rest = {axis[0] - along * unit[0], axis[1] - along * unit[1], axis[2] - along * unit[2]};
    return divided(rest, length(rest));
}

/// Completes the axes that are marked as missing.
void completeAxes(Axes& axes, std::array<bool, 3> missing) {
    for (size_t i = 0; i < 3; ++i) {
        const size_t j = (i + 1) % 3;
        const size_t k = (i + 2) % 3;
        if (missing[i] && !missing[j] && !missing[k]) {
            const Vector3 normal = cross(axes[j], axes[k]);
            if (length(normal) > kParallel) {
                axes[i] = divided(normal, length(normal));
                return;
            }
            missing[k] = true; // parallel: one of the two is redundant
        }
    }
    for (size_t i = 0; i < 3; ++i) {
        const size_t j = (i + 1) % 3;
        const size_t k = (i + 2) % 3;
        if (!missing[i] && missing[j] && missing[k]) {
            axes[j] = perpendicularAxis(j, axes[i]);
            axes[k] = cross(axes[i], axes[j]);
            return;
        }
    }
    if (missing[0] && missing[1] && missing[2])
        axes = {coordinateAxis(0), coordinateAxis(1), coordinateAxis(2)};
}

/// A number of right angles, and what is left, in -45 to 45 degrees; exact but for the sign of a zero, as std::remquo.
struct RightAngles {
    int count; ///< its lower bits at least
    double rest;
};

RightAngles rightAnglesIn(double degrees) {
    constexpr double kMost = 1.0e9; // further out the product is not exact, or the count does not fit an int
    if (!(std::abs(degrees) < kMost)) {
        int count = 0;
        const double rest = std::remquo(degrees, 90.0, &count);
        return {count, rest};
    }
    // Adding and subtracting a number too large for fractions rounds to the nearest whole number, halves to even ones.
    constexpr double kNoFractions = 6755399441055744.0; // 3 · 2⁵¹
    double count = degrees / 90.0 + kNoFractions - kNoFractions;
    double rest = degrees - count * 90.0;
    if (std::abs(rest) > 45.0) { // the quotient was rounded to a half
        count += std::copysign(1.0, rest);
        rest = degrees - count * 90.0;
    }
    return {static_cast<int>(count), rest};
}

} // namespace

SinCos sinCosDegrees(double degrees) {
    if (degrees == 0.0)
        return {degrees, 1.0}; // as the following gives it, too; most angles of a scene are none
    const auto [quadrant, rest] = rightAnglesIn(degrees);
    const double radians = rest * FBXSDK_PI_DIV_180;
    const double s = std::sin(radians);
    const double c = std::cos(radians);
    // a zero sine has the sign of the angle, a zero cosine none: then atan2 returns ±180 with the sign of the input
    const auto sine = [degrees](double value) { return value == 0.0 ? std::copysign(0.0, degrees) : value; };
    switch (static_cast<unsigned>(quadrant) & 3U) {
    case 0:
        return {sine(s), c};
    case 1:
        return {c, 0.0 - s};
    case 2:
        return {sine(-s), -c};
    default:
        return {-c, s + 0.0};
    }
}

Axes axesFromEuler(const FbxVector4& eulerDegrees, EFbxRotationOrder order) {
    const auto& [name, a, b, c, sign] = rowOf(order);
    const auto [sa, ca] = sinCosDegrees(sign * eulerDegrees.mData[a]);
    const auto [sb, cb] = sinCosDegrees(sign * eulerDegrees.mData[b]);
    const auto [sc, cc] = sinCosDegrees(sign * eulerDegrees.mData[c]);

    Axes axes;
    axes[a][a] = cb * cc;
    axes[a][b] = cb * sc;
    axes[a][c] = 0.0 - sb;
    axes[b][a] = sa * sb * cc - ca * sc;
    axes[b][b] = sa * sb * sc + ca * cc;
    axes[b][c] = sa * cb;
    axes[c][a] = ca * sb * cc + sa * sc;
    axes[c][b] = ca * sb * sc - sa * cc;
    axes[c][c] = ca * cb;
    return axes;
}

FbxVector4 eulerFromAxes(const Axes& axes, EFbxRotationOrder order) {
    const auto& [name, a, b, c, sign] = rowOf(order);
    const double cosine = std::sqrt(axes[a][a] * axes[a][a] + axes[a][b] * axes[a][b]);
    const bool regular = cosine > kGimbalThreshold;

    FbxVector4 radians;
    radians.mData[a] = regular ? std::atan2(axes[b][c], axes[c][c]) : std::atan2(-axes[c][b], axes[b][b]);
    radians.mData[b] = std::atan2(-axes[a][c], cosine);
    radians.mData[c] = regular ? std::atan2(axes[a][b], axes[a][a]) : 0.0;
    const double factor = sign * FBXSDK_180_DIV_PI;
    const auto degrees = [factor](double angle) { return angle * factor + 0.0; }; // no negative zeros
    return {degrees(radians.mData[0]), degrees(radians.mData[1]), degrees(radians.mData[2])};
}

Axes axesFromQuaternion(const FbxQuaternion& quaternion) {
    const double square = quaternion.DotProduct(quaternion);
    if (!(square > kSmallestLength))
        return {coordinateAxis(0), coordinateAxis(1), coordinateAxis(2)};
    const auto& [x, y, z, w] = quaternion.mData;
    const double s = 2.0 / square;
    return {{{1.0 - s * (y * y + z * z), s * (x * y + w * z), s * (x * z - w * y)},
             {s * (x * y - w * z), 1.0 - s * (x * x + z * z), s * (y * z + w * x)},
             {s * (x * z + w * y), s * (y * z - w * x), 1.0 - s * (x * x + y * y)}}};
}

FbxQuaternion quaternionFromAxes(const Axes& axes) {
    const double trace = axes[0][0] + axes[1][1] + axes[2][2];
    if (trace > 0.0) {
        const double s = 2.0 * std::sqrt(trace + 1.0);
        return {(axes[1][2] - axes[2][1]) / s, (axes[2][0] - axes[0][2]) / s, (axes[0][1] - axes[1][0]) / s, s / 4.0};
    }
    // divide by the largest component, which is at least a half
    size_t i = axes[1][1] > axes[0][0] ? 1 : 0;
    if (axes[2][2] > axes[i][i])
        i = 2;
    const size_t j = (i + 1) % 3;
    const size_t k = (i + 2) % 3;
    const double s = 2.0 * std::sqrt(std::max(0.0, 1.0 + axes[i][i] - axes[j][j] - axes[k][k]));
    if (!(s > 0.0))
        return {};
    FbxQuaternion result;
    result.mData[i] = s / 4.0;
    result.mData[j] = (axes[i][j] + axes[j][i]) / s;
    result.mData[k] = (axes[i][k] + axes[k][i]) / s;
    result.mData[3] = (axes[j][k] - axes[k][j]) / s;
    return result;
}

FbxQuaternion quaternionFromEuler(const FbxVector4& eulerDegrees, EFbxRotationOrder order) {
    return quaternionFromAxes(axesFromEuler(eulerDegrees, order));
}

FbxVector4 eulerFromQuaternion(const FbxQuaternion& quaternion, EFbxRotationOrder order) {
    return eulerFromAxes(axesFromQuaternion(quaternion), order);
}

FbxQuaternion slerp(const FbxQuaternion& a, const FbxQuaternion& b, double weight) {
    const FbxQuaternion target = a.DotProduct(b) < 0.0 ? -b : b;
    // half the chord and its counterpart give the angle to full precision, at both ends of its range
    const double angle = 2.0 * std::atan2((target - a).Length(), (target + a).Length());
    const double sine = std::sin(angle);
    if (!(sine > kParallel))
        return a * (1.0 - weight) + target * weight;
    return a * (std::sin((1.0 - weight) * angle) / sine) + target * (std::sin(weight * angle) / sine);
}

FbxAMatrix rotationMatrix(const Axes& axes) {
    FbxAMatrix matrix;
    for (size_t i = 0; i < 3; ++i)
        for (size_t j = 0; j < 3; ++j)
            matrix.mData[i].mData[j] = axes[i][j];
    return matrix;
}

FbxAMatrix rotationMatrix(const FbxVector4& eulerDegrees, EFbxRotationOrder order) {
    return rotationMatrix(axesFromEuler(eulerDegrees, order));
}

FbxVector4 eulerFromMatrix(const FbxAMatrix& matrix, EFbxRotationOrder order) {
    return eulerFromAxes(decompose(matrix).axes, order);
}

AxesAndScale decompose(const FbxAMatrix& matrix) {
    AxesAndScale result;
    std::array<bool, 3> missing;
    for (size_t i = 0; i < 3; ++i) {
        const double* row = matrix.mData[i].mData;
        result.axes[i] = {row[0], row[1], row[2]};
        result.scale[i] = length(result.axes[i]);
        missing[i] = result.scale[i] < kSmallestLength;
        if (!missing[i])
            result.axes[i] = divided(result.axes[i], result.scale[i]);
    }

    if (missing[0] || missing[1] || missing[2]) {
        completeAxes(result.axes, missing);
    } else if (dot(cross(result.axes[0], result.axes[1]), result.axes[2]) < 0.0) {
        for (size_t i = 0; i < 3; ++i) {
            result.scale[i] = -result.scale[i];
            result.axes[i] = divided(result.axes[i], -1.0);
        }
    }
    return result;
}

} // namespace detail
FBXSDK_NAMESPACE_END
