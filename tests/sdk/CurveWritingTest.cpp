// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Keying a curve from a channel, and the transform and null writers.
#include "support/WritingBuilders.h"

#include "TnFbxError.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>

namespace Tarnell::Fbx {
namespace {

using fbxsdk::FbxAnimCurveDef;
using test::keysOf;
using test::timeOf;
using test::valuesOf;
using test::WrittenScene;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;
using Samples = std::vector<float>;
using Transform = TnFbxTransform;

constexpr fbxsdk::FbxLongLong kFrame = fbxsdk::FBXSDK_TC_SECOND / 24;

/// A scene with one animated property's curve to write to.
struct CurveScene : WrittenScene {
    CurveScene() {
        prepareStack();
        node = fbxsdk::FbxNode::Create(scene, "node");
        curve = node->LclTranslation.GetCurve(layer(), node->LclTranslation.GetName(), "X", true);
        EXPECT_NE(curve, nullptr);
    }
    fbxsdk::FbxNode* node;
    fbxsdk::FbxAnimCurve* curve;
};

TEST(CurveKeys, AreNoneForAChannelThatIsNotAnimated) {
    CurveScene scene;
    TnFbxChannel channel;
    channel.setValue(2.5f);

    EXPECT_TRUE(scene.sdk.setCurveValues(scene.curve, &channel, 1.0f));

    EXPECT_EQ(scene.curve->KeyGetCount(), 0);
    EXPECT_EQ(scene.curve->GetValue(), 2.5f);
}

TEST(CurveKeys, AreAtEveryFrameOfTheRangeAndLinear) {
    CurveScene scene;
    TnFbxChannel channel;
    Samples samples;
    for (int frame = 1; frame <= 10; ++frame)
        samples.push_back(static_cast<float>(frame * frame));
    channel.setAnimatedValues(timeOf(1, samples.size()), samples);

    EXPECT_TRUE(scene.sdk.setCurveValues(scene.curve, &channel, 1.0f));

    ASSERT_EQ(scene.curve->KeyGetCount(), 10);
    for (int i = 0; i < 10; ++i) {
        EXPECT_EQ(scene.curve->KeyGetTime(i).Get(), (i + 1) * kFrame);
        EXPECT_EQ(scene.curve->KeyGetValue(i), static_cast<float>((i + 1) * (i + 1)));
        EXPECT_EQ(scene.curve->KeyGetInterpolation(i), FbxAnimCurveDef::eInterpolationLinear);
    }
}

TEST(CurveKeys, ScaleTheSamplesButNotTheDefaultValue) {
    CurveScene scene;
    TnFbxChannel channel;
    channel.setValue(0.75f);
    channel.setAnimatedValues(timeOf(0, 2), {0.5f, 2.0f});

    EXPECT_TRUE(scene.sdk.setCurveValues(scene.curve, &channel, 100.0f));

    EXPECT_THAT(valuesOf(scene.curve), ElementsAre(50.0f, 200.0f));
    EXPECT_EQ(scene.curve->GetValue(), 0.75f);
}

TEST(CurveKeys, AreAtTheFrameDividedByTheRateOfTheChannel) {
    CurveScene scene;
    scene.scene->GetGlobalSettings().SetTimeMode(fbxsdk::FbxTime::eFrames24);
    TnFbxChannel channel;
    channel.setAnimatedValues(timeOf(-1, 3, 48.0f), {1.0f, 2.0f, 3.0f});

    EXPECT_TRUE(scene.sdk.setCurveValues(scene.curve, &channel, 1.0f));

    EXPECT_THAT(keysOf(scene.curve), ElementsAre(Pair(-kFrame / 2, 1.0f), Pair(0, 2.0f), Pair(kFrame / 2, 3.0f)));
}

TEST(CurveKeys, DivideInDoublePrecision) {
    CurveScene scene;
    TnFbxChannel channel;
    const int frame = 100000;
    channel.setAnimatedValues(timeOf(frame, 1, 29.97f), {1.0f});

    EXPECT_TRUE(scene.sdk.setCurveValues(scene.curve, &channel, 1.0f));

    fbxsdk::FbxTime expected;
    expected.SetSecondDouble(frame / static_cast<double>(29.97f));
    EXPECT_EQ(scene.curve->KeyGetTime(0).Get(), expected.Get());
}

TEST(CurveKeys, HaveTheDefaultTangents) {
    CurveScene scene;
    TnFbxChannel channel;
    channel.setAnimatedValues(timeOf(0, 2), {1.0f, 2.0f});

    EXPECT_TRUE(scene.sdk.setCurveValues(scene.curve, &channel, 1.0f));

    EXPECT_EQ(scene.curve->KeyGetTangentMode(0), FbxAnimCurveDef::eTangentAuto);
    EXPECT_EQ(scene.curve->KeyGetData(0, FbxAnimCurveDef::eRightWeight), FbxAnimCurveDef::sDEFAULT_WEIGHT);
    EXPECT_EQ(scene.curve->KeyGetData(0, FbxAnimCurveDef::eNextLeftWeight), FbxAnimCurveDef::sDEFAULT_WEIGHT);
    EXPECT_EQ(scene.curve->KeyGetData(0, FbxAnimCurveDef::eRightVelocity), FbxAnimCurveDef::sDEFAULT_VELOCITY);
}

TEST(CurveKeys, AreAddedToThoseThatThereAre) {
    CurveScene scene;
    TnFbxChannel early, late;
    early.setAnimatedValues(timeOf(0, 2), {1.0f, 2.0f});
    late.setAnimatedValues(timeOf(1, 2), {20.0f, 30.0f});

    EXPECT_TRUE(scene.sdk.setCurveValues(scene.curve, &early, 1.0f));
    EXPECT_TRUE(scene.sdk.setCurveValues(scene.curve, &late, 1.0f));

    EXPECT_THAT(keysOf(scene.curve), ElementsAre(Pair(0, 1.0f), Pair(kFrame, 20.0f), Pair(2 * kFrame, 30.0f)));
}

TEST(CurveKeys, FallTogetherAtZeroForARateThatIsNoNumber) {
    CurveScene scene;
    TnFbxChannel channel;
    channel.setAnimatedValues(timeOf(1, 3, std::numeric_limits<float>::quiet_NaN()), {1.0f, 2.0f, 3.0f});
    ASSERT_TRUE(channel.getAnimated());

    EXPECT_TRUE(scene.sdk.setCurveValues(scene.curve, &channel, 1.0f));

    EXPECT_THAT(keysOf(scene.curve), ElementsAre(Pair(0, 3.0f)));
}

TEST(CurveKeys, ReachTheLastFrameThatThereIs) {
    CurveScene scene;
    TnFbxChannel channel;
    TnFbxTime time;
    constexpr int kLast = std::numeric_limits<int>::max();
    time.setTime(0.0f, kLast - 1, kLast, 24.0f);
    channel.setAnimatedValues(time, {1.0f, 2.0f});

    EXPECT_TRUE(scene.sdk.setCurveValues(scene.curve, &channel, 1.0f));

    ASSERT_EQ(scene.curve->KeyGetCount(), 2);
    fbxsdk::FbxTime last;
    last.SetSecondDouble(kLast / 24.0);
    EXPECT_EQ(scene.curve->KeyGetTime(1).Get(), last.Get());
    EXPECT_EQ(scene.curve->KeyGetValue(1), 2.0f);
}

TEST(CurveKeys, NeedACurveAndAChannel) {
    CurveScene scene;
    TnFbxChannel channel;

    EXPECT_FALSE(scene.sdk.setCurveValues(nullptr, &channel, 1.0f));
    EXPECT_FALSE(scene.sdk.setCurveValues(scene.curve, nullptr, 1.0f));
    EXPECT_FALSE(lastError().empty());
}

// ---- Transforms ----

/// Static values 1 to 9 in the nine channels that are written, 10 to 15 in skew and pivot.
Transform numberedTransform() {
    Transform transform;
    for (int i = Transform::kFbxTransformPositionX; i <= Transform::kFbxTransformPivotZ; ++i)
        transform.setTransformValue(static_cast<Transform::EFbxTransformChannelType>(i), static_cast<float>(i + 1));
    return transform;
}

struct TransformScene : WrittenScene {
    TransformScene() {
        prepareStack();
        node = sdk.createNull(manager, "node");
    }
    fbxsdk::FbxNode* node;
};

template <class Vector>
void expectVector(const Vector& vector, double x, double y, double z) {
    EXPECT_EQ(vector[0], x);
    EXPECT_EQ(vector[1], y);
    EXPECT_EQ(vector[2], z);
}

TEST(TransformWriting, SetsPositionRotationAndScale) {
    TransformScene scene;
    Transform transform = numberedTransform();

    EXPECT_TRUE(scene.sdk.setTransformCurveValues(scene.node, &transform));

    expectVector(scene.node->LclTranslation.Get(), 1.0, 2.0, 3.0);
    expectVector(scene.node->LclRotation.Get(), 4.0, 5.0, 6.0);
    expectVector(scene.node->LclScaling.Get(), 7.0, 8.0, 9.0);
}

TEST(TransformWriting, WritesNeitherSkewNorPivot) {
    TransformScene scene;
    Transform transform = numberedTransform();

    EXPECT_TRUE(scene.sdk.setTransformCurveValues(scene.node, &transform));

    const auto pivot = fbxsdk::FbxNode::eSourcePivot;
    expectVector(scene.node->GetRotationPivot(pivot), 0.0, 0.0, 0.0);
    expectVector(scene.node->GetScalingPivot(pivot), 0.0, 0.0, 0.0);
    expectVector(scene.node->GetRotationOffset(pivot), 0.0, 0.0, 0.0);
    EXPECT_FALSE(scene.node->GetRotationActive());
}

TEST(TransformWriting, KeysEveryComponentFromItsOwnChannel) {
    TransformScene scene;
    Transform transform = numberedTransform();
    const std::pair<Transform::EFbxTransformChannelType, float> animated[] = {
        {Transform::kFbxTransformPositionY, 20.0f},
        {Transform::kFbxTransformRotationZ, 60.0f},
        {Transform::kFbxTransformScaleX, 70.0f},
    };
    for (const auto& [channel, value] : animated)
        transform.setTransformValueAt(channel, timeOf(3, 2), {value, value + 1.0f});

    EXPECT_TRUE(scene.sdk.setTransformCurveValues(scene.node, &transform));

    EXPECT_THAT(keysOf(scene.curve(scene.node->LclTranslation, "Y")),
                ElementsAre(Pair(3 * kFrame, 20.0f), Pair(4 * kFrame, 21.0f)));
    EXPECT_THAT(valuesOf(scene.curve(scene.node->LclRotation, "Z")), ElementsAre(60.0f, 61.0f));
    EXPECT_THAT(valuesOf(scene.curve(scene.node->LclScaling, "X")), ElementsAre(70.0f, 71.0f));
    EXPECT_EQ(scene.node->LclTranslation.Get()[1], 2.0) << "the static value stays";
}

TEST(TransformWriting, KeysEveryComponentAtTheTimesOfItsOwnRange) {
    TransformScene scene;
    Transform transform = numberedTransform();
    const std::pair<Transform::EFbxTransformChannelType, TnFbxTime> animated[] = {
        {Transform::kFbxTransformPositionX, timeOf(0, 2)},        {Transform::kFbxTransformPositionY, timeOf(5, 2)},
        {Transform::kFbxTransformPositionZ, timeOf(5, 2, 48.0f)}, {Transform::kFbxTransformRotationX, timeOf(0, 4)},
        {Transform::kFbxTransformRotationY, timeOf(0, 2)},
    };
    for (const auto& [channel, time] : animated)
        transform.setTransformValueAt(channel, time, {1.0f, 2.0f, 3.0f, 4.0f});

    EXPECT_TRUE(scene.sdk.setTransformCurveValues(scene.node, &transform));

    const auto translation = [&](const char* component) {
        return keysOf(scene.curve(scene.node->LclTranslation, component));
    };
    const auto rotation = [&](const char* component) {
        return keysOf(scene.curve(scene.node->LclRotation, component));
    };
    EXPECT_THAT(translation("X"), ElementsAre(Pair(0, 1.0f), Pair(kFrame, 2.0f)));
    EXPECT_THAT(translation("Y"), ElementsAre(Pair(5 * kFrame, 1.0f), Pair(6 * kFrame, 2.0f)));
    EXPECT_THAT(translation("Z"), ElementsAre(Pair(5 * kFrame / 2, 1.0f), Pair(3 * kFrame, 2.0f)));
    EXPECT_THAT(rotation("X"),
                ElementsAre(Pair(0, 1.0f), Pair(kFrame, 2.0f), Pair(2 * kFrame, 3.0f), Pair(3 * kFrame, 4.0f)));
    EXPECT_THAT(rotation("Y"), ElementsAre(Pair(0, 1.0f), Pair(kFrame, 2.0f)));
}

TEST(TransformWriting, GivesComponentsWithoutSamplesACurveWithoutKeys) {
    TransformScene scene;
    Transform transform = numberedTransform();

    EXPECT_TRUE(scene.sdk.setTransformCurveValues(scene.node, &transform));

    fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3>* properties[] = {&scene.node->LclTranslation, &scene.node->LclRotation,
                                                              &scene.node->LclScaling};
    float expected = 1.0f;
    for (auto* property : properties) {
        for (const char* component : {"X", "Y", "Z"}) {
            fbxsdk::FbxAnimCurve* curve = scene.curve(*property, component);
            ASSERT_NE(curve, nullptr) << component;
            EXPECT_EQ(curve->KeyGetCount(), 0);
            EXPECT_EQ(curve->GetValue(), expected);
            expected += 1.0f;
        }
    }
}

TEST(TransformWriting, WritesStaticValuesWithoutAStack) {
    WrittenScene scene;
    fbxsdk::FbxNode* node = scene.sdk.createNull(scene.manager, "node");
    Transform transform = numberedTransform();
    transform.setTransformValueAt(Transform::kFbxTransformPositionX, timeOf(0, 2), {5.0f, 6.0f});

    EXPECT_TRUE(scene.sdk.setTransformCurveValues(node, &transform));

    expectVector(node->LclTranslation.Get(), 1.0, 2.0, 3.0);
    EXPECT_EQ(scene.scene->GetSrcObjectCount<fbxsdk::FbxAnimCurve>(), 0);
}

fbxsdk::FbxEuler::EOrder orderFor(int order) {
    TransformScene scene;
    Transform transform;
    transform.setTransformRotationOrder(static_cast<Transform::EFbxTransformRotationOrder>(order));
    EXPECT_TRUE(scene.sdk.setTransformCurveValues(scene.node, &transform));
    fbxsdk::FbxEuler::EOrder written = fbxsdk::FbxEuler::eOrderSphericXYZ;
    scene.node->GetRotationOrder(fbxsdk::FbxNode::eSourcePivot, written);
    return written;
}

TEST(TransformWriting, WritesTheRotationOrder) {
    EXPECT_EQ(orderFor(Transform::kFbxRotationOrderXYZ), fbxsdk::FbxEuler::eOrderXYZ);
    EXPECT_EQ(orderFor(Transform::kFbxRotationOrderXZY), fbxsdk::FbxEuler::eOrderXZY);
    EXPECT_EQ(orderFor(Transform::kFbxRotationOrderYXZ), fbxsdk::FbxEuler::eOrderYXZ);
    EXPECT_EQ(orderFor(Transform::kFbxRotationOrderYZX), fbxsdk::FbxEuler::eOrderYZX);
    EXPECT_EQ(orderFor(Transform::kFbxRotationOrderZXY), fbxsdk::FbxEuler::eOrderZXY);
    EXPECT_EQ(orderFor(Transform::kFbxRotationOrderZYX), fbxsdk::FbxEuler::eOrderZYX);
    EXPECT_EQ(orderFor(6), fbxsdk::FbxEuler::eOrderZXY);
    EXPECT_EQ(orderFor(-1), fbxsdk::FbxEuler::eOrderZXY);
}

TEST(TransformWriting, NeedsANodeAndATransform) {
    TransformScene scene;
    Transform transform;

    EXPECT_FALSE(scene.sdk.setTransformCurveValues(nullptr, &transform));
    EXPECT_FALSE(scene.sdk.setTransformCurveValues(scene.node, nullptr));
    EXPECT_FALSE(lastError().empty());
}

// ---- Nulls ----

TEST(NullWriting, SetsLookSizeAndTransform) {
    TransformScene scene;
    TnFbxNull null;
    null.setNullLookType(TnFbxNull::kFbxNullLookNone);
    null.setNullSize(2.5f);
    null.setTransformValue(Transform::kFbxTransformPositionX, 4.0f);

    EXPECT_TRUE(scene.sdk.setNullCurveValues(scene.node, &null));

    EXPECT_EQ(scene.node->GetNull()->Look.Get(), fbxsdk::FbxNull::eNone);
    EXPECT_EQ(scene.node->GetNull()->Size.Get(), 2.5);
    EXPECT_EQ(scene.node->LclTranslation.Get()[0], 4.0);
    EXPECT_EQ(scene.curve(scene.node->GetNull()->Size), nullptr);

    null.setNullLookType(TnFbxNull::kFbxNullLookCross);
    EXPECT_TRUE(scene.sdk.setNullCurveValues(scene.node, &null));
    EXPECT_EQ(scene.node->GetNull()->Look.Get(), fbxsdk::FbxNull::eCross);
}

TEST(NullWriting, KeepsTheLookForWhatIsNoLook) {
    TransformScene scene;
    TnFbxNull null;
    scene.node->GetNull()->Look.Set(fbxsdk::FbxNull::eNone);
    null.setNullLookType(static_cast<TnFbxNull::EFbxNullLookType>(7));

    EXPECT_TRUE(scene.sdk.setNullCurveValues(scene.node, &null));

    EXPECT_EQ(scene.node->GetNull()->Look.Get(), fbxsdk::FbxNull::eNone);
}

TEST(NullWriting, NeedsANodeWithANull) {
    TransformScene scene;
    TnFbxNull null;
    null.setTransformValue(Transform::kFbxTransformPositionX, 4.0f);
    fbxsdk::FbxNode* bare = fbxsdk::FbxNode::Create(scene.scene, "bare");

    EXPECT_FALSE(scene.sdk.setNullCurveValues(nullptr, &null));
    EXPECT_FALSE(scene.sdk.setNullCurveValues(scene.node, nullptr));
    EXPECT_FALSE(scene.sdk.setNullCurveValues(bare, &null));
    EXPECT_FALSE(lastError().empty());
    EXPECT_EQ(bare->LclTranslation.Get()[0], 0.0);
}

} // namespace
} // namespace Tarnell::Fbx
