// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <memory>

#include <fbxsdk/FbxClassId.h>

FBXSDK_NAMESPACE_BEGIN

class FbxObject;

/// A condition on objects. Cheap to copy; combined with &&, || and !.
class FBXSDK_DLL FbxCriteria {
public:
    /// Objects of the class or of any class that derives from it.
    static FbxCriteria ObjectType(const FbxClassId& pClassId);
    /// Objects of exactly that class.
    static FbxCriteria ObjectTypeStrict(const FbxClassId& pClassId);
    /// Properties, never objects.
    static FbxCriteria IsProperty();

    FbxCriteria() = default; ///< meets every object

    FbxCriteria operator&&(const FbxCriteria& pOther) const; ///< What meets both.
    FbxCriteria operator||(const FbxCriteria& pOther) const; ///< What meets one of the two, or both.
    FbxCriteria operator!() const;                           ///< What does not meet this one.

    [[nodiscard]] bool isMetBy(const FbxClassId& pClassId) const; ///< Whether objects of exactly that class meet it.
    /// Created with &&, || or !.
    [[nodiscard]] bool isCombined() const { return mOperands != nullptr; }
    /// Whether both are the same, without comparing the criteria that they combine.
    [[nodiscard]] bool isSame(const FbxCriteria& pOther) const {
        return mKind == pOther.mKind && mClassId == pOther.mClassId && mOperands == pOther.mOperands;
    }

private:
    struct Node;
    enum class Kind : unsigned char { any, type, strictType, property, both, either, inverse };
    Kind mKind = Kind::any;
    FbxClassId mClassId;
    std::shared_ptr<const Node> mOperands; ///< operands of a combination
};

FBXSDK_NAMESPACE_END
