// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Managers and the lifetime of objects.
#include <fbxsdk/FbxManager.h>

#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FbxManager::FbxManager() : mData(std::make_unique<detail::ManagerData>()) {}
FbxManager::~FbxManager() = default;

FbxManager* FbxManager::Create() { return new FbxManager; }

void FbxManager::Destroy() {
    mData->destroyAll();
    delete this;
}

FbxIOSettings* FbxManager::GetIOSettings() const { return mData->settings; }

void FbxManager::SetIOSettings(FbxIOSettings* pIOSettings) { mData->settings = pIOSettings; }

const char* FbxManager::GetVersion(bool) { return "Tarnell FBX platform 0.1.0"; }

namespace detail {

FbxObject* ManagerData::createObject(FbxManager* manager, const FbxClassId& id, const char* name) {
    if (!manager || !id.info() || !id.info()->construct)
        return nullptr;
    FbxObject* object = id.info()->construct(*manager, *id.info());
    if (name)
        object->mData->name = name;
    return object;
}

FbxObject* ManagerData::createObject(FbxObject* container, const FbxClassId& id, const char* name) {
    if (!container)
        return nullptr;
    FbxObject* object = createObject(container->GetFbxManager(), id, name);
    if (object)
        container->ConnectSrcObject(object);
    return object;
}

void ManagerData::enter(FbxObject& object) {
    object.mData->managerSlot = objects.size();
    objects.push_back(&object);
}

void ManagerData::leave(FbxObject& object) {
    if (tearingDown)
        return;
    if (static_cast<const void*>(settings) == &object)
        settings = nullptr;
    const std::size_t slot = object.mData->managerSlot;
    objects[slot] = objects.back();
    objects[slot]->mData->managerSlot = slot;
    objects.pop_back();
}

void ManagerData::destroyTogether(std::span<FbxObject* const> objects) {
    for (FbxObject* object : objects)
        object->mData->doomed = true;
    for (FbxObject* object : objects)
        object->mData->disconnectFromSurvivors();
    for (auto object = objects.rbegin(); object != objects.rend(); ++object)
        delete *object;
}

void ManagerData::destroyAll() {
    tearingDown = true;
    // In reverse order of creation: containers go last.
    while (!objects.empty()) {
        FbxObject* object = objects.back();
        objects.pop_back();
        delete object;
    }
}

} // namespace detail
FBXSDK_NAMESPACE_END
