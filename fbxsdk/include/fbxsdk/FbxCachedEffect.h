// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

/// An effect whose states are in a cache, as a kind of attribute without content of its own.
class FBXSDK_DLL FbxCachedEffect : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxCachedEffect, FbxNodeAttribute)

public:
    [[nodiscard]] EType GetAttributeType() const override; ///< eCachedEffect.
};

FBXSDK_NAMESPACE_END
