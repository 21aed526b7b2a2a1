// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

class FbxNode;
class FbxScene;

/// A unit of length: how many centimetres one unit is; and the conversion of scenes between units.
class FBXSDK_DLL FbxSystemUnit {
public:
    /// What a conversion applies to besides the nodes' transforms.
    struct ConversionOptions {
        bool mConvertRrsNodes = true;               ///< nodes that do not inherit their parent's scale
        bool mConvertLimits = true;                 ///< limits of translation and scaling
        bool mConvertClusters = true;               ///< bind matrices of skins
        bool mConvertLightIntensity = true;         ///< of no effect: intensities stay as the file has them
        bool mConvertPhotometricLProperties = true; ///< of no effect likewise
        bool mConvertCameraClipPlanes = true;       ///< near, far, front and back plane of cameras
    };

    constexpr FbxSystemUnit() = default; ///< centimetres
    /// That many centimetres, greater than zero. The multiplier is stored and has no part in conversions.
    constexpr FbxSystemUnit(double pScaleFactor, double pMultiplier = 1.0)
        : mScaleFactor(pScaleFactor), mMultiplier(pMultiplier) {}

    /// Scales the nodes below the root, their curves included, so that every global matrix is the old one in the new
    /// unit. Mesh points stay. The scene's global settings state this unit afterwards; a scene that has it already, and
    /// null, are left unchanged.
    void ConvertScene(FbxScene* pScene, const ConversionOptions& pOptions = DefaultConversionOptions) const;
    /// The same for the children of that node instead of the root's.
    void ConvertScene(FbxScene* pScene, FbxNode* pFbxRoot,
                      const ConversionOptions& pOptions = DefaultConversionOptions) const;
    /// Scales the children of the node only: cameras, bind matrices and global settings stay.
    void ConvertChildren(FbxNode* pRoot, const FbxSystemUnit& pSrcUnit,
                         const ConversionOptions& pOptions = DefaultConversionOptions) const;

    /// Centimetres per unit.
    [[nodiscard]] double GetScaleFactor() const { return mScaleFactor; }
    [[nodiscard]] double GetMultiplier() const { return mMultiplier; } ///< As given; has no part in conversions.
    /// How many of the other unit one of this is.
    [[nodiscard]] double GetConversionFactorTo(const FbxSystemUnit& pTarget) const;
    /// How many of this unit one of the other is.
    [[nodiscard]] double GetConversionFactorFrom(const FbxSystemUnit& pSource) const;

    /// Same factor and same multiplier, exactly.
    bool operator==(const FbxSystemUnit& pOther) const {
        return mScaleFactor == pOther.mScaleFactor && mMultiplier == pOther.mMultiplier;
    }
    bool operator!=(const FbxSystemUnit& pOther) const { return !(*this == pOther); } ///< The opposite.

    static const FbxSystemUnit mm,                           ///< 0.1 cm
        dm,                                                  ///< 10 cm
        cm,                                                  ///< 1 cm
        m,                                                   ///< 100 cm
        km,                                                  ///< 100,000 cm
        Inch,                                                ///< 2.54 cm
        Foot,                                                ///< 30.48 cm
        Mile,                                                ///< 160,934.4 cm
        Yard;                                                ///< 91.44 cm
    static const ConversionOptions DefaultConversionOptions; ///< All true.

private:
    double mScaleFactor = 1.0;
    double mMultiplier = 1.0;
};

FBXSDK_NAMESPACE_END
