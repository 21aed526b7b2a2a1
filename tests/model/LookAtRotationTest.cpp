// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The look-at conversion: closed forms, its effect on its inputs, and a hundred thousand cameras rebuilt from their
// angles.
#include "TnFbxCamera.h"

#include "ModelValues.h"

#include <array>
#include <cmath>
#include <cstddef>
#include <random>

namespace Tarnell::Fbx {
namespace {

using test::kInfinity;
using test::kNaN;
using test::range;
using Floats = std::array<float, 3>;
using Doubles = std::array<double, 3>;

/// One conversion: its angles, and the final values of its inputs.
struct Result {
    Floats angles;
    Floats position, lookAt, up;
};

Result convert(Floats position, Floats lookAt, Floats up, float roll) {
    Floats angles{kNaN, kNaN, kNaN};
    EXPECT_TRUE(TnFbxCamera::calculateCameraRotation(position.data(), lookAt.data(), up.data(), roll, angles[0],
                                                     angles[1], angles[2]));
    return {angles, position, lookAt, up};
}

/// The angles of a camera at the origin that looks along a direction.
Floats anglesAlong(Floats direction, Floats up = {0.0f, 1.0f, 0.0f}, float roll = 0.0f) {
    return convert({0.0f, 0.0f, 0.0f}, direction, up, roll).angles;
}

void expectNear(const Floats& actual, const Floats& expected, float tolerance) {
    for (std::size_t i = 0; i < 3; ++i)
        EXPECT_NEAR(actual[i], expected[i], tolerance) << "component " << i;
}

constexpr float kFewUlps = 2e-5f; // of angles up to 180, in which one unit in the last place is 1.5e-5

TEST(CameraVectors, NormaliseToUnitLength) {
    float x = 3.0f;
    float y = 0.0f;
    float z = -4.0f;

    TnFbxCamera::normalize(x, y, z);

    EXPECT_EQ((Floats{x, y, z}), (Floats{3.0f / 5.0f, 0.0f, -4.0f / 5.0f}));
}

TEST(CameraVectors, NormalisingLeavesAVectorWithoutALengthAsItIs) {
    Floats zero{0.0f, -0.0f, 0.0f};
    TnFbxCamera::normalize(zero[0], zero[1], zero[2]);
    EXPECT_EQ(zero, (Floats{0.0f, 0.0f, 0.0f}));
    EXPECT_TRUE(std::signbit(zero[1]));

    Floats notANumber{1.0f, kNaN, 3.0f};
    TnFbxCamera::normalize(notANumber[0], notANumber[1], notANumber[2]);
    EXPECT_EQ(notANumber[0], 1.0f);
    EXPECT_TRUE(std::isnan(notANumber[1]));
    EXPECT_EQ(notANumber[2], 3.0f);

    Floats tiny{1e-30f, 0.0f, 0.0f}; // its square is below every float
    TnFbxCamera::normalize(tiny[0], tiny[1], tiny[2]);
    EXPECT_EQ(tiny, (Floats{1e-30f, 0.0f, 0.0f}));
}

TEST(CameraVectors, NormalisingDividesByAnInfiniteLength) {
    Floats huge{1e30f, 1.0f, 0.0f}; // its square is beyond every float
    TnFbxCamera::normalize(huge[0], huge[1], huge[2]);
    EXPECT_EQ(huge, (Floats{0.0f, 0.0f, 0.0f}));

    Floats infinite{kInfinity, 1.0f, 0.0f};
    TnFbxCamera::normalize(infinite[0], infinite[1], infinite[2]);
    EXPECT_TRUE(std::isnan(infinite[0]));
    EXPECT_EQ(infinite[1], 0.0f);
}

TEST(CameraVectors, MultiplyCrosswise) {
    Floats c{};

    TnFbxCamera::crossProduct(1.0f, 2.0f, 3.0f, 5.0f, 7.0f, 11.0f, c[0], c[1], c[2]);

    EXPECT_EQ(c, (Floats{2.0f * 11.0f - 3.0f * 7.0f, 3.0f * 5.0f - 1.0f * 11.0f, 1.0f * 7.0f - 2.0f * 5.0f}));
    EXPECT_EQ(c, (Floats{1.0f, 4.0f, -3.0f}));
}

TEST(LookAtRotation, IsZeroLookingDownMinusZ) {
    EXPECT_EQ(anglesAlong({0.0f, 0.0f, -1.0f}), (Floats{0.0f, 0.0f, 0.0f}));
    EXPECT_EQ(anglesAlong({0.0f, 0.0f, -250.0f}), (Floats{0.0f, 0.0f, 0.0f}));
}

TEST(LookAtRotation, TurnsAboutY) {
    EXPECT_EQ(anglesAlong({1.0f, 0.0f, 0.0f})[1], -90.0f);
    EXPECT_EQ(anglesAlong({-1.0f, 0.0f, 0.0f})[1], 90.0f);
    EXPECT_EQ(std::fabs(anglesAlong({0.0f, 0.0f, 1.0f})[1]), 180.0f);
    expectNear(anglesAlong({1.0f, 0.0f, -1.0f}), {0.0f, -45.0f, 0.0f}, kFewUlps);
}

TEST(LookAtRotation, TiltsUpForAForwardThatRises) {
    expectNear(anglesAlong({0.0f, 0.6f, -0.8f}), {36.869898f, 0.0f, 0.0f}, kFewUlps);
    expectNear(anglesAlong({0.0f, -0.6f, -0.8f}), {-36.869898f, 0.0f, 0.0f}, kFewUlps);
}

TEST(LookAtRotation, RollsAgainstTheSignOfTheRollWithAShortPi) {
    const Floats thirty = anglesAlong({0.0f, 0.0f, -1.0f}, {0.0f, 1.0f, 0.0f}, 30.0f);
    EXPECT_EQ(thirty[0], 0.0f);
    EXPECT_EQ(thirty[1], 0.0f);
    EXPECT_NEAR(thirty[2], -30.00007f, 4e-6f); // with the whole π it would be −30.00000

    const Floats ninety = anglesAlong({0.0f, 0.0f, -1.0f}, {0.0f, 1.0f, 0.0f}, 90.0f);
    EXPECT_NEAR(ninety[2], -90.00021f, 1e-5f);

    EXPECT_NEAR(anglesAlong({0.0f, 0.0f, -1.0f}, {0.0f, 1.0f, 0.0f}, -30.0f)[2], 30.00007f, 4e-6f);
}

TEST(LookAtRotation, LooksStraightUpAndDown) {
    EXPECT_EQ(anglesAlong({0.0f, 1.0f, 0.0f}, {0.0f, 0.0f, -1.0f})[0], 90.0f);
    EXPECT_EQ(anglesAlong({0.0f, 1.0f, 0.0f}, {0.0f, 0.0f, -1.0f})[1], 0.0f);
    EXPECT_EQ(anglesAlong({0.0f, -5.0f, 0.0f}, {0.0f, 0.0f, -1.0f})[0], -90.0f);
    EXPECT_EQ(anglesAlong({0.0f, -5.0f, 0.0f}, {0.0f, 0.0f, -1.0f})[1], 0.0f);
}

TEST(LookAtRotation, GivesAllTurningToTheRollAtThePoles) {
    // looking up with the up vector toward +X: the side is F × up = −Z, and atan2(−V.x, S.x) = atan2(−1, 0)
    const Floats up = anglesAlong({0.0f, 1.0f, 0.0f}, {1.0f, 0.0f, 0.0f});
    EXPECT_EQ(up, (Floats{90.0f, 0.0f, -90.0f}));

    // within a hundred-thousandth of vertical counts as vertical, just beyond it does not
    EXPECT_EQ(anglesAlong({0.004f, 1.0f, 0.0f}, {0.0f, 0.0f, -1.0f})[0], 90.0f);
    EXPECT_EQ(anglesAlong({0.004f, 1.0f, 0.0f}, {0.0f, 0.0f, -1.0f})[1], 0.0f);
    EXPECT_LT(anglesAlong({0.005f, 1.0f, 0.0f}, {0.0f, 0.0f, -1.0f})[0], 89.8f);
    EXPECT_EQ(anglesAlong({0.005f, 1.0f, 0.0f}, {0.0f, 0.0f, -1.0f})[1], -90.0f);
}

TEST(LookAtRotation, TurnsByAHalfWhenItLooksAtItsOwnPosition) {
    const Result result = convert({1.0f, 2.0f, 3.0f}, {1.0f, 2.0f, 3.0f}, {0.0f, 1.0f, 0.0f}, 0.0f);

    EXPECT_EQ(result.angles, (Floats{0.0f, -180.0f, 0.0f}));
    EXPECT_EQ(result.lookAt, (Floats{0.0f, 0.0f, 0.0f}));
}

TEST(LookAtRotation, SurvivesAnUpVectorAlongItsDirection) {
    // no side, no up: both stay zero, and the angles are those of the direction
    const Result result = convert({0.0f, 0.0f, 0.0f}, {0.0f, 0.0f, -1.0f}, {0.0f, 0.0f, 2.0f}, 0.0f);

    EXPECT_EQ(result.angles[0], 0.0f);
    EXPECT_EQ(result.angles[1], 0.0f);
    EXPECT_EQ(result.up, (Floats{0.0f, 0.0f, 0.0f}));
}

TEST(LookAtRotation, OverwritesItsInputs) {
    const Result result = convert({1.0f, 2.0f, 3.0f}, {1.0f, 2.0f, -7.0f}, {5.0f, 4.0f, 3.0f}, 0.0f);

    EXPECT_EQ(result.lookAt, (Floats{0.0f, 0.0f, -10.0f})); // not normalised
    EXPECT_EQ(result.position, (Floats{0.0f, 0.0f, 0.0f}));
    const float length = std::sqrt(41.0f);
    expectNear(result.up, {5.0f / length, 4.0f / length, 0.0f}, 1e-6f);
}

TEST(LookAtRotation, LeavesTheRolledUpVectorBehind) {
    const Result result = convert({0.0f, 0.0f, 0.0f}, {0.0f, 0.0f, -1.0f}, {0.0f, 2.0f, 0.5f}, 30.0f);

    expectNear(result.up, {0.5f, 0.8660254f, 0.0f}, 2e-6f); // toward the side, +X
}

TEST(LookAtRotation, RoundsEveryStepToSinglePrecision) {
    const Result result = convert({1.1f, 2.2f, 3.3f}, {-4.4f, 6.6f, -8.8f}, {0.3f, 1.0f, 0.2f}, 33.3f);

    // computed independently of the library, one rounded operation at a time
    EXPECT_EQ(result.lookAt, (Floats{-0x1.6p+2f, 0x1.199998p+2f, -0x1.833334p+3f}));
    EXPECT_EQ(result.up, (Floats{0x1.71bf0cp-1f, 0x1.5fe28ep-1f, -0x1.40ddd8p-4f}));
    // the last bits of an arc tangent are the C library's own
    EXPECT_FLOAT_EQ(result.angles[0], 0x1.251152p+4f);
    EXPECT_FLOAT_EQ(result.angles[1], 0x1.871a72p+4f);
    EXPECT_FLOAT_EQ(result.angles[2], -0x1.5cf1a2p+5f);
}

TEST(LookAtRotation, SurvivesValuesThatAreNotFinite) {
    const Floats result = anglesAlong({kNaN, 0.0f, -1.0f});
    EXPECT_TRUE(std::isnan(result[1]));

    anglesAlong({kInfinity, -kInfinity, 0.0f});
    anglesAlong({3e38f, 3e38f, 3e38f});
    anglesAlong({0.0f, 0.0f, -1.0f}, {kNaN, kNaN, kNaN}, kInfinity);
}

Doubles toDoubles(const Floats& v) { return {v[0], v[1], v[2]}; }

Doubles unit(const Doubles& v) {
    const double length = std::sqrt(v[0] * v[0] + v[1] * v[1] + v[2] * v[2]);
    return {v[0] / length, v[1] / length, v[2] / length};
}

Doubles cross(const Doubles& a, const Doubles& b) {
    return {a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]};
}

/// A vector rotated by Euler angles in degrees: about Z, then about X, then about Y.
Doubles rotated(const Doubles& v, const Floats& degrees) {
    const double radians = 3.14159265358979323846 / 180.0;
    const double sx = std::sin(degrees[0] * radians), cx = std::cos(degrees[0] * radians);
    const double sy = std::sin(degrees[1] * radians), cy = std::cos(degrees[1] * radians);
    const double sz = std::sin(degrees[2] * radians), cz = std::cos(degrees[2] * radians);
    const Doubles z{cz * v[0] - sz * v[1], sz * v[0] + cz * v[1], v[2]};
    const Doubles x{z[0], cx * z[1] - sx * z[2], sx * z[1] + cx * z[2]};
    return {cy * x[0] + sy * x[2], x[1], -sy * x[0] + cy * x[2]};
}

/// The direction's own up vector after the roll, derived apart from the code under test.
Doubles expectedUp(const Doubles& forward, const Floats& up, float roll) {
    const Doubles side = unit(cross(forward, toDoubles(up)));
    const Doubles orthogonal = unit(cross(side, forward));
    const double angle = static_cast<double>(roll) * 3.1416 / 180.0;
    const double s = std::sin(angle), c = std::cos(angle);
    return {c * orthogonal[0] + s * side[0], c * orthogonal[1] + s * side[1], c * orthogonal[2] + s * side[2]};
}

double distance(const Doubles& a, const Doubles& b) {
    return std::hypot(a[0] - b[0], std::hypot(a[1] - b[1], a[2] - b[2]));
}

TEST(LookAtRotation, AHundredThousandCamerasLookWhereTheirAnglesSay) {
    constexpr double kTolerance = 1e-4; // single precision, amplified where the camera looks steeply or up is close
    std::mt19937 random(20240607);
    std::uniform_real_distribution<float> coordinate(-10.0f, 10.0f);
    std::uniform_real_distribution<float> degrees(-360.0f, 360.0f);
    const auto point = [&] { return Floats{coordinate(random), coordinate(random), coordinate(random)}; };
    int checked = 0;

    for (int i = 0; i < 100000; ++i) {
        const Floats position = point(), lookAt = point(), up = point();
        const float roll = degrees(random);
        const Doubles forward =
            unit({static_cast<double>(lookAt[0]) - position[0], static_cast<double>(lookAt[1]) - position[1],
                  static_cast<double>(lookAt[2]) - position[2]});
        const bool steep = std::hypot(forward[0], forward[2]) < 0.1;
        const bool upTooClose = distance(cross(forward, unit(toDoubles(up))), {0.0, 0.0, 0.0}) < 0.1;
        if (steep || upTooClose)
            continue; // there the angles are ill-conditioned; the poles have tests of their own
        ++checked;

        const Result result = convert(position, lookAt, up, roll);

        const Doubles wantedUp = expectedUp(forward, up, roll);
        ASSERT_LT(distance(rotated({0.0, 0.0, -1.0}, result.angles), forward), kTolerance) << "camera " << i;
        ASSERT_LT(distance(rotated({0.0, 1.0, 0.0}, result.angles), wantedUp), kTolerance) << "camera " << i;
        ASSERT_LT(distance(toDoubles(result.up), wantedUp), kTolerance) << "camera " << i;
    }
    EXPECT_GT(checked, 95000);
}

/// A camera with every value that the conversion reads animated over frames 0 to 2.
TnFbxCamera animatedCamera() {
    TnFbxCamera camera;
    camera.setTransformValueAt(TnFbxTransform::kFbxTransformPositionX, range(0, 2), {0.0f, 1.0f, 2.0f});
    camera.setTransformValueAt(TnFbxTransform::kFbxTransformPositionY, range(0, 2), {0.0f, 5.0f, 0.0f});
    camera.setTransformValueAt(TnFbxTransform::kFbxTransformPositionZ, range(0, 2), {0.0f, -1.0f, 3.0f});
    camera.setValueAt(TnFbxCamera::kFbxCameraLookAtPositionX, range(0, 2), {0.0f, 4.0f, 1.0f});
    camera.setValueAt(TnFbxCamera::kFbxCameraLookAtPositionY, range(0, 2), {0.0f, 2.0f, 1.0f});
    camera.setValueAt(TnFbxCamera::kFbxCameraLookAtPositionZ, range(0, 2), {-1.0f, -3.0f, 2.0f});
    camera.setValueAt(TnFbxCamera::kFbxCameraUpPositionX, range(0, 2), {0.0f, 0.5f, 0.0f});
    camera.setValueAt(TnFbxCamera::kFbxCameraUpPositionY, range(0, 2), {1.0f, 2.0f, 1.0f});
    camera.setValueAt(TnFbxCamera::kFbxCameraUpPositionZ, range(0, 2), {0.0f, 0.25f, 0.5f});
    camera.setValueAt(TnFbxCamera::kFbxCameraRoll, range(0, 2), {0.0f, 30.0f, 60.0f});
    return camera;
}

Floats anglesAt(const TnFbxCamera& camera, float frame) {
    Floats angles{kNaN, kNaN, kNaN};
    EXPECT_TRUE(camera.calculateCameraRotationAt(angles[0], angles[1], angles[2], frame));
    return angles;
}

TEST(LookAtRotation, AtAFrameTakesTheCamerasOwnValuesThere) {
    const TnFbxCamera camera = animatedCamera();

    EXPECT_EQ(anglesAt(camera, 0.0f), (Floats{0.0f, 0.0f, 0.0f}));
    EXPECT_EQ(anglesAt(camera, 1.0f),
              convert({1.0f, 5.0f, -1.0f}, {4.0f, 2.0f, -3.0f}, {0.5f, 2.0f, 0.25f}, 30.0f).angles);
    EXPECT_EQ(anglesAt(camera, 1.5f),
              convert({1.5f, 2.5f, 1.0f}, {2.5f, 1.5f, -0.5f}, {0.25f, 1.5f, 0.375f}, 45.0f).angles);
    EXPECT_EQ(anglesAt(camera, 99.0f),
              convert({2.0f, 0.0f, 3.0f}, {1.0f, 1.0f, 2.0f}, {0.0f, 1.0f, 0.5f}, 60.0f).angles);
}

TEST(LookAtRotation, AtAFrameTakesStaticValuesWhereThereAreNoSamples) {
    TnFbxCamera camera;
    camera.setTransformValue(TnFbxTransform::kFbxTransformPositionX, 1.0f);
    camera.setValue(TnFbxCamera::kFbxCameraLookAtPositionX, 2.0f);

    EXPECT_EQ(anglesAt(camera, 5.0f)[1], -90.0f);
    EXPECT_EQ(anglesAt(TnFbxCamera(), 0.0f), (Floats{0.0f, -180.0f, 0.0f}));
}

TEST(LookAtRotation, AtAFrameLeavesTheCameraAsItIs) {
    const TnFbxCamera camera = animatedCamera();

    const Floats first = anglesAt(camera, 1.0f);

    EXPECT_EQ(anglesAt(camera, 1.0f), first);
    EXPECT_EQ(camera.getTransformValueAt(TnFbxTransform::kFbxTransformPositionY, 1.0f), 5.0f);
    EXPECT_EQ(camera.getValueAt(TnFbxCamera::kFbxCameraLookAtPositionX, 1.0f), 4.0f);
    EXPECT_EQ(camera.getValueAt(TnFbxCamera::kFbxCameraUpPositionY, 1.0f), 2.0f);
    EXPECT_FALSE(camera.getTransformAnimated(TnFbxTransform::kFbxTransformRotationX));
}

} // namespace
} // namespace Tarnell::Fbx
