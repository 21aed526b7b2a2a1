// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The common part of transforms, cameras, lights and markers: channels behind an enumeration, with the same members
// under almost the same names. Every behaviour is tested on all four, against tables written out by hand.
#include "TnFbxCamera.h"
#include "TnFbxLight.h"
#include "TnFbxMarker.h"
#include "TnFbxTransform.h"

#include "ModelValues.h"

#include <cstddef>
#include <string>
#include <type_traits>
#include <vector>

namespace Tarnell::Fbx {
namespace {

using test::expectDefaultTime;
using test::expectTime;
using test::kHighest;
using test::kLowest;
using test::range;
using test::timeRecord;

struct ExpectedChannel {
    int number;
    int enumerator;
    const char* name;
    float constant;
    float defaultValue;
};

struct Transform : TnFbxTransform {
    using Channel = EFbxTransformChannelType;

    static const std::vector<ExpectedChannel>& expected() {
        static const std::vector<ExpectedChannel> rows = {
            {0, kFbxTransformPositionX, "positionX", kDefaultTransformPositionX, 0.0f},
            {1, kFbxTransformPositionY, "positionY", kDefaultTransformPositionY, 0.0f},
            {2, kFbxTransformPositionZ, "positionZ", kDefaultTransformPositionZ, 0.0f},
            {3, kFbxTransformRotationX, "rotationX", kDefaultTransformRotationX, 0.0f},
            {4, kFbxTransformRotationY, "rotationY", kDefaultTransformRotationY, 0.0f},
            {5, kFbxTransformRotationZ, "rotationZ", kDefaultTransformRotationZ, 0.0f},
            {6, kFbxTransformScaleX, "scaleX", kDefaultTransformScaleX, 1.0f},
            {7, kFbxTransformScaleY, "scaleY", kDefaultTransformScaleY, 1.0f},
            {8, kFbxTransformScaleZ, "scaleZ", kDefaultTransformScaleZ, 1.0f},
            {9, kFbxTransformSkewX, "skewX", kDefaultTransformSkewX, 0.0f},
            {10, kFbxTransformSkewY, "skewY", kDefaultTransformSkewY, 0.0f},
            {11, kFbxTransformSkewZ, "skewZ", kDefaultTransformSkewZ, 0.0f},
            {12, kFbxTransformPivotX, "pivotX", kDefaultTransformPivotX, 0.0f},
            {13, kFbxTransformPivotY, "pivotY", kDefaultTransformPivotY, 0.0f},
            {14, kFbxTransformPivotZ, "pivotZ", kDefaultTransformPivotZ, 0.0f},
        };
        return rows;
    }

    bool init() { return initTransform(); }
    bool clear() { return deleteTransform(); }
    bool setValue(Channel channel, float value) { return setTransformValue(channel, value); }
    bool setValueAt(Channel channel, TnFbxTime time, const std::vector<float>& values) {
        return setTransformValueAt(channel, time, values);
    }
    float getValue(Channel channel) const { return getTransformValue(channel); }
    float getValueAt(Channel channel, float frame) const { return getTransformValueAt(channel, frame); }
    bool getAnimated(Channel channel) const { return getTransformAnimated(channel); }
    TnFbxTime getTime(Channel channel) const { return getTransformTime(channel); }
    TnFbxChannel* channelObject(Channel channel) { return getTransformChannel(channel); }
    static const char* getChannelName(Channel channel) { return getTransformChannelName(channel); }
};

struct Camera : TnFbxCamera {
    using Channel = EFbxCameraChannelType;

    static const std::vector<ExpectedChannel>& expected() {
        static const std::vector<ExpectedChannel> rows = {
            {0, kFbxCameraLookAtPositionX, "lookAtPositionX", kDefaultCameraLookAtPositionX, 0.0f},
            {1, kFbxCameraLookAtPositionY, "lookAtPositionY", kDefaultCameraLookAtPositionY, 0.0f},
            {2, kFbxCameraLookAtPositionZ, "lookAtPositionZ", kDefaultCameraLookAtPositionZ, 0.0f},
            {3, kFbxCameraUpPositionX, "upPositionX", kDefaultCameraUpX, 0.0f},
            {4, kFbxCameraUpPositionY, "upPositionY", kDefaultCameraUpY, 1.0f},
            {5, kFbxCameraUpPositionZ, "upPositionZ", kDefaultCameraUpZ, 0.0f},
            {6, kFbxCameraRoll, "roll", kDefaultCameraRoll, 0.0f},
            {7, kFbxCameraFocalLength, "focalLength", kDefaultCameraFocalLength, 50.0f},
            {8, kFbxCameraApertureWidth, "apertureWidth", kDefaultCameraApertureWidth, 24.576f},
            {9, kFbxCameraApertureHeight, "apertureHeight", kDefaultCameraApertureHeight, 18.672f},
            {10, kFbxCameraNearPlane, "nearPlane", kDefaultCameraNearPlane, 0.1f},
            {11, kFbxCameraFarPlane, "farPlane", kDefaultCameraFarPlane, 10000.0f},
            {12, kFbxCameraFieldOfView, "filedOfView", kDefaultCameraFieldOfView, 25.115f},
            {13, kFbxCameraFieldOfViewX, "filedOfViewX", kDefaultCameraFieldOfViewX, 40.0f},
            {14, kFbxCameraFieldOfViewY, "filedOfViewY", kDefaultCameraFieldOfViewY, 40.0f},
            {15, kFbxCameraFilmOffsetX, "filmOffsetX", kDefaultCameraFilmOffsetX, 0.0f},
            {16, kFbxCameraFilmOffsetY, "filmOffsetY", kDefaultCameraFilmOffsetY, 0.0f},
        };
        return rows;
    }

    bool init() { return initCamera(); }
    bool clear() { return deleteCamera(); }
    TnFbxChannel* channelObject(Channel channel) { return getCameraChannel(channel); }
};

struct Light : TnFbxLight {
    using Channel = EFbxLightChannelType;

    static const std::vector<ExpectedChannel>& expected() {
        static const std::vector<ExpectedChannel> rows = {
            {0, kFbxLightRed, "red", kDefaultLightRed, 1.0f},
            {1, kFbxLightGreen, "green", kDefaultLightGreen, 1.0f},
            {2, kFbxLightBlue, "blue", kDefaultLightBlue, 1.0f},
            {3, kFbxLightAlpha, "alpha", kDefaultLightAlpha, 1.0f},
            {4, kFbxLightIntensity, "intensity", kDefaultLightIntensity, 1.0f},
            {5, kFbxLightConeAngle, "cone angle", kDefaultLightConeAngle, 40.0f},
        };
        return rows;
    }

    bool init() { return initLight(); }
    bool clear() { return deleteLight(); }
    TnFbxChannel* channelObject(Channel channel) { return getLightChannel(channel); }
};

struct Marker : TnFbxMarker {
    using Channel = EFbxMarkerChannelType;

    static const std::vector<ExpectedChannel>& expected() {
        static const std::vector<ExpectedChannel> rows = {
            {0, kFbxMarkerRed, "red", kDefaultMarkerRed, 1.0f},
            {1, kFbxMarkerGreen, "green", kDefaultMarkerGreen, 1.0f},
            {2, kFbxMarkerBlue, "blue", kDefaultMarkerBlue, 1.0f},
            {3, kFbxMarkerAlpha, "alpha", kDefaultMarkerAlpha, 1.0f},
        };
        return rows;
    }

    bool init() { return initMarker(); }
    bool clear() { return deleteMarker(); }
};

struct OwnerNames {
    template <typename Owner>
    static std::string GetName(int) {
        if constexpr (std::is_base_of_v<TnFbxCamera, Owner>)
            return "Camera";
        else if constexpr (std::is_base_of_v<TnFbxLight, Owner>)
            return "Light";
        else if constexpr (std::is_base_of_v<TnFbxMarker, Owner>)
            return "Marker";
        else
            return "Transform";
    }
};

template <typename Owner>
std::vector<typename Owner::Channel> allChannels() {
    std::vector<typename Owner::Channel> channels;
    for (std::size_t i = 0; i < Owner::expected().size(); ++i)
        channels.push_back(static_cast<typename Owner::Channel>(i));
    return channels;
}

template <typename Owner>
std::vector<typename Owner::Channel> numbersThatAreNoChannel() {
    const int count = static_cast<int>(Owner::expected().size());
    std::vector<typename Owner::Channel> numbers;
    for (const int number : {count, count + 1, 255, 256, kHighest, -1, -count, kLowest})
        numbers.push_back(static_cast<typename Owner::Channel>(number));
    return numbers;
}

template <typename Owner>
void expectEveryChannelAtItsDefault(const Owner& owner) {
    for (const ExpectedChannel& row : Owner::expected()) {
        SCOPED_TRACE(row.name);
        const auto channel = static_cast<typename Owner::Channel>(row.number);
        EXPECT_EQ(owner.getValue(channel), row.defaultValue);
        EXPECT_EQ(owner.getValueAt(channel, 7.5f), row.defaultValue);
        EXPECT_FALSE(owner.getAnimated(channel));
        expectDefaultTime(owner.getTime(channel));
    }
}

/// Channel i: static value 100 + i, samples i and i + 1 over frames 5 to 6.
template <typename Owner>
void fill(Owner& owner) {
    for (const auto channel : allChannels<Owner>()) {
        const float i = static_cast<float>(channel);
        ASSERT_TRUE(owner.setValue(channel, 100.0f + i));
        ASSERT_TRUE(owner.setValueAt(channel, timeRecord(1.0f, 5, 6, 30.0f), {i, i + 1.0f}));
    }
}

template <typename Owner>
void expectFilled(const Owner& owner) {
    for (const auto channel : allChannels<Owner>()) {
        SCOPED_TRACE(Owner::getChannelName(channel));
        const float i = static_cast<float>(channel);
        EXPECT_EQ(owner.getValue(channel), 100.0f + i);
        EXPECT_TRUE(owner.getAnimated(channel));
        EXPECT_EQ(owner.getValueAt(channel, 5.0f), i);
        EXPECT_EQ(owner.getValueAt(channel, 5.5f), i + 0.5f);
        EXPECT_EQ(owner.getValueAt(channel, 9.0f), i + 1.0f);
        expectTime(owner.getTime(channel), 1.0f, 5, 6, 30.0f);
    }
}

template <typename Owner>
class ChannelOwner : public testing::Test {};

using Owners = testing::Types<Transform, Camera, Light, Marker>;
TYPED_TEST_SUITE(ChannelOwner, Owners, OwnerNames);

TYPED_TEST(ChannelOwner, NumbersNamesAndDefaultsAreThoseOfTheTable) {
    int number = 0;
    for (const ExpectedChannel& row : TypeParam::expected()) {
        SCOPED_TRACE(row.name);
        EXPECT_EQ(row.number, number++);
        EXPECT_EQ(row.enumerator, row.number);
        EXPECT_EQ(row.constant, row.defaultValue);
        EXPECT_STREQ(TypeParam::getChannelName(static_cast<typename TypeParam::Channel>(row.number)), row.name);
    }
}

TYPED_TEST(ChannelOwner, StartsWithEveryChannelAtItsDefault) { expectEveryChannelAtItsDefault(TypeParam()); }

TYPED_TEST(ChannelOwner, NamesAreConstantsThatOutliveEveryObject) {
    for (const auto channel : allChannels<TypeParam>())
        EXPECT_EQ(TypeParam::getChannelName(channel), TypeParam().getChannelName(channel));
}

TYPED_TEST(ChannelOwner, SetsTheStaticValueOfOneChannelAlone) {
    for (const auto changed : allChannels<TypeParam>()) {
        TypeParam owner;
        EXPECT_TRUE(owner.setValue(changed, -8.25f));
        for (const ExpectedChannel& row : TypeParam::expected()) {
            const auto channel = static_cast<typename TypeParam::Channel>(row.number);
            EXPECT_EQ(owner.getValue(channel), channel == changed ? -8.25f : row.defaultValue) << row.name;
            EXPECT_FALSE(owner.getAnimated(channel));
        }
    }
}

TYPED_TEST(ChannelOwner, SetsTheSamplesOfOneChannelAlone) {
    for (const auto changed : allChannels<TypeParam>()) {
        TypeParam owner;
        EXPECT_TRUE(owner.setValueAt(changed, range(1, 2), {3.0f, 4.0f}));
        for (const auto channel : allChannels<TypeParam>())
            EXPECT_EQ(owner.getAnimated(channel), channel == changed);
        EXPECT_EQ(owner.getValueAt(changed, 1.5f), 3.5f);
    }
}

TYPED_TEST(ChannelOwner, FillsAndReadsBackEveryChannel) {
    TypeParam owner;

    fill(owner);

    expectFilled(owner);
}

TYPED_TEST(ChannelOwner, PassesTheRejectionOfSamplesOn) {
    TypeParam owner;
    fill(owner);

    for (const auto channel : allChannels<TypeParam>()) {
        EXPECT_FALSE(owner.setValueAt(channel, range(1, 3), {1.0f, 2.0f}));
        EXPECT_FALSE(owner.setValueAt(channel, range(1, 1), {}));
    }

    expectFilled(owner);
}

TYPED_TEST(ChannelOwner, RejectsEveryNumberThatIsNoChannel) {
    TypeParam owner;
    fill(owner);

    for (const auto channel : numbersThatAreNoChannel<TypeParam>()) {
        SCOPED_TRACE(static_cast<int>(channel));
        EXPECT_FALSE(owner.setValue(channel, 1.0f));
        EXPECT_FALSE(owner.setValueAt(channel, range(1, 1), {1.0f}));
        EXPECT_EQ(owner.getValue(channel), 0.0f);
        EXPECT_EQ(owner.getValueAt(channel, 5.0f), 0.0f);
        EXPECT_FALSE(owner.getAnimated(channel));
        expectDefaultTime(owner.getTime(channel));
        EXPECT_EQ(TypeParam::getChannelName(channel), nullptr);
    }
    expectFilled(owner);
}

TYPED_TEST(ChannelOwner, InitGoesBackToTheDefaults) {
    TypeParam owner;
    fill(owner);

    EXPECT_TRUE(owner.init());

    expectEveryChannelAtItsDefault(owner);
}

TYPED_TEST(ChannelOwner, DeleteLeavesZeroWhateverTheDefault) {
    TypeParam owner;
    fill(owner);

    EXPECT_TRUE(owner.clear());

    for (const auto channel : allChannels<TypeParam>()) {
        SCOPED_TRACE(TypeParam::getChannelName(channel));
        EXPECT_EQ(owner.getValue(channel), 0.0f);
        EXPECT_EQ(owner.getValueAt(channel, 5.0f), 0.0f);
        EXPECT_FALSE(owner.getAnimated(channel));
        expectDefaultTime(owner.getTime(channel));
    }
}

TYPED_TEST(ChannelOwner, AssignmentCopiesEveryChannel) {
    TypeParam source;
    TypeParam target;
    fill(source);

    target = source;
    source.clear();

    expectFilled(target);
}

TYPED_TEST(ChannelOwner, AssignmentToItselfChangesNothing) {
    TypeParam owner;
    fill(owner);
    const TypeParam& alias = owner;

    owner = alias;

    expectFilled(owner);
}

TYPED_TEST(ChannelOwner, AssignmentKeepsTheTargetsName) {
    TypeParam source;
    TypeParam target;
    source.setName("a");
    target.setName("b");

    target = source;

    EXPECT_EQ(target.getName(), "b");
}

TYPED_TEST(ChannelOwner, ACopyHasEveryChannelAndTheName) {
    TypeParam source;
    source.setName("a");
    fill(source);

    const TypeParam copy(source);
    source.clear();
    source.setName("");

    expectFilled(copy);
    EXPECT_EQ(copy.getName(), "a");
}

/// Those that give access to the channel objects; markers do not.
template <typename Owner>
class ChannelObjectOwner : public testing::Test {};

using ObjectOwners = testing::Types<Transform, Camera, Light>;
TYPED_TEST_SUITE(ChannelObjectOwner, ObjectOwners, OwnerNames);

TYPED_TEST(ChannelObjectOwner, ReturnsTheChannelItself) {
    TypeParam owner;

    for (const auto channel : allChannels<TypeParam>()) {
        SCOPED_TRACE(TypeParam::getChannelName(channel));
        TnFbxChannel* object = owner.channelObject(channel);
        ASSERT_NE(object, nullptr);
        object->setValue(5.0f);
        object->setValueAt(3.0f, 6.0f);
        EXPECT_EQ(owner.getValue(channel), 5.0f);
        EXPECT_EQ(owner.getValueAt(channel, 3.0f), 6.0f);
        EXPECT_TRUE(owner.getAnimated(channel));
        EXPECT_EQ(owner.getTime(channel).getStartFrame(), 3);
    }
}

TYPED_TEST(ChannelObjectOwner, ReturnsNoChannelForAnInvalidNumber) {
    TypeParam owner;

    for (const auto channel : numbersThatAreNoChannel<TypeParam>())
        EXPECT_EQ(owner.channelObject(channel), nullptr) << static_cast<int>(channel);
}

} // namespace
} // namespace Tarnell::Fbx
