// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An owned byte string; UTF-8 wherever it crosses the API.
#pragma once

#include <cstddef>
#include <string>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxString {
public:
    FbxString() = default;
    FbxString(const char* pStr) : mText(pStr ? pStr : "") {} ///< Null gives the empty string.
    FbxString(const char* pStr, size_t pLength); ///< The first pLength bytes, less when the string ends before.
    explicit FbxString(char pChar, size_t pRepeatCount = 1) : mText(pRepeatCount, pChar) {}
    explicit FbxString(int pValue);
    explicit FbxString(float pValue);  ///< The shortest decimal form that reads back the same.
    explicit FbxString(double pValue); ///< The shortest decimal form that reads back the same.

    FbxString& operator=(const char* pStr);

    [[nodiscard]] size_t GetLen() const { return mText.size(); }
    [[nodiscard]] bool IsEmpty() const { return mText.empty(); }
    void Clear() { mText.clear(); }
    /// Zero-terminated, never null; valid until the string changes.
    [[nodiscard]] char* Buffer() { return mText.data(); }
    [[nodiscard]] const char* Buffer() const { return mText.c_str(); }
    operator const char*() const { return mText.c_str(); }

    char& operator[](int pIndex) { return mText[static_cast<size_t>(pIndex)]; }
    char operator[](int pIndex) const { return mText[static_cast<size_t>(pIndex)]; }

    FbxString& operator+=(const FbxString& pOther);
    FbxString& operator+=(const char* pStr);
    FbxString& operator+=(char pChar);

    /// Byte order like strcmp: negative, 0 or positive. Null compares as the empty string.
    [[nodiscard]] int Compare(const char* pStr) const;
    /// As Compare, ASCII letters without regard to case.
    [[nodiscard]] int CompareNoCase(const char* pStr) const;

    /// Index of the first occurrence at or after the start; -1 when there is none.
    [[nodiscard]] int Find(char pChar, size_t pStartPosition = 0) const;
    [[nodiscard]] int Find(const char* pStrSub, size_t pStartPosition = 0) const;
    /// Index of the last occurrence; -1 when there is none.
    [[nodiscard]] int ReverseFind(char pChar) const;

    [[nodiscard]] FbxString Left(size_t pCount) const;
    [[nodiscard]] FbxString Mid(size_t pFirst) const;
    [[nodiscard]] FbxString Mid(size_t pFirst, size_t pCount) const;
    [[nodiscard]] FbxString Right(size_t pCount) const;
    [[nodiscard]] FbxString Upper() const; ///< ASCII letters only.
    [[nodiscard]] FbxString Lower() const; ///< ASCII letters only.

private:
    std::string mText;
};

inline FbxString operator+(const FbxString& pLeft, const FbxString& pRight) { return FbxString(pLeft) += pRight; }
inline FbxString operator+(const FbxString& pLeft, const char* pRight) { return FbxString(pLeft) += pRight; }
inline FbxString operator+(const char* pLeft, const FbxString& pRight) { return FbxString(pLeft) += pRight; }
inline FbxString operator+(const FbxString& pLeft, char pRight) { return FbxString(pLeft) += pRight; }

// Each comparison for both kinds of operand on both sides: with the conversion to const char* in the class, a missing
// one would silently compare addresses.
#define FBXSDK_STRING_COMPARISON(op)                                                                                   \
    inline bool operator op(const FbxString& pLeft, const FbxString& pRight) {                                         \
        return pLeft.Compare(pRight.Buffer()) op 0;                                                                    \
    }                                                                                                                  \
    inline bool operator op(const FbxString& pLeft, const char* pRight) { return pLeft.Compare(pRight) op 0; }         \
    inline bool operator op(const char* pLeft, const FbxString& pRight) {                                              \
        return FbxString(pLeft).Compare(pRight.Buffer()) op 0;                                                         \
    }
FBXSDK_STRING_COMPARISON(==)
FBXSDK_STRING_COMPARISON(!=)
FBXSDK_STRING_COMPARISON(<)
FBXSDK_STRING_COMPARISON(<=)
FBXSDK_STRING_COMPARISON(>)
FBXSDK_STRING_COMPARISON(>=)
#undef FBXSDK_STRING_COMPARISON

FBXSDK_NAMESPACE_END
