// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Folders that a write may create.
#pragma once

#include <filesystem>
#include <system_error>
#include <vector>

#include <unistd.h>

namespace Tarnell::Fbx::detail {

/// Removes the new folders again, unless they are kept or not empty.
class NewFolders {
public:
    /// For that folder and its ancestors.
    explicit NewFolders(std::filesystem::path folder) {
        std::error_code failure;
        while (folder.has_relative_path() && !std::filesystem::exists(folder, failure) && !failure) {
            mFolders.push_back(folder);
            folder = folder.parent_path();
        }
    }
    ~NewFolders() {
        for (const std::filesystem::path& folder : mFolders)
            ::rmdir(folder.c_str());
    }
    NewFolders(const NewFolders&) = delete;
    NewFolders& operator=(const NewFolders&) = delete;

    void keep() { mFolders.clear(); }

private:
    std::vector<std::filesystem::path> mFolders; // the innermost first
};

} // namespace Tarnell::Fbx::detail
