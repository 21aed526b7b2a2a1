// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Builds a new shot and writes it: a camera that moves and zooms, a spot light, two nulls and a waving sheet
// whose points go into a point cache next to the file. What a tracking or layout program passes to the next one.
#include <algorithm>
#include <cmath>
#include <cstdio>
#include <functional>
#include <string>
#include <vector>

#include "CameraLines.h"
#include "Fbx.h"
#include "TnFbxCamera.h"
#include "TnFbxError.h"
#include "TnFbxLight.h"
#include "TnFbxMesh.h"
#include "TnFbxNull.h"
#include "TnFbxWriteInfo.h"

using namespace Tarnell::Fbx;

namespace {

constexpr int kFirst = 1001, kLast = 1048;
constexpr float kFramesPerSecond = 24.0F;

/// A value for each frame; `part` goes from 0 to 1 over the shot.
std::vector<float> overTheShot(const std::function<float(float part)>& value) {
    std::vector<float> values;
    for (int frame = kFirst; frame <= kLast; ++frame)
        values.push_back(value(static_cast<float>(frame - kFirst) / static_cast<float>(kLast - kFirst)));
    return values;
}

TnFbxTime shot() {
    TnFbxTime time;
    time.setTime(static_cast<float>(kFirst), kFirst, kLast, kFramesPerSecond);
    return time;
}

TnFbxCamera makeCamera() {
    TnFbxCamera camera;
    camera.setName("shotCam");
    camera.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderXYZ);
    camera.setTransformValue(TnFbxTransform::kFbxTransformPositionY, 160.0F); // centimetres: eye height
    camera.setTransformValueAt(TnFbxTransform::kFbxTransformPositionX, shot(),
                               overTheShot([](float part) { return -100.0F + 200.0F * part; }));
    camera.setTransformValueAt(TnFbxTransform::kFbxTransformPositionZ, shot(),
                               overTheShot([](float part) { return 600.0F - 150.0F * part; }));
    camera.setTransformValueAt(TnFbxTransform::kFbxTransformRotationY, shot(),
                               overTheShot([](float part) { return -10.0F + 20.0F * part; }));
    camera.setApertureMode(TnFbxCamera::kFbxApertureFocalLength);
    camera.setValue(TnFbxCamera::kFbxCameraFocalLength, 35.0F); // millimetres
    camera.setValueAt(TnFbxCamera::kFbxCameraFocalLength, shot(),
                      overTheShot([](float part) { return 35.0F + 15.0F * part; }));
    camera.setValue(TnFbxCamera::kFbxCameraApertureWidth, 0.980F); // inches: Super 35
    camera.setValue(TnFbxCamera::kFbxCameraApertureHeight, 0.551F);
    return camera;
}

TnFbxLight makeSpot() {
    TnFbxLight light;
    light.setName("key");
    light.setLightType(TnFbxLight::kFbxLightSpot);
    light.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderXYZ);
    light.setTransformValue(TnFbxTransform::kFbxTransformPositionY, 400.0F);
    light.setTransformValue(TnFbxTransform::kFbxTransformPositionZ, 300.0F);
    light.setTransformValue(TnFbxTransform::kFbxTransformRotationX, -50.0F); // down and away, as a camera would look
    light.setValue(TnFbxLight::kFbxLightBlue, 0.8F);
    light.setValueAt(TnFbxLight::kFbxLightIntensity, shot(),
                     overTheShot([](float part) { return 1.0F + 0.5F * part; }));
    light.setValue(TnFbxLight::kFbxLightConeAngle, 35.0F);
    return light;
}

TnFbxNull makeNull(const char* name, float x) {
    TnFbxNull null;
    null.setName(name);
    null.setNullSize(20.0F);
    null.setTransformValue(TnFbxTransform::kFbxTransformPositionX, x);
    return null;
}

/// A sheet of squares; its points have one set per frame, the first of them made by allocateGeometryData.
TnFbxMesh makeSheet() {
    constexpr int kSide = 12;
    constexpr float kStep = 20.0F;
    TnFbxMesh mesh;
    mesh.setName("sheet");
    mesh.allocateGeometryData(kSide * kSide, (kSide + 1) * (kSide + 1), 4 * kSide * kSide);
    for (int set = 0; set <= kLast - kFirst; ++set) {
        if (set > 0)
            mesh.addControlPointSet();
        for (int row = 0, point = 0; row <= kSide; ++row) {
            for (int column = 0; column <= kSide; ++column, ++point) {
                const float x = kStep * static_cast<float>(column - kSide / 2);
                const float z = kStep * static_cast<float>(row - kSide / 2);
                const float y = 10.0F * std::sin(0.05F * x + 0.25F * static_cast<float>(set));
                if (set == 0)
                    mesh.setControlPoint(point, x, y, z);
                else
                    mesh.addControlPoint(x, y, z);
            }
        }
    }
    for (int polygon = 0; polygon < kSide * kSide; ++polygon) {
        const int corner = polygon / kSide * (kSide + 1) + polygon % kSide;
        const int corners[] = {corner, corner + kSide + 1, corner + kSide + 2, corner + 1};
        mesh.setPolygonVertexSize(polygon, 4);
        for (int i = 0; i < 4; ++i)
            mesh.setPointIndex(4 * polygon + i, corners[i]);
    }
    return mesh;
}

} // namespace

int main(int argc, char** argv) {
    if (argc < 2) {
        std::fprintf(stderr, "usage: %s FILE.fbx [--ascii] [--values]\n", argv[0]);
        return 2;
    }
    const std::vector<std::string> options(argv + 2, argv + argc);
    const auto isGiven = [&](const char* option) {
        return std::find(options.begin(), options.end(), option) != options.end();
    };
    TnFbxCamera camera = makeCamera();
    TnFbxLight light = makeSpot();
    TnFbxNull left = makeNull("left", -120.0F), right = makeNull("right", 120.0F);
    TnFbxMesh sheet = makeSheet();

    TnFbxWriteInfo info;
    info.setFileName(argv[1]);
    info.setAnimationStackName("Take 001");
    info.setFidelity(kFbxFidelityFaithful);
    info.setFileFormat(isGiven("--ascii"));
    info.setFPS(kFramesPerSecond);
    info.setStartFrame(static_cast<float>(kFirst)); // of the shot, and of its point cache
    info.setEndFrame(static_cast<float>(kLast));
    if (!Tarnell::Fbx::Fbx().writeFile(info, {&camera}, {&light}, {}, {&left, &right}, {&sheet})) {
        std::fprintf(stderr, "%s\n", lastError().c_str());
        return 1;
    }
    if (isGiven("--values"))
        printCamera(camera); // the written values, for comparison with what is read
    else
        std::printf("wrote %s\n", argv[1]);
    return 0;
}
