// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes: their points in the space of their node, and a point cache where those are animated.
#include "Decomposition.h"
#include "PlacementWriting.h"
#include "Writing.h"
#include "access/MeshBuilding.h"
#include "access/PointCacheWriting.h"
#include "access/WriteChecks.h"
#include "calls/LastError.h"
#include "model/FrameArithmetic.h"

#include "TnFbxError.h"

#include <algorithm>
#include <optional>
#include <string>
#include <vector>

namespace Tarnell::Fbx::faithful {

namespace {

using fbxsdk::FbxAMatrix;
using fbxsdk::FbxVector4;

constexpr const char* kTooManyCorners = "left out: the polygons have more polygon vertices than the mesh";
constexpr const char* kFlat = "its points were multiplied by a transform that has no inverse: they are written as they "
                              "are, without the transform";
constexpr const char* kNoCache =
    "its control points are animated, but no point cache was requested: only the first set is written";
constexpr const char* kOtherSets =
    "it does not have one set of control points per frame of the range: only the first set is written";

float asFloat(double value) { return static_cast<float>(value); }

/// The frames of point caches.
TnFbxTime cacheRange(const WrittenScene& scene) {
    const TnFbxWriteInfo& info = scene.info();
    TnFbxTime range;
    range.setTime(info.getStartFrame(), detail::truncateToInt(info.getStartFrame()),
                  detail::truncateToInt(info.getEndFrame()), static_cast<float>(scene.rate()));
    return range;
}

/// Reverses each polygon, starting at the same corner.
void reversePolygons(const TnFbxMesh& source, TnFbxMesh& mesh) {
    int start = 0;
    for (int polygon = 0; polygon < source.getNumberOfPolygons(); ++polygon) {
        const int size = std::max(source.getPolygonVertexSize(polygon), 0);
        for (int i = 1; i < size; ++i) {
            const int to = start + i, from = start + size - i;
            mesh.setPointIndex(to, source.getPointIndex(from));
            float x = 0.0f, y = 0.0f, z = 0.0f, w = 0.0f;
            source.getNormal(from, x, y, z);
            mesh.setNormal(to, x, y, z);
            source.getUV(from, x, y);
            mesh.setUV(to, x, y);
            source.getColour(from, x, y, z, w);
            mesh.setColour(to, x, y, z, w);
        }
        start += size;
    }
}

void transformPoints(TnFbxMesh& mesh, int set, const FbxAMatrix& matrix) {
    const int count = mesh.getNumberOfControlPoints();
    for (int i = set * count; i < (set + 1) * count; ++i) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        mesh.getControlPoint(i, x, y, z);
        const FbxVector4 point =
            matrix.MultT(FbxVector4(static_cast<double>(x), static_cast<double>(y), static_cast<double>(z)));
        mesh.setControlPoint(i, asFloat(point[0]), asFloat(point[1]), asFloat(point[2]));
    }
}

void transformNormals(TnFbxMesh& mesh, const FbxAMatrix& matrix) {
    for (int corner = 0; corner < mesh.getNumberOfPolygonVertices(); ++corner) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        mesh.getNormal(corner, x, y, z);
        const FbxVector4 normal = transformedNormal(
            matrix, FbxVector4(static_cast<double>(x), static_cast<double>(y), static_cast<double>(z)));
        mesh.setNormal(corner, asFloat(normal[0]), asFloat(normal[1]), asFloat(normal[2]));
    }
}

/// A mesh whose points are already transformed, with its points in its own space again; nothing where the
/// transform is singular.
std::optional<TnFbxMesh> unplaced(WrittenScene& scene, const TnFbxMesh& source) {
    TnFbxMesh mesh(source);
    const FbxAMatrix place = staticMatrixOf(source);
    const double hand = handedness(place);
    const FrameRange frames{cacheRange(scene).getStartFrame(), cacheRange(scene).getEndFrame(), scene.rate()};
    if (hand == 0.0)
        return std::nullopt;
    transformPoints(mesh, 0, place.Inverse());
    for (int set = 1; set < source.getNumberOfControlPointSets(); ++set) {
        const FbxAMatrix there = matrixAt(scene.keys(), mesh, frames.first + set, frames);
        if (handedness(there) == 0.0)
            return std::nullopt;
        transformPoints(mesh, set, there.Inverse());
    }
    if (hand < 0.0)
        reversePolygons(source, mesh);
    transformNormals(mesh, place.Inverse());
    return mesh;
}

/// Removes the mesh's cache again.
void dropCache(fbxsdk::FbxNode& node) {
    fbxsdk::FbxCache* cache = detail::pointCacheOf(node);
    if (fbxsdk::FbxVertexCacheDeformer* deformer = detail::pointCacheDeformerOf(node))
        deformer->Destroy();
    if (cache != nullptr)
        cache->Destroy();
}

bool writeCache(WrittenScene& scene, const TnFbxMesh& mesh, fbxsdk::FbxNode& node) {
    const TnFbxWriteInfo& info = scene.info();
    const bool maya = info.getMayaVertexCacheFormat();
    const bool wide = info.getCompatibilityVersion() >= TnFbxWriteInfo::kFbxVersion2016;
    const std::string name = scene.cacheNameFor(mesh.getName());
    const auto place = detail::pointCachePlace(info.getFileName(), name.c_str(), maya ? ".xml" : ".pc2");
    if (!detail::attachPointCache(scene.manager(), *node.GetGeometry(), place, name.c_str(), maya,
                                  /*withScene*/ true))
        return false;
    const TnFbxTime range = cacheRange(scene);
    const detail::PointCacheForm form = {name.c_str(), maya, wide, scene.rate()};
    fbxsdk::FbxStatus status;
    fbxsdk::FbxCache& cache = *detail::pointCacheOf(node);
    if (!detail::openPointCache(cache, mesh, range, form, status))
        return detail::fail(status.GetErrorString());
    detail::writePointSamples(cache, mesh, range, form); // only closing reports whether it worked
    return cache.CloseFile(&status) || detail::fail(status.GetErrorString());
}

void addCache(WrittenScene& scene, const TnFbxMesh& mesh, fbxsdk::FbxNode& node) {
    if (mesh.getNumberOfControlPointSets() < 2)
        return;
    if (!scene.info().getAnimateMeshVertices()) {
        scene.warnings().add(mesh.getName(), kNoCache);
    } else if (detail::pointCacheFault(mesh, cacheRange(scene)) != nullptr) {
        scene.warnings().add(mesh.getName(), kOtherSets);
    } else if (!writeCache(scene, mesh, node)) {
        detail::warn(mesh.getName() + ": written without its animation: " + lastError());
        dropCache(node);
    }
}

void addGeometry(WrittenScene& scene, const TnFbxMesh& mesh, fbxsdk::FbxNode& node) {
    auto& target = scene.add<fbxsdk::FbxMesh>(node);
    node.SetShadingMode(fbxsdk::FbxNode::eTextureShading);
    detail::buildMesh(mesh, target);
    addCache(scene, mesh, node);
}

/// Meshes that share all their arrays are one, on several nodes; each point cache has a mesh of its own. `mesh` must
/// be valid as long as the scene.
void addShared(WrittenScene& scene, const TnFbxMesh& mesh, fbxsdk::FbxNode& node) {
    if (mesh.getNumberOfControlPointSets() > 1) {
        addGeometry(scene, mesh, node);
        return;
    }
    fbxsdk::FbxMesh*& shared = scene.meshFor(detail::MeshArrays::identityOf(mesh));
    if (shared != nullptr) {
        node.SetNodeAttribute(shared);
        node.SetShadingMode(fbxsdk::FbxNode::eTextureShading);
    } else {
        addGeometry(scene, mesh, node);
        shared = node.GetMesh();
    }
}

} // namespace

void addObject(WrittenScene& scene, TnFbxMesh& source) {
    detail::ObjectWarnings& warnings = scene.warnings();
    if (detail::claimsTooManyCorners(source)) {
        warnings.add(source.getName(), kTooManyCorners);
        return;
    }
    detail::check(source, warnings);
    if (!source.getPointsPlaced()) {
        addShared(scene, source, addPlacedNode(scene, source, kSameAxes));
        return;
    }
    if (const std::optional<TnFbxMesh> mesh = unplaced(scene, source)) {
        addGeometry(scene, *mesh, addPlacedNode(scene, source, kSameAxes));
    } else {
        warnings.add(source.getName(), kFlat);
        addGeometry(scene, source, scene.addNode(source.getName()));
    }
}

} // namespace Tarnell::Fbx::faithful
