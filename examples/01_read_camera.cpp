// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The smallest host: the cameras of a file and their focal lengths. The README shows this program.
#include <cstdio>
#include <memory>

#include "Fbx.h"

int main(int, char** argv) {
    using namespace Tarnell::Fbx;
    TnFbxReadInfo info;
    info.setFileName(argv[1]);
    info.setFidelity(kFbxFidelityFaithful); // what the application shows, of the first stack

    TnFbxCamera* cameras = nullptr;
    int count = 0;
    if (!Tarnell::Fbx::Fbx().getCameras(info, &cameras, count)) {
        std::fprintf(stderr, "%s\n", lastError().c_str());
        return 1;
    }
    const std::unique_ptr<TnFbxCamera[]> owner(cameras);
    for (int i = 0; i < count; ++i) {
        std::printf("%s: focal length %g mm\n", cameras[i].getName().c_str(),
                    static_cast<double>(cameras[i].getValue(TnFbxCamera::kFbxCameraFocalLength)));
    }
}
