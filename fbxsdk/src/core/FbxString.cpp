// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The owned string. Case is that of ASCII letters, independent of the locale.
#include <fbxsdk/FbxString.h>

#include <algorithm>
#include <charconv>
#include <cstring>

FBXSDK_NAMESPACE_BEGIN
namespace {

char lower(char letter) { return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter; }

char upper(char letter) { return letter >= 'a' && letter <= 'z' ? static_cast<char>(letter - 'a' + 'A') : letter; }

const char* orEmpty(const char* text) { return text ? text : ""; }

template <typename Number>
std::string decimal(Number value) {
    char text[32];
    const auto [end, error] = std::to_chars(std::begin(text), std::end(text), value);
    return error == std::errc() ? std::string(text, end) : std::string();
}

int indexOf(size_t position) { return position == std::string::npos ? -1 : static_cast<int>(position); }

FbxString withLetters(const FbxString& text, char (*change)(char)) {
    FbxString result(text);
    std::transform(result.Buffer(), result.Buffer() + result.GetLen(), result.Buffer(), change);
    return result;
}

} // namespace

FbxString::FbxString(const char* pStr, size_t pLength) : mText(pStr ? std::string(pStr, strnlen(pStr, pLength)) : "") {}

FbxString::FbxString(int pValue) : mText(decimal(pValue)) {}

FbxString::FbxString(float pValue) : mText(decimal(pValue)) {}

FbxString::FbxString(double pValue) : mText(decimal(pValue)) {}

FbxString& FbxString::operator=(const char* pStr) {
    mText = std::string(orEmpty(pStr)); // through a copy: the argument may point into this string
    return *this;
}

FbxString& FbxString::operator+=(const FbxString& pOther) {
    mText += pOther.mText;
    return *this;
}

FbxString& FbxString::operator+=(const char* pStr) {
    mText += orEmpty(pStr);
    return *this;
}

FbxString& FbxString::operator+=(char pChar) {
    mText += pChar;
    return *this;
}

int FbxString::Compare(const char* pStr) const { return std::strcmp(mText.c_str(), orEmpty(pStr)); }

int FbxString::CompareNoCase(const char* pStr) const { return Lower().Compare(FbxString(pStr).Lower().Buffer()); }

int FbxString::Find(char pChar, size_t pStartPosition) const { return indexOf(mText.find(pChar, pStartPosition)); }

int FbxString::Find(const char* pStrSub, size_t pStartPosition) const {
    return indexOf(mText.find(orEmpty(pStrSub), pStartPosition));
}

int FbxString::ReverseFind(char pChar) const { return indexOf(mText.rfind(pChar)); }

FbxString FbxString::Left(size_t pCount) const { return Mid(0, pCount); }

FbxString FbxString::Mid(size_t pFirst) const { return Mid(pFirst, std::string::npos); }

FbxString FbxString::Mid(size_t pFirst, size_t pCount) const {
    FbxString result;
    if (pFirst < mText.size())
        result.mText = mText.substr(pFirst, pCount);
    return result;
}

FbxString FbxString::Right(size_t pCount) const { return Mid(mText.size() - std::min(pCount, mText.size())); }

FbxString FbxString::Upper() const { return withLetters(*this, upper); }

FbxString FbxString::Lower() const { return withLetters(*this, lower); }

FBXSDK_NAMESPACE_END
