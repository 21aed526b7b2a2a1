// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Channels of old takes, and the equivalent objects of 7.x.
#include "document/legacy/LegacyTakes.h"

#include <algorithm>
#include <cmath>
#include <optional>
#include <set>

#include "document/PropertyNames.h"
#include "document/TakeTimes.h"
#include "document/legacy/LegacyKeys.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr std::string_view kLayerName = "BaseLayer";

struct TransformRow {
    std::string_view channel, property;
};
constexpr TransformRow kTransformRows[] = {{"T", "Lcl Translation"}, {"R", "Lcl Rotation"}, {"S", "Lcl Scaling"}};

struct AxisRow {
    std::string_view channel, label;
};
constexpr AxisRow kAxes[] = {{"X", "d|X"}, {"Y", "d|Y"}, {"Z", "d|Z"}};

/// Follows the name of a shape in the channels of 5.x files.
constexpr std::string_view kShapeSuffix = " (Shape)";

const Record* channelNamed(const Record& parent, std::string_view name) {
    for (const Record& child : parent.children())
        if (child.name == "Channel" && child.value(0).toText() == name)
            return &child;
    return nullptr;
}

std::vector<ChannelComponent> axesOf(const Record& channel) {
    std::vector<ChannelComponent> components;
    for (std::size_t axis = 0; axis < std::size(kAxes); ++axis)
        if (const Record* record = channelNamed(channel, kAxes[axis].channel))
            components.push_back({kAxes[axis].label, axis, record});
    return components;
}

/// Finds the owner of the property that a channel drives: a shape's weight, the attribute's or the object's own.
LegacyChannel ownedChannel(LegacyObjects& objects, std::int64_t object, std::string_view name) {
    const LegacyModel* parts = objects.findModel(object);
    const bool suffixed = name.ends_with(kShapeSuffix);
    const std::string_view shapeName = suffixed ? name.substr(0, name.size() - kShapeSuffix.size()) : name;
    if (!parts || parts->attribute == 0)
        return {object, name, name, 1, {}};
    if (const auto shape = parts->shapeChannels.find(shapeName); shape != parts->shapeChannels.end())
        return {shape->second, kDeformPercent, kDeformPercent, 1, {}};
    const std::string_view present = modernPropertyName(objects.at(parts->attribute).subClass, name);
    const bool own = isModelProperty(name) || objects.property(object, name);
    if (!own || objects.property(parts->attribute, present))
        return {parts->attribute, present, present, 1, {}};
    return {object, name, name, 1, {}};
}

/// Before 5.8 a visibility is in percent.
bool hasPercentVisibility(const Document& document) { return document.version < 5800; }

void addTransform(std::int64_t object, const Record& transform, std::vector<LegacyChannel>& channels) {
    for (const TransformRow& row : kTransformRows)
        if (const Record* channel = channelNamed(transform, row.channel))
            channels.push_back({object, row.property, row.channel, 1, axesOf(*channel)});
}

void addNamed(LegacyObjects& objects, std::int64_t object, const Record& record, std::vector<LegacyChannel>& channels) {
    const std::string_view name = record.value(0).toText();
    if (name.empty())
        return;
    LegacyChannel channel = ownedChannel(objects, object, name);
    channel.components = axesOf(record);
    if (channel.components.empty()) {
        std::string label("d|");
        label += channel.property;
        channel.components.push_back({objects.builder().tree().keepText(std::move(label)), 0, &record});
    }
    if (channel.property == "Visibility" && hasPercentVisibility(objects.builder().document()))
        channel.scale = 0.01;
    channels.push_back(std::move(channel));
}

/// One take during its conversion.
class TakeReader {
public:
    TakeReader(LegacyObjects& objects, std::int64_t layer)
        : mObjects(objects), mBuilder(objects.builder()), mLayer(layer) {}

    void read(const Record& take) {
        for (const Record& record : take.children())
            if (const std::int64_t object = objectOf(record); object != 0)
                for (const LegacyChannel& channel : readChannels(mObjects, object, record))
                    readChannel(channel);
    }

private:
    /// A Model and a material may have the same name in files that do not write the class into it.
    [[nodiscard]] std::int64_t objectOf(const Record& record) {
        const std::int64_t object = record.hasBlock ? mObjects.find(record.value(0).toText()) : 0;
        const bool fits = object != 0 && (record.name == "Model") == (mObjects.at(object).record == "Model");
        return fits ? object : 0;
    }

    void readChannel(const LegacyChannel& channel) {
        std::vector<std::optional<CurveKeys>> curves;
        bool keyed = false;
        for (const ChannelComponent& component : channel.components) {
            curves.push_back(readLegacyCurve(mBuilder, *component.record, channel.scale));
            keyed = keyed || curves.back();
        }
        // A channel without keys is dropped unless it differs from the object's own value.
        if (channel.components.empty() || (!keyed && isStatic(channel)))
            return;
        if (!mDriven.emplace(channel.owner, channel.property).second)
            return;
        addNode(channel, curves);
    }

    [[nodiscard]] bool isStatic(const LegacyChannel& channel) {
        const DocumentProperty* property = mObjects.property(channel.owner, channel.property);
        return !property || std::all_of(channel.components.begin(), channel.components.end(),
                                        [&](const ChannelComponent& component) {
                                            return isStatic(channel, component, property->values);
                                        });
    }
    [[nodiscard]] static bool isStatic(const LegacyChannel& channel, const ChannelComponent& component,
                                       std::span<const Value> values) {
        if (component.axis >= values.size() || !component.record->child("Default"))
            return true;
        constexpr double kTolerance = 1e-6; // takes and properties are written in different precision
        const double value = values[component.axis].toReal();
        return std::abs(value - componentDefault(channel, component)) <= kTolerance * std::max(1.0, std::abs(value));
    }

    void addNode(const LegacyChannel& channel, std::vector<std::optional<CurveKeys>>& curves) {
        const std::int64_t node = mBuilder.newId();
        DocumentObject& object = mBuilder.addObject(node, "AnimationCurveNode", "", channel.nodeName);
        for (const ChannelComponent& component : channel.components)
            object.properties.push_back(
                propertyOf(component.label, "Number", "", "A",
                           mBuilder.keep({Value::ofReal(componentDefault(channel, component))})));
        mBuilder.connect(node, mLayer);
        mBuilder.connect(node, channel.owner, channel.property);
        for (std::size_t i = 0; i < curves.size(); ++i)
            if (curves[i])
                addCurve(node, channel.components[i].label, std::move(*curves[i]));
    }

    void addCurve(std::int64_t node, std::string_view label, CurveKeys curve) {
        const std::int64_t id = mBuilder.newId();
        DocumentObject& object = mBuilder.addObject(id, "AnimationCurve", "", "");
        object.legacyCurve = static_cast<int>(mBuilder.document().legacyCurves.size());
        mBuilder.document().legacyCurves.push_back(std::move(curve));
        mBuilder.connect(id, node, label);
    }

    LegacyObjects& mObjects;
    DocumentBuilder& mBuilder;
    std::int64_t mLayer;
    std::set<std::pair<std::int64_t, std::string_view>> mDriven;
};

void readTake(LegacyObjects& objects, const Record& record, const DocumentTake& take) {
    DocumentBuilder& builder = objects.builder();
    const std::int64_t stack = builder.newId();
    addTakeTimes(builder, take, builder.addObject(stack, "AnimationStack", "", take.name).properties);
    const std::int64_t layer = builder.newId();
    builder.addObject(layer, "AnimationLayer", "", kLayerName);
    builder.connect(layer, stack);
    TakeReader(objects, layer).read(record);
}

} // namespace

std::vector<LegacyChannel> readChannels(LegacyObjects& objects, std::int64_t object, const Record& record) {
    std::vector<LegacyChannel> channels;
    bool hasTransform = false;
    for (const Record& child : record.children()) {
        if (child.name != "Channel")
            continue;
        if (child.value(0).toText() != "Transform")
            addNamed(objects, object, child, channels);
        else if (!hasTransform) // damaged files nest or repeat it; the outermost first one is used
            addTransform(object, child, channels);
        hasTransform = hasTransform || child.value(0).toText() == "Transform";
    }
    return channels;
}

double componentDefault(const LegacyChannel& channel, const ChannelComponent& component) {
    const Record* record = component.record->child("Default");
    if (record)
        return record->value(0).toReal() * channel.scale;
    const Record* keys = component.record->child("Key"); // the first key's value
    return keys ? keys->value(1).toReal() * channel.scale : 0;
}

void readTakes(LegacyObjects& objects) {
    for (const Record& takes : objects.builder().root().children()) {
        if (takes.name != "Takes")
            continue;
        std::size_t next = objects.builder().document().takes.size();
        readTakeTimes(objects.builder(), takes);
        for (const Record& record : takes.children())
            if (record.name == "Take") {
                const DocumentTake take = objects.builder().document().takes[next++];
                readTake(objects, record, take);
            }
    }
}

} // namespace detail
FBXSDK_NAMESPACE_END
