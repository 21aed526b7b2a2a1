// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The inverse of PropertyReading. The flag that a property may be animated changes the spelling of its type: files use
// "Number" for animatable types where others are "double".
#include "io/SceneWriting.h"

#include <algorithm>
#include <string>

#include <fbxsdk/FbxAnimCurveNode.h>

#include "scene/IdleCurveNode.h"
#include "schema/PropertyFlags.h"
#include "schema/PropertyTypes.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// The two type strings of a type that is not animatable, and the one of its animatable form.
constexpr struct {
    std::string_view fixed, fixedSubType, animatable;
} kSpellings[] = {{"double", "Number", "Number"}, {"Vector3D", "Vector", "Vector"}, {"ColorRGB", "Color", "Color"},
                  {"bool", "", "Bool"},           {"int", "Integer", "Integer"},    {"enum", "", "Enum"}};

/// Spells the type according to the flag. Other types have one spelling for both.
void spellType(DocumentProperty& property, bool animatable) {
    for (const auto& row : kSpellings) {
        if (animatable && property.typeName == row.fixed && property.subTypeName == row.fixedSubType) {
            property.typeName = row.animatable;
            property.subTypeName = {};
            return;
        }
        if (!animatable && property.typeName == row.animatable && property.subTypeName.empty()) {
            property.typeName = row.fixed;
            property.subTypeName = row.fixedSubType;
            return;
        }
    }
}

const FbxAnimCurveNode* curveNodeOf(const ConnectionPoint& source) {
    return source.property < 0 ? FbxCast<FbxAnimCurveNode>(source.object) : nullptr;
}

bool isAnimated(const PropertyData& property) {
    return std::any_of(
        property.plug.sources.begin(), property.plug.sources.end(),
        [](const ConnectionPoint* source) {
            const FbxAnimCurveNode* node = curveNodeOf(*source);
            return node && !isIdle(*node);
        });
}

/// Whether the file has connections to or from the property.
bool isConnected(const PropertyData& property) {
    const auto isWritten = [](const ConnectionPoint* source) {
        const FbxAnimCurveNode* node = curveNodeOf(*source);
        return !node || !isIdle(*node);
    };
    return !property.plug.destinations.empty() ||
           std::any_of(property.plug.sources.begin(), property.plug.sources.end(), isWritten);
}

/// Whether curves drive a property is determined by its connections, not by the flags of a file.
unsigned flagsWith(unsigned flags, bool animated) {
    constexpr unsigned kAnimated = FbxPropertyFlags::eAnimatable | FbxPropertyFlags::eAnimated;
    return animated ? flags | kAnimated : flags & ~static_cast<unsigned>(FbxPropertyFlags::eAnimated);
}

std::span<const Value> valuesOf(const FbxDataType& type, const PropertyValue& value, RecordTree& texts) {
    switch (type.GetType()) {
    case eFbxUndefined:
    case eFbxReference:
    case eFbxBlob:
        return {};
    case eFbxString:
    case eFbxDateTime:
        return keepValue(texts, Value::ofText(texts.keepText(value.text)));
    case eFbxFloat:
    case eFbxDouble:
    case eFbxDouble2:
    case eFbxDouble3:
    case eFbxDouble4:
    case eFbxHalfFloat:
    case eFbxDistance: {
        const std::span<Value> kept = texts.newValues(componentCount(type.GetType()));
        std::transform(value.numbers.begin(), value.numbers.begin() + static_cast<std::ptrdiff_t>(kept.size()),
                       kept.begin(), Value::ofReal);
        return kept;
    }
    default:
        return keepValue(texts, Value::ofInteger(value.integer));
    }
}

DocumentProperty line(std::string_view name, const FbxDataType& type, const PropertyValue& value, std::string flags,
                      RecordTree& texts) {
    return {name, type.info()->typeName, type.info()->subTypeName, texts.keepText(std::move(flags)),
            valuesOf(type, value, texts)};
}

DocumentProperty defaultLine(const PropertyRow& row, RecordTree& texts) {
    return line(row.name, *row.type, defaultValue(row), row.flags, texts);
}

DocumentProperty writableLine(const PropertyData& data, RecordTree& texts) {
    const bool animated = isAnimated(data);
    DocumentProperty property = line(data.row ? std::string_view(data.row->name) : std::string_view(data.name),
                                     data.type, data.value, propertyFlagText(flagsWith(data.flags, animated)), texts);
    spellType(property, animated || (data.flags & FbxPropertyFlags::eAnimatable) != 0);
    return property;
}

bool sameValue(const PropertyValue& a, const PropertyValue& b, EFbxType type) {
    if (type == eFbxString || type == eFbxDateTime)
        return a.text == b.text;
    return a.numbers == b.numbers && a.integer == b.integer;
}

/// Connections count too: a reference holds nothing but its connection.
bool isChanged(const PropertyData& data) {
    if (!data.row || isConnected(data))
        return true;
    constexpr unsigned kWritten = ~static_cast<unsigned>(FbxPropertyFlags::eImported | FbxPropertyFlags::eAnimated);
    return !sameValue(data.value, defaultValue(*data.row), data.type.GetType()) ||
           (data.flags & kWritten) != (defaultFlags(*data.row) & kWritten);
}

} // namespace

std::vector<DocumentProperty> writableProperties(const FbxObject& object, PropertyChoice choice, RecordTree& texts) {
    std::vector<DocumentProperty> lines;
    const ObjectData& data = object.data();
    const std::span<const PropertyRow> rows = data.info->rows;
    auto next = data.properties().begin();
    for (int index = 0; index < data.propertyCount(); ++index) {
        if (next == data.properties().end() && choice == PropertyChoice::changed)
            break;
        const bool stored = next != data.properties().end() && (*next)->index == index;
        const PropertyData* property = stored ? *next++ : nullptr;
        if (property && (property->flags & FbxPropertyFlags::eNotSavable) != 0)
            continue;
        if (property && (choice == PropertyChoice::all || isChanged(*property)))
            lines.push_back(writableLine(*property, texts));
        else if (choice == PropertyChoice::all && static_cast<std::size_t>(index) < rows.size())
            lines.push_back(defaultLine(rows[static_cast<std::size_t>(index)], texts));
    }
    return lines;
}

std::vector<DocumentProperty> templateProperties(std::span<const PropertyRow> rows, RecordTree& texts) {
    std::vector<DocumentProperty> lines;
    for (const PropertyRow& row : rows)
        lines.push_back(defaultLine(row, texts));
    return lines;
}

std::string_view propertyName(const FbxObject& object, int index) {
    const std::span<const PropertyRow> rows = object.data().info->rows;
    if (static_cast<std::size_t>(index) < rows.size())
        return rows[static_cast<std::size_t>(index)].name;
    return object.data().property(index)->name;
}

void setProperty(std::vector<DocumentProperty>& properties, const DocumentProperty& line) {
    const auto found = std::find_if(properties.begin(), properties.end(),
                                    [&](const DocumentProperty& each) { return each.name == line.name; });
    if (found == properties.end())
        properties.push_back(line);
    else
        found->values = line.values;
}

std::span<const Value> keepValue(RecordTree& texts, const Value& value) {
    const std::span<Value> kept = texts.newValues(1);
    kept[0] = value;
    return kept;
}

std::string_view channelTypeName(const FbxDataType& type) {
    switch (type.GetType()) {
    case eFbxBool:
        return type == FbxVisibilityInheritanceDT ? type.info()->typeName : "Bool";
    case eFbxEnum:
        return "Enum";
    case eFbxShort:
        return "Short";
    case eFbxInt:
        return "Integer";
    default:
        return type == FbxVisibilityDT ? type.info()->typeName : "Number";
    }
}

} // namespace detail
FBXSDK_NAMESPACE_END
