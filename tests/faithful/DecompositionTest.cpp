// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Matrices decomposed and recomposed.
#include "faithful/Decomposition.h"
#include "faithful/Timeline.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>

namespace Tarnell::Fbx::faithful {
namespace {

constexpr RotationOrder kOrders[] = {TnFbxTransform::kFbxRotationOrderXYZ, TnFbxTransform::kFbxRotationOrderXZY,
                                     TnFbxTransform::kFbxRotationOrderYXZ, TnFbxTransform::kFbxRotationOrderYZX,
                                     TnFbxTransform::kFbxRotationOrderZXY, TnFbxTransform::kFbxRotationOrderZYX};

fbxsdk::FbxAMatrix composed(const Parts& parts) {
    fbxsdk::FbxAMatrix shear;
    shear[1][0] = parts.skew[0];
    shear[2][0] = parts.skew[1];
    shear[2][1] = parts.skew[2];
    fbxsdk::FbxAMatrix matrix = parts.rotation * shear;
    for (int axis = 0; axis < 3; ++axis) {
        for (int component = 0; component < 3; ++component)
            matrix[axis][component] *= parts.scale[static_cast<std::size_t>(axis)];
        matrix[3][axis] = parts.position[static_cast<std::size_t>(axis)];
    }
    return matrix;
}

void expectSame(const fbxsdk::FbxAMatrix& actual, const fbxsdk::FbxAMatrix& expected) {
    for (int row = 0; row < 4; ++row)
        for (int column = 0; column < 3; ++column)
            EXPECT_NEAR(actual.Get(row, column), expected.Get(row, column), 1e-9) << row << ' ' << column;
}

TEST(Decomposition, GivesPartsThatMakeAnyMatrixAgain) {
    std::mt19937 random(1);
    std::uniform_real_distribution<double> number(-5.0, 5.0);
    for (int i = 0; i < 1000; ++i) {
        fbxsdk::FbxAMatrix matrix;
        for (int row = 0; row < 4; ++row)
            for (int column = 0; column < 3; ++column)
                matrix[row][column] = number(random);
        const Parts parts = decompose(matrix, {1.0, number(random), 1.0});
        expectSame(composed(parts), matrix);
        EXPECT_EQ(handedness(parts.rotation), 1.0);
    }
}

TEST(Decomposition, TakesTheSignsOfTheScaleThatItIsGiven) {
    fbxsdk::FbxAMatrix mirrored;
    mirrored.SetTRS({1.0, 2.0, 3.0}, {10.0, 20.0, 30.0}, {1.0, 1.0, 1.0});
    for (int component = 0; component < 3; ++component)
        mirrored[1][component] *= -2.0;
    const Parts parts = decompose(mirrored, {1.0, -1.0, 1.0});
    EXPECT_NEAR(parts.scale[0], 1.0, 1e-12);
    EXPECT_NEAR(parts.scale[1], -2.0, 1e-12);
    const Vector angles = anglesNear(parts.rotation, TnFbxTransform::kFbxRotationOrderXYZ, {});
    EXPECT_NEAR(angles[0], 10.0, 1e-9);
    EXPECT_NEAR(angles[1], 20.0, 1e-9);
    EXPECT_NEAR(angles[2], 30.0, 1e-9);
}

TEST(Decomposition, ScalesXTheOtherWayWhereTheSignsDoNotMirror) {
    fbxsdk::FbxAMatrix mirrored;
    mirrored[2][2] = -1.0;
    const Parts parts = decompose(mirrored, {1.0, 1.0, 1.0});
    EXPECT_EQ(parts.scale[0], -1.0);
    expectSame(composed(parts), mirrored);
}

TEST(Decomposition, TakesAFlatAxisPerpendicularToTheOthers) {
    fbxsdk::FbxAMatrix flat;
    flat.SetR({0.0, 0.0, 90.0});
    for (int component = 0; component < 3; ++component)
        flat[1][component] = 0.0;
    const Parts parts = decompose(flat, {1.0, 1.0, 1.0});
    EXPECT_EQ(parts.scale[1], 0.0);
    EXPECT_NEAR(anglesNear(parts.rotation, TnFbxTransform::kFbxRotationOrderXYZ, {})[2], 90.0, 1e-9);
    const Parts nothing = decompose(fbxsdk::FbxAMatrix() * 0.0, {1.0, 1.0, 1.0});
    expectSame(nothing.rotation, fbxsdk::FbxAMatrix());
}

TEST(Angles, TurnLikeTheRotationInEveryOrder) {
    std::mt19937 random(2);
    std::uniform_real_distribution<double> angle(-720.0, 720.0);
    for (const RotationOrder order : kOrders) {
        for (int i = 0; i < 500; ++i) {
            const Vector angles = {angle(random), angle(random), angle(random)};
            const fbxsdk::FbxAMatrix rotation = rotationOf(angles, order);
            const Vector found = anglesNear(rotation, order, angles);
            for (std::size_t axis = 0; axis < 3; ++axis)
                EXPECT_NEAR(found[axis], angles[axis], 1e-6) << order;
        }
    }
}

TEST(Angles, GoOnThroughGimbalLockWithoutAFlip) {
    for (const RotationOrder order : kOrders) {
        Vector before = {10.0, 20.0, 30.0};
        const std::size_t middle =
            order == TnFbxTransform::kFbxRotationOrderXYZ || order == TnFbxTransform::kFbxRotationOrderZYX   ? 1
            : order == TnFbxTransform::kFbxRotationOrderXZY || order == TnFbxTransform::kFbxRotationOrderYZX ? 2
                                                                                                             : 0;
        before[middle] = 80.0;
        Vector given = before;
        for (int frame = 0; frame < 20; ++frame, given[middle] += 1.0) { // through 90 degrees, where frame 10 is
            const Vector now = anglesNear(rotationOf(given, order), order, before);
            for (std::size_t axis = 0; axis < 3; ++axis)
                EXPECT_NEAR(now[axis], given[axis], 1e-4) << order << " at " << frame;
            before = now;
        }
    }
}

TEST(Normals, StayPerpendicularToWhatIsStretchedAndOutsideOfWhatIsMirrored) {
    fbxsdk::FbxAMatrix matrix;
    matrix[0][0] = -2.0;
    const double half = std::sqrt(0.5);
    const fbxsdk::FbxVector4 normal = transformedNormal(matrix, {half, half, 0.0});
    EXPECT_NEAR(normal[0], -0.5 / std::sqrt(1.25), 1e-12);
    EXPECT_NEAR(normal[1], 1.0 / std::sqrt(1.25), 1e-12);
}

TEST(Timeline, CoversTheSpanByWholeFramesAtAnExactRate) {
    constexpr double rate = 30000.0 / 1001.0;
    fbxsdk::FbxTime start, stop;
    start.SetSecondDouble(10.0 / rate);
    stop.SetSecondDouble(20.5 / rate);
    const Timeline timeline(rate, fbxsdk::FbxTimeSpan(start, stop));
    EXPECT_EQ(timeline.first(), 10);
    EXPECT_EQ(timeline.last(), 21);
    EXPECT_NEAR(timeline.at(15.0).GetSecondDouble(), 15.0 * 1001.0 / 30000.0, 1e-9);
    EXPECT_EQ(timeline.record(0.0f).getFrameRate(), static_cast<float>(rate));
}

TEST(Timeline, HoldsFramesThatNoChannelCouldNumber) {
    const Timeline timeline(1e9, fbxsdk::FbxTimeSpan(fbxsdk::FBXSDK_TIME_MINUS_INFINITE, fbxsdk::FBXSDK_TIME_INFINITE));
    EXPECT_EQ(timeline.first(), std::numeric_limits<int>::min());
    EXPECT_EQ(timeline.last(), std::numeric_limits<int>::max());
}

} // namespace
} // namespace Tarnell::Fbx::faithful
