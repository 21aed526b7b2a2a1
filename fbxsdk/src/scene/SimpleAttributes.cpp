// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Node attributes that are little more than their properties.
#include <fbxsdk/FbxCachedEffect.h>
#include <fbxsdk/FbxCameraSwitcher.h>
#include <fbxsdk/FbxLODGroup.h>
#include <fbxsdk/FbxMarker.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxOpticalReference.h>
#include <fbxsdk/FbxSkeleton.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

// ---- FbxCachedEffect ----

FBXSDK_OBJECT_IMPLEMENT(FbxCachedEffect, FbxNodeAttribute, detail::kNodeAttributeRows)

FbxCachedEffect::FbxCachedEffect(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo) {}

FbxCachedEffect::~FbxCachedEffect() = default;

FbxNodeAttribute::EType FbxCachedEffect::GetAttributeType() const { return eCachedEffect; }

// ---- FbxCameraSwitcher ----

FBXSDK_OBJECT_IMPLEMENT(FbxCameraSwitcher, FbxNodeAttribute, detail::kCameraSwitcherRows)

FbxCameraSwitcher::FbxCameraSwitcher(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo), CameraIndex(detail::bindProperty<FbxInt>(*this, "Camera Index")) {}

FbxCameraSwitcher::~FbxCameraSwitcher() = default;

FbxNodeAttribute::EType FbxCameraSwitcher::GetAttributeType() const { return eCameraSwitcher; }

// ---- FbxLODGroup ----

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

// ---- FbxMarker ----

FBXSDK_OBJECT_IMPLEMENT(FbxMarker, FbxNodeAttribute, detail::kMarkerRows)

FbxMarker::FbxMarker(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo), Look(detail::bindProperty<ELook>(*this, "Look")),
      DrawLink(detail::bindProperty<FbxBool>(*this, "DrawLink")), Size(detail::bindProperty<FbxDouble>(*this, "Size")),
      ShowLabel(detail::bindProperty<FbxBool>(*this, "ShowLabel")),
      IKPivot(detail::bindProperty<FbxDouble3>(*this, "IKPivot")) {}

FbxMarker::~FbxMarker() = default;

FbxNodeAttribute::EType FbxMarker::GetAttributeType() const { return eMarker; }

void FbxMarker::Reset() {
    mType = eStandard;
    Look.Set(eCube);
    DrawLink.Set(true);
    Size.Set(100.0);
    ShowLabel.Set(false);
    IKPivot.Set(FbxDouble3(0, 0, 0));
}

FbxColor FbxMarker::GetDefaultColor() const { return FbxColor(Color.Get()); }

// ---- FbxNull ----

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

// ---- FbxOpticalReference ----

FBXSDK_OBJECT_IMPLEMENT(FbxOpticalReference, FbxNodeAttribute, detail::kNodeAttributeRows)

FbxOpticalReference::FbxOpticalReference(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo) {}

FbxOpticalReference::~FbxOpticalReference() = default;

FbxNodeAttribute::EType FbxOpticalReference::GetAttributeType() const { return eOpticalReference; }

// ---- FbxSkeleton ----

FBXSDK_OBJECT_IMPLEMENT(FbxSkeleton, FbxNodeAttribute, detail::kSkeletonRows)

FbxSkeleton::FbxSkeleton(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo), Size(detail::bindProperty<FbxDouble>(*this, "Size")),
      LimbLength(detail::bindProperty<FbxDouble>(*this, "LimbLength")) {}

FbxSkeleton::~FbxSkeleton() = default;

FbxNodeAttribute::EType FbxSkeleton::GetAttributeType() const { return eSkeleton; }

FBXSDK_NAMESPACE_END
