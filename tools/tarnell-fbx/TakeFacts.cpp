// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "TakeFacts.h"

#include <algorithm>
#include <cmath>

namespace tool {
namespace {

using Span = std::optional<std::pair<double, double>>;

Span secondsOf(const FbxTimeSpan& span, bool isOne) {
    if (!isOne)
        return std::nullopt;
    return std::pair(span.GetStart().GetSecondDouble(), span.GetStop().GetSecondDouble());
}

FbxTimeSpan nothing() { return {FBXSDK_TIME_INFINITE, FBXSDK_TIME_MINUS_INFINITE}; }

Span spanOfKeys(FbxScene& scene, FbxAnimStack& take) {
    FbxTimeSpan keys = nothing();
    bool keyed = false;
    for (int layer = 0; layer < take.GetMemberCount<FbxAnimLayer>(); ++layer)
        keyed = scene.GetRootNode()->GetAnimationInterval(keys, &take, layer) || keyed;
    return secondsOf(keys, keyed);
}

} // namespace

TakeFacts takeFacts(const SceneFile& file, FbxAnimStack* take) {
    TakeFacts facts;
    facts.frameRate = file.frameRate();
    if (!take)
        return facts;
    facts.exists = true;
    facts.name = take->GetName();
    const FbxTimeSpan stated = take->GetLocalTimeSpan();
    facts.span = secondsOf(stated, stated.GetStart() < stated.GetStop());
    facts.keys = spanOfKeys(file.scene(), *take);
    if (!facts.span && !facts.keys)
        return facts;
    const auto& one = facts.span ? *facts.span : *facts.keys;
    const auto& other = facts.keys ? *facts.keys : one;
    // Files round the ticks of fractional rates: a time that close to a whole frame is that frame.
    constexpr double kTolerance = 0.01, kMost = 2147483647.0;
    const double first = std::floor(std::min(one.first, other.first) * facts.frameRate + kTolerance);
    const double last = std::ceil(std::max(one.second, other.second) * facts.frameRate - kTolerance);
    facts.firstFrame = static_cast<long long>(std::clamp(first, -kMost, kMost));
    facts.lastFrame = std::max(facts.firstFrame, static_cast<long long>(std::clamp(last, -kMost, kMost)));
    return facts;
}

} // namespace tool
