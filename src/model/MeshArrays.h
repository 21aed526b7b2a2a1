// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The arrays of a mesh as memory, for readers that fill one array after the other.
#pragma once

#include "TnFbxMesh.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace Tarnell::Fbx::detail {

/// Gives a mesh the arrays of TnFbxMesh::allocateGeometryData. The large ones are only reserved at first: each is
/// sized when it is requested, or else at the end.
class MeshArrays {
public:
    using Vector = TnFbxMesh::Vector;
    using TextureCoordinate = TnFbxMesh::TextureCoordinate;

    explicit MeshArrays(TnFbxMesh& mesh) : mMesh(mesh) {}
    MeshArrays(const MeshArrays&) = delete;
    MeshArrays& operator=(const MeshArrays&) = delete;
    ~MeshArrays();

    /// The memory of a mesh with one set of points. Zero where a count is below 1.
    static std::uint64_t bytesOf(std::int64_t polygons, std::int64_t controlPoints, std::int64_t polygonVertices);
    /// Its own memory at most where another mesh has the same polygons and texture coordinates.
    static std::uint64_t bytesOfAnother(std::int64_t controlPoints, std::int64_t polygonVertices);

    /// Whether other meshes share the points.
    static bool sharesPoints(const TnFbxMesh& mesh) { return mesh.mGeometry.controlPoints.isShared(); }

    /// Which arrays a mesh has, and which flags: equal for meshes that share all of them, as long as these exist.
    using Identity = std::array<const void*, 9>;
    static Identity identityOf(const TnFbxMesh& mesh);

    /// To be called first; the mesh is initialised. False when a number is below 1; the mesh is empty then and no array
    /// may be requested.
    bool allocate(int polygons, int controlPoints, int polygonVertices);
    /// Instead: points without polygons.
    void allocatePoints(int controlPoints);
    /// Instead: the polygons, the texture coordinates and the flags of another mesh, with points, normals and colours
    /// of its own.
    void allocateLike(const TnFbxMesh::Geometry& other);

    // Each has its full number of elements, defaults at first.
    int* polygonVertexSizes() { return mMesh.mGeometry.polygonVertexSizes.own().data(); }
    int* pointIndices() { return mMesh.mGeometry.pointIndices.own().data(); }
    const int* polygonVertexSizes() const { return mMesh.mGeometry.polygonVertexSizes.data(); }
    const int* pointIndices() const { return mMesh.mGeometry.pointIndices.data(); }
    TnFbxMesh::Colour* colours();

    // For the polygon vertices in order, from the first one on, at most as many as there are. Those that are not added
    // have the defaults at the end.
    void addNormal(const TnFbxMesh::Vector& normal) { mMesh.mGeometry.normals.own().push_back(normal); }
    void addUV(const TnFbxMesh::TextureCoordinate& uv) { mMesh.mGeometry.uvs.own().push_back(uv); }
    void addNormals(const Vector* normals, std::size_t count) { append(mMesh.mGeometry.normals.own(), normals, count); }
    void addUVs(const TextureCoordinate* uvs, std::size_t count) { append(mMesh.mGeometry.uvs.own(), uvs, count); }

    /// Called by the destructor: defaults for everything that was not requested or added.
    void complete();

private:
    template <typename Element>
    static void append(std::vector<Element>& array, const Element* elements, std::size_t count) {
        array.insert(array.end(), elements, elements + count);
    }
    std::size_t polygonVertexCount() const;
    void addFirstSet(int controlPoints);
    void completeColours();

    TnFbxMesh& mMesh;
    bool mAllocated = false;
};

} // namespace Tarnell::Fbx::detail
