// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The first type string of a property decides how its values are stored. Simple readers do not convert.
#include "document/DocumentSections.h"

#include <algorithm>
#include <iterator>

#include "container/NumberConversion.h"
#include "document/RecordWriting.h"
#include "document/WrittenLines.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

enum class Storage { byte, shortInteger, integer, longInteger, singleReal, real, text };

struct TypeRow {
    std::string_view typeName;
    Storage storage;
};
/// Every other type holds floating-point numbers.
constexpr TypeRow kTypes[] = {
    {"bool", Storage::integer},
    {"Bool", Storage::integer},
    {"int", Storage::integer},
    {"Integer", Storage::integer},
    {"enum", Storage::integer},
    {"Enum", Storage::integer},
    {"Visibility Inheritance", Storage::integer},
    {"Action", Storage::integer},
    {"Blob", Storage::integer},
    {"KString", Storage::text},
    {"DateTime", Storage::text},
    {"charptr", Storage::text},
    {"KTime", Storage::longInteger},
    {"LongLong", Storage::longInteger},
    {"ULongLong", Storage::longInteger},
    {"Short", Storage::shortInteger},
    {"UByte", Storage::byte},
    {"float", Storage::singleReal},
    {"Float", Storage::singleReal},
    {"Distance", Storage::singleReal},
};

Storage storageOf(std::string_view typeName) {
    const auto* row = std::find_if(std::begin(kTypes), std::end(kTypes),
                                   [&](const TypeRow& each) { return each.typeName == typeName; });
    return row != std::end(kTypes) ? row->storage : Storage::real;
}

void writeValue(RecordSink& sink, const Value& value, Storage storage) {
    // A text among numbers, the choices of an enumeration or a unit, is written as text.
    if (value.type == Value::Type::text || storage == Storage::text) {
        sink.text(value.toText());
        return;
    }
    switch (storage) {
    case Storage::byte:
        return sink.byte(clampTo<std::uint8_t>(value.toInteger()));
    case Storage::shortInteger:
        return sink.shortInteger(clampTo<std::int16_t>(value.toInteger()));
    case Storage::integer:
        return sink.integer(clampTo<std::int32_t>(value.toInteger()));
    case Storage::longInteger:
        return sink.longInteger(value.toInteger());
    case Storage::singleReal:
        return sink.singleReal(convertNumber<float>(value.toReal()));
    case Storage::real:
    case Storage::text:
        return sink.real(value.toReal());
    }
}

void writeValues(RecordSink& sink, const DocumentProperty& property) {
    const Storage storage = storageOf(property.typeName);
    for (const Value& value : property.values)
        writeValue(sink, value, storage);
}

void writeLine70(RecordSink& sink, const DocumentProperty& property) {
    sink.beginRecord("P");
    for (const std::string_view text : {property.name, property.typeName, property.subTypeName, property.flags})
        sink.text(text);
    writeValues(sink, property);
    sink.endRecord();
}

} // namespace

void writeProperties70(RecordSink& sink, std::span<const DocumentProperty> properties) {
    const BlockScope block(sink, "Properties70");
    for (const DocumentProperty& property : properties)
        writeLine70(sink, property);
}

void writeLines70(RecordSink& sink, std::span<const WrittenLine> lines) {
    if (lines.empty())
        return;
    const BlockScope block(sink, "Properties70");
    for (const WrittenLine& line : lines)
        writeLine70(sink, *line.property);
}

void writeProperty60(RecordSink& sink, const DocumentProperty& property, std::string_view flags) {
    sink.beginRecord("Property");
    for (const std::string_view text : {property.name, property.typeName, flags})
        sink.text(text);
    writeValues(sink, property);
    sink.endRecord();
}

} // namespace detail
FBXSDK_NAMESPACE_END
