// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Blend shapes of files up to 7.1 are inside the geometry: they become deformers, as in later files, and
// vice versa.
#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

#include "document/Document.h"
#include "document/DocumentBuilder.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

inline constexpr std::string_view kDeformPercent = "DeformPercent";

struct InlineShape {
    std::string_view name;
    std::int64_t channel = 0; ///< the deformer that has the weight, as property kDeformPercent
};

/// Creates one blend shape of all Shape records of a geometry's body: the deformer, and a channel with one target per
/// record. A property of the geometry that is named like a shape is its weight and moves to the channel.
[[nodiscard]] std::vector<InlineShape> addInlineShapes(DocumentBuilder& builder, std::size_t geometryIndex);

/// Sets the static weight of a channel that addInlineShapes has created.
void setShapeWeight(DocumentBuilder& builder, DocumentObject& channel, std::span<const Value> weight);

/// Does so for every geometry of a 7.x document and redirects the weights' animation to the channels.
void translateInlineShapes(DocumentBuilder& builder);

/// Replaces the chain of deformers below each geometry by Shape records in the geometry, and the channels' weights by
/// properties of it. Of a channel with several targets the last one is kept, which is reached at the full weight: the
/// others cannot be stored.
void moveShapesInline(Document& document);

} // namespace detail
FBXSDK_NAMESPACE_END
