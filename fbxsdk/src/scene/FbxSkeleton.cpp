// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxSkeleton.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxSkeleton, FbxNodeAttribute, detail::kSkeletonRows)

FbxSkeleton::FbxSkeleton(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo), Size(detail::bindProperty<FbxDouble>(*this, "Size")),
      LimbLength(detail::bindProperty<FbxDouble>(*this, "LimbLength")) {}

FbxSkeleton::~FbxSkeleton() = default;

FbxNodeAttribute::EType FbxSkeleton::GetAttributeType() const { return eSkeleton; }

FBXSDK_NAMESPACE_END
