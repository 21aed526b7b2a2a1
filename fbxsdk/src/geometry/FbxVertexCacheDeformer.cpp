// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Vertex cache deformers.
#include <fbxsdk/FbxVertexCacheDeformer.h>

#include <fbxsdk/FbxCache.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxVertexCacheDeformer, FbxDeformer, detail::kVertexCacheDeformerRows)

FbxVertexCacheDeformer::FbxVertexCacheDeformer(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxDeformer(pManager, pInfo), Active(detail::bindProperty<FbxBool>(*this, "Active")),
      Channel(detail::bindProperty<FbxString>(*this, "ChannelName")),
      CacheSet(detail::bindProperty<FbxString>(*this, "CacheSet")),
      Type(detail::bindProperty<FbxEnum>(*this, "ChannelType")) {}

FbxVertexCacheDeformer::~FbxVertexCacheDeformer() = default;

FbxDeformer::EDeformerType FbxVertexCacheDeformer::GetDeformerType() const { return eVertexCache; }

void FbxVertexCacheDeformer::SetCache(FbxCache* pCache) {
    while (FbxCache* former = GetCache())
        if (former == pCache || !DisconnectSrcObject(former))
            return;
    if (pCache)
        ConnectSrcObject(pCache);
}

FbxCache* FbxVertexCacheDeformer::GetCache() const { return GetSrcObject<FbxCache>(); }

FBXSDK_NAMESPACE_END
