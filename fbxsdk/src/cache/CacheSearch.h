// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Where the files of a cache are, given what an FBX file says of them.
#pragma once

#include <string>
#include <vector>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The places to look, best first: the relative name beside the FBX file, the absolute name, and the bare file name in
/// the folder named after the FBX file, in the folder that the name has, and beside the FBX file itself, for files
/// that were moved or come from another system. Either slash separates. A relative name that climbs out of the FBX
/// file's folder is not followed.
[[nodiscard]] std::vector<std::string> cacheFileCandidates(const std::string& fbxFile, const std::string& relativeName,
                                                           const std::string& absoluteName);

} // namespace detail
FBXSDK_NAMESPACE_END
