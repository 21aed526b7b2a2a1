// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxTypes.h>

FBXSDK_NAMESPACE_BEGIN

/// Red, green, blue and alpha, 0 to 1 where they can be displayed; any number is stored.
class FBXSDK_DLL FbxColor {
public:
    constexpr FbxColor() = default; ///< Opaque black.
    /// The components in their order; opaque without an alpha.
    constexpr FbxColor(const double pRed, const double pGreen, const double pBlue, const double pAlpha = 1.0)
        : mRed(pRed), mGreen(pGreen), mBlue(pBlue), mAlpha(pAlpha) {}
    /// Red, green and blue of three numbers; opaque without an alpha.
    constexpr FbxColor(const FbxDouble3& pRGB, const double pAlpha = 1.0)
        : FbxColor(pRGB[0], pRGB[1], pRGB[2], pAlpha) {}
    /// All four of four numbers.
    constexpr FbxColor(const FbxDouble4& pRGBA) : FbxColor(pRGBA[0], pRGBA[1], pRGBA[2], pRGBA[3]) {}

    /// Replaces all four; opaque without an alpha.
    void Set(const double pRed, const double pGreen, const double pBlue, const double pAlpha = 1.0) {
        *this = FbxColor(pRed, pGreen, pBlue, pAlpha);
    }
    /// Whether all four components are within 0 to 1.
    [[nodiscard]] bool IsValid() const;

    /// 0 red, 1 green, 2 blue, anything else alpha.
    double& operator[](int pIndex);
    const double& operator[](int pIndex) const; ///< The same for reading.

    /// Exact, in all four.
    bool operator==(const FbxColor& pColor) const {
        return mRed == pColor.mRed && mGreen == pColor.mGreen && mBlue == pColor.mBlue && mAlpha == pColor.mAlpha;
    }
    bool operator!=(const FbxColor& pColor) const { return !(*this == pColor); } ///< The opposite.

    double mRed = 0.0;   ///< 0 to 1
    double mGreen = 0.0; ///< 0 to 1
    double mBlue = 0.0;  ///< 0 to 1
    double mAlpha = 1.0; ///< 0 transparent, 1 opaque
};

FBXSDK_NAMESPACE_END
