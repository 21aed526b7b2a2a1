// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Surfaces of spline patches.
#include <fbxsdk/FbxPatch.h>

#include <algorithm>

#include "geometry/GeometrySource.h"
#include "geometry/NurbsNumbers.h"
#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxPatch, FbxGeometry, detail::kMeshRows)

FbxPatch::FbxPatch(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxGeometry(pManager, pInfo) {}

FbxPatch::~FbxPatch() = default;

FbxNodeAttribute::EType FbxPatch::GetAttributeType() const { return FbxNodeAttribute::ePatch; }

void FbxPatch::InitControlPoints(int pUCount, EType pUType, int pVCount, EType pVType) {
    const std::int64_t count = std::int64_t{std::max(pUCount, 0)} * std::max(pVCount, 0);
    const bool sound = count > 0 && count <= detail::kMostPoints;
    FbxGeometry::InitControlPoints(sound ? static_cast<int>(count) : 0);
    mDirections[0].count = sound ? pUCount : 0;
    mDirections[1].count = sound ? pVCount : 0;
    mDirections[0].type = pUType;
    mDirections[1].type = pVType;
}

void FbxPatch::SetStep(int pUStep, int pVStep) {
    detachSource();
    mDirections[0].step = pUStep;
    mDirections[1].step = pVStep;
}

void FbxPatch::SetClosed(bool pU, bool pV) {
    detachSource();
    mDirections[0].closed = pU;
    mDirections[1].closed = pV;
}

void FbxPatch::SetUCapped(bool pUBottom, bool pUTop) {
    detachSource();
    mDirections[0].cappedBottom = pUBottom;
    mDirections[0].cappedTop = pUTop;
}

void FbxPatch::SetVCapped(bool pVBottom, bool pVTop) {
    detachSource();
    mDirections[1].cappedBottom = pVBottom;
    mDirections[1].cappedTop = pVTop;
}

FBXSDK_NAMESPACE_END
