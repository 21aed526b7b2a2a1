// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Outcomes: one table has the default message of each code.
#include <fbxsdk/FbxStatus.h>

#include <cstdarg>
#include <cstdio>
#include <iterator>
#include <utility>

FBXSDK_NAMESPACE_BEGIN
namespace {

struct SentenceRow {
    FbxStatus::EStatusCode code;
    const char* sentence;
};

constexpr SentenceRow kSentences[] = {
    {FbxStatus::eSuccess, ""},
    {FbxStatus::eFailure, "operation failed"},
    {FbxStatus::eInsufficientMemory, "not enough memory"},
    {FbxStatus::eInvalidParameter, "invalid parameter"},
    {FbxStatus::eIndexOutOfRange, "index out of range"},
    {FbxStatus::ePasswordError, "wrong password"},
    {FbxStatus::eInvalidFileVersion, "file version not supported"},
    {FbxStatus::eInvalidFile, "invalid file"},
    {FbxStatus::eSceneCheckFail, "scene check failed"},
};

constexpr bool inEnumeratorOrder() {
    for (int i = 0; i < static_cast<int>(std::size(kSentences)); ++i)
        if (kSentences[i].code != i)
            return false;
    return true;
}
static_assert(std::size(kSentences) == FbxStatus::eSceneCheckFail + 1 && inEnumeratorOrder());

const char* sentenceOf(FbxStatus::EStatusCode code) {
    const auto index = static_cast<size_t>(code);
    return kSentences[index < std::size(kSentences) ? index : static_cast<size_t>(FbxStatus::eFailure)].sentence;
}

} // namespace

void FbxStatus::Clear() { SetCode(eSuccess); }

void FbxStatus::SetCode(EStatusCode pCode) {
    mCode = pCode;
    mSentence = sentenceOf(pCode);
}

void FbxStatus::SetCode(EStatusCode pCode, const char* pErrorMsg, ...) {
    std::va_list arguments;
    va_start(arguments, pErrorMsg);
    std::va_list forLength;
    va_copy(forLength, arguments);
    const int length = std::vsnprintf(nullptr, 0, pErrorMsg, forLength);
    va_end(forLength);

    // built separately: the message that is replaced may be one of the arguments
    std::string sentence(length > 0 ? static_cast<size_t>(length) : 0, '\0');
    if (length > 0)
        std::vsnprintf(sentence.data(), sentence.size() + 1, pErrorMsg, arguments);
    va_end(arguments);
    mCode = pCode;
    mSentence = std::move(sentence);
}

FBXSDK_NAMESPACE_END
