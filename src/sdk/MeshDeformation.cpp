// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deformed control points: a vertex cache replaces everything, otherwise blend shapes and then skin clusters, which
// have a source of their own. Also the opening and closing of a scene's point caches.
#include "FbxSdk.h"

#include "BlendShapeWeights.h"
#include "PropertySampling.h"
#include "SkinClusters.h"
#include "access/FileWarnings.h"
#include "access/TimeModeScope.h"
#include "calls/LastError.h"

#include <algorithm>
#include <cmath>
#include <memory>
#include <string>
#include <vector>

namespace Tarnell::Fbx {

using detail::fail;

namespace {

using Deformer = fbxsdk::FbxDeformer;
using Point = fbxsdk::FbxVector4;

fbxsdk::FbxVertexCacheDeformer* vertexCacheOf(const fbxsdk::FbxGeometry& geometry) {
    return geometry.GetDeformerCount(Deformer::eVertexCache) > 0
               ? fbxsdk::FbxCast<fbxsdk::FbxVertexCacheDeformer>(geometry.GetDeformer(0, Deformer::eVertexCache))
               : nullptr;
}

bool hasActiveVertexCache(const fbxsdk::FbxGeometry& geometry) {
    const fbxsdk::FbxVertexCacheDeformer* deformer = vertexCacheOf(geometry);
    return deformer != nullptr && deformer->Active.Get();
}

bool hasClusters(const fbxsdk::FbxMesh& mesh) {
    bool found = false;
    detail::forEachCluster(mesh, [&found](fbxsdk::FbxCluster&) { found = true; });
    return found;
}

void closeCache(fbxsdk::FbxVertexCacheDeformer& deformer) {
    fbxsdk::FbxCache* cache = deformer.GetCache();
    if (cache != nullptr && deformer.Active.Get() && cache->IsOpen())
        cache->CloseFile();
}

/// Opens the cache unless an instance has done so already. Returns why it cannot be used; empty when it can.
///
/// kept: one that does not open is switched off, and the mesh then reads without it.
std::string openingFault(fbxsdk::FbxVertexCacheDeformer& deformer) {
    if (!deformer.Active.Get())
        return "it is switched off";
    fbxsdk::FbxCache* cache = deformer.GetCache();
    if (cache == nullptr)
        return "the file does not specify a cache";
    fbxsdk::FbxStatus status;
    if (cache->IsOpen() || cache->OpenFileForRead(&status))
        return {};
    deformer.Active.Set(false);
    return status.GetErrorString();
}

/// The name of its node, where there is one.
std::string nameOf(const fbxsdk::FbxGeometry& geometry) {
    const fbxsdk::FbxNode* node = geometry.GetNode(0);
    return node != nullptr ? node->GetName() : geometry.GetName();
}

/// Warns of a mesh that is read without its cache.
void warnOfCache(const std::string& fileName, const fbxsdk::FbxGeometry& geometry, const std::string& reason) {
    detail::warnAbout(fileName, '"' + nameOf(geometry) + "\" is read without its point cache: " + reason);
}

/// Adds the offset from the base to a target, times the weight, to every point that both have.
void addTarget(const fbxsdk::FbxShape& shape, const Point* base, int pointCount, double weight, Point* points) {
    const Point* target = shape.GetControlPoints();
    const int count = target != nullptr ? std::min(pointCount, shape.GetControlPointsCount()) : 0;
    for (int i = 0; i < count; ++i)
        points[i] += (target[i] - base[i]) * weight;
}

/// Adds the effect of one channel at a weight.
///
/// kept: the weight is a percentage and still multiplies the whole difference.
void addChannel(fbxsdk::FbxBlendShapeChannel& channel, double weight, const Point* base, int pointCount,
                Point* points) {
    const int targetCount = channel.GetTargetShapeCount();
    const double* fullWeights = channel.GetTargetShapeFullWeights();
    for (int step = 0; fullWeights != nullptr && step < targetCount; ++step) {
        if (const auto target = detail::targetOfStep(step, weight, fullWeights, targetCount)) {
            if (const fbxsdk::FbxShape* shape = channel.GetTargetShape(*target))
                addTarget(*shape, base, pointCount, weight, points);
        }
    }
}

} // namespace

bool FbxSdk::getDeformation(fbxsdk::FbxMesh* mesh) {
    return mesh != nullptr && (hasActiveVertexCache(*mesh) || mesh->GetShapeCount() != 0 || hasClusters(*mesh));
}

void FbxSdk::getDeformedControlPoints(fbxsdk::FbxNode* node, fbxsdk::FbxMesh* mesh, fbxsdk::FbxTime& time,
                                      fbxsdk::FbxAMatrix& globalPosition, fbxsdk::FbxVector4** points) {
    const int count = mesh != nullptr ? mesh->GetControlPointsCount() : 0;
    if (node == nullptr || points == nullptr || count < 1)
        return;
    const Point* source = mesh->GetControlPoints();
    delete[] * points;
    *points = nullptr;
    *points = new Point[static_cast<std::size_t>(count)];
    std::copy_n(source, count, *points);

    if (hasActiveVertexCache(*mesh)) {
        readVertexCacheData(mesh, time, *points);
        return;
    }
    if (mesh->GetShapeCount() != 0)
        computeShapeDeformation(node, mesh, time, *points);
    if (hasClusters(*mesh))
        computeClusterDeformation(globalPosition, mesh, time, *points);
}

void FbxSdk::readVertexCacheData(fbxsdk::FbxMesh* mesh, fbxsdk::FbxTime& time, fbxsdk::FbxVector4* points) {
    fbxsdk::FbxVertexCacheDeformer* deformer = mesh != nullptr ? vertexCacheOf(*mesh) : nullptr;
    fbxsdk::FbxCache* cache = deformer != nullptr ? deformer->GetCache() : nullptr;
    const int count = mesh != nullptr ? mesh->GetControlPointsCount() : 0;
    if (cache == nullptr || points == nullptr || count < 1)
        return;

    std::vector<double> buffer(static_cast<std::size_t>(count) * 3);
    const auto pointCount = static_cast<unsigned int>(count);
    fbxsdk::FbxStatus status;
    bool read = false;
    if (cache->GetCacheFileFormat() == fbxsdk::FbxCache::eMayaCache) {
        const fbxsdk::FbxString channelName = deformer->Channel.Get();
        const int channel = cache->GetChannelIndex(channelName);
        if (channel < 0) {
            warnOfCache(mFileName, *mesh, std::string("it has no channel \"") + channelName.Buffer() + '"');
            return;
        }
        read = cache->Read(channel, time, buffer.data(), pointCount, &status);
    } else {
        const detail::TimeModeScope timeMode(mScene);
        const auto frame = static_cast<unsigned int>(time.GetFrameCount(fbxsdk::FbxTime::eDefaultMode));
        read = cache->Read(frame, buffer.data(), pointCount, &status);
    }
    if (!read)
        warnOfCache(mFileName, *mesh, status.GetErrorString());
    if (read && !std::all_of(buffer.begin(), buffer.end(), [](double number) { return std::isfinite(number); }))
        detail::warnAbout(mFileName, '"' + nameOf(*mesh) + "\" has points in its point cache that are not finite");
    for (std::size_t i = 0; read && i < pointCount; ++i)
        for (int axis = 0; axis < 3; ++axis)
            points[i][axis] = buffer[3 * i + static_cast<std::size_t>(axis)];
}

void FbxSdk::computeShapeDeformation(fbxsdk::FbxNode* /*node*/, fbxsdk::FbxMesh* mesh, fbxsdk::FbxTime& time,
                                     fbxsdk::FbxVector4* points) {
    if (mesh == nullptr || points == nullptr)
        return;
    const int pointCount = mesh->GetControlPointsCount();
    const std::vector<Point> base(points, points + pointCount);
    const std::vector<fbxsdk::FbxAnimLayer*> layers = detail::layersOf(mCurrentAnimStack);
    const int deformerCount = mesh->GetDeformerCount(Deformer::eBlendShape);
    for (int b = 0; b < deformerCount; ++b) {
        auto* blendShape = fbxsdk::FbxCast<fbxsdk::FbxBlendShape>(mesh->GetDeformer(b, Deformer::eBlendShape));
        const int channelCount = blendShape != nullptr ? blendShape->GetBlendShapeChannelCount() : 0;
        for (int c = 0; c < channelCount; ++c) {
            fbxsdk::FbxBlendShapeChannel* channel = blendShape->GetBlendShapeChannel(c);
            for (fbxsdk::FbxAnimLayer* layer : layers) { // kept: every layer with a curve adds its own
                fbxsdk::FbxAnimCurve* curve = mesh->GetShapeChannel(b, c, layer, /*pCreateAsNeeded*/ false);
                if (channel != nullptr && curve != nullptr)
                    addChannel(*channel, static_cast<double>(curve->Evaluate(time)), base.data(), pointCount, points);
            }
        }
    }
}

bool FbxSdk::openClosePointCacheData(fbxsdk::FbxScene* scene, bool open) {
    if (scene == nullptr)
        return fail("no scene to open point caches of");
    const int nodeCount = scene->GetNodeCount();
    for (int i = 0; i < nodeCount; ++i) {
        fbxsdk::FbxNode* node = scene->GetNode(i);
        const fbxsdk::FbxGeometry* geometry = node != nullptr ? node->GetGeometry() : nullptr;
        fbxsdk::FbxVertexCacheDeformer* deformer = geometry != nullptr ? vertexCacheOf(*geometry) : nullptr;
        if (deformer == nullptr)
            continue;
        if (!open)
            closeCache(*deformer);
        else if (const std::string fault = openingFault(*deformer); !fault.empty())
            warnOfCache(mFileName, *geometry, fault);
    }
    return true; // closing follows the work, whose failure stays noted
}

} // namespace Tarnell::Fbx
