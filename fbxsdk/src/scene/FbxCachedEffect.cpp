// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxCachedEffect.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxCachedEffect, FbxNodeAttribute, detail::kNodeAttributeRows)

FbxCachedEffect::FbxCachedEffect(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo) {}

FbxCachedEffect::~FbxCachedEffect() = default;

FbxNodeAttribute::EType FbxCachedEffect::GetAttributeType() const { return eCachedEffect; }

FBXSDK_NAMESPACE_END
