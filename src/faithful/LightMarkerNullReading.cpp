// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Lights, markers, nulls and plain transforms.
#include "Aim.h"
#include "Placement.h"
#include "Reading.h"
#include "Sampling.h"

#include "access/AttributeEnums.h"
#include "calls/LastError.h"

#include <array>
#include <string>
#include <utility>

namespace Tarnell::Fbx::faithful {

namespace {

using fbxsdk::FbxNode;
using fbxsdk::FbxTime;

Placement lightPlacement(Scene& scene, FbxNode& node, bool global) {
    Placement placement = placementOf(scene, node, global);
    placement.matricesAt = rotatedFirst(std::move(placement.matricesAt), turnOf(kLightTurn));
    placement.nearOwn = false; // used only where they give the rotation in the axes of hosts
    return placement;
}

std::array<double, 4> opaque(const fbxsdk::FbxDouble3& colour) { return {colour[0], colour[1], colour[2], 1.0}; }

/// For values without a channel the value at the frame of the static ones is returned.
double sizeAt(const Scene& scene, const FbxNode& node, fbxsdk::FbxPropertyT<fbxsdk::FbxDouble>& property) {
    const double now = property.EvaluateValue(scene.now());
    const Timeline& timeline = scene.timeline();
    if (property.IsAnimated() && (property.EvaluateValue(timeline.at(static_cast<double>(timeline.first()))) != now ||
                                  property.EvaluateValue(timeline.at(static_cast<double>(timeline.last()))) != now)) {
        detail::warn(scene.fileName() + ": the size of \"" + node.GetName() +
                     "\" is animated; only its value at the frame of the static values is read");
    }
    return now;
}

} // namespace

bool readNode(Scene& scene, const TnFbxReadInfo& info, FbxNode& node, TnFbxTransform& transform) {
    return readPlacement(scene, placementOf(scene, node, info.getGlobalTransform()), transform);
}

bool readNode(Scene& scene, const TnFbxReadInfo& info, FbxNode& node, TnFbxLight& light) {
    fbxsdk::FbxLight& source = *node.GetLight();
    light.setLightType(
        detail::lookUp(detail::kLightTypes, source.LightType.Get<fbxsdk::FbxEnum>(), detail::kOtherLightType));
    light.setDecayType(
        detail::lookUp(detail::kDecayTypes, source.DecayType.Get<fbxsdk::FbxEnum>(), detail::kOtherDecayType));
    const auto valuesAt = [&source](const FbxTime& time) -> std::array<double, 6> {
        const std::array<double, 4> colour = opaque(source.Color.EvaluateValue(time));
        return {colour[0],
                colour[1],
                colour[2],
                colour[3],
                source.Intensity.EvaluateValue(time) / 100.0, // from percent
                source.OuterAngle.EvaluateValue(time)};
    };
    return readPlacement(scene, lightPlacement(scene, node, info.getGlobalTransform()), light) &&
           fillChannels<6>(scene, scene.isKeyed(source), light, TnFbxLight::kFbxLightRed, valuesAt);
}

bool readNode(Scene& scene, const TnFbxReadInfo& info, FbxNode& node, TnFbxMarker& marker) {
    fbxsdk::FbxMarker& source = *node.GetMarker();
    marker.setMarkerLookType(
        detail::lookUp(detail::kMarkerLooks, source.Look.Get<fbxsdk::FbxEnum>(), detail::kOtherMarkerLook));
    marker.setMarkerSize(toFloat(sizeAt(scene, node, source.Size)));
    return readNode(scene, info, node, static_cast<TnFbxTransform&>(marker)) &&
           fillChannels<4>(scene, scene.isKeyed(source), marker, TnFbxMarker::kFbxMarkerRed,
                           [&source](const FbxTime& time) { return opaque(source.Color.EvaluateValue(time)); });
}

bool readNode(Scene& scene, const TnFbxReadInfo& info, FbxNode& node, TnFbxNull& null) {
    if (fbxsdk::FbxNull* source = node.GetNull()) {
        null.setNullLookType(
            detail::lookUp(detail::kNullLooks, source->Look.Get<fbxsdk::FbxEnum>(), detail::kOtherNullLook));
        null.setNullSize(toFloat(sizeAt(scene, node, source->Size)));
    } else {
        null.setNullLookType(TnFbxNull::kFbxNullLookNone); // a node without an attribute is not drawn
    }
    return readNode(scene, info, node, static_cast<TnFbxTransform&>(null));
}

} // namespace Tarnell::Fbx::faithful
