// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The points of a mesh as its caches, blend shapes and skins leave them at a time.
#pragma once

#include "Scene.h"

#include <fbxsdk.h>

#include <vector>

namespace Tarnell::Fbx::faithful {

/// What the deformers of a mesh made of its points.
struct DeformedMesh {
    std::vector<fbxsdk::FbxVector4> points;
    /// Points of skins are in the world, others in the mesh's own space.
    bool inWorld = false;
    /// The points moved against each other: the normals stored in the file are no longer theirs.
    bool reshaped = false;
    /// The normals of the corners in the mesh's own space, where a cache has them.
    std::vector<fbxsdk::FbxVector4> normals;
    /// Whether skins turn the mesh inside out.
    bool mirrored = false;
};

/// The control points at a time. Caches that cannot be read are warned of.
DeformedMesh deformedPoints(Scene& scene, fbxsdk::FbxNode& node, fbxsdk::FbxMesh& mesh, const fbxsdk::FbxTime& time);

// Each of the three.

/// Replaces the points by those of the mesh's active cache; false when it has none that can be read.
bool applyPointCache(Scene& scene, fbxsdk::FbxNode& node, fbxsdk::FbxMesh& mesh, const fbxsdk::FbxTime& time,
                     std::vector<fbxsdk::FbxVector4>& points);
/// The normals of all corners from the mesh's active cache; none when it has none that can be read.
std::vector<fbxsdk::FbxVector4> cachedNormals(const fbxsdk::FbxMesh& mesh, const fbxsdk::FbxTime& time);
/// Whether any shape moved a point.
bool applyBlendShapes(fbxsdk::FbxMesh& mesh, const fbxsdk::FbxTime& time, std::vector<fbxsdk::FbxVector4>& points);
/// Moves the points into the world; false, and nothing changed, for a mesh without clusters.
bool applySkins(fbxsdk::FbxNode& node, fbxsdk::FbxMesh& mesh, const fbxsdk::FbxTime& time, DeformedMesh& deformed);

} // namespace Tarnell::Fbx::faithful
