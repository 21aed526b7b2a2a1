// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Properties are matched by name alone: type strings vary between writers and change when a property becomes
// animatable.
#include "io/ObjectReading.h"

#include <algorithm>
#include <string>

#include <fbxsdk/FbxObject.h>

#include "object/ObjectData.h"
#include "schema/PropertyFlags.h"
#include "schema/PropertyTypes.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

FbxDouble4 numbersOf(const DocumentProperty& line) {
    FbxDouble4 numbers(0, 0, 0, 0);
    const std::size_t count = std::min<std::size_t>(line.values.size(), 4);
    for (std::size_t i = 0; i < count; ++i)
        numbers[static_cast<int>(i)] = line.values[i].toReal();
    return numbers;
}

void setValue(FbxProperty& property, const DocumentProperty& line) {
    if (line.values.empty())
        return;
    const Value& first = line.values.front();
    switch (property.GetPropertyDataType().GetType()) {
    case eFbxString:
    case eFbxDateTime:
        property.Set(FbxString(first.text.data(), first.text.size()));
        break;
    case eFbxTime:
        property.Set(FbxTime(first.toInteger()));
        break;
    case eFbxDouble2:
    case eFbxDouble3:
    case eFbxDouble4:
        property.Set(numbersOf(line));
        break;
    case eFbxFloat:
    case eFbxDouble:
    case eFbxHalfFloat:
    case eFbxDistance:
        property.Set(first.toReal());
        break;
    default:
        property.Set(FbxLongLong{first.toInteger()});
        break;
    }
}

/// Adds to those of the class.
void setFlags(FbxProperty& property, std::string_view flags) {
    if (const unsigned stated = propertyFlags(flags); stated != 0)
        property.ModifyFlag(static_cast<FbxPropertyFlags::EFlags>(stated), true);
}

/// Whether the line says what the class's row says already, so that nothing needs to be stored.
bool isDefault(const FbxObject& object, int index, const DocumentProperty& line) {
    const std::span<const PropertyRow> rows = object.data().info->rows;
    if (static_cast<std::size_t>(index) >= rows.size() || object.data().property(index))
        return false;
    const PropertyRow& row = rows[static_cast<std::size_t>(index)];
    if (row.type->GetType() == eFbxString || line.flags != row.flags)
        return false;
    for (std::size_t i = 0; i < std::min<std::size_t>(line.values.size(), 4); ++i) {
        if (line.values[i].toReal() != row.numbers[i])
            return false;
    }
    return true;
}

void set(FbxProperty property, const DocumentProperty& line) {
    setValue(property, line);
    setFlags(property, line.flags);
}

void readProperty(FbxObject& object, const DocumentProperty& line) {
    const int index = object.data().findProperty(line.name);
    if (index >= 0) {
        if (!isDefault(object, index, line))
            set({&object, index}, line);
        return;
    }
    if (line.name.empty())
        return;
    const FbxProperty property = FbxProperty::Create(&object, dataTypeOf(line.typeName, line.subTypeName),
                                                     std::string(line.name).c_str(), "", /*pCheckForDup=*/false);
    set(property, line);
}

} // namespace

void readProperties(FbxObject& object, std::span<const DocumentProperty> properties) {
    for (const DocumentProperty& line : properties)
        readProperty(object, line);
}

void readTemplate(FbxObject& object, std::span<const DocumentProperty> properties, std::vector<TemplateLine>& lines) {
    for (const DocumentProperty& line : properties) {
        const int index = object.data().findProperty(line.name);
        if (index < 0 || isDefault(object, index, line))
            continue;
        set({&object, index}, line);
        lines.push_back({index, &line});
    }
}

void applyTemplate(FbxObject& object, std::span<const TemplateLine> lines) {
    for (const auto& [index, line] : lines)
        set({&object, index}, *line);
}

} // namespace detail
FBXSDK_NAMESPACE_END
