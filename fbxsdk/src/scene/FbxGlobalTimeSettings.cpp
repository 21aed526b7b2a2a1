// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Time settings of the old kind, kept in the global settings.
#include <fbxsdk/FbxGlobalTimeSettings.h>

#include <fbxsdk/FbxScene.h>

FBXSDK_NAMESPACE_BEGIN

void FbxGlobalTimeSettings::SetTimeMode(FbxTime::EMode pTimeMode) {
    mScene->GetGlobalSettings().SetTimeMode(pTimeMode);
}

FbxTime::EMode FbxGlobalTimeSettings::GetTimeMode() const { return mScene->GetGlobalSettings().GetTimeMode(); }

FBXSDK_NAMESPACE_END
