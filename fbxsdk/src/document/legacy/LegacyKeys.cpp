// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The key list of files before 7.x: time, value, then letters and numbers that define the following segment.
#include "document/legacy/LegacyKeys.h"

#include <algorithm>
#include <utility>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Reads key by key. Whether a letter follows is determined by the list itself: versions of the format differ in what
/// they omit, but the next key always begins with a number.
class KeyList {
public:
    explicit KeyList(std::span<const Value> values) : mValues(values) {}

    [[nodiscard]] bool atEnd() const { return mNext == mValues.size(); }

    /// False when the list has no key at this position.
    bool read(std::int64_t& time, float& value, KeyAttributes& attribute) {
        if (atEnd() || !mValues[mNext].isNumber())
            return false;
        time = mValues[mNext++].toInteger();
        double real = 0;
        if (!readNumber(real))
            return false;
        value = static_cast<float>(real);
        attribute = {};
        return readMode(attribute);
    }

private:
    [[nodiscard]] bool letterFollows() const { return !atEnd() && letterAt(mNext) != 0; }
    [[nodiscard]] char letterAt(std::size_t index) const {
        return mValues[index].isNumber() ? '\0' : mValues[index].toLetter();
    }
    bool readLetter(char& letter) {
        if (!letterFollows())
            return false;
        letter = letterAt(mNext++);
        return true;
    }
    bool readNumber(double& number) {
        if (atEnd() || !mValues[mNext].isNumber())
            return false;
        number = mValues[mNext++].toReal();
        return true;
    }

    bool readMode(KeyAttributes& attribute) {
        char letter = 0;
        if (!readLetter(letter))
            return false;
        switch (letter) {
        case kLegacyLinear:
            attribute.flags = KeyFlag::linear;
            return true;
        case kLegacyConstant:
            return readConstant(attribute);
        case kLegacyCubic:
            return readCubic(attribute);
        default:
            return false;
        }
    }

    bool readConstant(KeyAttributes& attribute) {
        attribute.flags = KeyFlag::constant;
        char which = 0;
        if (!readLetter(which))
            return true; // the oldest files have the standard kind only
        if (which == kLegacyConstantNext)
            attribute.flags |= KeyFlag::constantNext;
        return which == kLegacyConstantNext || which == kLegacyConstantThis;
    }

    bool readCubic(KeyAttributes& attribute) {
        char letter = 0;
        if (!readLetter(letter))
            return false;
        const auto* mode = std::find_if(std::begin(kLegacyTangents), std::end(kLegacyTangents),
                                        [&](const LegacyTangentRow& row) { return row.letter == letter; });
        if (mode == std::end(kLegacyTangents))
            return false;
        attribute.flags = KeyFlag::cubic | mode->flags;
        for (std::size_t i = 0; i < mode->numbers; ++i) {
            double number = 0;
            if (!readNumber(number))
                return false;
            if (mode->kept)
                attribute.data[i] = static_cast<float>(number);
        }
        while (letterFollows())
            if (!readWeights(attribute))
                return false;
        return true;
    }

    bool readWeights(KeyAttributes& attribute) {
        char letter = 0;
        readLetter(letter);
        const auto* mode = std::find_if(std::begin(kLegacyWeights), std::end(kLegacyWeights),
                                        [&](const LegacyWeightRow& row) { return row.letter == letter; });
        if (mode == std::end(kLegacyWeights))
            return false;
        attribute.flags |= mode->flags;
        return readWeight(attribute, mode->flags & KeyFlag::weightedRight, KeyData::rightWeight) &&
               readWeight(attribute, mode->flags & KeyFlag::weightedNextLeft, KeyData::nextLeftWeight);
    }

    bool readWeight(KeyAttributes& attribute, std::uint32_t present, std::size_t index) {
        double weight = 0;
        if (present == 0)
            return true;
        if (!readNumber(weight))
            return false;
        attribute.data[index] = static_cast<float>(weight);
        return true;
    }

    std::span<const Value> mValues;
    std::size_t mNext = 0;
};

/// False when the list does not consist of whole keys, or not of as many as the channel states.
bool readKeys(DocumentBuilder& builder, const Record& channel, const Record& keys, CurveKeys& curve) {
    KeyList list(keys.values);
    while (!list.atEnd()) {
        std::int64_t time = 0;
        float value = 0;
        KeyAttributes attribute;
        if (!list.read(time, value, attribute))
            return false;
        curve.times.push_back(builder.ticks(time));
        curve.values.push_back(value);
        if (curve.attributes.empty() || curve.attributes.back() != attribute)
            curve.attributes.push_back(attribute);
        curve.attributeOfKey.push_back(static_cast<std::uint32_t>(curve.attributes.size() - 1));
    }
    const Record* count = channel.child("KeyCount");
    return !count || std::cmp_equal(count->value(0).toInteger(), curve.times.size());
}

/// Automatic keys are flat at both ends of a curve, as applications show what they write with the letter 'a': 7.x
/// files mark the tangents of such keys as progressively clamped.
void flattenEnd(CurveKeys& curve, std::size_t key) {
    constexpr std::uint32_t kModes = KeyFlag::cubic | KeyFlag::tangentAuto | KeyFlag::tangentTcb |
                                     KeyFlag::tangentUser | KeyFlag::genericBreak | KeyFlag::genericClamp;
    std::uint32_t& index = curve.attributeOfKey[key];
    if ((curve.attributes[index].flags & kModes) != (KeyFlag::cubic | KeyFlag::tangentAuto))
        return;
    const bool shared = std::count(curve.attributeOfKey.begin(), curve.attributeOfKey.end(), index) > 1;
    if (shared) {
        curve.attributes.push_back(curve.attributes[index]);
        index = static_cast<std::uint32_t>(curve.attributes.size() - 1);
    }
    curve.attributes[index].flags |= KeyFlag::genericClampProgressive;
}

void scaleValues(CurveKeys& curve, double scale) {
    const auto factor = static_cast<float>(scale);
    for (float& value : curve.values)
        value *= factor;
    for (KeyAttributes& attribute : curve.attributes)
        if (attribute.flags & KeyFlag::tangentUser) {
            attribute.data[KeyData::rightSlope] *= factor;
            attribute.data[KeyData::nextLeftSlope] *= factor;
        }
}

} // namespace

std::optional<CurveKeys> readLegacyCurve(DocumentBuilder& builder, const Record& channel, double scale) {
    const Record* keys = channel.child("Key");
    if (!keys || keys->values.empty())
        return std::nullopt;
    CurveKeys curve;
    curve.defaultValue = static_cast<float>(channel.childValue("Default").toReal() * scale);
    if (!readKeys(builder, channel, *keys, curve)) {
        builder.warn(*keys, "the key list is incomplete or does not match its key count; the curve is left out");
        return std::nullopt;
    }
    curve.before = readExtrapolation(channel, "Pre-Extrapolation");
    curve.after = readExtrapolation(channel, "Post-Extrapolation");
    sortKeys(curve);
    flattenEnd(curve, 0);
    flattenEnd(curve, curve.times.size() - 1);
    if (scale != 1)
        scaleValues(curve, scale);
    return curve;
}

} // namespace detail
FBXSDK_NAMESPACE_END
