// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "cache/CacheSearch.h"

#include <algorithm>

#include <fbxsdk/FbxPathUtils.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

std::string cleaned(const std::string& name) {
    return name.empty() ? std::string() : std::string(FbxPathUtils::Clean(name.c_str()).Buffer());
}

bool climbsOut(const std::string& path) { return path == ".." || path.starts_with("../"); }

std::string fileNameOf(const std::string& path) { return FbxPathUtils::GetFileName(path.c_str()).Buffer(); }

std::string lastFolderOf(const std::string& path) {
    return fileNameOf(FbxPathUtils::GetFolderName(path.c_str()).Buffer());
}

std::string in(const std::string& folder, const std::string& name) { return folder + "/" + name; }
std::string in(const std::string& folder, const std::string& subfolder, const std::string& name) {
    return in(in(folder, subfolder), name);
}

} // namespace

std::vector<std::string> cacheFileCandidates(const std::string& fbxFile, const std::string& relativeName,
                                             const std::string& absoluteName) {
    std::vector<std::string> places;
    const auto add = [&](const std::string& place) {
        if (!place.empty() && std::find(places.begin(), places.end(), place) == places.end())
            places.push_back(place);
    };
    const std::string relative = cleaned(relativeName);
    const std::string absolute = cleaned(absoluteName);
    const bool isRelative = !relative.empty() && FbxPathUtils::IsRelative(relative.c_str());
    if (!fbxFile.empty()) {
        const std::string folder = FbxPathUtils::GetFolderName(FbxPathUtils::Resolve(fbxFile.c_str())).Buffer();
        const std::string stem = FbxPathUtils::GetFileName(fbxFile.c_str(), false).Buffer();
        if (isRelative && !climbsOut(relative))
            add(in(folder, relative));
        add(absolute);
        for (const std::string& name : {relative, absolute}) {
            if (name.empty())
                continue;
            const std::string file = fileNameOf(name);
            const std::string lastFolder = lastFolderOf(name);
            add(in(folder, stem + "_fpc", file));
            if (!lastFolder.empty() && lastFolder != "..")
                add(in(folder, lastFolder, file));
            add(in(folder, file));
        }
    } else {
        add(absolute);
        if (isRelative && !climbsOut(relative))
            add(relative);
    }
    return places;
}

} // namespace detail
FBXSDK_NAMESPACE_END
