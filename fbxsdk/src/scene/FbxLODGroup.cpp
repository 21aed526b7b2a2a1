// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxLODGroup.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxLODGroup, FbxNodeAttribute, detail::kLodGroupRows)

FbxLODGroup::FbxLODGroup(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo),
      ThresholdsUsedAsPercentage(detail::bindProperty<FbxBool>(*this, "ThresholdsUsedAsPercentage")),
      MinMaxDistance(detail::bindProperty<FbxBool>(*this, "MinMaxDistance")),
      MinDistance(detail::bindProperty<FbxDouble>(*this, "MinDistance")),
      MaxDistance(detail::bindProperty<FbxDouble>(*this, "MaxDistance")),
      WorldSpace(detail::bindProperty<FbxBool>(*this, "WorldSpace")) {}

FbxLODGroup::~FbxLODGroup() = default;

FbxNodeAttribute::EType FbxLODGroup::GetAttributeType() const { return eLODGroup; }

FBXSDK_NAMESPACE_END
