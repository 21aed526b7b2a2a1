// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The value of a keyed curve at any time: find the segment, interpolate it by its left key; outside the keys map
// the time back into them. Arithmetic is in double from whole ticks, results are single precision.
#include "animation/CurveEvaluation.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

#include "animation/CurveSegment.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

double valueOf(const CurveKeys& keys, std::size_t key) { return static_cast<double>(keys.values[key]); }

/// Rounds to single precision; a value out of range becomes the largest float.
inline float toFloat(double value) {
    constexpr double kLargest = static_cast<double>(std::numeric_limits<float>::max());
    return static_cast<float>(std::isfinite(value) ? std::clamp(value, -kLargest, kLargest) : value);
}

inline double bezier(double p0, double p1, double p2, double p3, double u) {
    const double v = 1.0 - u;
    return v * v * v * p0 + 3.0 * v * v * u * p1 + 3.0 * v * u * u * p2 + u * u * u * p3;
}

/// Finds the parameter at which the time cubic 0, right, 1 - left, 1 reaches a part of the segment.
///
/// With weights of 0 to 1 the cubic rises throughout, so there is one; Newton's steps are taken while they stay inside
/// the interval known to hold it, and halved intervals otherwise.
double parameterAt(double part, double right, double left) {
    constexpr int kSteps = 64; // enough to halve the interval until it is empty
    constexpr double kPrecision = 1.0e-15;
    double low = 0.0;
    double high = 1.0;
    double u = part;
    for (int step = 0; step < kSteps; ++step) {
        const double error = bezier(0.0, right, 1.0 - left, 1.0, u) - part;
        if (std::abs(error) <= kPrecision)
            break;
        (error > 0.0 ? high : low) = u;
        const double v = 1.0 - u;
        const double slope = 3.0 * (v * v * right + 2.0 * v * u * (1.0 - left - right) + u * u * left);
        const double next = u - error / slope;
        u = next > low && next < high ? next : (low + high) / 2.0;
    }
    return u;
}

CubicSegment cubicSegment(const CurveKeys& keys, std::size_t key) {
    CubicSegment segment;
    segment.key = key;
    segment.ticks = static_cast<double>(ticksBetween(keys.times[key], keys.times[key + 1]));
    segment.right = rightWeight(keys, key);
    segment.left = leftWeight(keys, key + 1);
    const double seconds = secondsBetween(keys.times[key], keys.times[key + 1]);
    const double start = valueOf(keys, key);
    const double end = valueOf(keys, key + 1);
    segment.values = {start, start + rightSlope(keys, key) * segment.right * seconds,
                      end - leftSlope(keys, key + 1) * segment.left * seconds, end};
    return segment;
}

inline double cubicValue(const CubicSegment& segment, double passed) {
    const double part = passed / segment.ticks;
    const bool plain = segment.right == kEqualWeight && segment.left == kEqualWeight;
    const auto& [start, startHandle, endHandle, end] = segment.values;
    return bezier(start, startHandle, endHandle, end, plain ? part : parameterAt(part, segment.right, segment.left));
}

/// The value strictly between a key and the next one.
double segmentValue(const CurveKeys& keys, std::size_t key, std::int64_t ticks, CurveCursor& cursor) {
    const double passed = static_cast<double>(ticksBetween(keys.times[key], ticks));
    if (cursor.cubic.key == key)
        return cubicValue(cursor.cubic, passed);
    const double start = valueOf(keys, key);
    const double end = valueOf(keys, key + 1);
    switch (interpolationOf(keys, key)) {
    case Interpolation::constant:
        return start;
    case Interpolation::constantNext:
        return end;
    case Interpolation::linear:
        return start + (end - start) * passed / static_cast<double>(ticksBetween(keys.times[key], keys.times[key + 1]));
    case Interpolation::cubic:
        break;
    }
    cursor.cubic = cubicSegment(keys, key);
    return cubicValue(cursor.cubic, passed);
}

/// Whether the time is at or after the key and before the next one.
bool isInSegment(const CurveKeys& keys, std::size_t key, std::int64_t ticks) {
    const std::size_t last = keys.keyCount() - 1;
    return key <= last && keys.times[key] <= ticks && (key == last || ticks < keys.times[key + 1]);
}

/// The last key at or before a time that lies within the keys. Samples usually come in order: the segment of the last
/// one and the segment after it are tried first.
std::size_t segmentAt(const CurveKeys& keys, std::int64_t ticks, CurveCursor& cursor) {
    const std::size_t guess = cursor.segment;
    std::size_t segment = guess;
    if (!isInSegment(keys, guess, ticks)) {
        segment = guess + 1;
        if (guess >= keys.keyCount() || !isInSegment(keys, segment, ticks)) {
            const auto begin = keys.times.begin();
            const auto end = begin + static_cast<std::ptrdiff_t>(keys.keyCount());
            const auto next = std::upper_bound(begin, end, ticks);
            segment = next == begin ? 0 : static_cast<std::size_t>(next - begin) - 1;
        }
    }
    cursor.segment = segment;
    return segment;
}

/// Whether the time is in the cubic segment of the last one, the most frequent case.
bool isWithinCubic(const CurveKeys& keys, std::int64_t ticks, const CurveCursor& cursor) {
    const std::size_t key = cursor.segment;
    return key == cursor.cubic.key && key + 1 < keys.keyCount() && keys.times[key] < ticks &&
           ticks < keys.times[key + 1];
}

double valueWithin(const CurveKeys& keys, std::int64_t ticks, CurveCursor& cursor) {
    const std::size_t key = segmentAt(keys, ticks, cursor);
    const bool between = key + 1 < keys.keyCount() && keys.times[key] < ticks && ticks < keys.times[key + 1];
    return between ? segmentValue(keys, key, ticks, cursor) : valueOf(keys, key);
}

enum class Side { before, after };

/// A time outside the keys mapped into them, and how many repetitions away it is.
struct Repetition {
    std::uint64_t number;
    std::uint64_t offset; ///< from the first key, less than the length of the keys
};

/// Repetitions are half open: where one ends the next one begins with the first key.
Repetition repetitionOf(std::int64_t first, std::uint64_t length, std::int64_t ticks, Side side) {
    if (side == Side::after) {
        const std::uint64_t distance = ticksBetween(first, ticks);
        return {distance / length, distance % length};
    }
    const std::uint64_t distance = ticksBetween(ticks, first); // at least one
    const std::uint64_t rest = distance % length;
    return {(distance - 1) / length + 1, rest == 0 ? 0 : length - rest};
}

/// The value when the repetitions are used up: the end of the last one.
double valueAfterRepetitions(const CurveKeys& keys, const Extrapolation& extrapolation, Side side) {
    const double first = valueOf(keys, 0);
    const double last = valueOf(keys, keys.keyCount() - 1);
    const double here = side == Side::after ? last : first;
    const double there = side == Side::after ? first : last;
    if (extrapolation.type == ExtrapolationType::mirrorRepetition)
        return extrapolation.count % 2 == 0 ? here : there;
    const bool relative = extrapolation.type == ExtrapolationType::relativeRepetition;
    return relative ? here + (here - there) * extrapolation.count : here;
}

double repeatedValue(const CurveKeys& keys, const Extrapolation& extrapolation, std::int64_t ticks, Side side,
                     CurveCursor& cursor) {
    const std::size_t lastKey = keys.keyCount() - 1;
    const std::int64_t first = keys.times[0];
    const std::uint64_t length = ticksBetween(first, keys.times[lastKey]);
    const Repetition repetition = repetitionOf(first, length, ticks, side);
    if (extrapolation.count >= 0 && repetition.number > static_cast<std::uint64_t>(extrapolation.count))
        return valueAfterRepetitions(keys, extrapolation, side);

    const bool mirrored = extrapolation.type == ExtrapolationType::mirrorRepetition && repetition.number % 2 == 1;
    const std::uint64_t offset = mirrored ? length - repetition.offset : repetition.offset;
    const auto inside = static_cast<std::int64_t>(static_cast<std::uint64_t>(first) + offset);
    const double value = valueWithin(keys, inside, cursor);
    if (extrapolation.type != ExtrapolationType::relativeRepetition)
        return value;
    const double rise = (valueOf(keys, lastKey) - valueOf(keys, 0)) * static_cast<double>(repetition.number);
    return side == Side::after ? value + rise : value - rise;
}

double keptSlopeValue(const CurveKeys& keys, std::int64_t ticks, Side side) {
    if (side == Side::before)
        return valueOf(keys, 0) - rightSlope(keys, 0) * secondsBetween(ticks, keys.times[0]);
    const std::size_t last = keys.keyCount() - 1;
    return valueOf(keys, last) + leftSlope(keys, last) * secondsBetween(keys.times[last], ticks);
}

double extrapolatedValue(const CurveKeys& keys, std::int64_t ticks, Side side, CurveCursor& cursor) {
    const Extrapolation& extrapolation = side == Side::before ? keys.before : keys.after;
    const std::size_t last = keys.keyCount() - 1;
    const bool hasLength = keys.times[0] < keys.times[last];
    switch (hasLength ? extrapolation.type : ExtrapolationType::constant) {
    case ExtrapolationType::keepSlope:
        return keptSlopeValue(keys, ticks, side);
    case ExtrapolationType::repetition:
    case ExtrapolationType::mirrorRepetition:
    case ExtrapolationType::relativeRepetition:
        return repeatedValue(keys, extrapolation, ticks, side, cursor);
    case ExtrapolationType::constant:
        break;
    }
    return valueOf(keys, side == Side::before ? 0 : last);
}

} // namespace

float evaluate(const CurveKeys& keys, std::int64_t ticks, CurveCursor* cursor) {
    if (cursor != nullptr && isWithinCubic(keys, ticks, *cursor)) {
        const std::int64_t start = keys.times[cursor->segment];
        return toFloat(cubicValue(cursor->cubic, static_cast<double>(ticksBetween(start, ticks))));
    }
    CurveCursor once;
    CurveCursor& used = cursor != nullptr ? *cursor : once;
    const std::size_t count = keys.keyCount();
    if (count == 0)
        return keys.defaultValue;
    if (ticks < keys.times[0])
        return toFloat(extrapolatedValue(keys, ticks, Side::before, used));
    if (ticks > keys.times[count - 1])
        return toFloat(extrapolatedValue(keys, ticks, Side::after, used));
    return toFloat(valueWithin(keys, ticks, used));
}

void evaluate(const CurveKeys& keys, const FbxTime* times, int count, float* values) {
    CurveCursor cursor;
    for (int i = 0; i < count; ++i) {
        values[i] = evaluate(keys, times[i].Get(), &cursor);
        const std::size_t key = cursor.segment;
        if (key != cursor.cubic.key || key + 1 >= keys.keyCount())
            continue;
        // The following times in the same cubic segment, most of the samples, and at the key at its end.
        const CubicSegment cubic = cursor.cubic;
        const std::int64_t start = keys.times[key];
        const std::int64_t end = keys.times[key + 1];
        for (; i + 1 < count && start < times[i + 1].Get() && times[i + 1].Get() < end; ++i)
            values[i + 1] = toFloat(cubicValue(cubic, static_cast<double>(ticksBetween(start, times[i + 1].Get()))));
        const bool isOnlyKeyThere = key + 2 == keys.keyCount() || end < keys.times[key + 2];
        if (i + 1 < count && times[i + 1].Get() == end && isOnlyKeyThere) {
            ++i;
            values[i] = toFloat(valueOf(keys, key + 1));
            cursor.segment = key + 1;
        }
    }
}

} // namespace detail
FBXSDK_NAMESPACE_END
