// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Aim.h"

#include <cmath>
#include <optional>

namespace Tarnell::Fbx::faithful {

namespace {

using fbxsdk::FbxAMatrix;
using fbxsdk::FbxVector4;

FbxVector4 minus(const FbxVector4& a, const FbxVector4& b) { return {a[0] - b[0], a[1] - b[1], a[2] - b[2]}; }

FbxVector4 crossProduct(const FbxVector4& a, const FbxVector4& b) {
    return {a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]};
}

double lengthOf(const FbxVector4& a) { return std::sqrt(a[0] * a[0] + a[1] * a[1] + a[2] * a[2]); }

/// Of unit length; nothing where there is none.
std::optional<FbxVector4> direction(const FbxVector4& a) {
    const double length = lengthOf(a);
    if (!(length > 1e-12) || !std::isfinite(length))
        return std::nullopt;
    return FbxVector4(a[0] / length, a[1] / length, a[2] / length);
}

/// The direction on the right of one that looks away from `back`: level where there is an up direction, else as the
/// camera has it.
std::optional<FbxVector4> rightOf(const FbxAMatrix& camera, const FbxVector4& up, const FbxVector4& back) {
    for (const FbxVector4& above : {up, camera.GetRow(1)})
        if (const std::optional<FbxVector4> right = direction(crossProduct(above, back)))
            return right;
    return direction(crossProduct(back, crossProduct(camera.GetRow(0), back)));
}

} // namespace

FbxAMatrix turnOf(const FbxVector4& angles) {
    FbxAMatrix turn;
    turn.SetR(angles);
    return turn;
}

FbxAMatrix aimed(const FbxAMatrix& camera, const FbxVector4& point, const FbxVector4& up, double roll) {
    const std::optional<FbxVector4> back = direction(minus(camera.GetT(), point));
    if (!back)
        return camera;
    const std::optional<FbxVector4> right = rightOf(camera, up, *back);
    if (!right)
        return camera;
    const FbxVector4 axes[3] = {*right, crossProduct(*back, *right), *back};
    FbxAMatrix turned;
    for (int axis = 0; axis < 3; ++axis)
        for (int component = 0; component < 3; ++component)
            turned[axis][component] = axes[axis][component];
    turned = turned * turnOf(FbxVector4(0.0, 0.0, -roll));
    FbxAMatrix matrix = camera;
    for (int axis = 0; axis < 3; ++axis) {
        const double size = lengthOf(camera.GetRow(axis));
        for (int component = 0; component < 3; ++component)
            matrix[axis][component] = turned[axis][component] * size;
    }
    return matrix;
}

} // namespace Tarnell::Fbx::faithful
