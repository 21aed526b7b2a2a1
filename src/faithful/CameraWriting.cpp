// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Cameras: lens and film that are consistent whichever of them a reader uses, both film offsets, and the aim.
#include "Aim.h"
#include "Decomposition.h"
#include "Lens.h"
#include "PlacementWriting.h"
#include "Writing.h"
#include "access/WriteChecks.h"

#include "TnFbxCamera.h"

#include <algorithm>
#include <array>
#include <optional>
#include <vector>

namespace Tarnell::Fbx::faithful {

namespace {

using fbxsdk::FbxAMatrix;
using fbxsdk::FbxCamera;
using fbxsdk::FbxVector4;
using Channel = TnFbxCamera::EFbxCameraChannelType;
using Mode = TnFbxCamera::EFbxCameraApertureMode;

const TnFbxChannel& channelOf(TnFbxCamera& camera, int channel) {
    return *camera.getCameraChannel(static_cast<Channel>(channel));
}

Channels3 channelsFrom(TnFbxCamera& camera, Channel first) {
    return {&channelOf(camera, first), &channelOf(camera, first + 1), &channelOf(camera, first + 2)};
}

// ---- Lens and film ----

/// A new camera's default film is in millimetres: a film of 24 inches does not exist.
double inchesPerUnit(TnFbxCamera& camera) {
    const TnFbxChannel& width = channelOf(camera, TnFbxCamera::kFbxCameraApertureWidth);
    const TnFbxChannel& height = channelOf(camera, TnFbxCamera::kFbxCameraApertureHeight);
    const bool isDefault = !width.getAnimated() && !height.getAnimated() &&
                           width.getValue() == TnFbxCamera::kDefaultCameraApertureWidth &&
                           height.getValue() == TnFbxCamera::kDefaultCameraApertureHeight;
    return isDefault ? 1.0 / kMillimetresPerInch : 1.0;
}

FbxCamera::EApertureMode apertureModeOf(Mode mode) {
    switch (mode) {
    case TnFbxCamera::kFbxApertureHorizontalAndVertical:
        return FbxCamera::eHorizAndVert;
    case TnFbxCamera::kFbxApertureHorizontal:
        return FbxCamera::eHorizontal;
    case TnFbxCamera::kFbxApertureVertical:
        return FbxCamera::eVertical;
    default:
        return FbxCamera::eFocalLength;
    }
}

/// The value that drives the lens, besides the film.
std::vector<Channel> driversOf(Mode mode) {
    switch (mode) {
    case TnFbxCamera::kFbxApertureHorizontalAndVertical:
        return {TnFbxCamera::kFbxCameraFieldOfViewX, TnFbxCamera::kFbxCameraFieldOfViewY};
    case TnFbxCamera::kFbxApertureHorizontal:
    case TnFbxCamera::kFbxApertureVertical:
        return {TnFbxCamera::kFbxCameraFieldOfView};
    default:
        return {TnFbxCamera::kFbxCameraFocalLength};
    }
}

struct LensRow {
    Channel channel;
    fbxsdk::FbxPropertyT<fbxsdk::FbxDouble> FbxCamera::*property;
    double Lens::*value;
};
constexpr LensRow kLensRows[] = {
    {TnFbxCamera::kFbxCameraFocalLength, &FbxCamera::FocalLength, &Lens::focalLength},
    {TnFbxCamera::kFbxCameraApertureWidth, &FbxCamera::FilmWidth, &Lens::width},
    {TnFbxCamera::kFbxCameraApertureHeight, &FbxCamera::FilmHeight, &Lens::height},
    {TnFbxCamera::kFbxCameraFieldOfView, &FbxCamera::FieldOfView, &Lens::fieldOfView},
    {TnFbxCamera::kFbxCameraFieldOfViewX, &FbxCamera::FieldOfViewX, &Lens::fieldOfViewX},
    {TnFbxCamera::kFbxCameraFieldOfViewY, &FbxCamera::FieldOfViewY, &Lens::fieldOfViewY},
};

/// The lens of a camera at any frame.
class LensSource {
public:
    LensSource(KeyWriter& keys, TnFbxCamera& camera)
        : mKeys(keys), mCamera(camera), mMode(camera.getApertureMode()), mDrivers(driversOf(mMode)),
          mInches(inchesPerUnit(camera)) {
        std::vector<const TnFbxChannel*> channels = {&channelOf(camera, TnFbxCamera::kFbxCameraApertureWidth),
                                                     &channelOf(camera, TnFbxCamera::kFbxCameraApertureHeight)};
        for (const Channel driver : mDrivers)
            channels.push_back(&channelOf(camera, driver));
        mRange = keys.rangeOf(channels);
    }

    const FrameRange& range() const { return mRange; }

    Lens at(std::int64_t frame) const {
        return agreeingWith([&](const TnFbxChannel& channel) { return mKeys.valueAt(channel, frame, mRange); });
    }
    Lens still() const { return agreeingWith(staticValue); }

    /// Angles that do not drive the lens stay static: readers compute them.
    bool isKeyed(Channel channel) const {
        const bool drives = std::find(mDrivers.begin(), mDrivers.end(), channel) != mDrivers.end();
        return drives ||
               (channel != TnFbxCamera::kFbxCameraFieldOfView && channel != TnFbxCamera::kFbxCameraFieldOfViewX &&
                channel != TnFbxCamera::kFbxCameraFieldOfViewY);
    }

private:
    template <class ValueOf>
    Lens agreeingWith(const ValueOf& valueOf) const {
        Lens stated{};
        for (const LensRow& row : kLensRows)
            stated.*row.value = valueOf(channelOf(mCamera, row.channel));
        stated.width *= mInches;
        stated.height *= mInches;
        Lens lens = agreeing(stated, mMode);
        for (const LensRow& row : kLensRows) // unchanged, not computed from themselves
            if (std::find(mDrivers.begin(), mDrivers.end(), row.channel) != mDrivers.end())
                lens.*row.value = stated.*row.value;
        return lens;
    }

    const KeyWriter& mKeys;
    TnFbxCamera& mCamera;
    Mode mMode;
    std::vector<Channel> mDrivers;
    double mInches;
    FrameRange mRange;
};

void writeLens(KeyWriter& keys, TnFbxCamera& source, FbxCamera& camera) {
    const LensSource lens(keys, source);
    const Lens still = lens.still();
    camera.ApertureMode.Set(apertureModeOf(source.getApertureMode()));
    camera.FilmSqueezeRatio.Set(1.0);
    if (still.height > 0.0)
        camera.FilmAspectRatio.Set(still.width / still.height);
    for (const LensRow& row : kLensRows) {
        (camera.*row.property).Set(still.*row.value);
        if (lens.isKeyed(row.channel)) {
            keys.writeKeys(
                camera.*row.property, nullptr, lens.range(),
                [&](std::int64_t frame) { return lens.at(frame).*row.value; });
        }
    }
}

// ---- Direction ----

/// The direction that a camera's rotation and its look-at channels give.
class LookAt {
public:
    LookAt(KeyWriter& keys, TnFbxCamera& camera) : mKeys(keys), mCamera(camera) {
        std::vector<const TnFbxChannel*> channels;
        for (int i = TnFbxCamera::kFbxCameraLookAtPositionX; i <= TnFbxCamera::kFbxCameraRoll; ++i)
            channels.push_back(&channelOf(camera, i));
        for (int i = TnFbxTransform::kFbxTransformPositionX; i <= TnFbxTransform::kFbxTransformRotationZ; ++i)
            channels.push_back(camera.getTransformChannel(static_cast<TnFbxTransform::EFbxTransformChannelType>(i)));
        mRange = keys.rangeOf(channels);
    }

    const FrameRange& range() const { return mRange; }

    /// The camera rotated toward the point with its up vector, and rolled.
    FbxAMatrix aimedAt(std::int64_t frame) const {
        return aimed(placeAt(frame), vectorAt(TnFbxCamera::kFbxCameraLookAtPositionX, frame),
                     vectorAt(TnFbxCamera::kFbxCameraUpPositionX, frame), valueAt(TnFbxCamera::kFbxCameraRoll, frame));
    }

    /// A point was set, and no rotation.
    bool wantsAim() const {
        const auto isSet = [this](Channel channel, float otherwise) {
            const TnFbxChannel& set = channelOf(mCamera, channel);
            return set.getAnimated() || set.getValue() != otherwise;
        };
        const bool hasPoint =
            isSet(TnFbxCamera::kFbxCameraLookAtPositionX, TnFbxCamera::kDefaultCameraLookAtPositionX) ||
            isSet(TnFbxCamera::kFbxCameraLookAtPositionY, TnFbxCamera::kDefaultCameraLookAtPositionY) ||
            isSet(TnFbxCamera::kFbxCameraLookAtPositionZ, TnFbxCamera::kDefaultCameraLookAtPositionZ);
        const faithful::Channels3 rotation = faithful::channelsFrom(mCamera, TnFbxTransform::kFbxTransformRotationX);
        return hasPoint && std::all_of(rotation.begin(), rotation.end(), [](const TnFbxChannel* channel) {
                   return !channel->getAnimated() && channel->getValue() == 0.0f;
               });
    }

    /// The rotation is that of a camera with a target, including the roll.
    bool isRolledAim() const {
        const TnFbxChannel& roll = channelOf(mCamera, TnFbxCamera::kFbxCameraRoll);
        if (!changes(roll) && staticValue(roll) == 0.0)
            return false;
        for (std::int64_t frame = mRange.first; frame <= mRange.last; ++frame) {
            constexpr double kSameDirection = 1e-4; // of computed floats
            const FbxAMatrix own = placeAt(frame), aim = aimedAt(frame);
            for (int axis = 0; axis < 3; ++axis) {
                for (int component = 0; component < 3; ++component)
                    if (!(std::abs(own.Get(axis, component) - aim.Get(axis, component)) < kSameDirection))
                        return false;
            }
        }
        return true;
    }

    /// The angles of the aimed camera, for readers that do not follow targets.
    void turnToward(KeyWriter& keys, fbxsdk::FbxNode& node) const {
        std::vector<Vector> angles;
        Vector last{};
        for (std::int64_t frame = mRange.first; frame <= mRange.last; ++frame) {
            last = anglesNear(aimedAt(frame), mCamera.getTransformRotationOrder(), last);
            angles.push_back(last);
        }
        node.LclRotation.Set(fbxsdk::FbxDouble3(angles[0][0], angles[0][1], angles[0][2]));
        constexpr const char* kComponents[] = {"X", "Y", "Z"};
        for (std::size_t i = 0; i < 3; ++i) {
            keys.writeKeys(
                node.LclRotation, kComponents[i], mRange,
                [&](std::int64_t frame) { return angles[static_cast<std::size_t>(frame - mRange.first)][i]; });
        }
    }

private:
    double valueAt(int channel, std::int64_t frame) const {
        return mKeys.valueAt(channelOf(mCamera, channel), frame, mRange);
    }
    FbxVector4 vectorAt(int first, std::int64_t frame) const {
        return {valueAt(first, frame), valueAt(first + 1, frame), valueAt(first + 2, frame)};
    }
    /// Without scale and skew.
    FbxAMatrix placeAt(std::int64_t frame) const {
        const auto at = [&](TnFbxTransform::EFbxTransformChannelType first) -> Vector {
            const faithful::Channels3 channels = faithful::channelsFrom(mCamera, first);
            return {mKeys.valueAt(*channels[0], frame, mRange), mKeys.valueAt(*channels[1], frame, mRange),
                    mKeys.valueAt(*channels[2], frame, mRange)};
        };
        FbxAMatrix place = rotationOf(at(TnFbxTransform::kFbxTransformRotationX), mCamera.getTransformRotationOrder());
        const Vector position = at(TnFbxTransform::kFbxTransformPositionX);
        place.SetT(FbxVector4(position[0], position[1], position[2]));
        return place;
    }

    const KeyWriter& mKeys;
    TnFbxCamera& mCamera;
    FrameRange mRange;
};

constexpr const char* kAimed = "look-at point, but no rotation: written with the rotation that aims it at the point";

/// The point, the up vector and the roll; a target where they determine the rotation.
void writeLookAt(WrittenScene& scene, TnFbxCamera& source, fbxsdk::FbxNode& node, FbxCamera& camera) {
    KeyWriter& keys = scene.keys();
    keys.write(camera.InterestPosition, channelsFrom(source, TnFbxCamera::kFbxCameraLookAtPositionX));
    keys.write(camera.UpVector, channelsFrom(source, TnFbxCamera::kFbxCameraUpPositionX));
    keys.write(camera.Roll, channelOf(source, TnFbxCamera::kFbxCameraRoll));

    const LookAt lookAt(keys, source);
    const bool turns = scene.info().getComputeCameraRotation() && lookAt.wantsAim();
    if (!turns && !lookAt.isRolledAim()) // the rotation determines the direction
        return;
    fbxsdk::FbxNode& target = scene.addNode(source.getName() + " target");
    scene.add<fbxsdk::FbxNull>(target);
    keys.write(target.LclTranslation, channelsFrom(source, TnFbxCamera::kFbxCameraLookAtPositionX));
    node.SetTarget(&target);
    if (turns) {
        lookAt.turnToward(keys, node);
        scene.warnings().add(source.getName(), kAimed);
    }
}

} // namespace

void addObject(WrittenScene& scene, TnFbxCamera& source) {
    KeyWriter& keys = scene.keys();
    fbxsdk::FbxNode& node = addPlacedNode(scene, source, kCameraAxes);
    FbxCamera& camera = scene.add<FbxCamera>(node);
    camera.ProjectionType.Set(source.getProjectionType() == TnFbxCamera::kFbxCameraOrthographic
                                  ? FbxCamera::eOrthogonal
                                  : FbxCamera::ePerspective);
    writeLens(keys, source, camera);
    keys.write(camera.NearPlane, channelOf(source, TnFbxCamera::kFbxCameraNearPlane));
    keys.write(camera.FarPlane, channelOf(source, TnFbxCamera::kFbxCameraFarPlane));
    keys.write(camera.FilmOffsetX, channelOf(source, TnFbxCamera::kFbxCameraFilmOffsetX));
    keys.write(camera.FilmOffsetY, channelOf(source, TnFbxCamera::kFbxCameraFilmOffsetY));
    writeLookAt(scene, source, node, camera);
    detail::check(source, scene.warnings());
}

} // namespace Tarnell::Fbx::faithful
