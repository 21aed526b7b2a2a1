// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Blend shapes and their channels.
#include <fbxsdk/FbxBlendShape.h>

#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxGeometry.h>
#include <fbxsdk/FbxShape.h>

#include "geometry/GeometrySource.h"
#include "geometry/SourceList.h"
#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxBlendShape, FbxDeformer, {})
FBXSDK_OBJECT_IMPLEMENT(FbxBlendShapeChannel, FbxSubDeformer, detail::kBlendShapeChannelRows)

FbxBlendShape::FbxBlendShape(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxDeformer(pManager, pInfo) {}

FbxBlendShape::~FbxBlendShape() = default;

FbxDeformer::EDeformerType FbxBlendShape::GetDeformerType() const { return eBlendShape; }

FbxGeometry* FbxBlendShape::GetGeometry() { return GetDstObject<FbxGeometry>(); }

bool FbxBlendShape::SetGeometry(FbxGeometry* pGeometry) { return detail::moveToDestination(*this, pGeometry); }

bool FbxBlendShape::AddBlendShapeChannel(FbxBlendShapeChannel* pBlendShapeChannel) {
    return detail::addSource(*this, pBlendShapeChannel);
}

FbxBlendShapeChannel* FbxBlendShape::RemoveBlendShapeChannel(FbxBlendShapeChannel* pBlendShapeChannel) {
    return detail::removeSource(*this, mChannels, pBlendShapeChannel);
}

FbxBlendShapeChannel* FbxBlendShape::GetBlendShapeChannel(int pIndex) { return detail::sourceAt(mChannels, pIndex); }

const FbxBlendShapeChannel* FbxBlendShape::GetBlendShapeChannel(int pIndex) const {
    return detail::sourceAt(mChannels, pIndex);
}

void FbxBlendShape::connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) {
    FbxDeformer::connectionChanged(pSource, pDestination, pConnected);
    if (&pDestination == this)
        detail::followConnection(mChannels, pSource, pConnected);
}

FbxBlendShapeChannel::FbxBlendShapeChannel(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxSubDeformer(pManager, pInfo), DeformPercent(detail::bindProperty<FbxDouble>(*this, "DeformPercent")) {}

FbxBlendShapeChannel::~FbxBlendShapeChannel() = default;

FbxSubDeformer::EType FbxBlendShapeChannel::GetSubDeformerType() const { return eBlendShapeChannel; }

FbxBlendShape* FbxBlendShapeChannel::GetBlendShapeDeformer() { return GetDstObject<FbxBlendShape>(); }

bool FbxBlendShapeChannel::SetBlendShapeDeformer(FbxBlendShape* pBlendShape) {
    return detail::moveToDestination(*this, pBlendShape);
}

bool FbxBlendShapeChannel::AddTargetShape(FbxShape* pShape, double pFullDeformPercent) {
    const std::size_t index = mTargets.size();
    if (!detail::addSource(*this, pShape))
        return false;
    completeFullWeights(index + 1);
    mFullWeights[index] = pFullDeformPercent;
    return true;
}

FbxShape* FbxBlendShapeChannel::RemoveTargetShape(FbxShape* pShape) {
    return detail::removeSource(*this, mTargets, pShape);
}

FbxShape* FbxBlendShapeChannel::GetTargetShape(int pIndex) { return detail::sourceAt(mTargets, pIndex); }

const FbxShape* FbxBlendShapeChannel::GetTargetShape(int pIndex) const { return detail::sourceAt(mTargets, pIndex); }

int FbxBlendShapeChannel::GetTargetShapeIndex(const FbxShape* pShape) const {
    return detail::indexOf(mTargets, pShape);
}

double* FbxBlendShapeChannel::GetTargetShapeFullWeights() {
    completeFullWeights(mTargets.size());
    return mFullWeights.empty() ? nullptr : mFullWeights.data();
}

void FbxBlendShapeChannel::SetFullWeightsCount(int pCount) {
    mFullWeights.resize(static_cast<std::size_t>(std::max(pCount, 0)));
}

void FbxBlendShapeChannel::completeFullWeights(std::size_t pCount) {
    for (std::size_t i = mFullWeights.size(); i < pCount; ++i)
        mFullWeights.push_back(100.0 * static_cast<double>(i + 1) / static_cast<double>(pCount));
}

void FbxBlendShapeChannel::connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) {
    FbxSubDeformer::connectionChanged(pSource, pDestination, pConnected);
    if (&pDestination != this)
        return;
    const int removed = detail::followConnection(mTargets, pSource, pConnected);
    if (removed >= 0 && static_cast<std::size_t>(removed) < mFullWeights.size())
        mFullWeights.erase(mFullWeights.begin() + removed);
}

FBXSDK_NAMESPACE_END
