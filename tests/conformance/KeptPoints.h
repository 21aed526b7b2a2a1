// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What the library does with a mesh in a way of its own, and hosts rely on, worked out from the scene's data alone.
#pragma once

#include "LoadedFile.h"
#include "Matrices.h"

#include <set>
#include <vector>

namespace conformance {

/// The control points that a skin moves. They stand in the world then, all others in the mesh's own space.
std::set<int> skinnedPoints(fbxsdk::FbxMesh& mesh);

/// The control points of a mesh with blend shapes at a time. Kept: a percentage multiplies the whole way to the target.
std::vector<Point> blendedPoints(fbxsdk::FbxMesh& mesh, const fbxsdk::FbxAnimStack* stack, const fbxsdk::FbxTime& time);

/// What the corners of a mesh come with.
struct CornerContent {
    bool normals = false, uvs = false, colours = false;

    bool operator==(const CornerContent&) const = default;
};

/// What is read of what the mesh has. Kept: of the first layer by control point or polygon vertex, and with colours of
/// materials where there are none of vertices.
CornerContent readContent(fbxsdk::FbxMesh& mesh, const CornerContent& has);

} // namespace conformance
