// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The clusters of a mesh.
#pragma once

#include <fbxsdk.h>

namespace Tarnell::Fbx::detail {

/// Calls `visit(cluster)` for every cluster of every skin.
template <class Visit>
void forEachCluster(const fbxsdk::FbxMesh& mesh, Visit&& visit) {
    const int skinCount = mesh.GetDeformerCount(fbxsdk::FbxDeformer::eSkin);
    for (int i = 0; i < skinCount; ++i) {
        auto* skin = fbxsdk::FbxCast<fbxsdk::FbxSkin>(mesh.GetDeformer(i, fbxsdk::FbxDeformer::eSkin));
        for (int j = 0; skin != nullptr && j < skin->GetClusterCount(); ++j)
            if (fbxsdk::FbxCluster* cluster = skin->GetCluster(j))
                visit(*cluster);
    }
}

} // namespace Tarnell::Fbx::detail
