// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deformers of a geometry.
#include <fbxsdk/FbxGeometry.h>

#include <fbxsdk/FbxBlendShape.h>
#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxSkin.h>
#include <fbxsdk/FbxVertexCacheDeformer.h>

#include "geometry/GeometrySource.h"
#include "geometry/SourceList.h"
#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_ABSTRACT_IMPLEMENT(FbxGeometry, FbxGeometryBase)

namespace {

template <class T>
T* withStatus(T* found, FbxStatus* status) {
    if (!status)
        return found;
    if (found)
        status->Clear();
    else
        status->SetCode(FbxStatus::eIndexOutOfRange);
    return found;
}

/// Null for an invalid type.
const FbxClassId* classOf(FbxDeformer::EDeformerType type) {
    switch (type) {
    case FbxDeformer::eSkin:
        return &FbxSkin::ClassId;
    case FbxDeformer::eBlendShape:
        return &FbxBlendShape::ClassId;
    case FbxDeformer::eVertexCache:
        return &FbxVertexCacheDeformer::ClassId;
    case FbxDeformer::eUnknown:
        break;
    }
    return nullptr;
}

} // namespace

FbxGeometry::FbxGeometry(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxGeometryBase(pManager, pInfo) {}

FbxGeometry::~FbxGeometry() = default;

int FbxGeometry::AddDeformer(FbxDeformer* pDeformer) {
    if (!pDeformer)
        return -1;
    detail::addSource(*this, pDeformer);
    return detail::indexOf(mDeformers, pDeformer);
}

FbxDeformer* FbxGeometry::RemoveDeformer(int pIndex, FbxStatus* pStatus) {
    return detail::removeSource(*this, mDeformers, GetDeformer(pIndex, pStatus));
}

FbxDeformer* FbxGeometry::GetDeformer(int pIndex, FbxStatus* pStatus) const {
    return withStatus(detail::sourceAt(mDeformers, pIndex), pStatus);
}

// Deformers are sources of the geometry, which lists those of a class.

int FbxGeometry::GetDeformerCount(FbxDeformer::EDeformerType pType) const {
    const FbxClassId* id = classOf(pType);
    return id ? GetSrcObjectCount(FbxCriteria::ObjectType(*id)) : 0;
}

FbxDeformer* FbxGeometry::GetDeformer(int pIndex, FbxDeformer::EDeformerType pType, FbxStatus* pStatus) const {
    const FbxClassId* id = classOf(pType);
    FbxObject* found = id ? GetSrcObject(FbxCriteria::ObjectType(*id), pIndex) : nullptr;
    return withStatus(static_cast<FbxDeformer*>(found), pStatus);
}

int FbxGeometry::GetShapeCount() const {
    int count = 0;
    for (FbxDeformer* deformer : mDeformers) {
        auto* blendShape = FbxCast<FbxBlendShape>(deformer);
        for (int i = 0; blendShape && i < blendShape->GetBlendShapeChannelCount(); ++i)
            count += blendShape->GetBlendShapeChannel(i)->GetTargetShapeCount();
    }
    return count;
}

FbxAnimCurve* FbxGeometry::GetShapeChannel(int pBlendShapeIndex, int pBlendShapeChannelIndex, FbxAnimLayer* pLayer,
                                           bool pCreateAsNeeded, FbxStatus* pStatus) {
    auto* blendShape = static_cast<FbxBlendShape*>(GetDeformer(pBlendShapeIndex, FbxDeformer::eBlendShape, pStatus));
    if (!blendShape)
        return nullptr;
    FbxBlendShapeChannel* channel = withStatus(blendShape->GetBlendShapeChannel(pBlendShapeChannelIndex), pStatus);
    return channel ? channel->DeformPercent.GetCurve(pLayer, pCreateAsNeeded) : nullptr;
}

void FbxGeometry::connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) {
    FbxGeometryBase::connectionChanged(pSource, pDestination, pConnected);
    if (&pDestination == this)
        detail::followConnection(mDeformers, pSource, pConnected);
}

FbxGeometry* FbxNode::GetGeometry() { return FbxCast<FbxGeometry>(GetNodeAttribute()); }

FBXSDK_NAMESPACE_END
