// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Axes, unit, time mode and other settings of a whole scene.
#pragma once

#include <fbxsdk/FbxAxisSystem.h>
#include <fbxsdk/FbxObject.h>
#include <fbxsdk/FbxSystemUnit.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxGlobalSettings : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxGlobalSettings, FbxObject)

public:
    [[nodiscard]] FbxAxisSystem GetAxisSystem() const;
    void SetAxisSystem(const FbxAxisSystem& pAxisSystem);
    /// 0 X, 1 Y, 2 Z; -1 when not stated.
    [[nodiscard]] int GetOriginalUpAxis() const;
    void SetOriginalUpAxis(const FbxAxisSystem& pAxisSystem);
    [[nodiscard]] FbxSystemUnit GetSystemUnit() const;
    void SetSystemUnit(const FbxSystemUnit& pOther);
    [[nodiscard]] FbxSystemUnit GetOriginalSystemUnit() const;
    void SetOriginalSystemUnit(const FbxSystemUnit& pOther);
    [[nodiscard]] FbxColor GetAmbientColor() const;
    void SetAmbientColor(FbxColor pAmbientColor);
    [[nodiscard]] FbxString GetDefaultCamera() const;
    bool SetDefaultCamera(const char* pCameraName);

    [[nodiscard]] FbxTime::EMode GetTimeMode() const;
    /// Also becomes the thread's global time mode, which eDefaultMode stands for.
    void SetTimeMode(FbxTime::EMode pTimeMode);
    [[nodiscard]] FbxTime::EProtocol GetTimeProtocol() const;
    void SetTimeProtocol(FbxTime::EProtocol pTimeProtocol);
    /// Frames per second of eCustom; -1 when not stated.
    [[nodiscard]] double GetCustomFrameRate() const;
    void SetCustomFrameRate(double pCustomFrameRate);
    void GetTimelineDefaultTimeSpan(FbxTimeSpan& pTimeSpan) const;
    void SetTimelineDefaultTimeSpan(const FbxTimeSpan& pTimeSpan);

    /// Makes the scene's time mode the thread's global one.
    void applyTimeMode() const;
};

FBXSDK_NAMESPACE_END
