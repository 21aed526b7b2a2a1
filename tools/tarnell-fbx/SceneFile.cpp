// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Opening files.
#include "SceneFile.h"

#include <cmath>

namespace tool {

SceneFile::SceneFile(const std::string& file) : mManager(FbxManager::Create()) {
    mImporter = FbxImporter::Create(mManager.get(), "");
    mScene = FbxScene::Create(mManager.get(), "");
    if (!mImporter->Initialize(file.c_str(), -1, nullptr) || !mImporter->Import(mScene, false))
        throw Unreadable(mImporter->GetStatus().GetErrorString());
}

double SceneFile::frameRate() const {
    if (timeMode() == FbxTime::eCustom) {
        const double rate = mScene->GetGlobalSettings().GetCustomFrameRate();
        return std::isfinite(rate) && rate > 0.0 ? rate : FbxTime::GetFrameRate(FbxTime::eCustom);
    }
    // Those of television are a thousandth below a whole number, and rounded to a few decimals.
    const double rate = FbxTime::GetFrameRate(timeMode());
    const double television = std::ceil(rate) * 1000.0 / 1001.0;
    constexpr double kRounding = 2e-4;
    return std::abs(rate - television) < kRounding ? television : rate;
}

FbxAnimStack* SceneFile::chooseTake(const std::string& name) const {
    const int count = mScene->GetSrcObjectCount<FbxAnimStack>();
    if (name.empty())
        return count > 0 ? mScene->GetSrcObject<FbxAnimStack>(0) : nullptr;
    std::string known;
    for (int i = 0; i < count; ++i) {
        auto* stack = mScene->GetSrcObject<FbxAnimStack>(i);
        if (name == stack->GetName()) {
            mScene->SetCurrentAnimationStack(stack);
            return stack;
        }
        known += std::string(known.empty() ? "\"" : ", \"") + stack->GetName() + '"';
    }
    throw Unreadable("there is no take \"" + name + "\"; takes: " + (known.empty() ? "none" : known));
}

} // namespace tool
