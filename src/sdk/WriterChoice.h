// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Which of a registry's writers writes a file.
#pragma once

#include <fbxsdk.h>

namespace Tarnell::Fbx::detail {

/// The first FBX writer whose description has the word; the native one when there is none. The registry is the
/// platform's, in which others may have entered writers of their own.
template <class Registry>
int findWriter(const Registry& registry, const char* word) {
    const int count = registry.GetWriterFormatCount();
    for (int format = 0; format < count; ++format) {
        const bool isFbx = registry.WriterIsFBX(format);
        if (isFbx && fbxsdk::FbxString(registry.GetWriterFormatDescription(format)).Find(word) >= 0) {
            return format;
        }
    }
    return registry.GetNativeWriterFormat();
}

} // namespace Tarnell::Fbx::detail
