// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Skins, clusters and blend shape channels. A cluster's file says where the deformed geometry's node stood as seen from
// the link; objects say where it stood in the world.
#include "geometry/DeformerReading.h"

#include <algorithm>
#include <array>
#include <optional>
#include <string_view>
#include <vector>

#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxSkin.h>

#include "geometry/ItemReading.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

template <class Enum>
struct Spelling {
    std::string_view text;
    Enum value;
};

constexpr Spelling<FbxSkin::EType> kSkinningTypes[] = {
    {"Rigid", FbxSkin::eRigid},
    {"Linear", FbxSkin::eLinear},
    {"DualQuaternion", FbxSkin::eDualQuaternion},
    {"Blend", FbxSkin::eBlend},
};

constexpr Spelling<FbxCluster::ELinkMode> kLinkModes[] = {
    {"Normalize", FbxCluster::eNormalize},
    {"Additive", FbxCluster::eAdditive},
    {"Total1", FbxCluster::eTotalOne},
};

template <class Enum, std::size_t N>
std::optional<Enum> findSpelling(const Spelling<Enum> (&spellings)[N], std::string_view text) {
    const auto* found = std::find_if(std::begin(spellings), std::end(spellings),
                                     [text](const Spelling<Enum>& spelling) { return spelling.text == text; });
    return found == std::end(spellings) ? std::nullopt : std::optional(found->value);
}

/// Sixteen numbers, the translation in the last four. What the last column says is not believed: the matrix is affine.
std::optional<FbxAMatrix> readMatrix(const Record& body, std::string_view name) {
    const Record* record = body.child(name);
    std::array<double, 16> numbers{};
    if (!record || !record->readNumbers(std::span<double>(numbers)))
        return std::nullopt;
    FbxAMatrix matrix;
    for (std::size_t row = 0; row < 4; ++row) {
        for (std::size_t column = 0; column < 3; ++column)
            matrix[static_cast<int>(row)][static_cast<int>(column)] = numbers[4 * row + column];
    }
    return matrix;
}

void readSkin(FbxSkin& skin, const Record& body) {
    if (const auto type = findSpelling(kSkinningTypes, body.childValue("SkinningType").toText()))
        skin.SetSkinningType(*type);
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
    if (const auto mode = findSpelling(kLinkModes, body.childValue("Mode").toText()))
        cluster.SetLinkMode(*mode);
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

void readChannel(FbxBlendShapeChannel& channel, const DocumentObject& object) {
    if (const Record* record = object.body->child("FullWeights")) {
        std::vector<double> weights(record->numberCount());
        if (record->readNumbers(std::span<double>(weights)))
            channel.setFullWeights(std::move(weights));
    }
    // The property, where there is one, is the newer truth.
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
        cluster->setSource(std::make_unique<GeometrySource>(GeometrySource{document, object.body}));
    } else if (auto* channel = FbxCast<FbxBlendShapeChannel>(&deformer)) {
        readChannel(*channel, object);
    }
}

void readClusterPoints(const Record& body, PlainArray<int>& indices, PlainArray<double>& weights) {
    const Record* indexRecord = body.child("Indexes");
    const Record* weightRecord = body.child("Weights");
    if (!indexRecord || !weightRecord)
        return;
    readItems(*indexRecord, indices);
    readItems(*weightRecord, weights);
    const int count = std::min(indices.count(), weights.count());
    indices.resizeUninitialised(count);
    weights.resizeUninitialised(count);
}

} // namespace detail
FBXSDK_NAMESPACE_END
