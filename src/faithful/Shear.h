// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A shear as what nodes can say: no node skews, but one that turns below one that scales does.
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

/// The parts of the shear that a transform has with its skews, as near as can be to those of the basis given: that of
/// the frame before, so that they go on from frame to frame.
ShearParts partsOfShear(const Vector& skew, const fbxsdk::FbxAMatrix& nearBasis);

} // namespace Tarnell::Fbx::faithful
