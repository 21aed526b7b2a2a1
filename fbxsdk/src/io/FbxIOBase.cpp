// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The common part of importers and exporters.
#include <fbxsdk/FbxIOBase.h>

#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_ABSTRACT_IMPLEMENT(FbxIOBase, FbxObject)

FbxIOBase::FbxIOBase(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxObject(pManager, pInfo) {}
FbxIOBase::~FbxIOBase() = default;

bool FbxIOBase::Initialize(const char* pFileName, int, FbxIOSettings*) {
    mStatus.Clear();
    mFileName = pFileName ? pFileName : "";
    if (!mFileName.empty())
        return true;
    mStatus.SetCode(FbxStatus::eInvalidParameter, "no file name");
    return false;
}

FbxString FbxIOBase::GetFileName() const { return FbxString(mFileName.c_str()); }

FBXSDK_NAMESPACE_END
