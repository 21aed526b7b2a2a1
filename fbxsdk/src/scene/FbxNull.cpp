// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxNull.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxNull, FbxNodeAttribute, detail::kNullRows)

const char* const FbxNull::sSize = "Size";
const char* const FbxNull::sLook = "Look";
const FbxDouble FbxNull::sDefaultSize = 100.0;
const FbxNull::ELook FbxNull::sDefaultLook = FbxNull::eCross;

FbxNull::FbxNull(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo), Size(detail::bindProperty<FbxDouble>(*this, "Size")),
      Look(detail::bindProperty<ELook>(*this, "Look")) {}

FbxNull::~FbxNull() = default;

FbxNodeAttribute::EType FbxNull::GetAttributeType() const { return eNull; }

void FbxNull::Reset() {
    Size.Set(sDefaultSize);
    Look.Set(sDefaultLook);
}

double FbxNull::GetSizeDefaultValue() const { return sDefaultSize; }

FBXSDK_NAMESPACE_END
