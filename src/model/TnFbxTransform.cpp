// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The transform: fifteen channels and two orders.
#include "TnFbxTransform.h"

#include <utility>

#include "ChannelSet.h"

namespace Tarnell::Fbx {

namespace {

constexpr detail::ChannelRow<TnFbxTransform::EFbxTransformChannelType> kTransformChannels[] = {
    {TnFbxTransform::kFbxTransformPositionX, "positionX", TnFbxTransform::kDefaultTransformPositionX},
    {TnFbxTransform::kFbxTransformPositionY, "positionY", TnFbxTransform::kDefaultTransformPositionY},
    {TnFbxTransform::kFbxTransformPositionZ, "positionZ", TnFbxTransform::kDefaultTransformPositionZ},
    {TnFbxTransform::kFbxTransformRotationX, "rotationX", TnFbxTransform::kDefaultTransformRotationX},
    {TnFbxTransform::kFbxTransformRotationY, "rotationY", TnFbxTransform::kDefaultTransformRotationY},
    {TnFbxTransform::kFbxTransformRotationZ, "rotationZ", TnFbxTransform::kDefaultTransformRotationZ},
    {TnFbxTransform::kFbxTransformScaleX, "scaleX", TnFbxTransform::kDefaultTransformScaleX},
    {TnFbxTransform::kFbxTransformScaleY, "scaleY", TnFbxTransform::kDefaultTransformScaleY},
    {TnFbxTransform::kFbxTransformScaleZ, "scaleZ", TnFbxTransform::kDefaultTransformScaleZ},
    {TnFbxTransform::kFbxTransformSkewX, "skewX", TnFbxTransform::kDefaultTransformSkewX},
    {TnFbxTransform::kFbxTransformSkewY, "skewY", TnFbxTransform::kDefaultTransformSkewY},
    {TnFbxTransform::kFbxTransformSkewZ, "skewZ", TnFbxTransform::kDefaultTransformSkewZ},
    {TnFbxTransform::kFbxTransformPivotX, "pivotX", TnFbxTransform::kDefaultTransformPivotX},
    {TnFbxTransform::kFbxTransformPivotY, "pivotY", TnFbxTransform::kDefaultTransformPivotY},
    {TnFbxTransform::kFbxTransformPivotZ, "pivotZ", TnFbxTransform::kDefaultTransformPivotZ},
};

using Channels = detail::ChannelSet<kTransformChannels>;

} // namespace

TnFbxTransform::TnFbxTransform() : mProperties() { Channels::initNew(mChannels); }

TnFbxTransform::~TnFbxTransform() = default;

// kept: the name is not copied
TnFbxTransform& TnFbxTransform::operator=(const TnFbxTransform& other) {
    if (this != &other) {
        mProperties = other.mProperties;
        mChannels = other.mChannels;
    }
    return *this;
}

bool TnFbxTransform::initTransform() {
    Channels::init(mChannels);
    mProperties = Properties();
    return true;
}

bool TnFbxTransform::deleteTransform() {
    Channels::clear(mChannels);
    mProperties = Properties();
    return true;
}

bool TnFbxTransform::setTransformValue(EFbxTransformChannelType channel, float value) {
    return Channels::setValue(mChannels, channel, value);
}

bool TnFbxTransform::setTransformValueAt(EFbxTransformChannelType channel, TnFbxTime time,
                                         const std::vector<float>& values) {
    return Channels::setValues(mChannels, channel, time, values);
}

bool TnFbxTransform::moveTransformValuesAt(EFbxTransformChannelType channel, TnFbxTime time,
                                           std::vector<float>&& values) {
    return Channels::moveValues(mChannels, channel, time, std::move(values));
}

float TnFbxTransform::getTransformValue(EFbxTransformChannelType channel) const {
    return Channels::value(mChannels, channel);
}

float TnFbxTransform::getTransformValueAt(EFbxTransformChannelType channel, float frame) const {
    return Channels::valueAt(mChannels, channel, frame);
}

bool TnFbxTransform::getTransformAnimated(EFbxTransformChannelType channel) const {
    return Channels::animated(mChannels, channel);
}

TnFbxTime TnFbxTransform::getTransformTime(EFbxTransformChannelType channel) const {
    return Channels::time(mChannels, channel);
}

TnFbxChannel* TnFbxTransform::getTransformChannel(EFbxTransformChannelType channel) {
    return Channels::find(mChannels, channel);
}

const char* TnFbxTransform::getTransformChannelName(EFbxTransformChannelType channel) {
    return Channels::name(channel);
}

bool TnFbxTransform::setTransformRotationOrder(EFbxTransformRotationOrder order) {
    mProperties.rotationOrder = order;
    return true;
}

TnFbxTransform::EFbxTransformRotationOrder TnFbxTransform::getTransformRotationOrder() const {
    return mProperties.rotationOrder;
}

bool TnFbxTransform::setTransformTransformOrder(EFbxTransformTransformOrder order) {
    mProperties.transformOrder = order;
    return true;
}

TnFbxTransform::EFbxTransformTransformOrder TnFbxTransform::getTransformTransformOrder() const {
    return mProperties.transformOrder;
}

} // namespace Tarnell::Fbx
