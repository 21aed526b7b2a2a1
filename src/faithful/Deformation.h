// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The points of a mesh after its caches, blend shapes and skins at a time.
#pragma once

#include "Scene.h"

#include <fbxsdk.h>

#include <vector>

namespace Tarnell::Fbx::faithful {

/// The result of a mesh's deformers for its points.
struct DeformedMesh {
    std::vector<fbxsdk::FbxVector4> points;
    /// Points of skins are in the world, others in the mesh's own space.
    bool inWorld = false;
    /// The points moved relative to each other: the normals stored in the file are no longer valid.
    bool reshaped = false;
    /// The normals of the corners in the mesh's own space, where a cache has them.
    std::vector<fbxsdk::FbxVector4> normals;
    /// Whether skins turn the mesh inside out.
    bool mirrored = false;
};

/// The control points at a time. Unreadable caches cause a warning.
DeformedMesh deformedPoints(Scene& scene, fbxsdk::FbxNode& node, fbxsdk::FbxMesh& mesh, const fbxsdk::FbxTime& time);

// Each of the three.

/// Replaces the points by those of the mesh's active cache; false when it has no readable one.
bool applyPointCache(Scene& scene, fbxsdk::FbxNode& node, fbxsdk::FbxMesh& mesh, const fbxsdk::FbxTime& time,
                     std::vector<fbxsdk::FbxVector4>& points);
/// The normals of all corners from the mesh's active cache; none when it has no readable one.
std::vector<fbxsdk::FbxVector4> cachedNormals(const fbxsdk::FbxMesh& mesh, const fbxsdk::FbxTime& time);
/// Whether any shape moved a point.
bool applyBlendShapes(fbxsdk::FbxMesh& mesh, const fbxsdk::FbxTime& time, std::vector<fbxsdk::FbxVector4>& points);
/// Moves the points to the world; false, and nothing changed, for a mesh without clusters.
bool applySkins(fbxsdk::FbxNode& node, fbxsdk::FbxMesh& mesh, const fbxsdk::FbxTime& time, DeformedMesh& deformed);

} // namespace Tarnell::Fbx::faithful
