// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The marker: four colour channels, a size and a look.
#include "TnFbxMarker.h"

#include <utility>

#include "ChannelSet.h"

namespace Tarnell::Fbx {

namespace {

constexpr detail::ChannelRow<TnFbxMarker::EFbxMarkerChannelType> kMarkerChannels[] = {
    {TnFbxMarker::kFbxMarkerRed, "red", TnFbxMarker::kDefaultMarkerRed},
    {TnFbxMarker::kFbxMarkerGreen, "green", TnFbxMarker::kDefaultMarkerGreen},
    {TnFbxMarker::kFbxMarkerBlue, "blue", TnFbxMarker::kDefaultMarkerBlue},
    {TnFbxMarker::kFbxMarkerAlpha, "alpha", TnFbxMarker::kDefaultMarkerAlpha},
};

using Channels = detail::ChannelSet<kMarkerChannels>;

} // namespace

TnFbxMarker::TnFbxMarker() : mProperties() { Channels::initNew(mChannels); }

TnFbxMarker::~TnFbxMarker() = default;

// kept: nothing of the transform is copied, nor the name
TnFbxMarker& TnFbxMarker::operator=(const TnFbxMarker& other) {
    if (this != &other) {
        mProperties = other.mProperties;
        mChannels = other.mChannels;
    }
    return *this;
}

bool TnFbxMarker::initMarker() {
    Channels::init(mChannels);
    mProperties = Properties();
    return true;
}

bool TnFbxMarker::deleteMarker() {
    Channels::clear(mChannels);
    mProperties = Properties();
    return true;
}

bool TnFbxMarker::setValue(EFbxMarkerChannelType channel, float value) {
    return Channels::setValue(mChannels, channel, value);
}

bool TnFbxMarker::setValueAt(EFbxMarkerChannelType channel, TnFbxTime time, const std::vector<float>& values) {
    return Channels::setValues(mChannels, channel, time, values);
}

bool TnFbxMarker::moveValuesAt(EFbxMarkerChannelType channel, TnFbxTime time, std::vector<float>&& values) {
    return Channels::moveValues(mChannels, channel, time, std::move(values));
}

float TnFbxMarker::getValue(EFbxMarkerChannelType channel) const { return Channels::value(mChannels, channel); }

float TnFbxMarker::getValueAt(EFbxMarkerChannelType channel, float frame) const {
    return Channels::valueAt(mChannels, channel, frame);
}

bool TnFbxMarker::getAnimated(EFbxMarkerChannelType channel) const { return Channels::animated(mChannels, channel); }

TnFbxTime TnFbxMarker::getTime(EFbxMarkerChannelType channel) const { return Channels::time(mChannels, channel); }

const char* TnFbxMarker::getChannelName(EFbxMarkerChannelType channel) { return Channels::name(channel); }

bool TnFbxMarker::setMarkerSize(float size) {
    mProperties.size = size;
    return true;
}

float TnFbxMarker::getMarkerSize() const { return mProperties.size; }

bool TnFbxMarker::setMarkerLookType(EFbxMarkerLookType lookType) {
    mProperties.lookType = lookType;
    return true;
}

TnFbxMarker::EFbxMarkerLookType TnFbxMarker::getMarkerLookType() const { return mProperties.lookType; }

} // namespace Tarnell::Fbx
