// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

/// The switcher selects which of the scene's cameras is live. A scene has at most one, in FbxGlobalCameraSettings.
class FBXSDK_DLL FbxCameraSwitcher : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxCameraSwitcher, FbxNodeAttribute)

public:
    FbxPropertyT<FbxInt> CameraIndex; ///< in files "Camera Index"; the number of the live camera, animatable

    [[nodiscard]] EType GetAttributeType() const override; ///< eCameraSwitcher.
};

FBXSDK_NAMESPACE_END
