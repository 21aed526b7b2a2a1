// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes that are handed out of one and the same source, for nodes that share it: what is equal among them is there
// once.
#pragma once

#include "TnFbxMesh.h"

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <map>
#include <set>

namespace Tarnell::Fbx::detail {

/// Knows the meshes that were handed out, and keeps their arrays as long as it lives.
class MeshInstances {
public:
    using Geometry = TnFbxMesh::Geometry;

    /// What meshes with the same polygons, in the same order of their corners, come from.
    struct Source {
        const void* mesh;
        bool isReversed;
        bool operator<(const Source& other) const {
            return mesh != other.mesh ? mesh < other.mesh : isReversed < other.isReversed;
        }
    };

    /// Whether nothing was asked about the source before.
    bool isFirst(const Source& source) { return mSources.insert({source, {}}).second; }
    /// The first mesh of the source that was kept; null when none was.
    const Geometry* find(const Source& source) const;

    /// Lets a filled mesh share with those that were kept what is equal. How many bytes it holds less for that.
    std::uint64_t keep(const Source& source, TnFbxMesh& mesh);

    void forget() { *this = {}; }

private:
    struct Kept {
        bool isFilled = false;
        Geometry geometry;
    };

    /// Any order in which equal arrays are neighbours.
    struct Less {
        template <class Element>
        bool operator()(const SharedArray<Element>& left, const SharedArray<Element>& right) const {
            if (left.size() != right.size()) {
                return left.size() < right.size();
            }
            return left.size() > 0 && std::memcmp(left.data(), right.data(), left.size() * sizeof(Element)) < 0;
        }
    };

    std::map<Source, Kept> mSources;
    std::set<SharedArray<TnFbxMesh::Vector>, Less> mVectors; // points and normals
    std::set<SharedArray<TnFbxMesh::Colour>, Less> mColours;
};

} // namespace Tarnell::Fbx::detail
