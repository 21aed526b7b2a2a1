// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A scene with one stack, its base layer and one node, and helpers for keys.
#pragma once

#include <initializer_list>
#include <utility>

#include <gtest/gtest.h>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxManager.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>

class AnimationFixture : public testing::Test {
protected:
    AnimationFixture()
        : manager(fbxsdk::FbxManager::Create()), scene(fbxsdk::FbxScene::Create(manager, "scene")),
          stack(fbxsdk::FbxAnimStack::Create(scene, "stack")), layer(addLayer()),
          node(fbxsdk::FbxNode::Create(scene, "node")) {
        scene->GetRootNode()->AddChild(node);
    }
    ~AnimationFixture() override { manager->Destroy(); }

    fbxsdk::FbxAnimLayer* addLayer() {
        fbxsdk::FbxAnimLayer* added = fbxsdk::FbxAnimLayer::Create(scene, "layer");
        stack->AddMember(added);
        return added;
    }

    static fbxsdk::FbxTime seconds(double value) {
        fbxsdk::FbxTime time;
        time.SetSecondDouble(value);
        return time;
    }

    /// Seconds and values; the keys are linear.
    using Keys = std::initializer_list<std::pair<double, double>>;

    static void addKeys(fbxsdk::FbxAnimCurve* curve, Keys keys) {
        for (const auto& [second, value] : keys) {
            curve->KeySet(curve->KeyAdd(seconds(second)), seconds(second), static_cast<float>(value),
                          fbxsdk::FbxAnimCurveDef::eInterpolationLinear);
        }
    }

    /// A curve node whose channels have these values.
    static fbxsdk::FbxAnimCurveNode* set(fbxsdk::FbxProperty property, fbxsdk::FbxAnimLayer* on, double x, double y = 0,
                                         double z = 0) {
        fbxsdk::FbxAnimCurveNode* made = property.GetCurveNode(on, /*pCreate=*/true);
        const double values[] = {x, y, z};
        for (unsigned int i = 0; made && i < made->GetChannelsCount() && i < 3; ++i)
            made->SetChannelValue(i, values[i]);
        return made;
    }

    fbxsdk::FbxManager* manager;
    fbxsdk::FbxScene* scene;
    fbxsdk::FbxAnimStack* stack;
    fbxsdk::FbxAnimLayer* layer; ///< the base layer
    fbxsdk::FbxNode* node;
};
