// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The light: six channels, a type and a decay.
#include "TnFbxLight.h"

#include <utility>

#include "ChannelSet.h"

namespace Tarnell::Fbx {

namespace {

constexpr detail::ChannelRow<TnFbxLight::EFbxLightChannelType> kLightChannels[] = {
    {TnFbxLight::kFbxLightRed, "red", TnFbxLight::kDefaultLightRed},
    {TnFbxLight::kFbxLightGreen, "green", TnFbxLight::kDefaultLightGreen},
    {TnFbxLight::kFbxLightBlue, "blue", TnFbxLight::kDefaultLightBlue},
    {TnFbxLight::kFbxLightAlpha, "alpha", TnFbxLight::kDefaultLightAlpha},
    {TnFbxLight::kFbxLightIntensity, "intensity", TnFbxLight::kDefaultLightIntensity},
    {TnFbxLight::kFbxLightConeAngle, "cone angle", TnFbxLight::kDefaultLightConeAngle}, // kept: the space
};

using Channels = detail::ChannelSet<kLightChannels>;

} // namespace

TnFbxLight::TnFbxLight() : mProperties() { Channels::initNew(mChannels); }

TnFbxLight::~TnFbxLight() = default;

// kept: nothing of the transform is copied, nor the name
TnFbxLight& TnFbxLight::operator=(const TnFbxLight& other) {
    if (this != &other) {
        mProperties = other.mProperties;
        mChannels = other.mChannels;
    }
    return *this;
}

bool TnFbxLight::initLight() {
    Channels::init(mChannels);
    mProperties = Properties();
    return true;
}

bool TnFbxLight::deleteLight() {
    Channels::clear(mChannels);
    mProperties = Properties();
    return true;
}

bool TnFbxLight::setValue(EFbxLightChannelType channel, float value) {
    return Channels::setValue(mChannels, channel, value);
}

bool TnFbxLight::setValueAt(EFbxLightChannelType channel, TnFbxTime time, const std::vector<float>& values) {
    return Channels::setValues(mChannels, channel, time, values);
}

bool TnFbxLight::moveValuesAt(EFbxLightChannelType channel, TnFbxTime time, std::vector<float>&& values) {
    return Channels::moveValues(mChannels, channel, time, std::move(values));
}

float TnFbxLight::getValue(EFbxLightChannelType channel) const { return Channels::value(mChannels, channel); }

float TnFbxLight::getValueAt(EFbxLightChannelType channel, float frame) const {
    return Channels::valueAt(mChannels, channel, frame);
}

bool TnFbxLight::getAnimated(EFbxLightChannelType channel) const { return Channels::animated(mChannels, channel); }

TnFbxTime TnFbxLight::getTime(EFbxLightChannelType channel) const { return Channels::time(mChannels, channel); }

TnFbxChannel* TnFbxLight::getLightChannel(EFbxLightChannelType channel) { return Channels::find(mChannels, channel); }

const char* TnFbxLight::getChannelName(EFbxLightChannelType channel) { return Channels::name(channel); }

bool TnFbxLight::setLightType(EFbxLightType lightType) {
    mProperties.lightType = lightType;
    return true;
}

TnFbxLight::EFbxLightType TnFbxLight::getLightType() const { return mProperties.lightType; }

bool TnFbxLight::setDecayType(EFbxLightDecayType decayType) {
    mProperties.decayType = decayType;
    return true;
}

TnFbxLight::EFbxLightDecayType TnFbxLight::getDecayType() const { return mProperties.decayType; }

} // namespace Tarnell::Fbx
