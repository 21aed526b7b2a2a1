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
    /// The channels. Colour components run from 0 to 1, an intensity of 1 is full intensity, the cone angle is in
    /// degrees.
    enum EFbxLightChannelType : int {
        kFbxLightRed,
        kFbxLightGreen,
        kFbxLightBlue,
        kFbxLightAlpha,
        kFbxLightIntensity,
        kFbxLightConeAngle
    };

    /// Numbered as in FBX; its area and volume lights read as point lights.
    enum EFbxLightType : int { kFbxLightPoint, kFbxLightDirectional, kFbxLightSpot };

    /// The fall-off with distance, numbered as in FBX.
    enum EFbxLightDecayType : int {
        kFbxLightDecayNone,
        kFbxLightDecayLinear,
        kFbxLightDecayQuadratic,
        kFbxLightDecayCubic
    };

    static constexpr float kDefaultLightRed = 1.0f;
    static constexpr float kDefaultLightGreen = 1.0f;
    static constexpr float kDefaultLightBlue = 1.0f;
    static constexpr float kDefaultLightAlpha = 1.0f;
    static constexpr float kDefaultLightIntensity = 1.0f;
    static constexpr float kDefaultLightConeAngle = 40.0f;

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

    /// The static value of a channel, and all its samples at once (`TnFbxChannel::setAnimatedValues`, with its result).
    /// False when there is no such channel; nothing changes then. A single sample is set through `getLightChannel`.
    bool setValue(EFbxLightChannelType channel, float value);
    bool setValueAt(EFbxLightChannelType channel, TnFbxTime time, const std::vector<float>& values);
    bool moveValuesAt(EFbxLightChannelType channel, TnFbxTime time, std::vector<float>&& values);

    /// What a channel holds. Where there is no such channel: 0, 0, false and a default time record.
    float getValue(EFbxLightChannelType channel) const;
    float getValueAt(EFbxLightChannelType channel, float frame) const;
    bool getAnimated(EFbxLightChannelType channel) const;
    TnFbxTime getTime(EFbxLightChannelType channel) const;

    /// The channel itself, owned by the light; null when there is no such channel.
    TnFbxChannel* getLightChannel(EFbxLightChannelType channel);

    /// The channel's printable name, a constant; null when there is no such channel.
    static const char* getChannelName(EFbxLightChannelType channel);

    /// Stored without a check; always true.
    bool setLightType(EFbxLightType lightType);
    EFbxLightType getLightType() const;
    bool setDecayType(EFbxLightDecayType decayType);
    EFbxLightDecayType getDecayType() const;

private:
    struct Properties {
        EFbxLightType lightType = kFbxLightSpot;
        EFbxLightDecayType decayType = kFbxLightDecayQuadratic;
    };

    Properties mProperties;
    std::array<TnFbxChannel, kFbxLightConeAngle + 1> mChannels;
};

} // namespace Tarnell::Fbx
