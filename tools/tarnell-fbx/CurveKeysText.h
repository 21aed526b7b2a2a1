// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A curve's keys as text.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include <fbxsdk.h>

#include "JsonWriter.h"

namespace tool {

struct KeyFacts {
    FbxTime time;
    float value = 0.0F;
    const char* interpolation = ""; ///< towards the next key: constant, next (the value of the next key), linear, cubic
    std::string tangent;            ///< auto, user, broken, auto broken, TCB; empty where there is none
    bool clamped = false;           ///< flat where the adjacent keys are not further up or down
    bool timeIndependent = false;
    std::optional<double> leftSlope, rightSlope;   ///< effective, per second, where a cubic segment begins or ends
    std::optional<double> leftWeight, rightWeight; ///< effective, on those sides: lengths of the handles
    std::optional<float> tension, continuity, bias;

    /// The values without a column of their own.
    [[nodiscard]] std::string remarks() const;
};

struct Extrapolation {
    const char* type = "constant"; ///< constant, repetition, mirror, slope, relative
    bool repeats = false;          ///< whether the keys repeat
    std::optional<long> count;     ///< of repetitions; none: endless, or where nothing is repeated
};

std::vector<KeyFacts> keyFacts(FbxAnimCurve& curve);
/// Of a curve with keys.
Extrapolation extrapolationBefore(FbxAnimCurve& curve);
Extrapolation extrapolationAfter(FbxAnimCurve& curve);

/// The keys of a key's JSON object from its interpolation on.
void printShape(const KeyFacts& key, JsonWriter& json);

} // namespace tool
