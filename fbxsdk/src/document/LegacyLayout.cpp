// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Who holds whom, from the document's connections.
#include "document/LegacyLayout.h"

#include <algorithm>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Kinds that exist as parts of takes only.
constexpr std::string_view kAnimationRecords[] = {"AnimationStack", "AnimationLayer", "AnimationCurveNode",
                                                  "AnimationCurve"};

bool isAnimation(const WritableObject& object) {
    return std::find(std::begin(kAnimationRecords), std::end(kAnimationRecords), object.record) !=
           std::end(kAnimationRecords);
}

/// Curves and surfaces have records of their own; attributes and meshes stand inside their Models.
bool standsInModel(const WritableObject& object) {
    return object.record == "NodeAttribute" || (object.record == "Geometry" && object.subClass == "Mesh");
}

bool betweenObjects(const DocumentConnection& connection) {
    return connection.sourceProperty.empty() && connection.destinationProperty.empty();
}

} // namespace

LegacyLayout::LegacyLayout(const WritableDocument& document) : mDocument(document), mNames(document.objects) {
    for (const WritableObject& object : document.objects)
        mObjects.emplace(object.id, &object);
    findAttributes();
}

const WritableObject* LegacyLayout::find(std::int64_t id) const {
    const auto found = mObjects.find(id);
    return found == mObjects.end() ? nullptr : found->second;
}

void LegacyLayout::findAttributes() {
    for (const DocumentConnection& connection : mDocument.connections) {
        const WritableObject* attribute = find(connection.source);
        const WritableObject* model = find(connection.destination);
        const bool holds =
            betweenObjects(connection) && attribute && model && model->record == "Model" && standsInModel(*attribute);
        // Of several attributes the first one stands in the Model.
        if (holds && mAttributes.emplace(model->id, attribute).second)
            mHolders[attribute->id].push_back(model->id);
    }
}

const WritableObject* LegacyLayout::attributeOf(std::int64_t model) const {
    const auto found = mAttributes.find(model);
    return found == mAttributes.end() ? nullptr : found->second;
}

const std::vector<std::int64_t>& LegacyLayout::holdersOf(std::int64_t attribute) const {
    static const std::vector<std::int64_t> kNone;
    const auto found = mHolders.find(attribute);
    return found == mHolders.end() ? kNone : found->second;
}

bool LegacyLayout::standsAlone(const WritableObject& object) const {
    return !isAnimation(object) && holdersOf(object.id).empty();
}

std::int64_t LegacyLayout::baseLayerOf(std::string_view stack) const {
    for (const DocumentConnection& connection : mDocument.connections) {
        const WritableObject* destination = find(connection.destination);
        const WritableObject* source = find(connection.source);
        if (destination && destination->record == "AnimationStack" && destination->name == stack && source &&
            source->record == "AnimationLayer")
            return source->id;
    }
    return 0;
}

LegacyLayout::Driven LegacyLayout::drivenBy(std::string_view stack) const {
    const std::int64_t layer = baseLayerOf(stack);
    std::unordered_map<std::int64_t, DrivenProperty> nodes; // of the layer
    if (layer == 0)
        return {};
    for (const DocumentConnection& connection : mDocument.connections) {
        const WritableObject* node = find(connection.source);
        if (connection.destination == layer && node && node->record == "AnimationCurveNode")
            nodes[node->id].node = node;
    }
    for (const DocumentConnection& connection : mDocument.connections) {
        const WritableObject* curve = find(connection.source);
        if (const auto node = nodes.find(connection.destination);
            node != nodes.end() && curve && curve->record == "AnimationCurve")
            node->second.curves.emplace(connection.destinationProperty, curve);
    }
    std::unordered_map<std::int64_t, std::vector<DrivenProperty>> byObject;
    for (const DocumentConnection& connection : mDocument.connections) {
        const auto node = nodes.find(connection.source);
        if (node == nodes.end() || connection.destinationProperty.empty())
            continue;
        DrivenProperty driven = node->second;
        driven.property = connection.destinationProperty;
        byObject[connection.destination].push_back(std::move(driven));
    }
    Driven result;
    for (const WritableObject& object : mDocument.objects) {
        if (const auto found = byObject.find(object.id); found != byObject.end() && !isAnimation(object))
            result.emplace_back(object.id, std::move(found->second));
    }
    return result;
}

} // namespace detail
FBXSDK_NAMESPACE_END
