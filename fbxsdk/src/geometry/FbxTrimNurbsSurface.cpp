// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Trimmed surfaces: their parts are connected to them.
#include <fbxsdk/FbxTrimNurbsSurface.h>

#include "geometry/GeometrySource.h"
#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxBoundary, FbxGeometry, detail::kMeshRows)
FBXSDK_OBJECT_IMPLEMENT(FbxTrimNurbsSurface, FbxGeometry, detail::kMeshRows)

const char* const FbxBoundary::sOuterFlag = "OuterBoundary";

FbxBoundary::FbxBoundary(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxGeometry(pManager, pInfo) {}

FbxBoundary::~FbxBoundary() = default;

FbxNodeAttribute::EType FbxBoundary::GetAttributeType() const { return eBoundary; }

void FbxBoundary::AddCurve(FbxNurbsCurve* pCurve) { ConnectSrcObject(pCurve); }

int FbxBoundary::GetCurveCount() const { return GetSrcObjectCount<FbxNurbsCurve>(); }

FbxNurbsCurve* FbxBoundary::GetCurve(int pIndex) const { return GetSrcObject<FbxNurbsCurve>(pIndex); }

FbxTrimNurbsSurface::FbxTrimNurbsSurface(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxGeometry(pManager, pInfo) {}

FbxTrimNurbsSurface::~FbxTrimNurbsSurface() = default;

FbxNodeAttribute::EType FbxTrimNurbsSurface::GetAttributeType() const { return eTrimNurbsSurface; }

void FbxTrimNurbsSurface::SetNurbsSurface(const FbxNurbsSurface* pNurbs) {
    while (FbxNurbsSurface* former = GetNurbsSurface())
        if (!DisconnectSrcObject(former))
            break;
    // A connection changes both ends; the surface's content is unchanged.
    ConnectSrcObject(const_cast<FbxNurbsSurface*>(pNurbs));
}

FbxNurbsSurface* FbxTrimNurbsSurface::GetNurbsSurface() const { return GetSrcObject<FbxNurbsSurface>(); }

bool FbxTrimNurbsSurface::AddBoundary(FbxBoundary* pBoundary) { return ConnectSrcObject(pBoundary); }

int FbxTrimNurbsSurface::GetBoundaryCount() const { return GetSrcObjectCount<FbxBoundary>(); }

FbxBoundary* FbxTrimNurbsSurface::GetBoundary(int pIndex) const { return GetSrcObject<FbxBoundary>(pIndex); }

void FbxTrimNurbsSurface::SetFlipNormals(bool pFlip) {
    detachSource();
    mFlipNormals = pFlip;
}

bool FbxTrimNurbsSurface::GetFlipNormals() const {
    ensureLoaded();
    return mFlipNormals;
}

int FbxTrimNurbsSurface::GetControlPointsCount() const {
    const FbxNurbsSurface* surface = GetNurbsSurface();
    return surface ? surface->GetControlPointsCount() : 0;
}

FbxVector4* FbxTrimNurbsSurface::GetControlPoints(FbxStatus* pStatus) const {
    const FbxNurbsSurface* surface = GetNurbsSurface();
    return surface ? surface->GetControlPoints(pStatus) : nullptr;
}

void FbxTrimNurbsSurface::SetControlPointAt(const FbxVector4& pCtrlPoint, int pIndex) {
    if (FbxNurbsSurface* surface = GetNurbsSurface())
        surface->SetControlPointAt(pCtrlPoint, pIndex);
}

FbxVector4 FbxTrimNurbsSurface::GetControlPointAt(int pIndex) const {
    const FbxNurbsSurface* surface = GetNurbsSurface();
    return surface ? surface->GetControlPointAt(pIndex) : FbxVector4();
}

FBXSDK_NAMESPACE_END
