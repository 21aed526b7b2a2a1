// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Transforms: local ones as they are keyed, global ones as they are evaluated, the two ways to decompose a
// rotation, and the rotation orders.
#include "support/MemoryLimitScope.h"
#include "support/SceneBuilders.h"

#include "TnFbxError.h"

#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <limits>
#include <random>

namespace Tarnell::Fbx {
namespace {

using fbxsdk::FbxAMatrix;
using fbxsdk::FbxVector4;
using test::samplesOf;
using test::TestScene;
using Euler = fbxsdk::FbxEuler;
using Samples = std::vector<float>;
using Transform = TnFbxTransform;

constexpr auto kPositionX = Transform::kFbxTransformPositionX;
constexpr auto kRotationX = Transform::kFbxTransformRotationX;
constexpr auto kScaleX = Transform::kFbxTransformScaleX;

constexpr float kDegreesTolerance = 1e-4f; // angles go through single-precision arc tangents

TnFbxTime timeRecord(int startFrame, int endFrame, float rate = 24.0f) {
    TnFbxTime time;
    time.setTime(0.0f, startFrame, endFrame, rate);
    return time;
}

Transform::EFbxTransformChannelType after(Transform::EFbxTransformChannelType channel, int offset) {
    return static_cast<Transform::EFbxTransformChannelType>(static_cast<int>(channel) + offset);
}

void expectStatic(const Transform& transform, Transform::EFbxTransformChannelType first, float x, float y, float z,
                  float tolerance = 0.0f) {
    EXPECT_NEAR(transform.getTransformValue(first), x, tolerance);
    EXPECT_NEAR(transform.getTransformValue(after(first, 1)), y, tolerance);
    EXPECT_NEAR(transform.getTransformValue(after(first, 2)), z, tolerance);
}

Transform readTransform(TestScene& scene, fbxsdk::FbxNode* node, bool global, TnFbxTime time) {
    Transform transform;
    FbxAMatrix geometric;
    EXPECT_TRUE(scene.sdk.getTransform(time, global, false, 0.0f, node, transform, geometric));
    return transform;
}

/// The nine vectors of a node in the world.
struct GlobalValues {
    bool result = false;
    std::array<Samples, 9> values;
};

GlobalValues globalValues(TestScene& scene, fbxsdk::FbxNode* node, TnFbxTime time, FbxAMatrix geometric = {}) {
    GlobalValues all;
    all.values.fill({7.0f, 7.0f}); // to be emptied
    auto& v = all.values;
    all.result = scene.sdk.getGlobalPositionRotationScaleValues(time, node, geometric, v[0], v[1], v[2], v[3], v[4],
                                                                v[5], v[6], v[7], v[8]);
    return all;
}

struct Angles {
    float x, y, z;
};

Angles extract(const FbxAMatrix& matrix) {
    FbxSdk sdk;
    Angles angles{};
    EXPECT_TRUE(sdk.extractMatrixRotation(matrix, angles.x, angles.y, angles.z));
    return angles;
}

FbxAMatrix rotation(double x, double y, double z) {
    FbxAMatrix matrix;
    matrix.SetR(FbxVector4(x, y, z));
    return matrix;
}

// ---- Rotation orders ----

TEST(RotationOrders, MapByTableInBothDirections) {
    struct Pair {
        Euler::EOrder fbx;
        Transform::EFbxTransformRotationOrder library;
    };
    const Pair pairs[] = {
        {Euler::eOrderXYZ, Transform::kFbxRotationOrderXYZ}, {Euler::eOrderXZY, Transform::kFbxRotationOrderXZY},
        {Euler::eOrderYZX, Transform::kFbxRotationOrderYZX}, {Euler::eOrderYXZ, Transform::kFbxRotationOrderYXZ},
        {Euler::eOrderZXY, Transform::kFbxRotationOrderZXY}, {Euler::eOrderZYX, Transform::kFbxRotationOrderZYX},
    };
    FbxSdk sdk;
    for (const Pair& pair : pairs) {
        EXPECT_EQ(sdk.getRotationOrderConstant(pair.fbx), pair.library);
        EXPECT_EQ(sdk.getRotationOrderConstant(pair.library), pair.fbx);
    }
}

TEST(RotationOrders, NumberTheTwoMiddleOnesDifferently) {
    FbxSdk sdk;
    EXPECT_EQ(static_cast<int>(sdk.getRotationOrderConstant(static_cast<Euler::EOrder>(2))), 3);
    EXPECT_EQ(static_cast<int>(sdk.getRotationOrderConstant(static_cast<Euler::EOrder>(3))), 2);
}

TEST(RotationOrders, ReadSphericAsXYZ) {
    FbxSdk sdk;
    EXPECT_EQ(sdk.getRotationOrderConstant(Euler::eOrderSphericXYZ), Transform::kFbxRotationOrderXYZ);
}

TEST(RotationOrders, FallBackToZXYInBothDirections) {
    FbxSdk sdk;
    for (const int number : {7, 99, -1})
        EXPECT_EQ(sdk.getRotationOrderConstant(static_cast<Euler::EOrder>(number)), Transform::kFbxRotationOrderZXY);
    for (const int number : {6, 7, 99, -1}) {
        EXPECT_EQ(sdk.getRotationOrderConstant(static_cast<Transform::EFbxTransformRotationOrder>(number)),
                  Euler::eOrderZXY);
    }
}

// ---- Euler angles from a matrix ----

TEST(ExtractMatrixRotation, GivesTheNegatedSineForX) {
    const Angles angles = extract(rotation(30.0, 0.0, 0.0));

    EXPECT_NEAR(angles.x, 30.0f, kDegreesTolerance);
    EXPECT_EQ(angles.y, 0.0f);
    EXPECT_EQ(angles.z, 0.0f);
}

TEST(ExtractMatrixRotation, TakesYAndZFromTheirRows) {
    EXPECT_NEAR(extract(rotation(0.0, 40.0, 0.0)).y, 40.0f, kDegreesTolerance);
    EXPECT_NEAR(extract(rotation(0.0, 0.0, -50.0)).z, -50.0f, kDegreesTolerance);
}

TEST(ExtractMatrixRotation, GivesAnglesThatApplyInTheOrderZXY) {
    std::mt19937 random(1);
    std::uniform_real_distribution<double> turn(-80.0, 80.0);
    for (int i = 0; i < 1000; ++i) {
        const FbxAMatrix matrix =
            rotation(0.0, turn(random), 0.0) * rotation(turn(random), 0.0, 0.0) * rotation(0.0, 0.0, turn(random));
        const Angles angles = extract(matrix);
        const FbxAMatrix back = rotation(0.0, static_cast<double>(angles.y), 0.0) *
                                rotation(static_cast<double>(angles.x), 0.0, 0.0) *
                                rotation(0.0, 0.0, static_cast<double>(angles.z));
        for (int row = 0; row < 3; ++row)
            for (int column = 0; column < 3; ++column)
                ASSERT_NEAR(back.Get(row, column), matrix.Get(row, column), 1e-5);
    }
}

TEST(ExtractMatrixRotation, TurnsAgainstTheSignAtGimbalLock) {
    // m[2][1] is −1 for a turn of +90 degrees about X and +1 for one of −90
    const Angles up = extract(rotation(90.0, 0.0, 0.0));
    EXPECT_EQ(up.x, 90.0f);
    EXPECT_EQ(up.y, 0.0f);
    EXPECT_NEAR(up.z, 0.0f, kDegreesTolerance);

    const Angles down = extract(rotation(-90.0, 0.0, 0.0));
    EXPECT_EQ(down.x, -90.0f);
    EXPECT_EQ(down.y, 0.0f);
    EXPECT_NEAR(down.z, 0.0f, kDegreesTolerance);
}

TEST(ExtractMatrixRotation, TakesZFromTheFirstTwoRowsAtGimbalLock) {
    FbxAMatrix matrix;
    matrix[0] = fbxsdk::FbxDouble4(0.0, 0.0, 1.0, 0.0);
    matrix[1] = fbxsdk::FbxDouble4(-1.0, 0.0, 0.0, 0.0);
    matrix[2] = fbxsdk::FbxDouble4(0.0, -1.0, 0.0, 0.0);

    const Angles angles = extract(matrix);

    EXPECT_EQ(angles.x, 90.0f);
    EXPECT_EQ(angles.y, 0.0f);
    EXPECT_EQ(angles.z, 90.0f); // atan2(1, 0)
}

TEST(ExtractMatrixRotation, HasAToleranceOfAHundredThousandth) {
    FbxAMatrix matrix;
    matrix[2] = fbxsdk::FbxDouble4(0.6, 0.99999, 0.8, 0.0); // within: gimbal lock, y is 0
    EXPECT_NE(extract(matrix).y, 0.0f) << "1 − 0.99999 is more than the tolerance in single precision";
    matrix[2] = fbxsdk::FbxDouble4(0.6, 0.999995, 0.8, 0.0);
    EXPECT_EQ(extract(matrix).y, 0.0f);
    EXPECT_EQ(extract(matrix).x, -90.0f);
}

TEST(ExtractMatrixRotation, MultipliesByAVanishingLength) {
    FbxAMatrix matrix; // an axis of no length: h is 0 and its own factor
    matrix[0] = fbxsdk::FbxDouble4(1.0, 1.0, 0.0, 0.0);
    matrix[2] = fbxsdk::FbxDouble4(0.0, 0.5, 0.0, 0.0);

    const Angles angles = extract(matrix);

    EXPECT_EQ(angles.x, -90.0f); // atan2(−0.5, 0)
    EXPECT_EQ(angles.y, 0.0f);   // atan2(0, 0)
    EXPECT_EQ(angles.z, 0.0f);   // atan2(1 · 0, 1 · 0), where 1 and 1 alone would give 45
}

TEST(ExtractMatrixRotation, SurvivesNumbersThatAreNone) {
    FbxAMatrix matrix;
    const double nan = std::numeric_limits<double>::quiet_NaN();
    matrix[2] = fbxsdk::FbxDouble4(nan, nan, nan, nan);

    EXPECT_TRUE(std::isnan(extract(matrix).x));
}

// ---- Local transforms ----

TEST(LocalTransform, HoldsNameOrderAndLocalValues) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* parent = scene.addNode("parent");
    parent->LclTranslation.Set({100.0, 0.0, 0.0});
    fbxsdk::FbxNode* node = scene.addNode("node", parent);
    node->LclTranslation.Set({1.0, 2.0, 3.0});
    node->LclRotation.Set({10.0, 20.0, 30.0});
    node->LclScaling.Set({2.0, 3.0, 4.0});
    node->SetRotationOrder(fbxsdk::FbxNode::eSourcePivot, Euler::eOrderYZX);

    const Transform transform = readTransform(scene, node, false, scene.time());

    EXPECT_EQ(transform.getName(), "node");
    EXPECT_EQ(transform.getTransformRotationOrder(), Transform::kFbxRotationOrderYZX);
    expectStatic(transform, kPositionX, 1.0f, 2.0f, 3.0f);
    expectStatic(transform, kRotationX, 10.0f, 20.0f, 30.0f);
    expectStatic(transform, kScaleX, 2.0f, 3.0f, 4.0f);
}

TEST(LocalTransform, SamplesEveryComponentIntoItsChannel) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = scene.addNode("node");
    const char* components[] = {"X", "Y", "Z"};
    for (int i = 0; i < 3; ++i) {
        const auto value = static_cast<float>(i);
        scene.key(node->LclTranslation, components[i], {{0, 10.0f + value}, {1, 20.0f + value}});
        scene.key(node->LclRotation, components[i], {{0, 30.0f + value}, {1, 40.0f + value}});
        scene.key(node->LclScaling, components[i], {{0, 50.0f + value}, {1, 60.0f + value}});
    }

    const Transform transform = readTransform(scene, node, false, scene.time());

    for (int i = 0; i < 3; ++i) {
        const auto value = static_cast<float>(i);
        EXPECT_EQ(samplesOf(transform, after(kPositionX, i)), Samples({10.0f + value, 20.0f + value}));
        EXPECT_EQ(samplesOf(transform, after(kRotationX, i)), Samples({30.0f + value, 40.0f + value}));
        EXPECT_EQ(samplesOf(transform, after(kScaleX, i)), Samples({50.0f + value, 60.0f + value}));
    }
}

TEST(LocalTransform, LeavesSkewAndPivotAlone) {
    TestScene scene(0, 10);
    Transform transform;
    transform.setTransformValue(Transform::kFbxTransformSkewX, 5.0f);
    transform.setTransformValue(Transform::kFbxTransformPivotZ, 6.0f);
    TnFbxTime time = scene.time();
    FbxAMatrix geometric;

    EXPECT_TRUE(scene.sdk.getTransform(time, false, false, 0.0f, scene.addNode("node"), transform, geometric));

    EXPECT_EQ(transform.getTransformValue(Transform::kFbxTransformSkewX), 5.0f);
    EXPECT_EQ(transform.getTransformValue(Transform::kFbxTransformPivotZ), 6.0f);
}

TEST(LocalTransform, IgnoresTheGeometricOffset) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.addNode("node");
    node->SetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot, FbxVector4(5.0, 0.0, 0.0));
    TnFbxReadInfo info = test::readAll(/*global*/ false);
    Transform transform;

    EXPECT_TRUE(scene.sdk.getTransforms(info, &transform, 1));

    expectStatic(transform, kPositionX, 0.0f, 0.0f, 0.0f);
}

TEST(GetTransform, FailsForANullNode) {
    TestScene scene;
    Transform transform;
    transform.setName("as it was");
    TnFbxTime time;
    FbxAMatrix geometric;

    EXPECT_FALSE(scene.sdk.getTransform(time, false, false, 0.0f, nullptr, transform, geometric));

    EXPECT_EQ(transform.getName(), "as it was");
    EXPECT_FALSE(lastError().empty());
}

// ---- Transforms in the world ----

TEST(GlobalTransform, PutsTheParentsTransformFirst) {
    TestScene scene(0, 2);
    fbxsdk::FbxNode* parent = scene.addNode("parent");
    parent->LclTranslation.Set({100.0, 0.0, 0.0});
    parent->LclScaling.Set({2.0, 2.0, 2.0});
    fbxsdk::FbxNode* node = scene.addNode("node", parent);
    node->LclTranslation.Set({1.0, 2.0, 3.0});

    const Transform transform = readTransform(scene, node, true, scene.time());

    EXPECT_EQ(transform.getName(), "node");
    expectStatic(transform, kPositionX, 102.0f, 4.0f, 6.0f);
    expectStatic(transform, kRotationX, 0.0f, 0.0f, 0.0f);
    expectStatic(transform, kScaleX, 2.0f, 2.0f, 2.0f);
    EXPECT_EQ(samplesOf(transform, kPositionX), Samples({102.0f, 102.0f, 102.0f}));
    test::expectRange(transform.getTransformTime(kPositionX), 0, 2, 24.0f);
}

TEST(GlobalTransform, TakesTheFirstFrameForTheStaticValue) {
    TestScene scene(1, 3);
    fbxsdk::FbxNode* node = scene.addNode("node");
    node->LclTranslation.Set({-5.0, 0.0, 0.0});
    scene.key(node->LclTranslation, "X", {{1, 10.0f}, {3, 30.0f}});

    const Transform transform = readTransform(scene, node, true, scene.time());

    EXPECT_EQ(samplesOf(transform, kPositionX), Samples({10.0f, 20.0f, 30.0f}));
    for (int i = 0; i < 9; ++i) {
        const auto channel = after(kPositionX, i);
        EXPECT_EQ(transform.getTransformValue(channel), samplesOf(transform, channel).front());
    }
}

TEST(GlobalTransform, OfASingleFrameIsAnimatedAllTheSame) {
    TestScene scene(5, 5);

    const Transform transform = readTransform(scene, scene.addNode("node"), true, scene.time());

    EXPECT_TRUE(transform.getTransformAnimated(kPositionX));
    test::expectRange(transform.getTransformTime(kPositionX), 5, 5, 24.0f);
}

TEST(GlobalTransform, KeepsTheRotationOrderOfTheObject) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = scene.addNode("node");
    node->SetRotationOrder(fbxsdk::FbxNode::eSourcePivot, Euler::eOrderYZX);

    const Transform transform = readTransform(scene, node, true, scene.time());

    EXPECT_EQ(transform.getTransformRotationOrder(), Transform::kFbxRotationOrderZXY);
}

TEST(GlobalTransform, KeepsItsDefaultsForAnInvertedRange) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.addNode("node");
    node->LclTranslation.Set({1.0, 2.0, 3.0});

    const Transform transform = readTransform(scene, node, true, timeRecord(5, 4));

    EXPECT_EQ(transform.getName(), "node");
    expectStatic(transform, kPositionX, 0.0f, 0.0f, 0.0f);
    expectStatic(transform, kScaleX, 1.0f, 1.0f, 1.0f);
    EXPECT_FALSE(transform.getTransformAnimated(kPositionX));
}

TEST(GlobalTransform, MultipliesByTheGeometricOffsetOnTheRight) {
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.addNode("node");
    node->LclScaling.Set({2.0, 2.0, 2.0});
    node->LclTranslation.Set({1.0, 0.0, 0.0});
    node->SetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot, FbxVector4(5.0, 0.0, 0.0));
    TnFbxReadInfo info = test::readAll(/*global*/ true);
    Transform transform;

    EXPECT_TRUE(scene.sdk.getTransforms(info, &transform, 1));

    expectStatic(transform, kPositionX, 11.0f, 0.0f, 0.0f);
}

TEST(GlobalTransform, DecomposesDifferentlyAtTheOriginAndBesideIt) {
    // Y, then X in the frame of the rotated Y: the two decompositions give other angles for the same rotation.
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.addNode("node");
    node->LclRotation.Set({90.0, 40.0, 0.0});

    const Transform atOrigin = readTransform(scene, node, true, scene.time());
    float x = 0.0f, y = 0.0f, z = 0.0f;
    scene.sdk.extractMatrixRotation(rotation(90.0, 40.0, 0.0), x, y, z);
    expectStatic(atOrigin, kRotationX, x, y, z, kDegreesTolerance);

    for (int axis = 0; axis < 3; ++axis) {
        SCOPED_TRACE(axis);
        fbxsdk::FbxDouble3 step;
        step[axis] = 1e-9;
        node->LclTranslation.Set(step);
        const Transform beside = readTransform(scene, node, true, scene.time());
        expectStatic(beside, kRotationX, 90.0f, 40.0f, 0.0f, kDegreesTolerance);
        EXPECT_NE(atOrigin.getTransformValue(after(kRotationX, 1)), beside.getTransformValue(after(kRotationX, 1)));
    }
}

TEST(GlobalTransform, IsNotAtTheOriginHoweverCloseItIs) {
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.addNode("node");
    node->LclRotation.Set({90.0, 40.0, 0.0});
    for (int axis = 0; axis < 3; ++axis) {
        SCOPED_TRACE(axis);
        fbxsdk::FbxDouble3 step;
        step[axis] = 1e-300; // zero as a float
        node->LclTranslation.Set(step);

        const Transform transform = readTransform(scene, node, true, scene.time());

        expectStatic(transform, kPositionX, 0.0f, 0.0f, 0.0f);
        expectStatic(transform, kRotationX, 90.0f, 40.0f, 0.0f, kDegreesTolerance);
    }
}

TEST(GlobalTransform, DecomposesBesideTheOriginWhatAGeometricTranslationMovesThere) {
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.addNode("node");
    node->LclRotation.Set({90.0, 40.0, 0.0});
    FbxAMatrix geometric;
    geometric.SetT(FbxVector4(0.0, 0.0, 1e-9));

    const GlobalValues atOrigin = globalValues(scene, node, timeRecord(0, 0));
    const GlobalValues moved = globalValues(scene, node, timeRecord(0, 0), geometric);

    EXPECT_NEAR(moved.values[3].at(0), 90.0f, kDegreesTolerance);
    EXPECT_NEAR(moved.values[4].at(0), 40.0f, kDegreesTolerance);
    EXPECT_NEAR(moved.values[5].at(0), 0.0f, kDegreesTolerance);
    EXPECT_GT(std::fabs(atOrigin.values[4].at(0) - moved.values[4].at(0)), 1.0f);
}

TEST(GlobalTransform, DecomposesAtTheOriginWhatAGeometricTranslationMovesThere) {
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.addNode("node");
    node->LclTranslation.Set({5.0, 0.0, 0.0});
    FbxAMatrix geometric;
    geometric.SetTRS(FbxVector4(-5.0, 0.0, 0.0), FbxVector4(90.0, 40.0, 0.0), FbxVector4(1.0, 1.0, 1.0));

    const GlobalValues all = globalValues(scene, node, timeRecord(0, 0), geometric);

    const Angles expected = extract(rotation(90.0, 40.0, 0.0));
    EXPECT_EQ(all.values[0].at(0), 0.0f);
    EXPECT_NEAR(all.values[3].at(0), expected.x, kDegreesTolerance);
    EXPECT_NEAR(all.values[4].at(0), expected.y, kDegreesTolerance);
    EXPECT_NEAR(all.values[5].at(0), expected.z, kDegreesTolerance);
}

TEST(GlobalTransform, TurnsAtTheOriginByNinetyDegreesAboutX) {
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.addNode("node");
    node->LclRotation.Set({90.0, 0.0, 0.0});
    expectStatic(readTransform(scene, node, true, scene.time()), kRotationX, 90.0f, 0.0f, 0.0f, kDegreesTolerance);
    node->LclRotation.Set({-90.0, 0.0, 0.0});
    expectStatic(readTransform(scene, node, true, scene.time()), kRotationX, -90.0f, 0.0f, 0.0f, kDegreesTolerance);
}

TEST(GlobalTransform, TurnsDirectionalAndSpotLightsAndNoOther) {
    struct Row {
        fbxsdk::FbxLight::EType type;
        float x;
    };
    const Row rows[] = {{fbxsdk::FbxLight::ePoint, 0.0f},
                        {fbxsdk::FbxLight::eDirectional, -90.0f},
                        {fbxsdk::FbxLight::eSpot, -90.0f},
                        {fbxsdk::FbxLight::eArea, 0.0f},
                        {fbxsdk::FbxLight::eVolume, 0.0f}};
    for (const Row& row : rows) {
        TestScene scene(0, 0);
        fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxLight>("light");
        node->GetLight()->LightType.Set(row.type);
        for (const double offset : {0.0, 1.0}) { // both decompositions
            node->LclTranslation.Set({offset, 0.0, 0.0});
            expectStatic(readTransform(scene, node, true, scene.time()), kRotationX, row.x, 0.0f, 0.0f,
                         kDegreesTolerance);
        }
    }
}

TEST(GlobalTransform, TurnsALightOnItsOwnSide) {
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxLight>("light");
    node->GetLight()->LightType.Set(fbxsdk::FbxLight::eSpot);
    node->LclRotation.Set({0.0, 0.0, 30.0});
    node->LclTranslation.Set({1.0, 0.0, 0.0});

    const Transform transform = readTransform(scene, node, true, scene.time());

    const FbxVector4 expected = (rotation(0.0, 0.0, 30.0) * rotation(-90.0, 0.0, 0.0)).GetR();
    expectStatic(transform, kRotationX, static_cast<float>(expected[0]), static_cast<float>(expected[1]),
                 static_cast<float>(expected[2]), kDegreesTolerance);
}

TEST(GlobalValues, HoldOneValuePerFrame) {
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.addNode("node");
    scene.key(node->LclTranslation, "Z", {{0, 0.0f}, {10, 10.0f}});

    const GlobalValues all = globalValues(scene, node, timeRecord(-2, 3));

    EXPECT_TRUE(all.result);
    EXPECT_EQ(all.values[2], Samples({0.0f, 0.0f, 0.0f, 1.0f, 2.0f, 3.0f}));
    for (const Samples& samples : all.values)
        EXPECT_EQ(samples.size(), 6u);
}

TEST(GlobalValues, AreTakenAtFrameByRateSeconds) {
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.addNode("node");
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {24, 24.0f}});

    const GlobalValues all = globalValues(scene, node, timeRecord(0, 2, 48.0f));

    EXPECT_EQ(all.values[0], Samples({0.0f, 0.5f, 1.0f}));
}

TEST(GlobalValues, AreEmptiedForAnInvertedRangeAndForANullNode) {
    TestScene scene(0, 0);
    for (const GlobalValues& all : {globalValues(scene, scene.addNode("node"), timeRecord(1, 0)),
                                    globalValues(scene, nullptr, timeRecord(0, 1))}) {
        EXPECT_FALSE(all.result);
        for (const Samples& samples : all.values)
            EXPECT_TRUE(samples.empty());
    }
}

TEST(GlobalValues, AreNoneForARangeOverTheMemoryLimit) {
    const support::MemoryLimitScope limit(1 << 20);
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.addNode("node");
    constexpr int kHighest = std::numeric_limits<int>::max();
    for (const TnFbxTime& time :
         {timeRecord(0, kHighest), timeRecord(-kHighest - 1, kHighest), timeRecord(1, (1 << 18) / 9 + 1)}) {
        const GlobalValues all = globalValues(scene, node, time);
        EXPECT_FALSE(all.result);
        EXPECT_NE(lastError().find("the limit is 1.0 MiB"), std::string::npos) << lastError();
        for (const Samples& samples : all.values)
            EXPECT_TRUE(samples.empty());
    }
    EXPECT_TRUE(globalValues(scene, node, timeRecord(1, (1 << 18) / 9)).result);
}

TEST(GlobalTransform, OfANodeThatNothingAnimatesTakesTheMemoryOfOneFrame) {
    const support::MemoryLimitScope limit(1024);
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.addNode("node");
    node->LclTranslation.Set({4.0, 0.0, 0.0});

    Transform transform = readTransform(scene, node, true, timeRecord(0, std::numeric_limits<int>::max()));

    test::expectRange(transform.getTransformTime(kPositionX), 0, std::numeric_limits<int>::max(), 24.0f);
    EXPECT_TRUE(transform.getTransformChannel(kPositionX)->isConstant());
    EXPECT_EQ(transform.getTransformValue(kPositionX), 4.0f);
    EXPECT_EQ(transform.getTransformValueAt(kPositionX, 1e9f), 4.0f);
}

TEST(GlobalTransform, FailsWhereWhatMovesWouldTakeMoreThanTheLimit) {
    const support::MemoryLimitScope limit(100 * 4 * 2); // two channels over a hundred frames
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.addNode("node");
    scene.key(node->LclTranslation, "X", {{0, 1.0f}, {99, 99.0f}}); // away from the origin, where angles have a sign
    scene.key(node->LclTranslation, "Y", {{0, 1.0f}, {99, 99.0f}});
    EXPECT_TRUE(readTransform(scene, node, true, timeRecord(0, 99)).getTransformAnimated(kPositionX));

    scene.key(node->LclTranslation, "Z", {{0, 1.0f}, {99, 99.0f}});
    TnFbxTime time = timeRecord(0, 99);
    Transform transform;
    fbxsdk::FbxAMatrix geometric;
    EXPECT_FALSE(scene.sdk.getTransform(time, true, false, 0.0f, node, transform, geometric));
    EXPECT_NE(lastError().find("frames 0 to 99 at 24 frames per second"), std::string::npos) << lastError();
    EXPECT_FALSE(transform.getTransformAnimated(after(kPositionX, 2)));
}

TEST(GlobalValues, SurviveARateOfZeroAndOneThatIsNoNumber) {
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.addNode("node");
    scene.key(node->LclTranslation, "X", {{0, 1.0f}, {24, 2.0f}});
    for (const float rate : {0.0f, -24.0f, std::numeric_limits<float>::quiet_NaN()})
        EXPECT_EQ(globalValues(scene, node, timeRecord(0, 2, rate)).values[0].size(), 3u);
}

// ---- Geometric offset and default values ----

TEST(GeometricOffset, IsReadAsThreeVectorsAndAsAMatrix) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.addNode("node");
    node->SetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot, FbxVector4(1.0, 2.0, 3.0));
    node->SetGeometricRotation(fbxsdk::FbxNode::eSourcePivot, FbxVector4(0.0, 0.0, 90.0));
    node->SetGeometricScaling(fbxsdk::FbxNode::eSourcePivot, FbxVector4(2.0, 2.0, 2.0));
    FbxVector4 t, r, s;

    EXPECT_TRUE(scene.sdk.getGeometricTransformation(node, t, r, s));

    EXPECT_EQ(t, FbxVector4(1.0, 2.0, 3.0));
    EXPECT_EQ(r, FbxVector4(0.0, 0.0, 90.0));
    EXPECT_EQ(s, FbxVector4(2.0, 2.0, 2.0));
    EXPECT_EQ(scene.sdk.getGeometry(node), FbxAMatrix(t, r, s));
    EXPECT_TRUE(scene.sdk.getGeometry(nullptr).IsIdentity());
}

TEST(DefaultAnimTransformation, TakesTheDefaultValuesOfTheCurvesThatExist) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.addNode("node");
    scene.key(node->LclTranslation, "Y", {{0, 1.0f}})->SetValue(12.0f);
    scene.key(node->LclScaling, "Z", {})->SetValue(3.0f);
    FbxVector4 t(-1.0, -1.0, -1.0), r(-1.0, -1.0, -1.0), s(-1.0, -1.0, -1.0);

    EXPECT_TRUE(scene.sdk.getDefaultAnimTransformation(node, t, r, s));

    EXPECT_EQ(t, FbxVector4(-1.0, 12.0, -1.0));
    EXPECT_EQ(r, FbxVector4(-1.0, -1.0, -1.0));
    EXPECT_EQ(s, FbxVector4(-1.0, -1.0, 3.0));
    EXPECT_FALSE(scene.sdk.getDefaultAnimTransformation(nullptr, t, r, s));
}

} // namespace
} // namespace Tarnell::Fbx
