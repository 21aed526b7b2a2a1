// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Candidates are tested with all times; the first that fits is refined with the time furthest from zero.
#include "animation/FrameRateOfTimes.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <vector>

#include "animation/CurveSegment.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr double kTicksPerSecond = 46186158000.0;

/// How far from a whole frame, in frames, a time still counts as that frame.
constexpr double kFrameTolerance = 0.01;
/// The fraction of the times that must be whole frames: a few keys between frames do not change the rate.
constexpr double kFittingPart = 0.9;

constexpr double kSlowest = 12.0;
constexpr double kFastest = 1000.0;
constexpr double kUsualRates[] = {30.0, 24.0, 25.0,  29.97, 23.976,       60.0,  50.0,
                                  48.0, 15.0, 59.94, 120.0, 119.88010468, 100.0, 1000.0};

/// Rates that a float cannot distinguish are equal: hosts keep their rate in one.
constexpr double kSameRate = 1.5e-7;

double framesAt(std::int64_t ticks, double rate) { return static_cast<double>(ticks) / kTicksPerSecond * rate; }

bool isWholeFrame(std::int64_t ticks, double rate) {
    const double frames = framesAt(ticks, rate);
    return std::abs(frames - std::round(frames)) <= kFrameTolerance;
}

bool fits(std::span<const std::int64_t> times, double rate) {
    const auto whole = std::count_if(times.begin(), times.end(), [&](std::int64_t t) { return isWholeFrame(t, rate); });
    return static_cast<double>(whole) >= kFittingPart * static_cast<double>(times.size());
}

/// The most frequent distance between adjacent times, up to rounding to whole ticks; 0 without any.
double usualDistance(std::span<const std::int64_t> times) {
    std::vector<std::uint64_t> distances;
    for (std::size_t i = 1; i < times.size(); ++i)
        distances.push_back(ticksBetween(times[i - 1], times[i]));
    std::sort(distances.begin(), distances.end());
    std::size_t most = 0;
    double usual = 0.0;
    for (std::size_t begin = 0; begin < distances.size();) {
        constexpr std::uint64_t kRounding = 400; // of a writer that counts 141120000 ticks per second
        const std::uint64_t least = distances[begin];
        const auto next = std::find_if(distances.begin() + static_cast<std::ptrdiff_t>(begin), distances.end(),
                                       [&](std::uint64_t distance) { return distance - least > kRounding; });
        const auto end = static_cast<std::size_t>(next - distances.begin());
        if (end - begin > most) {
            most = end - begin;
            usual = static_cast<double>(distances[begin + most / 2]);
        }
        begin = end;
    }
    return usual;
}

/// The same rate measured over the longest distance: the time furthest from 0 that is a whole frame.
double measured(std::span<const std::int64_t> times, double rate) {
    double furthest = 0.0, frames = 0.0;
    for (const std::int64_t time : times) {
        const auto ticks = static_cast<double>(time);
        if (isWholeFrame(time, rate) && std::abs(ticks) > std::abs(furthest)) {
            furthest = ticks;
            frames = std::round(framesAt(time, rate));
        }
    }
    return frames != 0.0 ? frames * kTicksPerSecond / furthest : rate;
}

/// The intended rate: a usual one, a decimal fraction, or one slowed down by 1000/1001.
double meantRate(double rate) {
    const auto isMeant = [&](double candidate) { return std::abs(rate / candidate - 1.0) <= kSameRate; };
    const double slowed = std::round(rate * 1.001) / 1.001;
    const auto* const usual = std::find_if(std::begin(kUsualRates), std::end(kUsualRates), isMeant);
    if (usual != std::end(kUsualRates))
        return *usual;
    for (const double candidate : {std::round(rate), std::round(rate * 100.0) / 100.0, slowed})
        if (isMeant(candidate))
            return candidate;
    return rate;
}

} // namespace

double frameRateOfTimes(std::span<const std::int64_t> times) {
    const auto isBeyondStart = [](std::int64_t time) { return std::abs(framesAt(time, kFastest)) > 0.5; };
    if (std::none_of(times.begin(), times.end(), isBeyondStart))
        return 0.0;
    const double distance = usualDistance(times);
    const double byDistance = distance > 0.0 ? kTicksPerSecond / distance : 0.0;
    if (byDistance >= kSlowest * (1.0 - kSameRate) && byDistance <= kFastest * (1.0 + kSameRate) &&
        fits(times, measured(times, byDistance)))
        return meantRate(measured(times, byDistance));
    for (const double rate : kUsualRates)
        if (fits(times, rate))
            return meantRate(measured(times, rate));
    return 0.0;
}

} // namespace detail
FBXSDK_NAMESPACE_END
