// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Units of length: how many centimetres one unit is, and the conversion of scenes between units.
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

class FbxNode;
class FbxScene;

class FBXSDK_DLL FbxSystemUnit {
public:
    struct ConversionOptions {
        bool mConvertRrsNodes = true; ///< nodes that do not inherit their parent's scale
        bool mConvertLimits = true;
        bool mConvertClusters = true;
        bool mConvertLightIntensity = true; ///< of no effect: intensities stay as the file has them
        bool mConvertPhotometricLProperties = true;
        bool mConvertCameraClipPlanes = true;
    };

    constexpr FbxSystemUnit() = default; ///< centimetres
    constexpr FbxSystemUnit(double pScaleFactor, double pMultiplier = 1.0)
        : mScaleFactor(pScaleFactor), mMultiplier(pMultiplier) {}

    /// Scales the nodes below the root, their curves included, so that every global matrix is the old one in the new
    /// unit. Mesh points stay.
    void ConvertScene(FbxScene* pScene, const ConversionOptions& pOptions = DefaultConversionOptions) const;
    void ConvertScene(FbxScene* pScene, FbxNode* pFbxRoot,
                      const ConversionOptions& pOptions = DefaultConversionOptions) const;
    void ConvertChildren(FbxNode* pRoot, const FbxSystemUnit& pSrcUnit,
                         const ConversionOptions& pOptions = DefaultConversionOptions) const;

    /// Centimetres per unit.
    [[nodiscard]] double GetScaleFactor() const { return mScaleFactor; }
    [[nodiscard]] double GetMultiplier() const { return mMultiplier; }
    [[nodiscard]] double GetConversionFactorTo(const FbxSystemUnit& pTarget) const;
    [[nodiscard]] double GetConversionFactorFrom(const FbxSystemUnit& pSource) const;

    bool operator==(const FbxSystemUnit& pOther) const {
        return mScaleFactor == pOther.mScaleFactor && mMultiplier == pOther.mMultiplier;
    }
    bool operator!=(const FbxSystemUnit& pOther) const { return !(*this == pOther); }

    static const FbxSystemUnit mm, dm, cm, m, km, Inch, Foot, Mile, Yard;
    static const ConversionOptions DefaultConversionOptions;

private:
    double mScaleFactor = 1.0;
    double mMultiplier = 1.0;
};

FBXSDK_NAMESPACE_END
