// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxDeformer.h>

FBXSDK_NAMESPACE_BEGIN

class FbxCache;

/// Deformation by the points of a cache.
class FBXSDK_DLL FbxVertexCacheDeformer : public FbxDeformer {
    FBXSDK_OBJECT_DECLARE(FbxVertexCacheDeformer, FbxDeformer)

public:
    /// Which part of the geometry the cache holds.
    enum ECacheChannelType {
        ePositions,  ///< control points
        eNormals,    ///< normals
        eUVs,        ///< texture coordinates
        eTangents,   ///< tangents
        eBinormals,  ///< binormals
        eUserDefined ///< anything else
    };

    FbxPropertyT<FbxBool> Active;     ///< whether it deforms; true
    FbxPropertyT<FbxString> Channel;  ///< in files ChannelName; the channel's name in a Maya cache
    FbxPropertyT<FbxString> CacheSet; ///< the name of a group of caches; "FbxCacheExport"
    FbxPropertyT<FbxEnum> Type;       ///< in files ChannelType; ECacheChannelType, ePositions

    [[nodiscard]] EDeformerType GetDeformerType() const override; ///< eVertexCache.

    /// The deformer's source cache; setting one replaces it, null removes it. Its manager still owns the cache.
    void SetCache(FbxCache* pCache);
    [[nodiscard]] FbxCache* GetCache() const; ///< Null when there is none.
};

FBXSDK_NAMESPACE_END
