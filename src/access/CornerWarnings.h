// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What the platform repaired in a mesh's polygons, for `lastWarnings()`.
#pragma once

#include "ObjectWarnings.h"

#include <fbxsdk.h>

#include <string>

namespace Tarnell::Fbx::detail {

/// Only the bundled platform counts them; corners from another platform are returned unchanged.
template <class Mesh>
void noteRepairedCorners(const std::string& fileName, const fbxsdk::FbxNode& node, const Mesh& mesh,
                         ObjectWarnings& warnings) {
    if constexpr (requires { mesh.GetRepairedCornerCount(); }) {
        if (mesh.GetRepairedCornerCount() > 0) {
            const bool hasPoints = mesh.GetControlPointsCount() > 0;
            const std::string file = fileName.empty() ? "" : fileName + ": ";
            warnings.add(file + '"' + node.GetName() + '"',
                         hasPoints
                             ? "polygons refer to control points that do not exist; control point 0 is read instead"
                             : "polygons refer to control points, but the mesh has none; the polygons are left out");
        }
    }
}

} // namespace Tarnell::Fbx::detail
