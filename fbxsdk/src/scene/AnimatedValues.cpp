// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A property's value and its animation change together, or samples and static values disagree.
#include "scene/AnimatedValues.h"

#include <vector>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxScene.h>

#include "animation/CurveEvaluation.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

std::vector<FbxAnimCurveNode*> curveNodesOf(const FbxProperty& property) {
    std::vector<FbxAnimCurveNode*> nodes;
    const FbxCriteria curveNodes = FbxCriteria::ObjectType(FbxAnimCurveNode::ClassId);
    for (int i = 0; FbxObject* source = property.GetSrcObject(curveNodes, i); ++i) {
        nodes.push_back(static_cast<FbxAnimCurveNode*>(source));
    }
    return nodes;
}

/// In how many channels the curve stands, over all curve nodes.
int useCount(const FbxAnimCurve& curve) {
    int count = 0;
    const FbxCriteria curveNodes = FbxCriteria::ObjectType(FbxAnimCurveNode::ClassId);
    for (int i = 0; FbxObject* destination = curve.GetDstObject(curveNodes, i); ++i) {
        const auto& node = static_cast<const FbxAnimCurveNode&>(*destination);
        for (unsigned int channel = 0; channel < node.GetChannelsCount(); ++channel) {
            for (unsigned int id = 0; node.GetCurve(channel, id); ++id)
                count += node.GetCurve(channel, id) == &curve;
        }
    }
    return count;
}

/// The channel's curve, replaced by a copy of its own when it drives anything else.
FbxAnimCurve* ownCurve(FbxAnimCurveNode& node, unsigned int channel) {
    FbxAnimCurve* curve = node.GetCurve(channel);
    if (!curve || useCount(*curve) <= 1)
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
    if (property.GetPropertyDataType().GetType() == eFbxDouble3) {
        property.Set(value);
    } else {
        property.Set(property.Get<FbxDouble>() * factor);
    }
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
    for (unsigned int i = 0; i < 3; ++i) {
        if (curves[i])
            node.DisconnectFromChannel(curves[i], i);
    }
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
    for (FbxAnimCurveNode* node : curveNodesOf(property)) {
        if (!applies(node->GetDstObject<FbxAnimLayer>()))
            continue;
        for (unsigned int channel = 0; channel < node->GetChannelsCount(); ++channel) {
            scaleChannel(*node, channel, factor);
        }
    }
}

void scaleAnimated(FbxProperty property, double factor) {
    scaleAnimated(property, factor, [](const FbxAnimLayer*) { return true; });
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
    for (FbxAnimCurveNode* node : curveNodesOf(property))
        permuteChannels(*node, permutation);
}

} // namespace detail
FBXSDK_NAMESPACE_END
