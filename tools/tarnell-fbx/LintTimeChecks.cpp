// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Checks of rates, takes and keys.
#include <algorithm>
#include <cmath>
#include <string>

#include <fbxsdk/extensions/FileFacts.h>

#include "CameraOrigins.h"
#include "LintChecks.h"
#include "SceneFacts.h"

namespace tool {
namespace {

std::string framesText(const std::pair<double, double>& seconds, double rate) {
    return rounded(seconds.first * rate, 3) + " to " + rounded(seconds.second * rate, 3);
}

/// A key this close to a whole frame is on it: files round the ticks of fractional rates.
constexpr double kFrameTolerance = 0.005;

} // namespace

void rateUnstated(const LintContext& context, LintReport& report) {
    if (context.stacks.empty() || extensions::statesFrameRate(context.scene()))
        return;
    const bool isCustom = context.file.timeMode() == FbxTime::eCustom;
    report.add("", std::string(isCustom ? "the time mode is custom, without a frame rate"
                                        : "the time mode is 0, the default of the application") +
                       "; read as " + rateText(context.take.frameRate));
}

void keysBetweenFrames(const LintContext& context, LintReport& report) {
    for (const KeyedChannel& keyed : *context.channels) {
        std::size_t between = 0, all = 0;
        double example = 0.0;
        for (const LayerCurve& each : keyed.channel.curves) {
            for (int i = 0; i < each.curve->KeyGetCount(); ++i, ++all) {
                const double frame = each.curve->KeyGetTime(i).GetSecondDouble() * context.take.frameRate;
                if (std::abs(frame - std::round(frame)) <= kFrameTolerance)
                    continue;
                example = between++ == 0 ? frame : example;
            }
        }
        if (between > 0)
            report.add(nameOf(*keyed.object), keyed.fullName() + ": " + std::to_string(between) + " of " +
                                                  countOf(all, "key", "keys") + " between whole frames, the first at " +
                                                  rounded(example, 4));
    }
}

void spanDiffersFromKeys(const LintContext& context, LintReport& report) {
    constexpr double kHalfAFrame = 0.5;
    for (const TakeFacts& take : context.takes) {
        if (!take.span || !take.keys || take.keys->first == take.keys->second)
            continue; // keys at one time only hold endlessly
        const double start = (take.keys->first - take.span->first) * take.frameRate;
        const double end = (take.keys->second - take.span->second) * take.frameRate;
        if (std::abs(start) > kHalfAFrame || std::abs(end) > kHalfAFrame)
            report.add(take.name, "the span of the take is frames " + framesText(*take.span, take.frameRate) +
                                      ", its keys are at frames " + framesText(*take.keys, take.frameRate));
    }
}

void takeWithoutSpan(const LintContext& context, LintReport& report) {
    for (const TakeFacts& take : context.takes) {
        if (!take.span)
            report.add(take.name, take.keys ? "the take states no span; its keys are at frames " +
                                                  framesText(*take.keys, take.frameRate)
                                            : "the take states no span");
    }
}

void takeWithoutKeys(const LintContext& context, LintReport& report) {
    const auto& channels = context.channelsByTake;
    // Not of static scenes.
    if (std::all_of(channels.begin(), channels.end(), [](const auto& each) { return each.empty(); }))
        return;
    for (std::size_t i = 0; i < context.takes.size(); ++i)
        if (channels[i].empty())
            report.add(context.takes[i].name, "nothing is keyed in the take");
}

void severalTakes(const LintContext& context, LintReport& report) {
    if (context.takes.size() > 1)
        report.add("", "the file has " + std::to_string(context.takes.size()) + " takes; the first is " +
                           inQuotes(context.takes.front().name));
}

void severalLayers(const LintContext& context, LintReport& report) {
    for (const FbxAnimStack* stack : context.stacks) {
        if (stack->GetMemberCount<FbxAnimLayer>() > 1)
            report.add(stack->GetName(),
                       "the take has " + std::to_string(stack->GetMemberCount<FbxAnimLayer>()) + " layers");
    }
}

void rotationFlips(const LintContext& context, LintReport& report) {
    constexpr double kHalfATurn = 180.0, kOneFrame = 1.01;
    for (const KeyedChannel& keyed : *context.channels) {
        if (keyed.channel.property.GetName() != FbxString("Lcl Rotation"))
            continue;
        std::size_t flips = 0;
        std::string example;
        for (const LayerCurve& each : keyed.channel.curves) {
            for (int i = 1; i < each.curve->KeyGetCount(); ++i) {
                const double from = each.curve->KeyGetTime(i - 1).GetSecondDouble() * context.take.frameRate;
                const double to = each.curve->KeyGetTime(i).GetSecondDouble() * context.take.frameRate;
                const auto before = static_cast<double>(each.curve->KeyGetValue(i - 1));
                const auto after = static_cast<double>(each.curve->KeyGetValue(i));
                if (to - from > kOneFrame || std::abs(after - before) < kHalfATurn)
                    continue;
                if (flips++ == 0)
                    example = "from " + rounded(before, 3) + "° to " + rounded(after, 3) + "° between frames " +
                              rounded(from, 3) + " and " + rounded(to, 3);
            }
        }
        if (flips > 0)
            report.add(nameOf(*keyed.object), keyed.fullName() + ": " + example +
                                                  (flips > 1 ? ", and " + std::to_string(flips - 1) + " more" : ""));
    }
}

} // namespace tool
