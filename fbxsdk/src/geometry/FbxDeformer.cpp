// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The bases of deformers.
#include <fbxsdk/FbxDeformer.h>

#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_ABSTRACT_IMPLEMENT(FbxDeformer, FbxObject)
FBXSDK_ABSTRACT_IMPLEMENT(FbxSubDeformer, FbxObject)

FbxDeformer::FbxDeformer(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxObject(pManager, pInfo) {}
FbxDeformer::~FbxDeformer() = default;
FbxDeformer::EDeformerType FbxDeformer::GetDeformerType() const { return eUnknown; }

FbxSubDeformer::FbxSubDeformer(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxObject(pManager, pInfo) {}
FbxSubDeformer::~FbxSubDeformer() = default;
FbxSubDeformer::EType FbxSubDeformer::GetSubDeformerType() const { return eUnknown; }

FBXSDK_NAMESPACE_END
