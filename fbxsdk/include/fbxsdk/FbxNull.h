// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A null: a node that is only shown as a cross, or not at all.
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxNull : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxNull, FbxNodeAttribute)

public:
    enum ELook : int { eNone, eCross };

    static const char* const sSize;
    static const char* const sLook;
    static const FbxDouble sDefaultSize;
    static const ELook sDefaultLook;

    FbxPropertyT<FbxDouble> Size; ///< scene units
    FbxPropertyT<ELook> Look;

    [[nodiscard]] EType GetAttributeType() const override;

    /// Sets size and look to their defaults.
    void Reset();
    [[nodiscard]] double GetSizeDefaultValue() const;
};

FBXSDK_NAMESPACE_END
