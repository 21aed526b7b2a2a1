// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Opening files.
#include "SceneFile.h"

namespace tool {

SceneFile::SceneFile(const std::string& file) : mManager(FbxManager::Create()) {
    mImporter = FbxImporter::Create(mManager.get(), "");
    mScene = FbxScene::Create(mManager.get(), "");
    if (!mImporter->Initialize(file.c_str(), -1, nullptr) || !mImporter->Import(mScene, false))
        throw Unreadable(mImporter->GetStatus().GetErrorString());
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
    throw Unreadable("it has no take \"" + name + "\"; its takes: " + (known.empty() ? "none" : known));
}

} // namespace tool
