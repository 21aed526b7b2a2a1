// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of a camera to a node's camera attribute: film, planes and lens, static and keyed.
#include "CurveWriting.h"

#include "calls/LastError.h"

namespace Tarnell::Fbx {

using detail::ChannelWriter;
using detail::fail;
using detail::succeed;

namespace {

using Camera = fbxsdk::FbxCamera;

void writeFilmSize(ChannelWriter& writer, TnFbxCamera& source, Camera& camera) {
    if (TnFbxChannel* width = source.getCameraChannel(TnFbxCamera::kFbxCameraApertureWidth)) {
        camera.SetApertureWidth(static_cast<double>(width->getValue()));
        writer.key(camera.FilmWidth, nullptr, width);
    }
    if (TnFbxChannel* height = source.getCameraChannel(TnFbxCamera::kFbxCameraApertureHeight)) {
        camera.SetApertureHeight(static_cast<double>(height->getValue()));
        writer.key(camera.FilmHeight, nullptr, height);
    }
}

/// Only what drives the lens in this aperture mode.
void writeLens(ChannelWriter& writer, TnFbxCamera& source, Camera& camera) {
    switch (source.getApertureMode()) {
    case TnFbxCamera::kFbxApertureHorizontalAndVertical:
        camera.ApertureMode.Set(Camera::eHorizAndVert);
        writer.write(camera.FieldOfViewX, source.getCameraChannel(TnFbxCamera::kFbxCameraFieldOfViewX));
        writer.write(camera.FieldOfViewY, source.getCameraChannel(TnFbxCamera::kFbxCameraFieldOfViewY));
        break;
    case TnFbxCamera::kFbxApertureHorizontal:
        camera.SetApertureMode(Camera::eHorizontal);
        writer.write(camera.FieldOfView, source.getCameraChannel(TnFbxCamera::kFbxCameraFieldOfView));
        break;
    case TnFbxCamera::kFbxApertureVertical:
        camera.SetApertureMode(Camera::eVertical);
        writer.write(camera.FieldOfView, source.getCameraChannel(TnFbxCamera::kFbxCameraFieldOfView));
        break;
    case TnFbxCamera::kFbxApertureFocalLength:
        camera.SetApertureMode(Camera::eFocalLength);
        writer.write(camera.FocalLength, source.getCameraChannel(TnFbxCamera::kFbxCameraFocalLength));
        break;
    default: // a number that is no mode does not define the lens
        break;
    }
}

void writeProjection(const TnFbxCamera& source, Camera& camera) {
    switch (source.getProjectionType()) {
    case TnFbxCamera::kFbxCameraPerspective:
        camera.ProjectionType.Set(Camera::ePerspective);
        break;
    case TnFbxCamera::kFbxCameraOrthographic:
        camera.ProjectionType.Set(Camera::eOrthogonal);
        break;
    default: // the camera keeps what it has
        break;
    }
}

/// Writes the channel and returns its static value; the default without a channel.
float writeOffset(ChannelWriter& writer, fbxsdk::FbxPropertyT<fbxsdk::FbxDouble>& property, TnFbxChannel* channel,
                  float otherwise) {
    writer.write(property, channel);
    return channel != nullptr ? channel->getValue() : otherwise;
}

void writeFilmOffset(ChannelWriter& writer, TnFbxCamera& source, Camera& camera) {
    const float x = writeOffset(writer, camera.FilmOffsetX, source.getCameraChannel(TnFbxCamera::kFbxCameraFilmOffsetX),
                                TnFbxCamera::kDefaultCameraFilmOffsetX);
    const float y = writeOffset(writer, camera.FilmOffsetY, source.getCameraChannel(TnFbxCamera::kFbxCameraFilmOffsetY),
                                TnFbxCamera::kDefaultCameraFilmOffsetY);
    // kept: the property is created and stays zero; the offsets are set a second time
    if (fbxsdk::FbxProperty::Create(&camera, fbxsdk::FbxDouble2DT, "FilmOffset", "", /*pCheckForDup*/ true).IsValid()) {
        camera.FilmOffsetX.Set(static_cast<double>(x));
        camera.FilmOffsetY.Set(static_cast<double>(y));
    }
}

} // namespace

// kept: look-at, up vector and roll are not written; the camera's rotation defines its direction
bool FbxSdk::setCameraCurveValues(fbxsdk::FbxNode* node, TnFbxCamera* camera) {
    Camera* target = node != nullptr ? node->GetCamera() : nullptr;
    if (target == nullptr || camera == nullptr)
        return fail("no node with a camera, or no camera to write");
    if (!setTransformCurveValues(node, camera))
        return false;
    ChannelWriter writer(currentLayer(), *mFrameTimes, *mMemory);
    writeFilmSize(writer, *camera, *target);
    writer.write(target->NearPlane, camera->getCameraChannel(TnFbxCamera::kFbxCameraNearPlane));
    writer.write(target->FarPlane, camera->getCameraChannel(TnFbxCamera::kFbxCameraFarPlane));
    writeLens(writer, *camera, *target);
    writeProjection(*camera, *target);
    writeFilmOffset(writer, *camera, *target);

    // a camera of the scene looks along X, one of the library along -Z
    node->SetPostRotation(fbxsdk::FbxNode::eSourcePivot, fbxsdk::FbxVector4(0.0, -90.0, 0.0, 1.0));
    node->SetRotationActive(true);
    return succeed();
}

} // namespace Tarnell::Fbx
