// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of value objects to a scene: the global settings that every written file has, and one node below the root
// per object.
#include "FbxSdk.h"

#include "access/TimeModeScope.h"
#include "access/WriteChecks.h"
#include "access/WrittenSpan.h"
#include "calls/LastError.h"
#include "calls/MemoryLimit.h"
#include "model/FrameArithmetic.h"

#include "TnFbxError.h"

#include <algorithm>
#include <cmath>
#include <set>

namespace Tarnell::Fbx {

using detail::fail;
using detail::succeed;

namespace {

using Time = fbxsdk::FbxTime;

struct TimeModeRow {
    float framesPerSecond;
    Time::EMode mode;
};

/// The first row that is close enough is used.
constexpr TimeModeRow kTimeModes[] = {
    {23.976f, Time::eFilmFullFrame},
    {24.0f, Time::eFrames24},
    {25.0f, Time::ePAL},
    {29.9700262f, Time::eNTSCDropFrame}, // kept: 29.97 is too far off and custom
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
    for (const TimeModeRow& row : kTimeModes)
        if (std::abs(framesPerSecond - row.framesPerSecond) < kTimeModeTolerance)
            return row.mode;
    return Time::eCustom;
}

/// The range to write; one that is not set, and an invalid one, do not define the span.
bool saysSpan(const TnFbxWriteInfo& info) {
    const float first = info.getStartFrame(), last = info.getEndFrame(), rate = info.getFPS();
    const bool isDefault = first == TnFbxWriteInfo::kDefaultStartFrame && last == TnFbxWriteInfo::kDefaultEndFrame;
    return !isDefault && first <= last && rate > 0.0f && std::isfinite(rate);
}

/// The range to write, at the rate to write it at.
TnFbxTime timeOf(const TnFbxWriteInfo& info) {
    TnFbxTime time;
    time.setTime(info.getStartFrame(), detail::truncateToInt(info.getStartFrame()),
                 detail::truncateToInt(info.getEndFrame()), info.getFPS());
    return time;
}

/// The keys of one scene, checked against `memoryLimit()`.
class KeyScope {
public:
    explicit KeyScope(detail::MemoryAccount& memory) : mMemory(memory) { mMemory.begin(); }
    ~KeyScope() { mMemory.end(); }
    KeyScope(const KeyScope&) = delete;
    KeyScope& operator=(const KeyScope&) = delete;

private:
    detail::MemoryAccount& mMemory;
};

/// Adds nodes to the root, and collects the warnings about all of them.
class SceneBuilder {
public:
    SceneBuilder(fbxsdk::FbxNode& root, fbxsdk::FbxAnimStack* stack) : mRoot(root), mStack(stack) {}

    /// Adds the result of `makeNode` for each valid object. Null omits the object.
    template <class Object, class MakeNode>
    void addNodes(const std::vector<Object*>& objects, MakeNode makeNode) {
        for (Object* object : objects) {
            fbxsdk::FbxNode* node = object != nullptr ? makeNode(*object) : nullptr;
            if (node != nullptr) {
                mRoot.AddChild(node);
                detail::enforceRotationOrder(*node);
                mSpan.addKeys(*node, mStack);
                detail::check(*object, warnings);
            } else if (object != nullptr) {
                warnings.add(object->getName(), "left out: " + lastError());
            }
        }
    }

    /// kept: meshes of one name write the same file.
    void noteCacheOf(const std::string& mesh) {
        if (!mCached.insert(mesh).second)
            warnings.add(mesh, "meshes with the same name share one point cache, that of the last of them");
    }

    /// States the span of time, and reports the warnings.
    void finish(const TnFbxWriteInfo& info, fbxsdk::FbxScene& scene) {
        if (saysSpan(info)) {
            const TnFbxTime range = timeOf(info);
            const auto rate = static_cast<double>(range.getFrameRate());
            mSpan.add(static_cast<double>(range.getStartFrame()) / rate);
            mSpan.add(static_cast<double>(range.getEndFrame()) / rate);
        }
        mSpan.store(scene, mStack);
        detail::warnAboutRate(info.getFPS(), timeModeOf(info.getFPS()) == Time::eCustom);
        warnings.report();
    }

    detail::ObjectWarnings warnings;

private:
    fbxsdk::FbxNode& mRoot;
    fbxsdk::FbxAnimStack* mStack;
    detail::WrittenSpan mSpan;
    std::set<std::string> mCached; // names of meshes
};

} // namespace

bool FbxSdk::createScene(const TnFbxWriteInfo& info, const std::vector<TnFbxCamera*>& cameras,
                         const std::vector<TnFbxLight*>& lights, const std::vector<TnFbxTransform*>& transforms,
                         const std::vector<TnFbxNull*>& nulls, const std::vector<TnFbxMesh*>& meshes) {
    const detail::CallScope call;
    if (!mInitialized || mManager == nullptr || mScene == nullptr)
        return fail("the FBX manager is not initialised");
    initCreateAnimationStack();
    // kept: the new stack is "Take 001"; another name selects nothing and changes nothing
    createScene(mManager, mScene, info.getFPS(), info.getAnimationStackName());
    fbxsdk::FbxNode* root = mScene->GetRootNode();
    if (root == nullptr)
        return fail("the scene has no root node");

    const KeyScope keys(*mMemory);
    SceneBuilder builder(*root, mCurrentAnimStack);
    // kept: cameras and lights are created in the scene, everything else by the manager
    if (info.getWriteCameras()) {
        builder.addNodes(
            cameras,
            [this](TnFbxCamera& camera) {
                fbxsdk::FbxNode* node = createCamera(mScene, camera.getName());
                setCameraCurveValues(node, &camera);
                return node;
            });
    }
    if (info.getWriteLights()) {
        builder.addNodes(
            lights,
            [this](TnFbxLight& light) {
                fbxsdk::FbxNode* node = createLight(mScene, light.getLightType(), light.getName());
                setLightCurveValues(node, &light);
                return node;
            });
    }
    if (info.getWriteTransforms()) {
        builder.addNodes(
            transforms,
            [this](TnFbxTransform& transform) {
                fbxsdk::FbxNode* node = createNull(mManager, transform.getName());
                setTransformCurveValues(node, &transform);
                return node;
            });
    }
    if (info.getWriteNulls()) {
        builder.addNodes(
            nulls,
            [this](TnFbxNull& null) {
                fbxsdk::FbxNode* node = createNull(mManager, null.getName());
                setNullCurveValues(node, &null);
                return node;
            });
    }
    if (info.getWriteMeshes()) { // kept: of a mesh only the points are written, not its transform
        builder.addNodes(
            meshes,
            [&](const TnFbxMesh& mesh) {
                fbxsdk::FbxNode* node = createMesh(mManager, &mesh, mesh.getName());
                if (node != nullptr && info.getAnimateMeshVertices()) {
                    builder.noteCacheOf(mesh.getName());
                    addPointCache(*node, mesh, info, timeOf(info), builder.warnings);
                }
                return node;
            });
    }
    builder.finish(info, *mScene);
    if (mMemory->exceeded())
        return fail(info.getFileName() + ": " + mMemory->describe("keys"));
    return succeed(); // kept: also when a curve or a point cache could not be written
}

bool FbxSdk::createScene(fbxsdk::FbxManager* manager, fbxsdk::FbxScene* scene, float framesPerSecond,
                         const std::string& animationStackName) {
    if (manager == nullptr || scene == nullptr)
        return fail("no FBX manager or no scene to set up");
    setGlobalLightSettings(scene);
    setGlobalCameraSettings(scene);
    setGlobalTimeSettings(scene, framesPerSecond);
    setCurrentAnimationStack(animationStackName);
    return succeed();
}

// kept: an orange ambient light and a magenta fog in every file
bool FbxSdk::setGlobalLightSettings(fbxsdk::FbxScene* scene) {
    if (scene == nullptr)
        return fail("no scene for the global light settings");
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
    if (scene == nullptr)
        return fail("no scene for the global camera settings");
    fbxsdk::FbxGlobalCameraSettings& settings = scene->GlobalCameraSettings();
    settings.SetDefaultCamera("Camera Switcher", /*pStatus*/ nullptr);
    settings.CreateProducerCameras();
    return succeed();
}

// kept: a custom mode gets no rate
bool FbxSdk::setGlobalTimeSettings(fbxsdk::FbxScene* scene, float framesPerSecond) {
    if (scene == nullptr)
        return fail("no scene for the global time settings");
    const detail::TimeModeScope timeMode; // the scene's settings would set theirs
    scene->GetGlobalSettings().SetTimeMode(timeModeOf(framesPerSecond));
    return succeed();
}

} // namespace Tarnell::Fbx
