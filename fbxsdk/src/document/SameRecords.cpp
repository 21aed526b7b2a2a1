// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deep comparison of records, by the bytes as stored.
#include "document/SameRecords.h"

#include <algorithm>
#include <bit>
#include <memory>
#include <utility>
#include <vector>

#include "container/NumberDecoding.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

bool sameArrays(const StoredArray& a, const StoredArray& b) {
    if (a.element != b.element || a.compressed != b.compressed || a.count != b.count ||
        a.bytes.size() != b.bytes.size())
        return false;
    std::unique_ptr<char[]> memoryOfA, memoryOfB;
    const std::span<const char> left = payloadOf(a, memoryOfA);
    const std::span<const char> right = payloadOf(b, memoryOfB);
    return std::equal(left.begin(), left.end(), right.begin());
}

bool sameValue(const Value& a, const Value& b) {
    if (a.type != b.type)
        return false;
    switch (a.type) {
    case Value::Type::none:
        return true;
    case Value::Type::integer:
        return a.integer == b.integer;
    case Value::Type::real: // bits, so that NaN equals itself
        return std::bit_cast<std::uint64_t>(a.real) == std::bit_cast<std::uint64_t>(b.real);
    case Value::Type::text:
    case Value::Type::raw:
    case Value::Type::word:
        return a.text == b.text;
    case Value::Type::array:
        return sameArrays(*a.array, *b.array);
    }
    return false;
}

} // namespace

bool sameValues(std::span<const Value> a, std::span<const Value> b) {
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), sameValue);
}

bool sameRecords(const Record& a, const Record& b) {
    std::vector<std::pair<const Record*, const Record*>> open{{&a, &b}};
    while (!open.empty()) {
        const auto [left, right] = open.back();
        open.pop_back();
        if (!sameValues(left->values, right->values))
            return false;
        const Record* first = left->firstChild;
        const Record* second = right->firstChild;
        for (; first && second; first = first->nextSibling, second = second->nextSibling) {
            if (first->name != second->name)
                return false;
            open.emplace_back(first, second);
        }
        if (first || second)
            return false;
    }
    return true;
}

} // namespace detail
FBXSDK_NAMESPACE_END
