// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

/// The base of objects that contain others: documents, stacks, layers. A member is a source object of the collection,
/// and may be a member of other collections too.
class FBXSDK_DLL FbxCollection : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxCollection, FbxObject)

public:
    /// Appends the object. True also when it is a member already, which keeps its position. False for null, for the
    /// collection itself, and for an object of another manager.
    virtual bool AddMember(FbxObject* pMember);
    virtual bool RemoveMember(FbxObject* pMember);               ///< Not destroyed. False when it is no member.
    [[nodiscard]] bool IsMember(const FbxObject* pMember) const; ///< False for null.

    [[nodiscard]] int GetMemberCount() const { return GetSrcObjectCount(); } ///< How many members there are.
    /// How many members meet the criterion.
    [[nodiscard]] int GetMemberCount(const FbxCriteria& pCriteria) const { return GetSrcObjectCount(pCriteria); }
    /// In order of entry; null out of range.
    [[nodiscard]] FbxObject* GetMember(int pIndex = 0) const { return GetSrcObject(pIndex); }
    /// The member at that index among those that meet the criterion; null out of range.
    [[nodiscard]] FbxObject* GetMember(const FbxCriteria& pCriteria, int pIndex = 0) const {
        return GetSrcObject(pCriteria, pIndex);
    }
    /// How many members are a T.
    template <class T>
    [[nodiscard]] int GetMemberCount() const {
        return GetSrcObjectCount<T>();
    }
    /// The member at that index among those that are a T; null out of range.
    template <class T>
    [[nodiscard]] T* GetMember(int pIndex = 0) const {
        return GetSrcObject<T>(pIndex);
    }
};

FBXSDK_NAMESPACE_END
