// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes as a report draws them: triangles, and no more of them than a page can carry.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "TnFbxMesh.h"

namespace tool {

using Point = std::array<float, 3>;

/// A mesh in triangles. `kept` are the numbers of the control points that are drawn, and triangles name places in it.
struct ReportMesh {
    std::vector<std::uint32_t> kept;
    std::vector<std::array<std::uint32_t, 3>> triangles;
    std::size_t triangleCount = 0; ///< before thinning
    std::size_t polygonCount = 0;
    std::size_t pointCount = 0;
    int droppedPolygons = 0; ///< that name points there are not, or points that are nowhere

    [[nodiscard]] bool isThinned() const { return triangles.size() < triangleCount; }
};

/// Polygons may be concave.
ReportMesh triangulated(const Tarnell::Fbx::TnFbxMesh& mesh);

/// Makes one point of those that are close to each other, until no more triangles than that are left.
void thin(ReportMesh& mesh, const std::vector<Point>& points, std::size_t mostTriangles);

/// The first set of control points.
std::vector<Point> pointsOf(const Tarnell::Fbx::TnFbxMesh& mesh);

} // namespace tool
