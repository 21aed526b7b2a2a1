// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Exporters: which file, which format, which version.
#include <fbxsdk/FbxExporter.h>

#include <fbxsdk/FbxIOPluginRegistry.h>
#include <fbxsdk/FbxPathUtils.h>
#include <fbxsdk/FbxScene.h>

#include "scene/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxExporter, FbxIOBase, std::span<const detail::PropertyRow>{})

FbxExporter::FbxExporter(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxIOBase(pManager, pInfo) {}
FbxExporter::~FbxExporter() = default;

namespace {

/// The registry's number for the format asked for; -1 when there is no such writer.
int writerOf(const FbxIOPluginRegistry& registry, const char* fileName, int format) {
    if (format >= 0)
        return format < registry.GetWriterFormatCount() ? format : -1;
    if (format != -1)
        return -1;
    const int byExtension = registry.FindWriterIDByExtension(FbxPathUtils::GetExtensionName(fileName).Buffer());
    return byExtension >= 0 ? byExtension : registry.GetNativeWriterFormat();
}

} // namespace

bool FbxExporter::Initialize(const char* pFileName, int pFileFormat, FbxIOSettings* pIOSettings) {
    mFileFormat = -1;
    if (!FbxIOBase::Initialize(pFileName, pFileFormat, pIOSettings))
        return false;
    const int writer = writerOf(GetFbxManager()->data().registry, pFileName, pFileFormat);
    if (writer < 0) {
        mStatus.SetCode(FbxStatus::eInvalidParameter, "%s: there is no writer number %d", pFileName, pFileFormat);
        return false;
    }
    const FbxString folder = FbxPathUtils::GetFolderName(FbxPathUtils::Resolve(pFileName));
    if (!FbxPathUtils::Exist(folder)) {
        mStatus.SetCode(FbxStatus::eInvalidParameter, "%s: there is no folder %s", pFileName, folder.Buffer());
        return false;
    }
    if (FbxPathUtils::Exist(pFileName)) {
        mStatus.SetCode(FbxStatus::eInvalidParameter, "%s: a folder stands there", pFileName);
        return false;
    }
    mFileFormat = writer;
    return true;
}

bool FbxExporter::Export(FbxDocument* pDocument, bool) {
    if (mFileFormat < 0) {
        mStatus.SetCode(FbxStatus::eFailure, "no file is named to export to");
        return false;
    }
    if (!FbxCast<FbxScene>(pDocument)) {
        mStatus.SetCode(FbxStatus::eInvalidParameter, "%s: there is no scene to export", mFileName.c_str());
        return false;
    }
    mStatus.SetCode(FbxStatus::eFailure, "%s: writing is not available in this version", mFileName.c_str());
    return false;
}

bool FbxExporter::SetFileExportVersion(FbxString pVersion, FbxSceneRenamer::ERenamingMode) {
    for (char const* const* known = GetCurrentWritableVersions(); *known; ++known) {
        if (pVersion != *known)
            continue;
        mVersion = *known;
        return true;
    }
    return false;
}

char const* const* FbxExporter::GetCurrentWritableVersions() const {
    // All writers write the same versions, so the answer does not depend on the format chosen.
    const FbxIOPluginRegistry& registry = GetFbxManager()->data().registry;
    return registry.GetWritableVersions(registry.GetNativeWriterFormat());
}

FBXSDK_NAMESPACE_END
