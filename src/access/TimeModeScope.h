// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The rate that the calling thread counts frames at belongs to the host: an operation that sets it gives it back.
#pragma once

#include <fbxsdk.h>

namespace Tarnell::Fbx::detail {

/// Keeps the thread's time mode for as long as it lives and restores it at the end, also when something throws.
class TimeModeScope {
public:
    TimeModeScope()
        : mMode(fbxsdk::FbxTime::GetGlobalTimeMode()),
          mCustomRate(fbxsdk::FbxTime::GetFrameRate(fbxsdk::FbxTime::eCustom)) {}
    /// With the scene's rate in force meanwhile. No scene: the mode stays.
    explicit TimeModeScope(const fbxsdk::FbxScene* scene) : TimeModeScope() {
        if (scene != nullptr) {
            const fbxsdk::FbxGlobalSettings& settings = scene->GetGlobalSettings();
            fbxsdk::FbxTime::SetGlobalTimeMode(settings.GetTimeMode(), settings.GetCustomFrameRate());
        }
    }
    ~TimeModeScope() {
        // The custom rate is kept beside the mode, also while another mode is in force.
        fbxsdk::FbxTime::SetGlobalTimeMode(fbxsdk::FbxTime::eCustom, mCustomRate);
        fbxsdk::FbxTime::SetGlobalTimeMode(mMode, mCustomRate);
    }
    TimeModeScope(const TimeModeScope&) = delete;
    TimeModeScope& operator=(const TimeModeScope&) = delete;

private:
    fbxsdk::FbxTime::EMode mMode;
    double mCustomRate;
};

} // namespace Tarnell::Fbx::detail
