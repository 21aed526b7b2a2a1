// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Cameras: placement, aim, lens and film of a node's camera attribute, sampled, and of a producer camera, static only.
#include "FbxSdk.h"

#include "GlobalSampler.h"
#include "PropertySampling.h"
#include "ReadScope.h"
#include "calls/LastError.h"

#include <algorithm>
#include <array>

namespace Tarnell::Fbx {

using detail::channelAfter;
using detail::fail;
using detail::PropertySampler;
using detail::succeed;
using detail::toFloat;

namespace {

using Camera = fbxsdk::FbxCamera;
using Scalar = fbxsdk::FbxPropertyT<fbxsdk::FbxDouble>;
using Vector = fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3>;

/// The static values of a vector into three consecutive channels.
void setVector(TnFbxCamera& camera, TnFbxCamera::EFbxCameraChannelType firstChannel, const Vector& property) {
    const fbxsdk::FbxDouble3 value = property.Get();
    for (int i = 0; i < 3; ++i)
        camera.setValue(channelAfter(firstChannel, i), toFloat(value[i]));
}

void setRotation(TnFbxCamera& camera, float x, float y, float z) {
    camera.setTransformValue(TnFbxTransform::kFbxTransformRotationX, x);
    camera.setTransformValue(TnFbxTransform::kFbxTransformRotationY, y);
    camera.setTransformValue(TnFbxTransform::kFbxTransformRotationZ, z);
}

/// The rotation at frame 0, as static values.
void setStaticLookAtRotation(TnFbxCamera& camera) {
    float x = 0.0f, y = 0.0f, z = 0.0f;
    camera.calculateCameraRotationAt(x, y, z, 0.0f);
    setRotation(camera, x, y, z);
}

TnFbxTransform::EFbxTransformRotationOrder rotationOrderOf(FbxSdk& sdk, const fbxsdk::FbxNode& node) {
    fbxsdk::FbxEuler::EOrder order = fbxsdk::FbxEuler::eOrderXYZ;
    node.GetRotationOrder(fbxsdk::FbxNode::eSourcePivot, order);
    return sdk.getRotationOrderConstant(order);
}

void setApertures(TnFbxCamera& camera, const Camera& source) {
    camera.setValue(TnFbxCamera::kFbxCameraApertureWidth, toFloat(source.GetApertureWidth()));
    camera.setValue(TnFbxCamera::kFbxCameraApertureHeight, toFloat(source.GetApertureHeight()));
}

void setPlanes(TnFbxCamera& camera, const Camera& source) {
    camera.setValue(TnFbxCamera::kFbxCameraNearPlane, toFloat(source.GetNearPlane()));
    camera.setValue(TnFbxCamera::kFbxCameraFarPlane, toFloat(source.GetFarPlane()));
}

void setProjection(TnFbxCamera& camera, const Camera& source) {
    switch (detail::enumNumber(source.ProjectionType)) {
    case Camera::ePerspective:
        camera.setProjectionType(TnFbxCamera::kFbxCameraPerspective);
        break;
    case Camera::eOrthogonal:
        camera.setProjectionType(TnFbxCamera::kFbxCameraOrthographic);
        break;
    default: // the camera keeps what it had
        break;
    }
}

/// kept: an angle that drives the lens becomes a sampled focal length; its static value is not converted
void readFieldOfViewAsFocalLength(PropertySampler& properties, const Camera& source, TnFbxCamera& camera) {
    if (!properties.sample(source.FieldOfView, nullptr))
        return;
    properties.samples().transform(
        [&source](float angle) { return toFloat(source.ComputeFocalLength(static_cast<double>(angle))); });
    properties.samples().moveInto(*camera.getCameraChannel(TnFbxCamera::kFbxCameraFocalLength), properties.time());
}

void readLens(PropertySampler& properties, const Camera& source, TnFbxCamera& camera) {
    switch (static_cast<int>(source.GetApertureMode())) {
    case Camera::eHorizontal:
    case Camera::eVertical:
        camera.setApertureMode(TnFbxCamera::kFbxApertureFocalLength);
        readFieldOfViewAsFocalLength(properties, source, camera);
        break;
    case Camera::eHorizAndVert: // kept: no static values
        camera.setApertureMode(TnFbxCamera::kFbxApertureHorizontalAndVertical);
        properties.sampleInto(camera, TnFbxCamera::kFbxCameraFieldOfViewX, source.FieldOfViewX);
        properties.sampleInto(camera, TnFbxCamera::kFbxCameraFieldOfViewY, source.FieldOfViewY);
        break;
    case Camera::eFocalLength:
        camera.setApertureMode(TnFbxCamera::kFbxApertureFocalLength);
        properties.readInto(camera, TnFbxCamera::kFbxCameraFocalLength, source.FocalLength);
        break;
    default: // a number that is no mode does not define the lens
        break;
    }
}

void readFilmOffset(PropertySampler& properties, const Camera& source, TnFbxCamera& camera) {
    properties.readInto(camera, TnFbxCamera::kFbxCameraFilmOffsetX, source.FilmOffsetX);
    properties.readInto(camera, TnFbxCamera::kFbxCameraFilmOffsetY, source.FilmOffsetY);
    if (source.FindProperty("FilmOffset", /*pCaseSensitive*/ true).IsValid()) {
        const float x = toFloat(source.FilmOffsetX.Get());
        camera.setValue(TnFbxCamera::kFbxCameraFilmOffsetX, x);
        camera.setValue(TnFbxCamera::kFbxCameraFilmOffsetY, x); // kept: Y is overwritten with X
    }
}

/// The frames over which the inputs of a camera's rotation are animated.
struct LookAtRange {
    static constexpr int kNoStart = 10000000;
    static constexpr int kNoEnd = -10000000;

    bool found = false;
    float rate = 0.0f;
    int start = kNoStart;
    int end = kNoEnd;
    bool isConstant = true; // no input is animated

    void include(FbxSdk& sdk, const TnFbxChannel& channel) {
        if (channel.getAnimated()) {
            sdk.getCameraFrameRange(channel.getTime(), found, rate, start, end);
            isConstant = isConstant && channel.isConstant();
        }
    }

    bool isAnimated() const { return end >= start && end != kNoEnd && start != kNoStart; }
};

LookAtRange lookAtRange(FbxSdk& sdk, TnFbxCamera& camera) {
    LookAtRange range;
    for (int i = 0; i < 3; ++i)
        range.include(sdk, *camera.getTransformChannel(channelAfter(TnFbxTransform::kFbxTransformPositionX, i)));
    for (int i = TnFbxCamera::kFbxCameraLookAtPositionX; i <= TnFbxCamera::kFbxCameraRoll; ++i)
        range.include(sdk, *camera.getCameraChannel(static_cast<TnFbxCamera::EFbxCameraChannelType>(i)));
    return range;
}

} // namespace

bool FbxSdk::getCamera(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, bool useInterestPosition,
                       fbxsdk::FbxNode* node, TnFbxCamera& camera, fbxsdk::FbxAMatrix& geometric) {
    auto* source = fbxsdk::FbxCast<Camera>(node != nullptr ? node->GetNodeAttribute() : nullptr);
    if (source == nullptr)
        return fail("no node with a camera to read");
    const detail::ReadScope scope(*this);
    PropertySampler properties = sampler(time, useSampleFPS, sampleFPS);
    camera.setName(node->GetName());
    properties.readIntoTransform(camera, TnFbxTransform::kFbxTransformPositionX, node->LclTranslation);

    bool looksAt = getTargetLookAt(time, global, *node, camera, geometric, properties);
    if (!looksAt && useInterestPosition) {
        setVector(camera, TnFbxCamera::kFbxCameraLookAtPositionX, source->InterestPosition);
        looksAt = true;
    }
    properties.readInto(camera, TnFbxCamera::kFbxCameraRoll, source->Roll);
    setVector(camera, TnFbxCamera::kFbxCameraUpPositionX, source->UpVector);

    if (looksAt)
        setLookAtRotation(camera);
    else
        properties.readIntoTransform(camera, TnFbxTransform::kFbxTransformRotationX, node->LclRotation);
    properties.readIntoTransform(camera, TnFbxTransform::kFbxTransformScaleX, node->LclScaling);
    camera.setTransformRotationOrder(looksAt ? TnFbxTransform::kFbxRotationOrderZXY : rotationOrderOf(*this, *node));
    camera.setTransformTransformOrder(TnFbxTransform::kFbxTransformOrderDefault);

    setApertures(camera, *source);
    readLens(properties, *source, camera);
    setPlanes(camera, *source);
    setProjection(camera, *source);
    readFilmOffset(properties, *source, camera);
    return scope.finish(succeed());
}

/// The look-at channels of a camera that has a target; returns whether it has one.
bool FbxSdk::getTargetLookAt(TnFbxTime& time, bool global, fbxsdk::FbxNode& node, TnFbxCamera& camera,
                             fbxsdk::FbxAMatrix& geometric, PropertySampler& properties) {
    fbxsdk::FbxNode* target = node.GetTarget();
    if (target == nullptr)
        return false;
    if (!global) { // kept: the camera's own translation curves, not the target's, and no static values
        properties.sampleVectorInto(camera, TnFbxCamera::kFbxCameraLookAtPositionX, node.LclTranslation);
        return true;
    }
    if (time.getStartFrame() > time.getEndFrame())
        return true;
    detail::GlobalSampler globals(*this, time);
    globals.add(*target, geometric);
    globals.sample(*mSamples);
    detail::GlobalRuns& position = *globals.take(*target, geometric);
    for (int i = 0; i < 3; ++i) {
        const auto channel = channelAfter(TnFbxCamera::kFbxCameraLookAtPositionX, i);
        detail::SampleRun& run = position[static_cast<std::size_t>(i)];
        camera.setValue(channel, run.first());
        run.moveInto(*camera.getCameraChannel(channel), time);
    }
    return true;
}

/// The rotation toward the look-at point, for every frame at which one of its inputs is animated.
void FbxSdk::setLookAtRotation(TnFbxCamera& camera) {
    const LookAtRange range = lookAtRange(*this, camera);
    const detail::SampleRange frames = {range.start, range.end};
    if (!range.isAnimated() || !(range.isConstant || mSamples->take(frames, range.rate, /*channelCount*/ 3))) {
        setStaticLookAtRotation(camera);
        return;
    }

    const std::int64_t count = detail::frameCount(range.start, range.end);
    std::array<detail::SampleRun, 3> angles;
    for (detail::SampleRun& angle : angles)
        angle.begin(static_cast<std::size_t>(count));
    for (std::int64_t i = 0; i < (range.isConstant ? 1 : count); ++i) {
        std::array<float, 3> at{};
        camera.calculateCameraRotationAt(at[0], at[1], at[2], static_cast<float>(range.start + i));
        for (std::size_t axis = 0; axis < angles.size(); ++axis)
            angles[axis].add(at[axis]);
    }
    TnFbxTime time;
    time.setTime(0.0f, range.start, range.end, range.rate);
    for (int axis = 0; axis < 3; ++axis) {
        detail::SampleRun& angle = angles[static_cast<std::size_t>(axis)];
        if (range.isConstant)
            angle.setConstant(angle.first());
        TnFbxChannel* channel = camera.getTransformChannel(channelAfter(TnFbxTransform::kFbxTransformRotationX, axis));
        angle.moveInto(*channel, time);
    }
}

void FbxSdk::getCameraFrameRange(TnFbxTime time, bool& found, float& frameRate, int& startFrame, int& endFrame) {
    startFrame = std::min(startFrame, time.getStartFrame());
    endFrame = std::max(endFrame, time.getEndFrame());
    frameRate = time.getFrameRate();
    found = true;
}

bool FbxSdk::getProducerCamera(fbxsdk::FbxNode* node, fbxsdk::FbxCamera* camera, TnFbxCamera& out, const char* name) {
    if (camera == nullptr)
        return fail("no producer camera to read");
    out.setName(name != nullptr ? name : "");
    const fbxsdk::FbxDouble3 position = camera->Position.Get();
    for (int i = 0; i < 3; ++i)
        out.setTransformValue(channelAfter(TnFbxTransform::kFbxTransformPositionX, i), toFloat(position[i]));
    setVector(out, TnFbxCamera::kFbxCameraUpPositionX, camera->UpVector);
    setVector(out, TnFbxCamera::kFbxCameraLookAtPositionX, camera->InterestPosition);
    out.setValue(TnFbxCamera::kFbxCameraRoll, toFloat(camera->Roll.Get()));

    setStaticLookAtRotation(out);
    for (int i = 0; i < 3; ++i)
        out.setTransformValue(channelAfter(TnFbxTransform::kFbxTransformScaleX, i), 1.0f);
    out.setTransformRotationOrder(node != nullptr ? rotationOrderOf(*this, *node)
                                                  : TnFbxTransform::kFbxRotationOrderZXY);
    out.setTransformTransformOrder(TnFbxTransform::kFbxTransformOrderDefault);

    setApertures(out, *camera);
    out.setValue(TnFbxCamera::kFbxCameraFocalLength, toFloat(camera->FocalLength.Get()));
    setPlanes(out, *camera);
    setProjection(out, *camera);
    return succeed();
}

} // namespace Tarnell::Fbx
