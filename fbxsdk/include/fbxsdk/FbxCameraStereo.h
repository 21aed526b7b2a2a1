// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxCamera.h>

FBXSDK_NAMESPACE_BEGIN

/// A stereo rig: a camera with one more for each eye. The rig's own properties describe the relation between them; the
/// host keeps the eyes consistent.
class FBXSDK_DLL FbxCameraStereo : public FbxCamera {
    FBXSDK_OBJECT_DECLARE(FbxCameraStereo, FbxCamera)

public:
    FbxPropertyT<FbxEnum> Stereo; ///< how the axes of the eyes relate: 0 none, 1 converged, 2 off-axis, 3 parallel
    FbxPropertyT<FbxDouble> InteraxialSeparation, ///< distance between the eyes, scene units; animatable
        ZeroParallax,                             ///< distance at which the views converge, scene units; animatable
        ToeInAdjust;                              ///< rotation of the eyes toward each other, degrees; animatable
    FbxPropertyT<FbxDouble> FilmOffsetRightCam,   ///< of the right eye, inches; animatable
        FilmOffsetLeftCam;                        ///< of the left eye, inches; animatable
    FbxPropertyT<FbxString> PrecompFileName,      ///< the absolute name of a compositing file; stored as given
        RelativePrecompFileName;                  ///< the same, relative to the scene's file

    [[nodiscard]] EType GetAttributeType() const override; ///< eCameraStereo.

    /// The camera of the left eye, replacing any other; null removes it. Its manager still owns the camera.
    void SetLeftCamera(FbxCamera* pCamera);
    [[nodiscard]] FbxCamera* GetLeftCamera() const; ///< Null when there is none.
    /// The camera of the right eye, replacing any other; null removes it.
    void SetRightCamera(FbxCamera* pCamera);
    [[nodiscard]] FbxCamera* GetRightCamera() const; ///< Null when there is none.
};

FBXSDK_NAMESPACE_END
