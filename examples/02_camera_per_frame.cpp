// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Prints one line per frame of a named camera: position, rotation, focal length. The input that a renderer or a
// matchmove tool needs for its own camera.
#include <cstdio>
#include <memory>

#include "CameraLines.h"
#include "Fbx.h"
#include "TnFbxCamera.h"
#include "TnFbxError.h"
#include "TnFbxReadInfo.h"

using namespace Tarnell::Fbx;

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
    printCamera(cameras[0]);
    return 0;
}
