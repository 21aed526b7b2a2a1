// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Which formats can be read and written.
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

/// Formats are numbered; a number out of range is no format, with empty texts.
class FBXSDK_DLL FbxIOPluginRegistry {
public:
    [[nodiscard]] int GetReaderFormatCount() const;
    [[nodiscard]] int GetWriterFormatCount() const;
    [[nodiscard]] const char* GetReaderFormatDescription(int pFileFormat) const;
    [[nodiscard]] const char* GetWriterFormatDescription(int pFileFormat) const;
    [[nodiscard]] const char* GetReaderFormatExtension(int pFileFormat) const;
    [[nodiscard]] const char* GetWriterFormatExtension(int pFileFormat) const;
    [[nodiscard]] bool ReaderIsFBX(int pFileFormat) const;
    [[nodiscard]] bool WriterIsFBX(int pFileFormat) const;
    [[nodiscard]] int GetNativeReaderFormat() const;
    [[nodiscard]] int GetNativeWriterFormat() const;
    /// -1 when there is none. Extensions count without regard to case.
    [[nodiscard]] int FindWriterIDByDescription(const char* pDescription) const;
    [[nodiscard]] int FindWriterIDByExtension(const char* pExtension) const;
    /// The reader for the file, by its content. False, with -1, when it is missing or no FBX file.
    bool DetectReaderFileFormat(const char* pFileName, int& pFileFormat) const;
    /// The version strings that the writer takes, ended by null; null for no format.
    [[nodiscard]] char const* const* GetWritableVersions(int pFileFormat) const;
};

FBXSDK_NAMESPACE_END
