// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What a curve's keys say, in words.
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
    bool clamped = false;           ///< flat where the neighbours are no further up or down
    bool timeIndependent = false;
    std::optional<double> leftSlope, rightSlope;   ///< in force, per second, where a cubic piece begins or ends
    std::optional<double> leftWeight, rightWeight; ///< in force, of those sides: lengths of the handles
    std::optional<float> tension, continuity, bias;

    /// What has no column of its own.
    [[nodiscard]] std::string remarks() const;
};

struct Extrapolation {
    const char* type = "constant"; ///< constant, repetition, mirror, slope, relative
    std::optional<long> count;     ///< of repetitions; none: without end, or where nothing is repeated
};

std::vector<KeyFacts> keyFacts(FbxAnimCurve& curve);
Extrapolation extrapolationBefore(const FbxAnimCurve& curve);
Extrapolation extrapolationAfter(const FbxAnimCurve& curve);

/// The keys of a key's JSON object from its interpolation on.
void printShape(const KeyFacts& key, JsonWriter& json);

} // namespace tool
