// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Changing a property together with everything that animates it, for conversions of units and axes.
#pragma once

#include <array>
#include <functional>

#include <fbxsdk/FbxProperty.h>

FBXSDK_NAMESPACE_BEGIN
class FbxAnimLayer;
namespace detail {

/// Component i of the result is sign[i] times component source[i] of the old value.
struct SignedPermutation {
    std::array<int, 3> source{0, 1, 2};
    std::array<double, 3> sign{1, 1, 1};

    [[nodiscard]] bool isIdentity() const;
};

/// Multiplies the property's value, and the channel values and keys of its curve nodes on every layer of every stack
/// for which `applies` holds, by the factor. A curve that also drives something else is copied first.
void scaleAnimated(FbxProperty property, double factor, const std::function<bool(const FbxAnimLayer*)>& applies);
void scaleAnimated(FbxProperty property, double factor);

/// Permutes the components of a vector property, and of its curve nodes on every layer.
void permuteAnimated(FbxProperty property, const SignedPermutation& permutation);

} // namespace detail
FBXSDK_NAMESPACE_END
