// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The keys of animation curves: the packed arrays of 7.x files, and the common rules for curves of all generations.
#include <algorithm>
#include <bit>
#include <numeric>

#include "document/FileTicks.h"
#include "document/legacy/LegacyKeys.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

template <class Number>
std::vector<Number> readAll(const Record& owner, std::string_view name) {
    const Record* record = owner.child(name);
    std::vector<Number> numbers(record ? record->numberCount() : 0);
    if (record && !record->readNumbers(numbers))
        numbers.clear();
    return numbers;
}

std::vector<std::uint32_t> readWords(const Record& owner, std::string_view name) {
    const Record* record = owner.child(name);
    std::vector<std::uint32_t> words(record ? record->numberCount() : 0);
    if (record && !record->readFloatBits(words))
        words.clear();
    return words;
}

float unpackedWeight(std::uint32_t halfWord) { return static_cast<float>(halfWord & 0xFFFFU) / kPackedUnit; }
float unpackedVelocity(std::uint32_t halfWord) {
    return static_cast<float>(static_cast<std::int16_t>(halfWord & 0xFFFFU)) / kPackedUnit;
}

/// Weights and velocities are used only where the flags say so.
void unpackWeights(KeyAttributes& attribute, std::span<const std::uint32_t> words) {
    if (attribute.flags & KeyFlag::weightedRight)
        attribute.data[2] = unpackedWeight(words[2]);
    if (attribute.flags & KeyFlag::weightedNextLeft)
        attribute.data[3] = unpackedWeight(words[2] >> 16U);
    if (attribute.flags & KeyFlag::velocityRight)
        attribute.data[4] = unpackedVelocity(words[3]);
    if (attribute.flags & KeyFlag::velocityNextLeft)
        attribute.data[5] = unpackedVelocity(words[3] >> 16U);
}

KeyAttributes unpacked(std::int32_t flags, std::span<const std::uint32_t> words) {
    KeyAttributes attribute;
    attribute.flags = static_cast<std::uint32_t>(flags);
    if (words.size() < kWordsPerAttribute)
        return attribute;
    attribute.data[0] = std::bit_cast<float>(words[0]);
    attribute.data[1] = std::bit_cast<float>(words[1]);
    const bool tcb = (attribute.flags & KeyFlag::cubic) && (attribute.flags & KeyFlag::tangentTcb);
    if (tcb)
        attribute.data[2] = std::bit_cast<float>(words[2]);
    else
        unpackWeights(attribute, words);
    return attribute;
}

std::vector<KeyAttributes> readAttributes(const Record& body) {
    const std::vector<std::int32_t> flags = readAll<std::int32_t>(body, "KeyAttrFlags");
    const std::vector<std::uint32_t> words = readWords(body, "KeyAttrDataFloat");
    std::vector<KeyAttributes> attributes;
    attributes.reserve(flags.size());
    for (std::size_t i = 0; i < flags.size(); ++i) {
        const std::size_t first = std::min(i * kWordsPerAttribute, words.size());
        attributes.push_back(unpacked(flags[i], std::span(words).subspan(first)));
    }
    if (attributes.empty())
        attributes.push_back({.flags = KeyFlag::linear});
    return attributes;
}

/// Attribute j applies to as many consecutive keys as its count says; the last one to all remaining keys.
std::vector<std::uint32_t> spreadAttributes(std::span<const std::int32_t> counts, std::size_t attributeCount,
                                            std::size_t keyCount) {
    std::vector<std::uint32_t> indices;
    indices.reserve(keyCount);
    for (std::size_t j = 0; j < std::min(counts.size(), attributeCount); ++j) {
        const auto wanted = static_cast<std::size_t>(std::max(counts[j], 0));
        indices.insert(indices.end(), std::min(wanted, keyCount - indices.size()), static_cast<std::uint32_t>(j));
    }
    indices.resize(keyCount, static_cast<std::uint32_t>(attributeCount - 1));
    return indices;
}

CurveKeys readPackedCurve(const Record& body, std::int64_t ticksPerSecond) {
    CurveKeys curve;
    curve.defaultValue = static_cast<float>(body.childValue("Default").toReal());
    curve.times = readAll<std::int64_t>(body, "KeyTime");
    curve.values = readAll<float>(body, "KeyValueFloat");
    const std::size_t count = std::min(curve.times.size(), curve.values.size());
    curve.times.resize(count);
    curve.values.resize(count);
    for (std::int64_t& time : curve.times)
        time = rescaledTicks(time, ticksPerSecond);
    curve.attributes = readAttributes(body);
    curve.attributeOfKey =
        spreadAttributes(readAll<std::int32_t>(body, "KeyAttrRefCount"), curve.attributes.size(), count);
    curve.before = readExtrapolation(body, "Pre-Extrapolation");
    curve.after = readExtrapolation(body, "Post-Extrapolation");
    sortKeys(curve);
    return curve;
}

} // namespace

Extrapolation readExtrapolation(const Record& owner, std::string_view name) {
    Extrapolation extrapolation;
    const Record* record = owner.child(name);
    if (!record)
        return extrapolation;
    const char letter = record->childValue("Type").toLetter();
    for (const ExtrapolationRow& row : kExtrapolations)
        if (row.letter == letter)
            extrapolation.type = row.type;
    if (extrapolation.type == ExtrapolationType::constant)
        return extrapolation;
    constexpr std::int64_t kEndless = -1;
    constexpr std::int64_t kMost = 1'000'000'000;
    extrapolation.count =
        static_cast<std::int32_t>(std::clamp(record->childValue("Repetition").toInteger(kEndless), kEndless, kMost));
    return extrapolation;
}

void sortKeys(CurveKeys& curve) {
    const auto& times = curve.times;
    if (std::adjacent_find(times.begin(), times.end(), std::greater_equal<>()) == times.end())
        return;
    std::vector<std::uint32_t> order(times.size());
    std::iota(order.begin(), order.end(), 0U);
    std::stable_sort(order.begin(), order.end(), [&](std::uint32_t a, std::uint32_t b) { return times[a] < times[b]; });
    CurveKeys sorted;
    for (std::size_t i = 0; i < order.size(); ++i) {
        if (i + 1 < order.size() && times[order[i]] == times[order[i + 1]])
            continue;
        sorted.times.push_back(times[order[i]]);
        sorted.values.push_back(curve.values[order[i]]);
        sorted.attributeOfKey.push_back(curve.attributeOfKey[order[i]]);
    }
    curve.times = std::move(sorted.times);
    curve.values = std::move(sorted.values);
    curve.attributeOfKey = std::move(sorted.attributeOfKey);
}

CurveKeys readCurve(const Document& document, const DocumentObject& object) {
    const auto legacy = static_cast<std::size_t>(object.legacyCurve);
    if (object.legacyCurve >= 0 && legacy < document.legacyCurves.size())
        return document.legacyCurves[legacy];
    return readPackedCurve(*object.body, document.fileTicksPerSecond);
}

} // namespace detail
FBXSDK_NAMESPACE_END
