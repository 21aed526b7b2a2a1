// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Rotations in three representations: Euler angles of any order, three perpendicular axes, unit quaternion. Pure
// functions.
#pragma once

#include <array>

#include <fbxsdk/FbxAMatrix.h>
#include <fbxsdk/FbxEuler.h>
#include <fbxsdk/FbxQuaternion.h>
#include <fbxsdk/FbxVector4.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The images of the x, y and z axis: the upper left 3×3 part of an FbxAMatrix, axes[i] being row i.
using Axes = std::array<std::array<double, 3>, 3>;

struct SinCos {
    double sin;
    double cos;
};

/// Exact at every multiple of 90°, so that quarter turns leave no 6e-17 where a zero belongs.
[[nodiscard]] SinCos sinCosDegrees(double degrees);

/// The rotation of Euler angles in degrees; each angle is at the index of its own axis (x, y, z), whatever the order.
/// For order ABC the rotation about A comes first. Spheric XYZ, and a number that is no order, count as XYZ.
[[nodiscard]] Axes axesFromEuler(const FbxVector4& eulerDegrees, EFbxRotationOrder order);

/// The Euler angles, in degrees, of perpendicular axes; w = 1. When the middle angle is ±90°, the last one is 0.
[[nodiscard]] FbxVector4 eulerFromAxes(const Axes& axes, EFbxRotationOrder order);

/// Any quaternion but zero represents the rotation of its unit quaternion; zero represents the identity.
[[nodiscard]] Axes axesFromQuaternion(const FbxQuaternion& quaternion);
[[nodiscard]] FbxQuaternion quaternionFromAxes(const Axes& axes);

[[nodiscard]] FbxQuaternion quaternionFromEuler(const FbxVector4& eulerDegrees, EFbxRotationOrder order);
[[nodiscard]] FbxVector4 eulerFromQuaternion(const FbxQuaternion& quaternion, EFbxRotationOrder order);

/// From a (weight 0) to b (weight 1) on the shorter arc at constant speed. Both need length 1.
[[nodiscard]] FbxQuaternion slerp(const FbxQuaternion& a, const FbxQuaternion& b, double weight);

/// A matrix with this rotation, no translation and scale 1.
[[nodiscard]] FbxAMatrix rotationMatrix(const Axes& axes);
[[nodiscard]] FbxAMatrix rotationMatrix(const FbxVector4& eulerDegrees, EFbxRotationOrder order);

/// The rotation of a matrix in the angles of an order: FbxAMatrix::GetR for orders other than XYZ.
[[nodiscard]] FbxVector4 eulerFromMatrix(const FbxAMatrix& matrix, EFbxRotationOrder order);

/// The factors of a 3×3 part: unit axes and their scale.
struct AxesAndScale {
    Axes axes;
    std::array<double, 3> scale; ///< all three negative when the matrix mirrors
};

/// Axes of length zero are completed: one from the other two by the cross product, two or three from the coordinate
/// axes, made perpendicular to the existing ones. So the axes are never NaN for a finite matrix, and their scale is 0.
[[nodiscard]] AxesAndScale decompose(const FbxAMatrix& matrix);

} // namespace detail
FBXSDK_NAMESPACE_END
