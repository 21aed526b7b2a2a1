// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Materials: members bound to their properties.
#include <fbxsdk/FbxSurfaceMaterial.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxSurfaceMaterial, FbxObject, detail::kMaterialRows)
FBXSDK_OBJECT_IMPLEMENT(FbxSurfaceLambert, FbxSurfaceMaterial, detail::kLambertRows)
FBXSDK_OBJECT_IMPLEMENT(FbxSurfacePhong, FbxSurfaceLambert, detail::kPhongRows)

FbxSurfaceMaterial::FbxSurfaceMaterial(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxObject(pManager, pInfo), ShadingModel(detail::bindProperty<FbxString>(*this, "ShadingModel")),
      MultiLayer(detail::bindProperty<FbxBool>(*this, "MultiLayer")) {}

FbxSurfaceMaterial::~FbxSurfaceMaterial() = default;

FbxSurfaceLambert::FbxSurfaceLambert(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxSurfaceMaterial(pManager, pInfo), Emissive(detail::bindProperty<FbxDouble3>(*this, "EmissiveColor")),
      EmissiveFactor(detail::bindProperty<FbxDouble>(*this, "EmissiveFactor")),
      Ambient(detail::bindProperty<FbxDouble3>(*this, "AmbientColor")),
      AmbientFactor(detail::bindProperty<FbxDouble>(*this, "AmbientFactor")),
      Diffuse(detail::bindProperty<FbxDouble3>(*this, "DiffuseColor")),
      DiffuseFactor(detail::bindProperty<FbxDouble>(*this, "DiffuseFactor")),
      NormalMap(detail::bindProperty<FbxDouble3>(*this, "NormalMap")),
      Bump(detail::bindProperty<FbxDouble3>(*this, "Bump")),
      BumpFactor(detail::bindProperty<FbxDouble>(*this, "BumpFactor")),
      TransparentColor(detail::bindProperty<FbxDouble3>(*this, "TransparentColor")),
      TransparencyFactor(detail::bindProperty<FbxDouble>(*this, "TransparencyFactor")),
      DisplacementColor(detail::bindProperty<FbxDouble3>(*this, "DisplacementColor")),
      DisplacementFactor(detail::bindProperty<FbxDouble>(*this, "DisplacementFactor")),
      VectorDisplacementColor(detail::bindProperty<FbxDouble3>(*this, "VectorDisplacementColor")),
      VectorDisplacementFactor(detail::bindProperty<FbxDouble>(*this, "VectorDisplacementFactor")) {}

FbxSurfaceLambert::~FbxSurfaceLambert() = default;

FbxSurfacePhong::FbxSurfacePhong(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxSurfaceLambert(pManager, pInfo), Specular(detail::bindProperty<FbxDouble3>(*this, "SpecularColor")),
      SpecularFactor(detail::bindProperty<FbxDouble>(*this, "SpecularFactor")),
      Shininess(detail::bindProperty<FbxDouble>(*this, "ShininessExponent")),
      Reflection(detail::bindProperty<FbxDouble3>(*this, "ReflectionColor")),
      ReflectionFactor(detail::bindProperty<FbxDouble>(*this, "ReflectionFactor")) {}

FbxSurfacePhong::~FbxSurfacePhong() = default;

FBXSDK_NAMESPACE_END
