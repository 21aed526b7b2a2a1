// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Folders that a write may make on its way.
#pragma once

#include <filesystem>
#include <system_error>
#include <vector>

#include <unistd.h>

namespace Tarnell::Fbx::detail {

/// Takes the folders away again that were not there before, unless they are kept or hold something.
class NewFolders {
public:
    /// Of that folder and those that it is in.
    explicit NewFolders(std::filesystem::path folder) {
        std::error_code failure;
        while (folder.has_relative_path() && !std::filesystem::exists(folder, failure) && !failure) {
            mFolders.push_back(folder);
            folder = folder.parent_path();
        }
    }
    ~NewFolders() {
        for (const std::filesystem::path& folder : mFolders) {
            ::rmdir(folder.c_str());
        }
    }
    NewFolders(const NewFolders&) = delete;
    NewFolders& operator=(const NewFolders&) = delete;

    void keep() { mFolders.clear(); }

private:
    std::vector<std::filesystem::path> mFolders; // the innermost first
};

} // namespace Tarnell::Fbx::detail
