// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// NURBS surfaces, those of newer and those of older writers.
#include <fbxsdk/FbxNurbs.h>
#include <fbxsdk/FbxNurbsSurface.h>

#include <algorithm>

#include "geometry/GeometrySource.h"
#include "geometry/NurbsNumbers.h"
#include "geometry/NurbsReading.h"
#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxNurbsSurface, FbxGeometry, detail::kMeshRows)
FBXSDK_OBJECT_IMPLEMENT(FbxNurbs, FbxGeometry, detail::kMeshRows)

FbxNurbsSurfaceBase::FbxNurbsSurfaceBase(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxGeometry(pManager, pInfo) {}

FbxNurbsSurfaceBase::~FbxNurbsSurfaceBase() = default;

namespace {

int asOrder(FbxUInt order) { return static_cast<int>(std::min<FbxUInt>(order, detail::kMostPoints)); }

void initDirection(FbxNurbsSurfaceBase::Direction& direction, int count, FbxNurbsSurfaceBase::EType type) {
    direction.count = count;
    direction.type = type;
    const bool sound = direction.order >= 2 && direction.order <= count;
    const int repeated = detail::repeatedPoints(type, direction.order);
    direction.knots.assign(sound ? static_cast<std::size_t>(detail::knotCount(count, direction.order, repeated)) : 0,
                           0.0);
    direction.multiplicity.clear();
}

} // namespace

void FbxNurbsSurfaceBase::InitControlPoints(int pUCount, EType pUType, int pVCount, EType pVType) {
    const std::int64_t count = std::int64_t{std::max(pUCount, 0)} * std::max(pVCount, 0);
    const bool sound = count > 0 && count <= detail::kMostPoints;
    FbxGeometry::InitControlPoints(sound ? static_cast<int>(count) : 0);
    initDirection(mDirections[0], sound ? pUCount : 0, pUType);
    initDirection(mDirections[1], sound ? pVCount : 0, pVType);
}

void FbxNurbsSurfaceBase::SetOrder(FbxUInt pUOrder, FbxUInt pVOrder) {
    detachSource();
    mDirections[0].order = asOrder(pUOrder);
    mDirections[1].order = asOrder(pVOrder);
}

void FbxNurbsSurfaceBase::SetStep(int pUStep, int pVStep) {
    detachSource();
    mDirections[0].step = pUStep;
    mDirections[1].step = pVStep;
}

void FbxNurbsSurfaceBase::SetFlipNormals(bool pFlipNormals) {
    detachSource();
    mFlipNormals = pFlipNormals;
}

bool FbxNurbsSurfaceBase::GetFlipNormals() const {
    ensureLoaded();
    return mFlipNormals;
}

double* FbxNurbsSurfaceBase::knots(int pDirection) const {
    ensureLoaded();
    std::vector<double>& knots = mDirections[pDirection].knots;
    return knots.empty() ? nullptr : knots.data();
}

int* FbxNurbsSurfaceBase::multiplicity(int pDirection) const {
    ensureLoaded();
    std::vector<int>& multiplicity = mDirections[pDirection].multiplicity;
    return multiplicity.empty() ? nullptr : multiplicity.data();
}

FbxNurbsSurface::FbxNurbsSurface(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNurbsSurfaceBase(pManager, pInfo) {}

FbxNurbsSurface::~FbxNurbsSurface() = default;

FbxNodeAttribute::EType FbxNurbsSurface::GetAttributeType() const { return eNurbsSurface; }

FbxNurbs::FbxNurbs(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxNurbsSurfaceBase(pManager, pInfo) {}

FbxNurbs::~FbxNurbs() = default;

FbxNodeAttribute::EType FbxNurbs::GetAttributeType() const { return eNurbs; }

FBXSDK_NAMESPACE_END
