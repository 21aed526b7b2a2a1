// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Cameras of scenes that tests build, and what the adapter reads of them.
#pragma once

#include "support/SceneBuilders.h"

#include <gtest/gtest.h>

#include <vector>

namespace Tarnell::Fbx::test {

using Camera = TnFbxCamera;
using Samples = std::vector<float>;
using Transform = TnFbxTransform;

struct ReadOptions {
    bool global = false;
    bool useInterestPosition = false;
    bool useSampleRate = false;
    float sampleRate = 0.0f;
};

inline bool readInto(TestScene& scene, fbxsdk::FbxNode* node, TnFbxCamera& camera, ReadOptions options = {}) {
    TnFbxTime time = scene.time();
    fbxsdk::FbxAMatrix geometric;
    return scene.sdk.getCamera(time, options.global, options.useSampleRate, options.sampleRate,
                               options.useInterestPosition, node, camera, geometric);
}

inline TnFbxCamera readCamera(TestScene& scene, fbxsdk::FbxNode* node, ReadOptions options = {}) {
    TnFbxCamera camera;
    EXPECT_TRUE(readInto(scene, node, camera, options));
    return camera;
}

inline fbxsdk::FbxNode* addCamera(TestScene& scene,
                                  fbxsdk::FbxCamera::EApertureMode mode = fbxsdk::FbxCamera::eFocalLength) {
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxCamera>("shot");
    node->GetCamera()->SetApertureMode(mode);
    return node;
}

inline std::vector<float> rotationAt(const TnFbxCamera& camera, float frame) {
    float x = 0.0f, y = 0.0f, z = 0.0f;
    camera.calculateCameraRotationAt(x, y, z, frame);
    return {x, y, z};
}

inline std::vector<float> rotationOf(const TnFbxCamera& camera) {
    return {camera.getTransformValue(TnFbxTransform::kFbxTransformRotationX),
            camera.getTransformValue(TnFbxTransform::kFbxTransformRotationY),
            camera.getTransformValue(TnFbxTransform::kFbxTransformRotationZ)};
}

inline TnFbxTime timeRecord(int startFrame, int endFrame, float rate) {
    TnFbxTime time;
    time.setTime(0.0f, startFrame, endFrame, rate);
    return time;
}

/// A camera whose modes are neither those of a new one nor any that is read.
inline TnFbxCamera cameraInOtherModes() {
    TnFbxCamera camera;
    camera.setApertureMode(TnFbxCamera::kFbxApertureVertical);
    camera.setProjectionType(TnFbxCamera::kFbxCameraOrthographic);
    camera.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderXYZ);
    return camera;
}

} // namespace Tarnell::Fbx::test
