// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A shear in terms of nodes: no node skews, but a rotated one below a scaled one does.
#pragma once

#include "Decomposition.h"

#include <fbxsdk.h>

namespace Tarnell::Fbx::faithful {

/// H = turn · stretch · basisᵀ, where `turn` and `basis` are rotations.
struct ShearParts {
    fbxsdk::FbxAMatrix turn;
    Vector stretch{};
    fbxsdk::FbxAMatrix basis;
};

/// The parts of the shear that a transform has by its skews, as close as possible to those of the basis given: that of
/// the frame before, so that they are continuous from frame to frame.
ShearParts partsOfShear(const Vector& skew, const fbxsdk::FbxAMatrix& nearBasis);

} // namespace Tarnell::Fbx::faithful
