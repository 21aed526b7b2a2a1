// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

/// A bone, as a kind of attribute: its placement is the node's, and clusters define what it moves
/// (FbxCluster::GetLink).
class FBXSDK_DLL FbxSkeleton : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxSkeleton, FbxNodeAttribute)

public:
    /// What part of a skeleton it is.
    enum EType {
        eRoot,     ///< the topmost bone
        eLimb,     ///< a bone with a length
        eLimbNode, ///< a joint, which nearly all files have; the default
        eEffector  ///< the end of a chain
    };

    FbxPropertyT<FbxDouble> Size;       ///< of the drawn joint, percent; 100
    FbxPropertyT<FbxDouble> LimbLength; ///< of an eLimb, as a fraction of the distance to the next joint; 1

    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override; ///< eSkeleton.

    void SetSkeletonType(EType pType) { mType = pType; }          ///< Any value is stored.
    [[nodiscard]] EType GetSkeletonType() const { return mType; } ///< eLimbNode by default.

private:
    EType mType = eLimbNode; ///< what nearly all files hold
};

FBXSDK_NAMESPACE_END
