// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From value objects to a scene: the global settings that every written file has, and one node below the root per
// object.
#include "FbxSdk.h"

#include "calls/LastError.h"
#include "model/FrameArithmetic.h"

#include <cmath>

namespace Tarnell::Fbx {

using detail::fail;
using detail::succeed;

namespace {

using Time = fbxsdk::FbxTime;

struct TimeModeRow {
    float framesPerSecond;
    Time::EMode mode;
};

/// The first row that is near enough counts.
constexpr TimeModeRow kTimeModes[] = {
    {23.976f, Time::eFilmFullFrame},
    {24.0f, Time::eFrames24},
    {25.0f, Time::ePAL},
    {29.9700262f, Time::eNTSCDropFrame}, // kept: 29.97 is too far away and custom
    {30.0f, Time::eFrames30},
    {48.0f, Time::eFrames48},
    {50.0f, Time::eFrames50},
    {60.0f, Time::eFrames60},
    {100.0f, Time::eFrames100},
    {120.0f, Time::eFrames120},
    {1000.0f, Time::eFrames1000},
};
constexpr float kTimeModeTolerance = 1e-5f;

Time::EMode timeModeOf(float framesPerSecond) {
    for (const TimeModeRow& row : kTimeModes) {
        if (std::abs(framesPerSecond - row.framesPerSecond) < kTimeModeTolerance) {
            return row.mode;
        }
    }
    return Time::eCustom;
}

/// The range to write, at the rate to write it at.
TnFbxTime timeOf(const TnFbxWriteInfo& info) {
    TnFbxTime time;
    time.setTime(info.getStartFrame(), detail::truncateToInt(info.getStartFrame()),
                 detail::truncateToInt(info.getEndFrame()), info.getFPS());
    return time;
}

/// Adds to the root what `makeNode` makes of each object that is one. Its null leaves the object out.
template <class Object, class MakeNode>
void addNodes(fbxsdk::FbxNode& root, const std::vector<Object*>& objects, MakeNode makeNode) {
    for (Object* object : objects) {
        fbxsdk::FbxNode* node = object != nullptr ? makeNode(*object) : nullptr;
        if (node != nullptr) {
            root.AddChild(node);
        }
    }
}

} // namespace

bool FbxSdk::createScene(const TnFbxWriteInfo& info, const std::vector<TnFbxCamera*>& cameras,
                         const std::vector<TnFbxLight*>& lights, const std::vector<TnFbxTransform*>& transforms,
                         const std::vector<TnFbxNull*>& nulls, const std::vector<TnFbxMesh*>& meshes) {
    const detail::CallScope call;
    if (!mInitialized || mManager == nullptr || mScene == nullptr) {
        return fail("the FBX manager is not initialised");
    }
    initCreateAnimationStack();
    // kept: the stack just made is "Take 001"; another name selects nothing and changes nothing
    createScene(mManager, mScene, info.getFPS(), info.getAnimationStackName());
    fbxsdk::FbxNode* root = mScene->GetRootNode();
    if (root == nullptr) {
        return fail("the scene has no root node");
    }

    // kept: cameras and lights are made in the scene, everything else by the manager
    if (info.getWriteCameras()) {
        addNodes(*root, cameras, [this](TnFbxCamera& camera) {
            fbxsdk::FbxNode* node = createCamera(mScene, camera.getName());
            setCameraCurveValues(node, &camera);
            return node;
        });
    }
    if (info.getWriteLights()) {
        addNodes(*root, lights, [this](TnFbxLight& light) {
            fbxsdk::FbxNode* node = createLight(mScene, light.getLightType(), light.getName());
            setLightCurveValues(node, &light);
            return node;
        });
    }
    if (info.getWriteTransforms()) {
        addNodes(*root, transforms, [this](TnFbxTransform& transform) {
            fbxsdk::FbxNode* node = createNull(mManager, transform.getName());
            setTransformCurveValues(node, &transform);
            return node;
        });
    }
    if (info.getWriteNulls()) {
        addNodes(*root, nulls, [this](TnFbxNull& null) {
            fbxsdk::FbxNode* node = createNull(mManager, null.getName());
            setNullCurveValues(node, &null);
            return node;
        });
    }
    if (info.getWriteMeshes()) { // kept: of a mesh only the points are written, not its transform
        addNodes(*root, meshes, [this, &info](const TnFbxMesh& mesh) {
            fbxsdk::FbxNode* node = createMesh(mManager, &mesh, mesh.getName());
            const bool maya = info.getMayaVertexCacheFormat();
            if (node != nullptr && info.getAnimateMeshVertices() &&
                mapVertexCacheOnMesh(mManager, node, maya, info.getFileName())) {
                const bool newest = info.getCompatibilityVersion() == TnFbxWriteInfo::kFbxVersion2016;
                animateVertexCacheOnMesh(node, &mesh, maya, newest, timeOf(info));
            }
            return node;
        });
    }
    return succeed(); // kept: also when a curve or a point cache could not be written
}

bool FbxSdk::createScene(fbxsdk::FbxManager* manager, fbxsdk::FbxScene* scene, float framesPerSecond,
                         const std::string& animationStackName) {
    if (manager == nullptr || scene == nullptr) {
        return fail("no FBX manager or no scene to set up");
    }
    setGlobalLightSettings(scene);
    setGlobalCameraSettings(scene);
    setGlobalTimeSettings(scene, framesPerSecond);
    setCurrentAnimationStack(animationStackName);
    return succeed();
}

// kept: an orange ambient light and a magenta fog in every file
bool FbxSdk::setGlobalLightSettings(fbxsdk::FbxScene* scene) {
    if (scene == nullptr) {
        return fail("no scene for the global light settings");
    }
    fbxsdk::FbxGlobalLightSettings& settings = scene->GlobalLightSettings();
    settings.SetAmbientColor(fbxsdk::FbxColor(1.0, 0.5, 0.2, 1.0));
    settings.SetFogEnable(true);
    settings.SetFogMode(fbxsdk::FbxGlobalLightSettings::eLinear);
    settings.SetFogDensity(0.002);
    settings.SetFogStart(0.0);
    settings.SetFogEnd(1000.0);
    settings.SetFogColor(fbxsdk::FbxColor(1.0, 0.0, 1.0, 1.0));
    return succeed();
}

bool FbxSdk::setGlobalCameraSettings(fbxsdk::FbxScene* scene) {
    if (scene == nullptr) {
        return fail("no scene for the global camera settings");
    }
    fbxsdk::FbxGlobalCameraSettings& settings = scene->GlobalCameraSettings();
    settings.SetDefaultCamera("Camera Switcher", /*pStatus*/ nullptr);
    settings.CreateProducerCameras();
    return succeed();
}

// kept: a custom mode gets no rate
bool FbxSdk::setGlobalTimeSettings(fbxsdk::FbxScene* scene, float framesPerSecond) {
    if (scene == nullptr) {
        return fail("no scene for the global time settings");
    }
    scene->GetGlobalSettings().SetTimeMode(timeModeOf(framesPerSecond));
    return succeed();
}

} // namespace Tarnell::Fbx
