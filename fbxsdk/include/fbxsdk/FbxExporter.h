// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <string>

#include <fbxsdk/FbxIOBase.h>
#include <fbxsdk/FbxSceneRenamer.h>

FBXSDK_NAMESPACE_BEGIN

class FbxDocument;

/// Writes a scene into an FBX file: Initialize names the file, Export writes it.
class FBXSDK_DLL FbxExporter : public FbxIOBase {
    FBXSDK_OBJECT_DECLARE(FbxExporter, FbxIOBase)

public:
    /// Takes the name of the file to write and the format's number in the registry. A format of -1 is chosen by the
    /// extension; a name without a known one means the native writer. No file is created before Export. False for a
    /// null or empty name, for a number that is no writer, when the folder does not exist and when a folder has the
    /// name; GetStatus then says why. A version that was set before stays.
    bool Initialize(const char* pFileName, int pFileFormat = -1, FbxIOSettings* pIOSettings = nullptr) override;

    /// Writes the document, which must be a scene, with all of its members but the root node. Omitted are curves
    /// without keys, curve nodes that add nothing to the static value, and, from 7.0 on, the producer cameras,
    /// which such files cannot hold.
    ///
    /// The file gets its name when all of it is written: until then, and after a failure, an older file of the name
    /// stays as it was. Point caches that wait for their scene (FbxCache::CloseFile) get their names in the same step.
    /// Large meshes are compressed on as many threads as extensions::setMaximumThreads allows; they end before the call
    /// returns.
    ///
    /// False, with a status, before Initialize, for a document that is no scene, when disk or memory do not suffice,
    /// and when the format cannot hold the scene.
    bool Export(FbxDocument* pDocument, bool pNonBlocking = false);

    /// One of the strings of GetCurrentWritableVersions; false for any other, and the version stays unchanged. Without
    /// a call the newest one is written. Names are never changed, whatever the mode.
    bool SetFileExportVersion(FbxString pVersion,
                              FbxSceneRenamer::ERenamingMode pRenamingMode = FbxSceneRenamer::eNone);
    /// "FBX201000" and so on, oldest first, terminated by null; the same for both formats. Valid for the whole run of
    /// the program.
    [[nodiscard]] char const* const* GetCurrentWritableVersions() const;
    /// The writer's number in the registry; -1 before Initialize and after it failed.
    [[nodiscard]] int GetFileFormat() const { return mFileFormat; }

private:
    std::string mVersion; ///< "FBX201600", …; empty for the newest
    int mFileFormat = -1;
};

FBXSDK_NAMESPACE_END
