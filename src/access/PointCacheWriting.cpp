// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "PointCacheWriting.h"

#include "calls/LastError.h"
#include "model/FrameArithmetic.h"

#include <cstdint>
#include <limits>
#include <string>
#include <vector>

namespace Tarnell::Fbx {

namespace {

using Cache = fbxsdk::FbxCache;

/// The platform renames such a cache when the scene is saved.
void appearWithScene(Cache& cache) {
    fbxsdk::FbxProperty property = fbxsdk::FbxProperty::Create(&cache, fbxsdk::FbxBoolDT, "AppearWithScene");
    property.ModifyFlag(fbxsdk::FbxPropertyFlags::eNotSavable, true);
    property.Set(true);
}

/// The control points from `first` on, as many as the buffer holds; missing points are at the
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

} // namespace

fbxsdk::FbxVertexCacheDeformer* detail::pointCacheDeformerOf(fbxsdk::FbxNode& node) {
    fbxsdk::FbxGeometry* geometry = node.GetGeometry();
    return fbxsdk::FbxCast<fbxsdk::FbxVertexCacheDeformer>(
        geometry != nullptr ? geometry->GetDeformer(0, fbxsdk::FbxDeformer::eVertexCache) : nullptr);
}

Cache* detail::pointCacheOf(fbxsdk::FbxNode& node) {
    fbxsdk::FbxVertexCacheDeformer* deformer = pointCacheDeformerOf(node);
    return deformer != nullptr ? deformer->GetCache() : nullptr;
}

bool detail::attachPointCache(fbxsdk::FbxManager& manager, fbxsdk::FbxGeometry& geometry, const PointCachePlace& place,
                              const char* name, bool maya, bool withScene) {
    if (!fbxsdk::FbxPathUtils::Create(place.folder))
        return fail(std::string(place.folder) + ": the folder cannot be created");
    Cache* cache = Cache::Create(&manager, name);
    cache->SetCacheFileName(place.relative, place.file);
    cache->SetCacheFileFormat(maya ? Cache::eMayaCache : Cache::eMaxPointCacheV2);
    if (withScene)
        appearWithScene(*cache);
    auto* deformer = fbxsdk::FbxVertexCacheDeformer::Create(&manager, name);
    deformer->SetCache(cache);
    deformer->Channel.Set(name);
    deformer->Active.Set(true);
    geometry.AddDeformer(deformer);
    return succeed();
}

const char* detail::pointCacheFault(const TnFbxMesh& mesh, const TnFbxTime& range) {
    const std::int64_t points = mesh.getNumberOfControlPoints();
    const std::int64_t frames = frameCount(range.getStartFrame(), range.getEndFrame());
    if (points < 1)
        return "the mesh has no control points";
    if (frames < 1 || frames != mesh.getNumberOfControlPointSets())
        return "the mesh does not have one set of control points per frame";
    return frames > std::numeric_limits<int>::max() / points ? "the mesh has too many control points for a point cache"
                                                             : nullptr;
}

bool detail::openPointCache(Cache& cache, const TnFbxMesh& mesh, const TnFbxTime& range, const PointCacheForm& form,
                            fbxsdk::FbxStatus& status) {
    if (form.maya) {
        return cache.OpenFileForWrite(Cache::eMCOneFile, form.rate, form.channel, form.wide ? Cache::eMCX : Cache::eMCC,
                                      Cache::eDoubleVectorArray, "Points", &status);
    }
    return cache.OpenFileForWrite(static_cast<double>(range.getStartFrame()), form.rate,
                                  static_cast<unsigned int>(mesh.getNumberOfControlPointSets()),
                                  static_cast<unsigned int>(mesh.getNumberOfControlPoints()), &status);
}

void detail::writePointSamples(Cache& cache, const TnFbxMesh& mesh, const TnFbxTime& range,
                               const PointCacheForm& form) {
    const int pointCount = mesh.getNumberOfControlPoints();
    std::vector<double> buffer(static_cast<std::size_t>(pointCount) * 3);
    const int channelIndex = cache.GetChannelIndex(form.channel);
    for (int sample = 0; sample < mesh.getNumberOfControlPointSets(); ++sample) {
        const int frame = range.getStartFrame() + sample;
        copyPoints(mesh, sample * pointCount, buffer);
        if (form.maya) {
            fbxsdk::FbxTime sampleTime;
            sampleTime.SetSecondDouble(static_cast<double>(frame) / form.rate);
            cache.Write(channelIndex, sampleTime, buffer.data(), static_cast<unsigned int>(pointCount));
        } else { // kept: the frame's own number, not the number of the sample
            cache.Write(static_cast<unsigned int>(frame), buffer.data());
        }
    }
}

} // namespace Tarnell::Fbx
