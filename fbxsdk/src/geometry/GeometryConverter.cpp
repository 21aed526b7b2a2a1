// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The new mesh is finished before anything is touched: what cannot be converted stays as it was.
#include <fbxsdk/FbxGeometryConverter.h>

#include <algorithm>
#include <vector>

#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>

#include "geometry/TessellationDeformers.h"
#include "geometry/TessellationMesh.h"
#include "geometry/TessellationTriangles.h"

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

FbxMesh* tessellate(FbxGeometry& surface) {
    const auto grid = detail::TessellationGrid::of(surface, detail::numbersPerPoint(surface));
    if (!grid)
        return nullptr;
    FbxMesh* mesh = newMeshFor(surface);
    detail::fillMesh(*mesh, *grid);
    detail::carryMaterial(*mesh, surface);
    detail::carryDeformers(*mesh, surface, *grid);
    return mesh;
}

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

/// In the former one's place, so that the node's choice among its attributes still stands.
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

void replaceEverywhere(FbxGeometry& former, FbxMesh& mesh) {
    for (FbxNode* node : nodesOf(former))
        replaceOn(*node, former, mesh);
    // A trimmed surface still needs what it is cut from.
    if (former.GetDstObjectCount<FbxNodeAttribute>() > 0)
        return;
    detail::destroyDeformers(former);
    former.Destroy();
}

} // namespace

FbxNodeAttribute* FbxGeometryConverter::Triangulate(FbxNodeAttribute* pNodeAttribute, bool pReplace, bool) {
    auto* polygons = FbxCast<FbxMesh>(pNodeAttribute);
    if (polygons && polygons->IsTriangleMesh())
        return polygons;
    if (!polygons && (!pNodeAttribute || !isSurface(*pNodeAttribute)))
        return nullptr;
    auto& geometry = static_cast<FbxGeometry&>(*pNodeAttribute);
    FbxMesh* mesh = polygons ? cutIntoTriangles(*polygons) : tessellate(geometry);
    if (!mesh)
        return nullptr;
    if (pReplace) {
        replaceEverywhere(geometry, *mesh);
    } else {
        for (FbxNode* node : nodesOf(geometry))
            node->ConnectSrcObject(mesh);
    }
    return mesh;
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
