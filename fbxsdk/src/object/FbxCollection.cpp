// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxCollection.h>

#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxCollection, FbxObject, std::span<const detail::PropertyRow>{})

FbxCollection::FbxCollection(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxObject(pManager, pInfo) {}
FbxCollection::~FbxCollection() = default;

bool FbxCollection::AddMember(FbxObject* pMember) {
    if (!pMember || pMember == this)
        return false;
    return IsMember(pMember) || ConnectSrcObject(pMember);
}

bool FbxCollection::RemoveMember(FbxObject* pMember) { return DisconnectSrcObject(pMember); }

bool FbxCollection::IsMember(const FbxObject* pMember) const { return IsConnectedSrcObject(pMember); }

FBXSDK_NAMESPACE_END
