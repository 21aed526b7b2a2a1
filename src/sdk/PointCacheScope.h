// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Keeps the point caches of a scene open for as long as they are read.
#pragma once

#include "FbxSdk.h"

namespace Tarnell::Fbx::detail {

/// Opens the caches of the scene and closes them again at the end, also when a reader throws. Null: none.
class PointCacheScope {
public:
    PointCacheScope(FbxSdk& sdk, fbxsdk::FbxScene* scene) : mSdk(sdk), mScene(scene) {
        if (mScene != nullptr)
            mSdk.openClosePointCacheData(mScene, /*open*/ true);
    }
    ~PointCacheScope() {
        if (mScene != nullptr)
            mSdk.openClosePointCacheData(mScene, /*open*/ false);
    }
    PointCacheScope(const PointCacheScope&) = delete;
    PointCacheScope& operator=(const PointCacheScope&) = delete;

private:
    FbxSdk& mSdk;
    fbxsdk::FbxScene* mScene;
};

} // namespace Tarnell::Fbx::detail
