// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How animation layers combine. The base layer replaces the property's static value; each further layer adds to the
// value so far, or overrides it, by its weight. Rotations compose and scales multiply by default.
#include "animation/PropertyEvaluation.h"

#include <algorithm>
#include <cmath>
#include <string_view>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/extensions/CurveSamples.h>

#include "core/Rotation.h"
#include "object/SceneMembers.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

LayerRule ruleOf(std::string_view propertyName) {
    if (propertyName == "Lcl Rotation")
        return LayerRule::rotation;
    if (propertyName == "Lcl Scaling")
        return LayerRule::scaling;
    return LayerRule::sum;
}

LayerContribution contributionOf(FbxAnimLayer& layer, const FbxAnimCurveNode& curveNode, bool base) {
    LayerContribution contribution;
    contribution.layer = &layer;
    contribution.base = base;
    const unsigned int count = std::min(curveNode.GetChannelsCount(), 4U);
    for (unsigned int i = 0; i < count; ++i) {
        FbxAnimCurve* curve = curveNode.GetCurve(i);
        contribution.curves[i] = curve && curve->KeyGetCount() > 0 ? curve : nullptr;
        contribution.values[i] = curveNode.channelValue(i);
    }
    return contribution;
}

/// The layer's values for each component: those of its curve, or the channel's where it has none.
void layerValues(LayerContribution& contribution, const FbxTime* times, int count, Components* values) {
    std::fill_n(values, count, contribution.values);
    for (std::size_t i = 0; i < contribution.curves.size(); ++i) {
        FbxAnimCurve* curve = contribution.curves[i];
        if (!curve)
            continue;
        std::array<float, kMostTimes> samples;
        if (count == 1)
            samples[0] = curve->Evaluate(*times, &contribution.hints[i]);
        else
            extensions::evaluate(*curve, times, count, samples.data());
        for (int j = 0; j < count; ++j)
            values[j][i] = static_cast<double>(samples[static_cast<std::size_t>(j)]);
    }
}

double weightOf(FbxAnimLayer& layer, const FbxTime& time) {
    double percent = layer.Weight.Get();
    // An animated weight is a curve node on the layer's own property.
    if (const FbxAnimCurveNode* curveNode = layer.Weight.GetSrcObject<FbxAnimCurveNode>()) {
        FbxAnimCurve* curve = curveNode->GetCurve(0);
        if (curve && curve->KeyGetCount() > 0)
            percent = static_cast<double>(curve->Evaluate(time));
    }
    const double weight = percent / 100.0;
    return weight > 0.0 ? std::min(weight, 1.0) : 0.0; // NaN counts as 0
}

/// A factor of partial weight: 1 at weight 0, the factor itself at weight 1, keeping its sign in between.
double weightedFactor(double factor, double weight) {
    if (weight >= 1.0)
        return factor;
    if (weight <= 0.0)
        return 1.0;
    return std::copysign(std::pow(std::abs(factor), weight), factor);
}

Components eulerOf(const FbxQuaternion& rotation, FbxEuler::EOrder order) {
    const FbxVector4 angles = eulerFromQuaternion(rotation, order);
    return {angles[0], angles[1], angles[2], 0.0};
}

FbxQuaternion quaternionOf(const Components& degrees, FbxEuler::EOrder order) {
    return quaternionFromEuler(FbxVector4(degrees[0], degrees[1], degrees[2]), order);
}

Components addLayer(const Components& below, const Components& layer, double weight, LayerRule rule,
                    const FbxAnimLayer& settings, FbxEuler::EOrder order) {
    if (rule == LayerRule::rotation && settings.RotationAccumulationMode.Get() == FbxAnimLayer::eRotationByLayer) {
        const FbxQuaternion turn = slerp(FbxQuaternion(), quaternionOf(layer, order), weight);
        return eulerOf(quaternionOf(below, order) * turn, order);
    }
    Components sum = below;
    const bool multiplies =
        rule == LayerRule::scaling && settings.ScaleAccumulationMode.Get() == FbxAnimLayer::eScaleMultiply;
    for (std::size_t i = 0; i < sum.size(); ++i)
        if (multiplies)
            sum[i] *= weightedFactor(layer[i], weight);
        else
            sum[i] += weight * layer[i];
    return sum;
}

Components overrideLayer(const Components& below, const Components& layer, double weight, LayerRule rule,
                         const FbxAnimLayer& settings, FbxEuler::EOrder order) {
    if (rule == LayerRule::rotation && settings.RotationAccumulationMode.Get() == FbxAnimLayer::eRotationByLayer)
        return eulerOf(slerp(quaternionOf(below, order), quaternionOf(layer, order), weight), order);
    Components mix{};
    const bool multiplies =
        rule == LayerRule::scaling && settings.ScaleAccumulationMode.Get() == FbxAnimLayer::eScaleMultiply;
    for (std::size_t i = 0; i < mix.size(); ++i) {
        mix[i] = multiplies ? weightedFactor(below[i], 1.0 - weight) * weightedFactor(layer[i], weight)
                            : (1.0 - weight) * below[i] + weight * layer[i];
    }
    return mix;
}

Components combine(const Components& below, const Components& layer, const FbxAnimLayer& settings, double weight,
                   const AnimatedProperty& animation, FbxEuler::EOrder order) {
    const EFbxType type = animation.property.GetPropertyDataType().GetType();
    const bool discrete = type == eFbxBool || type == eFbxEnum || settings.GetBlendModeBypass(type);
    if (discrete)
        return layer;
    switch (settings.BlendMode.Get()) {
    case FbxAnimLayer::eBlendOverride:
        return layer;
    case FbxAnimLayer::eBlendOverridePassthrough:
        return weight >= 1.0 ? layer : overrideLayer(below, layer, weight, animation.rule, settings, order);
    default:
        return addLayer(below, layer, weight, animation.rule, settings, order);
    }
}

} // namespace

AnimatedProperty bindAnimation(const FbxProperty& property, FbxAnimStack* stack) {
    AnimatedProperty animation;
    animation.property = property;
    const FbxDouble4 value = property.Get<FbxDouble4>();
    animation.staticValue = {value[0], value[1], value[2], value[3]};
    if (!stack || property.GetSrcObjectCount() == 0)
        return animation;

    animation.rule = ruleOf(property.GetNameAsCStr());
    const std::vector<FbxAnimLayer*> layers = sourcesOf<FbxAnimLayer>(*stack);
    const std::vector<FbxAnimCurveNode*> curveNodes = sourcesOf<FbxAnimCurveNode>(property);
    const bool soloOnly = std::any_of(layers.begin(), layers.end(), [](auto* layer) { return layer->Solo.Get(); });
    for (FbxAnimLayer* layer : layers) {
        if (layer->Mute.Get() || (soloOnly && !layer->Solo.Get()))
            continue;
        const auto node = std::find_if(curveNodes.begin(), curveNodes.end(),
                                       [&](auto* each) { return each->IsConnectedDstObject(layer); });
        if (node != curveNodes.end())
            animation.contributions.push_back(contributionOf(*layer, **node, layer == layers.front()));
    }
    return animation;
}

void evaluateAnimation(AnimatedProperty& animation, const FbxTime* times, int count, FbxEuler::EOrder rotationOrder,
                       Components* values) {
    std::fill_n(values, count, animation.staticValue);
    for (LayerContribution& contribution : animation.contributions) {
        if (contribution.base) {
            layerValues(contribution, times, count, values);
            continue;
        }
        std::array<Components, kMostTimes> layer;
        layerValues(contribution, times, count, layer.data());
        for (int i = 0; i < count; ++i) {
            values[i] = combine(values[i], layer[static_cast<std::size_t>(i)], *contribution.layer,
                                weightOf(*contribution.layer, times[i]), animation, rotationOrder);
        }
    }
}

} // namespace detail
FBXSDK_NAMESPACE_END
