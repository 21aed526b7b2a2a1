// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A stereo rig: a camera with a left and a right eye.
#pragma once

#include <fbxsdk/FbxCamera.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxCameraStereo : public FbxCamera {
    FBXSDK_OBJECT_DECLARE(FbxCameraStereo, FbxCamera)

public:
    FbxPropertyT<FbxEnum> Stereo;
    FbxPropertyT<FbxDouble> InteraxialSeparation, ZeroParallax, ToeInAdjust;
    FbxPropertyT<FbxDouble> FilmOffsetRightCam, FilmOffsetLeftCam;
    FbxPropertyT<FbxString> PrecompFileName, RelativePrecompFileName;

    [[nodiscard]] EType GetAttributeType() const override;

    // The cameras of the two eyes; null when there is none.
    void SetLeftCamera(FbxCamera* pCamera);
    [[nodiscard]] FbxCamera* GetLeftCamera() const;
    void SetRightCamera(FbxCamera* pCamera);
    [[nodiscard]] FbxCamera* GetRightCamera() const;
};

FBXSDK_NAMESPACE_END
