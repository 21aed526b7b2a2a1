// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The key list of files before 7.x: time, value, then letters and numbers that say how the curve goes on.
#include "document/legacy/LegacyKeys.h"

#include <algorithm>
#include <utility>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// What stands behind the letters of a cubic key, by its tangent letter.
struct CubicMode {
    char letter;
    std::uint32_t flags;
    int numbers; ///< how many numbers follow …
    bool kept;   ///< … and whether they are the first of Attribute::data; automatic tangents are computed anew
};
constexpr CubicMode kCubicModes[] = {
    {'s', kKeyUser, 2, true},                         // right slope, left slope of the next key
    {'b', kKeyUser | kKeyBreak, 2, true},             // the same, broken
    {'a', kKeyAuto, 0, false},                        //
    {'p', kKeyAuto | kKeyClampProgressive, 2, false}, // slopes
    {'q', kKeyAuto | kKeyClamp, 2, false},            // slopes
    {'t', kKeyTcb, 3, true},                          // tension, continuity, bias
    {'d', kKeyAuto | kKeyBreak, 1, false},            // a slope
};

struct WeightMode {
    char letter;
    std::uint32_t flags;
};
constexpr WeightMode kWeightModes[] = {
    {'n', 0}, {'a', kKeyWeightedRight | kKeyWeightedNextLeft}, {'r', kKeyWeightedRight}, {'l', kKeyWeightedNextLeft},
    {'c', 0},
};
constexpr int kRightWeight = 2;
constexpr int kNextLeftWeight = 3;

/// Reads key by key. Whether a letter follows is seen from the list itself: versions of the format differ in what they
/// leave out, but the next key always begins with a number.
class KeyList {
public:
    explicit KeyList(std::span<const Value> values) : mValues(values) {}

    [[nodiscard]] bool atEnd() const { return mNext == mValues.size(); }

    /// False when the list does not hold a key at this place.
    bool read(std::int64_t& time, float& value, DocumentCurve::Attribute& attribute) {
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

    bool readMode(DocumentCurve::Attribute& attribute) {
        char letter = 0;
        if (!readLetter(letter))
            return false;
        switch (letter) {
        case 'L':
            attribute.flags = kKeyLinear;
            return true;
        case 'C':
            return readConstant(attribute);
        case 'U':
            return readCubic(attribute);
        default:
            return false;
        }
    }

    bool readConstant(DocumentCurve::Attribute& attribute) {
        attribute.flags = kKeyConstant;
        char which = 0;
        if (!readLetter(which))
            return true; // the oldest files have the standard kind only
        if (which == 'n')
            attribute.flags |= kKeyConstantNext;
        return which == 'n' || which == 's';
    }

    bool readCubic(DocumentCurve::Attribute& attribute) {
        char letter = 0;
        if (!readLetter(letter))
            return false;
        const auto* mode = std::find_if(std::begin(kCubicModes), std::end(kCubicModes),
                                        [&](const CubicMode& row) { return row.letter == letter; });
        if (mode == std::end(kCubicModes))
            return false;
        attribute.flags = kKeyCubic | mode->flags;
        for (int i = 0; i < mode->numbers; ++i) {
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

    bool readWeights(DocumentCurve::Attribute& attribute) {
        char letter = 0;
        readLetter(letter);
        const auto* mode = std::find_if(std::begin(kWeightModes), std::end(kWeightModes),
                                        [&](const WeightMode& row) { return row.letter == letter; });
        if (mode == std::end(kWeightModes))
            return false;
        attribute.flags |= mode->flags;
        return readWeight(attribute, mode->flags & kKeyWeightedRight, kRightWeight) &&
               readWeight(attribute, mode->flags & kKeyWeightedNextLeft, kNextLeftWeight);
    }

    bool readWeight(DocumentCurve::Attribute& attribute, std::uint32_t present, int index) {
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

/// False when the list does not hold whole keys, or not as many as the channel says.
bool readKeys(DocumentBuilder& builder, const Record& channel, const Record& keys, DocumentCurve& curve) {
    KeyList list(keys.values);
    while (!list.atEnd()) {
        std::int64_t time = 0;
        float value = 0;
        DocumentCurve::Attribute attribute;
        if (!list.read(time, value, attribute))
            return false;
        curve.times.push_back(builder.ticks(time));
        curve.values.push_back(value);
        appendAttribute(curve, attribute);
    }
    const Record* count = channel.child("KeyCount");
    return !count || std::cmp_equal(count->value(0).toInteger(), curve.times.size());
}

/// Automatic keys are flat at both ends of a curve, as applications show what they write with the letter 'a': what 7.x
/// files say of such keys is that their tangents are clamped progressively.
void flattenEnd(DocumentCurve& curve, std::size_t key) {
    constexpr std::uint32_t kModes = kKeyCubic | kKeyAuto | kKeyTcb | kKeyUser | kKeyBreak | kKeyClamp;
    std::uint32_t& index = curve.attributeIndex[key];
    if ((curve.attributes[index].flags & kModes) != (kKeyCubic | kKeyAuto))
        return;
    const bool shared = std::count(curve.attributeIndex.begin(), curve.attributeIndex.end(), index) > 1;
    if (shared) {
        curve.attributes.push_back(curve.attributes[index]);
        index = static_cast<std::uint32_t>(curve.attributes.size() - 1);
    }
    curve.attributes[index].flags |= kKeyClampProgressive;
}

} // namespace

void appendAttribute(DocumentCurve& curve, const DocumentCurve::Attribute& attribute) {
    const auto same = [&](const DocumentCurve::Attribute& last) {
        return last.flags == attribute.flags && std::equal(std::begin(last.data), std::end(last.data), attribute.data);
    };
    if (curve.attributes.empty() || !same(curve.attributes.back()))
        curve.attributes.push_back(attribute);
    curve.attributeIndex.push_back(static_cast<std::uint32_t>(curve.attributes.size() - 1));
}

std::optional<DocumentCurve> readLegacyCurve(DocumentBuilder& builder, const Record& channel) {
    const Record* keys = channel.child("Key");
    if (!keys || keys->values.empty())
        return std::nullopt;
    DocumentCurve curve;
    curve.defaultValue = channel.childValue("Default").toReal();
    if (!readKeys(builder, channel, *keys, curve)) {
        builder.warn(*keys, "the keys do not add up; the curve is left out.");
        return std::nullopt;
    }
    curve.pre = readExtrapolation(channel, "Pre-Extrapolation");
    curve.post = readExtrapolation(channel, "Post-Extrapolation");
    sortKeys(curve);
    flattenEnd(curve, 0);
    flattenEnd(curve, curve.times.size() - 1);
    return curve;
}

} // namespace detail
FBXSDK_NAMESPACE_END
