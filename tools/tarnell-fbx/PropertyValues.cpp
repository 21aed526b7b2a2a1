// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Values of properties by type.
#include "PropertyValues.h"

#include "SceneFacts.h"

namespace tool {
namespace {

enum class Shape { none, boolean, integer, natural, real, text, time, vector };

Shape shapeOf(const FbxProperty& property) {
    switch (property.GetPropertyDataType().GetType()) {
    case eFbxBool:
        return Shape::boolean;
    case eFbxChar:
    case eFbxUChar:
    case eFbxShort:
    case eFbxUShort:
    case eFbxInt:
    case eFbxUInt:
    case eFbxLongLong:
    case eFbxEnum:
    case eFbxEnumM:
        return Shape::integer;
    case eFbxULongLong:
        return Shape::natural;
    case eFbxHalfFloat:
    case eFbxFloat:
    case eFbxDouble:
    case eFbxDistance:
        return Shape::real;
    case eFbxString:
    case eFbxDateTime:
        return Shape::text;
    case eFbxTime:
        return Shape::time;
    case eFbxDouble2:
    case eFbxDouble3:
    case eFbxDouble4:
        return Shape::vector;
    case eFbxUndefined:
    case eFbxDouble4x4:
    case eFbxReference:
    case eFbxBlob:
    case eFbxTypeCount:
        return Shape::none;
    }
    return Shape::none;
}

} // namespace

std::string typeName(const FbxProperty& property) { return property.GetPropertyDataType().GetName(); }

int componentCount(const FbxProperty& property) {
    switch (shapeOf(property)) {
    case Shape::vector:
        return static_cast<int>(property.GetPropertyDataType().GetType()) - static_cast<int>(eFbxDouble2) + 2;
    case Shape::boolean:
    case Shape::integer:
    case Shape::natural:
    case Shape::real:
    case Shape::time:
        return 1;
    case Shape::none:
    case Shape::text:
        return 0;
    }
    return 0;
}

std::string flagLetters(const FbxProperty& property) {
    constexpr struct {
        FbxPropertyFlags::EFlags flag;
        char letter;
    } kLetters[] = {{FbxPropertyFlags::eAnimatable, 'A'},
                    {FbxPropertyFlags::eAnimated, '+'},
                    {FbxPropertyFlags::eUserDefined, 'U'},
                    {FbxPropertyFlags::eHidden, 'H'}};
    std::string letters;
    for (const auto& row : kLetters)
        if (property.GetFlag(row.flag))
            letters += row.letter;
    return letters;
}

std::string valueText(const FbxProperty& property) {
    switch (shapeOf(property)) {
    case Shape::none:
        return {};
    case Shape::boolean:
        return property.Get<FbxBool>() ? "true" : "false";
    case Shape::integer:
        return std::to_string(property.Get<FbxLongLong>());
    case Shape::natural:
        return std::to_string(property.Get<FbxULongLong>());
    case Shape::real:
        return exactText(property.Get<FbxDouble>());
    case Shape::text:
        return inQuotes(property.Get<FbxString>().Buffer());
    case Shape::time:
        return exactText(property.Get<FbxTime>().GetSecondDouble()) + " s";
    case Shape::vector:
        break;
    }
    const auto numbers = property.Get<FbxDouble4>();
    std::string text;
    for (int i = 0; i < componentCount(property); ++i)
        text += (i == 0 ? "" : ", ") + exactText(numbers[i]);
    return text;
}

void printValue(const FbxProperty& property, JsonWriter& json) {
    switch (shapeOf(property)) {
    case Shape::none:
        json.null();
        return;
    case Shape::boolean:
        json.boolean(property.Get<FbxBool>());
        return;
    case Shape::integer:
        json.integer(property.Get<FbxLongLong>());
        return;
    case Shape::natural:
        json.natural(property.Get<FbxULongLong>());
        return;
    case Shape::real:
        json.real(property.Get<FbxDouble>());
        return;
    case Shape::text:
        json.text(property.Get<FbxString>().Buffer());
        return;
    case Shape::time:
        json.real(property.Get<FbxTime>().GetSecondDouble());
        return;
    case Shape::vector:
        break;
    }
    const auto numbers = property.Get<FbxDouble4>();
    json.beginArray();
    for (int i = 0; i < componentCount(property); ++i)
        json.real(numbers[i]);
    json.endArray();
}

} // namespace tool
