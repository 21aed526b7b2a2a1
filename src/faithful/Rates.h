// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Exact frame rates: those of television are fractions, which hosts and files state rounded.
#pragma once

#include <fbxsdk.h>

#include <cmath>

namespace Tarnell::Fbx::faithful {

struct RateRow {
    fbxsdk::FbxTime::EMode mode;
    double rate;
};

/// The first row of a rate is how it is written.
inline constexpr RateRow kTelevisionRates[] = {
    {fbxsdk::FbxTime::eFilmFullFrame, 24000.0 / 1001.0}, //
    {fbxsdk::FbxTime::eNTSCFullFrame, 30000.0 / 1001.0}, //
    {fbxsdk::FbxTime::eNTSCDropFrame, 30000.0 / 1001.0}, //
    {fbxsdk::FbxTime::eFrames59dot94, 60000.0 / 1001.0}, //
    {fbxsdk::FbxTime::eFrames119dot88, 120000.0 / 1001.0},
};

inline constexpr RateRow kWholeRates[] = {
    {fbxsdk::FbxTime::eFrames24, 24.0},   {fbxsdk::FbxTime::ePAL, 25.0},          {fbxsdk::FbxTime::eFrames30, 30.0},
    {fbxsdk::FbxTime::eFrames48, 48.0},   {fbxsdk::FbxTime::eFrames50, 50.0},     {fbxsdk::FbxTime::eFrames60, 60.0},
    {fbxsdk::FbxTime::eFrames72, 72.0},   {fbxsdk::FbxTime::eFrames96, 96.0},     {fbxsdk::FbxTime::eFrames100, 100.0},
    {fbxsdk::FbxTime::eFrames120, 120.0}, {fbxsdk::FbxTime::eFrames1000, 1000.0},
};

/// Whether the number of frames per second is valid.
inline bool isRate(double rate) { return std::isfinite(rate) && rate > 0.0; }

/// The mode of a rate and its exact number of frames per second: 23.976 and 29.97 mean fractions. A rate
/// without a mode is a custom one.
inline RateRow exactRate(float framesPerSecond) {
    constexpr double kTolerance = 2e-6; // 23.976 is 1e-6 below the rate it means
    const auto rate = static_cast<double>(framesPerSecond);
    for (const RateRow& row : kTelevisionRates)
        if (std::fabs(rate - row.rate) < kTolerance * row.rate)
            return row;
    for (const RateRow& row : kWholeRates)
        if (rate >= row.rate && rate <= row.rate)
            return row;
    return {fbxsdk::FbxTime::eCustom, rate};
}

} // namespace Tarnell::Fbx::faithful
