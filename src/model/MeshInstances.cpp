// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "MeshInstances.h"

namespace Tarnell::Fbx::detail {

namespace {

/// Replaces an array by an equal one of the pool, or adds it to the pool. Returns the bytes that are freed.
template <class Pool, class Element>
std::uint64_t shareEqual(Pool& pool, SharedArray<Element>& array) {
    const auto [equal, isNew] = pool.insert(array);
    if (isNew || equal->identity() == array.identity())
        return 0;
    array = *equal;
    return array.size() * sizeof(Element);
}

} // namespace

const TnFbxMesh::Geometry* MeshInstances::find(const Source& source) const {
    const auto found = mSources.find(source);
    return found != mSources.end() && found->second.isFilled ? &found->second.geometry : nullptr;
}

std::uint64_t MeshInstances::keep(const Source& source, TnFbxMesh& mesh) {
    TnFbxMesh::Geometry& geometry = mesh.mGeometry;
    const std::uint64_t freed = shareEqual(mVectors, geometry.controlPoints) + shareEqual(mVectors, geometry.normals) +
                                shareEqual(mColours, geometry.colours);
    Kept& kept = mSources[source];
    if (!kept.isFilled)
        kept = {true, geometry};
    return freed;
}

} // namespace Tarnell::Fbx::detail
