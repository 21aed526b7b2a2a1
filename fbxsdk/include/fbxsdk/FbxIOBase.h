// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <string>

#include <fbxsdk/FbxObject.h>
#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN

class FbxIOSettings;

/// The common part of importers and exporters: a file name and the outcome of the last operation.
class FBXSDK_DLL FbxIOBase : public FbxObject {
    FBXSDK_ABSTRACT_DECLARE(FbxIOBase, FbxObject)

public:
    /// Takes the file's name. A format of -1 is detected. Settings are accepted and have no effect. False for a null or
    /// empty name.
    virtual bool Initialize(const char* pFileName, int pFileFormat = -1, FbxIOSettings* pIOSettings = nullptr);
    [[nodiscard]] virtual FbxString GetFileName() const; ///< As given to Initialize, UTF-8; empty before.
    /// Why the last operation failed: which file, where in it, what is wrong. Success otherwise. Owned by the
    /// object.
    [[nodiscard]] FbxStatus& GetStatus() { return mStatus; }

protected:
    std::string mFileName; ///< as given, UTF-8
    FbxStatus mStatus;     ///< of the last operation
};

FBXSDK_NAMESPACE_END
