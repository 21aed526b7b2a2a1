// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

/// An empty object, used as a parent or as a locator; drawn as a cross or not at all.
class FBXSDK_DLL FbxNull : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxNull, FbxNodeAttribute)

public:
    /// How the null is drawn.
    enum ELook : int {
        eNone, ///< not at all
        eCross ///< as a cross; the default
    };

    static const char* const sSize;      ///< The name of the property Size.
    static const char* const sLook;      ///< The name of the property Look.
    static const FbxDouble sDefaultSize; ///< 100.
    static const ELook sDefaultLook;     ///< eCross.

    FbxPropertyT<FbxDouble> Size; ///< scene units; 100
    FbxPropertyT<ELook> Look;     ///< eCross by default

    [[nodiscard]] EType GetAttributeType() const override; ///< eNull.

    /// Sets size and look to their defaults.
    void Reset();
    [[nodiscard]] double GetSizeDefaultValue() const; ///< 100.
};

FBXSDK_NAMESPACE_END
