// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The value of a property at a time, over all layers of a stack.
#pragma once

#include <array>
#include <vector>

#include <fbxsdk/FbxEuler.h>
#include <fbxsdk/FbxProperty.h>

FBXSDK_NAMESPACE_BEGIN
class FbxAnimCurve;
class FbxAnimLayer;
class FbxAnimStack;
namespace detail {

using Components = std::array<double, 4>;

/// How the layers of a property combine, from the property's name.
enum class LayerRule { sum, rotation, scaling };

/// One layer that contributes to a property.
struct LayerContribution {
    FbxAnimLayer* layer = nullptr;
    bool base = false;                        ///< the stack's first layer: it replaces the static value
    std::array<FbxAnimCurve*, 4> curves{};    ///< of the components; null where there is none with keys
    std::array<int, 4> hints{-1, -1, -1, -1}; ///< search hints of the curves
    Components values{};                      ///< of components without a curve
};

/// A property with the layers that animate it, lowest first. Valid until the scene changes.
struct AnimatedProperty {
    FbxProperty property;
    LayerRule rule = LayerRule::sum;
    Components staticValue{};
    std::vector<LayerContribution> contributions;

    [[nodiscard]] bool animated() const { return !contributions.empty(); }
};

/// Looks up the layers of the stack that animate the property; muted layers are omitted, and when any layer of the
/// stack is solo all that are not. A null stack gives the static value.
AnimatedProperty bindAnimation(const FbxProperty& property, FbxAnimStack* stack);

/// How many times are evaluated together at most.
constexpr int kMostTimes = 64;

/// The values at some times, at most kMostTimes. The rotation order matters to layers that compose rotations.
void evaluateAnimation(AnimatedProperty& animation, const FbxTime* times, int count, FbxEuler::EOrder rotationOrder,
                       Components* values);
/// The value at one time.
[[nodiscard]] inline Components evaluateAnimation(AnimatedProperty& animation, const FbxTime& time,
                                                  FbxEuler::EOrder rotationOrder) {
    Components value;
    evaluateAnimation(animation, &time, 1, rotationOrder, &value);
    return value;
}

} // namespace detail
FBXSDK_NAMESPACE_END
