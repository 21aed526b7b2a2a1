// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The new mesh is completed before anything is changed: what cannot be converted stays unchanged.
#include <fbxsdk/FbxGeometryConverter.h>

#include <algorithm>
#include <memory>
#include <optional>
#include <vector>

#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>

#include "geometry/GeometrySource.h"
#include "geometry/tessellation/TessellationDeformers.h"
#include "geometry/tessellation/TessellationMesh.h"
#include "geometry/tessellation/TessellationTriangles.h"
#include "scene/SceneData.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

bool isSurface(const FbxNodeAttribute& attribute) {
    const FbxNodeAttribute::EType type = attribute.GetAttributeType();
    return type == FbxNodeAttribute::eNurbs || type == FbxNodeAttribute::eNurbsSurface ||
           type == FbxNodeAttribute::ePatch;
}

FbxMesh* newMeshFor(const FbxGeometry& geometry) {
    auto* mesh = FbxMesh::Create(geometry.GetFbxManager(), geometry.GetName());
    if (FbxScene* scene = geometry.GetScene())
        mesh->ConnectDstObject(scene);
    detail::carryProperties(*mesh, geometry);
    return mesh;
}

/// A surface during its conversion: how it will be sampled, and its data.
class SurfaceConversion {
public:
    explicit SurfaceConversion(FbxGeometry& surface)
        : mSurface(surface), mNumbersPerPoint(detail::numbersPerPoint(surface)), mFewest(fewestSamples(surface)),
          mPlan(detail::planTessellation(surface, mNumbersPerPoint, mFewest)) {}

    [[nodiscard]] bool isCoarser() const { return mPlan && mPlan->coarser; }

    /// Null without samples. The mesh is empty when it may be filled later.
    [[nodiscard]] FbxMesh* convert() {
        if (!mPlan)
            return nullptr;
        std::unique_ptr<detail::TessellationGrid> grid;
        mIsLate = mPlan->certainlyFinite && mSurface.GetDeformerCount() == 0;
        if (!mIsLate)
            grid = detail::TessellationGrid::of(mSurface, mNumbersPerPoint, mFewest);
        if (!mIsLate && !grid)
            return nullptr;
        if (FbxScene* scene = mSurface.GetScene())
            scene->sceneData().samplesUsed += samplesBeyondControlPoints();
        FbxMesh* mesh = newMeshFor(mSurface);
        if (grid) {
            detail::fillMesh(*mesh, *grid);
            detail::carryMaterial(*mesh, mSurface);
            detail::carryDeformers(*mesh, mSurface, *grid);
        }
        return mesh;
    }

    /// Transfers the surface to the mesh, which fills itself when its polygons are first accessed.
    void leaveTo(FbxMesh& mesh) const {
        mSurface.data().disconnectFromSurvivors();
        auto source = std::make_shared<detail::MeshOfSurface>(mSurface, mFewest);
        mesh.setSource(
            std::make_unique<detail::GeometrySource>(detail::GeometrySource{{}, nullptr, std::move(source)}));
    }
    [[nodiscard]] bool isLate() const { return mIsLate; }

    /// Fills the mesh at once: the surface stays with its owner.
    void fill(FbxMesh& mesh) const {
        const auto grid = detail::TessellationGrid::of(mSurface, mNumbersPerPoint, mFewest);
        if (!grid)
            return;
        detail::fillMesh(mesh, *grid);
        detail::carryMaterial(mesh, mSurface);
    }

private:
    static std::int64_t fewestSamples(const FbxGeometry& surface) {
        FbxScene* scene = surface.GetScene();
        const std::int64_t left = detail::kSamplesOfAnyScene - (scene ? scene->sceneData().samplesUsed : 0);
        return std::clamp<std::int64_t>(left, 0, detail::kSamplesOfAnySurface);
    }

    [[nodiscard]] std::int64_t samplesBeyondControlPoints() const {
        const std::int64_t worth = mSurface.GetControlPointsCount() * detail::kSamplesPerControlPoint;
        return std::max<std::int64_t>(mPlan->samples - worth, 0);
    }

    FbxGeometry& mSurface;
    std::int64_t mNumbersPerPoint, mFewest;
    std::optional<detail::TessellationPlan> mPlan;
    bool mIsLate = false;
};

FbxMesh* cutIntoTriangles(FbxMesh& polygons) {
    FbxMesh* mesh = newMeshFor(polygons);
    detail::fillTriangles(*mesh, polygons);
    detail::carryDeformers(*mesh, polygons);
    return mesh;
}

std::vector<FbxNode*> nodesOf(const FbxNodeAttribute& attribute) {
    std::vector<FbxNode*> nodes;
    nodes.reserve(static_cast<std::size_t>(attribute.GetNodeCount()));
    for (int i = 0; i < attribute.GetNodeCount(); ++i)
        nodes.push_back(attribute.GetNode(i));
    return nodes;
}

/// At the index of the former one, so that the node's default attribute remains the same.
void replaceOn(FbxNode& node, FbxNodeAttribute& former, FbxNodeAttribute& mesh) {
    std::vector<FbxNodeAttribute*> attributes;
    attributes.reserve(static_cast<std::size_t>(node.GetNodeAttributeCount()));
    for (int i = 0; i < node.GetNodeAttributeCount(); ++i)
        attributes.push_back(node.GetNodeAttributeByIndex(i));
    auto place = std::find(attributes.begin(), attributes.end(), &former);
    *place = &mesh;
    node.DisconnectSrcObject(&former);
    for (auto behind = place + 1; behind != attributes.end(); ++behind)
        node.DisconnectSrcObject(*behind);
    for (; place != attributes.end(); ++place)
        node.ConnectSrcObject(*place);
}

/// False when another object needs the former one.
bool replaceEverywhere(FbxGeometry& former, FbxMesh& mesh) {
    for (FbxNode* node : nodesOf(former))
        replaceOn(*node, former, mesh);
    // A trimmed surface still needs the surface that is cut.
    if (former.GetDstObjectCount<FbxNodeAttribute>() > 0)
        return false;
    detail::destroyDeformers(former);
    return true;
}

void putBeside(const FbxGeometry& former, FbxMesh& mesh) {
    for (FbxNode* node : nodesOf(former))
        node->ConnectSrcObject(&mesh);
}

FbxMesh* triangulateSurface(FbxGeometry& surface, bool replace, int& coarser) {
    SurfaceConversion conversion(surface);
    FbxMesh* mesh = conversion.convert();
    if (!mesh)
        return nullptr;
    coarser += conversion.isCoarser() ? 1 : 0;
    const bool isFree = replace && replaceEverywhere(surface, *mesh);
    if (!replace)
        putBeside(surface, *mesh);
    if (conversion.isLate() && isFree)
        conversion.leaveTo(*mesh);
    else if (conversion.isLate())
        conversion.fill(*mesh);
    else if (isFree)
        surface.Destroy();
    return mesh;
}

FbxMesh* triangulateMesh(FbxMesh& polygons, bool replace) {
    FbxMesh* mesh = cutIntoTriangles(polygons);
    if (!replace)
        putBeside(polygons, *mesh);
    else if (replaceEverywhere(polygons, *mesh))
        polygons.Destroy();
    return mesh;
}

} // namespace

FbxNodeAttribute* FbxGeometryConverter::Triangulate(FbxNodeAttribute* pNodeAttribute, bool pReplace, bool) {
    auto* polygons = FbxCast<FbxMesh>(pNodeAttribute);
    if (polygons && polygons->IsTriangleMesh())
        return polygons;
    if (!polygons && (!pNodeAttribute || !isSurface(*pNodeAttribute)))
        return nullptr;
    return polygons ? triangulateMesh(*polygons, pReplace)
                    : triangulateSurface(static_cast<FbxGeometry&>(*pNodeAttribute), pReplace, mCoarser);
}

bool FbxGeometryConverter::Triangulate(FbxScene* pScene, bool pReplace, bool pLegacy) {
    if (!pScene)
        return false;
    std::vector<FbxNodeAttribute*> attributes;
    for (int i = 0; i < pScene->GetNodeCount(); ++i) {
        for (int j = 0; j < pScene->GetNode(i)->GetNodeAttributeCount(); ++j) {
            FbxNodeAttribute* attribute = pScene->GetNode(i)->GetNodeAttributeByIndex(j);
            if ((attribute->Is<FbxMesh>() || isSurface(*attribute)) && attribute->GetNode() == pScene->GetNode(i))
                attributes.push_back(attribute);
        }
    }
    bool all = true;
    for (FbxNodeAttribute* attribute : attributes)
        all = Triangulate(attribute, pReplace, pLegacy) && all;
    return all;
}

FBXSDK_NAMESPACE_END
