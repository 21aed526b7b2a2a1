// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The setters of samples have one meaning each: hosts and bindings take their addresses.
#include <type_traits>
#include <vector>

#include <gtest/gtest.h>

#include "TnFbxCamera.h"
#include "TnFbxChannel.h"
#include "TnFbxLight.h"
#include "TnFbxMarker.h"
#include "TnFbxTransform.h"

namespace Tarnell::Fbx {
namespace {

template <class Class, class Channel>
using ValuesSetter = bool (Class::*)(Channel, TnFbxTime, const std::vector<float>&);

TEST(MemberPointers, AreUnambiguousForTheSettersOfSamples) {
    const auto camera = &TnFbxCamera::setValueAt;
    const auto light = &TnFbxLight::setValueAt;
    const auto marker = &TnFbxMarker::setValueAt;
    const auto transform = &TnFbxTransform::setTransformValueAt;
    const auto channel = &TnFbxChannel::setAnimatedValues;

    static_assert(
        std::is_same_v<decltype(camera), const ValuesSetter<TnFbxCamera, TnFbxCamera::EFbxCameraChannelType>>);
    static_assert(std::is_same_v<decltype(light), const ValuesSetter<TnFbxLight, TnFbxLight::EFbxLightChannelType>>);
    static_assert(
        std::is_same_v<decltype(marker), const ValuesSetter<TnFbxMarker, TnFbxMarker::EFbxMarkerChannelType>>);
    static_assert(std::is_same_v<decltype(transform),
                                 const ValuesSetter<TnFbxTransform, TnFbxTransform::EFbxTransformChannelType>>);
    static_assert(std::is_same_v<decltype(channel), bool (TnFbxChannel::*const)(TnFbxTime, const std::vector<float>&)>);

    TnFbxCamera object;
    TnFbxTime time;
    time.setTime(0.0f, 1, 2, 24.0f);
    EXPECT_TRUE((object.*camera)(TnFbxCamera::kFbxCameraFocalLength, time, {35.0f, 50.0f}));
    EXPECT_EQ(object.getValueAt(TnFbxCamera::kFbxCameraFocalLength, 2.0f), 50.0f);
}

TEST(MemberPointers, SamplesThatAreMovedInBringTheirMemory) {
    TnFbxTime time;
    time.setTime(0.0f, 1, 2, 24.0f);
    std::vector<float> values{35.0f, 50.0f};
    TnFbxCamera camera;

    EXPECT_TRUE(camera.moveValuesAt(TnFbxCamera::kFbxCameraFocalLength, time, std::move(values)));

    EXPECT_TRUE(values.empty()); // NOLINT(bugprone-use-after-move): this is what moving does here
    EXPECT_EQ(camera.getValueAt(TnFbxCamera::kFbxCameraFocalLength, 1.0f), 35.0f);
}

} // namespace
} // namespace Tarnell::Fbx
