// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reads one file as a host does, through the facade, and prints the result and the time.
#include "Measurement.h"

#include <Fbx.h>
#include <TnFbxCamera.h>
#include <TnFbxError.h>
#include <TnFbxMesh.h>
#include <TnFbxReadInfo.h>
#include <TnFbxTransform.h>

#include <cstdlib>
#include <cstring>
#include <memory>
#include <string>

namespace {

using namespace Tarnell::Fbx;

TnFbxReadInfo infoFor(const char* fileName) {
    TnFbxReadInfo info;
    info.setFileName(fileName);
    info.setAnimationStackName("any"); // only must not be empty
    return info;
}

/// Polygon vertices and the bounding box of the points, in the mesh's own space.
bool readMeshes(const char* fileName, bench::Answer& answer, bench::Cost& cost) {
    TnFbxReadInfo info = infoFor(fileName);
    info.setTransformPoints(false);
    TnFbxMesh* meshes = nullptr;
    int count = 0;
    bool success = false;
    cost = bench::measure([&] { success = Fbx().getMeshes(info, &meshes, count); });
    const std::unique_ptr<TnFbxMesh[]> owner(meshes);
    for (int i = 0; i < count; ++i) {
        answer.count += meshes[i].getNumberOfPolygonVertices();
        for (int point = 0; point < meshes[i].getNumberOfControlPoints(); ++point) {
            float x = 0, y = 0, z = 0;
            meshes[i].getControlPoint(point, x, y, z);
            answer.include(static_cast<double>(x), static_cast<double>(y), static_cast<double>(z));
        }
    }
    return success;
}

/// The file's own cameras (the library adds seven viewing cameras) and the bounding box of their positions.
bool readCameras(const char* fileName, bench::Answer& answer, bench::Cost& cost) {
    constexpr int kProducerCameras = 7;
    TnFbxReadInfo info = infoFor(fileName);
    TnFbxCamera* cameras = nullptr;
    int count = 0;
    bool success = false;
    cost = bench::measure([&] { success = Fbx().getCameras(info, &cameras, count); });
    const std::unique_ptr<TnFbxCamera[]> owner(cameras);
    for (int i = kProducerCameras; i < count; ++i) {
        ++answer.count;
        const auto position = [&](TnFbxTransform::EFbxTransformChannelType channel) {
            return static_cast<double>(cameras[i].getTransformValue(channel));
        };
        answer.include(position(TnFbxTransform::kFbxTransformPositionX),
                       position(TnFbxTransform::kFbxTransformPositionY),
                       position(TnFbxTransform::kFbxTransformPositionZ));
    }
    return success;
}

/// The nodes, and the bounding box of their positions at the frames with keys.
bool readTransforms(const char* fileName, bool global, bench::Answer& answer, bench::Cost& cost) {
    constexpr int kFramesPerKey = 5;
    TnFbxReadInfo info = infoFor(fileName);
    info.setGlobalTransform(global);
    TnFbxTransform* transforms = nullptr;
    int count = 0;
    bool success = false;
    cost = bench::measure([&] { success = Fbx().getTransforms(info, &transforms, count); });
    const std::unique_ptr<TnFbxTransform[]> owner(transforms);
    answer.count = count;
    for (int i = 0; i < count; ++i) {
        const TnFbxTime time = transforms[i].getTransformTime(TnFbxTransform::kFbxTransformPositionX);
        for (int frame = time.getStartFrame(); frame <= time.getEndFrame(); frame += kFramesPerKey) {
            const auto at = [&](TnFbxTransform::EFbxTransformChannelType channel) {
                return static_cast<double>(transforms[i].getTransformValueAt(channel, static_cast<float>(frame)));
            };
            answer.include(at(TnFbxTransform::kFbxTransformPositionX), at(TnFbxTransform::kFbxTransformPositionY),
                           at(TnFbxTransform::kFbxTransformPositionZ));
        }
    }
    return success;
}

bool readMode(const std::string& mode, const char* fileName, bench::Answer& answer, bench::Cost& cost) {
    if (mode == "mesh")
        return readMeshes(fileName, answer, cost);
    if (mode == "cameras")
        return readCameras(fileName, answer, cost);
    if (mode == "local")
        return readTransforms(fileName, /*global*/ false, answer, cost);
    return readTransforms(fileName, /*global*/ true, answer, cost);
}

} // namespace

int main(int argc, char** argv) {
    if (argc < 3 || argc > 4) {
        std::fputs("usage: bench_read_tarnell mesh|cameras|local|global FILE [REPETITIONS]\n", stderr);
        return 2;
    }
    const int repetitions = argc == 4 ? std::atoi(argv[3]) : 1;
    bench::Answer answer;
    bench::Cost best;
    for (int i = 0; i < repetitions; ++i) {
        answer = {};
        bench::Cost cost;
        if (!readMode(argv[1], argv[2], answer, cost)) {
            std::fprintf(stderr, "bench_read_tarnell: %s\n", lastError().c_str());
            return 1;
        }
        best = bench::cheaper(best, cost);
    }
    bench::print(answer, best);
    return 0;
}
