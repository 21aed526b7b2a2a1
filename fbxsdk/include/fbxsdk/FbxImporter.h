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

/// What a file says of itself, and what was noticed about it.
class FBXSDK_DLL FbxIOFileHeaderInfo {
public:
    int mFileVersion = 0;             ///< 7400 for 7.4; 0 before a file is open
    FbxString mCreator;               ///< the program that wrote the file, in its own words
    bool mASCII = false;              ///< text, else binary
    std::vector<FbxString> mWarnings; ///< what was repaired or dropped on reading, a sentence each
};

/// Reads a file into a scene: Initialize opens it, Import brings its content in. FBX is the only format, binary and
/// ASCII, versions 3000 to 7999.
class FBXSDK_DLL FbxImporter : public FbxIOBase {
    FBXSDK_OBJECT_DECLARE(FbxImporter, FbxIOBase)

public:
    /// Opens the file, finds out its format by its content and reads its structure; take information is there
    /// afterwards. False for a null or empty name, a number that is no reader, a file that is missing, unreadable, not
    /// FBX, of an unsupported version or damaged; GetStatus then says why. What was open before is closed in any case.
    bool Initialize(const char* pFileName, int pFileFormat = -1, FbxIOSettings* pIOSettings = nullptr) override;

    /// Whether a file is open: all that can be opened are FBX.
    [[nodiscard]] bool IsFBX() const { return mDocument != nullptr; }
    /// Adds the file's content to the document, which must be a scene; what it has already stays. Large arrays of
    /// geometry stay in the file and are read when they are first asked for. The scene's time mode becomes the global
    /// one of the calling thread.
    ///
    /// False before Initialize, for a document that is no scene, and when the file is damaged or has changed; GetStatus
    /// then says why, and the scene may hold a part of the content. What was repaired or dropped is appended to the
    /// warnings of GetFileHeaderInfo. The call always returns after the work is done.
    bool Import(FbxDocument* pDocument, bool pNonBlocking = false);
    /// The reader's number in the registry: 0 binary, 1 ASCII; -1 when no file is open.
    [[nodiscard]] int GetFileFormat() const;
    /// The parts of the file's version: 7, 4, 0 for 7400; zeros when no file is open.
    void GetFileVersion(int& pMajor, int& pMinor, int& pRevision) const;
    /// Null before Initialize. Belongs to the importer.
    [[nodiscard]] FbxIOFileHeaderInfo* GetFileHeaderInfo() { return mDocument ? &mHeader : nullptr; }
    /// How many animation stacks (takes) the file has; 0 when none is open.
    [[nodiscard]] int GetAnimStackCount() const { return static_cast<int>(mTakes.size()); }
    /// What the file says of its stack of that number; null out of range. Belongs to the importer; changing it has no
    /// effect.
    [[nodiscard]] FbxTakeInfo* GetTakeInfo(int pIndex);
    /// The name of the stack that the writing program had active; empty when the file does not say.
    [[nodiscard]] FbxString GetActiveAnimStackName() const;

private:
    std::shared_ptr<const detail::Document> mDocument;
    FbxIOFileHeaderInfo mHeader;
    std::vector<FbxTakeInfo> mTakes;
};

FBXSDK_NAMESPACE_END
