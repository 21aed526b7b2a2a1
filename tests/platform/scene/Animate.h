// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Helpers for stacks, layers and linear keys.
#pragma once

#include <initializer_list>
#include <utility>

#include <gtest/gtest.h>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxScene.h>

namespace animate {

using namespace fbxsdk;

inline FbxTime seconds(double value) {
    FbxTime time;
    time.SetSecondDouble(value);
    return time;
}

inline FbxAnimLayer* addLayer(FbxAnimStack& stack, const char* name = "layer") {
    FbxAnimLayer* layer = FbxAnimLayer::Create(stack.GetScene(), name);
    stack.AddMember(layer);
    return layer;
}

/// The base layer of a new stack.
inline FbxAnimLayer* addStack(FbxScene& scene, const char* name = "stack") {
    return addLayer(*FbxAnimStack::Create(&scene, name), "base");
}

/// A time in seconds and a value.
using Key = std::pair<double, double>;

/// Linear keys on one component of the property; null for the only one.
inline FbxAnimCurve* keys(FbxProperty property, FbxAnimLayer* layer, const char* component,
                          std::initializer_list<Key> list) {
    FbxAnimCurve* curve = property.GetCurve(layer, component, /*pCreate=*/true);
    if (!curve) {
        ADD_FAILURE() << "no curve for " << property.GetNameAsCStr();
        return nullptr;
    }
    for (const Key& key : list) {
        const FbxTime time = seconds(key.first);
        curve->KeySet(curve->KeyAdd(time), time, static_cast<float>(key.second), FbxAnimCurveDef::eInterpolationLinear);
    }
    return curve;
}

/// A curve node whose three channels have these values, without curves.
inline FbxAnimCurveNode* constants(FbxProperty property, FbxAnimLayer* layer, double x, double y, double z) {
    FbxAnimCurveNode* node = property.GetCurveNode(layer, /*pCreate=*/true);
    if (!node) {
        ADD_FAILURE() << "no curve node for " << property.GetNameAsCStr();
        return nullptr;
    }
    node->SetChannelValue(0, x);
    node->SetChannelValue(1, y);
    node->SetChannelValue(2, z);
    return node;
}

} // namespace animate
