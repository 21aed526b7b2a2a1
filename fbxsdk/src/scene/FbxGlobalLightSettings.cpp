// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Ambient light and fog. The ambient colour is kept in the global settings; the rest can be stored in files before 7.x
// only.
#include <fbxsdk/FbxGlobalLightSettings.h>

#include <fbxsdk/FbxScene.h>

FBXSDK_NAMESPACE_BEGIN

void FbxGlobalLightSettings::SetAmbientColor(FbxColor pAmbientColor) {
    mAmbientAlpha = pAmbientColor.mAlpha;
    mScene->GetGlobalSettings().SetAmbientColor(pAmbientColor);
}

FbxColor FbxGlobalLightSettings::GetAmbientColor() const {
    FbxColor color = static_cast<const FbxScene*>(mScene)->GetGlobalSettings().GetAmbientColor();
    color.mAlpha = mAmbientAlpha;
    return color;
}

void FbxGlobalLightSettings::RestoreDefaultSettings() {
    *this = FbxGlobalLightSettings(*mScene);
    SetAmbientColor(FbxColor(0.0, 0.0, 0.0));
}

FBXSDK_NAMESPACE_END
