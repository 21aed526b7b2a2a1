// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The inverse of CurveReading and LegacyKeys.
#include "document/DocumentSections.h"

#include <algorithm>
#include <bit>
#include <cmath>

#include "document/RecordWriting.h"
#include "document/legacy/LegacyKeys.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// The weight where the flags set none: a third.
constexpr std::uint32_t kDefaultPackedWeight = 3333;

std::uint32_t packedWeight(float weight, bool given) {
    if (!given)
        return kDefaultPackedWeight;
    return static_cast<std::uint32_t>(
        std::lround(std::clamp(std::isnan(weight) ? 0.0F : weight, 0.0F, 1.0F) * kPackedUnit));
}

std::uint32_t packedVelocity(float velocity, bool given) {
    constexpr float kLargest = 32767.0F / kPackedUnit;
    if (!given || std::isnan(velocity))
        return 0;
    const long units = std::lround(std::clamp(velocity, -kLargest, kLargest) * kPackedUnit);
    return static_cast<std::uint32_t>(units) & 0xFFFFU;
}

bool isTcb(const KeyAttributes& attribute) {
    return (attribute.flags & KeyFlag::cubic) != 0 && (attribute.flags & KeyFlag::tangentTcb) != 0;
}

void packAttribute(const KeyAttributes& attribute, std::vector<std::uint32_t>& words) {
    const auto has = [&](std::uint32_t flag) { return (attribute.flags & flag) != 0; };
    words.push_back(std::bit_cast<std::uint32_t>(attribute.data[0]));
    words.push_back(std::bit_cast<std::uint32_t>(attribute.data[1]));
    if (isTcb(attribute)) {
        words.push_back(std::bit_cast<std::uint32_t>(attribute.data[2]));
        words.push_back(0);
        return;
    }
    words.push_back(packedWeight(attribute.data[2], has(KeyFlag::weightedRight)) |
                    packedWeight(attribute.data[3], has(KeyFlag::weightedNextLeft)) << 16U);
    words.push_back(packedVelocity(attribute.data[4], has(KeyFlag::velocityRight)) |
                    packedVelocity(attribute.data[5], has(KeyFlag::velocityNextLeft)) << 16U);
}

/// The keys' attributes, one entry for each run of keys that share theirs.
struct PackedAttributes {
    std::vector<std::int32_t> flags, counts;
    std::vector<std::uint32_t> words;
};

/// The first key after one that does not have its index of attributes.
std::size_t endOfRun(const CurveKeys& curve, std::size_t key) {
    const std::vector<std::uint32_t>& indices = curve.attributeOfKey;
    if (key >= indices.size())
        return curve.keyCount();
    const auto first = indices.begin() + static_cast<std::ptrdiff_t>(key);
    const auto end = std::find_if(first, indices.end(), [first](std::uint32_t index) { return index != *first; });
    return std::min(curve.keyCount(), static_cast<std::size_t>(end - indices.begin()));
}

PackedAttributes packAttributes(const CurveKeys& curve) {
    PackedAttributes packed;
    const KeyAttributes* last = nullptr;
    for (std::size_t key = 0, next = 0; key < curve.keyCount(); key = next) {
        const KeyAttributes& attribute = curve.attributesOf(key);
        next = endOfRun(curve, key);
        const auto count = static_cast<std::int32_t>(next - key);
        if (&attribute == last) {
            packed.counts.back() += count;
            continue;
        }
        last = &attribute;
        packed.flags.push_back(std::bit_cast<std::int32_t>(attribute.flags));
        packed.counts.push_back(count);
        packAttribute(attribute, packed.words);
    }
    return packed;
}

void writeExtrapolation(RecordSink& sink, const VersionTraits& traits, std::string_view name,
                        const Extrapolation& extrapolation) {
    const bool known = extrapolation.type != ExtrapolationType::relativeRepetition || traits.relativeExtrapolation;
    if (extrapolation.type == ExtrapolationType::constant || !known)
        return;
    for (const ExtrapolationRow& row : kExtrapolations) {
        if (row.type != extrapolation.type)
            continue;
        const BlockScope block(sink, name);
        writeLetter(sink, "Type", row.letter);
        writeInteger(sink, "Repetition", extrapolation.count);
    }
}

void writeExtrapolations(RecordSink& sink, const VersionTraits& traits, const CurveKeys& curve) {
    writeExtrapolation(sink, traits, "Pre-Extrapolation", curve.before);
    writeExtrapolation(sink, traits, "Post-Extrapolation", curve.after);
}

template <class Row, std::size_t Count>
const Row& rowOf(const Row (&rows)[Count], std::uint32_t flags) {
    return *std::find_if(
        std::begin(rows), std::end(rows), [=](const Row& row) { return row.flags == flags; });
}

/// How a cubic key is written: user or TCB tangents, or else automatic ones, whose letters say no more.
std::uint32_t legacyTangent(const KeyAttributes& attribute) {
    if (isTcb(attribute))
        return KeyFlag::tangentTcb;
    const bool user = (attribute.flags & KeyFlag::tangentUser) != 0;
    return user ? attribute.flags & (KeyFlag::tangentUser | KeyFlag::genericBreak) : KeyFlag::tangentAuto;
}

/// `n`, `a,right,next left`, `r,right` or `l,next left`.
void writeLegacyWeights(RecordSink& sink, const KeyAttributes& attribute) {
    const std::uint32_t flags = attribute.flags & (KeyFlag::weightedRight | KeyFlag::weightedNextLeft);
    sink.letter(rowOf(kLegacyWeights, flags).letter);
    if ((flags & KeyFlag::weightedRight) != 0)
        sink.real(static_cast<double>(attribute.data[2]));
    if ((flags & KeyFlag::weightedNextLeft) != 0)
        sink.real(static_cast<double>(attribute.data[3]));
}

void writeLegacyCubic(RecordSink& sink, const KeyAttributes& attribute) {
    const LegacyTangentRow& row = rowOf(kLegacyTangents, legacyTangent(attribute));
    sink.letter(kLegacyCubic);
    sink.letter(row.letter);
    for (std::size_t i = 0; i < row.numbers; ++i)
        sink.real(static_cast<double>(attribute.data[i]));
    if (!isTcb(attribute))
        writeLegacyWeights(sink, attribute);
}

void writeLegacyMode(RecordSink& sink, const KeyAttributes& attribute) {
    if ((attribute.flags & KeyFlag::constant) != 0) {
        sink.letter(kLegacyConstant);
        sink.letter((attribute.flags & KeyFlag::constantNext) != 0 ? kLegacyConstantNext : kLegacyConstantThis);
    } else if ((attribute.flags & KeyFlag::cubic) != 0) {
        writeLegacyCubic(sink, attribute);
    } else {
        sink.letter(kLegacyLinear);
    }
}

} // namespace

void writeCurve(RecordSink& sink, const VersionTraits& traits, const CurveKeys& curve) {
    const PackedAttributes packed = packAttributes(curve);
    writeReal(sink, "Default", static_cast<double>(curve.defaultValue));
    writeInteger(sink, "KeyVer", traits.keyVersion);
    writeArray<std::int64_t>(sink, "KeyTime", std::span(curve.times).first(curve.keyCount()));
    writeArray<float>(sink, "KeyValueFloat", std::span(curve.values).first(curve.keyCount()));
    writeArray<std::int32_t>(sink, "KeyAttrFlags", packed.flags);
    sink.beginRecord("KeyAttrDataFloat");
    sink.floatBits(packed.words);
    sink.endRecord();
    writeArray<std::int32_t>(sink, "KeyAttrRefCount", packed.counts);
    writeExtrapolations(sink, traits, curve);
}

void writeLegacyCurve(RecordSink& sink, const VersionTraits& traits, const CurveKeys& curve, double defaultValue) {
    writeReal(sink, "Default", defaultValue);
    if (curve.keyCount() == 0)
        return;
    writeInteger(sink, "KeyVer", traits.keyVersion);
    writeInteger(sink, "KeyCount", static_cast<std::int32_t>(curve.keyCount()));
    sink.beginRecord("Key");
    for (std::size_t key = 0; key < curve.keyCount(); ++key) {
        sink.longInteger(curve.times[key]);
        sink.real(static_cast<double>(curve.values[key]));
        writeLegacyMode(sink, curve.attributesOf(key));
    }
    sink.endRecord();
    writeExtrapolations(sink, traits, curve);
}

} // namespace detail
FBXSDK_NAMESPACE_END
