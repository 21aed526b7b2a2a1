// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Values, records and the tree that owns them.
#include "container/Record.h"

#include <algorithm>

#include "container/LineCounter.h"
#include "container/NumberConversion.h"
#include "container/NumberDecoding.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

bool isNumeric(const Value& value) { return value.isNumber(); }

const StoredArray* findArray(std::span<const Value> values) {
    const auto found =
        std::find_if(values.begin(), values.end(), [](const Value& value) { return value.type == Value::Type::array; });
    return found != values.end() ? found->array : nullptr;
}

template <class Number>
Number convertValue(const Value& value) {
    return value.type == Value::Type::integer ? convertNumber<Number>(value.integer)
                                              : convertNumber<Number>(value.real);
}

template <class Number>
bool readScalars(std::span<const Value> values, std::span<Number> destination) {
    auto next = destination.begin();
    for (const Value& value : values) {
        if (next == destination.end())
            break;
        if (value.isNumber())
            *next++ = convertValue<Number>(value);
    }
    return next == destination.end();
}

template <class Number>
bool read(const Record& record, std::span<Number> destination) {
    const StoredArray* const array = findArray(record.values);
    const bool read = array != nullptr ? array->count >= destination.size() && decodeArray(*array, destination)
                                       : readScalars(record.values, destination);
    if (!read)
        std::fill(destination.begin(), destination.end(), Number{0});
    return read;
}

} // namespace

std::int64_t Value::toInteger(std::int64_t fallback) const {
    switch (type) {
    case Type::integer:
        return integer;
    case Type::real:
        return truncateTo<std::int64_t>(real);
    case Type::word:
        return text.size() == 1 ? static_cast<unsigned char>(text.front()) : fallback;
    case Type::none:
    case Type::text:
    case Type::raw:
    case Type::array:
        return fallback;
    }
    return fallback;
}

double Value::toReal(double fallback) const {
    switch (type) {
    case Type::integer:
        return static_cast<double>(integer);
    case Type::real:
        return real;
    case Type::word:
        return text.size() == 1 ? static_cast<unsigned char>(text.front()) : fallback;
    case Type::none:
    case Type::text:
    case Type::raw:
    case Type::array:
        return fallback;
    }
    return fallback;
}

char Value::toLetter() const {
    return (type == Type::text || type == Type::word) && text.size() == 1 ? text.front() : '\0';
}

const Record* Record::child(std::string_view childName) const {
    for (const Record& record : children())
        if (record.name == childName)
            return &record;
    return nullptr;
}

const Value& Record::childValue(std::string_view childName) const {
    const Record* const record = child(childName);
    return record != nullptr ? record->value(0) : kNoValue;
}

const StoredArray* Record::array() const { return findArray(values); }

std::size_t Record::numberCount() const {
    if (const StoredArray* const stored = array())
        return static_cast<std::size_t>(stored->count);
    return static_cast<std::size_t>(std::count_if(values.begin(), values.end(), isNumeric));
}

bool Record::readNumbers(std::span<double> destination) const { return read(*this, destination); }

bool Record::readNumbers(std::span<float> destination) const { return read(*this, destination); }

bool Record::readNumbers(std::span<std::int32_t> destination) const { return read(*this, destination); }

bool Record::readNumbers(std::span<std::int64_t> destination) const { return read(*this, destination); }

bool Record::readFloatBits(std::span<std::uint32_t> destination) const { return read(*this, destination); }

std::string RecordTree::placeOf(const Record& record) const {
    if (!ascii)
        return "offset " + std::to_string(record.location);
    return "line " + std::to_string(LineCounter(source).lineAt(record.location));
}

void RecordTree::addBlock(std::size_t leastSize) {
    constexpr std::size_t kLargestSize = std::size_t{1} << 20;
    const std::size_t size = std::max(leastSize, mBlockSize);
    mFree = {static_cast<std::byte*>(mMemory.allocate(size, kAlignment)), size};
    mBlockSize = std::min(2 * mBlockSize, kLargestSize);
}

std::string_view RecordTree::keepText(std::string text) { return mTexts.emplace_back(std::move(text)); }

} // namespace detail
FBXSDK_NAMESPACE_END
