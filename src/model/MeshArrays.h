// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The arrays of a mesh as memory, for readers that fill all of them one after the other.
#pragma once

#include "TnFbxMesh.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace Tarnell::Fbx::detail {

/// Gives a mesh the arrays of TnFbxMesh::allocateGeometryData. The large ones are only reserved at first: each takes
/// its memory when it is asked for, or else in the end.
class MeshArrays {
public:
    explicit MeshArrays(TnFbxMesh& mesh) : mMesh(mesh) {}
    MeshArrays(const MeshArrays&) = delete;
    MeshArrays& operator=(const MeshArrays&) = delete;
    ~MeshArrays();

    /// What a mesh of one set of points takes. Nothing where a count is below 1.
    static std::uint64_t bytesOf(std::int64_t polygons, std::int64_t controlPoints, std::int64_t polygonVertices);

    /// To be called first; the mesh is initialised. False when a number is below 1; the mesh is empty then and no array
    /// may be asked for.
    bool allocate(int polygons, int controlPoints, int polygonVertices);
    /// Instead: points that no polygon uses.
    void allocatePoints(int controlPoints);

    // Each holds as many elements as it has to, defaults at first.
    int* polygonVertexSizes() { return mMesh.mGeometry.polygonVertexSizes.data(); }
    int* pointIndices() { return mMesh.mGeometry.pointIndices.data(); }
    TnFbxMesh::Colour* colours();

    // Of the polygon vertices in order, from the first one on, as many as there are at most. Those that are not added
    // have the defaults in the end.
    void addNormal(const TnFbxMesh::Vector& normal) { mMesh.mGeometry.normals.push_back(normal); }
    void addUV(const TnFbxMesh::TextureCoordinate& uv) { mMesh.mGeometry.uvs.push_back(uv); }

private:
    std::size_t polygonVertexCount() const;
    void completeWithDefaults();

    TnFbxMesh& mMesh;
    bool mAllocated = false;
};

} // namespace Tarnell::Fbx::detail
