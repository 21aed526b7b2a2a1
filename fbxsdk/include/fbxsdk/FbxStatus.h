// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <string>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

/// The outcome of an operation: a code and a sentence.
class FBXSDK_DLL FbxStatus {
public:
    /// What kind of failure it was. The numbers are part of the API.
    enum EStatusCode {
        eSuccess = 0,        ///< nothing went wrong
        eFailure,            ///< anything that has no code of its own
        eInsufficientMemory, ///< memory ran out
        eInvalidParameter,   ///< an argument that the operation cannot work with
        eIndexOutOfRange,    ///< an index that names nothing
        ePasswordError,      ///< a file that is protected
        eInvalidFileVersion, ///< a version that is not supported
        eInvalidFile,        ///< a file that is damaged or of another format
        eSceneCheckFail      ///< a scene that contradicts itself
    };

    FbxStatus() = default;                                    ///< Success.
    explicit FbxStatus(EStatusCode pCode) { SetCode(pCode); } ///< The code with its general sentence.

    [[nodiscard]] bool Error() const { return mCode != eSuccess; } ///< Whether the code is anything but success.
    void Clear();                                                  ///< Back to success, without a sentence.
    [[nodiscard]] EStatusCode GetCode() const { return mCode; }    ///< eSuccess until a code is set.
    /// Sets the code and its general sentence.
    void SetCode(EStatusCode pCode);
    /// Sets the code and a sentence in the manner of printf.
    void SetCode(EStatusCode pCode, const char* pErrorMsg, ...) __attribute__((format(printf, 3, 4)));
    /// The sentence, UTF-8; never null, empty after success. Valid until the status changes.
    [[nodiscard]] const char* GetErrorString() const { return mSentence.c_str(); }

    explicit operator bool() const { return mCode == eSuccess; }                     ///< True after success.
    bool operator==(const FbxStatus& pOther) const { return mCode == pOther.mCode; } ///< Compares the codes alone.
    bool operator!=(const FbxStatus& pOther) const { return mCode != pOther.mCode; } ///< Compares the codes alone.

private:
    EStatusCode mCode = eSuccess;
    std::string mSentence;
};

FBXSDK_NAMESPACE_END
