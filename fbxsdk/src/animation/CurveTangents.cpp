// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Slopes of curves at their keys. User tangents are stored; auto and TCB tangents (Kochanek and Bartels, "Interpolating
// Splines with Local Tension, Continuity, and Bias Control") follow from the keys on both sides. Which formula holds
// for a key's left side is determined by the key's own flags; its numbers are stored with the key before.
//
// The meaning of stored numbers next to auto tangents was determined with files of MotionBuilder, which keeps the
// tangent's handle where its user put it: a bias is positive toward its own side, left and right alike, and keys that
// are independent of time have none (their number on the left repeats the slope or the shift that the flag represents).
#include "animation/CurveEvaluation.h"

#include <cmath>
#include <utility>

#include "animation/CurveSegment.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Adjacent values that differ by no more count as equal to a clamped tangent.
constexpr double kClampThreshold = 1.0e-5;

/// From this bias on, in percent, an amount is added that does not depend on the adjacent keys.
constexpr double kAbsoluteBias = 500.0;
constexpr double kAbsoluteBiasSlope = 40.0; ///< per second, for every 100 percent squared

/// The formulas' view of a key's adjacent keys. At an end both chords are the one that exists.
struct Neighbourhood {
    double leftRise = 0.0; ///< value minus that of the key before
    double leftSeconds = 0.0;
    double leftChord = 0.0;
    double rightRise = 0.0;
    double rightSeconds = 0.0;
    double rightChord = 0.0;
    bool hasLeft = false;
    bool hasRight = false;
};

double chord(double rise, double seconds) { return seconds > 0.0 ? rise / seconds : 0.0; }

Neighbourhood neighbourhoodOf(const CurveKeys& keys, std::size_t key) {
    Neighbourhood n;
    n.hasLeft = key > 0;
    n.hasRight = key + 1 < keys.keyCount();
    const double value = static_cast<double>(keys.values[key]);
    if (n.hasLeft) {
        n.leftRise = value - static_cast<double>(keys.values[key - 1]);
        n.leftSeconds = secondsBetween(keys.times[key - 1], keys.times[key]);
        n.leftChord = chord(n.leftRise, n.leftSeconds);
    }
    if (n.hasRight) {
        n.rightRise = static_cast<double>(keys.values[key + 1]) - value;
        n.rightSeconds = secondsBetween(keys.times[key], keys.times[key + 1]);
        n.rightChord = chord(n.rightRise, n.rightSeconds);
    }
    if (!n.hasLeft)
        n.leftChord = n.rightChord;
    if (!n.hasRight)
        n.rightChord = n.leftChord;
    return n;
}

/// Moves a slope toward the right (positive) or left (negative) chord, by percent and beyond.
double biased(double slope, double bias, const Neighbourhood& n) {
    const double target = bias > 0.0 ? n.rightChord : n.leftChord;
    const double percent = std::abs(bias);
    double result = slope + (target - slope) * percent / 100.0;
    if (percent > kAbsoluteBias) {
        const double excess = (percent - kAbsoluteBias) / 100.0;
        const double turn = n.rightChord >= n.leftChord ? 1.0 : -1.0; // from the left chord to the right one
        result += std::copysign(kAbsoluteBiasSlope, bias) * turn * excess * excess;
    }
    return result;
}

/// Shortens a slope so that a handle of that many seconds does not exceed the adjacent value.
double limited(double slope, double rise, double handleSeconds) {
    if (!(slope * rise > 0.0))
        return 0.0;
    const double limit = std::abs(rise) / handleSeconds;
    return std::abs(slope) > limit ? std::copysign(limit, slope) : slope;
}

bool isFlat(const Neighbourhood& n) {
    return (n.hasLeft && std::abs(n.leftRise) <= kClampThreshold) ||
           (n.hasRight && std::abs(n.rightRise) <= kClampThreshold);
}

bool isTimeIndependent(std::uint32_t flags) {
    return (flags & (KeyFlag::genericTimeIndependent | KeyFlag::genericClampProgressive)) != 0;
}

/// The slope of an auto tangent; the bias is positive to the right.
double autoSlope(const CurveKeys& keys, std::size_t key, double bias) {
    const std::uint32_t flags = keys.attributesOf(key).flags;
    const bool progressive = (flags & KeyFlag::genericClampProgressive) != 0;
    const bool timeIndependent = isTimeIndependent(flags);
    const Neighbourhood n = neighbourhoodOf(keys, key);
    const bool inside = n.hasLeft && n.hasRight;
    if (progressive && !inside)
        return 0.0;

    double slope = (n.leftChord + n.rightChord) / 2.0;
    if (timeIndependent && inside)
        slope = chord(n.leftRise + n.rightRise, n.leftSeconds + n.rightSeconds);
    else if (!timeIndependent)
        slope = biased(slope, bias, n);

    if ((flags & KeyFlag::genericClamp) != 0 && isFlat(n))
        return 0.0;
    if (progressive) {
        slope = limited(slope, n.leftRise, leftWeight(keys, key) * n.leftSeconds);
        slope = limited(slope, n.rightRise, rightWeight(keys, key) * n.rightSeconds);
    }
    return slope;
}

/// The slopes of a TCB tangent. At an end the missing chord counts as zero and the other one in full.
struct TcbSlopes {
    double left;
    double right;
};

TcbSlopes tcbSlopes(const CurveKeys& keys, std::size_t key) {
    const auto& data = keys.attributesOf(key).data;
    const Neighbourhood n = neighbourhoodOf(keys, key);
    const double t = 1.0 - static_cast<double>(data[KeyData::tension]);
    const double c = static_cast<double>(data[KeyData::continuity]);
    const double b = static_cast<double>(data[KeyData::bias]);
    const double factor = (n.hasLeft && n.hasRight ? 0.5 : 1.0) * t;
    const double before = n.hasLeft ? n.leftChord : 0.0;
    const double after = n.hasRight ? n.rightChord : 0.0;
    return {factor * ((1.0 + b) * (1.0 - c) * before + (1.0 - b) * (1.0 + c) * after),
            factor * ((1.0 + b) * (1.0 + c) * before + (1.0 - b) * (1.0 - c) * after)};
}

enum class Tangent { stored, automatic, tcb };

Tangent tangentOf(const KeyAttributes& attributes) {
    const std::uint32_t flags = attributes.flags;
    if ((flags & (KeyFlag::tangentUser | KeyFlag::constant)) != 0)
        return Tangent::stored; // the auto bit of a constant key means "next"
    if ((flags & KeyFlag::tangentTcb) != 0)
        return Tangent::tcb;
    return (flags & KeyFlag::tangentAuto) != 0 ? Tangent::automatic : Tangent::stored;
}

/// The number stored for the left side of a key. The first key has none, nor has one after a TCB key, where that number
/// is the continuity: they are smooth, so the number of the right side is used (a bias with the other sign).
double storedLeft(const CurveKeys& keys, std::size_t key, Tangent tangent) {
    if (key > 0 && tangentOf(keys.attributesOf(key - 1)) != Tangent::tcb)
        return static_cast<double>(keys.attributesOf(key - 1).data[KeyData::nextLeftSlope]);
    const double right = static_cast<double>(keys.attributesOf(key).data[KeyData::rightSlope]);
    return tangent == Tangent::automatic ? -right : right;
}

double usableWeight(float weight) {
    constexpr float kSmallest = 0.0001F;
    constexpr float kLargest = 0.99F;
    if (!(weight >= kSmallest))
        return std::isnan(weight) ? kEqualWeight : static_cast<double>(kSmallest);
    return static_cast<double>(weight > kLargest ? kLargest : weight);
}

double finiteOrFlat(double slope) { return std::isfinite(slope) ? slope : 0.0; }

double cubicRightSlope(const CurveKeys& keys, std::size_t key) {
    const KeyAttributes& attributes = keys.attributesOf(key);
    const double stored = static_cast<double>(attributes.data[KeyData::rightSlope]);
    switch (tangentOf(attributes)) {
    case Tangent::automatic:
        return autoSlope(keys, key, stored);
    case Tangent::tcb:
        return tcbSlopes(keys, key).right;
    case Tangent::stored:
        break;
    }
    return stored;
}

double cubicLeftSlope(const CurveKeys& keys, std::size_t key) {
    const Tangent tangent = tangentOf(keys.attributesOf(key));
    switch (tangent) {
    case Tangent::automatic:
        return autoSlope(keys, key, -storedLeft(keys, key, tangent));
    case Tangent::tcb:
        return tcbSlopes(keys, key).left;
    case Tangent::stored:
        break;
    }
    return storedLeft(keys, key, tangent);
}

/// Whether an auto key's slope has a part that does not follow the values of the keys.
bool hasAbsoluteBias(const CurveKeys& keys, std::size_t key) {
    const KeyAttributes& attributes = keys.attributesOf(key);
    const Tangent tangent = tangentOf(attributes);
    if (tangent != Tangent::automatic || isTimeIndependent(attributes.flags))
        return false;
    const double right = static_cast<double>(attributes.data[KeyData::rightSlope]);
    return std::abs(right) > kAbsoluteBias || std::abs(storedLeft(keys, key, tangent)) > kAbsoluteBias;
}

/// The slope of a segment that is no cubic.
double straightSlope(const CurveKeys& keys, std::size_t segment) {
    if (interpolationOf(keys, segment) != Interpolation::linear || segment + 1 >= keys.keyCount())
        return 0.0;
    return neighbourhoodOf(keys, segment).rightChord;
}

} // namespace

double rightWeight(const CurveKeys& keys, std::size_t key) {
    const KeyAttributes& attributes = keys.attributesOf(key);
    const bool weighted = (attributes.flags & KeyFlag::weightedRight) != 0 && tangentOf(attributes) != Tangent::tcb;
    return weighted ? usableWeight(attributes.data[KeyData::rightWeight]) : kEqualWeight;
}

double leftWeight(const CurveKeys& keys, std::size_t key) {
    if (key == 0)
        return kEqualWeight;
    const KeyAttributes& attributes = keys.attributesOf(key - 1);
    const bool weighted = (attributes.flags & KeyFlag::weightedNextLeft) != 0 && tangentOf(attributes) != Tangent::tcb;
    return weighted ? usableWeight(attributes.data[KeyData::nextLeftWeight]) : kEqualWeight;
}

double rightSlope(const CurveKeys& keys, std::size_t key) {
    const bool cubic = interpolationOf(keys, key) == Interpolation::cubic;
    return finiteOrFlat(cubic ? cubicRightSlope(keys, key) : straightSlope(keys, key));
}

double leftSlope(const CurveKeys& keys, std::size_t key) {
    const std::size_t segment = key > 0 ? key - 1 : key; // the first key: as if the curve started earlier
    const bool cubic = interpolationOf(keys, segment) == Interpolation::cubic;
    return finiteOrFlat(cubic ? cubicLeftSlope(keys, key) : straightSlope(keys, segment));
}

void multiplyValues(CurveKeys& keys, float factor) {
    CurveKeys result;
    result.attributeOfKey.resize(keys.keyCount());
    for (std::size_t key = 0; key < keys.keyCount(); ++key) {
        KeyAttributes attributes = keys.attributesOf(key);
        const Tangent tangent = tangentOf(attributes);
        const auto multiplied = [factor](double slope) {
            return static_cast<float>(slope * static_cast<double>(factor));
        };
        if (hasAbsoluteBias(keys, key)) {
            attributes.flags =
                (attributes.flags & ~KeyFlag::tangentAuto) | KeyFlag::tangentUser | KeyFlag::genericBreak;
        }
        if (tangent == Tangent::stored || hasAbsoluteBias(keys, key))
            attributes.data[KeyData::rightSlope] = multiplied(cubicRightSlope(keys, key));
        const std::size_t next = key + 1;
        const bool hasNext = next < keys.keyCount() && tangent != Tangent::tcb;
        if (hasNext && (tangentOf(keys.attributesOf(next)) == Tangent::stored || hasAbsoluteBias(keys, next)))
            attributes.data[KeyData::nextLeftSlope] = multiplied(cubicLeftSlope(keys, next));
        result.setAttributes(key, attributes);
    }

    keys.attributes = std::move(result.attributes);
    keys.attributeOfKey = std::move(result.attributeOfKey);
    for (float& value : keys.values)
        value *= factor;
    keys.defaultValue *= factor;
}

} // namespace detail
FBXSDK_NAMESPACE_END
