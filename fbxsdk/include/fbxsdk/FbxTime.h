// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A moment or duration in ticks, and a span between two moments.
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

inline constexpr FbxLongLong FBXSDK_TC_ZERO = 0;
inline constexpr FbxLongLong FBXSDK_TC_EPSILON = 1;
inline constexpr FbxLongLong FBXSDK_TC_MILLISECOND = 46186158;
inline constexpr FbxLongLong FBXSDK_TC_SECOND = FBXSDK_TC_MILLISECOND * 1000;
inline constexpr FbxLongLong FBXSDK_TC_MINUTE = FBXSDK_TC_SECOND * 60;
inline constexpr FbxLongLong FBXSDK_TC_HOUR = FBXSDK_TC_MINUTE * 60;
inline constexpr FbxLongLong FBXSDK_TC_DAY = FBXSDK_TC_HOUR * 24;
inline constexpr FbxLongLong FBXSDK_TC_INFINITY = INT64_MAX;
inline constexpr FbxLongLong FBXSDK_TC_MINFINITY = -INT64_MAX;

/// A time as a whole number of ticks, 46186158000 to the second.
///
/// Arithmetic never overflows: what is too far becomes FBXSDK_TC_INFINITY or FBXSDK_TC_MINFINITY.
class FBXSDK_DLL FbxTime {
public:
    /// Files may hold any number; one that is no mode counts as eDefaultMode.
    enum EMode : int {
        eDefaultMode = 0, ///< the global time mode of the calling thread
        eFrames120,
        eFrames100,
        eFrames60,
        eFrames50,
        eFrames48,
        eFrames30,
        eFrames30Drop,
        eNTSCDropFrame,
        eNTSCFullFrame,
        ePAL,
        eFrames24,
        eFrames1000,
        eFilmFullFrame,
        eCustom, ///< the rate given to SetGlobalTimeMode
        eFrames96,
        eFrames72,
        eFrames59dot94,
        eFrames119dot88,
        eModesCount
    };
    enum EProtocol { eSMPTE, eFrameCount, eDefaultProtocol };

    constexpr FbxTime(const FbxLongLong pTime = 0) : mTime(pTime) {}

    void Set(FbxLongLong pTime) { mTime = pTime; }
    [[nodiscard]] constexpr FbxLongLong Get() const { return mTime; }

    void SetMilliSeconds(FbxLongLong pMilliSeconds);
    [[nodiscard]] FbxLongLong GetMilliSeconds() const; ///< Whole milliseconds, truncated toward zero.

    /// Rounds to the nearest tick, so that frame ÷ rate lands exactly on the frame. NaN gives zero; what is too far
    /// becomes infinite.
    void SetSecondDouble(double pTime);
    [[nodiscard]] double GetSecondDouble() const;

    /// Hours, minutes and seconds of real time (not of a time code) plus frames and half frames (fields) of the mode.
    void SetTime(int pHour, int pMinute, int pSecond, int pFrame = 0, int pField = 0, EMode pTimeMode = eDefaultMode);

    void SetFrame(FbxLongLong pFrames, EMode pTimeMode = eDefaultMode);
    /// Whole frames, truncated toward zero; a time within a hundredth of a frame of a whole frame counts as that frame.
    [[nodiscard]] FbxLongLong GetFrameCount(EMode pTimeMode = eDefaultMode) const;
    [[nodiscard]] double GetFrameCountPrecise(EMode pTimeMode = eDefaultMode) const;

    /// Frames per second, always greater than zero.
    [[nodiscard]] static double GetFrameRate(EMode pTimeMode);
    /// Ticks per frame, rounded to the nearest.
    [[nodiscard]] static FbxLongLong GetOneFrameValue(EMode pTimeMode = eDefaultMode);
    /// The first mode whose rate is no further than the precision away; eDefaultMode when there is none.
    [[nodiscard]] static EMode ConvertFrameRateToTimeMode(double pFrameRate, double pPrecision = 0.00000001);

    /// What eDefaultMode and eCustom mean on the calling thread. The rate is used with eCustom only; one that is not
    /// greater than zero stands for 30.
    static void SetGlobalTimeMode(EMode pTimeMode, double pFrameRate = 0.0);
    [[nodiscard]] static EMode GetGlobalTimeMode();

    constexpr bool operator==(const FbxTime& pTime) const { return mTime == pTime.mTime; }
    constexpr bool operator!=(const FbxTime& pTime) const { return mTime != pTime.mTime; }
    constexpr bool operator<(const FbxTime& pTime) const { return mTime < pTime.mTime; }
    constexpr bool operator<=(const FbxTime& pTime) const { return mTime <= pTime.mTime; }
    constexpr bool operator>(const FbxTime& pTime) const { return mTime > pTime.mTime; }
    constexpr bool operator>=(const FbxTime& pTime) const { return mTime >= pTime.mTime; }

    FbxTime& operator+=(const FbxTime& pTime);
    FbxTime& operator-=(const FbxTime& pTime);
    FbxTime operator+(const FbxTime& pTime) const;
    FbxTime operator-(const FbxTime& pTime) const;
    FbxTime operator*(const FbxTime& pTime) const; ///< The product of the tick counts.
    FbxTime operator/(const FbxTime& pTime) const; ///< The quotient of the tick counts; division by zero saturates.
    FbxTime operator*(int pFactor) const;
    FbxTime operator/(int pDivisor) const;

    FbxTime& operator++(); ///< One tick on.
    FbxTime operator++(int);
    FbxTime& operator--();
    FbxTime operator--(int);

private:
    FbxLongLong mTime;
};

inline constexpr FbxTime FBXSDK_TIME_ZERO{FBXSDK_TC_ZERO};
inline constexpr FbxTime FBXSDK_TIME_EPSILON{FBXSDK_TC_EPSILON};
inline constexpr FbxTime FBXSDK_TIME_ONE_SECOND{FBXSDK_TC_SECOND};
inline constexpr FbxTime FBXSDK_TIME_ONE_MINUTE{FBXSDK_TC_MINUTE};
inline constexpr FbxTime FBXSDK_TIME_ONE_HOUR{FBXSDK_TC_HOUR};
inline constexpr FbxTime FBXSDK_TIME_INFINITE{FBXSDK_TC_INFINITY};
inline constexpr FbxTime FBXSDK_TIME_MINUS_INFINITE{FBXSDK_TC_MINFINITY};

inline constexpr int FBXSDK_TIME_FORWARD = 1;
inline constexpr int FBXSDK_TIME_BACKWARD = 0;

/// A pair of times; the start may lie behind the stop.
class FBXSDK_DLL FbxTimeSpan {
public:
    constexpr FbxTimeSpan() = default;
    constexpr FbxTimeSpan(FbxTime pStart, FbxTime pStop) : mStart(pStart), mStop(pStop) {}

    void Set(FbxTime pStart, FbxTime pStop) { *this = FbxTimeSpan(pStart, pStop); }
    void SetStart(FbxTime pStart) { mStart = pStart; }
    void SetStop(FbxTime pStop) { mStop = pStop; }
    [[nodiscard]] constexpr FbxTime GetStart() const { return mStart; }
    [[nodiscard]] constexpr FbxTime GetStop() const { return mStop; }

    /// The distance of start and stop, never negative.
    [[nodiscard]] FbxTime GetDuration() const;
    /// The distance with its sign: negative when the span runs backward.
    [[nodiscard]] FbxTime GetSignedDuration() const;
    /// FBXSDK_TIME_FORWARD or FBXSDK_TIME_BACKWARD.
    [[nodiscard]] int GetDirection() const;
    /// Whether the time lies between start and stop, both included.
    [[nodiscard]] bool IsInside(FbxTime pTime) const;
    /// The common part in this span's direction; an empty span at zero when there is none.
    [[nodiscard]] FbxTimeSpan Intersect(const FbxTimeSpan& pOther) const;
    /// Widens this span so that it covers the other one, in the given direction.
    void UnionAssignment(const FbxTimeSpan& pOther, int pDirection = FBXSDK_TIME_FORWARD);

    constexpr bool operator==(const FbxTimeSpan& pOther) const {
        return mStart == pOther.mStart && mStop == pOther.mStop;
    }
    constexpr bool operator!=(const FbxTimeSpan& pOther) const { return !(*this == pOther); }

private:
    FbxTime mStart;
    FbxTime mStop;
};

FBXSDK_NAMESPACE_END
