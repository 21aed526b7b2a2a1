// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes for drawing in a report: triangles, limited to what a page can hold.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "TnFbxMesh.h"

namespace tool {

using Point = std::array<float, 3>;

/// A mesh in triangles. `kept` are the numbers of the control points that are drawn, and triangles are indices into it.
struct ReportMesh {
    std::vector<std::uint32_t> kept;
    std::vector<std::array<std::uint32_t, 3>> triangles;
    std::size_t triangleCount = 0; ///< before decimation
    std::size_t polygonCount = 0;
    std::size_t pointCount = 0;
    int droppedPolygons = 0; ///< with missing points, or points that are not finite

    [[nodiscard]] bool isThinned() const { return triangles.size() < triangleCount; }
};

/// Polygons may be concave.
ReportMesh triangulated(const Tarnell::Fbx::TnFbxMesh& mesh);

/// Merges points that are close to each other, until no more triangles than that are left.
void thin(ReportMesh& mesh, const std::vector<Point>& points, std::size_t mostTriangles);

/// The first set of control points.
std::vector<Point> pointsOf(const Tarnell::Fbx::TnFbxMesh& mesh);

} // namespace tool
