// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A camera as text, a line per frame: what was read from a file, or what is about to be written, in the same form.
#pragma once

#include <cstdio>

#include "TnFbxCamera.h"

inline void printFrame(const Tarnell::Fbx::TnFbxCamera& camera, int frame) {
    using namespace Tarnell::Fbx;
    const auto at = [&](TnFbxTransform::EFbxTransformChannelType channel) {
        return static_cast<double>(camera.getTransformValueAt(channel, static_cast<float>(frame)));
    };
    std::printf("%5d  position %9.3f %9.3f %9.3f  rotation %8.3f %8.3f %8.3f  focal length %7.3f\n", frame,
                at(TnFbxTransform::kFbxTransformPositionX), at(TnFbxTransform::kFbxTransformPositionY),
                at(TnFbxTransform::kFbxTransformPositionZ), at(TnFbxTransform::kFbxTransformRotationX),
                at(TnFbxTransform::kFbxTransformRotationY), at(TnFbxTransform::kFbxTransformRotationZ),
                static_cast<double>(camera.getValueAt(TnFbxCamera::kFbxCameraFocalLength, static_cast<float>(frame))));
}

/// Every frame of the camera's movement.
inline void printCamera(const Tarnell::Fbx::TnFbxCamera& camera) {
    const Tarnell::Fbx::TnFbxTime time = camera.getTransformTime(Tarnell::Fbx::TnFbxTransform::kFbxTransformPositionX);
    for (int frame = time.getStartFrame(); frame <= time.getEndFrame(); ++frame)
        printFrame(camera, frame);
}
