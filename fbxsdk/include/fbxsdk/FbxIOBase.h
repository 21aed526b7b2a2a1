// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What importers and exporters share: a file name and the outcome of the last operation.
#pragma once

#include <string>

#include <fbxsdk/FbxObject.h>
#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN

class FbxIOSettings;

class FBXSDK_DLL FbxIOBase : public FbxObject {
    FBXSDK_ABSTRACT_DECLARE(FbxIOBase, FbxObject)

public:
    /// A format of -1 is found out. Settings are accepted and of no effect.
    virtual bool Initialize(const char* pFileName, int pFileFormat = -1, FbxIOSettings* pIOSettings = nullptr);
    [[nodiscard]] virtual FbxString GetFileName() const;
    /// Why the last operation failed: which file, where in it, what is wrong.
    [[nodiscard]] FbxStatus& GetStatus() { return mStatus; }

protected:
    std::string mFileName;
    FbxStatus mStatus;
};

FBXSDK_NAMESPACE_END
