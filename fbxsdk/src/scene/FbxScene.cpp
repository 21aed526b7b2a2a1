// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Scenes: the root node, the settings, the list of nodes and the current stack.
#include <fbxsdk/FbxScene.h>

#include <algorithm>

#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxNode.h>

#include "object/ManagerData.h"
#include "scene/SceneData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxScene, FbxDocument, detail::kDocumentRows)

FbxScene::FbxScene(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxDocument(pManager, pInfo), mSceneData(std::make_unique<detail::SceneData>(*this)) {
    data().scene = this;
    data().membership = mSceneData.get();
    mSceneData->root = FbxNode::Create(this, "RootNode");
    mSceneData->settings = FbxGlobalSettings::Create(this, "GlobalSettings");
}

FbxScene::~FbxScene() = default;

FbxNode* FbxScene::GetRootNode() const { return mSceneData->root; }

FbxGlobalSettings& FbxScene::GetGlobalSettings() { return *mSceneData->settings; }
const FbxGlobalSettings& FbxScene::GetGlobalSettings() const { return *mSceneData->settings; }
FbxGlobalLightSettings& FbxScene::GlobalLightSettings() { return mSceneData->lights; }
FbxGlobalCameraSettings& FbxScene::GlobalCameraSettings() { return mSceneData->cameras; }
FbxGlobalTimeSettings& FbxScene::GlobalTimeSettings() { return mSceneData->times; }

int FbxScene::GetNodeCount() const { return static_cast<int>(mSceneData->nodes.size()); }

FbxNode* FbxScene::GetNode(int pIndex) const {
    const auto& nodes = mSceneData->nodes;
    return pIndex >= 0 && static_cast<std::size_t>(pIndex) < nodes.size() ? nodes[static_cast<std::size_t>(pIndex)]
                                                                          : nullptr;
}

void FbxScene::SetCurrentAnimationStack(FbxAnimStack* pAnimStack) {
    if (pAnimStack && pAnimStack->GetScene() != this)
        return;
    mSceneData->currentStack = pAnimStack;
    ++GetFbxManager()->data().revision;
    if (pAnimStack)
        ActiveAnimStackName.Set(FbxString(pAnimStack->GetName()));
}

FbxAnimStack* FbxScene::GetCurrentAnimationStack() const {
    if (mSceneData->currentStack)
        return mSceneData->currentStack;
    return mSceneData->stacks.empty() ? nullptr : mSceneData->stacks.front();
}

namespace detail {

namespace {

/// Adds the object to the list, or removes it, when it is a T.
template <class T>
void keepInList(std::vector<T*>& members, FbxObject& object, bool isMember) {
    T* member = FbxCast<T>(&object);
    if (!member)
        return;
    if (isMember) {
        members.push_back(member);
    } else {
        // Members mostly leave in reverse order: search from the end.
        const auto place = std::find(members.rbegin(), members.rend(), member);
        members.erase(std::next(place).base());
    }
}

} // namespace

void SceneData::enter(FbxObject& member) {
    keepInList(nodes, member, true);
    keepInList(stacks, member, true);
}

void SceneData::leave(FbxObject& member) {
    keepInList(nodes, member, false);
    keepInList(stacks, member, false);
    if (static_cast<FbxObject*>(currentStack) == &member)
        currentStack = nullptr;
    cameras.forget(member);
}

bool SceneData::isFixed(const FbxObject& member) const {
    return &member == static_cast<const FbxObject*>(root) || &member == static_cast<const FbxObject*>(settings);
}

std::string SceneData::fileName() const { return documents.empty() ? std::string() : documents.back()->tree->fileName; }

} // namespace detail
FBXSDK_NAMESPACE_END
