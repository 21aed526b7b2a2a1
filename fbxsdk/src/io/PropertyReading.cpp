// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Properties are matched only by name: type strings vary between writers and change when a property becomes
// animatable.
#include "io/ObjectReading.h"

#include <algorithm>
#include <string>

#include <fbxsdk/FbxObject.h>
#include <fbxsdk/FbxTime.h>

#include "object/ObjectData.h"
#include "object/PropertyConversion.h"
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

void setValue(PropertyData& property, const DocumentProperty& line) {
    const Value& first = line.values.front();
    const EFbxType type = property.type.GetType();
    const auto write = [&](EFbxType given, const auto& value) {
        writePropertyValue(property.value, type, &value, given);
    };
    switch (type) {
    case eFbxString:
    case eFbxDateTime:
        property.value.text = first.text;
        break;
    case eFbxTime:
        write(eFbxTime, FbxTime(first.toInteger()));
        break;
    case eFbxDouble2:
    case eFbxDouble3:
    case eFbxDouble4:
        write(eFbxDouble4, numbersOf(line));
        break;
    case eFbxFloat:
    case eFbxDouble:
    case eFbxHalfFloat:
    case eFbxDistance:
        write(eFbxDouble, first.toReal());
        break;
    default:
        write(eFbxLongLong, FbxLongLong{first.toInteger()});
        break;
    }
}

/// Whether the line equals the class's row, so that nothing needs to be stored.
bool isDefault(const FbxObject& object, int index, const DocumentProperty& line) {
    const std::span<const PropertyRow> rows = object.data().info->rows;
    if (static_cast<std::size_t>(index) >= rows.size() || object.data().property(index))
        return false;
    const PropertyRow& row = rows[static_cast<std::size_t>(index)];
    if (row.type->GetType() == eFbxString || line.flags != row.flags)
        return false;
    for (std::size_t i = 0; i < std::min<std::size_t>(line.values.size(), 4); ++i)
        if (line.values[i].toReal() != row.numbers[i])
            return false;
    return true;
}

/// Flags add to those of the class.
void set(PropertyData& property, const DocumentProperty& line) {
    if (!line.values.empty())
        setValue(property, line);
    property.flags |= propertyFlags(line.flags);
}

void readProperty(FbxObject& object, const DocumentProperty& line) {
    ObjectData& data = object.data();
    const int index = data.findProperty(NameKey(line.name));
    if (index >= 0) {
        if (!isDefault(object, index, line))
            set(data.materialise(index), line);
    } else if (!line.name.empty()) {
        set(data.appendProperty(dataTypeOf(line.typeName, line.subTypeName), std::string(line.name)), line);
    }
}

} // namespace

void readProperties(FbxObject& object, std::span<const DocumentProperty> properties) {
    for (const DocumentProperty& line : properties)
        readProperty(object, line);
}

void readTemplate(FbxObject& object, std::span<const DocumentProperty> properties, std::vector<TemplateLine>& lines) {
    for (const DocumentProperty& line : properties) {
        const int index = object.data().findProperty(NameKey(line.name));
        if (index < 0 || isDefault(object, index, line))
            continue;
        set(object.data().materialise(index), line);
        lines.push_back({index, &line});
    }
}

void applyTemplate(FbxObject& object, std::span<const TemplateLine> lines) {
    for (const auto& [index, line] : lines)
        set(object.data().materialise(index), *line);
}

} // namespace detail
FBXSDK_NAMESPACE_END
