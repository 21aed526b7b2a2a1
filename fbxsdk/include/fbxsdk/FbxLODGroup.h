// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A group of which one child is shown, by distance.
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

/// Thresholds and display levels of the children are dynamic properties: "Thresholds|Level0", "DisplayLevels|Level0", …
class FBXSDK_DLL FbxLODGroup : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxLODGroup, FbxNodeAttribute)

public:
    FbxPropertyT<FbxBool> ThresholdsUsedAsPercentage;
    FbxPropertyT<FbxBool> MinMaxDistance;
    FbxPropertyT<FbxDouble> MinDistance, MaxDistance;
    FbxPropertyT<FbxBool> WorldSpace;

    [[nodiscard]] EType GetAttributeType() const override;
};

FBXSDK_NAMESPACE_END
