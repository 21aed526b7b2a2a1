// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Skins, clusters, blend shapes and cache deformers: the inverse of DeformerReading.
#include <string_view>
#include <vector>

#include <fbxsdk/FbxBlendShape.h>
#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxSkin.h>
#include <fbxsdk/FbxVertexCacheDeformer.h>

#include "document/RecordWriting.h"
#include "geometry/GeometryWriting.h"
#include "schema/Spellings.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

void writeSkin(const FbxSkin& skin, const VersionTraits& traits, RecordSink& sink) {
    writeReal(sink, "Link_DeformAcuracy", skin.GetDeformAccuracy());
    if (traits.skinningType)
        writeText(sink, "SkinningType", spellingOf(kSkinningTypes, skin.GetSkinningType(), FbxSkin::eLinear));
    if (const auto count = static_cast<std::size_t>(skin.GetControlPointIndicesCount())) {
        writeArray<std::int32_t>(sink, "Indexes", {skin.GetControlPointIndices(), count});
        writeArray<double>(sink, "BlendWeights", {skin.GetControlPointBlendWeights(), count});
    }
}

void writeMatrix(RecordSink& sink, std::string_view name, const FbxAMatrix& matrix) {
    double numbers[16];
    for (int i = 0; i < 16; ++i)
        numbers[i] = matrix[i / 4][i % 4];
    writeArray<double>(sink, name, numbers);
}

/// An absent record means normalising.
void writeLinkMode(RecordSink& sink, FbxCluster::ELinkMode mode) {
    if (mode != FbxCluster::eNormalize)
        writeText(sink, "Mode", spellingOf(kLinkModes, mode, FbxCluster::eNormalize));
}

void writePoints(RecordSink& sink, const FbxCluster& cluster) {
    const auto count = static_cast<std::size_t>(cluster.GetControlPointIndicesCount());
    if (count == 0)
        return;
    writeArray<std::int32_t>(sink, "Indexes", {cluster.GetControlPointIndices(), count});
    writeArray<double>(sink, "Weights", {cluster.GetControlPointWeights(), count});
}

/// Files state the transform of the deformed geometry relative to the link.
void writeCluster(const FbxCluster& cluster, RecordSink& sink) {
    FbxAMatrix transform, link, associate;
    cluster.GetTransformMatrix(transform);
    cluster.GetTransformLinkMatrix(link);
    cluster.GetTransformAssociateModelMatrix(associate);
    writeTexts(sink, "UserData", {"", ""});
    writePoints(sink, cluster);
    writeMatrix(sink, "Transform", link.Inverse() * transform);
    writeMatrix(sink, "TransformLink", link);
    if (cluster.GetAssociateModel() || !associate.IsIdentity())
        writeMatrix(sink, "TransformAssociateModel", associate);
    writeLinkMode(sink, cluster.GetLinkMode());
}

void writeChannel(FbxBlendShapeChannel& channel, RecordSink& sink) {
    const auto count = static_cast<std::size_t>(channel.GetTargetShapeCount());
    writeReal(sink, "DeformPercent", channel.DeformPercent.Get());
    writeArray<double>(sink, "FullWeights", {channel.GetTargetShapeFullWeights(), count});
}

} // namespace

void writeDeformerVersion(const FbxObject& deformer, const VersionTraits& traits, RecordSink& sink) {
    constexpr int kVersion = 100;
    writeInteger(sink, "Version", deformer.Is<FbxSkin>() ? traits.skinVersion : kVersion);
}

void writeDeformerRecords(FbxObject& deformer, const VersionTraits& traits, RecordSink& sink) {
    if (const auto* skin = FbxCast<FbxSkin>(&deformer))
        writeSkin(*skin, traits, sink);
    else if (const auto* cluster = FbxCast<FbxCluster>(&deformer))
        writeCluster(*cluster, sink);
    else if (auto* channel = FbxCast<FbxBlendShapeChannel>(&deformer))
        writeChannel(*channel, sink);
}

} // namespace detail
FBXSDK_NAMESPACE_END
