// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The time that a scene's animation covers: that of its keys, or, without any, that of its Maya point caches.
#include "FbxSdk.h"

#include "PointCacheScope.h"
#include "PropertySampling.h"
#include "access/NodeWalk.h"
#include "calls/LastError.h"

#include <algorithm>
#include <limits>

namespace Tarnell::Fbx {

using detail::fail;
using detail::succeed;

namespace {

/// The deformer's Maya cache; null when it has none.
fbxsdk::FbxCache* mayaCacheOf(fbxsdk::FbxMesh& mesh) {
    auto* deformer =
        fbxsdk::FbxCast<fbxsdk::FbxVertexCacheDeformer>(mesh.GetDeformer(0, fbxsdk::FbxDeformer::eVertexCache));
    fbxsdk::FbxCache* cache = deformer != nullptr ? deformer->GetCache() : nullptr;
    return cache != nullptr && cache->GetCacheFileFormat() == fbxsdk::FbxCache::eMayaCache ? cache : nullptr;
}

/// Widens the range by every channel of the cache; returns whether one of them has a range.
bool widenByChannels(fbxsdk::FbxCache& cache, float& start, float& end) {
    bool found = false;
    const int channelCount = cache.GetChannelCount();
    for (int i = 0; i < channelCount; ++i) {
        fbxsdk::FbxTime first, last;
        if (cache.GetAnimationRange(i, first, last)) {
            start = std::min(detail::toFloat(first.GetSecondDouble()), start);
            end = std::max(detail::toFloat(last.GetSecondDouble()), end);
            found = true;
        }
    }
    return found;
}

} // namespace

bool FbxSdk::getAnimationFrameRange(float& start, float& end) {
    fbxsdk::FbxNode* root = mScene != nullptr ? mScene->GetRootNode() : nullptr;
    if (root == nullptr)
        return fail("the scene has no root node");
    fbxsdk::FbxTimeSpan span(fbxsdk::FBXSDK_TIME_INFINITE, fbxsdk::FBXSDK_TIME_MINUS_INFINITE);
    if (root->GetAnimationInterval(span, /*pAnimStack: the current one*/ nullptr, /*pAnimLayerId*/ 0)) {
        start = detail::toFloat(span.GetStart().GetSecondDouble()); // kept: seconds, although the name says frames
        end = detail::toFloat(span.GetStop().GetSecondDouble());
        return succeed();
    }

    start = std::numeric_limits<float>::max();
    end = -start;
    const detail::PointCacheScope caches(*this, mScene);
    return getAnimationFrameRangeRecursive(root, start, end) ? succeed() : fail("nothing in the scene is animated");
}

bool FbxSdk::getAnimationFrameRangeRecursive(fbxsdk::FbxNode* node, float& start, float& end) {
    bool found = false;
    detail::walkNodes(node, [&](fbxsdk::FbxNode& visited) {
        fbxsdk::FbxMesh* mesh = visited.GetMesh();
        if (mesh != nullptr && getDeformation(mesh)) {
            if (fbxsdk::FbxCache* cache = mayaCacheOf(*mesh))
                found = widenByChannels(*cache, start, end) || found;
        }
        return true;
    });
    return found;
}

} // namespace Tarnell::Fbx
