// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The control points of a node's mesh in the world, deformed as by the library.
#pragma once

#include "LoadedFile.h"
#include "Matrices.h"

#include <vector>

namespace conformance {

/// Whether skins or caches move the mesh's points.
bool isDeformed(fbxsdk::FbxMesh& mesh);
bool hasBlendShapes(fbxsdk::FbxMesh& mesh);

/// Every control point in the world. Caches have to be open.
std::vector<Point> worldPoints(LoadedFile& file, fbxsdk::FbxNode& node, fbxsdk::FbxMesh& mesh, fbxsdk::FbxTime time);

/// The scene's point caches are open for the lifetime of the object.
class OpenCaches {
public:
    explicit OpenCaches(LoadedFile& file) : mFile(file) { mFile.sdk().openClosePointCacheData(mFile.scene(), true); }
    ~OpenCaches() { mFile.sdk().openClosePointCacheData(mFile.scene(), false); }
    OpenCaches(const OpenCaches&) = delete;
    OpenCaches& operator=(const OpenCaches&) = delete;

private:
    LoadedFile& mFile;
};

} // namespace conformance
