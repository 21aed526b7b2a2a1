// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Directly from the definitions (docs/kept-behaviours.md), without regard to speed.
#include "KeptPoints.h"

#include <cmath>
#include <map>

namespace conformance {

using namespace fbxsdk;

namespace {

/// Adds the effect of one curve of a channel to the points.
void addTargets(FbxBlendShapeChannel& channel, double weight, const std::vector<Point>& base,
                std::vector<Point>& points) {
    const int targets = channel.GetTargetShapeCount();
    const double* fullWeights = channel.GetTargetShapeFullWeights();
    for (int step = 0; step < targets; ++step) {
        int target = weight > 0 && weight < fullWeights[0] ? 0 : -1;
        if (step + 1 < targets && fullWeights[step] < weight && weight < fullWeights[step + 1])
            target = step + 1;
        if (target < 0)
            continue;
        FbxShape& shape = *channel.GetTargetShape(target);
        for (std::size_t i = 0; i < points.size(); ++i) {
            const FbxVector4 end = shape.GetControlPointAt(static_cast<int>(i));
            for (std::size_t axis = 0; axis < base[i].size(); ++axis)
                points[i][axis] += (end[static_cast<int>(axis)] - base[i][axis]) * weight;
        }
    }
}

bool isByCorner(const FbxLayerElement& element) {
    return element.GetMappingMode() == FbxLayerElement::eByControlPoint ||
           element.GetMappingMode() == FbxLayerElement::eByPolygonVertex;
}

bool givesColours(FbxLayer& layer, FbxMesh& mesh) {
    if (FbxLayerElementVertexColor* colours = layer.GetVertexColors())
        return isByCorner(*colours);
    FbxLayerElementMaterial* materials = layer.GetMaterials();
    const FbxNode* node = mesh.GetNode();
    return materials && node && node->GetMaterialCount() > 0 &&
           (isByCorner(*materials) || materials->GetMappingMode() == FbxLayerElement::eByPolygon);
}

} // namespace

std::set<int> skinnedPoints(FbxMesh& mesh) {
    std::map<int, double> weights;
    for (int s = 0; s < mesh.GetDeformerCount(FbxDeformer::eSkin); ++s) {
        auto* skin = FbxCast<FbxSkin>(mesh.GetDeformer(s, FbxDeformer::eSkin));
        for (int c = 0; c < skin->GetClusterCount(); ++c) {
            FbxCluster* cluster = skin->GetCluster(c);
            for (int i = 0; cluster->GetLink() && i < cluster->GetControlPointIndicesCount(); ++i)
                weights[cluster->GetControlPointIndices()[i]] += cluster->GetControlPointWeights()[i];
        }
    }
    constexpr double kNoWeight = 1e-5;
    std::set<int> result;
    for (const auto& [point, weight] : weights)
        if (std::abs(weight) > kNoWeight)
            result.insert(point);
    return result;
}

std::vector<Point> blendedPoints(FbxMesh& mesh, const FbxAnimStack* stack, const FbxTime& time) {
    std::vector<Point> base;
    for (int i = 0; i < mesh.GetControlPointsCount(); ++i) {
        const FbxVector4 point = mesh.GetControlPointAt(i);
        base.push_back({point[0], point[1], point[2]});
    }
    std::vector<Point> points = base;
    const FbxCriteria layers = FbxCriteria::ObjectType(FbxAnimLayer::ClassId);
    for (int b = 0; b < mesh.GetDeformerCount(FbxDeformer::eBlendShape); ++b) {
        auto* blendShape = FbxCast<FbxBlendShape>(mesh.GetDeformer(b, FbxDeformer::eBlendShape));
        for (int c = 0; c < blendShape->GetBlendShapeChannelCount(); ++c) {
            for (int i = 0; stack && i < stack->GetSrcObjectCount(layers); ++i) {
                auto* layer = FbxCast<FbxAnimLayer>(stack->GetSrcObject(layers, i));
                if (FbxAnimCurve* curve = mesh.GetShapeChannel(b, c, layer, false))
                    addTargets(*blendShape->GetBlendShapeChannel(c), static_cast<double>(curve->Evaluate(time)), base,
                               points);
            }
        }
    }
    return points;
}

CornerContent readContent(FbxMesh& mesh, const CornerContent& has) {
    CornerContent read;
    FbxLayer* first = mesh.GetLayer(0);
    read.normals = has.normals && first && first->GetNormals() && isByCorner(*first->GetNormals());
    read.uvs = has.uvs && first && first->GetUVs() && isByCorner(*first->GetUVs());
    for (int i = 0; i < mesh.GetLayerCount(); ++i)
        read.colours = read.colours || givesColours(*mesh.GetLayer(i), mesh);
    return read;
}

} // namespace conformance
