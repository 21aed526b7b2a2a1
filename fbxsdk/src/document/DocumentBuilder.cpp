// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Objects, ids, warnings and values of a document under construction.
#include "document/DocumentBuilder.h"

#include <algorithm>
#include <limits>

#include "container/FileFormat.h"
#include "document/FileTicks.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr std::size_t kMostWarnings = 100;

bool idIsUsed(const Document& document, std::int64_t id) { return id == 0 || document.find(id) != nullptr; }

} // namespace

DocumentBuilder::DocumentBuilder(std::unique_ptr<RecordTree> tree, std::uint32_t version)
    : mDocument(std::make_unique<Document>()) {
    mDocument->tree = std::move(tree);
    mDocument->version = version;
}

std::int64_t DocumentBuilder::newId() {
    do
        ++mLastNewId;
    while (idIsUsed(*mDocument, mLastNewId));
    return mLastNewId;
}

DocumentObject& DocumentBuilder::addObject(std::int64_t id, std::string_view record, std::string_view subClass,
                                           std::string_view name, const Record* body) {
    DocumentObject& object = mDocument->objects.emplace_back();
    object.id = id;
    object.record = record;
    object.subClass = subClass;
    object.name = name;
    object.body = body ? body : &newRecord(record);
    return object;
}

void DocumentBuilder::indexObjects() {
    auto& objects = mDocument->objects;
    auto& index = mDocument->idIndex;
    const auto fill = [&] {
        index.clear();
        index.reserve(objects.size());
        for (std::size_t i = 0; i < objects.size(); ++i)
            index.emplace_back(objects[i].id, static_cast<std::uint32_t>(i));
        std::sort(index.begin(), index.end()); // of equal ids, the first in the file comes first
    };
    fill();
    std::vector<bool> doubled(objects.size(), false);
    std::size_t doubledCount = 0;
    for (std::size_t i = 1; i < index.size(); ++i)
        if (index[i].first == index[i - 1].first) {
            doubled[index[i].second] = true;
            ++doubledCount;
        }
    if (doubledCount == 0)
        return;
    std::size_t position = 0;
    std::erase_if(objects, [&](const DocumentObject&) { return doubled[position++]; });
    fill();
    warn(std::to_string(doubledCount) + " objects have the id of an earlier object; they are left out");
}

void DocumentBuilder::connect(std::int64_t source, std::int64_t destination, std::string_view destinationProperty,
                              std::string_view sourceProperty) {
    mDocument->connections.push_back({source, destination, sourceProperty, destinationProperty});
}

void DocumentBuilder::warn(std::string sentence) {
    auto& warnings = mDocument->warnings;
    if (warnings.size() < kMostWarnings) {
        warnings.push_back(std::move(sentence));
        return;
    }
    ++mSilentWarnings;
    const std::string rest = std::to_string(mSilentWarnings) + " more warnings are not listed";
    if (mSilentWarnings == 1)
        warnings.push_back(rest);
    else
        warnings.back() = rest;
}

void DocumentBuilder::warn(const Record& record, const std::string& sentence) {
    const bool isListed = mDocument->warnings.size() < kMostWarnings; // lines take time to count
    warn(isListed ? tree().placeOf(record) + ": " + sentence : sentence);
}

std::span<const Value> DocumentBuilder::keep(std::initializer_list<Value> values) { return mDocument->keep(values); }

std::span<const Value> DocumentBuilder::keepReals(std::span<const double> numbers) {
    const std::span<Value> kept = tree().newValues(numbers.size());
    std::transform(numbers.begin(), numbers.end(), kept.begin(), Value::ofReal);
    return kept;
}

std::span<const Value> DocumentBuilder::numbersOf(const Record& record, std::size_t count) {
    const bool scalars = record.values.empty() || record.values.front().type != Value::Type::array;
    if (scalars)
        return record.values.first(std::min(count, record.values.size()));
    std::vector<double> numbers(std::min(count, record.numberCount()));
    if (!record.readNumbers(numbers))
        return {};
    return keepReals(numbers);
}

Record& DocumentBuilder::newRecord(std::string_view name, std::span<const Value> values) {
    Record& record = tree().newRecord(name);
    record.values = values;
    return record;
}

Record& DocumentBuilder::aliasOf(const Record& original, std::string_view name) {
    Record& record = tree().newRecord(name);
    record = original;
    record.name = name;
    record.nextSibling = nullptr;
    return record;
}

std::int64_t DocumentBuilder::ticks(std::int64_t fileTicks) const {
    return rescaledTicks(fileTicks, mDocument->fileTicksPerSecond);
}

void DocumentBuilder::rescale(DocumentProperty& property) {
    if (mDocument->fileTicksPerSecond == kTicksPerSecond || property.typeName != "KTime")
        return;
    const std::span<Value> rescaled = tree().newValues(property.values.size());
    std::transform(property.values.begin(), property.values.end(), rescaled.begin(), [&](const Value& value) {
        return value.isNumber() ? Value::ofInteger(ticks(value.toInteger())) : value;
    });
    property.values = rescaled;
}

void ChildAppender::add(Record& child) {
    child.nextSibling = nullptr;
    if (mLast)
        mLast->nextSibling = &child;
    else
        mParent.firstChild = &child;
    mLast = &child;
}

DocumentProperty propertyOf(std::string_view name, std::string_view typeName, std::string_view subTypeName,
                            std::string_view flags, std::span<const Value> values) {
    return {name, typeName, subTypeName, flags, values};
}

std::string quotedName(std::string_view name) {
    constexpr std::size_t kLongest = 100;
    std::string text("\"");
    text += name.substr(0, kLongest);
    text += name.size() > kLongest ? "…\"" : "\"";
    return text;
}

std::string_view nameWithoutClass(std::string_view fullName, bool ascii) {
    if (const auto separator = fullName.find(kBinaryNameSeparator); separator != std::string_view::npos)
        return fullName.substr(0, separator);
    if (!ascii)
        return fullName;
    const auto separator = fullName.find(kAsciiNameSeparator);
    return separator == std::string_view::npos ? fullName : fullName.substr(separator + 2);
}

} // namespace detail
FBXSDK_NAMESPACE_END
