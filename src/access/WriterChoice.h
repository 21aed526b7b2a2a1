// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The choice of a registry's writer for a file and of its version, and one export.
#pragma once

#include "TnFbxWriteInfo.h"
#include "calls/LastError.h"

#include <fbxsdk.h>

#include <iterator>
#include <string>

namespace Tarnell::Fbx::detail {

/// The first FBX writer whose description contains the word; the native one when there is none. The registry is the
/// platform's, to which others may have added writers of their own.
template <class Registry>
int findWriter(const Registry& registry, const char* word) {
    const int count = registry.GetWriterFormatCount();
    for (int format = 0; format < count; ++format) {
        const bool isFbx = registry.WriterIsFBX(format);
        if (isFbx && fbxsdk::FbxString(registry.GetWriterFormatDescription(format)).Find(word) >= 0)
            return format;
    }
    return registry.GetNativeWriterFormat();
}

/// By compatibility version; an invalid one means the newest. There was no change of the format in 2015.
inline const char* versionString(TnFbxWriteInfo::eCompatibilityVersion version) {
    constexpr const char* kVersions[] = {"FBX201000", "FBX201100", "FBX201200", "FBX201300", "FBX201400"};
    constexpr const char* kNewestVersion = "FBX201600";
    const auto index = static_cast<int>(version);
    return index >= 0 && index < static_cast<int>(std::size(kVersions)) ? kVersions[index] : kNewestVersion;
}

/// Writes the file with one of the writers, and releases the exporter. False with the reason noted; the manager
/// releases the exporter then.
inline bool exportDocument(fbxsdk::FbxExporter& exporter, fbxsdk::FbxDocument* document, const std::string& fileName,
                           int format) {
    if (!exporter.Initialize(fileName.c_str(), format, /*pIOSettings*/ nullptr))
        return failAbout(fileName, exporter.GetStatus().GetErrorString(), "cannot be written");
    const bool exported = exporter.Export(document, /*pNonBlocking*/ false);
    const bool result =
        exported ? succeed() : failAbout(fileName, exporter.GetStatus().GetErrorString(), "cannot be written");
    exporter.Destroy(/*pRecursive*/ false);
    return result;
}

} // namespace Tarnell::Fbx::detail
