// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Prints one line per frame of a named camera: position, rotation, focal length. What a renderer or a matchmove tool
// would feed its own camera with.
#include <cstdio>
#include <memory>

#include "Fbx.h"
#include "TnFbxCamera.h"
#include "TnFbxError.h"
#include "TnFbxReadInfo.h"

using namespace Tarnell::Fbx;

namespace {

void printFrame(const TnFbxCamera& camera, int frame) {
    const auto at = [&](TnFbxTransform::EFbxTransformChannelType channel) {
        return static_cast<double>(camera.getTransformValueAt(channel, static_cast<float>(frame)));
    };
    std::printf("%5d  position %9.3f %9.3f %9.3f  rotation %8.3f %8.3f %8.3f  focal length %7.3f\n", frame,
                at(TnFbxTransform::kFbxTransformPositionX), at(TnFbxTransform::kFbxTransformPositionY),
                at(TnFbxTransform::kFbxTransformPositionZ), at(TnFbxTransform::kFbxTransformRotationX),
                at(TnFbxTransform::kFbxTransformRotationY), at(TnFbxTransform::kFbxTransformRotationZ),
                static_cast<double>(camera.getValueAt(TnFbxCamera::kFbxCameraFocalLength, static_cast<float>(frame))));
}

} // namespace

int main(int argc, char** argv) {
    if (argc != 3) {
        std::fprintf(stderr, "usage: %s FILE.fbx CAMERA\n", argv[0]);
        return 2;
    }
    TnFbxReadInfo info;
    info.setFileName(argv[1]);
    info.setAnimationStackName("Take 001");
    info.setAllObjects(false);
    info.setObjectName(argv[2]);

    TnFbxCamera* cameras = nullptr;
    int count = 0;
    const bool read = Tarnell::Fbx::Fbx().getCameras(info, &cameras, count);
    const std::unique_ptr<TnFbxCamera[]> owner(cameras);
    if (!read || count == 0) {
        std::fprintf(stderr, "%s\n", read ? "no camera of that name" : lastError().c_str());
        return 1;
    }
    const TnFbxTime time = cameras[0].getTransformTime(TnFbxTransform::kFbxTransformPositionX);
    for (int frame = time.getStartFrame(); frame <= time.getEndFrame(); ++frame)
        printFrame(cameras[0], frame);
    return 0;
}
