// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Blocks, names and precision of Wavefront files.
#include "WavefrontFile.h"

#include "../support/TemporaryFolder.h"

#include <gmock/gmock.h>

using namespace conformance;
using testing::DoubleEq;
using testing::ElementsAre;

namespace {

WavefrontFile parsed(const std::string& content) {
    const support::TemporaryFolder folder;
    return readWavefront(folder.write("scene.obj", content));
}

} // namespace

TEST(WavefrontFile, NamesABlockByTheGroupOfItsFirstFace) {
    const WavefrontFile file = parsed("g default\nv 1 2 3\nv 4 5 6\ng Cube Top\nf 1 2\nv 7 8 9\nf 3\n");

    ASSERT_EQ(file.blocks.size(), 2u);
    EXPECT_THAT(file.blocks[0].points, ElementsAre(Point{1, 2, 3}, Point{4, 5, 6}));
    EXPECT_THAT(file.blocks[0].names, ElementsAre("Cube", "Top"));
    EXPECT_THAT(file.blocks[1].points, ElementsAre(Point{7, 8, 9}));
}

TEST(WavefrontFile, TellsWhenPointsAreInAnotherOrder) {
    EXPECT_FALSE(parsed("# Blender v2.93.1 OBJ File: ''\n").inOtherOrder);
    EXPECT_TRUE(parsed("# 3ds Max Wavefront OBJ Exporter v0.99\n").inOtherOrder);
    EXPECT_TRUE(parsed("# bad_order\n").inOtherOrder);
}

TEST(WavefrontFile, ToleratesAUnitOfTheLastDigit) {
    EXPECT_THAT(parsed("v 1.2500 2.0000 3.0000\n").tolerance, DoubleEq(0.0001));
    EXPECT_THAT(parsed("# tolerance=0.01\nv 1.2500 2.0000 3.0000\n").tolerance, DoubleEq(0.01));
}

TEST(WavefrontFile, DecodesEscapedCharactersOfNames) {
    EXPECT_EQ(decodedName("FBXASC0500FBXASC032Sided"), "20 Sided");
    EXPECT_EQ(decodedName("FBXASC0"), "FBXASC0");
    EXPECT_EQ(decodedName("FBXASCabc"), "FBXASCabc");
}
