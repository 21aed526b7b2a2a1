// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A moment or duration in ticks, and a span between two moments.
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

inline constexpr FbxLongLong FBXSDK_TC_ZERO = 0;                              ///< No ticks.
inline constexpr FbxLongLong FBXSDK_TC_EPSILON = 1;                           ///< One tick, the smallest step of time.
inline constexpr FbxLongLong FBXSDK_TC_MILLISECOND = 46186158;                ///< Ticks per millisecond.
inline constexpr FbxLongLong FBXSDK_TC_SECOND = FBXSDK_TC_MILLISECOND * 1000; ///< Ticks per second.
inline constexpr FbxLongLong FBXSDK_TC_MINUTE = FBXSDK_TC_SECOND * 60;        ///< Ticks per minute.
inline constexpr FbxLongLong FBXSDK_TC_HOUR = FBXSDK_TC_MINUTE * 60;          ///< Ticks per hour.
inline constexpr FbxLongLong FBXSDK_TC_DAY = FBXSDK_TC_HOUR * 24;             ///< Ticks per day.
inline constexpr FbxLongLong FBXSDK_TC_INFINITY = INT64_MAX;                  ///< No end; the largest number of ticks.
inline constexpr FbxLongLong FBXSDK_TC_MINFINITY = -INT64_MAX;                ///< Negative infinity; its negative.

/// A time as a whole number of ticks, 46186158000 per second.
///
/// Arithmetic never overflows: results out of range become FBXSDK_TC_INFINITY or FBXSDK_TC_MINFINITY.
class FBXSDK_DLL FbxTime {
public:
    /// Frame rates. Files may hold any number; one that is no mode counts as eDefaultMode.
    enum EMode : int {
        eDefaultMode = 0, ///< the global time mode of the calling thread
        eFrames120,       ///< 120 frames per second
        eFrames100,       ///< 100 frames per second
        eFrames60,        ///< 60 frames per second
        eFrames50,        ///< 50 frames per second
        eFrames48,        ///< 48 frames per second
        eFrames30,        ///< 30 frames per second
        eFrames30Drop,    ///< 30 frames per second, shown as a drop-frame time code
        eNTSCDropFrame,   ///< 29.97002617 frames per second, shown as a drop-frame time code
        eNTSCFullFrame,   ///< 29.97002617 frames per second
        ePAL,             ///< 25 frames per second
        eFrames24,        ///< 24 frames per second
        eFrames1000,      ///< 1000 frames per second
        eFilmFullFrame,   ///< 23.976 frames per second
        eCustom,          ///< the rate given to SetGlobalTimeMode
        eFrames96,        ///< 96 frames per second
        eFrames72,        ///< 72 frames per second
        eFrames59dot94,   ///< 59.94005234 frames per second
        eFrames119dot88,  ///< 119.88010468 frames per second
        eModesCount       ///< how many modes there are; none itself
    };
    /// How applications show times.
    enum EProtocol {
        eSMPTE,          ///< hours, minutes, seconds, frames
        eFrameCount,     ///< the number of the frame
        eDefaultProtocol ///< the application's default
    };

    /// That many ticks; not explicit, so that ticks convert to times.
    constexpr FbxTime(const FbxLongLong pTime = 0) : mTime(pTime) {}

    void Set(FbxLongLong pTime) { mTime = pTime; }                    ///< Sets the number of ticks.
    [[nodiscard]] constexpr FbxLongLong Get() const { return mTime; } ///< The number of ticks.

    void SetMilliSeconds(FbxLongLong pMilliSeconds);   ///< Infinite when out of range.
    [[nodiscard]] FbxLongLong GetMilliSeconds() const; ///< Whole milliseconds, truncated toward zero.

    /// Rounds to the nearest tick, so that frame ÷ rate lands exactly on the frame. NaN gives zero; a value out of
    /// range becomes infinite.
    void SetSecondDouble(double pTime);
    [[nodiscard]] double GetSecondDouble() const; ///< The nearest double to ticks ÷ 46186158000.

    /// Hours, minutes and seconds of real time (not of a time code) plus frames and half frames (fields) of the mode.
    void SetTime(int pHour, int pMinute, int pSecond, int pFrame = 0, int pField = 0, EMode pTimeMode = eDefaultMode);

    /// The time at which a frame begins, rounded to the nearest tick where the mode's frames are not whole numbers of
    /// them.
    void SetFrame(FbxLongLong pFrames, EMode pTimeMode = eDefaultMode);
    /// Whole frames, truncated toward zero; a time within a hundredth of a frame of a whole frame counts as that frame.
    [[nodiscard]] FbxLongLong GetFrameCount(EMode pTimeMode = eDefaultMode) const;
    [[nodiscard]] double GetFrameCountPrecise(EMode pTimeMode = eDefaultMode) const; ///< Frames with their fraction.

    /// Frames per second, always greater than zero: 30 where neither the mode nor the thread's global mode states a
    /// rate.
    [[nodiscard]] static double GetFrameRate(EMode pTimeMode);
    /// Ticks per frame, rounded to the nearest.
    [[nodiscard]] static FbxLongLong GetOneFrameValue(EMode pTimeMode = eDefaultMode);
    /// The first mode whose rate is no further than the precision away; eDefaultMode when there is none.
    [[nodiscard]] static EMode ConvertFrameRateToTimeMode(double pFrameRate, double pPrecision = 0.00000001);

    /// The meaning of eDefaultMode and eCustom on the calling thread; other threads keep theirs. The rate is used with
    /// eCustom only; one that is not greater than zero counts as 30.
    static void SetGlobalTimeMode(EMode pTimeMode, double pFrameRate = 0.0);
    [[nodiscard]] static EMode GetGlobalTimeMode(); ///< Of the calling thread; initially eFrames30.

    /// Exact, in ticks, as all comparisons are.
    constexpr bool operator==(const FbxTime& pTime) const { return mTime == pTime.mTime; }
    constexpr bool operator!=(const FbxTime& pTime) const { return mTime != pTime.mTime; } ///< Exact.
    constexpr bool operator<(const FbxTime& pTime) const { return mTime < pTime.mTime; }   ///< Earlier.
    constexpr bool operator<=(const FbxTime& pTime) const { return mTime <= pTime.mTime; } ///< Not later.
    constexpr bool operator>(const FbxTime& pTime) const { return mTime > pTime.mTime; }   ///< Later.
    constexpr bool operator>=(const FbxTime& pTime) const { return mTime >= pTime.mTime; } ///< Not earlier.

    FbxTime& operator+=(const FbxTime& pTime);     ///< Infinite when the sum is out of range.
    FbxTime& operator-=(const FbxTime& pTime);     ///< Infinite when the difference is out of range.
    FbxTime operator+(const FbxTime& pTime) const; ///< Infinite when the sum is out of range.
    FbxTime operator-(const FbxTime& pTime) const; ///< Infinite when the difference is out of range.
    FbxTime operator*(const FbxTime& pTime) const; ///< The product of the tick counts.
    FbxTime operator/(const FbxTime& pTime) const; ///< The quotient of the tick counts; division by zero saturates.
    FbxTime operator*(int pFactor) const;          ///< Multiplied by the number.
    FbxTime operator/(int pDivisor) const; ///< That part of it, truncated toward zero; division by zero saturates.

    FbxTime& operator++();   ///< Adds one tick.
    FbxTime operator++(int); ///< Adds one tick; returns the time before.
    FbxTime& operator--();   ///< Subtracts one tick.
    FbxTime operator--(int); ///< Subtracts one tick; returns the time before.

private:
    FbxLongLong mTime;
};

inline constexpr FbxTime FBXSDK_TIME_ZERO{FBXSDK_TC_ZERO};         ///< Zero.
inline constexpr FbxTime FBXSDK_TIME_EPSILON{FBXSDK_TC_EPSILON};   ///< One tick.
inline constexpr FbxTime FBXSDK_TIME_ONE_SECOND{FBXSDK_TC_SECOND}; ///< 46186158000 ticks.
inline constexpr FbxTime FBXSDK_TIME_ONE_MINUTE{FBXSDK_TC_MINUTE}; ///< 60 seconds.
inline constexpr FbxTime FBXSDK_TIME_ONE_HOUR{FBXSDK_TC_HOUR};     ///< 60 minutes.
/// Positive infinity; as a time of evaluation: the static value.
inline constexpr FbxTime FBXSDK_TIME_INFINITE{FBXSDK_TC_INFINITY};
inline constexpr FbxTime FBXSDK_TIME_MINUS_INFINITE{FBXSDK_TC_MINFINITY}; ///< Negative infinity.

inline constexpr int FBXSDK_TIME_FORWARD = 1;  ///< A span whose stop is not before its start.
inline constexpr int FBXSDK_TIME_BACKWARD = 0; ///< A span whose stop is before its start.

/// A pair of times; the start may be after the stop.
class FBXSDK_DLL FbxTimeSpan {
public:
    constexpr FbxTimeSpan() = default;                                                     ///< From zero to zero.
    constexpr FbxTimeSpan(FbxTime pStart, FbxTime pStop) : mStart(pStart), mStop(pStop) {} ///< As given, in any order.

    void Set(FbxTime pStart, FbxTime pStop) { *this = FbxTimeSpan(pStart, pStop); } ///< As given, in any order.
    void SetStart(FbxTime pStart) { mStart = pStart; }                              ///< The stop stays.
    void SetStop(FbxTime pStop) { mStop = pStop; }                                  ///< The start stays.
    /// The first of the pair, not necessarily the earlier.
    [[nodiscard]] constexpr FbxTime GetStart() const { return mStart; }
    [[nodiscard]] constexpr FbxTime GetStop() const { return mStop; } ///< The second of the pair.

    /// The distance of start and stop, never negative.
    [[nodiscard]] FbxTime GetDuration() const;
    /// The distance with its sign: negative when the span runs backward.
    [[nodiscard]] FbxTime GetSignedDuration() const;
    /// FBXSDK_TIME_FORWARD or FBXSDK_TIME_BACKWARD.
    [[nodiscard]] int GetDirection() const;
    /// Whether the time lies between start and stop, both included.
    [[nodiscard]] bool IsInside(FbxTime pTime) const;
    /// The intersection in this span's direction; an empty span at zero when there is none.
    [[nodiscard]] FbxTimeSpan Intersect(const FbxTimeSpan& pOther) const;
    /// Widens this span so that it covers the other one, in the given direction.
    void UnionAssignment(const FbxTimeSpan& pOther, int pDirection = FBXSDK_TIME_FORWARD);

    /// Same start and same stop: a span and its reverse differ.
    constexpr bool operator==(const FbxTimeSpan& pOther) const {
        return mStart == pOther.mStart && mStop == pOther.mStop;
    }
    constexpr bool operator!=(const FbxTimeSpan& pOther) const { return !(*this == pOther); } ///< The opposite.

private:
    FbxTime mStart;
    FbxTime mStop;
};

FBXSDK_NAMESPACE_END
