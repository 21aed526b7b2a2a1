// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The frame rate of the calling thread belongs to the host: an operation that sets it restores it.
#pragma once

#include <fbxsdk.h>

namespace Tarnell::Fbx::detail {

/// Saves the thread's time mode and restores it at the end of the scope, also when something throws.
class TimeModeScope {
public:
    TimeModeScope()
        : mMode(fbxsdk::FbxTime::GetGlobalTimeMode()),
          mCustomRate(fbxsdk::FbxTime::GetFrameRate(fbxsdk::FbxTime::eCustom)) {}
    /// Sets the scene's rate for the scope. No scene: the mode stays.
    explicit TimeModeScope(const fbxsdk::FbxScene* scene) : TimeModeScope() {
        if (scene != nullptr) {
            const fbxsdk::FbxGlobalSettings& settings = scene->GetGlobalSettings();
            fbxsdk::FbxTime::SetGlobalTimeMode(settings.GetTimeMode(), settings.GetCustomFrameRate());
        }
    }
    ~TimeModeScope() {
        // The custom rate is stored besides the mode, also while another mode is set.
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
