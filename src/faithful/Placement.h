// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Where a node is and how it is turned, as the channels of a transform.
#pragma once

#include "Decomposition.h"
#include "Scene.h"

#include "TnFbxTransform.h"

#include <fbxsdk.h>

#include <functional>

namespace Tarnell::Fbx::faithful {

/// The node in the world, without its geometric offset.
fbxsdk::FbxAMatrix worldMatrix(fbxsdk::FbxNode& node, const fbxsdk::FbxTime& time);

/// The world of the node's parent; the identity below the root.
fbxsdk::FbxAMatrix parentMatrix(fbxsdk::FbxNode& node, const fbxsdk::FbxTime& time);

/// The node as seen from its parent.
fbxsdk::FbxAMatrix localMatrix(fbxsdk::FbxNode& node, const fbxsdk::FbxTime& time);

/// The offset between the node and its geometry.
fbxsdk::FbxAMatrix geometricMatrix(const fbxsdk::FbxNode& node);

/// What is decomposed, and what helps to choose among decompositions that are alike.
struct Placement {
    fbxsdk::FbxNode& node;
    std::function<fbxsdk::FbxAMatrix(const fbxsdk::FbxTime&)> matrixAt;
    bool moves;
    bool ownAngles; ///< the node's own angles are tried first
    bool nearOwn;   ///< others begin near to them
};

/// The placement of a node as it is: in the world, or from its parent.
Placement placementOf(Scene& scene, fbxsdk::FbxNode& node, bool global);

/// Fills position, rotation, scale and skew, and sets the order: that of the node, where it is in force. Angles go on
/// from frame to frame. False, with the reason noted, when there is no room for the samples.
bool readPlacement(Scene& scene, const Placement& placement, TnFbxTransform& object);

} // namespace Tarnell::Fbx::faithful
