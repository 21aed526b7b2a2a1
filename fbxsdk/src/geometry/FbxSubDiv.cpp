// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Subdivision surfaces.
#include <fbxsdk/FbxSubDiv.h>

#include <fbxsdk/FbxMesh.h>

#include "geometry/GeometrySource.h"
#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxSubDiv, FbxGeometry, detail::kMeshRows)

FbxSubDiv::FbxSubDiv(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxGeometry(pManager, pInfo) {}

FbxSubDiv::~FbxSubDiv() = default;

FbxNodeAttribute::EType FbxSubDiv::GetAttributeType() const { return eSubDiv; }

bool FbxSubDiv::SetBaseMesh(FbxMesh* pMesh) {
    if (FbxMesh* former = GetBaseMesh())
        DisconnectSrcObject(former);
    return pMesh && ConnectSrcObject(pMesh);
}

FbxMesh* FbxSubDiv::GetBaseMesh() const { return GetSrcObject<FbxMesh>(); }

FBXSDK_NAMESPACE_END
