// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Skins.
#include <fbxsdk/FbxSkin.h>

#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxGeometry.h>

#include "geometry/GeometrySource.h"
#include "geometry/SourceList.h"
#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxSkin, FbxDeformer, {})

FbxSkin::FbxSkin(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxDeformer(pManager, pInfo) {}

FbxSkin::~FbxSkin() = default;

FbxDeformer::EDeformerType FbxSkin::GetDeformerType() const { return eSkin; }

bool FbxSkin::AddCluster(FbxCluster* pCluster) { return detail::addSource(*this, pCluster); }

FbxCluster* FbxSkin::RemoveCluster(FbxCluster* pCluster) { return detail::removeSource(*this, mClusters, pCluster); }

FbxCluster* FbxSkin::GetCluster(int pIndex) { return detail::sourceAt(mClusters, pIndex); }

const FbxCluster* FbxSkin::GetCluster(int pIndex) const { return detail::sourceAt(mClusters, pIndex); }

FbxGeometry* FbxSkin::GetGeometry() { return GetDstObject<FbxGeometry>(); }

bool FbxSkin::SetGeometry(FbxGeometry* pGeometry) { return detail::moveToDestination(*this, pGeometry); }

void FbxSkin::AddControlPointIndex(int pIndex, double pBlendWeight) {
    mIndices.add(pIndex);
    mBlendWeights.add(pBlendWeight);
}

int* FbxSkin::GetControlPointIndices() const { return mIndices.count() == 0 ? nullptr : mIndices.data(); }

double* FbxSkin::GetControlPointBlendWeights() const {
    return mBlendWeights.count() == 0 ? nullptr : mBlendWeights.data();
}

void FbxSkin::connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) {
    FbxDeformer::connectionChanged(pSource, pDestination, pConnected);
    if (&pDestination == this)
        detail::followConnection(mClusters, pSource, pConnected);
}

FBXSDK_NAMESPACE_END
