// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxAxisSystem.h>
#include <fbxsdk/FbxObject.h>
#include <fbxsdk/FbxSystemUnit.h>

FBXSDK_NAMESPACE_BEGIN

/// Axes, unit, time mode and other settings of a whole scene, kept as properties. Setting them changes no object:
/// conversions are calls of FbxAxisSystem and FbxSystemUnit. Each scene owns one.
class FBXSDK_DLL FbxGlobalSettings : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxGlobalSettings, FbxObject)

public:
    /// Y up and right-handed by default and where a file's axes are inconsistent.
    [[nodiscard]] FbxAxisSystem GetAxisSystem() const;
    void SetAxisSystem(const FbxAxisSystem& pAxisSystem); ///< Stores the axes; no object is rotated.
    /// 0 X, 1 Y, 2 Z; -1 when not stated.
    [[nodiscard]] int GetOriginalUpAxis() const;
    void SetOriginalUpAxis(const FbxAxisSystem& pAxisSystem); ///< Stores the axis and its sign.
    [[nodiscard]] FbxSystemUnit GetSystemUnit() const; ///< Centimetres by default and where a file's number is no unit.
    void SetSystemUnit(const FbxSystemUnit& pOther);   ///< Stores the unit; no object is scaled.
    /// The unit in which the scene was created; centimetres by default.
    [[nodiscard]] FbxSystemUnit GetOriginalSystemUnit() const;
    void SetOriginalSystemUnit(const FbxSystemUnit& pOther); ///< For information.
    [[nodiscard]] FbxColor GetAmbientColor() const;          ///< Opaque; black by default.
    void SetAmbientColor(FbxColor pAmbientColor);            ///< The alpha is not kept.
    /// The name of the camera with which views start; empty by default.
    [[nodiscard]] FbxString GetDefaultCamera() const;
    /// Any name, whether there is such a camera or not; false for null.
    bool SetDefaultCamera(const char* pCameraName);

    [[nodiscard]] FbxTime::EMode GetTimeMode() const; ///< eDefaultMode by default and for a number that is no mode.
    /// Also becomes the thread's global time mode, which is the meaning of eDefaultMode.
    void SetTimeMode(FbxTime::EMode pTimeMode);
    [[nodiscard]] FbxTime::EProtocol GetTimeProtocol() const; ///< eDefaultProtocol by default.
    void SetTimeProtocol(FbxTime::EProtocol pTimeProtocol);   ///< How applications show times.
    /// Frames per second of eCustom; -1 when not stated.
    [[nodiscard]] double GetCustomFrameRate() const;
    /// Frames per second of eCustom; effective on the thread at once when that is the time mode.
    void SetCustomFrameRate(double pCustomFrameRate);
    /// Sets pTimeSpan; from zero to one second by default.
    void GetTimelineDefaultTimeSpan(FbxTimeSpan& pTimeSpan) const;
    void SetTimelineDefaultTimeSpan(const FbxTimeSpan& pTimeSpan); ///< The span that applications show initially.

    /// Makes the scene's time mode the thread's global one.
    void applyTimeMode() const;
};

FBXSDK_NAMESPACE_END
