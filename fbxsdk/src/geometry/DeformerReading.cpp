// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Skins, clusters and blend shape channels. A cluster in a file states the transform of the deformed geometry's node
// relative to the link; objects hold its global transform.
#include "geometry/GeometryReading.h"

#include <algorithm>
#include <array>
#include <optional>
#include <vector>

#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxSkin.h>

#include "geometry/ItemReading.h"
#include "schema/Spellings.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Sixteen numbers, the translation in the last four. The last column is ignored: the matrix is affine.
std::optional<FbxAMatrix> readMatrix(const Record& body, std::string_view name) {
    const Record* record = body.child(name);
    std::array<double, 16> numbers{};
    if (!record || !record->readNumbers(std::span<double>(numbers)))
        return std::nullopt;
    FbxAMatrix matrix;
    for (std::size_t row = 0; row < 4; ++row)
        for (std::size_t column = 0; column < 3; ++column)
            matrix[static_cast<int>(row)][static_cast<int>(column)] = numbers[4 * row + column];
    return matrix;
}

void readSkin(FbxSkin& skin, const Record& body) {
    const int type = numberOf(kSkinningTypes, body.childValue("SkinningType").toText(), skin.GetSkinningType());
    skin.SetSkinningType(static_cast<FbxSkin::EType>(type));
    skin.SetDeformAccuracy(body.childValue("Link_DeformAcuracy").toReal(skin.GetDeformAccuracy()));
    const Record* indexRecord = body.child("Indexes");
    const Record* weightRecord = body.child("BlendWeights");
    if (!indexRecord || !weightRecord)
        return;
    PlainArray<int> indices;
    PlainArray<double> weights;
    readItems(*indexRecord, indices);
    readItems(*weightRecord, weights);
    for (int i = 0; i < std::min(indices.count(), weights.count()); ++i)
        skin.AddControlPointIndex(indices[i], weights[i]);
}

void readCluster(FbxCluster& cluster, const Record& body) {
    const int mode = numberOf(kLinkModes, body.childValue("Mode").toText(), cluster.GetLinkMode());
    cluster.SetLinkMode(static_cast<FbxCluster::ELinkMode>(mode));
    const std::optional<FbxAMatrix> link = readMatrix(body, "TransformLink");
    const std::optional<FbxAMatrix> geometry = readMatrix(body, "Transform");
    const std::optional<FbxAMatrix> associate = readMatrix(body, "TransformAssociateModel");
    if (link)
        cluster.SetTransformLinkMatrix(*link);
    if (geometry)
        cluster.SetTransformMatrix(link ? *link * *geometry : *geometry);
    if (associate)
        cluster.SetTransformAssociateModelMatrix(*associate);
}

void readClusterPoints(FbxCluster& cluster, const std::shared_ptr<const Document>& document, const Record& body) {
    const Record* indices = body.child("Indexes");
    const Record* weights = body.child("Weights");
    if (!indices || !weights)
        return;
    readLate(document, *indices, cluster.indices(), LateReading::whole);
    readLate(document, *weights, cluster.weights(), LateReading::whole);
}

void readChannel(FbxBlendShapeChannel& channel, const DocumentObject& object) {
    if (const Record* record = object.body->child("FullWeights")) {
        std::vector<double> weights(record->numberCount());
        if (record->readNumbers(std::span<double>(weights)))
            channel.setFullWeights(std::move(weights));
    }
    // The property, where there is one, takes precedence.
    const Value& percent = object.body->childValue("DeformPercent");
    if (percent.isNumber() && !object.property("DeformPercent"))
        channel.DeformPercent.Set(percent.toReal());
}

} // namespace

void readDeformer(FbxObject& deformer, const std::shared_ptr<const Document>& document, const DocumentObject& object) {
    if (auto* skin = FbxCast<FbxSkin>(&deformer)) {
        readSkin(*skin, *object.body);
    } else if (auto* cluster = FbxCast<FbxCluster>(&deformer)) {
        readCluster(*cluster, *object.body);
        readClusterPoints(*cluster, document, *object.body);
    } else if (auto* channel = FbxCast<FbxBlendShapeChannel>(&deformer)) {
        readChannel(*channel, object);
    }
}

} // namespace detail
FBXSDK_NAMESPACE_END
