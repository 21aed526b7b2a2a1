// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Where converted objects stand and how they are turned. The library hands out angles in the order of its
// decompositions, and cameras by their local values; what is written hangs below the root and is turned in one order.
#pragma once

#include <vector>

#include "FbxSdk.h"
#include "TnFbxCamera.h"
#include "TnFbxMesh.h"

#include <fbxsdk.h>

namespace tool {

/// Gives the camera the place and direction that its node has in the world, at every frame of the range: rotations in
/// the order XYZ, such that it looks along the same line once it is written with the post-rotation of cameras.
void placeCamera(Tarnell::Fbx::TnFbxCamera& camera, FbxNode& node, const Tarnell::Fbx::TnFbxTime& range);

/// The points of a mesh at one frame, added to it as a set of their own.
///
/// The library leaves a node's geometric offset out in the world, and takes skinned points, which it has in the world
/// already, through the node's transform again. Here each point is where the file's application shows it: in the world,
/// or with `local` in the space of the node's parent. Point caches must be open.
class MeshPlacement {
public:
    MeshPlacement(Tarnell::Fbx::FbxSdk& sdk, bool local) : mSdk(sdk), mLocal(local) {}

    /// Replaces the points and turns the normals of a mesh that was read without its transform.
    void place(Tarnell::Fbx::TnFbxMesh& mesh, FbxNode& node, FbxTime time) const;
    void addPoints(Tarnell::Fbx::TnFbxMesh& mesh, FbxNode& node, FbxTime time) const;

private:
    FbxAMatrix placeOf(FbxNode& node, FbxTime time) const;
    std::vector<FbxVector4> pointsOf(FbxNode& node, FbxTime time) const;

    Tarnell::Fbx::FbxSdk& mSdk;
    bool mLocal;
};

/// The moment of a frame at the rate of the range.
FbxTime timeAt(const Tarnell::Fbx::TnFbxTime& range, long long frame);

/// Puts rotations that were read in the world into the order XYZ. Angles go on from frame to frame without a jump, so
/// that what lies between two frames lies between their angles.
void expressInXyz(Tarnell::Fbx::TnFbxTransform& object);

} // namespace tool
