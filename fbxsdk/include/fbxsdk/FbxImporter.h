// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files into scenes.
#pragma once

#include <memory>
#include <vector>

#include <fbxsdk/FbxIOBase.h>
#include <fbxsdk/FbxTakeInfo.h>

FBXSDK_NAMESPACE_BEGIN

class FbxDocument;

namespace detail {
struct Document;
}

/// Facts about a file as such.
class FBXSDK_DLL FbxIOFileHeaderInfo {
public:
    int mFileVersion = 0; ///< 7400 for 7.4
    FbxString mCreator;
    bool mASCII = false;
    std::vector<FbxString> mWarnings; ///< what was repaired or dropped on reading, a sentence each
};

class FBXSDK_DLL FbxImporter : public FbxIOBase {
    FBXSDK_OBJECT_DECLARE(FbxImporter, FbxIOBase)

public:
    /// Opens the file, finds out its format by its content and reads its structure. False for a null or empty name, a
    /// file that is missing, unreadable, not FBX, of an unsupported version or damaged; GetStatus then says why.
    bool Initialize(const char* pFileName, int pFileFormat = -1, FbxIOSettings* pIOSettings = nullptr) override;

    [[nodiscard]] bool IsFBX() const { return mDocument != nullptr; }
    /// Adds the file's content to the document, which must be a scene.
    bool Import(FbxDocument* pDocument, bool pNonBlocking = false);
    [[nodiscard]] int GetFileFormat() const;
    void GetFileVersion(int& pMajor, int& pMinor, int& pRevision) const;
    /// Null before Initialize. Belongs to the importer.
    [[nodiscard]] FbxIOFileHeaderInfo* GetFileHeaderInfo() { return mDocument ? &mHeader : nullptr; }
    [[nodiscard]] int GetAnimStackCount() const { return static_cast<int>(mTakes.size()); }
    /// Null out of range. Belongs to the importer.
    [[nodiscard]] FbxTakeInfo* GetTakeInfo(int pIndex);
    [[nodiscard]] FbxString GetActiveAnimStackName() const;

private:
    std::shared_ptr<const detail::Document> mDocument;
    FbxIOFileHeaderInfo mHeader;
    std::vector<FbxTakeInfo> mTakes;
};

FBXSDK_NAMESPACE_END
