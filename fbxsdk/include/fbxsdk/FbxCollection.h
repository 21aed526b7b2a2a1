// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Objects that hold others: documents, stacks, layers. Membership is a source connection.
#pragma once

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxCollection : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxCollection, FbxObject)

public:
    /// False for null and for the collection itself; adding a member again changes nothing.
    virtual bool AddMember(FbxObject* pMember);
    virtual bool RemoveMember(FbxObject* pMember);
    [[nodiscard]] bool IsMember(const FbxObject* pMember) const;

    [[nodiscard]] int GetMemberCount() const { return GetSrcObjectCount(); }
    [[nodiscard]] int GetMemberCount(const FbxCriteria& pCriteria) const { return GetSrcObjectCount(pCriteria); }
    [[nodiscard]] FbxObject* GetMember(int pIndex = 0) const { return GetSrcObject(pIndex); }
    [[nodiscard]] FbxObject* GetMember(const FbxCriteria& pCriteria, int pIndex = 0) const {
        return GetSrcObject(pCriteria, pIndex);
    }
    template <class T>
    [[nodiscard]] int GetMemberCount() const {
        return GetSrcObjectCount<T>();
    }
    template <class T>
    [[nodiscard]] T* GetMember(int pIndex = 0) const {
        return GetSrcObject<T>(pIndex);
    }
};

FBXSDK_NAMESPACE_END
