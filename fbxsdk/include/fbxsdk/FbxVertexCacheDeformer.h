// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Points that come from a cache.
#pragma once

#include <fbxsdk/FbxDeformer.h>

FBXSDK_NAMESPACE_BEGIN

class FbxCache;

class FBXSDK_DLL FbxVertexCacheDeformer : public FbxDeformer {
    FBXSDK_OBJECT_DECLARE(FbxVertexCacheDeformer, FbxDeformer)

public:
    enum ECacheChannelType { ePositions, eNormals, eUVs, eTangents, eBinormals, eUserDefined };

    FbxPropertyT<FbxBool> Active;
    FbxPropertyT<FbxString> Channel; ///< the channel's name in a Maya cache
    FbxPropertyT<FbxString> CacheSet;
    FbxPropertyT<FbxEnum> Type; ///< ECacheChannelType

    [[nodiscard]] EDeformerType GetDeformerType() const override;

    /// The deformer's source cache; setting one replaces it, null removes it.
    void SetCache(FbxCache* pCache);
    [[nodiscard]] FbxCache* GetCache() const;
};

FBXSDK_NAMESPACE_END
