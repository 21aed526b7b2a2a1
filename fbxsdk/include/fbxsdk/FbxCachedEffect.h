// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An effect whose result is held in a cache.
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxCachedEffect : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxCachedEffect, FbxNodeAttribute)

public:
    [[nodiscard]] EType GetAttributeType() const override;
};

FBXSDK_NAMESPACE_END
