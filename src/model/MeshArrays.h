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

/// Gives a mesh the arrays of TnFbxMesh::allocateGeometryData. Memory for all of them is reserved at first; what is not
/// added to an array has the default, which takes no memory.
class MeshArrays {
public:
    using Vector = TnFbxMesh::Vector;
    using TextureCoordinate = TnFbxMesh::TextureCoordinate;
    using Colour = TnFbxMesh::Colour;

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

    // For reading a mesh array by array.
    static const SharedArray<int>& polygonVertexSizesOf(const TnFbxMesh& mesh) {
        return mesh.mGeometry.polygonVertexSizes;
    }
    static const SharedArray<int>& pointIndicesOf(const TnFbxMesh& mesh) { return mesh.mGeometry.pointIndices; }
    static const SharedArray<Vector>& controlPointsOf(const TnFbxMesh& mesh) { return mesh.mGeometry.controlPoints; }
    static const SharedArray<Vector>& normalsOf(const TnFbxMesh& mesh) { return mesh.mGeometry.normals; }
    static const SharedArray<TextureCoordinate>& uvsOf(const TnFbxMesh& mesh) { return mesh.mGeometry.uvs; }
    static const SharedArray<Colour>& coloursOf(const TnFbxMesh& mesh) { return mesh.mGeometry.colours; }

    /// To be called first; the mesh is initialised. False when a number is below 1; the mesh is empty then and no array
    /// may be requested.
    bool allocate(int polygons, int controlPoints, int polygonVertices);
    /// Instead: points without polygons.
    void allocatePoints(int controlPoints);
    /// Instead: the polygons, the texture coordinates and the flags of another mesh, with points, normals and colours
    /// of its own.
    void allocateLike(const TnFbxMesh::Geometry& other);

    // Each appends to its array: for the polygons, the points and the polygon vertices in order, from the first one on,
    // at most as many as there are.
    void addPolygonVertexSize(int size) { polygonVertexSizes().push_back(size); }
    /// Those that were added, to add more.
    std::vector<int>& polygonVertexSizes() { return mMesh.mGeometry.polygonVertexSizes.own(); }
    void addPointIndex(int index) { mMesh.mGeometry.pointIndices.own().push_back(index); }
    void addPointIndices(const int* indices, std::size_t count) {
        append(mMesh.mGeometry.pointIndices.own(), indices, count);
    }
    void addControlPoint(const Vector& point) { mMesh.mGeometry.controlPoints.own().push_back(point); }
    void addControlPoints(const Vector* points, std::size_t count) {
        append(mMesh.mGeometry.controlPoints.own(), points, count);
    }
    void addNormal(const Vector& normal) { mMesh.mGeometry.normals.own().push_back(normal); }
    void addNormals(const Vector* normals, std::size_t count) { append(mMesh.mGeometry.normals.own(), normals, count); }
    void addUV(const TextureCoordinate& uv) { mMesh.mGeometry.uvs.own().push_back(uv); }
    void addUVs(const TextureCoordinate* uvs, std::size_t count) { append(mMesh.mGeometry.uvs.own(), uvs, count); }

    /// All of them, of which those that are not set have the default.
    Colour* colours();

    const int* addedPolygonVertexSizes() const { return mMesh.mGeometry.polygonVertexSizes.stored(); }
    const int* addedPointIndices() const { return mMesh.mGeometry.pointIndices.stored(); }

    /// Called by the destructor: defaults for everything that was not added.
    void complete() noexcept;

private:
    template <typename Element>
    static void append(std::vector<Element>& array, const Element* elements, std::size_t count) {
        array.insert(array.end(), elements, elements + count);
    }
    void addFirstSet(std::size_t controlPoints);
    void completeColours() noexcept;

    TnFbxMesh& mMesh;
    std::size_t mPolygonCount = 0;
    std::size_t mCornerCount = 0;
    bool mAllocated = false;
};

} // namespace Tarnell::Fbx::detail
