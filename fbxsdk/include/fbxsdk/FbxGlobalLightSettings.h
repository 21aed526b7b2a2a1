// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxColor.h>

FBXSDK_NAMESPACE_BEGIN

class FbxScene;

/// Ambient light and fog. Files before 7.0 hold both; later ones hold only the ambient colour, so that the fog is lost
/// with them.
class FBXSDK_DLL FbxGlobalLightSettings {
public:
    /// How the fog density grows with the distance.
    enum EFogMode {
        eLinear,               ///< linearly, from start to end
        eExponential,          ///< exponentially, by the density
        eExponentialSquareRoot ///< exponentially with the square of the distance, by the density
    };

    explicit FbxGlobalLightSettings(FbxScene& pScene) : mScene(&pScene) {} ///< For the scene, which owns one.

    /// The ambient colour of the global settings, where 7.x files keep it, plus an alpha.
    void SetAmbientColor(FbxColor pAmbientColor);
    [[nodiscard]] FbxColor GetAmbientColor() const;                    ///< Opaque black by default.
    void SetFogEnable(bool pEnable) { mFogEnable = pEnable; }          ///< Whether there is fog.
    [[nodiscard]] bool GetFogEnable() const { return mFogEnable; }     ///< False by default.
    void SetFogColor(FbxColor pColor) { mFogColor = pColor; }          ///< 0 to 1; not checked.
    [[nodiscard]] FbxColor GetFogColor() const { return mFogColor; }   ///< Opaque white by default.
    void SetFogMode(EFogMode pMode) { mFogMode = pMode; }              ///< Which of the following numbers are used.
    [[nodiscard]] EFogMode GetFogMode() const { return mFogMode; }     ///< eLinear by default.
    void SetFogDensity(double pDensity) { mFogDensity = pDensity; }    ///< Of both exponential modes.
    [[nodiscard]] double GetFogDensity() const { return mFogDensity; } ///< 0.002 by default.
    void SetFogStart(double pStart) { mFogStart = pStart; } ///< Distance at which linear fog begins, scene units.
    [[nodiscard]] double GetFogStart() const { return mFogStart; } ///< 0.3 by default.
    void SetFogEnd(double pEnd) { mFogEnd = pEnd; }            ///< Distance at which linear fog is full, scene units.
    [[nodiscard]] double GetFogEnd() const { return mFogEnd; } ///< 1000 by default.
    void RestoreDefaultSettings();                             ///< Black ambient light and no fog.

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
