// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Keys as text.
#include "CurveKeysText.h"

#include <algorithm>
#include <cmath>

#include <fbxsdk/extensions/CurveSlopes.h>

#include "SceneFacts.h"

namespace tool {
namespace {

using Def = FbxAnimCurveDef;

const char* interpolationName(const FbxAnimCurve& curve, int key) {
    switch (curve.KeyGetInterpolation(key)) {
    case Def::eInterpolationConstant:
        return curve.KeyGetConstantMode(key) == Def::eConstantNext ? "next" : "constant";
    case Def::eInterpolationLinear:
        return "linear";
    case Def::eInterpolationCubic:
        return "cubic";
    }
    return "unknown";
}

bool has(int bits, int flag) { return (bits & flag) == flag; }

const char* tangentName(int mode) {
    if (has(mode, Def::eTangentTCB))
        return "TCB";
    if (has(mode, Def::eTangentAutoBreak))
        return "auto broken";
    if (has(mode, Def::eTangentAuto))
        return "auto";
    if (has(mode, Def::eTangentGenericBreak))
        return "broken";
    return has(mode, Def::eTangentUser) ? "user" : "none";
}

bool isCubic(const FbxAnimCurve& curve, int key) {
    return key >= 0 && key + 1 < curve.KeyGetCount() && curve.KeyGetInterpolation(key) == Def::eInterpolationCubic;
}

bool isTcb(const FbxAnimCurve& curve, int key) { return has(curve.KeyGetTangentMode(key), Def::eTangentTCB); }

void addSlopes(const FbxAnimCurve& curve, int key, KeyFacts& facts) {
    const extensions::KeySlopes slopes = extensions::slopesAt(curve, key);
    if (isCubic(curve, key - 1)) {
        facts.leftSlope = slopes.left;
        facts.leftWeight = slopes.leftWeight;
    }
    if (isCubic(curve, key)) {
        facts.rightSlope = slopes.right;
        facts.rightWeight = slopes.rightWeight;
    }
}

KeyFacts factsOf(const FbxAnimCurve& curve, int key) {
    KeyFacts facts;
    facts.time = curve.KeyGetTime(key);
    facts.value = curve.KeyGetValue(key);
    facts.interpolation = interpolationName(curve, key);
    const int mode = curve.KeyGetTangentMode(key);
    if (curve.KeyGetInterpolation(key) == Def::eInterpolationCubic) {
        facts.tangent = tangentName(mode);
        facts.clamped = has(mode, Def::eTangentGenericClamp);
        facts.timeIndependent = has(mode, Def::eTangentGenericTimeIndependent);
    }
    addSlopes(curve, key, facts);
    if (isCubic(curve, key) && isTcb(curve, key)) {
        facts.tension = curve.KeyGetData(key, Def::eTCBTension);
        facts.continuity = curve.KeyGetData(key, Def::eTCBContinuity);
        facts.bias = curve.KeyGetData(key, Def::eTCBBias);
    }
    return facts;
}

/// Whether the curve is constant before or after its keys, and not between them. In the API the count 0 means endless
/// repetition, and also is what a file with 0 repetitions has.
bool standsStillBeside(FbxAnimCurve& curve, bool before) {
    constexpr long long kProbes = 32;
    const FbxTime first = curve.KeyGetTime(0), last = curve.KeyGetTime(curve.KeyGetCount() - 1);
    const long long length = last.Get() - first.Get();
    const float edge = curve.KeyGetValue(before ? 0 : curve.KeyGetCount() - 1);
    bool movesInside = false;
    for (long long i = 1; i < kProbes; ++i) {
        const long long away = length / kProbes * i;
        if (curve.Evaluate(FbxTime(before ? first.Get() - away : last.Get() + away)) != edge)
            return false;
        movesInside = movesInside || curve.Evaluate(FbxTime(first.Get() + away)) != edge;
    }
    return movesInside;
}

Extrapolation extrapolation(FbxAnimCurve& curve, bool before) {
    const auto type = before ? curve.GetPreExtrapolation() : curve.GetPostExtrapolation();
    const unsigned long count = before ? curve.GetPreExtrapolationCount() : curve.GetPostExtrapolationCount();
    const bool isCounted = count > 0 || (type != FbxAnimCurveBase::eConstant && standsStillBeside(curve, before));
    const std::optional<long> times = isCounted ? std::optional(static_cast<long>(count)) : std::nullopt;
    switch (type) {
    case FbxAnimCurveBase::eConstant:
        return {"constant", false, {}};
    case FbxAnimCurveBase::eRepetition:
        return {"repetition", true, times};
    case FbxAnimCurveBase::eMirrorRepetition:
        return {"mirror", true, times};
    case FbxAnimCurveBase::eKeepSlope:
        return {"slope", false, {}};
    case FbxAnimCurveBase::eRelativeRepetition:
        return {"relative", true, times};
    }
    return {"unknown", false, {}};
}

/// Whether a weight differs from the default third; old files have it with four digits.
bool isUnusual(const std::optional<double>& weight) {
    constexpr double kClose = 1e-3;
    return weight && std::abs(*weight - static_cast<double>(Def::sDEFAULT_WEIGHT)) > kClose;
}

} // namespace

std::string KeyFacts::remarks() const {
    std::string text;
    const auto add = [&](const std::string& remark) { text += (text.empty() ? "" : ", ") + remark; };
    if (clamped)
        add("clamped");
    if (timeIndependent)
        add("time-independent");
    if (isUnusual(leftWeight))
        add("left weight " + floatText(*leftWeight));
    if (isUnusual(rightWeight))
        add("right weight " + floatText(*rightWeight));
    if (tension)
        add("tension " + exactText(*tension) + ", continuity " + exactText(*continuity) + ", bias " + exactText(*bias));
    return text;
}

std::vector<KeyFacts> keyFacts(FbxAnimCurve& curve) {
    std::vector<KeyFacts> facts;
    facts.reserve(static_cast<std::size_t>(std::max(curve.KeyGetCount(), 0)));
    for (int key = 0; key < curve.KeyGetCount(); ++key)
        facts.push_back(factsOf(curve, key));
    return facts;
}

Extrapolation extrapolationBefore(FbxAnimCurve& curve) { return extrapolation(curve, /*before=*/true); }

Extrapolation extrapolationAfter(FbxAnimCurve& curve) { return extrapolation(curve, /*before=*/false); }

void printShape(const KeyFacts& key, JsonWriter& json) {
    json.text("interpolation", key.interpolation);
    json.text("tangent", key.tangent);
    json.boolean("clamped", key.clamped);
    json.boolean("timeIndependent", key.timeIndependent);
    const auto add = [&](const char* name, const auto& number) {
        json.key(name);
        if (number)
            json.real(*number);
        else
            json.null();
    };
    add("leftSlope", key.leftSlope);
    add("rightSlope", key.rightSlope);
    add("leftWeight", key.leftWeight);
    add("rightWeight", key.rightWeight);
    add("tension", key.tension);
    add("continuity", key.continuity);
    add("bias", key.bias);
}

} // namespace tool
