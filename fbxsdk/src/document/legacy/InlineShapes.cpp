// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Converts Shape records inside a geometry to a chain of deformers.
#include "document/legacy/InlineShapes.h"
#include "schema/SubClasses.h"

#include <map>
#include <unordered_map>
#include <unordered_set>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// The properties of the geometry that are weights, by the name of their shape.
class Weights {
public:
    Weights(DocumentBuilder& builder, std::size_t geometryIndex) : mBuilder(builder), mGeometryIndex(geometryIndex) {
        for (const DocumentProperty& property : properties())
            if (!property.values.empty())
                mValues.insert_or_assign(property.name, property.values.first(1));
    }

    /// 0 when the shape has none.
    [[nodiscard]] std::span<const Value> of(std::string_view shapeName) const {
        const auto found = mValues.find(shapeName);
        return found == mValues.end() ? mBuilder.keep({Value::ofReal(0)}) : found->second;
    }

    void removeFromGeometry(std::span<const InlineShape> shapes) {
        std::unordered_set<std::string_view> names;
        for (const InlineShape& shape : shapes)
            names.insert(shape.name);
        std::erase_if(properties(), [&](const DocumentProperty& property) { return names.contains(property.name); });
    }

private:
    [[nodiscard]] std::vector<DocumentProperty>& properties() {
        return mBuilder.document().objects[mGeometryIndex].properties;
    }

    DocumentBuilder& mBuilder;
    std::size_t mGeometryIndex;
    std::unordered_map<std::string_view, std::span<const Value>> mValues;
};

const Record& channelBody(DocumentBuilder& builder, std::span<const Value> weight) {
    Record& body = builder.newRecord("Deformer");
    ChildAppender children(body);
    children.add(builder.newRecord("Version", builder.keep({Value::ofInteger(100)})));
    children.add(builder.newRecord(kDeformPercent, weight));
    children.add(builder.newRecord("FullWeights", builder.keep({Value::ofReal(100)})));
    return body;
}

InlineShape addChannel(DocumentBuilder& builder, std::int64_t blendShape, const Record& shape, const Weights& weights) {
    const std::string_view name = nameWithoutClass(shape.value(0).toText(), builder.tree().ascii);
    const std::span<const Value> weight = weights.of(name);
    const std::int64_t channel = builder.newId();
    setShapeWeight(builder, builder.addObject(channel, "Deformer", SubClass::kBlendShapeChannel, name), weight);
    const std::int64_t target = builder.newId();
    builder.addObject(target, "Geometry", SubClass::kShape, name, &shape);
    builder.connect(channel, blendShape);
    builder.connect(target, channel);
    return {name, channel};
}

/// The channels of weights that were properties, by the geometry and the property's name.
using MovedWeights = std::map<std::pair<std::int64_t, std::string_view>, std::int64_t>;

/// The connection of a curve node to the geometry's property is redirected to the channel's; and since the node's
/// component is named after the property, the node's own property and its connections change as well.
class AnimationMover {
public:
    AnimationMover(Document& document, const MovedWeights& moved) : mDocument(document), mMoved(moved) {}

    void move() {
        for (DocumentConnection& connection : mDocument.connections)
            moveToChannel(connection);
        if (mOldNames.empty())
            return;
        for (DocumentObject& object : mDocument.objects)
            renameComponent(object);
        for (DocumentConnection& connection : mDocument.connections)
            if (namesOldComponent(connection.destination, connection.destinationProperty))
                connection.destinationProperty = kComponent;
    }

private:
    static constexpr std::string_view kPrefix = "d|";
    static constexpr std::string_view kComponent = "d|DeformPercent";

    void moveToChannel(DocumentConnection& connection) {
        if (connection.destinationProperty.empty())
            return;
        const auto found = mMoved.find({connection.destination, connection.destinationProperty});
        if (found == mMoved.end())
            return;
        mOldNames.emplace(connection.source, connection.destinationProperty);
        connection.destination = found->second;
        connection.destinationProperty = kDeformPercent;
    }

    [[nodiscard]] bool namesOldComponent(std::int64_t node, std::string_view property) const {
        const auto found = mOldNames.find(node);
        return found != mOldNames.end() && property.starts_with(kPrefix) &&
               property.substr(kPrefix.size()) == found->second;
    }

    void renameComponent(DocumentObject& object) const {
        if (object.record != "AnimationCurveNode" || !mOldNames.contains(object.id))
            return;
        object.name = kDeformPercent;
        for (DocumentProperty& property : object.properties)
            if (namesOldComponent(object.id, property.name))
                property.name = kComponent;
    }

    Document& mDocument;
    const MovedWeights& mMoved;
    std::unordered_map<std::int64_t, std::string_view> mOldNames; ///< of the shape, by curve node
};

} // namespace

std::vector<InlineShape> addInlineShapes(DocumentBuilder& builder, std::size_t geometryIndex) {
    std::vector<InlineShape> shapes;
    const Record& body = *builder.document().objects[geometryIndex].body;
    const std::int64_t geometry = builder.document().objects[geometryIndex].id;
    std::int64_t blendShape = 0;
    Weights weights(builder, geometryIndex);
    for (const Record& shape : body.children()) {
        if (shape.name != "Shape" || !shape.hasBlock)
            continue;
        if (blendShape == 0) {
            blendShape = builder.newId();
            builder.addObject(blendShape, "Deformer", SubClass::kBlendShape, "");
            builder.connect(blendShape, geometry);
        }
        shapes.push_back(addChannel(builder, blendShape, shape, weights));
    }
    weights.removeFromGeometry(shapes);
    return shapes;
}

void setShapeWeight(DocumentBuilder& builder, DocumentObject& channel, std::span<const Value> weight) {
    channel.body = &channelBody(builder, weight);
    channel.properties.assign({propertyOf(kDeformPercent, "Number", "", "A", weight)});
}

void translateInlineShapes(DocumentBuilder& builder) {
    MovedWeights moved;
    const std::size_t objectCount = builder.document().objects.size();
    for (std::size_t i = 0; i < objectCount; ++i) {
        const DocumentObject& object = builder.document().objects[i];
        if (!object.body->child("Shape") || object.record != "Geometry" || object.subClass == SubClass::kShape)
            continue;
        const std::int64_t geometry = object.id;
        for (const InlineShape& shape : addInlineShapes(builder, i))
            moved.emplace(std::pair(geometry, shape.name), shape.channel);
    }
    if (moved.empty())
        return;
    AnimationMover(builder.document(), moved).move();
    builder.indexObjects();
}

} // namespace detail
FBXSDK_NAMESPACE_END
