// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Animated points of a mesh as a point cache: the vertex cache on the node's mesh, and the file with one sample per
// frame.
#include "FbxSdk.h"

#include "ObjectWarnings.h"
#include "PointCachePlace.h"
#include "calls/LastError.h"
#include "model/FrameArithmetic.h"

#include "TnFbxError.h"

#include <cstdint>
#include <filesystem>
#include <iostream>
#include <limits>
#include <system_error>
#include <vector>

namespace Tarnell::Fbx {

using detail::fail;
using detail::succeed;

namespace {

using Cache = fbxsdk::FbxCache;
using Paths = fbxsdk::FbxPathUtils;
using Text = fbxsdk::FbxString;

fbxsdk::FbxVertexCacheDeformer* deformerOf(fbxsdk::FbxNode& node) {
    fbxsdk::FbxGeometry* geometry = node.GetGeometry();
    return fbxsdk::FbxCast<fbxsdk::FbxVertexCacheDeformer>(
        geometry != nullptr ? geometry->GetDeformer(0, fbxsdk::FbxDeformer::eVertexCache) : nullptr);
}

Cache* cacheOf(fbxsdk::FbxNode& node) {
    fbxsdk::FbxVertexCacheDeformer* deformer = deformerOf(node);
    return deformer != nullptr ? deformer->GetCache() : nullptr;
}

/// The platform gives such a cache its name when the scene is saved.
void appearWithScene(Cache& cache) {
    fbxsdk::FbxProperty property = fbxsdk::FbxProperty::Create(&cache, fbxsdk::FbxBoolDT, "AppearWithScene");
    property.ModifyFlag(fbxsdk::FbxPropertyFlags::eNotSavable, true);
    property.Set(true);
}

bool exists(const std::string& file) {
    std::error_code ignored;
    return std::filesystem::exists(file, ignored);
}

constexpr const char* kNoSets = "one set of points per frame of the range is missing; a point cache is named in the "
                                "file and not written";
constexpr const char* kOldCache =
    "a point cache is named in the file and not written; an older one of its name is there";

std::string fileNameOf(const Cache& cache) {
    Text relative, absolute;
    cache.GetCacheFileName(relative, absolute);
    return std::string(absolute);
}

/// Null, or why the points of the mesh are not those of the range.
const char* faultOf(const TnFbxMesh& mesh, const TnFbxTime& time) {
    const std::int64_t points = mesh.getNumberOfControlPoints();
    const std::int64_t frames = detail::frameCount(time.getStartFrame(), time.getEndFrame());
    if (points < 1) {
        return "the mesh has no control points";
    }
    if (frames < 1 || frames != mesh.getNumberOfControlPointSets()) {
        return "the mesh has not one set of control points per frame";
    }
    return frames > std::numeric_limits<int>::max() / points ? "the mesh has too many control points" : nullptr;
}

bool openCache(Cache& cache, const char* channel, const TnFbxMesh& mesh, bool mayaFormat, bool useMcxFormat,
               const TnFbxTime& time, fbxsdk::FbxStatus& status) {
    const auto rate = static_cast<double>(time.getFrameRate());
    if (mayaFormat) {
        return cache.OpenFileForWrite(Cache::eMCOneFile, rate, channel, useMcxFormat ? Cache::eMCX : Cache::eMCC,
                                      Cache::eDoubleVectorArray, "Points", &status);
    }
    return cache.OpenFileForWrite(static_cast<double>(time.getStartFrame()), rate,
                                  static_cast<unsigned int>(mesh.getNumberOfControlPointSets()),
                                  static_cast<unsigned int>(mesh.getNumberOfControlPoints()), &status);
}

/// The control points from `first` on, as many as the buffer has room for; points that there are not lie at the
/// origin.
void copyPoints(const TnFbxMesh& mesh, int first, std::vector<double>& buffer) {
    for (std::size_t i = 0; i < buffer.size(); i += 3) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        mesh.getControlPoint(first + static_cast<int>(i / 3), x, y, z);
        buffer[i] = static_cast<double>(x);
        buffer[i + 1] = static_cast<double>(y);
        buffer[i + 2] = static_cast<double>(z);
    }
}

void writeSamples(Cache& cache, const char* channel, const TnFbxMesh& mesh, bool mayaFormat, const TnFbxTime& time) {
    const int pointCount = mesh.getNumberOfControlPoints();
    std::vector<double> buffer(static_cast<std::size_t>(pointCount) * 3);
    const int channelIndex = cache.GetChannelIndex(channel);
    for (int sample = 0; sample < mesh.getNumberOfControlPointSets(); ++sample) {
        const int frame = time.getStartFrame() + sample;
        copyPoints(mesh, sample * pointCount, buffer);
        if (mayaFormat) {
            fbxsdk::FbxTime sampleTime;
            sampleTime.SetSecondDouble(static_cast<double>(frame) / static_cast<double>(time.getFrameRate()));
            cache.Write(channelIndex, sampleTime, buffer.data(), static_cast<unsigned int>(pointCount));
        } else { // kept: the frame's own number, not the number of the sample
            cache.Write(static_cast<unsigned int>(frame), buffer.data());
        }
    }
}

} // namespace

bool FbxSdk::mapVertexCacheOnMesh(fbxsdk::FbxManager* manager, fbxsdk::FbxNode* meshNode, bool mayaFormat,
                                  const std::string& fbxFileName) {
    fbxsdk::FbxGeometry* geometry = meshNode != nullptr ? meshNode->GetGeometry() : nullptr;
    if (manager == nullptr || geometry == nullptr) {
        return fail("no FBX manager or no node with a mesh for a point cache");
    }
    if (fbxFileName.empty()) {
        return fail("no file name is given");
    }
    const char* name = meshNode->GetName();
    const auto place = detail::pointCachePlace(
        fbxFileName, name, mayaFormat ? kMayaVertexCacheFileExtension : kMaxVertexCacheFileExtension);
    if (!Paths::Create(place.folder)) {
        return fail(std::string(place.folder) + ": the folder cannot be created");
    }

    Cache* cache = Cache::Create(manager, name);
    cache->SetCacheFileName(place.relative, place.file);
    cache->SetCacheFileFormat(mayaFormat ? Cache::eMayaCache : Cache::eMaxPointCacheV2);
    if (mCachesAppearWithScene) {
        appearWithScene(*cache);
    }

    auto* deformer = fbxsdk::FbxVertexCacheDeformer::Create(manager, name);
    deformer->SetCache(cache);
    deformer->Channel.Set(name);
    deformer->Active.Set(true);
    geometry->AddDeformer(deformer);
    return succeed();
}

bool FbxSdk::animateVertexCacheOnMesh(fbxsdk::FbxNode* meshNode, const TnFbxMesh* mesh, bool mayaFormat,
                                      bool useMcxFormat, const TnFbxTime& time) {
    if (meshNode == nullptr || mesh == nullptr) {
        return fail("no node or no mesh to write a point cache of");
    }
    if (const char* fault = faultOf(*mesh, time)) {
        return fail(std::string(meshNode->GetName()) + ": " + fault);
    }
    Cache* cache = cacheOf(*meshNode);
    if (cache == nullptr) {
        return fail(std::string(meshNode->GetName()) + ": the node has no vertex cache");
    }
    fbxsdk::FbxStatus status;
    if (!openCache(*cache, meshNode->GetName(), *mesh, mayaFormat, useMcxFormat, time, status)) {
        std::cout << "Error opening file for write: " << status.GetErrorString() << std::endl; // kept: hosts show it
        return fail(fileNameOf(*cache) + ": " + status.GetErrorString());
    }
    writeSamples(*cache, meshNode->GetName(), *mesh, mayaFormat, time); // kept: only closing says whether it worked
    return cache->CloseFile(&status) ? succeed() : fail(status.GetErrorString());
}

void FbxSdk::addPointCache(fbxsdk::FbxNode& node, const TnFbxMesh& mesh, const TnFbxWriteInfo& info,
                           const TnFbxTime& time, detail::ObjectWarnings& warnings) {
    const bool maya = info.getMayaVertexCacheFormat();
    const bool newest = info.getCompatibilityVersion() == TnFbxWriteInfo::kFbxVersion2016;
    if (!mapVertexCacheOnMesh(mManager, &node, maya, info.getFileName())) {
        detail::warn(mesh.getName() + ": is written without its animation: " + lastError());
        return;
    }
    if (animateVertexCacheOnMesh(&node, &mesh, maya, newest, time)) {
        return;
    }
    Cache* cache = cacheOf(node);
    const bool isOldThere = cache != nullptr && exists(fileNameOf(*cache));
    if (faultOf(mesh, time) != nullptr) { // kept: the deformer stays, and names a file that is not there
        warnings.add(mesh.getName(), isOldThere ? kOldCache : kNoSets);
        return;
    }
    // Without the deformer: it would read an older cache, or none.
    detail::warn(mesh.getName() + ": is written without its animation: " + lastError() +
                 (isOldThere ? "; an older point cache is still there" : ""));
    deformerOf(node)->Destroy();
    if (cache != nullptr) {
        cache->Destroy();
    }
}

} // namespace Tarnell::Fbx
