// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Timeline.h"

#include <cmath>
#include <limits>

namespace Tarnell::Fbx::faithful {

namespace {

/// A time this close to a whole frame is that frame's: files round the ticks of fractional rates.
constexpr double kFrameTolerance = 0.01;

std::int64_t wholeFrame(double frame) {
    constexpr auto least = static_cast<double>(std::numeric_limits<int>::min());
    constexpr auto most = static_cast<double>(std::numeric_limits<int>::max());
    return static_cast<std::int64_t>(std::fmin(std::fmax(frame, least), most));
}

} // namespace

Timeline::Timeline(double rate, const fbxsdk::FbxTimeSpan& span) : mRate(rate) {
    const double first = span.GetStart().GetSecondDouble() * rate;
    const double last = span.GetStop().GetSecondDouble() * rate;
    mFirst = wholeFrame(std::floor(first + kFrameTolerance));
    mLast = wholeFrame(std::ceil(last - kFrameTolerance));
    mLast = mLast < mFirst ? mFirst : mLast;
}

fbxsdk::FbxTime Timeline::at(double frame) const {
    fbxsdk::FbxTime time;
    time.SetSecondDouble(frame / mRate);
    return time;
}

TnFbxTime Timeline::record(float frame) const {
    TnFbxTime time;
    time.setTime(frame, static_cast<int>(mFirst), static_cast<int>(mLast), static_cast<float>(mRate));
    return time;
}

} // namespace Tarnell::Fbx::faithful
