// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The base of what deforms geometry, and of the parts of deformers.
#pragma once

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

/// A deformer is a source of the geometry that it deforms.
class FBXSDK_DLL FbxDeformer : public FbxObject {
    FBXSDK_ABSTRACT_DECLARE(FbxDeformer, FbxObject)

public:
    enum EDeformerType { eUnknown, eSkin, eBlendShape, eVertexCache };

    [[nodiscard]] virtual EDeformerType GetDeformerType() const;
};

/// A sub-deformer is a source of its deformer.
class FBXSDK_DLL FbxSubDeformer : public FbxObject {
    FBXSDK_ABSTRACT_DECLARE(FbxSubDeformer, FbxObject)

public:
    enum EType { eUnknown, eCluster, eBlendShapeChannel };

    [[nodiscard]] virtual EType GetSubDeformerType() const;
};

FBXSDK_NAMESPACE_END
