// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxOpticalReference.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxOpticalReference, FbxNodeAttribute, detail::kNodeAttributeRows)

FbxOpticalReference::FbxOpticalReference(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo) {}

FbxOpticalReference::~FbxOpticalReference() = default;

FbxNodeAttribute::EType FbxOpticalReference::GetAttributeType() const { return eOpticalReference; }

FBXSDK_NAMESPACE_END
