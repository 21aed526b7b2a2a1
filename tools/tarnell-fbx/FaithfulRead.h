// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Faithful reads for commands that show what the application shows.
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

#include "Fbx.h"
#include "SceneFile.h"
#include "TnFbxError.h"
#include "TnFbxReadInfo.h"

namespace tool {

template <class Object>
struct FaithfulObjects {
    std::shared_ptr<Object[]> objects;
    std::size_t count = 0;
    std::vector<std::string> warnings;
};

inline Tarnell::Fbx::TnFbxReadInfo faithfulInfo(const std::string& file, const std::string& take) {
    Tarnell::Fbx::TnFbxReadInfo info;
    info.setFileName(file);
    info.setAnimationStackName(take);
    info.setFidelity(Tarnell::Fbx::kFbxFidelityFaithful);
    return info;
}

/// All objects of a kind, in the order of the tree. Throws Unreadable.
template <class Object>
FaithfulObjects<Object> readFaithfully(Tarnell::Fbx::TnFbxReadInfo info,
                                       bool (Tarnell::Fbx::Fbx::*read)(Tarnell::Fbx::TnFbxReadInfo&, Object**, int&)
                                           const) {
    Object* objects = nullptr;
    int count = 0;
    const bool done = (Tarnell::Fbx::Fbx().*read)(info, &objects, count);
    FaithfulObjects<Object> result{std::shared_ptr<Object[]>(objects), static_cast<std::size_t>(count), {}};
    if (!done)
        throw Unreadable(Tarnell::Fbx::lastError());
    result.warnings = Tarnell::Fbx::lastWarnings();
    return result;
}

} // namespace tool
