// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The switcher: which of the scene's cameras is live.
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxCameraSwitcher : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxCameraSwitcher, FbxNodeAttribute)

public:
    FbxPropertyT<FbxInt> CameraIndex;

    [[nodiscard]] EType GetAttributeType() const override;
};

FBXSDK_NAMESPACE_END
