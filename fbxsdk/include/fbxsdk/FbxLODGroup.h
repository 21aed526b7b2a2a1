// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

/// A node's children as levels of detail, of which applications show one by its distance.
///
/// Thresholds and display levels of the children are dynamic properties: "Thresholds|Level0", "DisplayLevels|Level0", …
class FBXSDK_DLL FbxLODGroup : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxLODGroup, FbxNodeAttribute)

public:
    FbxPropertyT<FbxBool> ThresholdsUsedAsPercentage; ///< percent of the picture instead of distances; false
    FbxPropertyT<FbxBool> MinMaxDistance;             ///< whether the two distances are used; false
    FbxPropertyT<FbxDouble> MinDistance,              ///< below it nothing is shown, scene units; -100
        MaxDistance;                                  ///< beyond it nothing is shown, scene units; 100
    FbxPropertyT<FbxBool> WorldSpace;                 ///< distances in the world, else in the group's own space; false

    [[nodiscard]] EType GetAttributeType() const override; ///< eLODGroup.
};

FBXSDK_NAMESPACE_END
