// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <string>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

/// The outcome of an operation: a code and a message.
class FBXSDK_DLL FbxStatus {
public:
    /// What kind of failure it was. The numbers are part of the API.
    enum EStatusCode {
        eSuccess = 0,        ///< nothing went wrong
        eFailure,            ///< any failure without a code of its own
        eInsufficientMemory, ///< memory ran out
        eInvalidParameter,   ///< an argument that the operation cannot work with
        eIndexOutOfRange,    ///< an index out of range
        ePasswordError,      ///< a file that is protected
        eInvalidFileVersion, ///< a version that is not supported
        eInvalidFile,        ///< a file that is damaged or of another format
        eSceneCheckFail      ///< an inconsistent scene
    };

    FbxStatus() = default;                                    ///< Success.
    explicit FbxStatus(EStatusCode pCode) { SetCode(pCode); } ///< The code with its default message.

    [[nodiscard]] bool Error() const { return mCode != eSuccess; } ///< Whether the code is anything but success.
    void Clear();                                                  ///< Resets to success, without a message.
    [[nodiscard]] EStatusCode GetCode() const { return mCode; }    ///< eSuccess until a code is set.
    /// Sets the code and its default message.
    void SetCode(EStatusCode pCode);
    /// Sets the code and a message formatted as by printf.
    void SetCode(EStatusCode pCode, const char* pErrorMsg, ...) __attribute__((format(printf, 3, 4)));
    /// The message, UTF-8; never null, empty after success. Valid until the status changes.
    [[nodiscard]] const char* GetErrorString() const { return mSentence.c_str(); }

    explicit operator bool() const { return mCode == eSuccess; }                     ///< True after success.
    bool operator==(const FbxStatus& pOther) const { return mCode == pOther.mCode; } ///< Compares the codes only.
    bool operator!=(const FbxStatus& pOther) const { return mCode != pOther.mCode; } ///< Compares the codes only.

private:
    EStatusCode mCode = eSuccess;
    std::string mSentence;
};

FBXSDK_NAMESPACE_END
