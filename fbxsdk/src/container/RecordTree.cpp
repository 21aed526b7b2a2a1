// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Values, records and the tree that owns them.
#include "container/Record.h"

#include <algorithm>
#include <bit>
#include <limits>
#include <new>
#include <type_traits>

#include "container/NumberConversion.h"
#include "container/NumberDecoding.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

constexpr Value kNoValue{};

// The tree's memory is released without destructors.
static_assert(std::is_trivially_destructible_v<Record> && std::is_trivially_destructible_v<Value> &&
              std::is_trivially_destructible_v<StoredArray>);

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
        if (next == destination.end()) {
            break;
        }
        if (value.isNumber()) {
            *next++ = convertValue<Number>(value);
        }
    }
    return next == destination.end();
}

template <class Number>
bool read(const Record& record, std::span<Number> destination) {
    const StoredArray* const array = findArray(record.values);
    const bool read = array != nullptr ? array->count >= destination.size() && decodeArray(*array, destination)
                                       : readScalars(record.values, destination);
    if (!read) {
        std::fill(destination.begin(), destination.end(), Number{0});
    }
    return read;
}

} // namespace

Value Value::ofInteger(std::int64_t number) {
    Value value;
    value.type = Type::integer;
    value.integer = number;
    return value;
}

Value Value::ofReal(double number) {
    Value value;
    value.type = Type::real;
    value.real = number;
    return value;
}

Value Value::ofText(std::string_view text) {
    Value value;
    value.type = Type::text;
    value.text = text;
    return value;
}

Value Value::ofWord(std::string_view word) {
    Value value;
    value.type = Type::word;
    value.text = word;
    return value;
}

Value Value::ofArray(const StoredArray& array) {
    Value value;
    value.type = Type::array;
    value.array = &array;
    return value;
}

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

std::string_view Value::toText() const {
    return type == Type::text || type == Type::raw || type == Type::word ? text : std::string_view();
}

char Value::toLetter() const {
    return (type == Type::text || type == Type::word) && text.size() == 1 ? text.front() : '\0';
}

const Record* Record::child(std::string_view childName) const {
    for (const Record& record : children()) {
        if (record.name == childName) {
            return &record;
        }
    }
    return nullptr;
}

const Value& Record::value(std::size_t index) const { return index < values.size() ? values[index] : kNoValue; }

const Value& Record::childValue(std::string_view childName) const {
    const Record* const record = child(childName);
    return record != nullptr ? record->value(0) : kNoValue;
}

const StoredArray* Record::array() const { return findArray(values); }

std::size_t Record::numberCount() const {
    if (const StoredArray* const stored = array()) {
        return static_cast<std::size_t>(stored->count);
    }
    return static_cast<std::size_t>(std::count_if(values.begin(), values.end(), isNumeric));
}

bool Record::readNumbers(std::span<double> destination) const { return read(*this, destination); }

bool Record::readNumbers(std::span<float> destination) const { return read(*this, destination); }

bool Record::readNumbers(std::span<std::int32_t> destination) const { return read(*this, destination); }

bool Record::readNumbers(std::span<std::int64_t> destination) const { return read(*this, destination); }

bool Record::readFloatBits(std::span<std::uint32_t> destination) const { return read(*this, destination); }

std::string RecordTree::placeOf(const Record& record) const {
    return (ascii ? "line " : "offset ") + std::to_string(record.location);
}

Record& RecordTree::newRecord(std::string_view name) {
    auto* const record = new (mMemory.allocate(sizeof(Record), alignof(Record))) Record;
    record->name = name;
    return *record;
}

std::span<Value> RecordTree::newValues(std::size_t count) {
    if (count == 0) {
        return {};
    }
    auto* const values = static_cast<Value*>(mMemory.allocate(count * sizeof(Value), alignof(Value)));
    std::uninitialized_default_construct_n(values, count);
    return {values, count};
}

StoredArray& RecordTree::newArray() {
    return *new (mMemory.allocate(sizeof(StoredArray), alignof(StoredArray))) StoredArray;
}

std::string_view RecordTree::keepText(std::string text) { return mTexts.emplace_back(std::move(text)); }

} // namespace detail
FBXSDK_NAMESPACE_END
