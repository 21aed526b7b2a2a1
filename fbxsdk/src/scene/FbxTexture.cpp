// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Textures. Files number the mapping types in their own way: with them UV is 0.
#include <fbxsdk/FbxTexture.h>

#include <fbxsdk/FbxPathUtils.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_ABSTRACT_IMPLEMENT(FbxTexture, FbxObject)
FBXSDK_OBJECT_IMPLEMENT(FbxFileTexture, FbxTexture, detail::kFileTextureRows)
FBXSDK_OBJECT_IMPLEMENT(FbxLayeredTexture, FbxTexture, detail::kLayeredTextureRows)

namespace {

/// Converts a mapping type to its number in files, and back: UV (6) and none (0) are exchanged. Only the number of UV
/// is known from files; the others keep those of the enumerators.
constexpr FbxEnum exchangedMapping(FbxEnum number) {
    if (number == FbxTexture::eUV)
        return FbxTexture::eNull;
    if (number == FbxTexture::eNull)
        return FbxTexture::eUV;
    return number;
}

std::string textOf(const char* text) { return text ? text : ""; }

} // namespace

FbxTexture::FbxTexture(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxObject(pManager, pInfo), Alpha(detail::bindProperty<FbxDouble>(*this, "Texture alpha")),
      WrapModeU(detail::bindProperty<EWrapMode>(*this, "WrapModeU")),
      WrapModeV(detail::bindProperty<EWrapMode>(*this, "WrapModeV")),
      UVSwap(detail::bindProperty<FbxBool>(*this, "UVSwap")),
      PremultiplyAlpha(detail::bindProperty<FbxBool>(*this, "PremultiplyAlpha")),
      Translation(detail::bindProperty<FbxDouble3>(*this, "Translation")),
      Rotation(detail::bindProperty<FbxDouble3>(*this, "Rotation")),
      Scaling(detail::bindProperty<FbxDouble3>(*this, "Scaling")),
      RotationPivot(detail::bindProperty<FbxDouble3>(*this, "TextureRotationPivot")),
      ScalingPivot(detail::bindProperty<FbxDouble3>(*this, "TextureScalingPivot")),
      UVSet(detail::bindProperty<FbxString>(*this, "UVSet")),
      mTextureUse(detail::bindProperty<FbxEnum>(*this, "TextureTypeUse")),
      mMapping(detail::bindProperty<FbxEnum>(*this, "CurrentMappingType")) {}

FbxTexture::~FbxTexture() = default;

void FbxTexture::SetTextureUse(ETextureUse pTextureUse) { mTextureUse.Set(pTextureUse); }

FbxTexture::ETextureUse FbxTexture::GetTextureUse() const {
    const FbxEnum use = mTextureUse.Get();
    return use >= eStandard && use <= eBumpNormalMap ? static_cast<ETextureUse>(use) : eStandard;
}

void FbxTexture::SetMappingType(EMappingType pMappingType) { mMapping.Set(exchangedMapping(pMappingType)); }

FbxTexture::EMappingType FbxTexture::GetMappingType() const {
    const FbxEnum mapping = exchangedMapping(mMapping.Get());
    return mapping >= eNull && mapping <= eEnvironment ? static_cast<EMappingType>(mapping) : eNull;
}

void FbxTexture::SetSwapUV(bool pSwapUV) { UVSwap.Set(pSwapUV); }

bool FbxTexture::GetSwapUV() const { return UVSwap.Get(); }

void FbxTexture::SetTranslation(double pU, double pV) { Translation.Set(FbxDouble3(pU, pV, Translation.Get()[2])); }

double FbxTexture::GetTranslationU() const { return Translation.Get()[0]; }

double FbxTexture::GetTranslationV() const { return Translation.Get()[1]; }

void FbxTexture::SetScale(double pU, double pV) { Scaling.Set(FbxDouble3(pU, pV, Scaling.Get()[2])); }

double FbxTexture::GetScaleU() const { return Scaling.Get()[0]; }

double FbxTexture::GetScaleV() const { return Scaling.Get()[1]; }

void FbxTexture::SetRotation(double pU, double pV, double pW) { Rotation.Set(FbxDouble3(pU, pV, pW)); }

double FbxTexture::GetRotationU() const { return Rotation.Get()[0]; }

double FbxTexture::GetRotationV() const { return Rotation.Get()[1]; }

double FbxTexture::GetRotationW() const { return Rotation.Get()[2]; }

FbxFileTexture::FbxFileTexture(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxTexture(pManager, pInfo), UseMaterial(detail::bindProperty<FbxBool>(*this, "UseMaterial")),
      UseMipMap(detail::bindProperty<FbxBool>(*this, "UseMipMap")) {}

FbxFileTexture::~FbxFileTexture() = default;

bool FbxFileTexture::SetFileName(const char* pName) {
    mFileName = textOf(pName);
    if (mRelativeFileName.empty())
        mRelativeFileName = FbxPathUtils::GetFileName(mFileName.c_str()).Buffer();
    return true;
}

const char* FbxFileTexture::GetFileName() const { return mFileName.c_str(); }

bool FbxFileTexture::SetRelativeFileName(const char* pName) {
    mRelativeFileName = textOf(pName);
    return true;
}

const char* FbxFileTexture::GetRelativeFileName() const { return mRelativeFileName.c_str(); }

FbxLayeredTexture::FbxLayeredTexture(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxTexture(pManager, pInfo) {}

FbxLayeredTexture::~FbxLayeredTexture() = default;

FBXSDK_NAMESPACE_END
