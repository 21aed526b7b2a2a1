// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// NURBS curves.
#include <fbxsdk/FbxNurbsCurve.h>

#include <algorithm>

#include "geometry/GeometrySource.h"
#include "geometry/NurbsNumbers.h"
#include "geometry/NurbsReading.h"
#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxNurbsCurve, FbxGeometry, detail::kMeshRows)

FbxNurbsCurve::FbxNurbsCurve(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxGeometry(pManager, pInfo) {}

FbxNurbsCurve::~FbxNurbsCurve() = default;

FbxNodeAttribute::EType FbxNurbsCurve::GetAttributeType() const { return eNurbsCurve; }

void FbxNurbsCurve::InitControlPoints(int pCount, EType pVType) {
    const int count = pCount <= detail::kMostPoints ? std::max(pCount, 0) : 0;
    FbxGeometry::InitControlPoints(count);
    mContent.type = pVType;
    const bool sound = mContent.order >= 2 && mContent.order <= count;
    const int repeated = detail::repeatedPoints(pVType, mContent.order);
    mContent.knots.assign(sound ? static_cast<std::size_t>(detail::knotCount(count, mContent.order, repeated)) : 0,
                          0.0);
}

void FbxNurbsCurve::SetOrder(int pOrder) {
    detachSource();
    mContent.order = pOrder;
}

int FbxNurbsCurve::GetOrder() const {
    ensureLoaded();
    return mContent.order;
}

FbxNurbsCurve::EType FbxNurbsCurve::GetType() const {
    ensureLoaded();
    return mContent.type;
}

int FbxNurbsCurve::GetKnotCount() const {
    ensureLoaded();
    return static_cast<int>(mContent.knots.size());
}

double* FbxNurbsCurve::GetKnotVector() const {
    ensureLoaded();
    return mContent.knots.empty() ? nullptr : mContent.knots.data();
}

void FbxNurbsCurve::SetStep(int pStep) {
    detachSource();
    mContent.step = pStep;
}

int FbxNurbsCurve::GetStep() const {
    ensureLoaded();
    return mContent.step;
}

void FbxNurbsCurve::SetDimension(EDimension pDimension) {
    detachSource();
    mContent.dimension = pDimension;
}

FbxNurbsCurve::EDimension FbxNurbsCurve::GetDimension() const {
    ensureLoaded();
    return mContent.dimension;
}

bool FbxNurbsCurve::IsRational() const {
    ensureLoaded();
    return mContent.rational;
}

FBXSDK_NAMESPACE_END
