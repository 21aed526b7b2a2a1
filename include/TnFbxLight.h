// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A light: an animated transform plus colour, intensity, cone angle, kind and decay.
#pragma once

#include "TnFbxChannel.h"
#include "TnFbxExport.h"
#include "TnFbxTime.h"
#include "TnFbxTransform.h"

#include <array>
#include <vector>

namespace Tarnell::Fbx {

/// A light. Its position and rotation are channels of the transform it derives from.
class TARNELL_FBX_API TnFbxLight : public TnFbxTransform {
public:
    /// The channels.
    enum EFbxLightChannelType : int {
        kFbxLightRed,       ///< From 0 to 1.
        kFbxLightGreen,     ///< From 0 to 1.
        kFbxLightBlue,      ///< From 0 to 1.
        kFbxLightAlpha,     ///< Kept for the host: lights of files have none.
        kFbxLightIntensity, ///< 1 is full intensity, 100 in the file.
        kFbxLightConeAngle  ///< The outer angle of a spot light, degrees.
    };

    /// Numbered as in FBX; its area and volume lights read as point lights.
    enum EFbxLightType : int {
        kFbxLightPoint,       ///< Shines from one point in all directions.
        kFbxLightDirectional, ///< Shines in one direction, from far away.
        kFbxLightSpot         ///< Shines in a cone. The default.
    };

    /// The fall-off with distance, numbered as in FBX.
    enum EFbxLightDecayType : int {
        kFbxLightDecayNone,      ///< The same at any distance.
        kFbxLightDecayLinear,    ///< By the distance.
        kFbxLightDecayQuadratic, ///< By its square, as in nature. The default.
        kFbxLightDecayCubic      ///< By its cube.
    };

    /// The static value of the channel of that name in a new light.
    /// @{
    static constexpr float kDefaultLightRed = 1.0f;
    static constexpr float kDefaultLightGreen = 1.0f;
    static constexpr float kDefaultLightBlue = 1.0f;
    static constexpr float kDefaultLightAlpha = 1.0f;
    static constexpr float kDefaultLightIntensity = 1.0f;
    static constexpr float kDefaultLightConeAngle = 40.0f;
    /// @}

    /// The intensity channel is an FBX light's intensity, in which 100 is full, times this factor.
    static constexpr float kNormalizeLightIntensity = 0.01f;

    /// A default transform, every channel at its default, a spot light with quadratic decay.
    TnFbxLight();
    TnFbxLight(const TnFbxLight& other) = default;
    ~TnFbxLight() override;

    /// Copies the light channels, the type and the decay; the target keeps its own transform and name.
    TnFbxLight& operator=(const TnFbxLight& other);

    /// The light part of a new light; the transform stays as it is. Always true.
    bool initLight();

    /// The same, but with every static value 0, colour and intensity included; always true.
    bool deleteLight();

    /// Sets the static value of a channel. False when there is no such channel.
    bool setValue(EFbxLightChannelType channel, float value);

    /// Replaces all samples of a channel, as `TnFbxChannel::setAnimatedValues` and `moveAnimatedValues` do, with their
    /// result. False also when there is no such channel; nothing changes then. A single sample is set through
    /// `getLightChannel`.
    /// @{
    bool setValueAt(EFbxLightChannelType channel, TnFbxTime time, const std::vector<float>& values);
    bool moveValuesAt(EFbxLightChannelType channel, TnFbxTime time, std::vector<float>&& values);
    /// @}

    /// The static value of a channel; 0 when there is no such channel.
    float getValue(EFbxLightChannelType channel) const;
    /// The value at a frame, as `TnFbxChannel::getAnimatedValue` gives it; 0 when there is no such channel.
    float getValueAt(EFbxLightChannelType channel, float frame) const;
    /// Whether a channel has samples; false when there is no such channel.
    bool getAnimated(EFbxLightChannelType channel) const;
    /// A copy of the time record of a channel; a default one when there is no such channel.
    TnFbxTime getTime(EFbxLightChannelType channel) const;

    /// The channel itself, owned by the light; null when there is no such channel.
    TnFbxChannel* getLightChannel(EFbxLightChannelType channel);

    /// The channel's printable name, a constant; null when there is no such channel.
    static const char* getChannelName(EFbxLightChannelType channel);

    /// Stored without a check; always true.
    /// @{
    bool setLightType(EFbxLightType lightType);
    bool setDecayType(EFbxLightDecayType decayType);
    /// @}
    EFbxLightType getLightType() const;      ///< Default spot.
    EFbxLightDecayType getDecayType() const; ///< Default quadratic.

private:
    struct Properties {
        EFbxLightType lightType = kFbxLightSpot;
        EFbxLightDecayType decayType = kFbxLightDecayQuadratic;
    };

    Properties mProperties;
    std::array<TnFbxChannel, kFbxLightConeAngle + 1> mChannels;
};

} // namespace Tarnell::Fbx
