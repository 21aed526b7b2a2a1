// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A take lists the objects that it animates, as channels within channels:
//
//     Model: "Model::x" { Channel: "Transform" { Channel: "T" { Channel: "X" { Default Key … } … } … } Channel: "Roll"
//     … }
#include "document/legacy/LegacyLayout.h"

#include <algorithm>
#include <array>
#include <set>

#include "document/DocumentSections.h"
#include "document/PropertyNames.h"
#include "document/RecordWriting.h"
#include "document/WrittenLines.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

struct TransformRow {
    std::string_view property, channel;
    std::int32_t layerType;
};
constexpr TransformRow kTransformRows[] = {
    {"Lcl Translation", "T", 1}, {"Lcl Rotation", "R", 2}, {"Lcl Scaling", "S", 3}};

constexpr std::array<std::string_view, 4> kAxes{"X", "Y", "Z", "W"};
constexpr std::string_view kPrefix = "d|";

bool isTransform(std::string_view property) {
    return std::any_of(
        std::begin(kTransformRows), std::end(kTransformRows),
        [&](const TransformRow& row) { return row.property == property; });
}

class TakeWriter {
public:
    TakeWriter(const LegacyLayout& layout, const VersionTraits& traits, RecordSink& sink)
        : mLayout(layout), mTraits(traits), mSink(sink) {}

    void write(const DocumentTake& take) {
        const BlockScope block(mSink, "Take", take.name);
        writeTakeTimes(take, mSink);
        const LegacyLayout::Driven driven = mLayout.drivenBy(take.name);
        for (const std::int64_t model : modelsOf(driven))
            writeModel(*mLayout.find(model), driven);
        for (const auto& [id, properties] : driven)
            writeOther(id, properties);
    }

private:
    /// The Models that are animated, or contain an attribute that is.
    [[nodiscard]] std::set<std::int64_t> modelsOf(const LegacyLayout::Driven& driven) const {
        std::set<std::int64_t> models;
        for (const auto& [id, properties] : driven) {
            if (mLayout.find(id)->record == "Model")
                models.insert(id);
            const std::span<const std::int64_t> holders = mLayout.holdersOf(id);
            models.insert(holders.begin(), holders.end());
        }
        return models;
    }

    static const std::vector<DrivenProperty>* propertiesOf(const LegacyLayout::Driven& driven, std::int64_t id) {
        const auto found =
            std::lower_bound(driven.begin(), driven.end(), id,
                             [](const auto& entry, std::int64_t wanted) { return entry.first < wanted; });
        return found != driven.end() && found->first == id ? &found->second : nullptr;
    }

    /// A Model's channels are its own and those of the attribute in it.
    void writeModel(const DocumentObject& model, const LegacyLayout::Driven& driven) {
        const DocumentObject* attribute = mLayout.attributeOf(model.id);
        const std::vector<DrivenProperty>* own = propertiesOf(driven, model.id);
        const std::vector<DrivenProperty>* inner = attribute ? propertiesOf(driven, attribute->id) : nullptr;
        if (!own && !inner)
            return;
        beginObject("Model", model.id);
        if (own) {
            writeTransform(model, *own);
            writeChannels(*own, {});
        }
        if (inner)
            writeChannels(*inner, attribute->subClass);
        mSink.endRecord();
    }

    void writeOther(std::int64_t id, const std::vector<DrivenProperty>& properties) {
        const DocumentObject& object = *mLayout.find(id);
        if (object.record == "Model" || !mLayout.standsAlone(object))
            return;
        beginObject(object.record, id);
        writeChannels(properties, object.subClass);
        mSink.endRecord();
    }

    void beginObject(std::string_view record, std::int64_t id) {
        const LegacyName name = mLayout.nameOf(id);
        mSink.beginRecord(record);
        mSink.objectName(name.nameClass, name.name);
        mSink.beginBlock();
        writeReal(mSink, "Version", 1.1);
    }

    /// All three parts of the transform, whichever of them are animated.
    void writeTransform(const DocumentObject& model, const std::vector<DrivenProperty>& properties) {
        const bool moves = std::any_of(properties.begin(), properties.end(),
                                       [](const DrivenProperty& driven) { return isTransform(driven.property); });
        if (!moves)
            return;
        const BlockScope block(mSink, "Channel", std::string_view("Transform"));
        for (const TransformRow& row : kTransformRows) {
            const BlockScope part(mSink, "Channel", row.channel);
            const auto driven = std::find_if(properties.begin(), properties.end(),
                                             [&](const DrivenProperty& each) { return each.property == row.property; });
            if (driven != properties.end())
                writeComponents(*driven);
            else
                writeStatic(model, row.property);
            writeInteger(mSink, "LayerType", row.layerType);
        }
    }

    void writeStatic(const DocumentObject& model, std::string_view property) {
        mLines.fill(model);
        const WrittenLine* const line = mLines.find(property);
        for (std::size_t i = 0; line && i < std::min(line->property->values.size(), kAxes.size()); ++i) {
            const BlockScope block(mSink, "Channel", kAxes[i]);
            writeReal(mSink, "Default", line->property->values[i].toReal());
            writeColor();
        }
    }

    void writeChannels(const std::vector<DrivenProperty>& properties, std::string_view subClass) {
        for (const DrivenProperty& driven : properties) {
            if (isTransform(driven.property))
                continue;
            const BlockScope block(mSink, "Channel", legacyPropertyName(subClass, driven.property));
            mLines.fill(*driven.node);
            if (mLines.all().size() == 1)
                writeKeys(driven, mLines.all().front());
            else
                writeComponents(driven);
        }
    }

    void writeComponents(const DrivenProperty& driven) {
        mLines.fill(*driven.node);
        for (const WrittenLine& component : mLines.all()) {
            const BlockScope block(mSink, "Channel", component.property->name.substr(kPrefix.size()));
            writeKeys(driven, component);
        }
    }

    void writeKeys(const DrivenProperty& driven, const WrittenLine& component) {
        const auto found = driven.curves.find(component.property->name);
        const double value = component.value().toReal();
        const auto write = [&](const CurveKeys& keys) { writeLegacyCurve(mSink, mTraits, keys, value); };
        if (found != driven.curves.end())
            found->second->content->curve(mTraits, write);
        else
            write({});
        writeColor();
    }

    /// Of the curve in editors.
    void writeColor() { writeReals(mSink, "Color", {1, 1, 1}); }

    const LegacyLayout& mLayout;
    const VersionTraits& mTraits;
    RecordSink& mSink;
    WrittenLines mLines; ///< of the curve node or Model that is being written
};

} // namespace

void writeLegacyTakes(const LegacyLayout& layout, const VersionTraits& traits, RecordSink& sink) {
    sink.heading("Takes and animation section");
    const BlockScope block(sink, "Takes");
    writeText(sink, "Current", layout.document().activeStackName);
    for (const DocumentTake& take : layout.document().takes)
        TakeWriter(layout, traits, sink).write(take);
}

} // namespace detail
FBXSDK_NAMESPACE_END
