// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The paths of a cache's files, derived from those in an FBX file.
#pragma once

#include <string>
#include <vector>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The candidate paths, best first: the relative name from the folder of the FBX file, the absolute name, and the bare
/// file name in the folder named after the FBX file, in the folder that the name has, and in the folder of the FBX
/// file, for files that were moved or come from another system. Either slash separates. A relative name that leads out
/// of the FBX file's folder is not followed.
[[nodiscard]] std::vector<std::string> cacheFileCandidates(const std::string& fbxFile, const std::string& relativeName,
                                                           const std::string& absoluteName);

} // namespace detail
FBXSDK_NAMESPACE_END
