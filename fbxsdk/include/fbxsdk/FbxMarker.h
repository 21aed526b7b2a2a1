// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxColor.h>
#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

/// A marker at a position: a handle of a rig or a captured point.
class FBXSDK_DLL FbxMarker : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxMarker, FbxNodeAttribute)

public:
    /// What the marker is for.
    enum EType {
        eStandard,   ///< any purpose; the default
        eOptical,    ///< a captured point
        eEffectorFK, ///< moves a joint by the angles above it
        eEffectorIK  ///< moves a chain by its end
    };
    /// How the marker is drawn.
    enum ELook : int {
        eCube,       ///< the default
        eHardCross,  ///< a thick cross
        eLightCross, ///< a thin cross
        eSphere,     ///< a sphere
        eCapsule,    ///< a cylinder with round ends
        eBox,        ///< a flat box
        eBone,       ///< a bone
        eSquare,     ///< a flat square
        eCircle,     ///< a flat circle
        eStick,      ///< a line
        eNone        ///< not at all
    };

    FbxPropertyT<ELook> Look;         ///< eCube by default
    FbxPropertyT<FbxBool> DrawLink;   ///< whether a line to the parent is drawn; true
    FbxPropertyT<FbxDouble> Size;     ///< percent of the usual size; 100
    FbxPropertyT<FbxBool> ShowLabel;  ///< whether the name is drawn; false
    FbxPropertyT<FbxDouble3> IKPivot; ///< of an eEffectorIK, scene units; (0, 0, 0)

    /// eMarker for every type of marker.
    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override;

    void SetType(EType pType) { mType = pType; }          ///< Any value is stored.
    [[nodiscard]] EType GetType() const { return mType; } ///< eStandard by default.
    /// Sets the marker's own properties, and its type, to their defaults; the colour stays.
    void Reset();
    /// The value of the property Color, opaque.
    [[nodiscard]] FbxColor GetDefaultColor() const;

private:
    EType mType = eStandard;
};

FBXSDK_NAMESPACE_END
