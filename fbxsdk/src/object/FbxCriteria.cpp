// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Criteria: small expression trees over class identities.
#include <fbxsdk/FbxCriteria.h>

FBXSDK_NAMESPACE_BEGIN

struct FbxCriteria::Node {
    FbxCriteria first, second;
};

FbxCriteria FbxCriteria::ObjectType(const FbxClassId& pClassId) {
    FbxCriteria criteria;
    criteria.mKind = Kind::type;
    criteria.mClassId = pClassId;
    return criteria;
}

FbxCriteria FbxCriteria::ObjectTypeStrict(const FbxClassId& pClassId) {
    FbxCriteria criteria;
    criteria.mKind = Kind::strictType;
    criteria.mClassId = pClassId;
    return criteria;
}

FbxCriteria FbxCriteria::IsProperty() {
    FbxCriteria criteria;
    criteria.mKind = Kind::property;
    return criteria;
}

FbxCriteria FbxCriteria::operator&&(const FbxCriteria& pOther) const {
    FbxCriteria criteria;
    criteria.mKind = Kind::both;
    criteria.mOperands = std::make_shared<Node>(Node{*this, pOther});
    return criteria;
}

FbxCriteria FbxCriteria::operator||(const FbxCriteria& pOther) const {
    FbxCriteria criteria;
    criteria.mKind = Kind::either;
    criteria.mOperands = std::make_shared<Node>(Node{*this, pOther});
    return criteria;
}

FbxCriteria FbxCriteria::operator!() const {
    FbxCriteria criteria;
    criteria.mKind = Kind::inverse;
    criteria.mOperands = std::make_shared<Node>(Node{*this, FbxCriteria()});
    return criteria;
}

bool FbxCriteria::isMetBy(const FbxClassId& pClassId) const {
    switch (mKind) {
    case Kind::any:
        return true;
    case Kind::type:
        return pClassId.Is(mClassId);
    case Kind::strictType:
        return pClassId == mClassId;
    case Kind::property:
        return false;
    case Kind::both:
        return mOperands->first.isMetBy(pClassId) && mOperands->second.isMetBy(pClassId);
    case Kind::either:
        return mOperands->first.isMetBy(pClassId) || mOperands->second.isMetBy(pClassId);
    case Kind::inverse:
        return !mOperands->first.isMetBy(pClassId);
    }
    return false;
}

FBXSDK_NAMESPACE_END
