// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxImporter.h>

#include <fbxsdk/FbxIOPluginRegistry.h>
#include <fbxsdk/FbxScene.h>

#include "container/FileBytes.h"
#include "document/TakeTimes.h"
#include "io/SceneReading.h"
#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxImporter, FbxIOBase, std::span<const detail::PropertyRow>{})

FbxImporter::FbxImporter(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxIOBase(pManager, pInfo) {}
FbxImporter::~FbxImporter() = default;

namespace {

FbxString stringOf(std::string_view text) { return {text.data() ? text.data() : "", text.size()}; }

FbxTakeInfo takeInfo(const detail::DocumentTake& take) {
    FbxTakeInfo info;
    info.mName = info.mImportName = stringOf(take.name);
    info.mDescription = stringOf(take.description);
    info.mLocalTimeSpan.Set(FbxTime(take.localStart), FbxTime(take.localStop));
    info.mReferenceTimeSpan.Set(FbxTime(take.referenceStart), FbxTime(take.referenceStop));
    return info;
}

} // namespace

bool FbxImporter::Initialize(const char* pFileName, int pFileFormat, FbxIOSettings* pIOSettings) {
    mDocument.reset();
    mTakes.clear();
    mHeader = {};
    if (!FbxIOBase::Initialize(pFileName, pFileFormat, pIOSettings))
        return false;
    if (pFileFormat < -1 || pFileFormat >= GetFbxManager()->GetIOPluginRegistry()->GetReaderFormatCount()) {
        mStatus.SetCode(FbxStatus::eInvalidParameter, "%s: there is no reader with index %d", pFileName, pFileFormat);
        return false;
    }
    const auto readDocument = [&] { return (mDocument = detail::readDocument(mFileName, mStatus)) != nullptr; };
    if (!detail::faultToStatus(mStatus, readDocument))
        return false;
    mHeader.mFileVersion = static_cast<int>(mDocument->version);
    mHeader.mCreator = FbxString(mDocument->creator.c_str());
    mHeader.mASCII = mDocument->tree->ascii;
    for (const std::string& warning : mDocument->warnings)
        mHeader.mWarnings.emplace_back(warning.c_str());
    for (const detail::DocumentTake& take : detail::listTakes(*mDocument))
        mTakes.push_back(takeInfo(take));
    return true;
}

bool FbxImporter::Import(FbxDocument* pDocument, bool) {
    if (!mDocument) {
        mStatus.SetCode(FbxStatus::eFailure, "no file is open");
        return false;
    }
    auto* scene = FbxCast<FbxScene>(pDocument);
    if (!scene) {
        mStatus.SetCode(FbxStatus::eInvalidParameter, "%s: there is no scene to import into", mFileName.c_str());
        return false;
    }
    mStatus.Clear();
    std::vector<std::string> notes;
    if (!detail::faultToStatus(mStatus, [&] { return detail::readScene(mDocument, *scene, mStatus, &notes); }))
        return false;
    for (const std::string& note : notes)
        mHeader.mWarnings.emplace_back(note.c_str());
    scene->GetGlobalSettings().applyTimeMode();
    return true;
}

int FbxImporter::GetFileFormat() const { return mDocument && mDocument->tree->ascii ? 1 : mDocument ? 0 : -1; }

void FbxImporter::GetFileVersion(int& pMajor, int& pMinor, int& pRevision) const {
    const int version = mHeader.mFileVersion;
    pMajor = version / 1000;
    pMinor = version / 100 % 10;
    pRevision = version / 10 % 10;
}

FbxTakeInfo* FbxImporter::GetTakeInfo(int pIndex) {
    return pIndex >= 0 && static_cast<std::size_t>(pIndex) < mTakes.size() ? &mTakes[static_cast<std::size_t>(pIndex)]
                                                                           : nullptr;
}

FbxString FbxImporter::GetActiveAnimStackName() const {
    return mDocument ? FbxString(mDocument->activeStackName.c_str()) : FbxString();
}

FBXSDK_NAMESPACE_END
