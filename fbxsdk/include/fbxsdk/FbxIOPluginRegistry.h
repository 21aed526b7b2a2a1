// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

/// Which formats can be read and written: 0 is binary FBX, 1 ASCII FBX, in both directions. A number out of range is no
/// format, with empty texts. Texts are valid for the whole run of the program.
class FBXSDK_DLL FbxIOPluginRegistry {
public:
    [[nodiscard]] int GetReaderFormatCount() const; ///< Readers have the numbers below it.
    [[nodiscard]] int GetWriterFormatCount() const; ///< Writers have the numbers below it.
    /// "FBX binary (*.fbx)" or "FBX ascii (*.fbx)"; the empty string for no format, never null.
    [[nodiscard]] const char* GetReaderFormatDescription(int pFileFormat) const;
    /// The same for a writer.
    [[nodiscard]] const char* GetWriterFormatDescription(int pFileFormat) const;
    /// "fbx", without a dot; the empty string for no format.
    [[nodiscard]] const char* GetReaderFormatExtension(int pFileFormat) const;
    [[nodiscard]] const char* GetWriterFormatExtension(int pFileFormat) const; ///< The same for a writer.
    [[nodiscard]] bool ReaderIsFBX(int pFileFormat) const; ///< True for every reader, false for no format.
    [[nodiscard]] bool WriterIsFBX(int pFileFormat) const; ///< True for every writer, false for no format.
    [[nodiscard]] int GetNativeReaderFormat() const;       ///< Binary FBX.
    [[nodiscard]] int GetNativeWriterFormat() const;       ///< Binary FBX.
    /// The writer with exactly that description; -1 when there is none and for null.
    [[nodiscard]] int FindWriterIDByDescription(const char* pDescription) const;
    /// The first writer for the extension, which is given without a dot and compared without regard to case; -1 when
    /// there is none and for null.
    [[nodiscard]] int FindWriterIDByExtension(const char* pExtension) const;
    /// The reader for the file, by its content. False, with -1, when it is missing or no FBX file.
    bool DetectReaderFileFormat(const char* pFileName, int& pFileFormat) const;
    /// The version strings that the writer accepts, terminated by null; null for no format.
    [[nodiscard]] char const* const* GetWritableVersions(int pFileFormat) const;
};

FBXSDK_NAMESPACE_END
