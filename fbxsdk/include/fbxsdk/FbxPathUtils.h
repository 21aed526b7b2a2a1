// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxString.h>

FBXSDK_NAMESPACE_BEGIN

/// Paths as UTF-8 text. Both "/" and "\" separate on input, results use "/"; drive letters and "//server" are kept. A
/// null path counts as the empty one; empty results are empty strings.
class FBXSDK_DLL FbxPathUtils {
public:
    /// Root and file with one separator between; the file alone when it is absolute.
    [[nodiscard]] static FbxString Bind(const char* pRootPath, const char* pFilePath, bool pCleanPath = true);

    /// The folder part without trailing separator (a root stays "/"); empty when there is none.
    [[nodiscard]] static FbxString GetFolderName(const char* pFilePath);
    /// The last component; without extension: up to its last dot.
    [[nodiscard]] static FbxString GetFileName(const char* pFilePath, bool pWithExtension = true);
    /// What follows the last dot of the last component.
    [[nodiscard]] static FbxString GetExtensionName(const char* pFilePath);
    /// Replaces or appends the extension, given with or without dot; an empty one removes it.
    [[nodiscard]] static FbxString ChangeExtension(const char* pFilePath, const char* pExtension);

    /// Whether the folder exists.
    [[nodiscard]] static bool Exist(const char* pFolderPathUTF8);
    /// Creates the folder and every missing parent. True also when it exists already; false when it cannot be created
    /// or something other than a folder has the name.
    static bool Create(const char* pFolderPathUTF8);
    /// Deletes an empty folder; false when there is none or it is not empty.
    static bool Delete(const char* pFolderPathUTF8);
    /// Whether the folder exists and is empty.
    [[nodiscard]] static bool IsEmpty(const char* pFolderPathUTF8);

    /// Whether it starts neither with a separator nor with a drive.
    [[nodiscard]] static bool IsRelative(const char* pPath);
    /// The folder relative to the root folder, "." when they are the same.
    ///
    /// Relative arguments are resolved against the current directory. On another drive or server: the absolute path.
    [[nodiscard]] static FbxString GetRelativePath(const char* pRootPath, const char* pNewPath);
    /// The file relative to the root folder. Otherwise as GetRelativePath.
    [[nodiscard]] static FbxString GetRelativeFilePath(const char* pRootPath, const char* pNewFilePath);
    /// The absolute, cleaned path, from the current directory. Nothing needs to exist.
    [[nodiscard]] static FbxString Resolve(const char* pRelPath);
    /// One kind of separator, none repeated or trailing, no "." and no ".." behind a component; "." alone
    /// when nothing else is left. Does not access the file system.
    [[nodiscard]] static FbxString Clean(const char* pPath);
    /// A path in the folder, starting with the prefix, at which nothing exists yet.
    [[nodiscard]] static FbxString GenerateFileName(const char* pFolder, const char* pPrefix);
};

FBXSDK_NAMESPACE_END
