// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The curves of a property, found and created through the curve node that a layer has for it.
#include <algorithm>
#include <array>
#include <cstring>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>
#include <fbxsdk/extensions/PropertySamples.h>

#include "animation/PropertyEvaluation.h"
#include "object/PropertyConversion.h"
#include "object/SceneMembers.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

FbxAnimLayer* firstLayer(const FbxProperty& property) {
    FbxScene* scene = property.IsValid() ? property.GetFbxObject()->GetScene() : nullptr;
    FbxAnimStack* stack = scene ? scene->GetCurrentAnimationStack() : nullptr;
    return stack ? stack->GetMember<FbxAnimLayer>(0) : nullptr;
}

/// Null selects the first channel. Files and hosts name colour channels by component, so X, Y and Z also mean R, G
/// and B where a node has those.
int channelOf(const FbxAnimCurveNode& node, const char* channel) {
    if (!channel)
        return node.GetChannelsCount() > 0 ? 0 : -1;
    const int index = node.GetChannelIndex(channel);
    if (index >= 0)
        return index;
    constexpr const char* kAliases[][2] = {{"X", "R"}, {"Y", "G"}, {"Z", "B"}};
    for (const auto& alias : kAliases)
        if (std::strcmp(channel, alias[0]) == 0)
            return node.GetChannelIndex(alias[1]);
    return -1;
}

/// The order in which layers compose the object's rotations; XYZ for objects that are no nodes.
FbxEuler::EOrder orderInForce(FbxObject& object) {
    FbxEuler::EOrder order = FbxEuler::eOrderXYZ;
    const auto* node = FbxCast<FbxNode>(&object);
    if (node && node->GetRotationActive() && !node->GetRotationSpaceForLimitOnly(FbxNode::eSourcePivot))
        node->GetRotationOrder(FbxNode::eSourcePivot, order);
    return order;
}

} // namespace

FbxAnimCurve* FbxProperty::GetCurve(FbxAnimLayer* pAnimLayer, bool pCreate) {
    return GetCurve(pAnimLayer, nullptr, nullptr, pCreate);
}

FbxAnimCurve* FbxProperty::GetCurve(FbxAnimLayer* pAnimLayer, const char* pChannel, bool pCreate) {
    return GetCurve(pAnimLayer, nullptr, pChannel, pCreate);
}

FbxAnimCurve* FbxProperty::GetCurve(FbxAnimLayer* pAnimLayer, const char* pName, const char* pChannel, bool pCreate) {
    if (!IsValid() || !pAnimLayer)
        return nullptr;
    if (pName && std::strcmp(pName, GetNameAsCStr()) != 0)
        return nullptr;
    FbxAnimCurveNode* node = GetCurveNode(pAnimLayer, pCreate);
    if (!node)
        return nullptr;
    const int channel = channelOf(*node, pChannel);
    if (channel < 0)
        return nullptr;
    FbxAnimCurve* curve = node->GetCurve(static_cast<unsigned int>(channel));
    return curve || !pCreate ? curve : node->CreateCurve("", static_cast<unsigned int>(channel));
}

FbxAnimCurveNode* FbxProperty::GetCurveNode(bool pCreate) { return GetCurveNode(firstLayer(*this), pCreate); }

FbxAnimCurveNode* FbxProperty::GetCurveNode(FbxAnimStack* pAnimStack, bool pCreate) {
    return pAnimStack ? GetCurveNode(pAnimStack->GetMember<FbxAnimLayer>(0), pCreate) : nullptr;
}

FbxAnimCurveNode* FbxProperty::GetCurveNode(FbxAnimLayer* pAnimLayer, bool pCreate) {
    if (!IsValid() || !pAnimLayer)
        return nullptr;
    for (FbxAnimCurveNode* node : detail::sourcesOf<FbxAnimCurveNode>(*this))
        if (node->IsConnectedDstObject(pAnimLayer))
            return node;
    return pCreate ? pAnimLayer->CreateCurveNode(*this) : nullptr;
}

FbxAnimCurveNode* FbxProperty::CreateCurveNode(FbxAnimLayer* pAnimLayer) { return GetCurveNode(pAnimLayer, true); }

bool FbxProperty::IsAnimated(FbxAnimLayer* pAnimLayer) const {
    FbxProperty self = *this;
    const FbxAnimCurveNode* node = self.GetCurveNode(pAnimLayer ? pAnimLayer : firstLayer(*this), false);
    return node && node->IsAnimated();
}

void FbxProperty::evaluate(void* pValue, EFbxType pType, const FbxTime& pTime) {
    readValue(pValue, pType);
    FbxScene* scene = IsValid() ? mObject->GetScene() : nullptr;
    if (!scene || pTime == FBXSDK_TIME_INFINITE)
        return;
    detail::AnimatedProperty animation = detail::bindAnimation(*this, scene->GetCurrentAnimationStack());
    if (!animation.animated())
        return;
    const detail::Components value = detail::evaluateAnimation(animation, pTime, orderInForce(*mObject));
    detail::convertNumbers(value, pValue, pType);
}

void extensions::evaluate(FbxPropertyT<FbxDouble3>& property, const FbxTime* times, int count, FbxDouble3* values) {
    std::fill_n(values, std::max(count, 0), property.Get());
    FbxScene* scene = property.IsValid() ? property.GetFbxObject()->GetScene() : nullptr;
    if (!scene)
        return;
    detail::AnimatedProperty animation = detail::bindAnimation(property, scene->GetCurrentAnimationStack());
    if (!animation.animated())
        return;
    const FbxEuler::EOrder order = orderInForce(*property.GetFbxObject());
    std::array<detail::Components, detail::kMostTimes> evaluated;
    for (int done = 0; done < count; done += detail::kMostTimes) {
        const int size = std::min(detail::kMostTimes, count - done);
        detail::evaluateAnimation(animation, times + done, size, order, evaluated.data());
        for (int i = 0; i < size; ++i)
            if (times[done + i] != FBXSDK_TIME_INFINITE)
                detail::convertNumbers(evaluated[static_cast<std::size_t>(i)], &values[done + i], eFbxDouble3);
    }
}

FBXSDK_NAMESPACE_END
