// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of an aim (position, look-at point, up vector and roll) to Euler angles in single-precision arithmetic.
#pragma once

namespace Tarnell::Fbx::detail {

struct Vector3 {
    float x, y, z;
};

/// The vector at unit length; unchanged when its length is zero or NaN.
Vector3 normalized(const Vector3& v);

/// a × b.
Vector3 cross(const Vector3& a, const Vector3& b);

struct LookAtRotation {
    Vector3 direction;     ///< From the position to the look-at point, not normalised.
    Vector3 up;            ///< Orthogonal to the direction, after the roll, of unit length.
    Vector3 anglesDegrees; ///< To be applied in the order Z, X, Y. All zero looks along −Z with +Y up.
};

LookAtRotation rotationFromLookAt(const Vector3& position, const Vector3& lookAt, const Vector3& up, float rollDegrees);

} // namespace Tarnell::Fbx::detail
