// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The location of point caches: each FBX file has a folder for them next to it.
#pragma once

#include "PointCacheName.h"

#include <fbxsdk.h>

#include <string>

namespace Tarnell::Fbx::detail {

/// The cache of one mesh of an FBX file.
struct PointCachePlace {
    fbxsdk::FbxString folder;
    fbxsdk::FbxString file;
    fbxsdk::FbxString relative; ///< the file relative to the folder of the FBX file
};

inline PointCachePlace pointCachePlace(const std::string& fbxFileName, const char* nodeName,
                                       const std::string& extension) {
    using Paths = fbxsdk::FbxPathUtils;
    const fbxsdk::FbxString fbxFolder = Paths::GetFolderName(Paths::Resolve(fbxFileName.c_str()));
    const fbxsdk::FbxString stem = Paths::GetFileName(fbxFileName.c_str(), /*pWithExtension*/ false);
    PointCachePlace place;
    place.folder = Paths::Bind(fbxFolder, stem + "_fpc"); // the FBX folder may be the root
    place.file = place.folder + "/" + pointCacheName(nodeName).c_str() + extension.c_str();
    place.relative = Paths::GetRelativeFilePath(fbxFolder, place.file);
    return place;
}

} // namespace Tarnell::Fbx::detail
