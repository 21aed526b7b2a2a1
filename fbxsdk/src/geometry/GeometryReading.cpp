// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes and shapes.
#include "geometry/GeometryReading.h"

#include <algorithm>
#include <vector>

#include "geometry/ItemReading.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// The number of polygons in a list of corners.
int countPolygons(const PlainArray<int>& corners) {
    const auto closed = std::count_if(corners.begin(), corners.end(), [](int corner) { return corner < 0; });
    const bool lastIsOpen = corners.count() > 0 && corners[corners.count() - 1] >= 0;
    return static_cast<int>(closed) + (lastIsOpen ? 1 : 0);
}

/// Corners are as in files: a negative entry is the last corner of its polygon, all bits inverted. An unterminated last
/// polygon ends with the list. Corners at points that do not exist are moved to point 0; without points there are no
/// polygons. Returns the number of such corners.
int cutIntoPolygons(PlainArray<int>& corners, PlainArray<int>& starts, int pointCount) {
    int repaired = 0;
    if (pointCount == 0) {
        repaired = corners.count();
        corners.clear();
    }
    starts.resizeUninitialised(countPolygons(corners));
    const int count = corners.count();
    int* const cornerList = corners.data();
    int* start = starts.data();
    bool atStart = true;
    for (int i = 0; i < count; ++i) {
        const int stored = cornerList[i];
        const int corner = stored < 0 ? ~stored : stored;
        repaired += corner < pointCount ? 0 : 1;
        cornerList[i] = corner < pointCount ? corner : 0;
        if (atStart)
            *start++ = i;
        atStart = stored < 0;
    }
    return repaired;
}

/// Adds offsets, three numbers each, to the points of the indices; without indices to the first points in order.
void applyOffsets(PlainArray<FbxVector4>& points, const PlainArray<int>* indices, const std::vector<double>& offsets) {
    int count = static_cast<int>(offsets.size() / 3);
    if (indices)
        count = std::min(count, indices->count());
    const double* offset = offsets.data();
    for (int i = 0; i < count; ++i, offset += 3) {
        const int index = indices ? (*indices)[i] : i;
        if (!points.contains(index))
            continue;
        for (int axis = 0; axis < 3; ++axis)
            points[index][axis] += offset[axis];
    }
}

} // namespace

void attachSource(FbxGeometryBase& geometry, const std::shared_ptr<const Document>& document,
                  const DocumentObject& object) {
    geometry.setSource(std::make_unique<GeometrySource>(GeometrySource{document, object.body}));
}

int readMesh(FbxMesh& mesh, const GeometrySource& source) {
    if (const Record* vertices = source.body->child("Vertices"))
        readLate(source.document, *vertices, mesh.points(), LateReading::shown, nullptr, source.ahead);
    const Record* polygons = source.body->child("PolygonVertexIndex");
    if (!polygons)
        return 0;
    readItems(*polygons, mesh.polygonVertices());
    return cutIntoPolygons(mesh.polygonVertices(), mesh.polygonStarts(), mesh.points().count());
}

void readShape(FbxShape& shape, const FbxGeometryBase& base, const Record& body) {
    const int count = base.GetControlPointsCount();
    shape.points().resizeUninitialised(count);
    std::copy_n(base.GetControlPoints(), count, shape.points().begin());

    const Record* vertices = body.child("Vertices");
    if (!vertices)
        return;
    std::vector<double> offsets(std::min(vertices->numberCount(), 3 * static_cast<std::size_t>(INT32_MAX / 4)));
    if (!vertices->readNumbers(std::span<double>(offsets)))
        return;
    PlainArray<int> indices;
    const Record* indexRecord = body.child("Indexes");
    if (indexRecord)
        readItems(*indexRecord, indices);
    applyOffsets(shape.points(), indexRecord ? &indices : nullptr, offsets);
}

} // namespace detail
FBXSDK_NAMESPACE_END
