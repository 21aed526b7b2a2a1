// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Arrays of meshes that are inflated by several threads.
#pragma once

#include <memory>
#include <unordered_map>
#include <vector>

#include "container/Record.h"
#include "core/Parallel.h"
#include "document/Document.h"
#include "geometry/StoredBytes.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Compressed arrays that other threads inflate before they are requested.
class ArraysAhead {
public:
    /// Those of a mesh, given by its record, that most readers of a mesh request: points, and normals, texture
    /// coordinates and colours of the first elements. When the mesh follows the one that was read last, those of the
    /// following meshes, too. Null where they are too small for a thread, or only the caller's is allowed.
    static std::shared_ptr<ArraysAhead> ofMesh(const Record& body, const Document& document);

    ArraysAhead(std::shared_ptr<const FileBytes> file, std::vector<const StoredArray*> arrays);

    /// The bytes of an array, sound or not; null when the caller has to inflate it. To be called once for each.
    [[nodiscard]] std::unique_ptr<InflatedBytes> take(const StoredArray& array);

private:
    std::shared_ptr<const FileBytes> mFile;
    std::vector<const StoredArray*> mArrays;
    std::unordered_map<const StoredArray*, std::size_t> mPlaces; ///< in the list
    std::vector<std::unique_ptr<InflatedBytes>> mInflated;
    WorkAhead mWork; ///< the last member: its threads end before the others are destroyed
};

} // namespace detail
FBXSDK_NAMESPACE_END
