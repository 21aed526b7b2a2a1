// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What the platform repaired, omitted or assumed of a file, for `lastWarnings()`.
#pragma once

#include "calls/LastError.h"

#include <fbxsdk.h>

#include <string>

namespace Tarnell::Fbx::detail {

/// A warning that begins with the name of the file.
inline void warnAbout(const std::string& fileName, const std::string& sentence) {
    const bool named = fileName.empty() || sentence.compare(0, fileName.size(), fileName) == 0;
    warn(named ? sentence : fileName + ": " + sentence);
}

/// Only the bundled platform has a list of its repairs; with another one there are no warnings of this kind.
template <class HeaderInfo>
void warnOfRepairs(const std::string& fileName, const HeaderInfo* header) {
    if constexpr (requires { header->mWarnings.begin(); }) {
        if (header != nullptr)
            for (const fbxsdk::FbxString& warning : header->mWarnings)
                warnAbout(fileName, warning.Buffer());
    }
}

} // namespace Tarnell::Fbx::detail
