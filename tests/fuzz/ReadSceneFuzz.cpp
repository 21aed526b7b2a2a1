// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Any bytes give a valid scene or a reason: the node tree is a tree, attributes and nodes refer to each other, the
// functions of polygons are consistent, and everything can be converted, evaluated and read.
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <span>
#include <vector>

#include <fbxsdk.h>

#include "container/Record.h"
#include "document/Document.h"
#include "io/SceneReading.h"

namespace {

using namespace fbxsdk;

/// More would only take time.
constexpr int kNodesRead = 300;
constexpr int kCornersRead = 2000;

void require(bool holds, const char* what) {
    if (!holds) {
        std::fprintf(stderr, "broken: %s\n", what);
        std::abort();
    }
}

void readCurves(FbxObject& object, FbxAnimLayer* layer) {
    for (FbxProperty property = object.GetFirstProperty(); property.IsValid();
         property = object.GetNextProperty(property)) {
        for (const char* channel : {"X", "Y", "Z"}) {
            FbxAnimCurve* curve = property.GetCurve(layer, property.GetNameAsCStr(), channel, false);
            if (curve && curve->KeyGetCount() > 0) {
                (void)curve->Evaluate(curve->KeyGetTime(curve->KeyGetCount() / 2));
                (void)curve->Evaluate(FbxTime(1000));
            }
        }
    }
}

void readMesh(FbxMesh& mesh) {
    const int points = mesh.GetControlPointsCount();
    require(points == 0 || mesh.GetControlPoints() != nullptr, "points without an array");
    int corners = 0;
    for (int p = 0; p < mesh.GetPolygonCount(); ++p) {
        require(mesh.GetPolygonVertexIndex(p) == corners, "a polygon does not start where the last one ended");
        corners += mesh.GetPolygonSize(p);
    }
    require(corners == mesh.GetPolygonVertexCount(), "polygons have other corners than the mesh");
    for (int p = 0, read = 0; p < mesh.GetPolygonCount() && read < kCornersRead; ++p) {
        for (int k = 0; k < mesh.GetPolygonSize(p); ++k, ++read) {
            FbxVector4 normal;
            (void)mesh.GetPolygonVertexNormal(p, k, normal);
            (void)mesh.GetTextureUVIndex(p, k);
            require(mesh.GetPolygonVertex(p, k) == mesh.GetPolygonVertices()[mesh.GetPolygonVertexIndex(p) + k],
                    "two ways to a corner differ");
        }
    }
    for (int i = 0; i < mesh.GetDeformerCount(FbxDeformer::eSkin); ++i) {
        auto& skin = static_cast<FbxSkin&>(*mesh.GetDeformer(i, FbxDeformer::eSkin));
        for (int c = 0; c < skin.GetClusterCount(); ++c) {
            const int count = skin.GetCluster(c)->GetControlPointIndicesCount();
            require(count == 0 || skin.GetCluster(c)->GetControlPointWeights(), "indices without weights");
        }
    }
    for (int i = 0; i < mesh.GetDeformerCount(FbxDeformer::eBlendShape); ++i) {
        auto& blend = static_cast<FbxBlendShape&>(*mesh.GetDeformer(i, FbxDeformer::eBlendShape));
        for (int c = 0; c < blend.GetBlendShapeChannelCount(); ++c) {
            FbxBlendShapeChannel* channel = blend.GetBlendShapeChannel(c);
            for (int t = 0; t < channel->GetTargetShapeCount(); ++t) {
                require(channel->GetTargetShapeFullWeights() != nullptr, "targets without full weights");
                require(channel->GetTargetShape(t)->GetControlPointsCount() == points, "a target of another size");
            }
        }
    }
}

void readNode(FbxNode& node, FbxAnimLayer* layer) {
    for (int i = 0; i < node.GetChildCount(); ++i)
        require(node.GetChild(i)->GetParent() == &node, "a child with another parent");
    for (int i = 0; i < node.GetNodeAttributeCount(); ++i) {
        FbxNodeAttribute* attribute = node.GetNodeAttributeByIndex(i);
        bool known = false;
        for (int n = 0; n < attribute->GetNodeCount(); ++n)
            known = known || attribute->GetNode(n) == &node;
        require(known, "an attribute that does not know its node");
        readCurves(*attribute, layer);
        if (auto* mesh = FbxCast<FbxMesh>(attribute))
            readMesh(*mesh);
    }
    readCurves(node, layer);
    for (const FbxLongLong ticks : {FbxLongLong{0}, FbxLongLong{46186158000}, FbxLongLong{1} << 60})
        (void)node.EvaluateGlobalTransform(FbxTime(ticks)).GetR();
}

void readScene(FbxScene& scene) {
    FbxSystemUnit(1.0).ConvertScene(&scene);
    FbxAxisSystem(FbxAxisSystem::MayaYUp).ConvertScene(&scene);
    FbxAnimStack* stack = scene.GetSrcObject<FbxAnimStack>();
    FbxAnimLayer* layer = stack ? stack->GetMember<FbxAnimLayer>() : nullptr;
    FbxTimeSpan span;
    (void)scene.GetRootNode()->GetAnimationInterval(span);
    std::vector<FbxNode*> pending{scene.GetRootNode()};
    int read = 0;
    while (!pending.empty()) {
        FbxNode* node = pending.back();
        pending.pop_back();
        require(++read <= scene.GetNodeCount(), "the tree has more nodes than the scene");
        if (read <= kNodesRead)
            readNode(*node, layer);
        for (int i = 0; i < node->GetChildCount(); ++i)
            pending.push_back(node->GetChild(i));
    }
}

struct ManagerDeleter {
    void operator()(FbxManager* manager) const { manager->Destroy(); }
};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    FbxStatus status;
    const std::span<const char> input(reinterpret_cast<const char*>(bytes), size);
    auto tree = detail::readRecords(input, "input.fbx", status);
    std::shared_ptr<const detail::Document> document;
    if (tree)
        document = detail::readDocument(std::move(tree), status);
    if (!document) {
        require(status.Error() && status.GetErrorString()[0] != '\0', "a failure without a reason");
        return 0;
    }
    const std::unique_ptr<FbxManager, ManagerDeleter> manager(FbxManager::Create());
    FbxScene* scene = FbxScene::Create(manager.get(), "");
    if (detail::readScene(document, *scene, status))
        readScene(*scene);
    else
        require(status.Error(), "a failure without a reason");
    return 0;
}
