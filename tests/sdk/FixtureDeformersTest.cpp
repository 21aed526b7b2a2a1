// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deformed meshes of hand-written files: skins, shapes and point caches.
#include "FixtureFiles.h"

namespace Tarnell::Fbx {
namespace {

using test::FacadeRead;
using test::fixture;
using test::isNear;
using test::pointsOf;
using test::readAtFrame;
using test::Samples;

/// The points of a mesh at a frame.
Samples pointsAt(const char* file, const char* mesh, float frame) {
    FacadeRead<TnFbxMesh> meshes(readAtFrame(file, frame));
    return pointsOf(meshes[mesh]);
}

// ---- Skins ----

class SkinOfEachGeneration : public testing::TestWithParam<const char*> {};

INSTANTIATE_TEST_SUITE_P(Files, SkinOfEachGeneration,
                         testing::Values("skin_5800_ascii.fbx", "skin_6100_ascii.fbx", "skin_7400_ascii.fbx"));

// The lower bone is at (0,1,0), where it was bound. The upper one was bound at (0,2,0) and rotates by 90° about Z: it
// maps (x,y) to (2 − y, 2 + x). In the world the points were at
//     (0,1) on the lower bone alone,
//     (0,3) on the upper one alone, which moves it to (−1,2),
//     (1,2) on both equally: the middle between it and (0,3),
//     (0,4) with a quarter and three quarters: ¼ (0,4) + ¾ (−2,2).
TEST_P(SkinOfEachGeneration, GivesThePointsInTheWorldWhereTheBonesTakeThem) {
    EXPECT_THAT(pointsAt(GetParam(), "body", 0.0f), isNear({0, 1, 0, -1, 2, 0, 0.5f, 2.5f, 0, -1.5f, 2.5f, 0}));
}

TEST_P(SkinOfEachGeneration, LeavesTheNodeWhereItIs) {
    FacadeRead<TnFbxMesh> meshes(fixture(GetParam()));

    EXPECT_EQ(test::positionOf(meshes["body"]), Samples({5, 0, 0}));
}

// The point (0,4,0) follows two bones. The lower one has moved by (1,0,0). The upper one was bound at (0,2,0), is
// at (1,2,0) and has rotated by 90° about Z: it maps (x,y) to (1 − (y − 2), 2 + x).
//
// Additive, each has half the weight and moves the result of the one before: the lower to (½,4); the upper maps that
// to (−1,2½), and half of the way there is (−¼,3¼).
// Of total one: ¼ (1,4) + ½ (−1,2) and the missing quarter of (0,4).
TEST(LinkModesFixture, AddUpOrFillUpWithThePointItself) {
    EXPECT_THAT(pointsAt("link_modes_7400_ascii.fbx", "additive", 0.0f), isNear({-0.25f, 3.25f, 0, 0, 0, 0, 1, 0, 0}));
    EXPECT_THAT(pointsAt("link_modes_7400_ascii.fbx", "total one", 0.0f), isNear({-0.25f, 3, 0, 0, 0, 0, 1, 0, 0}));
}

// ---- Shapes. The weight is 25 times the frame ----

// kept: the weight multiplies the whole difference; below the first full weight each of the two targets gives the first
// one, above it the second one alone, and at a full weight there is none
TEST(BlendShapeFixture, GoesThroughItsInBetweenTarget) {
    const Samples base = {0, 0, 0, 1, 0, 0, 0, 1, 0};
    const auto at = [](float frame) { return pointsAt("blend_shape_7400_ascii.fbx", "face", frame); };

    EXPECT_EQ(at(0.0f), base);
    EXPECT_THAT(at(1.0f), isNear({0, 0, 0, 1, 0, 2.0f * 25.0f * 0.04f, 0, 1, 0}));
    EXPECT_EQ(at(2.0f), base);
    EXPECT_THAT(at(3.0f), isNear({0, 0, 0, 1, 75.0f * 0.04f, 0, 75.0f * 0.08f, 1, 0}));
    EXPECT_EQ(at(4.0f), base);
}

TEST(BlendShapeFixture, MovesByAShapeWithinItsMesh) {
    for (const char* file : {"blend_shape_6100_ascii.fbx", "blend_shape_7100_ascii.fbx"}) {
        EXPECT_EQ(pointsAt(file, "face", 0.0f), Samples({0, 0, 0, 1, 0, 0, 0, 1, 0})) << file;
        EXPECT_THAT(pointsAt(file, "face", 1.0f), isNear({0, 0, 0, 1, 25.0f * 0.04f, 0, 25.0f * 0.08f, 1, 0})) << file;
        EXPECT_THAT(pointsAt(file, "face", 3.0f), isNear({0, 0, 0, 1, 75.0f * 0.04f, 0, 75.0f * 0.08f, 1, 0})) << file;
    }
}

// ---- Caches. At frame f, the points 0, 1 and 2 are at (p, f², number of the cache) ----

Samples wave(float height, float cache) { return {0, height, cache, 1, height, cache, 2, height, cache}; }

TEST(CachesFixture, OfMayaAreReadAtTheFrame) {
    for (const float frame : {0.0f, 1.0f, 2.0f}) {
        EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "wide", frame), isNear(wave(frame * frame, 1))) << frame;
        EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "files", frame), isNear(wave(frame * frame, 3))) << frame;
    }
}

TEST(CachesFixture, OfMayaAreInterpolatedBetweenTheirSamples) {
    EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "wide", 1.5f), isNear(wave((1.0f + 4.0f) / 2.0f, 1)));
    EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "files", 1.5f), isNear(wave((1.0f + 4.0f) / 2.0f, 3)));
    EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "narrow", 1.0f), isNear(wave((0.0f + 4.0f) / 2.0f, 2)));
    EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "narrow", 3.0f), isNear(wave((4.0f + 16.0f) / 2.0f, 2)));
}

TEST(CachesFixture, OfMayaHoldTheirLastSample) {
    EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "wide", 5.0f), isNear(wave(4, 1)));
    EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "narrow", 5.0f), isNear(wave(16, 2)));
    EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "files", 5.0f), isNear(wave(4, 3)));
}

TEST(CachesFixture, OfMaxBeginAtTheirStartFrameAndAreReadByWholeFrames) {
    EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "max", 0.0f), isNear(wave(1, 4))); // it begins at frame 1
    EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "max", 2.0f), isNear(wave(4, 4)));
    EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "max", 2.5f), isNear(wave(4, 4)));
    EXPECT_THAT(pointsAt("caches_7400_ascii.fbx", "max", 3.0f), isNear(wave(9, 4)));
}

TEST(CachesFixture, ThatAreNotThereLeaveThePointsAsTheyAre) {
    EXPECT_EQ(pointsAt("caches_7400_ascii.fbx", "lost", 1.0f), Samples({0, 0, 9, 1, 0, 9, 2, 0, 9}));
}

// kept: the range is in seconds; caches of Maya are used where nothing else is animated
TEST(CachesFixture, OfMayaGiveTheRangeOfTheFile) {
    float start = -1.0f, end = -1.0f;
    ASSERT_TRUE(Fbx().getAnimationFrameRange(fixture("caches_7400_ascii.fbx").c_str(), start, end)) << lastError();

    EXPECT_EQ(start, 0.0f);
    EXPECT_EQ(end, 4.0f / 24.0f);
}

} // namespace
} // namespace Tarnell::Fbx
