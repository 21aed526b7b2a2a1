// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Materials: the plain one, and the two whose shading model is known.
#pragma once

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

/// A material of any shading model.
class FBXSDK_DLL FbxSurfaceMaterial : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxSurfaceMaterial, FbxObject)

public:
    FbxPropertyT<FbxString> ShadingModel;
    FbxPropertyT<FbxBool> MultiLayer;
};

/// Colours are 0 to 1, each with a factor of its own.
class FBXSDK_DLL FbxSurfaceLambert : public FbxSurfaceMaterial {
    FBXSDK_OBJECT_DECLARE(FbxSurfaceLambert, FbxSurfaceMaterial)

public:
    FbxPropertyT<FbxDouble3> Emissive; ///< in files EmissiveColor
    FbxPropertyT<FbxDouble> EmissiveFactor;
    FbxPropertyT<FbxDouble3> Ambient; ///< in files AmbientColor
    FbxPropertyT<FbxDouble> AmbientFactor;
    FbxPropertyT<FbxDouble3> Diffuse; ///< in files DiffuseColor
    FbxPropertyT<FbxDouble> DiffuseFactor;
    FbxPropertyT<FbxDouble3> NormalMap, Bump;
    FbxPropertyT<FbxDouble> BumpFactor;
    FbxPropertyT<FbxDouble3> TransparentColor;
    FbxPropertyT<FbxDouble> TransparencyFactor;
    FbxPropertyT<FbxDouble3> DisplacementColor;
    FbxPropertyT<FbxDouble> DisplacementFactor;
    FbxPropertyT<FbxDouble3> VectorDisplacementColor;
    FbxPropertyT<FbxDouble> VectorDisplacementFactor;
};

class FBXSDK_DLL FbxSurfacePhong : public FbxSurfaceLambert {
    FBXSDK_OBJECT_DECLARE(FbxSurfacePhong, FbxSurfaceLambert)

public:
    FbxPropertyT<FbxDouble3> Specular; ///< in files SpecularColor
    FbxPropertyT<FbxDouble> SpecularFactor;
    FbxPropertyT<FbxDouble> Shininess;   ///< in files ShininessExponent
    FbxPropertyT<FbxDouble3> Reflection; ///< in files ReflectionColor
    FbxPropertyT<FbxDouble> ReflectionFactor;
};

FBXSDK_NAMESPACE_END
