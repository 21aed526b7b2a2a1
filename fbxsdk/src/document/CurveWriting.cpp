// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The mirror of CurveReading and LegacyKeys.
#include "document/CurveWriting.h"

#include <algorithm>
#include <bit>
#include <cmath>

#include "document/RecordWriting.h"
#include "document/legacy/LegacyKeys.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Weights and velocities are stored as whole numbers of this unit.
constexpr float kPackedUnit = 9999.0F;
/// The weight that counts where the flags name none: a third.
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

bool isTcb(const DocumentCurve::Attribute& attribute) {
    return (attribute.flags & kKeyCubic) != 0 && (attribute.flags & kKeyTcb) != 0;
}

void packAttribute(const DocumentCurve::Attribute& attribute, std::vector<std::uint32_t>& words) {
    const auto has = [&](std::uint32_t flag) { return (attribute.flags & flag) != 0; };
    words.push_back(std::bit_cast<std::uint32_t>(attribute.data[0]));
    words.push_back(std::bit_cast<std::uint32_t>(attribute.data[1]));
    if (isTcb(attribute)) {
        words.push_back(std::bit_cast<std::uint32_t>(attribute.data[2]));
        words.push_back(0);
        return;
    }
    words.push_back(packedWeight(attribute.data[2], has(kKeyWeightedRight)) |
                    packedWeight(attribute.data[3], has(kKeyWeightedNextLeft)) << 16U);
    words.push_back(packedVelocity(attribute.data[4], has(kKeyVelocityRight)) |
                    packedVelocity(attribute.data[5], has(kKeyVelocityNextLeft)) << 16U);
}

/// The keys' attributes, one entry for each run of keys that share theirs.
struct PackedAttributes {
    std::vector<std::int32_t> flags, counts;
    std::vector<std::uint32_t> words;
};

const DocumentCurve::Attribute& attributeOf(const DocumentCurve& curve, std::size_t key) {
    static const DocumentCurve::Attribute kLinear{.flags = kKeyLinear};
    const std::size_t index = key < curve.attributeIndex.size() ? curve.attributeIndex[key] : curve.attributes.size();
    return index < curve.attributes.size() ? curve.attributes[index] : kLinear;
}

PackedAttributes packAttributes(const DocumentCurve& curve) {
    PackedAttributes packed;
    const DocumentCurve::Attribute* last = nullptr;
    for (std::size_t key = 0; key < curve.times.size(); ++key) {
        const DocumentCurve::Attribute& attribute = attributeOf(curve, key);
        if (&attribute == last) {
            ++packed.counts.back();
            continue;
        }
        last = &attribute;
        packed.flags.push_back(std::bit_cast<std::int32_t>(attribute.flags));
        packed.counts.push_back(1);
        packAttribute(attribute, packed.words);
    }
    return packed;
}

void writeExtrapolation(RecordSink& sink, const VersionTraits& traits, std::string_view name,
                        const DocumentCurve::Extrapolation& extrapolation) {
    constexpr char kConstant = 'C', kRelative = 'A';
    const bool known = extrapolation.type != kRelative || traits.relativeExtrapolation;
    if (extrapolation.type == kConstant || !known)
        return;
    const BlockScope block(sink, name);
    writeLetter(sink, "Type", extrapolation.type);
    writeInteger(sink, "Repetition", extrapolation.repetitions);
}

void writeExtrapolations(RecordSink& sink, const VersionTraits& traits, const DocumentCurve& curve) {
    writeExtrapolation(sink, traits, "Pre-Extrapolation", curve.pre);
    writeExtrapolation(sink, traits, "Post-Extrapolation", curve.post);
}

/// `n`, `a,right,next left`, `r,right` or `l,next left`.
void writeLegacyWeights(RecordSink& sink, const DocumentCurve::Attribute& attribute) {
    constexpr struct {
        std::uint32_t flags;
        char letter;
    } kModes[] = {{kKeyWeightedRight | kKeyWeightedNextLeft, 'a'},
                  {kKeyWeightedRight, 'r'},
                  {kKeyWeightedNextLeft, 'l'},
                  {0, 'n'}};
    const std::uint32_t flags = attribute.flags & (kKeyWeightedRight | kKeyWeightedNextLeft);
    for (const auto& mode : kModes) {
        if (mode.flags == flags)
            sink.letter(mode.letter);
    }
    if ((flags & kKeyWeightedRight) != 0)
        sink.real(static_cast<double>(attribute.data[2]));
    if ((flags & kKeyWeightedNextLeft) != 0)
        sink.real(static_cast<double>(attribute.data[3]));
}

void writeLegacyCubic(RecordSink& sink, const DocumentCurve::Attribute& attribute) {
    sink.letter('U');
    if (isTcb(attribute)) {
        sink.letter('t');
        for (const float number : {attribute.data[0], attribute.data[1], attribute.data[2]})
            sink.real(static_cast<double>(number));
        return;
    }
    if ((attribute.flags & kKeyUser) == 0) {
        sink.letter('a');
    } else {
        sink.letter((attribute.flags & kKeyBreak) != 0 ? 'b' : 's');
        sink.real(static_cast<double>(attribute.data[0]));
        sink.real(static_cast<double>(attribute.data[1]));
    }
    writeLegacyWeights(sink, attribute);
}

void writeLegacyMode(RecordSink& sink, const DocumentCurve::Attribute& attribute) {
    if ((attribute.flags & kKeyConstant) != 0) {
        sink.letter('C');
        sink.letter((attribute.flags & kKeyConstantNext) != 0 ? 'n' : 's');
    } else if ((attribute.flags & kKeyCubic) != 0) {
        writeLegacyCubic(sink, attribute);
    } else {
        sink.letter('L');
    }
}

} // namespace

void writeCurve(RecordSink& sink, const VersionTraits& traits, const DocumentCurve& curve) {
    const PackedAttributes packed = packAttributes(curve);
    writeReal(sink, "Default", curve.defaultValue);
    writeInteger(sink, "KeyVer", traits.keyVersion);
    writeArray<std::int64_t>(sink, "KeyTime", curve.times);
    writeArray<float>(sink, "KeyValueFloat", curve.values);
    writeArray<std::int32_t>(sink, "KeyAttrFlags", packed.flags);
    sink.beginRecord("KeyAttrDataFloat");
    sink.floatBits(packed.words);
    sink.endRecord();
    writeArray<std::int32_t>(sink, "KeyAttrRefCount", packed.counts);
    writeExtrapolations(sink, traits, curve);
}

void writeLegacyCurve(RecordSink& sink, const VersionTraits& traits, const DocumentCurve& curve) {
    writeReal(sink, "Default", curve.defaultValue);
    if (curve.times.empty())
        return;
    writeInteger(sink, "KeyVer", traits.keyVersion);
    writeInteger(sink, "KeyCount", static_cast<std::int32_t>(curve.times.size()));
    sink.beginRecord("Key");
    for (std::size_t key = 0; key < curve.times.size(); ++key) {
        sink.longInteger(curve.times[key]);
        sink.real(static_cast<double>(curve.values[key]));
        writeLegacyMode(sink, attributeOf(curve, key));
    }
    sink.endRecord();
    writeExtrapolations(sink, traits, curve);
}

} // namespace detail
FBXSDK_NAMESPACE_END
