// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A camera: an animated transform plus lens, film back, clipping planes and an aim.
#pragma once

#include "TnFbxChannel.h"
#include "TnFbxExport.h"
#include "TnFbxTime.h"
#include "TnFbxTransform.h"

#include <array>
#include <vector>

namespace Tarnell::Fbx {

/// A camera. Its position and rotation are channels of the transform it derives from.
class TARNELL_FBX_API TnFbxCamera : public TnFbxTransform {
public:
    /// The channels. The look-at and the up point are positions in the space of the camera's own position, not
    /// directions; roll and fields of view are in degrees, the focal length in millimetres, the aperture in the units
    /// of the scene's camera.
    enum EFbxCameraChannelType : int {
        kFbxCameraLookAtPositionX,
        kFbxCameraLookAtPositionY,
        kFbxCameraLookAtPositionZ,
        kFbxCameraUpPositionX,
        kFbxCameraUpPositionY,
        kFbxCameraUpPositionZ,
        kFbxCameraRoll,
        kFbxCameraFocalLength,
        kFbxCameraApertureWidth,
        kFbxCameraApertureHeight,
        kFbxCameraNearPlane,
        kFbxCameraFarPlane,
        kFbxCameraFieldOfView,
        kFbxCameraFieldOfViewX,
        kFbxCameraFieldOfViewY,
        kFbxCameraFilmOffsetX,
        kFbxCameraFilmOffsetY
    };

    enum EFbxCameraProjectionType : int { kFbxCameraPerspective, kFbxCameraOrthographic };

    /// Which values drive the lens, numbered as in FBX.
    enum EFbxCameraApertureMode : int {
        kFbxApertureHorizontalAndVertical, ///< Both fields of view.
        kFbxApertureHorizontal,            ///< The horizontal field of view.
        kFbxApertureVertical,              ///< The vertical field of view.
        kFbxApertureFocalLength            ///< The focal length.
    };

    static constexpr float kDefaultCameraLookAtPositionX = 0.0f;
    static constexpr float kDefaultCameraLookAtPositionY = 0.0f;
    static constexpr float kDefaultCameraLookAtPositionZ = 0.0f;
    static constexpr float kDefaultCameraUpX = 0.0f;
    static constexpr float kDefaultCameraUpY = 1.0f;
    static constexpr float kDefaultCameraUpZ = 0.0f;
    static constexpr float kDefaultCameraRoll = 0.0f;
    static constexpr float kDefaultCameraFocalLength = 50.0f;
    static constexpr float kDefaultCameraApertureWidth = 24.576f;
    static constexpr float kDefaultCameraApertureHeight = 18.672f;
    static constexpr float kDefaultCameraNearPlane = 0.1f;
    static constexpr float kDefaultCameraFarPlane = 10000.0f;
    static constexpr float kDefaultCameraFieldOfView = 25.115f;
    static constexpr float kDefaultCameraFieldOfViewX = 40.0f;
    static constexpr float kDefaultCameraFieldOfViewY = 40.0f;
    static constexpr float kDefaultCameraFilmOffsetX = 0.0f;
    static constexpr float kDefaultCameraFilmOffsetY = 0.0f;

    /// A default transform, every channel at its default, perspective, aperture mode focal length.
    TnFbxCamera();
    TnFbxCamera(const TnFbxCamera& other) = default;
    ~TnFbxCamera() override;

    /// Copies the camera channels, the projection and the aperture mode; the target keeps its own transform and name.
    TnFbxCamera& operator=(const TnFbxCamera& other);

    /// The camera part of a new camera; the transform stays as it is. Always true.
    bool initCamera();

    /// The same, but with every static value 0, up vector and focal length included; always true.
    bool deleteCamera();

    /// The static value of a channel, and all its samples at once (`TnFbxChannel::setAnimatedValues`, with its result).
    /// False when there is no such channel; nothing changes then. A single sample is set through `getCameraChannel`.
    bool setValue(EFbxCameraChannelType channel, float value);
    bool setValueAt(EFbxCameraChannelType channel, TnFbxTime time, const std::vector<float>& values);
    bool moveValuesAt(EFbxCameraChannelType channel, TnFbxTime time, std::vector<float>&& values);

    /// What a channel holds. Where there is no such channel: 0, 0, false and a default time record.
    float getValue(EFbxCameraChannelType channel) const;
    float getValueAt(EFbxCameraChannelType channel, float frame) const;
    bool getAnimated(EFbxCameraChannelType channel) const;
    TnFbxTime getTime(EFbxCameraChannelType channel) const;

    /// The channel itself, owned by the camera; null when there is no such channel.
    TnFbxChannel* getCameraChannel(EFbxCameraChannelType channel);

    /// The channel's printable name, a constant; null when there is no such channel. The three fields of view are
    /// spelt "filedOfView…".
    static const char* getChannelName(EFbxCameraChannelType channel);

    /// Stored without a check; always true.
    bool setProjectionType(EFbxCameraProjectionType projectionType);
    EFbxCameraProjectionType getProjectionType() const;
    bool setApertureMode(EFbxCameraApertureMode apertureMode);
    EFbxCameraApertureMode getApertureMode() const;

    /// Scales a vector to unit length in place; one whose length is zero or NaN stays as it is.
    static void normalize(float& x, float& y, float& z);

    /// c = a × b.
    static void crossProduct(float ax, float ay, float az, float bx, float by, float bz, float& cx, float& cy,
                             float& cz);

    /// The Euler angles, in degrees, of a camera at `position` that looks at `lookAt`; always true.
    ///
    /// `position`, `lookAt` and `up` are three floats each, and all are overwritten: with zero, with the direction
    /// `lookAt` − `position`, and with the unit up vector after the roll. `up` is used as a direction here. `roll` is
    /// in degrees. All angles zero is a camera that looks along −Z with +Y up; the angles are meant to be applied in
    /// the order ZXY: roll about Z, then tilt about X, then turn about Y.
    static bool calculateCameraRotation(float* position, float* lookAt, float* up, float roll, float& rotationX,
                                        float& rotationY, float& rotationZ);

    /// The same from the camera's own position, look-at, up and roll channels at a frame; always true.
    bool calculateCameraRotationAt(float& rotationX, float& rotationY, float& rotationZ, float frame) const;

private:
    struct Properties {
        EFbxCameraProjectionType projectionType = kFbxCameraPerspective;
        EFbxCameraApertureMode apertureMode = kFbxApertureFocalLength;
    };

    Properties mProperties;
    std::array<TnFbxChannel, kFbxCameraFilmOffsetY + 1> mChannels;
};

} // namespace Tarnell::Fbx
