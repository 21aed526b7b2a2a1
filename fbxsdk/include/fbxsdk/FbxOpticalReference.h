// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

/// The origin of captured points, as a kind of attribute without content of its own.
class FBXSDK_DLL FbxOpticalReference : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxOpticalReference, FbxNodeAttribute)

public:
    [[nodiscard]] EType GetAttributeType() const override; ///< eOpticalReference.
};

FBXSDK_NAMESPACE_END
