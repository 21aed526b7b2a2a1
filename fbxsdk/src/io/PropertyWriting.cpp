// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The inverse of PropertyReading. The flag that a property may be animated changes the spelling of its type: files use
// "Number" for animatable types where others are "double".
#include "io/SceneWriting.h"

#include <algorithm>
#include <bit>
#include <cstdint>
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

/// The texts stay where they are.
std::span<const Value> valuesOf(const FbxDataType& type, const PropertyValue& value, WrittenLines& lines) {
    switch (type.GetType()) {
    case eFbxUndefined:
    case eFbxReference:
    case eFbxBlob:
        return {};
    case eFbxString:
    case eFbxDateTime:
        return lines.keep(Value::ofText(value.text));
    case eFbxFloat:
    case eFbxDouble:
    case eFbxDouble2:
    case eFbxDouble3:
    case eFbxDouble4:
    case eFbxHalfFloat:
    case eFbxDistance:
        return lines.keepReals(std::span(value.numbers).first(componentCount(type.GetType())));
    default:
        return lines.keep(Value::ofInteger(value.integer));
    }
}

DocumentProperty writableLine(const PropertyData& data, std::string_view name, CommonTexts& texts,
                              WrittenLines& lines) {
    const bool animated = isAnimated(data);
    DocumentProperty property{name, data.type.info()->typeName, data.type.info()->subTypeName,
                              texts.flags(flagsWith(data.flags, animated)), valuesOf(data.type, data.value, lines)};
    spellType(property, animated || (data.flags & FbxPropertyFlags::eAnimatable) != 0);
    return property;
}

bool hasDefault(const PropertyValue& value, const PropertyRow& row, EFbxType type) {
    if (type == eFbxString || type == eFbxDateTime)
        return value.text == row.text;
    return value.numbers == row.numbers && value.integer == static_cast<std::int64_t>(row.numbers[0]);
}

/// Connections count too: a reference holds nothing but its connection.
bool isChanged(const PropertyData& data) {
    if (!data.row || isConnected(data))
        return true;
    constexpr unsigned kWritten = ~static_cast<unsigned>(FbxPropertyFlags::eImported | FbxPropertyFlags::eAnimated);
    return !hasDefault(data.value, *data.row, data.type.GetType()) ||
           (data.flags & kWritten) != (defaultFlags(*data.row) & kWritten);
}

/// Whether the line of the class is that of the property, too: a negative zero is written as such.
bool isSame(const PropertyData& data) {
    const auto bitsOf = [](double number) { return std::bit_cast<std::uint64_t>(number); };
    return !isChanged(data) && std::ranges::equal(data.value.numbers, data.row->numbers, {}, bitsOf, bitsOf);
}

} // namespace

std::string_view CommonTexts::flags(unsigned flags) {
    const auto [text, isNew] = mFlags.try_emplace(flags);
    if (isNew)
        text->second = mTree.keepText(propertyFlagText(flags));
    return text->second;
}

std::string_view CommonTexts::channel(std::string_view name) {
    constexpr std::string_view kPrefix = "d|";
    if (const auto known = mChannels.find(name); known != mChannels.end())
        return known->second;
    const std::string_view text = mTree.keepText(std::string(kPrefix).append(name));
    mChannels.emplace(text.substr(kPrefix.size()), text);
    return text;
}

const DefaultLines& ClassOutputs::defaultsOf(std::span<const PropertyRow> rows) {
    const auto [known, isNew] = mDefaults.try_emplace(rows.data());
    DefaultLines& defaults = known->second;
    if (!isNew)
        return defaults;
    defaults.firstNumber = mNextNumber;
    mNextNumber += static_cast<int>(rows.size());
    mLines.clear();
    for (const PropertyRow& row : rows) {
        const FbxDataType& type = *row.type;
        std::span<const Value> values = valuesOf(type, defaultValue(row), mLines);
        if (!values.empty() && values[0].type == Value::Type::text)
            values = mLines.keep(Value::ofText(row.text)); // the other one is gone
        mLines.add({row.name, type.info()->typeName, type.info()->subTypeName, row.flags, values});
    }
    defaults.lines = mLines.kept(mTree);
    return defaults;
}

void addLines(const FbxObject& object, PropertyChoice choice, const DefaultLines& defaults, CommonTexts& texts,
              WrittenLines& lines) {
    const ObjectData& data = object.data();
    const int rowCount = static_cast<int>(data.info->rows.size());
    auto next = data.properties().begin();
    const auto end = data.properties().end();
    for (int index = 0; next != end || (choice == PropertyChoice::all && index < rowCount); ++index) {
        if (choice == PropertyChoice::changed)
            index = (*next)->index;
        const bool isStored = next != end && (*next)->index == index;
        const PropertyData* const property = isStored ? *next++ : nullptr;
        const DocumentProperty* const line =
            index < rowCount ? &defaults.lines[static_cast<std::size_t>(index)] : nullptr;
        if (property && (property->flags & FbxPropertyFlags::eNotSavable) != 0)
            continue;
        const bool isDefault = !property || (choice == PropertyChoice::all ? isSame(*property) : !isChanged(*property));
        if (!isDefault)
            lines.add(writableLine(*property, line ? line->name : std::string_view(property->name), texts, lines));
        else if (choice == PropertyChoice::all)
            lines.refer(*line, defaults.firstNumber + index);
    }
}

std::string_view propertyName(const FbxObject& object, int index) {
    const std::span<const PropertyRow> rows = object.data().info->rows;
    if (static_cast<std::size_t>(index) < rows.size())
        return rows[static_cast<std::size_t>(index)].name;
    return object.data().property(index)->name;
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
