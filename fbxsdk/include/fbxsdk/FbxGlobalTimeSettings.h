// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxTime.h>

FBXSDK_NAMESPACE_BEGIN

class FbxScene;

/// Time settings of files before 7.x. They are those of FbxGlobalSettings, under another name.
class FBXSDK_DLL FbxGlobalTimeSettings {
public:
    explicit FbxGlobalTimeSettings(FbxScene& pScene) : mScene(&pScene) {} ///< For the scene, which owns one.

    void SetTimeMode(FbxTime::EMode pTimeMode);       ///< Also becomes the thread's global time mode.
    [[nodiscard]] FbxTime::EMode GetTimeMode() const; ///< The scene's time mode.

private:
    FbxScene* mScene;
};

FBXSDK_NAMESPACE_END
