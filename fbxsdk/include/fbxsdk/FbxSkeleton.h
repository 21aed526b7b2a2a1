// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A bone or joint.
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxSkeleton : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxSkeleton, FbxNodeAttribute)

public:
    enum EType { eRoot, eLimb, eLimbNode, eEffector };

    FbxPropertyT<FbxDouble> Size;
    FbxPropertyT<FbxDouble> LimbLength;

    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override;

    void SetSkeletonType(EType pType) { mType = pType; }
    [[nodiscard]] EType GetSkeletonType() const { return mType; }

private:
    EType mType = eLimbNode; ///< what nearly all files hold
};

FBXSDK_NAMESPACE_END
