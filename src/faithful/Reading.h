// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The entry points of faithful reads for the facade, and the readers of single nodes.
#pragma once

#include "Scene.h"

#include "TnFbxCamera.h"
#include "TnFbxLight.h"
#include "TnFbxMarker.h"
#include "TnFbxMesh.h"
#include "TnFbxNull.h"
#include "TnFbxReadInfo.h"
#include "TnFbxTransform.h"

namespace Tarnell::Fbx::faithful {

/// Reads all nodes of a kind, or the first of the name, into an array that the caller owns; null for none. After a
/// failure, whose reason is noted, there may be one as well.
template <class Object>
bool readObjects(const TnFbxReadInfo& info, Object** objects, int& count);

/// The same of a scene that is loaded.
template <class Object>
bool readObjects(Scene& scene, const TnFbxReadInfo& info, Object** objects, int& count);

/// Replaces surfaces by meshes, and warns of those that cannot be converted.
void triangulateSurfaces(Scene& scene);

extern template bool readObjects(const TnFbxReadInfo&, TnFbxMesh**, int&);
extern template bool readObjects(const TnFbxReadInfo&, TnFbxCamera**, int&);
extern template bool readObjects(const TnFbxReadInfo&, TnFbxLight**, int&);
extern template bool readObjects(const TnFbxReadInfo&, TnFbxMarker**, int&);
extern template bool readObjects(const TnFbxReadInfo&, TnFbxNull**, int&);
extern template bool readObjects(const TnFbxReadInfo&, TnFbxTransform**, int&);

// One node, which must be of the kind, into a new object. False, with the reason noted, when there is not enough
// memory or the node is damaged.
bool readNode(Scene& scene, const TnFbxReadInfo& info, fbxsdk::FbxNode& node, TnFbxMesh& mesh);
bool readNode(Scene& scene, const TnFbxReadInfo& info, fbxsdk::FbxNode& node, TnFbxCamera& camera);
bool readNode(Scene& scene, const TnFbxReadInfo& info, fbxsdk::FbxNode& node, TnFbxLight& light);
bool readNode(Scene& scene, const TnFbxReadInfo& info, fbxsdk::FbxNode& node, TnFbxMarker& marker);
bool readNode(Scene& scene, const TnFbxReadInfo& info, fbxsdk::FbxNode& node, TnFbxNull& null);
bool readNode(Scene& scene, const TnFbxReadInfo& info, fbxsdk::FbxNode& node, TnFbxTransform& transform);

/// The points of a mesh at the scene's frame as one more set of an object that was read from the node.
bool addPoints(Scene& scene, const TnFbxReadInfo& info, fbxsdk::FbxNode& node, TnFbxMesh& mesh);

} // namespace Tarnell::Fbx::faithful
