// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The property lines of ASCII files, checked against the table of their types.
#include "document/DocumentBuilder.h"

#include <algorithm>
#include <iterator>
#include <string_view>

#include "schema/PropertyFlags.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

struct TypeRow {
    std::string_view typeName;
    std::size_t numbers;
};
constexpr TypeRow kTypes[] = {
    {"Lcl Translation", 3},
    {"Lcl Rotation", 3},
    {"Lcl Scaling", 3},
    {"Vector3D", 3},
    {"Vector", 3},
    {"Color", 3},
    {"ColorRGB", 3},
    {"Translation", 3},
    {"Rotation", 3},
    {"Scaling", 3},
    {"ColorAndAlpha", 4},
    {"ColorRGBA", 4},
    {"double", 1},
    {"Number", 1},
    {"float", 1},
    {"Float", 1},
    {"Real", 1},
    {"int", 1},
    {"Integer", 1},
    {"bool", 1},
    {"Bool", 1},
    {"enum", 1},
    {"KTime", 1},
    {"FieldOfView", 1},
    {"FieldOfViewX", 1},
    {"FieldOfViewY", 1},
    {"Roll", 1},
    {"OpticalCenterX", 1},
    {"OpticalCenterY", 1},
    {"Visibility", 1},
    {"Weight", 1},
    {"Intensity", 1},
    {"Cone angle", 1},
    {"Distance", 1},
};

/// The number of entries before the values, by the name of the list: name, type, in newer files its kind, flags.
struct ListRow {
    std::string_view list, line;
    std::size_t texts;
};
constexpr ListRow kLists[] = {{"Properties70", "P", 4}, {"Properties60", "Property", 3}};

bool hasTooMany(const Record& line, std::size_t texts) {
    if (line.values.size() < texts + 2) // every type holds one number
        return false;
    const auto* const type = std::find_if(std::begin(kTypes), std::end(kTypes),
                                          [&](const TypeRow& row) { return row.typeName == line.value(1).toText(); });
    const bool user = line.value(texts - 1).toText().find(kUserFlagLetter) != std::string_view::npos;
    if (type == std::end(kTypes) || user)
        return false;
    const auto values = line.values.subspan(texts);
    const auto numbers =
        std::count_if(values.begin(), values.end(), [](const Value& value) { return value.isNumber(); });
    return static_cast<std::size_t>(numbers) > type->numbers;
}

/// The first line of the subtree that holds too many; null when there is none.
const Record* faultyLine(const Record& parent) {
    const auto* const list =
        std::find_if(std::begin(kLists), std::end(kLists), [&](const ListRow& row) { return row.list == parent.name; });
    for (const Record& child : parent.children()) {
        const bool isLine = list != std::end(kLists) && child.name == list->line;
        if (isLine && hasTooMany(child, list->texts))
            return &child;
        if (const Record* faulty = isLine ? nullptr : faultyLine(child))
            return faulty;
    }
    return nullptr;
}

} // namespace

bool checkValueCounts(const RecordTree& tree, FbxStatus& status) {
    const Record* line = tree.ascii ? faultyLine(tree.root) : nullptr;
    if (line)
        status.SetCode(FbxStatus::eInvalidFile, "%s: %s: the property \"%s\" has more numbers than its type allows",
                       tree.fileName.c_str(), tree.placeOf(*line).c_str(),
                       std::string(line->value(0).toText()).c_str());
    return line == nullptr;
}

} // namespace detail
FBXSDK_NAMESPACE_END
