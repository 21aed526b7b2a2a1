// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <memory>
#include <stdexcept>
#include <string>

#include <fbxsdk.h>

namespace tool {

/// Why a file cannot be shown. The message may begin with the file's name.
class Unreadable : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// A file as the inspecting commands use it: the scene, before any conversion, and the facts of the file itself.
class SceneFile {
public:
    /// Throws Unreadable.
    explicit SceneFile(const std::string& file);

    [[nodiscard]] FbxScene& scene() const { return *mScene; }
    [[nodiscard]] FbxImporter& importer() const { return *mImporter; }
    [[nodiscard]] FbxTime::EMode timeMode() const { return mScene->GetGlobalSettings().GetTimeMode(); }
    /// Frames per second; also where the file has a rate of its own. That of television is exact: 24000/1001 where the
    /// application says 23.976.
    [[nodiscard]] double frameRate() const;

    /// Whether the file identifies its objects by numbers, as files from 7.0 on do.
    [[nodiscard]] bool hasIds() const { return mImporter->GetFileHeaderInfo()->mFileVersion >= 7000; }

    /// Selects the stack of that name for evaluation; an empty name means the first. Null when the file has
    /// none. Throws Unreadable, with the existing names, when there is none of that name.
    FbxAnimStack* chooseTake(const std::string& name) const;

private:
    struct Destroyer {
        void operator()(FbxManager* manager) const { manager->Destroy(); }
    };
    std::unique_ptr<FbxManager, Destroyer> mManager;
    FbxImporter* mImporter = nullptr;
    FbxScene* mScene = nullptr;
};

} // namespace tool
