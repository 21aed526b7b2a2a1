// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Scenes built in memory through the platform's API, for the tests of the adapter: a context with an empty scene, and
// helpers for nodes, attributes, keys and meshes.
#pragma once

#include "FbxSdk.h"

#include <fbxsdk.h>
#include <gtest/gtest.h>

#include <initializer_list>
#include <type_traits>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::test {

/// A value at a frame of 24 per second.
using Key = std::pair<int, float>;

inline fbxsdk::FbxTime timeOfFrame(int frame) {
    fbxsdk::FbxTime time;
    time.SetFrame(frame, fbxsdk::FbxTime::eFrames24);
    return time;
}

/// A context whose scene runs at 24 frames per second over a range of frames, in one stack with one layer.
class TestScene {
public:
    explicit TestScene(int firstFrame = 0, int lastFrame = 0) {
        EXPECT_TRUE(sdk.initFbxSdkManager());
        scene = sdk.getScene();
        scene->GetGlobalSettings().SetTimeMode(fbxsdk::FbxTime::eFrames24);
        sdk.initCreateAnimationStack();
        stack = scene->GetSrcObject<fbxsdk::FbxAnimStack>(0);
        layer = stack->GetSrcObject<fbxsdk::FbxAnimLayer>(0);
        setSpan(firstFrame, lastFrame);
    }

    void setSpan(int firstFrame, int lastFrame) {
        const fbxsdk::FbxTimeSpan span(timeOfFrame(firstFrame), timeOfFrame(lastFrame));
        stack->SetLocalTimeSpan(span);
    }

    fbxsdk::FbxAnimLayer* addLayer() {
        fbxsdk::FbxAnimLayer* added = fbxsdk::FbxAnimLayer::Create(scene, "another layer");
        stack->AddMember(added);
        return added;
    }

    /// A node without attribute, under the root or under another node.
    fbxsdk::FbxNode* addNode(const char* name, fbxsdk::FbxNode* parent = nullptr) {
        fbxsdk::FbxNode* node = fbxsdk::FbxNode::Create(scene, name);
        (parent != nullptr ? parent : scene->GetRootNode())->AddChild(node);
        return node;
    }

    /// A node with a new attribute of a class.
    template <class Attribute>
    fbxsdk::FbxNode* add(const char* name, fbxsdk::FbxNode* parent = nullptr) {
        fbxsdk::FbxNode* node = addNode(name, parent);
        node->SetNodeAttribute(Attribute::Create(scene, name));
        return node;
    }

    /// Linear keys on one component of a property (null: a scalar property), which becomes animatable if it is not.
    fbxsdk::FbxAnimCurve* key(fbxsdk::FbxProperty property, const char* component, std::initializer_list<Key> keys,
                              fbxsdk::FbxAnimLayer* on = nullptr) {
        property.ModifyFlag(fbxsdk::FbxPropertyFlags::eAnimatable, true);
        fbxsdk::FbxAnimCurve* curve =
            property.GetCurve(on != nullptr ? on : layer, property.GetName(), component, true);
        EXPECT_NE(curve, nullptr);
        for (const Key& key : keys) {
            const fbxsdk::FbxTime time = timeOfFrame(key.first);
            const int index = curve->KeyAdd(time);
            curve->KeySet(index, time, key.second, fbxsdk::FbxAnimCurveDef::eInterpolationLinear);
        }
        return curve;
    }

    /// The range of the current stack at the scene's own rate.
    TnFbxTime time(float frame = 0.0f) {
        TnFbxTime result;
        EXPECT_TRUE(sdk.getGlobalAnimationStackTime(result, frame, false, 0.0f));
        return result;
    }

    FbxSdk sdk;
    fbxsdk::FbxScene* scene = nullptr;
    fbxsdk::FbxAnimStack* stack = nullptr;
    fbxsdk::FbxAnimLayer* layer = nullptr;
};

/// Options for a read by the context itself, which requires neither file nor stack name.
inline TnFbxReadInfo readAll(bool global = false) {
    TnFbxReadInfo info;
    info.setGlobalTransform(global);
    return info;
}

inline TnFbxReadInfo readNamed(const char* name, bool global = false) {
    TnFbxReadInfo info = readAll(global);
    info.setAllObjects(false);
    info.setObjectName(name);
    return info;
}

/// Control points and polygons.
inline void fillMesh(fbxsdk::FbxMesh& mesh, const std::vector<fbxsdk::FbxVector4>& points,
                     const std::vector<std::vector<int>>& polygons) {
    mesh.InitControlPoints(static_cast<int>(points.size()));
    for (std::size_t i = 0; i < points.size(); ++i)
        mesh.SetControlPointAt(points[i], static_cast<int>(i));
    for (const std::vector<int>& polygon : polygons) {
        mesh.BeginPolygon();
        for (const int index : polygon)
            mesh.AddPolygon(index);
        mesh.EndPolygon();
    }
}

/// One triangle with the corners (0,0,0), (1,0,0), (0,1,0).
inline fbxsdk::FbxNode* addTriangle(TestScene& scene, const char* name) {
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxMesh>(name);
    fillMesh(*node->GetMesh(), {{0.0, 0.0, 0.0}, {1.0, 0.0, 0.0}, {0.0, 1.0, 0.0}}, {{0, 1, 2}});
    return node;
}

/// The values of an object's channel, one of its own or of its transform, over the channel's range.
template <class Object, class Channel>
std::vector<float> samplesOf(const Object& object, Channel channel) {
    constexpr bool ofTransform = std::is_same_v<Channel, TnFbxTransform::EFbxTransformChannelType>;
    std::vector<float> samples;
    if constexpr (ofTransform) {
        const TnFbxTime time = object.getTransformTime(channel);
        for (int f = time.getStartFrame(); object.getTransformAnimated(channel) && f <= time.getEndFrame(); ++f)
            samples.push_back(object.getTransformValueAt(channel, static_cast<float>(f)));
    } else {
        const TnFbxTime time = object.getTime(channel);
        for (int f = time.getStartFrame(); object.getAnimated(channel) && f <= time.getEndFrame(); ++f)
            samples.push_back(object.getValueAt(channel, static_cast<float>(f)));
    }
    return samples;
}

inline void expectRange(const TnFbxTime& time, int startFrame, int endFrame, float frameRate) {
    EXPECT_EQ(time.getStartFrame(), startFrame);
    EXPECT_EQ(time.getEndFrame(), endFrame);
    EXPECT_EQ(time.getFrameRate(), frameRate);
}

} // namespace Tarnell::Fbx::test
