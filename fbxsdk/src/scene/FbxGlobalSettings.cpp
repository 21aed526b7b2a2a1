// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Settings of a whole scene, stored as properties under the names that files have.
#include <fbxsdk/FbxGlobalSettings.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxGlobalSettings, FbxObject, detail::kGlobalSettingsRows)

FbxGlobalSettings::FbxGlobalSettings(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxObject(pManager, pInfo) {}
FbxGlobalSettings::~FbxGlobalSettings() = default;

namespace {

int integerOf(const FbxGlobalSettings& settings, const char* name) { return settings.FindProperty(name).Get<FbxInt>(); }

template <class T>
void store(FbxGlobalSettings& settings, const char* name, const T& value) {
    settings.FindProperty(name).Set(value);
}

/// Numbers of files that are no unit count as centimetres.
FbxSystemUnit unitOf(const FbxGlobalSettings& settings, const char* name) {
    const auto scale = settings.FindProperty(name).Get<FbxDouble>();
    constexpr double kLargest = 1e12;
    return scale > 0.0 && scale < kLargest ? FbxSystemUnit(scale) : FbxSystemUnit();
}

} // namespace

FbxAxisSystem FbxGlobalSettings::GetAxisSystem() const {
    return FbxAxisSystem::fromAxes(integerOf(*this, "UpAxis"), integerOf(*this, "UpAxisSign"),
                                   integerOf(*this, "FrontAxis"), integerOf(*this, "FrontAxisSign"),
                                   integerOf(*this, "CoordAxis"), integerOf(*this, "CoordAxisSign"));
}

void FbxGlobalSettings::SetAxisSystem(const FbxAxisSystem& pAxisSystem) {
    const FbxAxisSystem::Axes axes = pAxisSystem.axes();
    store(*this, "UpAxis", axes.up);
    store(*this, "UpAxisSign", axes.upSign);
    store(*this, "FrontAxis", axes.front);
    store(*this, "FrontAxisSign", axes.frontSign);
    store(*this, "CoordAxis", axes.coord);
    store(*this, "CoordAxisSign", axes.coordSign);
}

int FbxGlobalSettings::GetOriginalUpAxis() const { return integerOf(*this, "OriginalUpAxis"); }

void FbxGlobalSettings::SetOriginalUpAxis(const FbxAxisSystem& pAxisSystem) {
    store(*this, "OriginalUpAxis", pAxisSystem.axes().up);
    store(*this, "OriginalUpAxisSign", pAxisSystem.axes().upSign);
}

FbxSystemUnit FbxGlobalSettings::GetSystemUnit() const { return unitOf(*this, "UnitScaleFactor"); }

void FbxGlobalSettings::SetSystemUnit(const FbxSystemUnit& pOther) {
    store(*this, "UnitScaleFactor", pOther.GetScaleFactor());
}

FbxSystemUnit FbxGlobalSettings::GetOriginalSystemUnit() const { return unitOf(*this, "OriginalUnitScaleFactor"); }

void FbxGlobalSettings::SetOriginalSystemUnit(const FbxSystemUnit& pOther) {
    store(*this, "OriginalUnitScaleFactor", pOther.GetScaleFactor());
}

FbxColor FbxGlobalSettings::GetAmbientColor() const {
    const auto color = FindProperty("AmbientColor").Get<FbxDouble3>();
    return {color[0], color[1], color[2], 1.0};
}

void FbxGlobalSettings::SetAmbientColor(FbxColor pAmbientColor) {
    store(*this, "AmbientColor", FbxDouble3(pAmbientColor.mRed, pAmbientColor.mGreen, pAmbientColor.mBlue));
}

FbxString FbxGlobalSettings::GetDefaultCamera() const { return FindProperty("DefaultCamera").Get<FbxString>(); }

bool FbxGlobalSettings::SetDefaultCamera(const char* pCameraName) {
    if (!pCameraName)
        return false;
    store(*this, "DefaultCamera", FbxString(pCameraName));
    return true;
}

FbxTime::EMode FbxGlobalSettings::GetTimeMode() const {
    const int mode = integerOf(*this, "TimeMode");
    return mode > FbxTime::eDefaultMode && mode < FbxTime::eModesCount ? static_cast<FbxTime::EMode>(mode)
                                                                       : FbxTime::eDefaultMode;
}

void FbxGlobalSettings::SetTimeMode(FbxTime::EMode pTimeMode) {
    store(*this, "TimeMode", static_cast<FbxEnum>(pTimeMode));
    applyTimeMode();
}

FbxTime::EProtocol FbxGlobalSettings::GetTimeProtocol() const {
    const int protocol = integerOf(*this, "TimeProtocol");
    return protocol >= FbxTime::eSMPTE && protocol < FbxTime::eDefaultProtocol
               ? static_cast<FbxTime::EProtocol>(protocol)
               : FbxTime::eDefaultProtocol;
}

void FbxGlobalSettings::SetTimeProtocol(FbxTime::EProtocol pTimeProtocol) {
    store(*this, "TimeProtocol", static_cast<FbxEnum>(pTimeProtocol));
}

double FbxGlobalSettings::GetCustomFrameRate() const { return FindProperty("CustomFrameRate").Get<FbxDouble>(); }

void FbxGlobalSettings::SetCustomFrameRate(double pCustomFrameRate) {
    store(*this, "CustomFrameRate", pCustomFrameRate);
    applyTimeMode();
}

void FbxGlobalSettings::GetTimelineDefaultTimeSpan(FbxTimeSpan& pTimeSpan) const {
    pTimeSpan.Set(FindProperty("TimeSpanStart").Get<FbxTime>(), FindProperty("TimeSpanStop").Get<FbxTime>());
}

void FbxGlobalSettings::SetTimelineDefaultTimeSpan(const FbxTimeSpan& pTimeSpan) {
    store(*this, "TimeSpanStart", pTimeSpan.GetStart());
    store(*this, "TimeSpanStop", pTimeSpan.GetStop());
}

void FbxGlobalSettings::applyTimeMode() const { FbxTime::SetGlobalTimeMode(GetTimeMode(), GetCustomFrameRate()); }

FBXSDK_NAMESPACE_END
