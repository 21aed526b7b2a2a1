// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Which object contains which, from the document's connections.
#include "document/legacy/LegacyLayout.h"
#include "schema/SubClasses.h"

#include <algorithm>
#include <iterator>
#include <map>
#include <set>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Kinds that exist only as parts of takes.
constexpr std::string_view kAnimationRecords[] = {"AnimationStack", "AnimationLayer", "AnimationCurveNode",
                                                  "AnimationCurve"};

bool isAnimation(const DocumentObject& object) {
    return std::find(std::begin(kAnimationRecords), std::end(kAnimationRecords), object.record) !=
           std::end(kAnimationRecords);
}

/// Curves and surfaces have records of their own; attributes and meshes are inside their Models.
bool standsInModel(const DocumentObject& object) {
    return object.record == "NodeAttribute" || (object.record == "Geometry" && object.subClass == SubClass::kMesh);
}

bool betweenObjects(const DocumentConnection& connection) {
    return connection.sourceProperty.empty() && connection.destinationProperty.empty();
}

} // namespace

LegacyLayout::LegacyLayout(const Document& document) : mDocument(document), mNames(document.objects) {
    for (const DocumentObject& object : document.objects)
        mObjects.at(object.id) = &object;
    findAttributes();
    findAnimation();
}

const DocumentObject* LegacyLayout::find(std::int64_t id) const { return mObjects[id]; }

void LegacyLayout::findAttributes() {
    std::vector<std::pair<std::int64_t, std::int64_t>> holders; // attribute and Model
    for (const DocumentConnection& connection : mDocument.connections) {
        const DocumentObject* attribute = find(connection.source);
        const DocumentObject* model = find(connection.destination);
        const bool holds =
            betweenObjects(connection) && attribute && model && model->record == "Model" && standsInModel(*attribute);
        // Of several attributes the first one is in the Model.
        if (!holds || attributeOf(model->id))
            continue;
        mAttributes.at(model->id) = attribute;
        holders.emplace_back(attribute->id, model->id);
    }
    std::stable_sort(holders.begin(), holders.end(), [](const auto& a, const auto& b) { return a.first < b.first; });
    mHolders.reserve(holders.size()); // the spans stay valid
    for (const auto& [attribute, model] : holders) {
        mHolders.push_back(model);
        std::span<const std::int64_t>& models = mHoldersOf.at(attribute);
        models = models.empty() ? std::span(&mHolders.back(), 1) : std::span(models.data(), models.size() + 1);
    }
}

const DocumentObject* LegacyLayout::attributeOf(std::int64_t model) const { return mAttributes[model]; }

std::span<const std::int64_t> LegacyLayout::holdersOf(std::int64_t attribute) const { return mHoldersOf[attribute]; }

bool LegacyLayout::standsAlone(const DocumentObject& object) const {
    return !isAnimation(object) && holdersOf(object.id).empty();
}

void LegacyLayout::findAnimation() {
    for (const DocumentConnection& connection : mDocument.connections) {
        const DocumentObject* source = find(connection.source);
        const DocumentObject* destination = find(connection.destination);
        if (!source)
            continue;
        if (source->record == "AnimationLayer" && destination && destination->record == "AnimationStack")
            mBaseLayers.emplace(destination->name, source->id);
        if (source->record == "AnimationCurve")
            mCurves[connection.destination].emplace(connection.destinationProperty, source);
        if (source->record != "AnimationCurveNode")
            continue;
        mMembers[connection.destination].push_back(source->id);
        if (!connection.destinationProperty.empty() && destination && !isAnimation(*destination))
            mDriving[source->id].push_back(&connection);
    }
}

LegacyLayout::Driven LegacyLayout::drivenBy(std::string_view stack) const {
    const auto layer = mBaseLayers.find(stack);
    const auto members = layer == mBaseLayers.end() ? mMembers.end() : mMembers.find(layer->second);
    if (members == mMembers.end())
        return {};
    std::set<const DocumentConnection*> connections; // in their order
    for (const std::int64_t node : members->second)
        if (const auto driving = mDriving.find(node); driving != mDriving.end())
            connections.insert(driving->second.begin(), driving->second.end());
    std::map<std::int64_t, std::vector<DrivenProperty>> byObject;
    for (const DocumentConnection* connection : connections) {
        DrivenProperty driven{connection->destinationProperty, find(connection->source), {}};
        if (const auto curves = mCurves.find(connection->source); curves != mCurves.end())
            driven.curves = curves->second;
        byObject[connection->destination].push_back(std::move(driven));
    }
    return {std::make_move_iterator(byObject.begin()), std::make_move_iterator(byObject.end())};
}

} // namespace detail
FBXSDK_NAMESPACE_END
