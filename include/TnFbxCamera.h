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
    /// directions. A faithful read stores a direction in the up channels.
    enum EFbxCameraChannelType : int {
        kFbxCameraLookAtPositionX, ///< X of the point that the camera looks at, scene units.
        kFbxCameraLookAtPositionY, ///< Y of the point that the camera looks at, scene units.
        kFbxCameraLookAtPositionZ, ///< Z of the point that the camera looks at, scene units.
        kFbxCameraUpPositionX,     ///< X of the up point, scene units.
        kFbxCameraUpPositionY,     ///< Y of the up point, scene units.
        kFbxCameraUpPositionZ,     ///< Z of the up point, scene units.
        kFbxCameraRoll,            ///< Degrees, about the viewing direction.
        kFbxCameraFocalLength,     ///< Millimetres.
        kFbxCameraApertureWidth,   ///< The film's width, in the unit of the file's camera: inches. See
                                   ///< `kDefaultCameraApertureWidth`.
        kFbxCameraApertureHeight,  ///< The film's height, in the same unit.
        kFbxCameraNearPlane,       ///< Distance from the camera, scene units.
        kFbxCameraFarPlane,        ///< Distance from the camera, scene units.
        kFbxCameraFieldOfView,     ///< Degrees, horizontal or vertical as the aperture mode says.
        kFbxCameraFieldOfViewX,    ///< Degrees, horizontal.
        kFbxCameraFieldOfViewY,    ///< Degrees, vertical.
        kFbxCameraFilmOffsetX,     ///< Inches, to the right.
        kFbxCameraFilmOffsetY      ///< Inches, upwards.
    };

    /// The projection, numbered as in FBX.
    enum EFbxCameraProjectionType : int {
        kFbxCameraPerspective, ///< The default.
        kFbxCameraOrthographic ///< Parallel; the zoom has no channel.
    };

    /// Which values drive the lens, numbered as in FBX.
    enum EFbxCameraApertureMode : int {
        kFbxApertureHorizontalAndVertical, ///< Both fields of view.
        kFbxApertureHorizontal,            ///< The horizontal field of view.
        kFbxApertureVertical,              ///< The vertical field of view.
        kFbxApertureFocalLength            ///< The focal length.
    };

    /// The static value of the channel of that name in a new camera. The film of 24.576 by 18.672, unlike any that is
    /// read from a file, is in millimetres; a faithful write interprets it so.
    /// @{
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
    /// @}

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

    /// Sets the static value of a channel. False when there is no such channel.
    bool setValue(EFbxCameraChannelType channel, float value);

    /// Replaces all samples of a channel, as `TnFbxChannel::setAnimatedValues` and `moveAnimatedValues` do, with their
    /// result. False also when there is no such channel; nothing changes then. A single sample is set through
    /// `getCameraChannel`.
    /// @{
    bool setValueAt(EFbxCameraChannelType channel, TnFbxTime time, const std::vector<float>& values);
    bool moveValuesAt(EFbxCameraChannelType channel, TnFbxTime time, std::vector<float>&& values);
    /// @}

    /// The static value of a channel; 0 when there is no such channel.
    float getValue(EFbxCameraChannelType channel) const;
    /// The value at a frame, as `TnFbxChannel::getAnimatedValue` gives it; 0 when there is no such channel.
    float getValueAt(EFbxCameraChannelType channel, float frame) const;
    /// Whether a channel has samples; false when there is no such channel.
    bool getAnimated(EFbxCameraChannelType channel) const;
    /// A copy of the time record of a channel; a default one when there is no such channel.
    TnFbxTime getTime(EFbxCameraChannelType channel) const;

    /// The channel itself, owned by the camera; null when there is no such channel.
    TnFbxChannel* getCameraChannel(EFbxCameraChannelType channel);

    /// The channel's printable name, a constant; null when there is no such channel. The three fields of view are
    /// spelt "filedOfView…".
    static const char* getChannelName(EFbxCameraChannelType channel);

    /// Stored without a check; always true.
    /// @{
    bool setProjectionType(EFbxCameraProjectionType projectionType);
    bool setApertureMode(EFbxCameraApertureMode apertureMode);
    /// @}
    EFbxCameraProjectionType getProjectionType() const; ///< Default perspective.
    EFbxCameraApertureMode getApertureMode() const;     ///< Default focal length.

    /// Scales a vector to unit length in place; one whose length is zero or NaN is unchanged.
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
