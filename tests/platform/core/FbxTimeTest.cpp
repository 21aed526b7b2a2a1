// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Ticks, frames, seconds and time modes; spans of time.
#include <cmath>
#include <cstdint>
#include <limits>
#include <random>
#include <set>
#include <string>
#include <thread>

#include <gtest/gtest.h>

#include <fbxsdk/FbxTime.h>

#include "core/TimeModes.h"

namespace {

using namespace fbxsdk;

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInfinity = std::numeric_limits<double>::infinity();

/// Restores the thread's global time mode.
class GlobalTimeModeGuard {
public:
    GlobalTimeModeGuard() : mMode(FbxTime::GetGlobalTimeMode()), mCustomRate(FbxTime::GetFrameRate(FbxTime::eCustom)) {}
    ~GlobalTimeModeGuard() {
        FbxTime::SetGlobalTimeMode(FbxTime::eCustom, mCustomRate);
        FbxTime::SetGlobalTimeMode(mMode);
    }
    GlobalTimeModeGuard(const GlobalTimeModeGuard&) = delete;
    GlobalTimeModeGuard& operator=(const GlobalTimeModeGuard&) = delete;

private:
    FbxTime::EMode mMode;
    double mCustomRate;
};

FbxTime atSeconds(double seconds) {
    FbxTime time;
    time.SetSecondDouble(seconds);
    return time;
}

struct RateRow {
    FbxTime::EMode mode;
    int number;
    double rate;
    FbxLongLong ticksPerFrame; ///< 0 where no whole number is exact
};

// written out by hand; compared row by row with the table of the code
constexpr RateRow kRates[] = {
    {FbxTime::eFrames120, 1, 120.0, 384884650},
    {FbxTime::eFrames100, 2, 100.0, 461861580},
    {FbxTime::eFrames60, 3, 60.0, 769769300},
    {FbxTime::eFrames50, 4, 50.0, 923723160},
    {FbxTime::eFrames48, 5, 48.0, 962211625},
    {FbxTime::eFrames30, 6, 30.0, 1539538600},
    {FbxTime::eFrames30Drop, 7, 30.0, 1539538600},
    {FbxTime::eNTSCDropFrame, 8, 29.97002617, 0},
    {FbxTime::eNTSCFullFrame, 9, 29.97002617, 0},
    {FbxTime::ePAL, 10, 25.0, 1847446320},
    {FbxTime::eFrames24, 11, 24.0, 1924423250},
    {FbxTime::eFrames1000, 12, 1000.0, 46186158},
    {FbxTime::eFilmFullFrame, 13, 23.976, 0},
    {FbxTime::eFrames96, 15, 96.0, 0},
    {FbxTime::eFrames72, 16, 72.0, 0},
    {FbxTime::eFrames59dot94, 17, 59.94005234, 0},
    {FbxTime::eFrames119dot88, 18, 119.88010468, 0},
};

TEST(FbxTime, HasTheDocumentedNumberAndRateForEveryMode) {
    for (const RateRow& row : kRates) {
        EXPECT_EQ(row.mode, row.number);
        EXPECT_EQ(FbxTime::GetFrameRate(row.mode), row.rate) << row.number;
    }
    EXPECT_EQ(FbxTime::eDefaultMode, 0);
    EXPECT_EQ(FbxTime::eCustom, 14);
    EXPECT_EQ(FbxTime::eModesCount, 19);
}

TEST(FbxTime, NamesEveryModeDifferently) {
    std::set<std::string> names;
    for (const auto& row : detail::timeModes())
        names.insert(row.name);
    EXPECT_EQ(names.size(), static_cast<size_t>(FbxTime::eModesCount));
    EXPECT_EQ(names.count(""), 0U);
}

TEST(FbxTime, HasExactTicksPerFrameWhereTheRateDividesTheSecond) {
    for (const RateRow& row : kRates) {
        const FbxLongLong expected =
            row.ticksPerFrame != 0 ? row.ticksPerFrame : std::llround(46186158000.0L / row.rate);
        EXPECT_EQ(FbxTime::GetOneFrameValue(row.mode), expected) << row.number;
    }
    EXPECT_EQ(FBXSDK_TC_SECOND, 46186158000);
}

TEST(FbxTime, PutsTheSecondsOfAFrameExactlyOnThatFrameInEveryMode) {
    for (const RateRow& row : kRates) {
        for (FbxLongLong k = 1; k < 200000; k += 2) {
            const FbxTime after = atSeconds(static_cast<double>(k) / row.rate);
            const FbxTime before = atSeconds(static_cast<double>(-k) / row.rate);

            ASSERT_EQ(after.GetFrameCount(row.mode), k) << row.number;
            ASSERT_EQ(before.GetFrameCount(row.mode), -k) << row.number;
        }
    }
}

TEST(FbxTime, PutsTheSecondsOfAFrameExactlyOnItsTicksInExactModes) {
    for (const RateRow& row : kRates)
        for (FbxLongLong k = 1; row.ticksPerFrame != 0 && k < 200000; k += 2)
            ASSERT_EQ(atSeconds(static_cast<double>(k) / row.rate).Get(), k * row.ticksPerFrame) << row.number;
}

TEST(FbxTime, ComesBackToTheFrameThatWasSet) {
    for (const RateRow& row : kRates) {
        for (const FbxLongLong k : {0LL, 1LL, -1LL, 7LL, 1001LL, -86400LL, 123456789LL}) {
            FbxTime time;
            time.SetFrame(k, row.mode);

            EXPECT_EQ(time.GetFrameCount(row.mode), k) << row.number;
            EXPECT_NEAR(time.GetFrameCountPrecise(row.mode), static_cast<double>(k), 1.0e-7) << row.number;
        }
    }
}

TEST(FbxTime, CountsAShotOf1001FramesAtTheNtscRatesWhicheverSpellingWroteIt) {
    struct Shot {
        FbxTime::EMode mode;
        double writtenRate;
    };
    const Shot shots[] = {
        {FbxTime::eFilmFullFrame, 23.976},
        {FbxTime::eFilmFullFrame, static_cast<double>(23.976F)},
        {FbxTime::eFilmFullFrame, 24000.0 / 1001.0},
        {FbxTime::eNTSCDropFrame, 29.97002617},
        {FbxTime::eNTSCFullFrame, static_cast<double>(29.9700262F)},
        {FbxTime::eNTSCFullFrame, 30000.0 / 1001.0},
    };
    for (const Shot& shot : shots)
        for (int frame = -1001; frame <= 1001; ++frame)
            ASSERT_EQ(atSeconds(frame / shot.writtenRate).GetFrameCount(shot.mode), frame) << shot.writtenRate;
}

TEST(FbxTime, TruncatesFramesTowardZeroOutsideAHundredthOfAFrame) {
    const FbxLongLong frame = 1539538600; // at 30 frames per second
    const auto framesOf = [](FbxLongLong ticks) { return FbxTime(ticks).GetFrameCount(FbxTime::eFrames30); };

    EXPECT_EQ(framesOf(10 * frame - 1), 10); // a key time that its writer truncated
    EXPECT_EQ(framesOf(10 * frame - frame / 101), 10);
    EXPECT_EQ(framesOf(10 * frame - frame / 99), 9);
    EXPECT_EQ(framesOf(10 * frame + frame / 2), 10);
    EXPECT_EQ(framesOf(-10 * frame + 1), -10);
    EXPECT_EQ(framesOf(-10 * frame + frame / 99), -9);
    EXPECT_EQ(framesOf(-10 * frame - frame / 2), -10);
    EXPECT_EQ(framesOf(frame / 2), 0);
    EXPECT_EQ(framesOf(-frame / 2), 0);
}

TEST(FbxTime, RoundsSecondsToTheNearestTick) {
    EXPECT_EQ(atSeconds(1.0).Get(), 46186158000);
    EXPECT_EQ(atSeconds(0.6 / 46186158000.0).Get(), 1);
    EXPECT_EQ(atSeconds(0.4 / 46186158000.0).Get(), 0);
    EXPECT_EQ(atSeconds(-0.6 / 46186158000.0).Get(), -1);
    EXPECT_EQ(atSeconds(0.041666666666666664).Get(), 1924423250);
    EXPECT_EQ(FbxTime(46186158000 / 2).GetSecondDouble(), 0.5);
    EXPECT_EQ(FbxTime(-46186158000).GetSecondDouble(), -1.0);
}

TEST(FbxTime, RoundsHalvesAwayFromZero) {
    EXPECT_EQ(atSeconds(1.0 / 32.0).Get(), 1443317438); // 1443317437.5
    EXPECT_EQ(atSeconds(-1.0 / 32.0).Get(), -1443317438);
    EXPECT_EQ(atSeconds(std::nextafter(1.0 / 32.0, 0.0)).Get(), 1443317437);
    EXPECT_EQ(atSeconds(std::nextafter(-1.0 / 32.0, 0.0)).Get(), -1443317437);
}

TEST(FbxTime, IsTheNearestTickToAnySeconds) {
    __extension__ typedef __int128 Wide;
    std::mt19937_64 random(2'026);
    for (int i = 0; i < 200'000; ++i) {
        const int binaryPlaces = 26 + static_cast<int>(random() % 44);
        const auto number = static_cast<std::int64_t>(random() >> (11 + random() % 53));
        const Wide half = Wide{1} << (binaryPlaces - 1);
        const auto nearest = static_cast<FbxLongLong>((Wide{number} * 46186158000 + half) >> binaryPlaces);
        const double seconds = std::ldexp(static_cast<double>(number), -binaryPlaces); // exact
        ASSERT_EQ(atSeconds(seconds).Get(), nearest) << number << " / 2^" << binaryPlaces;
        ASSERT_EQ(atSeconds(-seconds).Get(), -nearest) << -number << " / 2^" << binaryPlaces;
    }
}

TEST(FbxTime, SaturatesSecondsThatAreNoTime) {
    EXPECT_EQ(atSeconds(kNaN).Get(), 0);
    EXPECT_EQ(atSeconds(kInfinity), FBXSDK_TIME_INFINITE);
    EXPECT_EQ(atSeconds(-kInfinity), FBXSDK_TIME_MINUS_INFINITE);
    EXPECT_EQ(atSeconds(1.0e300), FBXSDK_TIME_INFINITE);
    EXPECT_EQ(atSeconds(-1.0e18), FBXSDK_TIME_MINUS_INFINITE);
    EXPECT_EQ(atSeconds(1.0e-320).Get(), 0);
    EXPECT_EQ(atSeconds(0.0).Get(), 0);
    EXPECT_EQ(atSeconds(-0.0).Get(), 0);
    EXPECT_EQ(atSeconds(1.0e-28).Get(), 0);
    EXPECT_EQ(atSeconds(199'697'755.0).Get(), 9223272064675290000);
    EXPECT_EQ(atSeconds(200'000'000.0), FBXSDK_TIME_INFINITE);
    EXPECT_EQ(atSeconds(-200'000'000.0), FBXSDK_TIME_MINUS_INFINITE);
    EXPECT_EQ(atSeconds(std::nextafter(268435456.0, 0.0)), FBXSDK_TIME_INFINITE);
    EXPECT_EQ(atSeconds(268435456.0), FBXSDK_TIME_INFINITE);
}

TEST(FbxTime, HasTheDocumentedInfiniteTimes) {
    EXPECT_EQ(FBXSDK_TC_INFINITY, 0x7FFFFFFFFFFFFFFF);
    EXPECT_EQ(static_cast<FbxULongLong>(FBXSDK_TC_MINFINITY), 0x8000000000000001ULL);
    EXPECT_EQ(FBXSDK_TIME_ZERO.Get(), 0);
    EXPECT_EQ(FBXSDK_TIME_ONE_SECOND.Get(), 46186158000);
}

TEST(FbxTime, CountsFramesOfInfiniteTimesWithoutOverflow) {
    EXPECT_EQ(FBXSDK_TIME_INFINITE.GetFrameCount(FbxTime::eFrames30), 5990997586);
    EXPECT_EQ(FBXSDK_TIME_MINUS_INFINITE.GetFrameCount(FbxTime::eFrames30), -5990997586);
    EXPECT_EQ(FbxTime(INT64_MIN).GetFrameCount(FbxTime::eFrames1000), -199699919548);
    EXPECT_GT(FBXSDK_TIME_INFINITE.GetFrameCount(FbxTime::eNTSCDropFrame), 0);
}

TEST(FbxTime, SaturatesFramesThatAreTooFar) {
    FbxTime time;
    time.SetFrame(INT64_MAX, FbxTime::eFrames24);
    EXPECT_EQ(time, FBXSDK_TIME_INFINITE);
    time.SetFrame(INT64_MIN, FbxTime::eFilmFullFrame);
    EXPECT_EQ(time, FBXSDK_TIME_MINUS_INFINITE);
}

TEST(FbxTime, SetsHoursMinutesSecondsFramesAndFields) {
    FbxTime time;
    time.SetTime(1, 2, 3, 4, 1, FbxTime::eFrames24);
    EXPECT_EQ(time.Get(), 3723 * FBXSDK_TC_SECOND + 4 * 1924423250LL + 1924423250LL / 2);
    time.SetTime(0, 0, -1);
    EXPECT_EQ(time.Get(), -FBXSDK_TC_SECOND);
    time.SetTime(INT32_MAX, INT32_MAX, INT32_MAX, INT32_MAX, INT32_MAX, FbxTime::eFrames24);
    EXPECT_EQ(time, FBXSDK_TIME_INFINITE);
}

TEST(FbxTime, ConvertsMilliSecondsAsWholeNumbers) {
    FbxTime time;
    time.SetMilliSeconds(1500);
    EXPECT_EQ(time.Get(), 46186158 * 1500LL);
    EXPECT_EQ(time.GetMilliSeconds(), 1500);
    EXPECT_EQ(FbxTime(46186157).GetMilliSeconds(), 0);
    time.SetMilliSeconds(INT64_MIN);
    EXPECT_EQ(time, FBXSDK_TIME_MINUS_INFINITE);
}

TEST(FbxTime, FindsTheModeOfARate) {
    EXPECT_EQ(FbxTime::ConvertFrameRateToTimeMode(24.0), FbxTime::eFrames24);
    EXPECT_EQ(FbxTime::ConvertFrameRateToTimeMode(30.0), FbxTime::eFrames30);
    EXPECT_EQ(FbxTime::ConvertFrameRateToTimeMode(29.97002617), FbxTime::eNTSCDropFrame);
    EXPECT_EQ(FbxTime::ConvertFrameRateToTimeMode(29.97, 1.0e-4), FbxTime::eNTSCDropFrame);
    EXPECT_EQ(FbxTime::ConvertFrameRateToTimeMode(29.97), FbxTime::eDefaultMode);
    EXPECT_EQ(FbxTime::ConvertFrameRateToTimeMode(0.0), FbxTime::eDefaultMode);
    EXPECT_EQ(FbxTime::ConvertFrameRateToTimeMode(kNaN), FbxTime::eDefaultMode);
}

TEST(FbxTime, TakesTheGlobalModeForTheDefaultMode) {
    const GlobalTimeModeGuard guard;
    EXPECT_EQ(FbxTime::GetGlobalTimeMode(), FbxTime::eFrames30);
    EXPECT_EQ(FbxTime::GetFrameRate(FbxTime::eDefaultMode), 30.0);

    FbxTime::SetGlobalTimeMode(FbxTime::eFrames48);

    EXPECT_EQ(FbxTime::GetFrameRate(FbxTime::eDefaultMode), 48.0);
    EXPECT_EQ(FBXSDK_TIME_ONE_SECOND.GetFrameCount(), 48);
    EXPECT_EQ(FbxTime::GetOneFrameValue(), 962211625);
}

TEST(FbxTime, CountsInTheCustomRate) {
    const GlobalTimeModeGuard guard;
    FbxTime::SetGlobalTimeMode(FbxTime::eCustom, 12.5);

    EXPECT_EQ(FbxTime::GetFrameRate(FbxTime::eDefaultMode), 12.5);
    EXPECT_EQ(FbxTime::GetFrameRate(FbxTime::eCustom), 12.5);
    for (int frame = -5000; frame <= 5000; ++frame)
        ASSERT_EQ(atSeconds(frame / 12.5).GetFrameCount(), frame);
}

TEST(FbxTime, FallsBackTo30WithoutAUsableCustomRate) {
    const GlobalTimeModeGuard guard;
    for (const double rate : {0.0, -24.0, kNaN, kInfinity}) {
        FbxTime::SetGlobalTimeMode(FbxTime::eCustom, rate);
        EXPECT_EQ(FbxTime::GetFrameRate(FbxTime::eCustom), 30.0) << rate;
    }
    FbxTime::SetGlobalTimeMode(FbxTime::eDefaultMode);
    EXPECT_EQ(FbxTime::GetFrameRate(FbxTime::eDefaultMode), 30.0);
}

TEST(FbxTime, HasARateForModeNumbersThatDoNotExist) {
    const GlobalTimeModeGuard guard;
    for (const int number : {-1, 19, 4711}) {
        EXPECT_EQ(FbxTime::GetFrameRate(static_cast<FbxTime::EMode>(number)), 30.0);
        FbxTime::SetGlobalTimeMode(static_cast<FbxTime::EMode>(number));
        EXPECT_EQ(FbxTime::GetGlobalTimeMode(), FbxTime::eDefaultMode);
    }
}

TEST(FbxTime, SurvivesExtremeCustomRates) {
    const GlobalTimeModeGuard guard;
    FbxTime::SetGlobalTimeMode(FbxTime::eCustom, 1.0e300);
    EXPECT_EQ(FBXSDK_TIME_ONE_SECOND.GetFrameCount(), FBXSDK_TC_INFINITY);
    EXPECT_EQ(FbxTime::GetOneFrameValue(), 0);
    FbxTime::SetGlobalTimeMode(FbxTime::eCustom, 1.0e-300);
    EXPECT_EQ(FBXSDK_TIME_ONE_SECOND.GetFrameCount(), 0);
    EXPECT_EQ(FbxTime::GetOneFrameValue(), FBXSDK_TC_INFINITY);
}

TEST(FbxTime, KeepsTheGlobalModeOfEachThreadApart) {
    const GlobalTimeModeGuard guard;
    FbxTime::SetGlobalTimeMode(FbxTime::eFrames24);
    double otherRate = 0.0;

    std::thread([&otherRate] {
        otherRate = FbxTime::GetFrameRate(FbxTime::eDefaultMode);
        FbxTime::SetGlobalTimeMode(FbxTime::ePAL);
    }).join();

    EXPECT_EQ(otherRate, 30.0);
    EXPECT_EQ(FbxTime::GetFrameRate(FbxTime::eDefaultMode), 24.0);
}

TEST(FbxTime, AddsSubtractsMultipliesAndDividesTicks) {
    const FbxTime seven(7);
    EXPECT_EQ(seven + FbxTime(3), FbxTime(10));
    EXPECT_EQ(seven - FbxTime(10), FbxTime(-3));
    EXPECT_EQ(seven * 3, FbxTime(21));
    EXPECT_EQ(seven / 2, FbxTime(3));
    EXPECT_EQ(seven * FbxTime(2), FbxTime(14));
    EXPECT_EQ(seven / FbxTime(-2), FbxTime(-3));

    FbxTime time = seven;
    time += FbxTime(1);
    time -= FbxTime(3);
    EXPECT_EQ(time++, FbxTime(5));
    EXPECT_EQ(++time, FbxTime(7));
    EXPECT_EQ(time--, FbxTime(7));
    EXPECT_EQ(--time, FbxTime(5));
}

TEST(FbxTime, SaturatesArithmetic) {
    EXPECT_EQ(FBXSDK_TIME_INFINITE + FBXSDK_TIME_ONE_SECOND, FBXSDK_TIME_INFINITE);
    EXPECT_EQ(FBXSDK_TIME_MINUS_INFINITE - FBXSDK_TIME_ONE_SECOND, FBXSDK_TIME_MINUS_INFINITE);
    EXPECT_EQ(FBXSDK_TIME_INFINITE - FBXSDK_TIME_MINUS_INFINITE, FBXSDK_TIME_INFINITE);
    EXPECT_EQ(FBXSDK_TIME_INFINITE * -2, FBXSDK_TIME_MINUS_INFINITE);
    EXPECT_EQ(FbxTime(INT64_MIN) / -1, FBXSDK_TIME_INFINITE);
    EXPECT_EQ(FbxTime(5) / 0, FBXSDK_TIME_INFINITE);
    EXPECT_EQ(FbxTime(-5) / 0, FBXSDK_TIME_MINUS_INFINITE);
    EXPECT_EQ(FbxTime(0) / FbxTime(0), FBXSDK_TIME_ZERO);
    FbxTime infinite = FBXSDK_TIME_INFINITE;
    EXPECT_EQ(++infinite, FBXSDK_TIME_INFINITE);
}

TEST(FbxTimeSpan, HoldsAnyPair) {
    const FbxTimeSpan none;
    const FbxTimeSpan backward(FbxTime(10), FbxTime(-5));
    EXPECT_EQ(none.GetStart(), FBXSDK_TIME_ZERO);
    EXPECT_EQ(none.GetStop(), FBXSDK_TIME_ZERO);
    EXPECT_EQ(backward.GetStart(), FbxTime(10));
    EXPECT_EQ(backward.GetStop(), FbxTime(-5));
    EXPECT_EQ(backward.GetDuration(), FbxTime(15));
    EXPECT_EQ(backward.GetSignedDuration(), FbxTime(-15));
    EXPECT_EQ(backward.GetDirection(), FBXSDK_TIME_BACKWARD);
    EXPECT_EQ(none.GetDirection(), FBXSDK_TIME_FORWARD);
    EXPECT_NE(none, backward);
}

TEST(FbxTimeSpan, IncludesBothEndsInEitherDirection) {
    for (const FbxTimeSpan& span : {FbxTimeSpan(FbxTime(1), FbxTime(5)), FbxTimeSpan(FbxTime(5), FbxTime(1))}) {
        EXPECT_TRUE(span.IsInside(FbxTime(1)));
        EXPECT_TRUE(span.IsInside(FbxTime(5)));
        EXPECT_FALSE(span.IsInside(FbxTime(0)));
        EXPECT_FALSE(span.IsInside(FbxTime(6)));
    }
}

TEST(FbxTimeSpan, IntersectsInItsOwnDirection) {
    const FbxTimeSpan forward(FbxTime(0), FbxTime(10));
    const FbxTimeSpan backward(FbxTime(20), FbxTime(5));
    EXPECT_EQ(forward.Intersect(backward), FbxTimeSpan(FbxTime(5), FbxTime(10)));
    EXPECT_EQ(backward.Intersect(forward), FbxTimeSpan(FbxTime(10), FbxTime(5)));
    EXPECT_EQ(forward.Intersect(FbxTimeSpan(FbxTime(11), FbxTime(12))), FbxTimeSpan());
}

TEST(FbxTimeSpan, UnitesInTheGivenDirection) {
    FbxTimeSpan span(FbxTime(3), FbxTime(7));
    span.UnionAssignment(FbxTimeSpan(FbxTime(12), FbxTime(5)));
    EXPECT_EQ(span, FbxTimeSpan(FbxTime(3), FbxTime(12)));
    span.UnionAssignment(FbxTimeSpan(FbxTime(-1), FbxTime(0)), FBXSDK_TIME_BACKWARD);
    EXPECT_EQ(span, FbxTimeSpan(FbxTime(12), FbxTime(-1)));
}

TEST(FbxTimeSpan, SaturatesTheDurationOfAnEndlessSpan) {
    EXPECT_EQ(FbxTimeSpan(FBXSDK_TIME_MINUS_INFINITE, FBXSDK_TIME_INFINITE).GetDuration(), FBXSDK_TIME_INFINITE);
}

} // namespace
