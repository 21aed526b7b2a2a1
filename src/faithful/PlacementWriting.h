// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Position, rotation, scale and skew of an object as its node has them.
#pragma once

#include "WrittenScene.h"

#include "TnFbxTransform.h"

#include <fbxsdk.h>

#include <array>

namespace Tarnell::Fbx::faithful {

/// The axes of a kind of node relative to those of its objects.
struct NodeAxes {
    const fbxsdk::FbxVector4* turn;       ///< null: they are the same
    std::array<std::size_t, 3> scaleFrom; ///< the object's axis that each axis of the node is
};
extern const NodeAxes kSameAxes, kCameraAxes, kLightAxes;

/// A new node of the object's name with the object's placement. A skewed one is below another node, named
/// after it, which scales it along rotated axes.
fbxsdk::FbxNode& addPlacedNode(WrittenScene& scene, TnFbxTransform& object, const NodeAxes& axes);

/// The object at a frame: T · R · H · S.
fbxsdk::FbxAMatrix matrixAt(const KeyWriter& keys, TnFbxTransform& object, std::int64_t frame, const FrameRange& range);
/// The same with its static values.
fbxsdk::FbxAMatrix staticMatrixOf(const TnFbxTransform& object);

/// Consecutive channels of an object.
Channels3 channelsFrom(TnFbxTransform& object, TnFbxTransform::EFbxTransformChannelType first);

} // namespace Tarnell::Fbx::faithful
