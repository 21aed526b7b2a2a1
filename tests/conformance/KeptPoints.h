// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The deliberate behaviours of the library for meshes, computed from the scene's data alone.
#pragma once

#include "LoadedFile.h"
#include "Matrices.h"

#include <set>
#include <vector>

namespace conformance {

/// The control points that a skin moves. They are in the world then, all others in the mesh's own space.
std::set<int> skinnedPoints(fbxsdk::FbxMesh& mesh);

/// The control points of a mesh with blend shapes at a time. Kept: a percentage multiplies the whole offset to the
/// target.
std::vector<Point> blendedPoints(fbxsdk::FbxMesh& mesh, const fbxsdk::FbxAnimStack* stack, const fbxsdk::FbxTime& time);

/// The values of a mesh's corners.
struct CornerContent {
    bool normals = false, uvs = false, colours = false;

    bool operator==(const CornerContent&) const = default;
};

/// The values that are read. Kept: of the first layer by control point or polygon vertex, and with colours of
/// materials where there are none of vertices.
CornerContent readContent(fbxsdk::FbxMesh& mesh, const CornerContent& has);

} // namespace conformance
