// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A matrix as position, rotation, scale and skew, and a rotation as angles in any order.
#pragma once

#include "TnFbxTransform.h"

#include <fbxsdk.h>

#include <array>

namespace Tarnell::Fbx::faithful {

using Vector = std::array<double, 3>;
using RotationOrder = TnFbxTransform::EFbxTransformRotationOrder;

/// Matrix = T · R · H · S, the rightmost first. H adds to X `skew[0]` of Y and `skew[1]` of Z, and to Y `skew[2]` of Z.
struct Parts {
    Vector position{};
    fbxsdk::FbxAMatrix rotation; // nothing else
    Vector scale{};
    Vector skew{};
};

/// The parts of an affine matrix. `signs` states which axes are scaled by a negative number; where they do not mirror
/// as the matrix does, the sign of X is reversed. An axis of no length is taken perpendicular to the others.
Parts decompose(const fbxsdk::FbxAMatrix& matrix, const Vector& signs);

/// The rotation by these angles, in degrees.
fbxsdk::FbxAMatrix rotationOf(const Vector& angles, RotationOrder order);

/// Of all angles, in degrees, that give the rotation, those nearest to `near`.
Vector anglesNear(const fbxsdk::FbxAMatrix& rotation, RotationOrder order, const Vector& near);

/// Whether a rotation is that of the parts, up to rounding: an axis without scale may be anywhere.
bool turnsLike(const fbxsdk::FbxAMatrix& rotation, const Parts& parts);

/// The sign of a matrix's determinant: −1 where it mirrors, 0 where it flattens.
double handedness(const fbxsdk::FbxAMatrix& matrix);

/// The image of a normal under a matrix: of unit length, or zero where its surface is flattened to a line.
fbxsdk::FbxVector4 transformedNormal(const fbxsdk::FbxAMatrix& matrix, const fbxsdk::FbxVector4& normal);

} // namespace Tarnell::Fbx::faithful
