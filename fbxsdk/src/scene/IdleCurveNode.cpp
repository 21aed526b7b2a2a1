// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Layers above the base layer contribute the values of their curve nodes even without keys: those are never idle.
#include "scene/IdleCurveNode.h"

#include <algorithm>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

bool hasCurves(const FbxAnimCurveNode& node) {
    for (unsigned int channel = 0; channel < node.GetChannelsCount(); ++channel)
        if (node.GetCurveCount(channel) > 0)
            return true;
    return false;
}

bool isOnBaseLayer(const FbxAnimCurveNode& node) {
    const auto* layer = node.GetDstObject<FbxAnimLayer>();
    const auto* stack = layer ? layer->GetDstObject<FbxAnimStack>() : nullptr;
    return stack && stack->GetSrcObject<FbxAnimLayer>() == layer;
}

bool hasValueOf(const FbxAnimCurveNode& node, const FbxProperty& property) {
    const FbxDouble4 value = property.Get<FbxDouble4>();
    const unsigned int count = std::min(node.GetChannelsCount(), 4U);
    for (unsigned int channel = 0; channel < count; ++channel)
        if (node.channelValue(channel) != value[static_cast<int>(channel)])
            return false;
    return true;
}

} // namespace

bool isIdle(const FbxAnimCurveNode& node) {
    if (node.IsAnimated() || node.GetDstPropertyCount() != 1 || !isOnBaseLayer(node))
        return false;
    return hasCurves(node) || hasValueOf(node, node.GetDstProperty());
}

} // namespace detail
FBXSDK_NAMESPACE_END
