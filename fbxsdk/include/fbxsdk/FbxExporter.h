// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Scenes into files.
#pragma once

#include <string>

#include <fbxsdk/FbxIOBase.h>
#include <fbxsdk/FbxSceneRenamer.h>

FBXSDK_NAMESPACE_BEGIN

class FbxDocument;

class FBXSDK_DLL FbxExporter : public FbxIOBase {
    FBXSDK_OBJECT_DECLARE(FbxExporter, FbxIOBase)

public:
    /// Takes the name of the file to write and the format's number in the registry. A format of -1 goes by the
    /// extension; a name without one that is known means the native writer. No file is made before Export.
    /// False for a null or empty name, for a number that is no writer, and when the folder is not there; GetStatus then
    /// says why. A version that was set before stays.
    bool Initialize(const char* pFileName, int pFileFormat = -1, FbxIOSettings* pIOSettings = nullptr) override;

    /// Writes the document, which must be a scene. False, with a status, when it cannot.
    bool Export(FbxDocument* pDocument, bool pNonBlocking = false);

    /// One of the strings of GetCurrentWritableVersions; false for any other, and the version stays as it was. Without
    /// a call the newest one is written. Names are never changed, whatever the mode.
    bool SetFileExportVersion(FbxString pVersion,
                              FbxSceneRenamer::ERenamingMode pRenamingMode = FbxSceneRenamer::eNone);
    /// Ended by null.
    [[nodiscard]] char const* const* GetCurrentWritableVersions() const;
    /// -1 before Initialize.
    [[nodiscard]] int GetFileFormat() const { return mFileFormat; }

private:
    std::string mVersion; ///< "FBX201600", …; empty for the newest
    int mFileFormat = -1;
};

FBXSDK_NAMESPACE_END
