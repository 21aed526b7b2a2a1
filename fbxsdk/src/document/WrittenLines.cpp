// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "document/WrittenLines.h"

#include <algorithm>
#include <cassert>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

void WrittenLines::clear() {
    mLines.clear();
    mOwn.reuse();
    mValues.reuse();
}

void WrittenLines::fill(const DocumentObject& object) {
    clear();
    for (const DocumentProperty& property : object.properties)
        refer(property);
    if (object.content->properties)
        object.content->properties(*this);
}

const WrittenLine* WrittenLines::find(std::string_view name) const {
    const auto found = std::find_if(mLines.begin(), mLines.end(),
                                    [&](const WrittenLine& each) { return each.property->name == name; });
    return found == mLines.end() ? nullptr : &*found;
}

void WrittenLines::set(const DocumentProperty& line) {
    const auto found = std::find_if(mLines.begin(), mLines.end(),
                                    [&](const WrittenLine& each) { return each.property->name == line.name; });
    if (found == mLines.end()) {
        add(line);
        return;
    }
    DocumentProperty& changed = mOwn.next();
    changed = *found->property;
    changed.values = line.values;
    *found = {&changed};
}

void WrittenLines::remove(std::string_view name) {
    std::erase_if(
        mLines, [&](const WrittenLine& each) { return each.property->name == name; });
}

std::span<const Value> WrittenLines::keep(const Value& value) {
    std::array<Value, kMostValues>& values = mValues.next();
    values[0] = value;
    return {values.data(), 1};
}

std::span<const Value> WrittenLines::keepReals(std::span<const double> numbers) {
    assert(numbers.size() <= kMostValues);
    std::array<Value, kMostValues>& values = mValues.next();
    std::transform(numbers.begin(), numbers.end(), values.begin(), Value::ofReal);
    return {values.data(), numbers.size()};
}

std::vector<DocumentProperty> WrittenLines::kept(RecordTree& tree) const {
    std::vector<DocumentProperty> properties;
    properties.reserve(mLines.size());
    for (const WrittenLine& line : mLines) {
        const std::span<Value> values = tree.newValues(line.property->values.size());
        std::copy(line.property->values.begin(), line.property->values.end(), values.begin());
        properties.push_back(*line.property);
        properties.back().values = values;
    }
    return properties;
}

} // namespace detail
FBXSDK_NAMESPACE_END
