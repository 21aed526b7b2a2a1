// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes and shapes: the inverse of GeometryReading.
#include "geometry/GeometryWriting.h"

#include <algorithm>
#include <vector>

#include "document/RecordWriting.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr int kGeometryVersion = 124;

std::vector<double> packedPoints(const FbxGeometryBase& geometry) {
    const int count = geometry.GetControlPointsCount();
    const FbxVector4* const points = geometry.GetControlPoints();
    std::vector<double> numbers;
    numbers.reserve(3 * static_cast<std::size_t>(count));
    for (int i = 0; i < count; ++i)
        numbers.insert(numbers.end(), {points[i][0], points[i][1], points[i][2]});
    return numbers;
}

/// The last corner of a polygon has all bits inverted. Corners that belong to no polygon are omitted.
std::vector<std::int32_t> closedPolygons(const FbxMesh& mesh) {
    std::vector<std::int32_t> corners;
    corners.reserve(static_cast<std::size_t>(mesh.GetPolygonVertexCount()));
    const int* const vertices = mesh.GetPolygonVertices();
    for (int polygon = 0; polygon < mesh.GetPolygonCount(); ++polygon) {
        const int size = mesh.GetPolygonSize(polygon);
        if (size == 0)
            continue;
        const int* const first = vertices + mesh.GetPolygonVertexIndex(polygon);
        corners.insert(corners.end(), first, first + size);
        corners.back() = ~corners.back();
    }
    return corners;
}

bool hasEdges(FbxGeometryBase& geometry) {
    auto* mesh = FbxCast<FbxMesh>(&geometry);
    return mesh && mesh->GetPolygonCount() > 0 && mesh->edges().count() > 0;
}

void writePolygons(FbxMesh& mesh, RecordSink& sink) {
    writeArray<std::int32_t>(sink, "PolygonVertexIndex", closedPolygons(mesh));
    if (hasEdges(mesh))
        writeArray<std::int32_t>(sink, "Edges", {mesh.edges().data(), static_cast<std::size_t>(mesh.edges().count())});
    writeInteger(sink, "GeometryVersion", kGeometryVersion);
}

/// The difference of a shape to its base: the points that it moves, and the offsets.
struct ShapeOffsets {
    std::vector<std::int32_t> indices;
    std::vector<double> offsets;
};

ShapeOffsets offsetsOf(FbxShape& shape) {
    ShapeOffsets result;
    const FbxGeometry* base = shape.GetBaseGeometry();
    if (!base)
        return result;
    const int count = std::min(shape.GetControlPointsCount(), base->GetControlPointsCount());
    const FbxVector4* const to = shape.GetControlPoints();
    const FbxVector4* const from = base->GetControlPoints();
    for (int i = 0; i < count; ++i) {
        const double offset[] = {to[i][0] - from[i][0], to[i][1] - from[i][1], to[i][2] - from[i][2]};
        if (offset[0] == 0.0 && offset[1] == 0.0 && offset[2] == 0.0)
            continue;
        result.indices.push_back(i);
        result.offsets.insert(result.offsets.end(), std::begin(offset), std::end(offset));
    }
    return result;
}

} // namespace

void writeShapeRecords(FbxShape& shape, const VersionTraits& traits, RecordSink& sink) {
    const ShapeOffsets shapeOffsets = offsetsOf(shape);
    if (traits.shapeVersion)
        writeInteger(sink, "Version", 100);
    writeArray<std::int32_t>(sink, "Indexes", shapeOffsets.indices);
    writeArray<double>(sink, "Vertices", shapeOffsets.offsets);
    // Normals are not stored, but some readers require their record.
    writeArray<double>(sink, "Normals", std::vector<double>(shapeOffsets.offsets.size(), 0.0));
}

void writeGeometryRecords(FbxGeometryBase& geometry, const VersionTraits& traits, RecordSink& sink) {
    if (auto* shape = FbxCast<FbxShape>(&geometry)) {
        writeShapeRecords(*shape, traits, sink);
        return;
    }
    if (auto* mesh = FbxCast<FbxMesh>(&geometry)) {
        writeArray<double>(sink, "Vertices", packedPoints(*mesh));
        writePolygons(*mesh, sink);
    } else {
        writeNurbsRecords(geometry, sink);
    }
    writeLayers(geometry, hasEdges(geometry), traits, sink);
    writeRecordsBehindLayers(geometry, sink);
}

} // namespace detail
FBXSDK_NAMESPACE_END
