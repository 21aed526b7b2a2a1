// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The position and orientation of a node, as the channels of a transform.
#pragma once

#include "Decomposition.h"
#include "Scene.h"

#include "TnFbxTransform.h"

#include <fbxsdk.h>

#include <functional>
#include <span>

namespace Tarnell::Fbx::faithful {

/// The node's global matrix, without its geometric offset.
fbxsdk::FbxAMatrix worldMatrix(fbxsdk::FbxNode& node, const fbxsdk::FbxTime& time);

/// The global matrix of the node's parent; the identity below the root.
fbxsdk::FbxAMatrix parentMatrix(fbxsdk::FbxNode& node, const fbxsdk::FbxTime& time);

/// The node's matrix relative to its parent.
fbxsdk::FbxAMatrix localMatrix(fbxsdk::FbxNode& node, const fbxsdk::FbxTime& time);

/// The offset between the node and its geometry.
fbxsdk::FbxAMatrix geometricMatrix(const fbxsdk::FbxNode& node);

/// One matrix for each time.
using MatricesAt = std::function<void(std::span<const fbxsdk::FbxTime> times, fbxsdk::FbxAMatrix* matrices)>;

/// The matrix to decompose, and hints for choosing among equivalent decompositions.
struct Placement {
    fbxsdk::FbxNode& node;
    MatricesAt matricesAt;
    bool moves;
    bool ownAngles; ///< the node's own angles are tried first
    bool nearOwn;   ///< others are chosen close to them
};

/// The placement of a node: in the world, or relative to its parent.
Placement placementOf(Scene& scene, fbxsdk::FbxNode& node, bool global);

/// The same matrices, and before them a rotation.
MatricesAt rotatedFirst(MatricesAt matricesAt, const fbxsdk::FbxAMatrix& turn);

/// Fills position, rotation, scale and skew, and sets the order: that of the node, where it is used. Angles are
/// continuous from frame to frame. False, with the reason noted, when there is not enough memory for the samples.
bool readPlacement(Scene& scene, const Placement& placement, TnFbxTransform& object);

} // namespace Tarnell::Fbx::faithful
