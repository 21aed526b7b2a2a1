// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <cstddef>
#include <string>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

/// An owned byte string; UTF-8 wherever it crosses the API. Lengths and indices count bytes; case conversions are those
/// of ASCII.
class FBXSDK_DLL FbxString {
public:
    FbxString() = default;                                   ///< The empty string.
    FbxString(const char* pStr) : mText(pStr ? pStr : "") {} ///< Null gives the empty string.
    FbxString(const char* pStr, size_t pLength); ///< The first pLength bytes, less when the string ends before.
    explicit FbxString(char pChar, size_t pRepeatCount = 1) : mText(pRepeatCount, pChar) {} ///< One byte repeated.
    explicit FbxString(int pValue);                                                         ///< In decimal form.
    explicit FbxString(float pValue);  ///< The shortest decimal form that reads back the same.
    explicit FbxString(double pValue); ///< The shortest decimal form that reads back the same.

    FbxString& operator=(const char* pStr); ///< Null gives the empty string; a part of this string may be given.

    [[nodiscard]] size_t GetLen() const { return mText.size(); } ///< Bytes, without the terminating zero.
    [[nodiscard]] bool IsEmpty() const { return mText.empty(); } ///< Whether there are no bytes.
    void Clear() { mText.clear(); }                              ///< Resets to the empty string.
    /// Zero-terminated, never null; valid until the string changes.
    [[nodiscard]] char* Buffer() { return mText.data(); }
    [[nodiscard]] const char* Buffer() const { return mText.c_str(); } ///< The same for reading.
    operator const char*() const { return mText.c_str(); }             ///< The same as Buffer.

    /// The index must be one of an existing byte; it is not checked.
    char& operator[](int pIndex) { return mText[static_cast<size_t>(pIndex)]; }
    char operator[](int pIndex) const { return mText[static_cast<size_t>(pIndex)]; } ///< The same for reading.

    FbxString& operator+=(const FbxString& pOther); ///< Appends the other string.
    FbxString& operator+=(const char* pStr);        ///< Null appends nothing.
    FbxString& operator+=(char pChar);              ///< Appends one byte.

    /// Byte order like strcmp: negative, 0 or positive. Null compares as the empty string.
    [[nodiscard]] int Compare(const char* pStr) const;
    /// As Compare, ASCII letters without regard to case.
    [[nodiscard]] int CompareNoCase(const char* pStr) const;

    /// Index of the first occurrence at or after the start; -1 when there is none.
    [[nodiscard]] int Find(char pChar, size_t pStartPosition = 0) const;
    /// The same for a string of bytes; case matters.
    [[nodiscard]] int Find(const char* pStrSub, size_t pStartPosition = 0) const;
    /// Index of the last occurrence; -1 when there is none.
    [[nodiscard]] int ReverseFind(char pChar) const;

    [[nodiscard]] FbxString Left(size_t pCount) const; ///< The first bytes; all of them when there are fewer.
    [[nodiscard]] FbxString Mid(size_t pFirst) const;  ///< From that byte on; empty beyond the end.
    /// That many bytes from that one on, fewer when the string ends before.
    [[nodiscard]] FbxString Mid(size_t pFirst, size_t pCount) const;
    [[nodiscard]] FbxString Right(size_t pCount) const; ///< The last bytes; all of them when there are fewer.
    [[nodiscard]] FbxString Upper() const;              ///< ASCII letters only.
    [[nodiscard]] FbxString Lower() const;              ///< ASCII letters only.

private:
    std::string mText;
};

/// Both strings concatenated; the operands are unchanged.
inline FbxString operator+(const FbxString& pLeft, const FbxString& pRight) { return FbxString(pLeft) += pRight; }
/// The same; null counts as the empty string.
inline FbxString operator+(const FbxString& pLeft, const char* pRight) { return FbxString(pLeft) += pRight; }
/// The same; null counts as the empty string.
inline FbxString operator+(const char* pLeft, const FbxString& pRight) { return FbxString(pLeft) += pRight; }
/// The same with one byte.
inline FbxString operator+(const FbxString& pLeft, char pRight) { return FbxString(pLeft) += pRight; }

/// Declares one comparison for both kinds of operand on both sides: with the conversion to const char* in the class, a
/// missing one would silently compare addresses.
#define FBXSDK_STRING_COMPARISON(op)                                                                                   \
    /** By the order of the bytes, as FbxString::Compare. */                                                           \
    inline bool operator op(const FbxString& pLeft, const FbxString& pRight) {                                         \
        return pLeft.Compare(pRight.Buffer()) op 0;                                                                    \
    }                                                                                                                  \
    /** The same; null compares as the empty string. */                                                                \
    inline bool operator op(const FbxString& pLeft, const char* pRight) { return pLeft.Compare(pRight) op 0; }         \
    /** The same; null compares as the empty string. */                                                                \
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
