// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Undeformed and cached points are in the mesh's own space, skinned ones in the node's, where the geometric
// transform is already applied.
#include "MeshPoints.h"

#include <memory>
#include <span>

namespace conformance {

using namespace fbxsdk;

namespace {

std::vector<Point> transformed(const FbxAMatrix& matrix, std::span<const FbxVector4> points) {
    std::vector<Point> result;
    result.reserve(points.size());
    for (const FbxVector4& point : points) {
        const FbxVector4 moved = matrix.MultT(point);
        result.push_back({moved[0], moved[1], moved[2]});
    }
    return result;
}

bool hasActiveCache(FbxMesh& mesh) {
    auto* cache = FbxCast<FbxVertexCacheDeformer>(mesh.GetDeformer(0, FbxDeformer::eVertexCache));
    return cache != nullptr && cache->Active.Get();
}

} // namespace

bool isDeformed(FbxMesh& mesh) {
    return mesh.GetDeformerCount(FbxDeformer::eSkin) > 0 || mesh.GetDeformerCount(FbxDeformer::eVertexCache) > 0;
}

bool hasBlendShapes(FbxMesh& mesh) { return mesh.GetDeformerCount(FbxDeformer::eBlendShape) > 0; }

std::vector<Point> worldPoints(LoadedFile& file, FbxNode& node, FbxMesh& mesh, FbxTime time) {
    FbxAMatrix world = worldMatrix(node, time);
    const auto count = static_cast<std::size_t>(mesh.GetControlPointsCount());
    if (!file.sdk().getDeformation(&mesh))
        return transformed(world * geometricMatrix(node), {mesh.GetControlPoints(), count});
    FbxVector4* deformed = nullptr;
    file.sdk().getDeformedControlPoints(&node, &mesh, time, world, &deformed);
    const std::unique_ptr<FbxVector4[]> owner(deformed);
    if (deformed == nullptr)
        return {};
    return transformed(hasActiveCache(mesh) ? world * geometricMatrix(node) : world, {deformed, count});
}

} // namespace conformance
