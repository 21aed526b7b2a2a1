// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxMarker.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

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

FBXSDK_NAMESPACE_END
