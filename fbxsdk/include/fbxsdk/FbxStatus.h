// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The outcome of an operation: a code and a sentence.
#pragma once

#include <string>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxStatus {
public:
    enum EStatusCode {
        eSuccess = 0,
        eFailure,
        eInsufficientMemory,
        eInvalidParameter,
        eIndexOutOfRange,
        ePasswordError,
        eInvalidFileVersion,
        eInvalidFile,
        eSceneCheckFail
    };

    FbxStatus() = default;
    explicit FbxStatus(EStatusCode pCode) { SetCode(pCode); }

    [[nodiscard]] bool Error() const { return mCode != eSuccess; }
    void Clear();
    [[nodiscard]] EStatusCode GetCode() const { return mCode; }
    /// Sets the code and its general sentence.
    void SetCode(EStatusCode pCode);
    /// Sets the code and a sentence in the manner of printf.
    void SetCode(EStatusCode pCode, const char* pErrorMsg, ...) __attribute__((format(printf, 3, 4)));
    /// Never null; empty after success.
    [[nodiscard]] const char* GetErrorString() const { return mSentence.c_str(); }

    explicit operator bool() const { return mCode == eSuccess; }
    bool operator==(const FbxStatus& pOther) const { return mCode == pOther.mCode; }
    bool operator!=(const FbxStatus& pOther) const { return mCode != pOther.mCode; }

private:
    EStatusCode mCode = eSuccess;
    std::string mSentence;
};

FBXSDK_NAMESPACE_END
