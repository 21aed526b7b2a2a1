// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Textures: images from files, and layers of other textures.
#pragma once

#include <string>

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

/// What all textures share: use, mapping and placement.
class FBXSDK_DLL FbxTexture : public FbxObject {
    FBXSDK_ABSTRACT_DECLARE(FbxTexture, FbxObject)

public:
    enum ETextureUse {
        eStandard,
        eShadowMap,
        eLightMap,
        eSphericalReflectionMap,
        eSphereReflectionMap,
        eBumpNormalMap
    };
    enum EMappingType { eNull, ePlanar, eSpherical, eCylindrical, eBox, eFace, eUV, eEnvironment };
    enum EWrapMode : int { eRepeat, eClamp };

    FbxPropertyT<FbxDouble> Alpha;
    FbxPropertyT<EWrapMode> WrapModeU, WrapModeV;
    FbxPropertyT<FbxBool> UVSwap;
    FbxPropertyT<FbxBool> PremultiplyAlpha;
    FbxPropertyT<FbxDouble3> Translation, Rotation, Scaling; ///< (u, v, w); the angles in degrees
    FbxPropertyT<FbxDouble3> RotationPivot, ScalingPivot;
    FbxPropertyT<FbxString> UVSet;

    void SetTextureUse(ETextureUse pTextureUse);
    [[nodiscard]] ETextureUse GetTextureUse() const;
    void SetMappingType(EMappingType pMappingType);
    [[nodiscard]] EMappingType GetMappingType() const;
    void SetSwapUV(bool pSwapUV);
    [[nodiscard]] bool GetSwapUV() const;
    void SetTranslation(double pU, double pV);
    [[nodiscard]] double GetTranslationU() const;
    [[nodiscard]] double GetTranslationV() const;
    void SetScale(double pU, double pV);
    [[nodiscard]] double GetScaleU() const;
    [[nodiscard]] double GetScaleV() const;
    void SetRotation(double pU, double pV, double pW = 0.0);
    [[nodiscard]] double GetRotationU() const;
    [[nodiscard]] double GetRotationV() const;
    [[nodiscard]] double GetRotationW() const;

private:
    FbxPropertyT<FbxEnum> mTextureUse, mMapping;
};

/// An image file. Names are stored as given; no file is touched.
class FBXSDK_DLL FbxFileTexture : public FbxTexture {
    FBXSDK_OBJECT_DECLARE(FbxFileTexture, FbxTexture)

public:
    enum EMaterialUse { eModelMaterial, eDefaultMaterial };

    FbxPropertyT<FbxBool> UseMaterial;
    FbxPropertyT<FbxBool> UseMipMap;

    /// Null is the empty name. A relative name that is empty becomes the file's name without its folder. Always true.
    bool SetFileName(const char* pName);
    [[nodiscard]] const char* GetFileName() const;
    bool SetRelativeFileName(const char* pName);
    [[nodiscard]] const char* GetRelativeFileName() const;
    void SetMaterialUse(EMaterialUse pMaterialUse) { mMaterialUse = pMaterialUse; }
    [[nodiscard]] EMaterialUse GetMaterialUse() const { return mMaterialUse; }

private:
    std::string mFileName, mRelativeFileName;
    EMaterialUse mMaterialUse = eModelMaterial;
};

/// Several textures, its sources, over one another.
class FBXSDK_DLL FbxLayeredTexture : public FbxTexture {
    FBXSDK_OBJECT_DECLARE(FbxLayeredTexture, FbxTexture)
};

FBXSDK_NAMESPACE_END
