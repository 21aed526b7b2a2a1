// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Tick arithmetic. Rates that are whole numbers mostly have a whole number of ticks per frame and are counted in whole
// numbers; the others go through long double, whose 64-bit mantissa holds every tick. All results saturate.
#include <fbxsdk/FbxTime.h>

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstdint>
#include <iterator>

#include "core/TimeModes.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

using detail::TimeModeRow;

__extension__ typedef __int128 Wide;

constexpr TimeModeRow kTimeModes[] = {
    {FbxTime::eDefaultMode, "default", 0.0},
    {FbxTime::eFrames120, "120 fps", 120.0},
    {FbxTime::eFrames100, "100 fps", 100.0},
    {FbxTime::eFrames60, "60 fps", 60.0},
    {FbxTime::eFrames50, "50 fps", 50.0},
    {FbxTime::eFrames48, "48 fps", 48.0},
    {FbxTime::eFrames30, "30 fps", 30.0},
    {FbxTime::eFrames30Drop, "30 fps drop", 30.0},
    {FbxTime::eNTSCDropFrame, "NTSC drop", 29.97002617},
    {FbxTime::eNTSCFullFrame, "NTSC full", 29.97002617},
    {FbxTime::ePAL, "PAL", 25.0},
    {FbxTime::eFrames24, "24 fps", 24.0},
    {FbxTime::eFrames1000, "1000 fps", 1000.0},
    {FbxTime::eFilmFullFrame, "film full", 23.976},
    {FbxTime::eCustom, "custom", 0.0},
    {FbxTime::eFrames96, "96 fps", 96.0},
    {FbxTime::eFrames72, "72 fps", 72.0},
    {FbxTime::eFrames59dot94, "59.94 fps", 59.94005234},
    {FbxTime::eFrames119dot88, "119.88 fps", 119.88010468},
};

constexpr bool inEnumeratorOrder() {
    for (int i = 0; i < static_cast<int>(std::size(kTimeModes)); ++i)
        if (kTimeModes[i].mode != i)
            return false;
    return true;
}
static_assert(std::size(kTimeModes) == FbxTime::eModesCount && inEnumeratorOrder());

/// The rate of a scene without a usable rate of its own.
constexpr FbxTime::EMode kFallbackMode = FbxTime::eFrames30;
constexpr double kFallbackRate = kTimeModes[kFallbackMode].rate;

/// How far from a whole frame, in frames, a time still counts as that frame. It absorbs key times that another program
/// truncated to a tick, and the difference of the NTSC rates in use (29.97002617 and 30000/1001).
constexpr long double kFrameTolerance = 0.01L;

constexpr long double kTicksPerSecond = static_cast<long double>(FBXSDK_TC_SECOND);

struct GlobalTimeMode {
    FbxTime::EMode mode = kFallbackMode;
    double customRate = 0.0;
};

/// One for each thread: scenes that are read on different threads must not change each other's rates.
GlobalTimeMode& globalTimeMode() {
    static thread_local GlobalTimeMode mode;
    return mode;
}

bool isUsableRate(double rate) { return rate > 0.0 && std::isfinite(rate); }

/// Saturating and always defined: every long double becomes a tick count, NaN becomes 0.
FbxLongLong saturated(long double ticks) {
    if (std::isnan(ticks))
        return 0;
    if (ticks >= static_cast<long double>(FBXSDK_TC_INFINITY))
        return FBXSDK_TC_INFINITY;
    if (ticks <= static_cast<long double>(FBXSDK_TC_MINFINITY))
        return FBXSDK_TC_MINFINITY;
    return static_cast<FbxLongLong>(ticks);
}

FbxLongLong saturated(Wide ticks) {
    return static_cast<FbxLongLong>(
        std::clamp(ticks, static_cast<Wide>(FBXSDK_TC_MINFINITY), static_cast<Wide>(FBXSDK_TC_INFINITY)));
}

/// To the nearest tick, halves away from zero. The library's rounding takes several times as long.
FbxLongLong rounded(long double ticks) {
    const FbxLongLong whole = saturated(ticks);
    const long double rest = ticks - static_cast<long double>(whole); // exact, unless the whole is the end of the range
    if (rest >= 0.5L && whole < FBXSDK_TC_INFINITY)
        return whole + 1;
    return rest <= -0.5L && whole > FBXSDK_TC_MINFINITY ? whole - 1 : whole;
}

Wide wide(FbxLongLong ticks) { return ticks; }

/// The ticks of a number of seconds, 0 for NaN. The product of the seconds' mantissa with the ticks of a second is
/// exact, so that only the last step rounds: to the nearest tick, halves away from zero. A time is set for every
/// sample, and long double is several times slower.
FbxLongLong ticksOfSeconds(double seconds) {
    constexpr double kTooMany = 268435456.0; // 2^28, which is more ticks than there are
    if (!(std::abs(seconds) < kTooMany))
        return saturated(static_cast<long double>(seconds) * kTicksPerSecond);
    constexpr int kMantissaBits = 52;
    constexpr int kUnitExponent = 1075; // of a double whose mantissa counts ones
    const auto bits = std::bit_cast<std::uint64_t>(std::abs(seconds));
    const int exponent = static_cast<int>(bits >> kMantissaBits);
    const int shift = kUnitExponent - exponent; // at least 25, as there are few seconds
    if (shift > 90)                             // the product has 89 bits at most; and here are all denormal numbers
        return 0;
    const std::uint64_t leadingBit = std::uint64_t{1} << kMantissaBits;
    const Wide product = wide(static_cast<FbxLongLong>((bits & (leadingBit - 1)) | leadingBit)) * FBXSDK_TC_SECOND;
    const FbxLongLong ticks = saturated((product + (wide(1) << (shift - 1))) >> shift);
    return seconds < 0.0 ? -ticks : ticks;
}

/// Ticks per frame when that is a whole number, otherwise 0.
FbxLongLong exactFrameTicks(double rate) {
    if (rate != std::floor(rate) || rate > static_cast<double>(FBXSDK_TC_SECOND))
        return 0;
    const auto wholeRate = static_cast<FbxLongLong>(rate);
    return FBXSDK_TC_SECOND % wholeRate == 0 ? FBXSDK_TC_SECOND / wholeRate : 0;
}

long double preciseFrames(FbxLongLong ticks, double rate) {
    const FbxLongLong frameTicks = exactFrameTicks(rate);
    if (frameTicks != 0)
        return static_cast<long double>(ticks) / static_cast<long double>(frameTicks);
    return static_cast<long double>(ticks) * static_cast<long double>(rate) / kTicksPerSecond;
}

} // namespace

std::span<const TimeModeRow> detail::timeModes() { return kTimeModes; }

void FbxTime::SetMilliSeconds(FbxLongLong pMilliSeconds) {
    mTime = saturated(wide(pMilliSeconds) * FBXSDK_TC_MILLISECOND);
}

FbxLongLong FbxTime::GetMilliSeconds() const { return mTime / FBXSDK_TC_MILLISECOND; }

void FbxTime::SetSecondDouble(double pTime) { mTime = ticksOfSeconds(pTime); }

double FbxTime::GetSecondDouble() const {
    return static_cast<double>(static_cast<long double>(mTime) / kTicksPerSecond);
}

void FbxTime::SetTime(int pHour, int pMinute, int pSecond, int pFrame, int pField, EMode pTimeMode) {
    const Wide clock =
        wide(pHour) * FBXSDK_TC_HOUR + wide(pMinute) * FBXSDK_TC_MINUTE + wide(pSecond) * FBXSDK_TC_SECOND;
    const long double halfFrames = 2.0L * pFrame + pField;
    const long double frameTicks = kTicksPerSecond / GetFrameRate(pTimeMode);
    mTime = saturated(clock + rounded(halfFrames * frameTicks / 2.0L));
}

void FbxTime::SetFrame(FbxLongLong pFrames, EMode pTimeMode) {
    const double rate = GetFrameRate(pTimeMode);
    const FbxLongLong frameTicks = exactFrameTicks(rate);
    mTime = frameTicks != 0 ? saturated(wide(pFrames) * frameTicks)
                            : rounded(static_cast<long double>(pFrames) * kTicksPerSecond / rate);
}

FbxLongLong FbxTime::GetFrameCount(EMode pTimeMode) const {
    const long double frames = preciseFrames(mTime, GetFrameRate(pTimeMode));
    const long double nearest = std::round(frames);
    return saturated(std::abs(frames - nearest) <= kFrameTolerance ? nearest : std::trunc(frames));
}

double FbxTime::GetFrameCountPrecise(EMode pTimeMode) const {
    return static_cast<double>(preciseFrames(mTime, GetFrameRate(pTimeMode)));
}

double FbxTime::GetFrameRate(EMode pTimeMode) {
    const GlobalTimeMode& global = globalTimeMode();
    const auto index = static_cast<size_t>(pTimeMode); // numbers from files may be anything
    const EMode mode = index < std::size(kTimeModes) && pTimeMode != eDefaultMode ? pTimeMode : global.mode;
    if (mode == eCustom)
        return isUsableRate(global.customRate) ? global.customRate : kFallbackRate;
    return mode == eDefaultMode ? kFallbackRate : kTimeModes[mode].rate;
}

FbxLongLong FbxTime::GetOneFrameValue(EMode pTimeMode) {
    return rounded(kTicksPerSecond / static_cast<long double>(GetFrameRate(pTimeMode)));
}

FbxTime::EMode FbxTime::ConvertFrameRateToTimeMode(double pFrameRate, double pPrecision) {
    const auto* const row =
        std::find_if(std::begin(kTimeModes), std::end(kTimeModes), [&](const TimeModeRow& candidate) {
            return candidate.rate > 0.0 && std::abs(candidate.rate - pFrameRate) <= pPrecision;
        });
    return row == std::end(kTimeModes) ? eDefaultMode : row->mode;
}

void FbxTime::SetGlobalTimeMode(EMode pTimeMode, double pFrameRate) {
    GlobalTimeMode& global = globalTimeMode();
    global.mode = static_cast<size_t>(pTimeMode) < std::size(kTimeModes) ? pTimeMode : eDefaultMode;
    if (pTimeMode == eCustom)
        global.customRate = pFrameRate;
}

FbxTime::EMode FbxTime::GetGlobalTimeMode() { return globalTimeMode().mode; }

FbxTime& FbxTime::operator+=(const FbxTime& pTime) { return *this = *this + pTime; }

FbxTime& FbxTime::operator-=(const FbxTime& pTime) { return *this = *this - pTime; }

FbxTime FbxTime::operator+(const FbxTime& pTime) const { return saturated(wide(mTime) + pTime.mTime); }

FbxTime FbxTime::operator-(const FbxTime& pTime) const { return saturated(wide(mTime) - pTime.mTime); }

FbxTime FbxTime::operator*(const FbxTime& pTime) const { return saturated(wide(mTime) * pTime.mTime); }

FbxTime FbxTime::operator/(const FbxTime& pTime) const {
    if (pTime.mTime == 0)
        return mTime > 0 ? FBXSDK_TC_INFINITY : mTime < 0 ? FBXSDK_TC_MINFINITY : FBXSDK_TC_ZERO;
    return saturated(wide(mTime) / pTime.mTime);
}

FbxTime FbxTime::operator*(int pFactor) const { return *this * FbxTime(pFactor); }

FbxTime FbxTime::operator/(int pDivisor) const { return *this / FbxTime(pDivisor); }

FbxTime& FbxTime::operator++() { return *this += FBXSDK_TIME_EPSILON; }

FbxTime FbxTime::operator++(int) {
    const FbxTime before = *this;
    ++*this;
    return before;
}

FbxTime& FbxTime::operator--() { return *this -= FBXSDK_TIME_EPSILON; }

FbxTime FbxTime::operator--(int) {
    const FbxTime before = *this;
    --*this;
    return before;
}

FbxTime FbxTimeSpan::GetDuration() const { return std::max(mStart, mStop) - std::min(mStart, mStop); }

FbxTime FbxTimeSpan::GetSignedDuration() const { return mStop - mStart; }

int FbxTimeSpan::GetDirection() const { return mStop >= mStart ? FBXSDK_TIME_FORWARD : FBXSDK_TIME_BACKWARD; }

bool FbxTimeSpan::IsInside(FbxTime pTime) const {
    return pTime >= std::min(mStart, mStop) && pTime <= std::max(mStart, mStop);
}

FbxTimeSpan FbxTimeSpan::Intersect(const FbxTimeSpan& pOther) const {
    const FbxTime first = std::max(std::min(mStart, mStop), std::min(pOther.mStart, pOther.mStop));
    const FbxTime last = std::min(std::max(mStart, mStop), std::max(pOther.mStart, pOther.mStop));
    if (first > last)
        return {};
    return GetDirection() == FBXSDK_TIME_FORWARD ? FbxTimeSpan(first, last) : FbxTimeSpan(last, first);
}

void FbxTimeSpan::UnionAssignment(const FbxTimeSpan& pOther, int pDirection) {
    const auto [first, last] = std::minmax({mStart, mStop, pOther.mStart, pOther.mStop});
    *this = pDirection == FBXSDK_TIME_FORWARD ? FbxTimeSpan(first, last) : FbxTimeSpan(last, first);
}

FBXSDK_NAMESPACE_END
