// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Textures: images from files, and layers of other textures.
#pragma once

#include <string>

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

/// The common part of all textures: use, mapping and placement. A texture is a source of the property that it colours.
class FBXSDK_DLL FbxTexture : public FbxObject {
    FBXSDK_ABSTRACT_DECLARE(FbxTexture, FbxObject)

public:
    /// What the texture is for.
    enum ETextureUse {
        eStandard,               ///< a colour; the default
        eShadowMap,              ///< shadows
        eLightMap,               ///< light
        eSphericalReflectionMap, ///< a reflected environment, by angles
        eSphereReflectionMap,    ///< a reflected environment, as seen in a sphere
        eBumpNormalMap           ///< the direction of normals
    };
    /// How a surface gets its coordinates.
    enum EMappingType {
        eNull,        ///< not set
        ePlanar,      ///< planar projection
        eSpherical,   ///< spherical projection
        eCylindrical, ///< cylindrical projection
        eBox,         ///< projection from six planes
        eFace,        ///< each face separately
        eUV,          ///< by the geometry's texture coordinates; the default
        eEnvironment  ///< by reflection
    };
    /// The content beyond the coordinates 0 and 1.
    enum EWrapMode : int {
        eRepeat, ///< the image repeated; the default
        eClamp   ///< the colour of its border
    };

    FbxPropertyT<FbxDouble> Alpha;          ///< in files "Texture alpha"; 0 to 1; 1, animatable
    FbxPropertyT<EWrapMode> WrapModeU,      ///< along u; eRepeat
        WrapModeV;                          ///< along v; eRepeat
    FbxPropertyT<FbxBool> UVSwap;           ///< whether u and v are swapped; false
    FbxPropertyT<FbxBool> PremultiplyAlpha; ///< whether colours are multiplied by alpha; true
    FbxPropertyT<FbxDouble3> Translation,   ///< (u, v, w); (0, 0, 0), animatable
        Rotation,                           ///< about (u, v, w), degrees; (0, 0, 0), animatable
        Scaling;                            ///< (u, v, w); (1, 1, 1), animatable
    FbxPropertyT<FbxDouble3> RotationPivot, ///< in files TextureRotationPivot; (0, 0, 0)
        ScalingPivot;                       ///< in files TextureScalingPivot; (0, 0, 0)
    FbxPropertyT<FbxString> UVSet;          ///< the name of the set of texture coordinates; "default"

    void SetTextureUse(ETextureUse pTextureUse);     ///< In files TextureTypeUse.
    [[nodiscard]] ETextureUse GetTextureUse() const; ///< eStandard by default and for a number that is no use.
    /// In files CurrentMappingType, where the numbers of eNull and eUV are swapped.
    void SetMappingType(EMappingType pMappingType);
    [[nodiscard]] EMappingType GetMappingType() const;       ///< eUV by default, eNull for a number that is no mapping.
    void SetSwapUV(bool pSwapUV);                            ///< The property UVSwap.
    [[nodiscard]] bool GetSwapUV() const;                    ///< False by default.
    void SetTranslation(double pU, double pV);               ///< Sets u and v of the property Translation; w stays.
    [[nodiscard]] double GetTranslationU() const;            ///< 0 by default.
    [[nodiscard]] double GetTranslationV() const;            ///< 0 by default.
    void SetScale(double pU, double pV);                     ///< Sets u and v of the property Scaling; w is unchanged.
    [[nodiscard]] double GetScaleU() const;                  ///< 1 by default.
    [[nodiscard]] double GetScaleV() const;                  ///< 1 by default.
    void SetRotation(double pU, double pV, double pW = 0.0); ///< Sets the property Rotation, degrees.
    [[nodiscard]] double GetRotationU() const;               ///< Degrees.
    [[nodiscard]] double GetRotationV() const;               ///< Degrees.
    [[nodiscard]] double GetRotationW() const;               ///< Degrees; the rotation within the plane of u and v.

private:
    FbxPropertyT<FbxEnum> mTextureUse, mMapping;
};

/// A texture whose image is a file. Names are stored as given, UTF-8; no file is accessed.
class FBXSDK_DLL FbxFileTexture : public FbxTexture {
    FBXSDK_OBJECT_DECLARE(FbxFileTexture, FbxTexture)

public:
    /// Whether the material's own colour is used besides the texture; kept in memory, not in files.
    enum EMaterialUse {
        eModelMaterial,  ///< the model's material; the default
        eDefaultMaterial ///< a default material
    };

    FbxPropertyT<FbxBool> UseMaterial; ///< whether the material's colour is mixed in; false
    FbxPropertyT<FbxBool> UseMipMap;   ///< whether smaller images are used far away; false

    /// Null is the empty name. A relative name that is empty becomes the file's name without its folder. Always true.
    bool SetFileName(const char* pName);
    [[nodiscard]] const char* GetFileName() const;         ///< Never null; valid until the name changes.
    bool SetRelativeFileName(const char* pName);           ///< Null is the empty name. Always true.
    [[nodiscard]] const char* GetRelativeFileName() const; ///< Never null; valid until the name changes.
    void SetMaterialUse(EMaterialUse pMaterialUse) { mMaterialUse = pMaterialUse; } ///< Any value is stored.
    [[nodiscard]] EMaterialUse GetMaterialUse() const { return mMaterialUse; }      ///< eModelMaterial by default.

private:
    std::string mFileName, mRelativeFileName;
    EMaterialUse mMaterialUse = eModelMaterial;
};

/// Several textures stacked: its sources, the lowest first.
class FBXSDK_DLL FbxLayeredTexture : public FbxTexture {
    FBXSDK_OBJECT_DECLARE(FbxLayeredTexture, FbxTexture)
};

FBXSDK_NAMESPACE_END
