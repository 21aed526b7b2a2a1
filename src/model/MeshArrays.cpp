// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// All memory is allocated before the first array is filled: on failure the mesh is still empty.
#include "MeshArrays.h"

#include <sys/mman.h>

namespace Tarnell::Fbx::detail {

namespace {

constexpr char kSet = 1; // its address represents a flag that is set

/// Uses large pages for memory that will soon be filled completely, where the system has some: most of the time of
/// small ones is spent getting them one by one.
void preferLargePages(void* memory, std::size_t size) {
    constexpr std::uintptr_t largePage = std::uintptr_t{1} << 21U;
    const auto address = reinterpret_cast<std::uintptr_t>(memory);
    const std::uintptr_t first = (address + largePage - 1) / largePage * largePage;
    const std::uintptr_t end = (address + size) / largePage * largePage;
    if (first < end)
        ::madvise(static_cast<char*>(memory) + (first - address), end - first, MADV_HUGEPAGE);
}

template <typename Element>
void reserveExactly(SharedArray<Element>& array, std::size_t count) {
    array.reserve(count);
    std::vector<Element>& elements = array.own();
    preferLargePages(elements.data(), elements.capacity() * sizeof(Element));
}

} // namespace

MeshArrays::~MeshArrays() {
    if (mAllocated)
        complete();
}

std::uint64_t MeshArrays::bytesOf(std::int64_t polygons, std::int64_t controlPoints, std::int64_t polygonVertices) {
    if (polygons < 1 || controlPoints < 1 || polygonVertices < 1)
        return 0;
    constexpr std::size_t corner =
        sizeof(int) + sizeof(TnFbxMesh::Vector) + sizeof(TnFbxMesh::TextureCoordinate) + sizeof(TnFbxMesh::Colour);
    return static_cast<std::uint64_t>(polygons) * sizeof(int) +
           static_cast<std::uint64_t>(controlPoints) * sizeof(TnFbxMesh::Vector) +
           static_cast<std::uint64_t>(polygonVertices) * corner;
}

std::uint64_t MeshArrays::bytesOfAnother(std::int64_t controlPoints, std::int64_t polygonVertices) {
    if (controlPoints < 1 || polygonVertices < 1)
        return 0;
    constexpr std::size_t corner = sizeof(TnFbxMesh::Vector) + sizeof(TnFbxMesh::Colour);
    return static_cast<std::uint64_t>(controlPoints) * sizeof(TnFbxMesh::Vector) +
           static_cast<std::uint64_t>(polygonVertices) * corner;
}

MeshArrays::Identity MeshArrays::identityOf(const TnFbxMesh& mesh) {
    const TnFbxMesh::Geometry& g = mesh.mGeometry;
    const auto flag = [](bool value) -> const void* { return value ? &kSet : nullptr; };
    return {g.polygonVertexSizes.identity(),
            g.pointIndices.identity(),
            g.controlPoints.identity(),
            g.normals.identity(),
            g.uvs.identity(),
            g.colours.identity(),
            flag(g.validNormals),
            flag(g.validUVs),
            flag(g.validColours)};
}

bool MeshArrays::allocate(int polygons, int controlPoints, int polygonVertices) {
    mMesh.initMesh(); // kept: before the check, so that a failure leaves an empty mesh
    if (polygons < 1 || controlPoints < 1 || polygonVertices < 1)
        return false;
    const auto polygonCount = static_cast<std::size_t>(polygons);
    const auto cornerCount = static_cast<std::size_t>(polygonVertices);
    TnFbxMesh::Geometry& g = mMesh.mGeometry;
    reserveExactly(g.polygonVertexSizes, polygonCount);
    reserveExactly(g.pointIndices, cornerCount);
    reserveExactly(g.normals, cornerCount);
    reserveExactly(g.uvs, cornerCount);
    reserveExactly(g.colours, cornerCount);
    addFirstSet(static_cast<std::size_t>(controlPoints));
    mPolygonCount = polygonCount;
    mCornerCount = cornerCount;
    mAllocated = true;
    return true;
}

void MeshArrays::allocatePoints(int controlPoints) {
    mMesh.initMesh();
    if (controlPoints > 0) {
        addFirstSet(static_cast<std::size_t>(controlPoints));
        mPolygonCount = mCornerCount = 0;
        mAllocated = true;
    }
}

void MeshArrays::allocateLike(const TnFbxMesh::Geometry& other) {
    mMesh.initMesh();
    TnFbxMesh::Geometry like = other;
    const std::size_t cornerCount = like.pointIndices.size();
    like.normals = {};
    like.colours = {};
    like.controlPoints = {};
    reserveExactly(like.normals, cornerCount);
    reserveExactly(like.colours, cornerCount);
    mMesh.mGeometry = like;
    addFirstSet(static_cast<std::size_t>(other.controlPointCount));
    mPolygonCount = like.polygonVertexSizes.size();
    mCornerCount = cornerCount;
    mAllocated = true;
}

void MeshArrays::addFirstSet(std::size_t controlPoints) {
    reserveExactly(mMesh.mGeometry.controlPoints, controlPoints);
    mMesh.mGeometry.controlPointCount = static_cast<int>(controlPoints);
    mMesh.mGeometry.controlPointSetCount = 1;
}

void MeshArrays::complete() noexcept {
    TnFbxMesh::Geometry& g = mMesh.mGeometry;
    g.polygonVertexSizes.fill(mPolygonCount, 0);
    g.pointIndices.fill(mCornerCount, 0);
    g.normals.fill(mCornerCount, {TnFbxMesh::kDefaultMeshNX, TnFbxMesh::kDefaultMeshNY, TnFbxMesh::kDefaultMeshNZ});
    g.uvs.fill(mCornerCount, {TnFbxMesh::kDefaultMeshU, TnFbxMesh::kDefaultMeshV});
    g.controlPoints.fill(static_cast<std::size_t>(g.controlPointCount),
                         {TnFbxMesh::kDefaultMeshPX, TnFbxMesh::kDefaultMeshPY, TnFbxMesh::kDefaultMeshPZ});
    completeColours();
}

void MeshArrays::completeColours() noexcept {
    mMesh.mGeometry.colours.fill(mCornerCount, {TnFbxMesh::kDefaultMeshRed, TnFbxMesh::kDefaultMeshGreen,
                                                TnFbxMesh::kDefaultMeshBlue, TnFbxMesh::kDefaultMeshAlpha});
}

TnFbxMesh::Colour* MeshArrays::colours() {
    completeColours();
    return mMesh.mGeometry.colours.own().data();
}

} // namespace Tarnell::Fbx::detail
