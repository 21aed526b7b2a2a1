// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Animated points of a mesh as a point cache: the vertex cache on the node's mesh, and the file with one sample per
// frame.
#include "FbxSdk.h"

#include "access/ObjectWarnings.h"
#include "access/PointCacheWriting.h"
#include "calls/LastError.h"

#include "TnFbxError.h"

#include <filesystem>
#include <iostream>
#include <system_error>

namespace Tarnell::Fbx {

using detail::fail;
using detail::pointCacheDeformerOf;
using detail::pointCacheFault;
using detail::pointCacheOf;
using detail::succeed;

namespace {

using Cache = fbxsdk::FbxCache;
using Text = fbxsdk::FbxString;

bool exists(const std::string& file) {
    std::error_code ignored;
    return std::filesystem::exists(file, ignored);
}

constexpr const char* kNoSets = "it does not have one set of control points per frame of the range; the file refers to "
                                "a point cache that is not written";
constexpr const char* kOldCache =
    "the file refers to a point cache that is not written; an older one with the same name exists";

std::string fileNameOf(const Cache& cache) {
    Text relative, absolute;
    cache.GetCacheFileName(relative, absolute);
    return std::string(absolute);
}

} // namespace

bool FbxSdk::mapVertexCacheOnMesh(fbxsdk::FbxManager* manager, fbxsdk::FbxNode* meshNode, bool mayaFormat,
                                  const std::string& fbxFileName) {
    fbxsdk::FbxGeometry* geometry = meshNode != nullptr ? meshNode->GetGeometry() : nullptr;
    if (manager == nullptr || geometry == nullptr)
        return fail("no FBX manager or no node with a mesh for a point cache");
    if (fbxFileName.empty())
        return fail("no file name is given");
    const char* name = meshNode->GetName();
    const auto place = detail::pointCachePlace(
        fbxFileName, name, mayaFormat ? kMayaVertexCacheFileExtension : kMaxVertexCacheFileExtension);
    return detail::attachPointCache(*manager, *geometry, place, name, mayaFormat, mCachesAppearWithScene);
}

bool FbxSdk::animateVertexCacheOnMesh(fbxsdk::FbxNode* meshNode, const TnFbxMesh* mesh, bool mayaFormat,
                                      bool useMcxFormat, const TnFbxTime& time) {
    if (meshNode == nullptr || mesh == nullptr)
        return fail("no node or no mesh to write a point cache of");
    if (const char* fault = pointCacheFault(*mesh, time))
        return fail(std::string(meshNode->GetName()) + ": " + fault);
    Cache* cache = pointCacheOf(*meshNode);
    if (cache == nullptr)
        return fail(std::string(meshNode->GetName()) + ": the node has no vertex cache");
    const detail::PointCacheForm form = {meshNode->GetName(), mayaFormat, useMcxFormat,
                                         static_cast<double>(time.getFrameRate())};
    fbxsdk::FbxStatus status;
    if (!detail::openPointCache(*cache, *mesh, time, form, status)) {
        std::cout << "Error opening file for write: " << status.GetErrorString() << std::endl; // kept: hosts show it
        return fail(fileNameOf(*cache) + ": " + status.GetErrorString());
    }
    detail::writePointSamples(*cache, *mesh, time, form); // kept: only closing reports whether it worked
    return cache->CloseFile(&status) ? succeed() : fail(status.GetErrorString());
}

void FbxSdk::addPointCache(fbxsdk::FbxNode& node, const TnFbxMesh& mesh, const TnFbxWriteInfo& info,
                           const TnFbxTime& time, detail::ObjectWarnings& warnings) {
    const bool maya = info.getMayaVertexCacheFormat();
    const bool newest = info.getCompatibilityVersion() == TnFbxWriteInfo::kFbxVersion2016;
    if (!mapVertexCacheOnMesh(mManager, &node, maya, info.getFileName())) {
        detail::warn(mesh.getName() + ": written without its animation: " + lastError());
        return;
    }
    if (animateVertexCacheOnMesh(&node, &mesh, maya, newest, time))
        return;
    Cache* cache = pointCacheOf(node);
    const bool isOldThere = cache != nullptr && exists(fileNameOf(*cache));
    if (pointCacheFault(mesh, time) != nullptr) { // kept: the deformer stays, and names a file that does not exist
        warnings.add(mesh.getName(), isOldThere ? kOldCache : kNoSets);
        return;
    }
    // Without the deformer: it would read an older cache, or none.
    detail::warn(mesh.getName() + ": written without its animation: " + lastError() +
                 (isOldThere ? "; an older point cache still exists" : ""));
    pointCacheDeformerOf(node)->Destroy();
    if (cache != nullptr)
        cache->Destroy();
}

} // namespace Tarnell::Fbx
