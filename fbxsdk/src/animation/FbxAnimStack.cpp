// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Animation stacks: the spans are four stored times.
#include <fbxsdk/FbxAnimStack.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxAnimStack, FbxCollection, detail::kAnimStackRows)

FbxAnimStack::FbxAnimStack(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxCollection(pManager, pInfo), Description(detail::bindProperty<FbxString>(*this, "Description")),
      LocalStart(detail::bindProperty<FbxTime>(*this, "LocalStart")),
      LocalStop(detail::bindProperty<FbxTime>(*this, "LocalStop")),
      ReferenceStart(detail::bindProperty<FbxTime>(*this, "ReferenceStart")),
      ReferenceStop(detail::bindProperty<FbxTime>(*this, "ReferenceStop")) {}

FbxAnimStack::~FbxAnimStack() = default;

FbxTimeSpan FbxAnimStack::GetLocalTimeSpan() const { return {LocalStart.Get(), LocalStop.Get()}; }

void FbxAnimStack::SetLocalTimeSpan(const FbxTimeSpan& pTimeSpan) {
    LocalStart.Set(pTimeSpan.GetStart());
    LocalStop.Set(pTimeSpan.GetStop());
}

FbxTimeSpan FbxAnimStack::GetReferenceTimeSpan() const { return {ReferenceStart.Get(), ReferenceStop.Get()}; }

void FbxAnimStack::SetReferenceTimeSpan(const FbxTimeSpan& pTimeSpan) {
    ReferenceStart.Set(pTimeSpan.GetStart());
    ReferenceStop.Set(pTimeSpan.GetStop());
}

void FbxAnimStack::Reset() {
    Description.Set(FbxString());
    SetLocalTimeSpan(FbxTimeSpan());
    SetReferenceTimeSpan(FbxTimeSpan());
}

FBXSDK_NAMESPACE_END
