// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The camera: seventeen channels, two modes, and the look-at conversion over its channels.
#include "TnFbxCamera.h"

#include <utility>

#include "ChannelSet.h"
#include "LookAtRotation.h"

namespace Tarnell::Fbx {

namespace {

constexpr detail::ChannelRow<TnFbxCamera::EFbxCameraChannelType> kCameraChannels[] = {
    {TnFbxCamera::kFbxCameraLookAtPositionX, "lookAtPositionX", TnFbxCamera::kDefaultCameraLookAtPositionX},
    {TnFbxCamera::kFbxCameraLookAtPositionY, "lookAtPositionY", TnFbxCamera::kDefaultCameraLookAtPositionY},
    {TnFbxCamera::kFbxCameraLookAtPositionZ, "lookAtPositionZ", TnFbxCamera::kDefaultCameraLookAtPositionZ},
    {TnFbxCamera::kFbxCameraUpPositionX, "upPositionX", TnFbxCamera::kDefaultCameraUpX},
    {TnFbxCamera::kFbxCameraUpPositionY, "upPositionY", TnFbxCamera::kDefaultCameraUpY},
    {TnFbxCamera::kFbxCameraUpPositionZ, "upPositionZ", TnFbxCamera::kDefaultCameraUpZ},
    {TnFbxCamera::kFbxCameraRoll, "roll", TnFbxCamera::kDefaultCameraRoll},
    {TnFbxCamera::kFbxCameraFocalLength, "focalLength", TnFbxCamera::kDefaultCameraFocalLength},
    {TnFbxCamera::kFbxCameraApertureWidth, "apertureWidth", TnFbxCamera::kDefaultCameraApertureWidth},
    {TnFbxCamera::kFbxCameraApertureHeight, "apertureHeight", TnFbxCamera::kDefaultCameraApertureHeight},
    {TnFbxCamera::kFbxCameraNearPlane, "nearPlane", TnFbxCamera::kDefaultCameraNearPlane},
    {TnFbxCamera::kFbxCameraFarPlane, "farPlane", TnFbxCamera::kDefaultCameraFarPlane},
    // kept: the spelling of these three
    {TnFbxCamera::kFbxCameraFieldOfView, "filedOfView", TnFbxCamera::kDefaultCameraFieldOfView},
    {TnFbxCamera::kFbxCameraFieldOfViewX, "filedOfViewX", TnFbxCamera::kDefaultCameraFieldOfViewX},
    {TnFbxCamera::kFbxCameraFieldOfViewY, "filedOfViewY", TnFbxCamera::kDefaultCameraFieldOfViewY},
    {TnFbxCamera::kFbxCameraFilmOffsetX, "filmOffsetX", TnFbxCamera::kDefaultCameraFilmOffsetX},
    {TnFbxCamera::kFbxCameraFilmOffsetY, "filmOffsetY", TnFbxCamera::kDefaultCameraFilmOffsetY},
};

using Channels = detail::ChannelSet<kCameraChannels>;

detail::Vector3 load(const float* components) { return {components[0], components[1], components[2]}; }

void store(const detail::Vector3& v, float* components) {
    components[0] = v.x;
    components[1] = v.y;
    components[2] = v.z;
}

void store(const detail::Vector3& v, float& x, float& y, float& z) {
    x = v.x;
    y = v.y;
    z = v.z;
}

} // namespace

TnFbxCamera::TnFbxCamera() : mProperties() { Channels::initNew(mChannels); }

TnFbxCamera::~TnFbxCamera() = default;

// kept: nothing of the transform is copied, nor the name
TnFbxCamera& TnFbxCamera::operator=(const TnFbxCamera& other) {
    if (this != &other) {
        mProperties = other.mProperties;
        mChannels = other.mChannels;
    }
    return *this;
}

bool TnFbxCamera::initCamera() {
    Channels::init(mChannels);
    mProperties = Properties();
    return true;
}

bool TnFbxCamera::deleteCamera() {
    Channels::clear(mChannels);
    mProperties = Properties();
    return true;
}

bool TnFbxCamera::setValue(EFbxCameraChannelType channel, float value) {
    return Channels::setValue(mChannels, channel, value);
}

bool TnFbxCamera::setValueAt(EFbxCameraChannelType channel, TnFbxTime time, const std::vector<float>& values) {
    return Channels::setValues(mChannels, channel, time, values);
}

bool TnFbxCamera::moveValuesAt(EFbxCameraChannelType channel, TnFbxTime time, std::vector<float>&& values) {
    return Channels::moveValues(mChannels, channel, time, std::move(values));
}

float TnFbxCamera::getValue(EFbxCameraChannelType channel) const { return Channels::value(mChannels, channel); }

float TnFbxCamera::getValueAt(EFbxCameraChannelType channel, float frame) const {
    return Channels::valueAt(mChannels, channel, frame);
}

bool TnFbxCamera::getAnimated(EFbxCameraChannelType channel) const { return Channels::animated(mChannels, channel); }

TnFbxTime TnFbxCamera::getTime(EFbxCameraChannelType channel) const { return Channels::time(mChannels, channel); }

TnFbxChannel* TnFbxCamera::getCameraChannel(EFbxCameraChannelType channel) {
    return Channels::find(mChannels, channel);
}

const char* TnFbxCamera::getChannelName(EFbxCameraChannelType channel) { return Channels::name(channel); }

bool TnFbxCamera::setProjectionType(EFbxCameraProjectionType projectionType) {
    mProperties.projectionType = projectionType;
    return true;
}

TnFbxCamera::EFbxCameraProjectionType TnFbxCamera::getProjectionType() const { return mProperties.projectionType; }

bool TnFbxCamera::setApertureMode(EFbxCameraApertureMode apertureMode) {
    mProperties.apertureMode = apertureMode;
    return true;
}

TnFbxCamera::EFbxCameraApertureMode TnFbxCamera::getApertureMode() const { return mProperties.apertureMode; }

void TnFbxCamera::normalize(float& x, float& y, float& z) { store(detail::normalized({x, y, z}), x, y, z); }

void TnFbxCamera::crossProduct(float ax, float ay, float az, float bx, float by, float bz, float& cx, float& cy,
                               float& cz) {
    store(detail::cross({ax, ay, az}, {bx, by, bz}), cx, cy, cz);
}

bool TnFbxCamera::calculateCameraRotation(float* position, float* lookAt, float* up, float roll, float& rotationX,
                                          float& rotationY, float& rotationZ) {
    const auto [direction, rolledUp, angles] = detail::rotationFromLookAt(load(position), load(lookAt), load(up), roll);
    store(direction, lookAt); // kept: the inputs are overwritten
    store({0.0f, 0.0f, 0.0f}, position);
    store(rolledUp, up);
    store(angles, rotationX, rotationY, rotationZ);
    return true;
}

bool TnFbxCamera::calculateCameraRotationAt(float& rotationX, float& rotationY, float& rotationZ, float frame) const {
    float position[] = {getTransformValueAt(kFbxTransformPositionX, frame),
                        getTransformValueAt(kFbxTransformPositionY, frame),
                        getTransformValueAt(kFbxTransformPositionZ, frame)};
    float lookAt[] = {getValueAt(kFbxCameraLookAtPositionX, frame), getValueAt(kFbxCameraLookAtPositionY, frame),
                      getValueAt(kFbxCameraLookAtPositionZ, frame)};
    // kept: the up point is taken as a direction, not relative to the position
    float up[] = {getValueAt(kFbxCameraUpPositionX, frame), getValueAt(kFbxCameraUpPositionY, frame),
                  getValueAt(kFbxCameraUpPositionZ, frame)};
    return calculateCameraRotation(position, lookAt, up, getValueAt(kFbxCameraRoll, frame), rotationX, rotationY,
                                   rotationZ);
}

} // namespace Tarnell::Fbx
