// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A marker: a point that is captured, or that moves a character.
#pragma once

#include <fbxsdk/FbxColor.h>
#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxMarker : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxMarker, FbxNodeAttribute)

public:
    enum EType { eStandard, eOptical, eEffectorFK, eEffectorIK };
    enum ELook : int {
        eCube,
        eHardCross,
        eLightCross,
        eSphere,
        eCapsule,
        eBox,
        eBone,
        eSquare,
        eCircle,
        eStick,
        eNone
    };

    FbxPropertyT<ELook> Look;
    FbxPropertyT<FbxBool> DrawLink;
    FbxPropertyT<FbxDouble> Size;
    FbxPropertyT<FbxBool> ShowLabel;
    FbxPropertyT<FbxDouble3> IKPivot;

    /// eMarker for every type of marker.
    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override;

    void SetType(EType pType) { mType = pType; }
    [[nodiscard]] EType GetType() const { return mType; }
    /// Sets the marker's own properties, and its type, to their defaults.
    void Reset();
    /// The value of the property Color, opaque.
    [[nodiscard]] FbxColor GetDefaultColor() const;

private:
    EType mType = eStandard;
};

FBXSDK_NAMESPACE_END
