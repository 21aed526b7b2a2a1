// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Times that are derived from the keys of a file.
#include "scene/MissingTimes.h"

#include <algorithm>
#include <cstdio>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxScene.h>

#include "animation/CurveEvaluation.h"
#include "animation/FrameRateOfTimes.h"
#include "object/SceneMembers.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

bool states(const DocumentObject& object, std::string_view start, std::string_view stop) {
    return object.property(start) != nullptr || object.property(stop) != nullptr;
}

bool states(std::span<const DocumentProperty> settings, std::string_view name) {
    return std::any_of(
        settings.begin(), settings.end(), [&](const auto& line) { return line.name == name; });
}

template <class Visit>
void eachCurve(const FbxAnimStack& stack, Visit&& visit) {
    for (const FbxAnimLayer* layer : sourcesOf<FbxAnimLayer>(stack)) {
        for (const FbxAnimCurveNode* node : sourcesOf<FbxAnimCurveNode>(*layer)) {
            for (unsigned int channel = 0; channel < node->GetChannelsCount(); ++channel)
                if (const FbxAnimCurve* curve = node->GetCurve(channel))
                    visit(curve->keys());
        }
    }
}

/// False when the stack has no keys.
bool keySpan(const FbxAnimStack& stack, FbxTimeSpan& span) {
    bool found = false;
    std::int64_t first = 0, last = 0;
    eachCurve(stack, [&](const CurveKeys& keys) {
        if (keys.keyCount() == 0)
            return;
        const std::int64_t start = keys.times.front(), stop = keys.times[keys.keyCount() - 1];
        first = found ? std::min(first, start) : start;
        last = found ? std::max(last, stop) : stop;
        found = true;
    });
    span.Set(FbxTime(first), FbxTime(last));
    return found;
}

void fillSpan(const Document& document, const DocumentObject& source, FbxAnimStack& stack, FbxScene& scene) {
    const bool byTemplate = stack.LocalStart.Get().Get() != 0 || stack.LocalStop.Get().Get() != 0;
    if (byTemplate || states(source, "LocalStart", "LocalStop"))
        return;
    FbxTimeSpan span;
    if (keySpan(stack, span)) {
        stack.SetLocalTimeSpan(span);
    } else if (states(source, "ReferenceStart", "ReferenceStop")) {
        stack.SetLocalTimeSpan(stack.GetReferenceTimeSpan());
    } else if (states(document.globalSettings, "TimeSpanStart") || states(document.globalSettings, "TimeSpanStop")) {
        scene.GetGlobalSettings().GetTimelineDefaultTimeSpan(span);
        stack.SetLocalTimeSpan(span);
    }
}

/// The document's stacks with their objects in the file, in the order of the file.
template <class Visit>
void eachStack(const Document& document, const std::vector<FbxObject*>& objects, Visit&& visit) {
    for (std::size_t i = 0; i < document.objects.size(); ++i)
        if (auto* stack = FbxCast<FbxAnimStack>(objects[i]))
            visit(document.objects[i], *stack);
}

void sortOut(std::vector<std::int64_t>& times) {
    std::sort(times.begin(), times.end());
    times.erase(std::unique(times.begin(), times.end()), times.end());
}

/// The times of all keys; without keys, start and stop of the stack.
std::vector<std::int64_t> timesOf(const FbxAnimStack& stack) {
    std::vector<std::int64_t> times;
    std::size_t sorted = 0;
    eachCurve(stack, [&](const CurveKeys& keys) {
        times.insert(times.end(), keys.times.begin(), keys.times.end());
        if (times.size() < 2 * sorted + 1024) // usually the curves have their keys at the same times
            return;
        sortOut(times);
        sorted = times.size();
    });
    if (times.empty())
        times = {stack.LocalStart.Get().Get(), stack.LocalStop.Get().Get()};
    sortOut(times);
    return times;
}

std::string rateText(double rate) {
    char text[32];
    std::snprintf(text, sizeof text, "%.10g", rate);
    return text;
}

} // namespace

void fillStackSpans(const Document& document, const std::vector<FbxObject*>& objects, FbxScene& scene) {
    eachStack(
        document, objects,
        [&](const DocumentObject& source, FbxAnimStack& stack) { fillSpan(document, source, stack, scene); });
}

std::string fillFrameRate(const Document& document, const std::vector<FbxObject*>& objects, FbxScene& scene) {
    FbxGlobalSettings& settings = scene.GetGlobalSettings();
    const bool lacksRate = settings.GetTimeMode() == FbxTime::eCustom && !(settings.GetCustomFrameRate() > 0.0);
    scene.sceneData().fileStatesRate = settings.GetTimeMode() != FbxTime::eDefaultMode && !lacksRate;
    if (!lacksRate)
        return {};
    const FbxAnimStack* first = nullptr;
    eachStack(document, objects, [&](const DocumentObject&, FbxAnimStack& stack) { first = first ? first : &stack; });
    const double rate = first ? frameRateOfTimes(timesOf(*first)) : 0.0;
    const std::string start = "the time mode is custom, but states no frame rate; ";
    if (rate <= 0.0)
        return start + "30 frames per second are assumed, since none can be derived from the file";
    settings.FindProperty("CustomFrameRate").Set(rate);
    return start + rateText(rate) + " frames per second were derived from its times";
}

} // namespace detail
FBXSDK_NAMESPACE_END
