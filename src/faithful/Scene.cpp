// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Scene.h"

#include "Rates.h"
#include "access/FileWarnings.h"
#include "access/Normalisation.h"
#include "calls/LastError.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <utility>

namespace Tarnell::Fbx::faithful {

using detail::fail;
using detail::failAbout;

namespace {

/// From there on a float does not distinguish adjacent frames.
constexpr std::int64_t kMostFrames = std::int64_t{1} << 24;

/// The rate of a scene whose file says "custom" without one.
constexpr double kRateOfNoRate = 30.0;

template <class Object, class Owner>
std::vector<Object*> sourcesOf(Owner& owner) {
    std::vector<Object*> objects;
    const auto isOne = fbxsdk::FbxCriteria::ObjectType(Object::ClassId);
    const int count = owner.GetSrcObjectCount(isOne);
    for (int i = 0; i < count; ++i)
        if (auto* object = fbxsdk::FbxCast<Object>(owner.GetSrcObject(isOne, i)))
            objects.push_back(object);
    return objects;
}

double exactRate(const fbxsdk::FbxGlobalSettings& settings) {
    const fbxsdk::FbxTime::EMode mode = settings.GetTimeMode();
    for (const RateRow& row : kTelevisionRates)
        if (row.mode == mode)
            return row.rate;
    if (mode != fbxsdk::FbxTime::eCustom)
        return fbxsdk::FbxTime::GetFrameRate(mode);
    const double rate = settings.GetCustomFrameRate();
    return std::isfinite(rate) && rate > 0.0 ? rate : kRateOfNoRate;
}

bool import(fbxsdk::FbxManager& manager, fbxsdk::FbxScene& scene, const std::string& fileName) {
    fbxsdk::FbxImporter* importer = fbxsdk::FbxImporter::Create(&manager, "");
    const bool imported = importer->Initialize(fileName.c_str(), /*pFileFormat: detect*/ -1, /*pIOSettings*/ nullptr) &&
                          importer->Import(&scene, /*pNonBlocking*/ false);
    if (!imported)
        failAbout(fileName, importer->GetStatus().GetErrorString(), "cannot be read");
    detail::warnOfRepairs(fileName, importer->GetFileHeaderInfo());
    importer->Destroy(/*pRecursive*/ false);
    return imported;
}

std::string listed(const std::vector<fbxsdk::FbxAnimStack*>& stacks) {
    std::string text;
    for (const fbxsdk::FbxAnimStack* stack : stacks)
        text += (text.empty() ? "\"" : ", \"") + std::string(stack->GetName()) + '"';
    return text.empty() ? "none" : text;
}

} // namespace

Scene::~Scene() {
    if (mManager != nullptr)
        mManager->Destroy();
}

bool Scene::load(const TnFbxReadInfo& info) {
    mFileName = info.getFileName();
    mMemory.begin();
    mManager = fbxsdk::FbxManager::Create();
    if (mManager == nullptr)
        return fail("the FBX manager cannot be created");
    mScene = fbxsdk::FbxScene::Create(mManager, "");
    if (!import(*mManager, *mScene, mFileName))
        return false;
    const fbxsdk::FbxGlobalSettings& settings = mScene->GetGlobalSettings();
    const double unit = settings.GetSystemUnit().GetScaleFactor();
    detail::convertToCentimetres(*mScene);
    const double left = settings.GetSystemUnit().GetScaleFactor(); // a unit that is not a number
    mUnit = left < 1.0 || left > 1.0 || std::isnan(left) ? 1.0 : unit;
    detail::convertToYUp(*mScene);
    mLoaded = true;
    return select(info);
}

bool Scene::select(const TnFbxReadInfo& info) {
    fbxsdk::FbxAnimStack* const formerStack = mStack;
    const std::vector<fbxsdk::FbxAnimLayer*> formerLayers = mLayers;
    if (selectStack(info.getAimationStackName()) && selectFrames(info)) {
        mMoves.clear();
        return true;
    }
    mStack = formerStack;
    mLayers = formerLayers;
    if (mStack != nullptr)
        mScene->SetCurrentAnimationStack(mStack);
    return false;
}

bool Scene::selectStack(const std::string& name) {
    const std::vector<fbxsdk::FbxAnimStack*> stacks = sourcesOf<fbxsdk::FbxAnimStack>(*mScene);
    const auto found = std::find_if(stacks.begin(), stacks.end(), [&name](const fbxsdk::FbxAnimStack* stack) {
        return name.empty() || name == stack->GetName();
    });
    if (found != stacks.end()) {
        mStack = *found;
        mScene->SetCurrentAnimationStack(mStack);
        mLayers = sourcesOf<fbxsdk::FbxAnimLayer>(*mStack);
        return true;
    }
    return name.empty() ||
           fail(mFileName + ": there is no animation stack \"" + name + "\"; the file has " + listed(stacks));
}

bool Scene::selectFrames(const TnFbxReadInfo& info) {
    const fbxsdk::FbxGlobalSettings& settings = mScene->GetGlobalSettings();
    fbxsdk::FbxTime::SetGlobalTimeMode(settings.GetTimeMode(), settings.GetCustomFrameRate());
    mFileRate = exactRate(settings);
    const double rate = info.getUseSampleFPS() ? exactRate(info.getSampleFPS()).rate : mFileRate;
    if (!std::isfinite(rate) || !(rate > 0.0))
        return fail("a sample rate of " + std::to_string(rate) + " frames per second is not valid");
    const Timeline former = std::exchange(mTimeline, Timeline(rate, animatedSpan()));
    if (setFrame(info.getFrame()))
        return true;
    mTimeline = former;
    return false;
}

bool Scene::setFrame(float frame) {
    if (!std::isfinite(frame))
        return fail("the frame of the static values is not a finite number");
    mFrame = frame;
    mNow = mTimeline.at(static_cast<double>(frame));
    return true;
}

/// The stack's own span and that of its keys.
fbxsdk::FbxTimeSpan Scene::animatedSpan() {
    if (mStack == nullptr)
        return {};
    fbxsdk::FbxTimeSpan span = mStack->GetLocalTimeSpan();
    const bool stated = span.GetStart() < span.GetStop();
    fbxsdk::FbxTimeSpan keys(fbxsdk::FBXSDK_TIME_INFINITE, fbxsdk::FBXSDK_TIME_MINUS_INFINITE);
    bool keyed = false;
    for (int layer = 0; layer < static_cast<int>(mLayers.size()); ++layer)
        keyed = mScene->GetRootNode()->GetAnimationInterval(keys, mStack, layer) || keyed;
    if (!keyed)
        return stated ? span : fbxsdk::FbxTimeSpan();
    if (!stated)
        return keys;
    span.UnionAssignment(keys);
    return span;
}

bool Scene::isKeyed(fbxsdk::FbxProperty property) const {
    for (fbxsdk::FbxAnimLayer* layer : mLayers)
        if (property.IsAnimated(layer))
            return true;
    return false;
}

bool Scene::isKeyed(const fbxsdk::FbxObject& object) const {
    for (fbxsdk::FbxProperty property = object.GetFirstProperty(); property.IsValid();
         property = object.GetNextProperty(property))
        if (isKeyed(property))
            return true;
    return false;
}

bool Scene::moves(fbxsdk::FbxNode& node) {
    std::vector<const fbxsdk::FbxNode*> above;
    bool moving = false;
    for (fbxsdk::FbxNode* at = &node; at != nullptr && !moving; at = at->GetParent()) {
        const auto known = mMoves.find(at);
        if (known != mMoves.end()) {
            moving = known->second;
            break;
        }
        above.push_back(at);
        moving = isKeyed(at->LclTranslation) || isKeyed(at->LclRotation) || isKeyed(at->LclScaling);
    }
    // The visited nodes are at and below the animated one, or none of them is animated.
    for (const fbxsdk::FbxNode* each : above)
        mMoves[each] = moving;
    return moving;
}

bool Scene::grantSamples(std::int64_t channels) {
    const std::int64_t frames = mTimeline.count();
    if (frames > kMostFrames) {
        return fail(mFileName + ": the animation has " + std::to_string(frames) + " frames at " +
                    std::to_string(mTimeline.rate()) + " per second; channels hold at most " +
                    std::to_string(kMostFrames));
    }
    return grantBytes(static_cast<std::uint64_t>(frames * channels) * sizeof(float));
}

bool Scene::grantBytes(std::uint64_t bytes) {
    return mMemory.take(bytes) || fail(mFileName + ": " + mMemory.describe());
}

} // namespace Tarnell::Fbx::faithful
