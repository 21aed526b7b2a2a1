// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Time settings of files before 7.x. The scene's time mode is in FbxGlobalSettings.
#pragma once

#include <fbxsdk/FbxTime.h>

FBXSDK_NAMESPACE_BEGIN

class FbxScene;

class FBXSDK_DLL FbxGlobalTimeSettings {
public:
    explicit FbxGlobalTimeSettings(FbxScene& pScene) : mScene(&pScene) {}

    void SetTimeMode(FbxTime::EMode pTimeMode);
    [[nodiscard]] FbxTime::EMode GetTimeMode() const;

private:
    FbxScene* mScene;
};

FBXSDK_NAMESPACE_END
