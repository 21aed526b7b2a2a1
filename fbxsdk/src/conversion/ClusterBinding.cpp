// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// All three matrices of a cluster are transformed: the skinning formula contains inverse(link) times mesh, in which the
// common factor cancels.
#include "conversion/ClusterBinding.h"

#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxScene.h>

#include "object/SceneMembers.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

void transformBindMatrices(FbxScene& scene, const FbxAMatrix& transform) {
    for (FbxCluster* cluster : sourcesOf<FbxCluster>(scene)) {
        FbxAMatrix matrix;
        cluster->SetTransformMatrix(transform * cluster->GetTransformMatrix(matrix));
        cluster->SetTransformLinkMatrix(transform * cluster->GetTransformLinkMatrix(matrix));
        cluster->SetTransformAssociateModelMatrix(transform * cluster->GetTransformAssociateModelMatrix(matrix));
    }
}

} // namespace detail
FBXSDK_NAMESPACE_END
