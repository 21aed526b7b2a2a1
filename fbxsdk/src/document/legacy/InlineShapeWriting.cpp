// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Converts a chain of deformers to Shape records inside a geometry.

#include <algorithm>
#include <set>
#include <string>
#include <unordered_map>
#include <unordered_set>
#include <utility>

#include "document/DocumentSections.h"
#include "document/legacy/InlineShapes.h"
#include "schema/SubClasses.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr std::string_view kPrefix = "d|";

bool isKind(const DocumentObject& object, std::string_view record, std::string_view subClass) {
    return object.record == record && object.subClass == subClass;
}

/// A Shape record: its name and what writes its content.
struct ShapeRecord {
    std::string_view name;
    WriteRecords content;
};

class ShapeMover {
public:
    explicit ShapeMover(Document& document) : mDocument(document) {
        for (std::size_t i = 0; i < document.objects.size(); ++i)
            mIndex.emplace(document.objects[i].id, i);
        for (const DocumentConnection& connection : document.connections)
            if (connection.sourceProperty.empty() && connection.destinationProperty.empty())
                mSources[connection.destination].push_back(connection.source);
    }

    void move() {
        for (DocumentObject& object : mDocument.objects)
            if (object.record == "Geometry" && object.subClass != SubClass::kShape)
                moveInto(object);
        if (mRemoved.empty())
            return;
        moveAnimation();
        removeMoved();
    }

private:
    struct Weight {
        std::int64_t geometry = 0;
        std::string_view name;
    };

    [[nodiscard]] DocumentObject* find(std::int64_t id) {
        const auto found = mIndex.find(id);
        return found == mIndex.end() ? nullptr : &mDocument.objects[found->second];
    }
    [[nodiscard]] std::vector<DocumentObject*> sourcesOf(std::int64_t id, std::string_view record,
                                                         std::string_view subClass) {
        std::vector<DocumentObject*> sources;
        for (const std::int64_t source : mSources[id]) {
            DocumentObject* object = find(source);
            if (object && isKind(*object, record, subClass))
                sources.push_back(object);
        }
        return sources;
    }

    void moveInto(DocumentObject& geometry) {
        const std::vector<DocumentObject*> blendShapes = sourcesOf(geometry.id, "Deformer", SubClass::kBlendShape);
        if (blendShapes.empty())
            return;
        mDocument.settleProperties(geometry);
        std::vector<ShapeRecord> shapes;
        std::set<std::string, std::less<>> names;
        for (const DocumentProperty& property : geometry.properties)
            names.emplace(property.name);
        for (const DocumentObject* blendShape : blendShapes) {
            mRemoved.insert(blendShape->id);
            for (DocumentObject* channel : sourcesOf(blendShape->id, "Deformer", SubClass::kBlendShapeChannel))
                moveChannel(geometry, *channel, names, shapes);
        }
        if (!shapes.empty())
            appendShapes(geometry, std::move(shapes));
    }

    void moveChannel(DocumentObject& geometry, DocumentObject& channel, std::set<std::string, std::less<>>& names,
                     std::vector<ShapeRecord>& shapes) {
        mRemoved.insert(channel.id);
        const std::vector<DocumentObject*> targets = sourcesOf(channel.id, "Geometry", SubClass::kShape);
        for (const DocumentObject* target : targets)
            mRemoved.insert(target->id);
        if (targets.empty())
            return;
        const std::string_view wanted = !targets.back()->name.empty() ? targets.back()->name : channel.name;
        const std::string_view name = mDocument.tree->keepText(uniqueName(wanted, names));
        shapes.push_back({name, targets.back()->content->after});
        addWeight(geometry, channel, name);
        mWeights.emplace(channel.id, Weight{geometry.id, name});
    }

    static std::string uniqueName(std::string_view wanted, std::set<std::string, std::less<>>& names) {
        const std::string base(wanted.empty() ? "Shape" : wanted);
        std::string name = base;
        for (int i = 2; !names.insert(name).second; ++i)
            name = base + '_' + std::to_string(i);
        return name;
    }

    void addWeight(DocumentObject& geometry, DocumentObject& channel, std::string_view name) {
        mDocument.settleProperties(channel);
        const DocumentProperty* percent = findProperty(channel.properties, kDeformPercent);
        DocumentProperty weight{name, "Number", "", "A", {}};
        if (percent) {
            weight.flags = percent->flags;
            weight.values = percent->values;
        } else {
            weight.values = mDocument.keep({Value::ofReal(0)});
        }
        geometry.properties.push_back(weight);
    }

    static void appendShapes(DocumentObject& geometry, std::vector<ShapeRecord> shapes) {
        geometry.content->after = [before = std::move(geometry.content->after),
                                   shapes = std::move(shapes)](RecordSink& sink, const VersionTraits& traits) {
            before(sink, traits);
            for (const ShapeRecord& shape : shapes) {
                sink.beginRecord("Shape");
                sink.text(shape.name);
                sink.beginBlock();
                shape.content(sink, traits);
                sink.endRecord();
            }
        };
    }

    /// The curve node of a weight now drives the geometry's property, and is named after it.
    void moveAnimation() {
        std::unordered_map<std::int64_t, std::string_view> nodes; ///< the component's new name
        for (DocumentConnection& connection : mDocument.connections) {
            const auto weight = mWeights.find(connection.destination);
            if (weight == mWeights.end() || connection.destinationProperty != kDeformPercent)
                continue;
            connection.destination = weight->second.geometry;
            connection.destinationProperty = weight->second.name;
            renameNode(connection.source, weight->second.name, nodes);
        }
        for (DocumentConnection& connection : mDocument.connections) {
            const auto node = nodes.find(connection.destination);
            if (node != nodes.end() && connection.destinationProperty.starts_with(kPrefix))
                connection.destinationProperty = node->second;
        }
    }

    void renameNode(std::int64_t id, std::string_view name, std::unordered_map<std::int64_t, std::string_view>& nodes) {
        DocumentObject* node = find(id);
        if (!node || node->record != "AnimationCurveNode")
            return;
        mDocument.settleProperties(*node);
        if (node->properties.size() != 1)
            return;
        node->name = name;
        node->properties.front().name = mDocument.tree->keepText(std::string(kPrefix) + std::string(name));
        nodes.emplace(id, node->properties.front().name);
    }

    void removeMoved() {
        std::erase_if(
            mDocument.objects, [&](const DocumentObject& object) { return mRemoved.contains(object.id); });
        std::erase_if(mDocument.connections, [&](const DocumentConnection& connection) {
            return mRemoved.contains(connection.source) || mRemoved.contains(connection.destination);
        });
    }

    Document& mDocument;
    std::unordered_map<std::int64_t, std::size_t> mIndex;
    std::unordered_map<std::int64_t, std::vector<std::int64_t>> mSources;
    std::unordered_set<std::int64_t> mRemoved;
    std::unordered_map<std::int64_t, Weight> mWeights; ///< by channel
};

} // namespace

void moveShapesInline(Document& document) {
    const bool hasShapes =
        std::any_of(document.objects.begin(), document.objects.end(),
                    [](const DocumentObject& each) { return isKind(each, "Deformer", SubClass::kBlendShape); });
    if (hasShapes)
        ShapeMover(document).move();
}

} // namespace detail
FBXSDK_NAMESPACE_END
