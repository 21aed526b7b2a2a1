// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes that are read from the same source, for nodes that share it: their equal arrays are shared.
#pragma once

#include "TnFbxMesh.h"

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <map>
#include <set>
#include <tuple>

namespace Tarnell::Fbx::detail {

/// Keeps the returned meshes' arrays as long as it exists.
class MeshInstances {
public:
    using Geometry = TnFbxMesh::Geometry;

    /// The source of meshes with the same polygons, in the same order of their corners.
    struct Source {
        const void* mesh;
        bool isReversed;
        bool operator<(const Source& other) const {
            return mesh != other.mesh ? mesh < other.mesh : isReversed < other.isReversed;
        }
    };

    /// Whether the source has not been looked up before.
    bool isFirst(const Source& source) { return mSources.insert({source, {}}).second; }
    /// The first mesh of the source that was kept; null when none was.
    const Geometry* find(const Source& source) const;

    /// Lets a filled mesh share equal arrays with the kept ones. Returns how many bytes it holds less.
    std::uint64_t keep(const Source& source, TnFbxMesh& mesh);

    void forget() { *this = {}; }

private:
    struct Kept {
        bool isFilled = false;
        Geometry geometry;
    };

    /// Any order in which equal arrays are adjacent.
    struct Less {
        template <class Element>
        bool operator()(const SharedArray<Element>& left, const SharedArray<Element>& right) const {
            const auto extent = [](const auto& array) {
                return std::tuple(array.size(), array.storedCount(), array.filler() != nullptr);
            };
            if (extent(left) != extent(right))
                return extent(left) < extent(right);
            const auto order = [](const Element* a, const Element* b, std::size_t count) {
                return a != nullptr && b != nullptr ? std::memcmp(a, b, count * sizeof(Element)) : 0;
            };
            const int elements = order(left.stored(), right.stored(), left.storedCount());
            return elements != 0 ? elements < 0 : order(left.filler(), right.filler(), 1) < 0;
        }
    };

    std::map<Source, Kept> mSources;
    std::set<SharedArray<TnFbxMesh::Vector>, Less> mVectors; // points and normals
    std::set<SharedArray<TnFbxMesh::Colour>, Less> mColours;
};

} // namespace Tarnell::Fbx::detail
