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
    if (first < end) {
        ::madvise(static_cast<char*>(memory) + (first - address), end - first, MADV_HUGEPAGE);
    }
}

template <typename Element>
void reserveExactly(SharedArray<Element>& array, std::size_t count) {
    std::vector<Element>& elements = array.own();
    elements.reserve(count);
    preferLargePages(elements.data(), elements.capacity() * sizeof(Element));
}

/// Elements up to a count for which memory is reserved; existing ones stay.
template <typename Element>
void fill(SharedArray<Element>& array, std::size_t count, const Element& value) {
    if (array.size() < count) {
        array.own().resize(count, value);
    }
}

} // namespace

MeshArrays::~MeshArrays() {
    if (mAllocated) {
        complete();
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

std::uint64_t MeshArrays::bytesOfAnother(std::int64_t controlPoints, std::int64_t polygonVertices) {
    if (controlPoints < 1 || polygonVertices < 1) {
        return 0;
    }
    constexpr std::size_t corner = sizeof(TnFbxMesh::Vector) + sizeof(TnFbxMesh::Colour);
    return static_cast<std::uint64_t>(controlPoints) * sizeof(TnFbxMesh::Vector) +
           static_cast<std::uint64_t>(polygonVertices) * corner;
}

MeshArrays::Identity MeshArrays::identityOf(const TnFbxMesh& mesh) {
    const TnFbxMesh::Geometry& g = mesh.mGeometry;
    const auto flag = [](bool value) -> const void* { return value ? &kSet : nullptr; };
    return {g.polygonVertexSizes.data(),
            g.pointIndices.data(),
            g.controlPoints.data(),
            g.normals.data(),
            g.uvs.data(),
            g.colours.data(),
            flag(g.validNormals),
            flag(g.validUVs),
            flag(g.validColours)};
}

bool MeshArrays::allocate(int polygons, int controlPoints, int polygonVertices) {
    mMesh.initMesh(); // kept: before the check, so that a failure leaves an empty mesh
    if (polygons < 1 || controlPoints < 1 || polygonVertices < 1) {
        return false;
    }
    const auto polygonCount = static_cast<std::size_t>(polygons);
    const auto cornerCount = static_cast<std::size_t>(polygonVertices);
    TnFbxMesh::Geometry& g = mMesh.mGeometry;
    reserveExactly(g.polygonVertexSizes, polygonCount);
    reserveExactly(g.pointIndices, cornerCount);
    reserveExactly(g.controlPoints, static_cast<std::size_t>(controlPoints));
    reserveExactly(g.normals, cornerCount);
    reserveExactly(g.uvs, cornerCount);
    reserveExactly(g.colours, cornerCount);

    fill(g.polygonVertexSizes, polygonCount, 0);
    fill(g.pointIndices, cornerCount, 0);
    addFirstSet(controlPoints);
    mAllocated = true;
    return true;
}

void MeshArrays::allocatePoints(int controlPoints) {
    mMesh.initMesh();
    if (controlPoints > 0) {
        addFirstSet(controlPoints);
    }
}

void MeshArrays::allocateLike(const TnFbxMesh::Geometry& other) {
    mMesh.initMesh();
    TnFbxMesh::Geometry like = other;
    like.normals = {};
    like.colours = {};
    like.controlPoints = {};
    reserveExactly(like.normals, like.pointIndices.size());
    reserveExactly(like.colours, like.pointIndices.size());
    reserveExactly(like.controlPoints, static_cast<std::size_t>(like.controlPointCount));
    mMesh.mGeometry = like;
    addFirstSet(other.controlPointCount);
    mAllocated = true;
}

void MeshArrays::addFirstSet(int controlPoints) {
    fill(mMesh.mGeometry.controlPoints, static_cast<std::size_t>(controlPoints),
         {TnFbxMesh::kDefaultMeshPX, TnFbxMesh::kDefaultMeshPY, TnFbxMesh::kDefaultMeshPZ});
    mMesh.mGeometry.controlPointCount = controlPoints;
    mMesh.mGeometry.controlPointSetCount = 1;
}

std::size_t MeshArrays::polygonVertexCount() const { return mMesh.mGeometry.pointIndices.size(); }

void MeshArrays::complete() {
    fill(mMesh.mGeometry.normals, polygonVertexCount(),
         {TnFbxMesh::kDefaultMeshNX, TnFbxMesh::kDefaultMeshNY, TnFbxMesh::kDefaultMeshNZ});
    fill(mMesh.mGeometry.uvs, polygonVertexCount(), {TnFbxMesh::kDefaultMeshU, TnFbxMesh::kDefaultMeshV});
    completeColours();
}

void MeshArrays::completeColours() {
    fill(mMesh.mGeometry.colours, polygonVertexCount(),
         {TnFbxMesh::kDefaultMeshRed, TnFbxMesh::kDefaultMeshGreen, TnFbxMesh::kDefaultMeshBlue,
          TnFbxMesh::kDefaultMeshAlpha});
}

TnFbxMesh::Colour* MeshArrays::colours() {
    completeColours();
    return mMesh.mGeometry.colours.own().data();
}

} // namespace Tarnell::Fbx::detail
