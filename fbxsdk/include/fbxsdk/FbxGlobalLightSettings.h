// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Ambient light and fog, which files before 7.x have a place for.
#pragma once

#include <fbxsdk/FbxColor.h>

FBXSDK_NAMESPACE_BEGIN

class FbxScene;

class FBXSDK_DLL FbxGlobalLightSettings {
public:
    enum EFogMode { eLinear, eExponential, eExponentialSquareRoot };

    explicit FbxGlobalLightSettings(FbxScene& pScene) : mScene(&pScene) {}

    /// The ambient colour of the global settings, where 7.x files keep it, and an alpha beside it.
    void SetAmbientColor(FbxColor pAmbientColor);
    [[nodiscard]] FbxColor GetAmbientColor() const;
    void SetFogEnable(bool pEnable) { mFogEnable = pEnable; }
    [[nodiscard]] bool GetFogEnable() const { return mFogEnable; }
    void SetFogColor(FbxColor pColor) { mFogColor = pColor; }
    [[nodiscard]] FbxColor GetFogColor() const { return mFogColor; }
    void SetFogMode(EFogMode pMode) { mFogMode = pMode; }
    [[nodiscard]] EFogMode GetFogMode() const { return mFogMode; }
    void SetFogDensity(double pDensity) { mFogDensity = pDensity; }
    [[nodiscard]] double GetFogDensity() const { return mFogDensity; }
    void SetFogStart(double pStart) { mFogStart = pStart; }
    [[nodiscard]] double GetFogStart() const { return mFogStart; }
    void SetFogEnd(double pEnd) { mFogEnd = pEnd; }
    [[nodiscard]] double GetFogEnd() const { return mFogEnd; }
    void RestoreDefaultSettings();

private:
    FbxScene* mScene;
    double mAmbientAlpha = 1.0;
    FbxColor mFogColor{1.0, 1.0, 1.0, 1.0};
    bool mFogEnable = false;
    EFogMode mFogMode = eLinear;
    double mFogDensity = 0.002;
    double mFogStart = 0.3;
    double mFogEnd = 1000.0;
};

FBXSDK_NAMESPACE_END
