// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxClassId.h>

#include "object/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN

bool FbxClassId::Is(const FbxClassId& pId) const {
    if (!pId.mInfo)
        return false;
    for (const detail::ClassInfo* each = mInfo; each; each = each->parent)
        if (each == pId.mInfo)
            return true;
    return false;
}

const char* FbxClassId::GetName() const { return mInfo ? mInfo->name : ""; }

FbxClassId FbxClassId::GetParent() const { return FbxClassId(mInfo ? mInfo->parent : nullptr); }

FBXSDK_NAMESPACE_END
