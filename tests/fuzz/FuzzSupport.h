// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The common part of the fuzz targets over the facade: the abort when an invariant fails, objects that were read, and
// files with an old time of modification.
#pragma once

#include "support/TemporaryFolder.h"

#include <Fbx.h>
#include <TnFbxError.h>
#include <TnFbxLimits.h>
#include <TnFbxMesh.h>
#include <TnFbxReadInfo.h>

#include <chrono>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

namespace fuzz {

inline void require(bool holds, const char* what) {
    if (!holds) {
        std::fprintf(stderr, "broken: %s (%s)\n", what, Tarnell::Fbx::lastError().c_str());
        std::abort();
    }
}

/// A file that was last written a while ago: readers check again one that is being written just now, which takes
/// milliseconds.
inline void writeOldFile(const support::TemporaryFolder& folder, const std::string& name, const std::string& content) {
    const std::string file = folder.write(name, content);
    std::filesystem::last_write_time(file, std::filesystem::file_time_type::clock::now() - std::chrono::hours(1));
}

/// The memory limit of a call: enough for valid files, and little enough to be used a thousand times a
/// minute.
inline bool limitMemory() {
    Tarnell::Fbx::setMemoryLimit(std::uint64_t{1} << 20);
    return true;
}

/// Whether the last call failed for that reason.
inline bool isBeyondLimit() {
    return Tarnell::Fbx::lastError().find("would be needed; the limit is") != std::string::npos;
}

/// Every object of a kind in a file.
template <class Object>
struct List {
    std::unique_ptr<Object[]> objects;
    int count = 0;
    bool read = false;
    bool isTooLarge = false; ///< for the memory limit: the array exists, though it is incomplete

    List(Tarnell::Fbx::TnFbxReadInfo& info,
         bool (Tarnell::Fbx::Fbx::*reader)(Tarnell::Fbx::TnFbxReadInfo&, Object**, int&) const) {
        Object* made = nullptr;
        read = (Tarnell::Fbx::Fbx().*reader)(info, &made, count);
        objects.reset(made);
        isTooLarge = isBeyondLimit();
        require(read || !Tarnell::Fbx::lastError().empty(), "a failure without a reason");
        require(count >= 0 && (read || isTooLarge || count == 0) && (count == 0 || made != nullptr),
                "a count without objects");
    }

    [[nodiscard]] std::vector<Object*> pointers() const {
        std::vector<Object*> all;
        for (int i = 0; i < count; ++i)
            all.push_back(&objects[static_cast<std::size_t>(i)]);
        return all;
    }
};

inline void checkMesh(const Tarnell::Fbx::TnFbxMesh& mesh) {
    int corners = 0;
    for (int p = 0; p < mesh.getNumberOfPolygons(); ++p) {
        require(mesh.getPolygonVertexSize(p) >= 0, "a polygon of a negative size");
        corners += mesh.getPolygonVertexSize(p);
    }
    require(corners == mesh.getNumberOfPolygonVertices(), "polygons have other corners than the mesh");
    for (int i = 0; i < corners; ++i) {
        const int point = mesh.getPointIndex(i);
        require(point >= 0 && point < mesh.getNumberOfControlPoints(), "a corner without a point");
    }
}

} // namespace fuzz
