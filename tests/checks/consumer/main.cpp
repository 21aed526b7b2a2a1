// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reads the cameras of a file through the installed library.
#include <cstdio>
#include <memory>

#include <Fbx.h>

int main(int argc, char** argv) {
    using namespace Tarnell::Fbx;
    if (argc != 2)
        return 2;
    TnFbxReadInfo info;
    info.setFileName(argv[1]);
    info.setAnimationStackName("Take 001");
    TnFbxCamera* cameras = nullptr;
    int count = 0;
    if (!Tarnell::Fbx::Fbx().getCameras(info, &cameras, count)) {
        std::fprintf(stderr, "%s\n", lastError().c_str());
        return 1;
    }
    const std::unique_ptr<TnFbxCamera[]> owner(cameras);
    for (int i = 0; i < count; ++i)
        std::printf("%s\n", cameras[i].getName().c_str());
    return 0;
}
