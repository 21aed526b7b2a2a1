// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "WrittenScene.h"

#include "Rates.h"
#include "access/PointCacheName.h"
#include "access/TimeModeScope.h"
#include "access/WriteChecks.h"
#include "calls/LastError.h"

#include <algorithm>
#include <cmath>

namespace Tarnell::Fbx::faithful {

namespace {

constexpr const char* kStackWithoutName = "Take 001";
constexpr const char* kNumbered =
    "objects with the same name are numbered: files of this version identify objects by name";

std::string inLowerCase(std::string text) {
    std::transform(text.begin(), text.end(), text.begin(),
                   [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; });
    return text;
}

} // namespace

WrittenScene::~WrittenScene() {
    if (mManager != nullptr)
        mManager->Destroy();
}

bool WrittenScene::begin(const TnFbxWriteInfo& info) {
    mInfo = &info;
    mManager = fbxsdk::FbxManager::Create();
    if (mManager == nullptr)
        return detail::fail("the FBX manager cannot be created");
    mScene = fbxsdk::FbxScene::Create(mManager, "");
    const std::string& name = info.getAnimationStackName();
    mStack = fbxsdk::FbxAnimStack::Create(mScene, name.empty() ? kStackWithoutName : name.c_str());
    auto* layer = fbxsdk::FbxAnimLayer::Create(mScene, "BaseLayer");
    mStack->AddMember(layer);
    mScene->SetCurrentAnimationStack(mStack);

    const RateRow rate = exactRate(info.getFPS());
    fbxsdk::FbxGlobalSettings& settings = mScene->GetGlobalSettings();
    const detail::TimeModeScope timeMode; // the settings would set theirs
    if (isRate(rate.rate)) {
        mRate = rate.rate;
        settings.SetTimeMode(rate.mode);
        settings.SetCustomFrameRate(rate.mode == fbxsdk::FbxTime::eCustom ? rate.rate : -1.0);
    } else {
        detail::warnAboutRate(info.getFPS(), /*isCustom*/ false);
        settings.SetTimeMode(fbxsdk::FbxTime::eFrames24);
    }
    mKeys = std::make_unique<KeyWriter>(*layer, mRate);
    return true;
}

void WrittenScene::finish() {
    const float first = mInfo->getStartFrame(), last = mInfo->getEndFrame();
    const bool isDefault = first == TnFbxWriteInfo::kDefaultStartFrame && last == TnFbxWriteInfo::kDefaultEndFrame;
    if (!isDefault && first <= last && std::isfinite(first) && std::isfinite(last)) {
        mKeys->span().add(static_cast<double>(first) / mRate);
        mKeys->span().add(static_cast<double>(last) / mRate);
    }
    mKeys->span().store(*mScene, mStack);
    mWarnings.report();
}

fbxsdk::FbxNode& WrittenScene::addNode(const std::string& name, fbxsdk::FbxNode* parent) {
    fbxsdk::FbxNode* node = fbxsdk::FbxNode::Create(mScene, name.c_str());
    if (!mNodeNames.insert(name).second && mInfo->getCompatibilityVersion() == TnFbxWriteInfo::kFbxVersion2010)
        mWarnings.add(name, kNumbered);
    (parent != nullptr ? parent : mScene->GetRootNode())->AddChild(node);
    return *node;
}

std::string WrittenScene::cacheNameFor(const std::string& mesh) {
    std::string name = mesh;
    int& number = mNextNumbers.try_emplace(mesh, 2).first->second;
    while (!mCacheNames.insert(inLowerCase(detail::pointCacheName(name))).second)
        name = mesh + ' ' + std::to_string(number++);
    return name;
}

} // namespace Tarnell::Fbx::faithful
