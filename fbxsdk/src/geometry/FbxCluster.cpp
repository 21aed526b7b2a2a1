// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Clusters. The associate model is connected to a property, as in older files, since a plain source node is the link.
#include <fbxsdk/FbxCluster.h>

#include <algorithm>

#include <fbxsdk/FbxNode.h>

#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxCluster, FbxSubDeformer, {})

namespace {
constexpr const char* kAssociateModel = "SrcModelReference";
}

FbxCluster::FbxCluster(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxSubDeformer(pManager, pInfo) {}

FbxCluster::~FbxCluster() = default;

FbxSubDeformer::EType FbxCluster::GetSubDeformerType() const { return eCluster; }

void FbxCluster::SetLink(const FbxNode* pNode) {
    if (pNode == mLink)
        return;
    while (mLink && DisconnectSrcObject(mLink)) {
    }
    if (pNode)
        ConnectSrcObject(const_cast<FbxNode*>(pNode)); // the API takes a const node; a connection changes both ends
}

void FbxCluster::SetAssociateModel(FbxNode* pNode) {
    FbxProperty property = FbxProperty::Create(this, FbxReferenceDT, kAssociateModel);
    while (FbxNode* former = property.GetSrcObject<FbxNode>())
        if (!property.DisconnectSrcObject(former))
            break;
    if (pNode)
        property.ConnectSrcObject(pNode);
}

FbxNode* FbxCluster::GetAssociateModel() const {
    const FbxProperty property = FindProperty(kAssociateModel);
    return property.IsValid() ? property.GetSrcObject<FbxNode>() : nullptr;
}

void FbxCluster::AddControlPointIndex(int pIndex, double pWeight) {
    // Surplus entries of either list are ignored.
    const int count = GetControlPointIndicesCount();
    mIndices.resizeUninitialised(count);
    mWeights.resizeUninitialised(count);
    mIndices.add(pIndex);
    mWeights.add(pWeight);
}

int FbxCluster::GetControlPointIndicesCount() const { return std::min(mIndices.count(), mWeights.count()); }

int* FbxCluster::GetControlPointIndices() const {
    return GetControlPointIndicesCount() == 0 ? nullptr : mIndices.data();
}

double* FbxCluster::GetControlPointWeights() const {
    return GetControlPointIndicesCount() == 0 ? nullptr : mWeights.data();
}

void FbxCluster::SetTransformParentMatrix(const FbxAMatrix& pMatrix) {
    mTransformParent = pMatrix;
    mTransformParentSet = true;
}

void FbxCluster::connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) {
    FbxSubDeformer::connectionChanged(pSource, pDestination, pConnected);
    if (&pDestination != this || !pSource.Is<FbxNode>())
        return;
    if (!pConnected)
        mLink = GetSrcObject<FbxNode>();
    else if (!mLink)
        mLink = static_cast<FbxNode*>(&pSource);
}

FBXSDK_NAMESPACE_END
