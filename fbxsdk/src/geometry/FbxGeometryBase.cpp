// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Control points.
#include <fbxsdk/FbxGeometryBase.h>

#include <fbxsdk/extensions/ItemRuns.h>

#include "geometry/GeometrySource.h"
#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_ABSTRACT_IMPLEMENT(FbxGeometryBase, FbxLayerContainer)

FbxGeometryBase::FbxGeometryBase(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxLayerContainer(pManager, pInfo), PrimaryVisibility(detail::bindProperty<FbxBool>(*this, "Primary Visibility")),
      CastShadow(detail::bindProperty<FbxBool>(*this, "Casts Shadows")),
      ReceiveShadow(detail::bindProperty<FbxBool>(*this, "Receive Shadows")),
      BBoxMin(detail::bindProperty<FbxDouble3>(*this, "BBoxMin")),
      BBoxMax(detail::bindProperty<FbxDouble3>(*this, "BBoxMax")) {}

FbxGeometryBase::~FbxGeometryBase() = default;

void FbxGeometryBase::InitControlPoints(int pCount) {
    detachSource();
    mControlPoints.clear();
    mControlPoints.resize(pCount, FbxVector4());
}

int FbxGeometryBase::GetControlPointsCount() const {
    ensureLoaded();
    return mControlPoints.count();
}

FbxVector4* FbxGeometryBase::GetControlPoints(FbxStatus* pStatus) const {
    ensureLoaded();
    const bool none = mControlPoints.count() == 0;
    if (pStatus) {
        if (none)
            pStatus->SetCode(FbxStatus::eFailure, "the geometry has no control points");
        else
            pStatus->Clear();
    }
    return none ? nullptr : mControlPoints.data();
}

void FbxGeometryBase::SetControlPointAt(const FbxVector4& pCtrlPoint, int pIndex) {
    detachSource();
    if (mControlPoints.contains(pIndex))
        mControlPoints[pIndex] = pCtrlPoint;
}

FbxVector4 FbxGeometryBase::GetControlPointAt(int pIndex) const {
    ensureLoaded();
    return mControlPoints.contains(pIndex) ? mControlPoints.value(pIndex) : FbxVector4();
}

extensions::ItemRun extensions::controlPointRun(FbxGeometryBase& geometry, int index) {
    const bool exists = index >= 0 && index < geometry.GetControlPointsCount(); // reads the geometry's source, too
    return exists ? geometry.points().run(index) : ItemRun{};
}

FBXSDK_NAMESPACE_END
