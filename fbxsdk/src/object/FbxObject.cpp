// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Objects: identity, properties by name, connections and membership in a scene.
#include <fbxsdk/FbxObject.h>

#include <unordered_set>
#include <vector>

#include "object/ManagerData.h"
#include "object/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN

namespace detail {
extern const ClassInfo kFbxObjectInfo;
constinit const ClassInfo kFbxObjectInfo{"FbxObject", nullptr, {}, &ManagerData::construct<FbxObject>};
} // namespace detail
constinit const FbxClassId FbxObject::ClassId{&detail::kFbxObjectInfo};

FbxObject* FbxObject::Create(FbxManager* pManager, const char* pName) {
    return detail::ManagerData::create<FbxObject>(pManager, pName);
}
FbxObject* FbxObject::Create(FbxObject* pContainer, const char* pName) {
    return detail::ManagerData::create<FbxObject>(pContainer, pName);
}

FbxObject::FbxObject(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : RootProperty(this, detail::kRootProperty), mData(std::make_unique<detail::ObjectData>()) {
    mData->info = &pInfo;
    mData->manager = &pManager;
    mData->plug.object = this;
    pManager.data().enter(*this);
}

FbxObject::~FbxObject() { mData->manager->data().leave(*this); }

namespace {

/// The permanent members of a scene are freed with the scene only.
bool isKeptByScene(const FbxObject& object) {
    return object.GetScene() && !detail::isScene(object) && object.data().membership->isFixed(object);
}

} // namespace

void FbxObject::Destroy(bool pRecursive) {
    if (!pRecursive && !detail::isScene(*this)) {
        // Frees no other object and allocates no memory: callers can rely on it for cleaning up.
        FbxObject* const alone = this;
        if (!isKeptByScene(*this))
            detail::ManagerData::destroyTogether({&alone, 1});
        return;
    }
    std::vector<FbxObject*> doomed;
    std::unordered_set<const FbxObject*> known;
    const auto doom = [&](FbxObject& object) {
        const bool isKept = isKeptByScene(object) && !known.contains(&object.data().membership->scene);
        if (!isKept && known.insert(&object).second)
            doomed.push_back(&object);
    };
    doom(*this);
    for (std::size_t i = 0; i < doomed.size(); ++i) { // NOLINT(modernize-loop-convert): the list grows
        // A scene frees its members as well, and its members are its sources.
        const FbxScene* scene = detail::isScene(*doomed[i]) ? doomed[i]->GetScene() : nullptr;
        for (const detail::ConnectionPoint* source : doomed[i]->mData->plug.sources)
            if (source->property < 0 && (pRecursive || (scene && source->object->GetScene() == scene)))
                doom(*source->object);
    }
    detail::ManagerData::destroyTogether(doomed);
}

FbxClassId FbxObject::GetClassId() const { return FbxClassId(mData->info); }

const char* FbxObject::GetName() const { return mData->name.c_str(); }

void FbxObject::SetName(const char* pName) { mData->name = pName ? pName : ""; }

FbxManager* FbxObject::GetFbxManager() const { return mData->manager; }

FbxScene* FbxObject::GetScene() const { return mData->scene; }

FbxProperty FbxObject::FindProperty(const char* pName, bool pCaseSensitive) const {
    if (!pName)
        return {};
    const int index = pCaseSensitive ? mData->findProperty(detail::NameKey(std::string_view(pName)))
                                     : mData->findPropertyInAnyCase(pName);
    return index < 0 ? FbxProperty() : FbxProperty(const_cast<FbxObject*>(this), index);
}

FbxProperty FbxObject::FindProperty(const char* pName, const FbxDataType& pDataType, bool pCaseSensitive) const {
    const FbxProperty property = FindProperty(pName, pCaseSensitive);
    return property.IsValid() && property.GetPropertyDataType() == pDataType ? property : FbxProperty();
}

FbxProperty FbxObject::GetFirstProperty() const {
    return mData->propertyCount() > 0 ? FbxProperty(const_cast<FbxObject*>(this), 0) : FbxProperty();
}

FbxProperty FbxObject::GetNextProperty(const FbxProperty& pProperty) const {
    const int next = pProperty.index() + 1;
    return pProperty.GetFbxObject() == this && next < mData->propertyCount()
               ? FbxProperty(const_cast<FbxObject*>(this), next)
               : FbxProperty();
}

bool FbxObject::ConnectSrcObject(FbxObject* pObject, FbxConnection::EType) {
    return pObject && detail::ObjectData::connect(pObject->mData->plug, mData->plug);
}

bool FbxObject::ConnectDstObject(FbxObject* pObject, FbxConnection::EType) {
    return pObject && detail::ObjectData::connect(mData->plug, pObject->mData->plug);
}

bool FbxObject::IsConnectedSrcObject(const FbxObject* pObject) const {
    return pObject && detail::isConnected(pObject->mData->plug, mData->plug);
}

bool FbxObject::IsConnectedDstObject(const FbxObject* pObject) const {
    return pObject && detail::isConnected(mData->plug, pObject->mData->plug);
}

bool FbxObject::DisconnectSrcObject(FbxObject* pObject) {
    return pObject && detail::ObjectData::disconnect(pObject->mData->plug, mData->plug);
}

bool FbxObject::DisconnectDstObject(FbxObject* pObject) {
    return pObject && detail::ObjectData::disconnect(mData->plug, pObject->mData->plug);
}

bool FbxObject::ConnectSrcProperty(const FbxProperty& pProperty) {
    FbxProperty source = pProperty;
    return source.ConnectDstObject(this);
}

bool FbxObject::ConnectDstProperty(const FbxProperty& pProperty) {
    FbxProperty destination = pProperty;
    return destination.ConnectSrcObject(this);
}

int FbxObject::GetSrcObjectCount() const { return mData->plug.sources.countObjects(FbxCriteria()); }
int FbxObject::GetSrcObjectCount(const FbxCriteria& pCriteria) const {
    return mData->plug.sources.countObjects(pCriteria);
}
FbxObject* FbxObject::GetSrcObject(int pIndex) const { return mData->plug.sources.objectAt(FbxCriteria(), pIndex); }
FbxObject* FbxObject::GetSrcObject(const FbxCriteria& pCriteria, int pIndex) const {
    return mData->plug.sources.objectAt(pCriteria, pIndex);
}
int FbxObject::GetDstObjectCount() const { return mData->plug.destinations.countObjects(FbxCriteria()); }
int FbxObject::GetDstObjectCount(const FbxCriteria& pCriteria) const {
    return mData->plug.destinations.countObjects(pCriteria);
}
FbxObject* FbxObject::GetDstObject(int pIndex) const {
    return mData->plug.destinations.objectAt(FbxCriteria(), pIndex);
}
FbxObject* FbxObject::GetDstObject(const FbxCriteria& pCriteria, int pIndex) const {
    return mData->plug.destinations.objectAt(pCriteria, pIndex);
}
int FbxObject::GetSrcPropertyCount() const { return mData->plug.sources.countProperties(); }
FbxProperty FbxObject::GetSrcProperty(int pIndex) const { return mData->plug.sources.propertyAt(pIndex); }
int FbxObject::GetDstPropertyCount() const { return mData->plug.destinations.countProperties(); }
FbxProperty FbxObject::GetDstProperty(int pIndex) const { return mData->plug.destinations.propertyAt(pIndex); }

void FbxObject::connectionChanged(FbxObject&, FbxObject&, bool) {}

void FbxObject::sceneChanged(FbxScene*) {}

FBXSDK_NAMESPACE_END
