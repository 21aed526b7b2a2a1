// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Counts are compared before anything is decoded.
#include "geometry/NurbsNumbers.h"

#include <algorithm>
#include <limits>
#include <vector>

#include "geometry/ItemReading.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
std::int64_t integerAt(const Record* record, std::size_t index, std::int64_t fallback) {
    if (!record)
        return fallback;
    if (record->value(0).type != Value::Type::array)
        return record->value(index).toInteger(fallback);
    std::vector<std::int64_t> numbers(index + 1);
    return record->readNumbers(std::span(numbers)) ? numbers[index] : fallback;
}

int stepOf(std::int64_t step) {
    return static_cast<int>(std::clamp<std::int64_t>(step, 1, std::numeric_limits<int>::max()));
}

bool readPoints(PlainArray<FbxVector4>& points, const Record& body, std::int64_t count, int numbersPerPoint) {
    const Record* record = body.child("Points");
    if (!record || count < 1 || count > kMostPoints ||
        record->numberCount() != static_cast<std::size_t>(count) * static_cast<std::size_t>(numbersPerPoint))
        return false;
    return numbersPerPoint == 4 ? readWeightedPoints(*record, points) : readItems(*record, points);
}

} // namespace detail
FBXSDK_NAMESPACE_END
