// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Target shapes. Files store them as offsets from the deformed geometry's points.
#include <fbxsdk/FbxShape.h>

#include <fbxsdk/FbxBlendShape.h>
#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxGeometry.h>

#include "geometry/GeometrySource.h"
#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxShape, FbxGeometryBase, detail::kMeshRows)

FbxShape::FbxShape(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxGeometryBase(pManager, pInfo) {}

FbxShape::~FbxShape() = default;

FbxNodeAttribute::EType FbxShape::GetAttributeType() const { return eShape; }

FbxBlendShapeChannel* FbxShape::GetBlendShapeChannel() const { return GetDstObject<FbxBlendShapeChannel>(); }

FbxGeometry* FbxShape::GetBaseGeometry() {
    FbxBlendShapeChannel* channel = GetBlendShapeChannel();
    FbxBlendShape* blendShape = channel ? channel->GetBlendShapeDeformer() : nullptr;
    return blendShape ? blendShape->GetGeometry() : nullptr;
}

FBXSDK_NAMESPACE_END
