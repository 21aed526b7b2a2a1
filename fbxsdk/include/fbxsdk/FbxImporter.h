// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
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

/// What the header of a file states, and what was noticed on reading.
class FBXSDK_DLL FbxIOFileHeaderInfo {
public:
    int mFileVersion = 0;             ///< 7400 for 7.4; 0 before a file is open
    FbxString mCreator;               ///< the program that wrote the file, as it names itself
    bool mASCII = false;              ///< ASCII, else binary
    std::vector<FbxString> mWarnings; ///< what was repaired or dropped on reading, one sentence each
};

/// Reads a file into a scene: Initialize opens it, Import reads its content. FBX is the only format, binary and
/// ASCII, versions 3000 to 7999.
class FBXSDK_DLL FbxImporter : public FbxIOBase {
    FBXSDK_OBJECT_DECLARE(FbxImporter, FbxIOBase)

public:
    /// Opens the file, detects its format by its content and reads its structure; take information is available
    /// afterwards. False for a null or empty name, a number that is no reader, a file that is missing, unreadable, not
    /// FBX, of an unsupported version or damaged; GetStatus then says why. A file that was open before is closed in any
    /// case.
    bool Initialize(const char* pFileName, int pFileFormat = -1, FbxIOSettings* pIOSettings = nullptr) override;

    /// Whether a file is open: all that can be opened are FBX.
    [[nodiscard]] bool IsFBX() const { return mDocument != nullptr; }
    /// Adds the file's content to the document, which must be a scene; its existing content stays. Large arrays of
    /// geometry stay in the file and are read on the first access. The scene's time mode becomes the global
    /// one of the calling thread.
    ///
    /// False before Initialize, for a document that is no scene, and when the file is damaged or has changed; GetStatus
    /// then says why, and the scene may hold a part of the content. Repaired or dropped content is reported in the
    /// warnings of GetFileHeaderInfo. The call always returns after the work is done.
    bool Import(FbxDocument* pDocument, bool pNonBlocking = false);
    /// The reader's number in the registry: 0 binary, 1 ASCII; -1 when no file is open.
    [[nodiscard]] int GetFileFormat() const;
    /// The parts of the file's version: 7, 4, 0 for 7400; zeros when no file is open.
    void GetFileVersion(int& pMajor, int& pMinor, int& pRevision) const;
    /// Null before Initialize. Owned by the importer.
    [[nodiscard]] FbxIOFileHeaderInfo* GetFileHeaderInfo() { return mDocument ? &mHeader : nullptr; }
    /// How many animation stacks (takes) the file has; 0 when none is open.
    [[nodiscard]] int GetAnimStackCount() const { return static_cast<int>(mTakes.size()); }
    /// What the file states about its stack of that number; null out of range. Owned by the importer; changing it has
    /// no effect.
    [[nodiscard]] FbxTakeInfo* GetTakeInfo(int pIndex);
    /// The name of the stack that the writing program had active; empty when the file does not state it.
    [[nodiscard]] FbxString GetActiveAnimStackName() const;

private:
    std::shared_ptr<const detail::Document> mDocument;
    FbxIOFileHeaderInfo mHeader;
    std::vector<FbxTakeInfo> mTakes;
};

FBXSDK_NAMESPACE_END
