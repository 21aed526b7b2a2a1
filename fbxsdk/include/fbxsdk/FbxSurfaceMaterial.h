// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Materials: the generic one, and the two with a known shading model.
#pragma once

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

/// A material of any shading model. Nodes have materials (FbxNode::AddMaterial); layer elements assign them to
/// polygons.
class FBXSDK_DLL FbxSurfaceMaterial : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxSurfaceMaterial, FbxObject)

public:
    FbxPropertyT<FbxString> ShadingModel; ///< "Unknown", "Lambert" or "Phong" by class; any text
    FbxPropertyT<FbxBool> MultiLayer;     ///< whether layers of textures are used; false
};

/// A matt material. Colours are 0 to 1, each with a factor of its own; textures are sources of the properties.
class FBXSDK_DLL FbxSurfaceLambert : public FbxSurfaceMaterial {
    FBXSDK_OBJECT_DECLARE(FbxSurfaceLambert, FbxSurfaceMaterial)

public:
    FbxPropertyT<FbxDouble3> Emissive;                ///< in files EmissiveColor; black, animatable
    FbxPropertyT<FbxDouble> EmissiveFactor;           ///< 1, animatable
    FbxPropertyT<FbxDouble3> Ambient;                 ///< in files AmbientColor; (0.2, 0.2, 0.2), animatable
    FbxPropertyT<FbxDouble> AmbientFactor;            ///< 1, animatable
    FbxPropertyT<FbxDouble3> Diffuse;                 ///< in files DiffuseColor; (0.8, 0.8, 0.8), animatable
    FbxPropertyT<FbxDouble> DiffuseFactor;            ///< 1, animatable
    FbxPropertyT<FbxDouble3> NormalMap,               ///< for a texture of normals; (0, 0, 0)
        Bump;                                         ///< for a texture of heights; (0, 0, 0)
    FbxPropertyT<FbxDouble> BumpFactor;               ///< 1
    FbxPropertyT<FbxDouble3> TransparentColor;        ///< the transmitted colour; black, animatable
    FbxPropertyT<FbxDouble> TransparencyFactor;       ///< 0 opaque (the default) to 1, animatable
    FbxPropertyT<FbxDouble3> DisplacementColor;       ///< for a texture of displacements along the normal; black
    FbxPropertyT<FbxDouble> DisplacementFactor;       ///< 1
    FbxPropertyT<FbxDouble3> VectorDisplacementColor; ///< for a texture of displacements in all directions; black
    FbxPropertyT<FbxDouble> VectorDisplacementFactor; ///< 1
};

/// A shiny material: a matt one with highlights and reflections.
class FBXSDK_DLL FbxSurfacePhong : public FbxSurfaceLambert {
    FBXSDK_OBJECT_DECLARE(FbxSurfacePhong, FbxSurfaceLambert)

public:
    FbxPropertyT<FbxDouble3> Specular;      ///< in files SpecularColor; (0.2, 0.2, 0.2), animatable
    FbxPropertyT<FbxDouble> SpecularFactor; ///< 1, animatable
    FbxPropertyT<FbxDouble> Shininess;   ///< in files ShininessExponent; the exponent of the highlight, 20, animatable
    FbxPropertyT<FbxDouble3> Reflection; ///< in files ReflectionColor; black, animatable
    FbxPropertyT<FbxDouble> ReflectionFactor; ///< 1, animatable
};

FBXSDK_NAMESPACE_END
