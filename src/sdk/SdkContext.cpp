// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The context: its manager and scene, the loading of a file with the normalisation that every read relies on, and the
// animation stack with the range of frames to read.
#include "FbxSdk.h"

#include "GlobalSampler.h"
#include "PropertySampling.h"
#include "SampleAccount.h"
#include "SampleRange.h"
#include "access/FileWarnings.h"
#include "access/FrameTimes.h"
#include "access/NodeWalk.h"
#include "access/Normalisation.h"
#include "access/ObjectWarnings.h"
#include "access/TimeModeScope.h"
#include "calls/LastError.h"
#include "calls/MemoryLimit.h"
#include "model/FrameArithmetic.h"
#include "model/MeshInstances.h"

namespace Tarnell::Fbx {

using detail::fail;
using detail::failAbout;
using detail::succeed;

const std::string FbxSdk::kMayaVertexCacheFileExtension = ".xml";
const std::string FbxSdk::kMaxVertexCacheFileExtension = ".pc2";
const std::string FbxSdk::kDefaultAnimationStackName = "Take 001";

namespace {

constexpr char kDefaultLayerName[] = "Default Layer";

/// What an import is meant to read.
constexpr const char* kImportSettings[] = {
    "Import|AdvOptGrp|FileFormat|Fbx|Material",        //
    "Import|AdvOptGrp|FileFormat|Fbx|Texture",         //
    "Import|AdvOptGrp|FileFormat|Fbx|Link",            //
    "Import|AdvOptGrp|FileFormat|Fbx|Shape",           //
    "Import|AdvOptGrp|FileFormat|Fbx|Gobo",            //
    "Import|AdvOptGrp|FileFormat|Fbx|Animation",       //
    "Import|AdvOptGrp|FileFormat|Fbx|Global_Settings", //
};

/// kept: the settings go to neither the importer nor the manager, so a read always runs with the platform's own
/// defaults.
void createImportSettings(fbxsdk::FbxManager* manager) {
    fbxsdk::FbxIOSettings* settings = fbxsdk::FbxIOSettings::Create(manager, "IOSRoot");
    for (const char* path : kImportSettings)
        settings->SetBoolProp(path, true);
}

fbxsdk::FbxCriteria isStack() { return fbxsdk::FbxCriteria::ObjectType(fbxsdk::FbxAnimStack::ClassId); }

fbxsdk::FbxAnimStack* stackAt(fbxsdk::FbxScene& scene, int index) {
    return fbxsdk::FbxCast<fbxsdk::FbxAnimStack>(scene.GetSrcObject(isStack(), index));
}

/// The platform evaluates the same stack. The stack that is set is recorded in the scene's file, so it is set
/// only when it changes.
void evaluateStack(fbxsdk::FbxScene& scene, fbxsdk::FbxAnimStack* stack) {
    if (scene.GetCurrentAnimationStack() != stack)
        scene.SetCurrentAnimationStack(stack);
}

} // namespace

FbxSdk::FbxSdk()
    : mMemory(std::make_unique<detail::MemoryAccount>()), mSamples(std::make_unique<detail::SampleAccount>(*mMemory)),
      mWarnings(std::make_unique<detail::ObjectWarnings>()), mInstances(std::make_unique<detail::MeshInstances>()),
      mFrameTimes(std::make_unique<detail::FrameTimes>()) {}

FbxSdk::~FbxSdk() {
    mInitialized = false;
    destroySdkObjects(&mManager);
    mScene = nullptr;
}

// kept: nothing of the other context is copied
FbxSdk& FbxSdk::operator=(const FbxSdk& other) {
    if (this != &other)
        initFbxSdkManager();
    return *this;
}

bool FbxSdk::initFbxSdkManager() {
    if (!mInitialized) {
        destroySdkObjects(&mManager); // of an attempt that failed half-way
        if (!initializeSdkObjects(&mManager, &mScene))
            return false;
        mInitialized = true;
    }
    return succeed();
}

bool FbxSdk::destroyFbxSdkManager() {
    if (!mInitialized)
        return fail("there is no FBX manager to destroy");
    destroySdkObjects(&mManager);
    mScene = nullptr; // both were destroyed with the manager
    mFileName.clear();
    mCurrentAnimStack = nullptr;
    mInitialized = false;
    return true; // the reason of the failure that led here stays
}

bool FbxSdk::initializeSdkObjects(fbxsdk::FbxManager** manager, fbxsdk::FbxScene** scene) {
    if (manager == nullptr || scene == nullptr)
        return fail("the pointer to the FBX manager or its scene is null");
    *manager = fbxsdk::FbxManager::Create();
    if (*manager == nullptr)
        return fail("the FBX manager cannot be created");
    *scene = fbxsdk::FbxScene::Create(*manager, "");
    return succeed();
}

bool FbxSdk::destroySdkObjects(fbxsdk::FbxManager** manager) {
    if (manager != nullptr && *manager != nullptr) {
        (*manager)->Destroy();
        *manager = nullptr;
    }
    return true;
}

fbxsdk::FbxScene* FbxSdk::getScene() const { return mScene; }

bool FbxSdk::loadScene(fbxsdk::FbxManager* manager, fbxsdk::FbxScene* scene, const std::string& fileName) {
    if (manager == nullptr || scene == nullptr)
        return fail(fileName + ": no scene to load it into");
    const detail::TimeModeScope timeMode; // an import leaves the file's
    fbxsdk::FbxImporter* importer = fbxsdk::FbxImporter::Create(manager, "");
    if (!importer->Initialize(fileName.c_str(), /*pFileFormat: detect*/ -1, /*pIOSettings*/ nullptr)) {
        // the manager releases the importer
        return failAbout(fileName, importer->GetStatus().GetErrorString(), "cannot be read");
    }
    if (importer->IsFBX()) {
        const int takeCount = importer->GetAnimStackCount();
        for (int i = 0; i < takeCount; ++i)
            static_cast<void>(importer->GetTakeInfo(i));
        createImportSettings(manager);
    }
    const bool imported = importer->Import(scene, /*pNonBlocking*/ false);
    const bool result =
        imported ? succeed() : failAbout(fileName, importer->GetStatus().GetErrorString(), "cannot be read");
    detail::warnOfRepairs(fileName, importer->GetFileHeaderInfo());
    importer->Destroy(/*pRecursive*/ false);
    return result;
}

bool FbxSdk::loadScene(const std::string& fileName, bool convertGeometry) {
    const detail::CallScope call;
    if (!mInitialized)
        return fail(fileName + ": the FBX manager is not initialised");
    if (!loadScene(mManager, mScene, fileName))
        return false;
    const bool converted = detail::failOnFault(fileName, [&] {
        detail::convertToCentimetres(*mScene);
        detail::convertToYUp(*mScene);
        return !convertGeometry || convertNurbsAndPatchRecursive(mManager, mScene->GetRootNode());
    });
    if (!converted)
        return false;
    initCreateAnimationStack();
    mFileName = fileName;
    return succeed();
}

bool FbxSdk::convertNurbsAndPatch(fbxsdk::FbxManager* manager, fbxsdk::FbxScene* scene) {
    return convertNurbsAndPatchRecursive(manager, scene != nullptr ? scene->GetRootNode() : nullptr);
}

bool FbxSdk::convertNurbsAndPatchRecursive(fbxsdk::FbxManager* manager, fbxsdk::FbxNode* node) {
    detail::Triangulation triangulation(manager);
    int left = 0;
    const bool result = detail::walkNodes(node, [&](fbxsdk::FbxNode& visited) {
        left += triangulation.visit(visited) ? 0 : 1;
        return true;
    });
    triangulation.warnOfCoarser();
    if (left > 0) {
        detail::warn(std::to_string(left) + (left == 1 ? " surface" : " surfaces") +
                     " cannot be converted to a mesh: invalid surface data, or too many samples");
    }
    return result;
}

// kept: the first stack is read, whatever the options' stack name
void FbxSdk::initCreateAnimationStack() {
    if (mScene == nullptr)
        return;
    mCurrentAnimStack = mScene->GetSrcObjectCount(isStack()) > 0
                            ? stackAt(*mScene, 0)
                            : fbxsdk::FbxAnimStack::Create(mScene, kDefaultAnimationStackName.c_str());
    evaluateStack(*mScene, mCurrentAnimStack);
    const auto isLayer = fbxsdk::FbxCriteria::ObjectType(fbxsdk::FbxAnimLayer::ClassId);
    if (mCurrentAnimStack != nullptr && mCurrentAnimStack->GetSrcObjectCount(isLayer) == 0)
        mCurrentAnimStack->AddMember(fbxsdk::FbxAnimLayer::Create(mScene, kDefaultLayerName));
}

bool FbxSdk::setCurrentAnimationStack(const std::string& name) {
    const int count = mScene != nullptr ? mScene->GetSrcObjectCount(isStack()) : 0;
    for (int i = 0; i < count; ++i) {
        fbxsdk::FbxAnimStack* stack = stackAt(*mScene, i);
        if (stack != nullptr && name == stack->GetName()) {
            mCurrentAnimStack = stack;
            evaluateStack(*mScene, stack);
            return succeed();
        }
    }
    return fail("the scene has no animation stack \"" + name + "\"");
}

bool FbxSdk::getAnimationStackNames(std::vector<std::string>& names) {
    names.clear();
    if (mScene == nullptr)
        return fail("no scene is loaded");
    const int count = mScene->GetSrcObjectCount(isStack());
    for (int i = 0; i < count; ++i)
        if (const fbxsdk::FbxAnimStack* stack = stackAt(*mScene, i))
            names.emplace_back(stack->GetName());
    return succeed();
}

bool FbxSdk::getGlobalAnimationStackTime(TnFbxTime& time, float frame, bool useSampleFPS, float sampleFPS) {
    time.initTime();
    if (!mInitialized || mScene == nullptr || mCurrentAnimStack == nullptr)
        return fail("no scene is loaded");
    const detail::TimeModeScope timeMode(mScene);
    const fbxsdk::FbxTimeSpan span = mCurrentAnimStack->GetLocalTimeSpan();
    const fbxsdk::FbxTime::EMode mode = mScene->GetGlobalSettings().GetTimeMode();
    float rate = static_cast<float>(fbxsdk::FbxTime::GetFrameRate(mode));
    int first = detail::narrowFrame(span.GetStart().GetFrameCount(mode));
    int last = detail::narrowFrame(span.GetStop().GetFrameCount(mode));
    if (sampleFPS > 0.0f && useSampleFPS) {
        first = detail::convertFrame(first, rate, sampleFPS);
        last = detail::convertFrame(last, rate, sampleFPS);
        rate = sampleFPS;
    }
    time.setTime(frame, first, last, rate);
    return succeed();
}

} // namespace Tarnell::Fbx
