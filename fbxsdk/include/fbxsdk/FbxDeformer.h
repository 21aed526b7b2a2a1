// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The base of deformers, and of their parts.
#pragma once

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

/// The base of deformers, which move the points of geometry. A deformer is a source of the geometry that it deforms.
class FBXSDK_DLL FbxDeformer : public FbxObject {
    FBXSDK_ABSTRACT_DECLARE(FbxDeformer, FbxObject)

public:
    /// What kind of deformer it is.
    enum EDeformerType {
        eUnknown,    ///< none of the others
        eSkin,       ///< FbxSkin
        eBlendShape, ///< FbxBlendShape
        eVertexCache ///< FbxVertexCacheDeformer
    };

    [[nodiscard]] virtual EDeformerType GetDeformerType() const; ///< Of the class.
};

/// A part of a deformer, and a source of it.
class FBXSDK_DLL FbxSubDeformer : public FbxObject {
    FBXSDK_ABSTRACT_DECLARE(FbxSubDeformer, FbxObject)

public:
    /// What kind of part it is.
    enum EType {
        eUnknown,          ///< none of the others
        eCluster,          ///< FbxCluster
        eBlendShapeChannel ///< FbxBlendShapeChannel
    };

    [[nodiscard]] virtual EType GetSubDeformerType() const; ///< Of the class.
};

FBXSDK_NAMESPACE_END
