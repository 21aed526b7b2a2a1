// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A property's static value and its curves are converted together, so that they agree afterwards.
#include "conversion/AnimatedValues.h"

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxScene.h>

#include "animation/CurveEvaluation.h"
#include "object/SceneMembers.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Whether the curve drives more than one channel, over all curve nodes. Thousands may share one curve: the search ends
/// at the second.
bool isShared(const FbxAnimCurve& curve) {
    int uses = 0;
    for (const ConnectionPoint* point : curve.data().plug.destinations) {
        const auto* node = point->property < 0 ? FbxCast<FbxAnimCurveNode>(point->object) : nullptr;
        uses += node ? node->usesOf(curve) : 0;
        if (uses > 1)
            return true;
    }
    return false;
}

/// The channel's curve, replaced by a copy of its own when it drives anything else.
FbxAnimCurve* ownCurve(FbxAnimCurveNode& node, unsigned int channel) {
    FbxAnimCurve* curve = node.GetCurve(channel);
    if (!curve || !isShared(*curve))
        return curve;
    FbxScene* scene = curve->GetScene();
    FbxAnimCurve* copy = scene ? FbxAnimCurve::Create(scene, curve->GetName())
                               : FbxAnimCurve::Create(curve->GetFbxManager(), curve->GetName());
    copy->editKeys() = curve->keys();
    node.DisconnectFromChannel(curve, channel);
    node.ConnectToChannel(copy, channel, true);
    return copy;
}

void scaleChannel(FbxAnimCurveNode& node, unsigned int channel, double factor) {
    if (factor == 1.0)
        return;
    node.setChannelValue(channel, node.channelValue(channel) * factor);
    if (FbxAnimCurve* curve = ownCurve(node, channel))
        curve->KeyMultValue(static_cast<float>(factor));
}

void scaleValue(FbxProperty& property, double factor) {
    FbxDouble3 value = property.Get<FbxDouble3>();
    for (int i = 0; i < 3; ++i)
        value[i] *= factor;
    if (property.GetPropertyDataType().GetType() == eFbxDouble3)
        property.Set(value);
    else
        property.Set(property.Get<FbxDouble>() * factor);
}

void permuteChannels(FbxAnimCurveNode& node, const SignedPermutation& permutation) {
    if (node.GetChannelsCount() != 3)
        return;
    std::array<double, 3> values{};
    std::array<FbxAnimCurve*, 3> curves{};
    for (unsigned int i = 0; i < 3; ++i) {
        values[i] = node.channelValue(i);
        curves[i] = ownCurve(node, i);
    }
    for (unsigned int i = 0; i < 3; ++i)
        if (curves[i])
            node.DisconnectFromChannel(curves[i], i);
    for (unsigned int i = 0; i < 3; ++i) {
        const auto from = static_cast<std::size_t>(permutation.source[i]);
        node.setChannelValue(i, values[from] * permutation.sign[i]);
        if (!curves[from])
            continue;
        node.ConnectToChannel(curves[from], i, true);
        if (permutation.sign[i] < 0)
            curves[from]->KeyMultValue(-1.0F);
    }
}

} // namespace

bool SignedPermutation::isIdentity() const {
    return source == std::array<int, 3>{0, 1, 2} && sign == std::array<double, 3>{1, 1, 1};
}

void scaleAnimated(FbxProperty property, double factor, const std::function<bool(const FbxAnimLayer*)>& applies) {
    if (!property.IsValid())
        return;
    scaleValue(property, factor);
    for (FbxAnimCurveNode* node : sourcesOf<FbxAnimCurveNode>(property)) {
        if (!applies(node->GetDstObject<FbxAnimLayer>()))
            continue;
        for (unsigned int channel = 0; channel < node->GetChannelsCount(); ++channel)
            scaleChannel(*node, channel, factor);
    }
}

void scaleAnimated(FbxProperty property, double factor) {
    scaleAnimated(
        property, factor, [](const FbxAnimLayer*) { return true; });
}

void permuteAnimated(FbxProperty property, const SignedPermutation& permutation) {
    if (!property.IsValid() || permutation.isIdentity())
        return;
    const FbxDouble3 old = property.Get<FbxDouble3>();
    FbxDouble3 value;
    for (int i = 0; i < 3; ++i) {
        const auto row = static_cast<std::size_t>(i);
        value[i] = old[permutation.source[row]] * permutation.sign[row];
    }
    property.Set(value);
    for (FbxAnimCurveNode* node : sourcesOf<FbxAnimCurveNode>(property))
        permuteChannels(*node, permutation);
}

} // namespace detail
FBXSDK_NAMESPACE_END
