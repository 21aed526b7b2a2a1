// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Where converted objects stand and how they are turned. The library hands out angles in the order of its
// decompositions, and cameras by their local values; what is written hangs below the root and is turned in one order.
#pragma once

#include "TnFbxCamera.h"

#include <fbxsdk.h>

namespace tool {

/// Gives the camera the place and direction that its node has in the world, at every frame of the range: rotations in
/// the order XYZ, such that it looks along the same line once it is written with the post-rotation of cameras.
void placeCamera(Tarnell::Fbx::TnFbxCamera& camera, FbxNode& node, const Tarnell::Fbx::TnFbxTime& range);

/// Puts rotations that were read in the world into the order XYZ. Angles go on from frame to frame without a jump, so
/// that what lies between two frames lies between their angles.
void expressInXyz(Tarnell::Fbx::TnFbxTransform& object);

} // namespace tool
