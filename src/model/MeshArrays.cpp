// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// All memory is found before the first array is filled: when there is too little, the mesh is still empty.
#include "MeshArrays.h"

namespace Tarnell::Fbx::detail {

namespace {

template <typename Element>
void reserveExactly(std::vector<Element>& array, int count) {
    array.reserve(static_cast<std::size_t>(count));
}

/// Elements up to a count that memory was reserved for; those that are there already stay.
template <typename Element>
Element* filled(std::vector<Element>& array, std::size_t count, const Element& value) {
    array.resize(count, value);
    return array.data();
}

} // namespace

MeshArrays::~MeshArrays() {
    if (mAllocated) {
        completeWithDefaults();
    }
}

std::uint64_t MeshArrays::bytesOf(std::int64_t polygons, std::int64_t controlPoints, std::int64_t polygonVertices) {
    if (polygons < 1 || controlPoints < 1 || polygonVertices < 1) {
        return 0;
    }
    constexpr std::size_t corner =
        sizeof(int) + sizeof(TnFbxMesh::Vector) + sizeof(TnFbxMesh::TextureCoordinate) + sizeof(TnFbxMesh::Colour);
    return static_cast<std::uint64_t>(polygons) * sizeof(int) +
           static_cast<std::uint64_t>(controlPoints) * sizeof(TnFbxMesh::Vector) +
           static_cast<std::uint64_t>(polygonVertices) * corner;
}

bool MeshArrays::allocate(int polygons, int controlPoints, int polygonVertices) {
    mMesh.initMesh(); // kept: before the check, so that a failure leaves an empty mesh
    if (polygons < 1 || controlPoints < 1 || polygonVertices < 1) {
        return false;
    }
    TnFbxMesh::Geometry& g = mMesh.mGeometry;
    reserveExactly(g.polygonVertexSizes, polygons);
    reserveExactly(g.pointIndices, polygonVertices);
    reserveExactly(g.controlPoints, controlPoints);
    reserveExactly(g.normals, polygonVertices);
    reserveExactly(g.uvs, polygonVertices);
    reserveExactly(g.colours, polygonVertices);

    filled(g.polygonVertexSizes, static_cast<std::size_t>(polygons), 0);
    filled(g.pointIndices, static_cast<std::size_t>(polygonVertices), 0);
    filled(g.controlPoints, static_cast<std::size_t>(controlPoints),
           {TnFbxMesh::kDefaultMeshPX, TnFbxMesh::kDefaultMeshPY, TnFbxMesh::kDefaultMeshPZ});
    g.controlPointCount = controlPoints;
    g.controlPointSetCount = 1;
    mAllocated = true;
    return true;
}

void MeshArrays::allocatePoints(int controlPoints) {
    mMesh.initMesh();
    if (controlPoints > 0) {
        TnFbxMesh::Geometry& g = mMesh.mGeometry;
        filled(g.controlPoints, static_cast<std::size_t>(controlPoints),
               {TnFbxMesh::kDefaultMeshPX, TnFbxMesh::kDefaultMeshPY, TnFbxMesh::kDefaultMeshPZ});
        g.controlPointCount = controlPoints;
        g.controlPointSetCount = 1;
    }
}

std::size_t MeshArrays::polygonVertexCount() const { return mMesh.mGeometry.pointIndices.size(); }

void MeshArrays::completeWithDefaults() {
    filled(mMesh.mGeometry.normals, polygonVertexCount(),
           {TnFbxMesh::kDefaultMeshNX, TnFbxMesh::kDefaultMeshNY, TnFbxMesh::kDefaultMeshNZ});
    filled(mMesh.mGeometry.uvs, polygonVertexCount(), {TnFbxMesh::kDefaultMeshU, TnFbxMesh::kDefaultMeshV});
    colours();
}

TnFbxMesh::Colour* MeshArrays::colours() {
    return filled(mMesh.mGeometry.colours, polygonVertexCount(),
                  {TnFbxMesh::kDefaultMeshRed, TnFbxMesh::kDefaultMeshGreen, TnFbxMesh::kDefaultMeshBlue,
                   TnFbxMesh::kDefaultMeshAlpha});
}

} // namespace Tarnell::Fbx::detail
