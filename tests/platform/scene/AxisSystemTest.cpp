// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Axis systems as values: every combination that a file can state, and invalid ones.
#include <algorithm>
#include <array>
#include <climits>
#include <vector>

#include <gtest/gtest.h>

#include <fbxsdk/FbxAxisSystem.h>

namespace {

using namespace fbxsdk;
using Axes = FbxAxisSystem::Axes;

std::array<int, 6> integersOf(const Axes& axes) {
    return {axes.up, axes.upSign, axes.front, axes.frontSign, axes.coord, axes.coordSign};
}

FbxAxisSystem systemOf(const std::array<int, 6>& file) {
    return FbxAxisSystem::fromAxes(file[0], file[1], file[2], file[3], file[4], file[5]);
}

/// The six integers of all 48 systems.
std::vector<std::array<int, 6>> everySystem() {
    std::vector<std::array<int, 6>> all;
    for (int up = 0; up < 3; ++up)
        for (int front = 0; front < 3; ++front)
            for (int signs = 0; up != front && signs < 8; ++signs)
                all.push_back({up, signs & 1 ? 1 : -1, front, signs & 2 ? 1 : -1, 3 - up - front, signs & 4 ? 1 : -1});
    return all;
}

TEST(FbxAxisSystemTest, GivesBackTheIntegersItWasMadeOf) {
    const auto all = everySystem();
    ASSERT_EQ(all.size(), 48U);

    for (const auto& file : all)
        EXPECT_EQ(integersOf(systemOf(file).axes()), file);
}

TEST(FbxAxisSystemTest, DiffersForEveryCombination) {
    const auto all = everySystem();
    for (const auto& a : all)
        for (const auto& b : all)
            EXPECT_EQ(systemOf(a) == systemOf(b), a == b);
}

TEST(FbxAxisSystemTest, IsRightHandedWhereUpTimesFrontIsTheThirdAxis) {
    int rightHanded = 0;
    for (const auto& file : everySystem()) {
        int up[3] = {}, front[3] = {}, coord[3] = {};
        up[file[0]] = file[1];
        front[file[2]] = file[3];
        coord[file[4]] = file[5];
        const int cross[3] = {up[1] * front[2] - up[2] * front[1], up[2] * front[0] - up[0] * front[2],
                              up[0] * front[1] - up[1] * front[0]};
        const bool expected = std::equal(cross, cross + 3, coord);
        EXPECT_EQ(systemOf(file).GetCoorSystem() == FbxAxisSystem::eRightHanded, expected);
        rightHanded += expected;
    }
    EXPECT_EQ(rightHanded, 24);
}

TEST(FbxAxisSystemTest, CallsTheFirstOfTheTwoRemainingAxesEven) {
    const struct {
        int up, front;
        FbxAxisSystem::EFrontVector parity;
    } kRows[] = {{0, 1, FbxAxisSystem::eParityEven}, {0, 2, FbxAxisSystem::eParityOdd},
                 {1, 0, FbxAxisSystem::eParityEven}, {1, 2, FbxAxisSystem::eParityOdd},
                 {2, 0, FbxAxisSystem::eParityEven}, {2, 1, FbxAxisSystem::eParityOdd}};
    for (const auto& row : kRows) {
        int upSign = 0, frontSign = 0;
        const FbxAxisSystem system = FbxAxisSystem::fromAxes(row.up, -1, row.front, 1, 3 - row.up - row.front, 1);
        EXPECT_EQ(system.GetUpVector(upSign), row.up + 1);
        EXPECT_EQ(system.GetFrontVector(frontSign), row.parity);
        EXPECT_EQ(upSign, -1);
        EXPECT_EQ(frontSign, 1);
    }
}

TEST(FbxAxisSystemTest, HasTheSystemsOfKnownTools) {
    const FbxAxisSystem yUp(FbxAxisSystem::eYAxis, FbxAxisSystem::eParityOdd, FbxAxisSystem::eRightHanded);
    const auto minusOdd = static_cast<FbxAxisSystem::EFrontVector>(-FbxAxisSystem::eParityOdd);
    const FbxAxisSystem zUp(FbxAxisSystem::eZAxis, minusOdd, FbxAxisSystem::eRightHanded);
    const FbxAxisSystem left(FbxAxisSystem::eYAxis, FbxAxisSystem::eParityOdd, FbxAxisSystem::eLeftHanded);

    EXPECT_EQ(FbxAxisSystem::MayaYUp, yUp);
    EXPECT_EQ(FbxAxisSystem::Motionbuilder, yUp);
    EXPECT_EQ(FbxAxisSystem::OpenGL, yUp);
    EXPECT_EQ(FbxAxisSystem::MayaZUp, zUp);
    EXPECT_EQ(FbxAxisSystem::Max, zUp);
    EXPECT_EQ(FbxAxisSystem::DirectX, left);
    EXPECT_EQ(FbxAxisSystem::Lightwave, left);
    EXPECT_EQ(FbxAxisSystem(), yUp);
    EXPECT_NE(yUp, zUp);
    EXPECT_NE(yUp, left);
}

TEST(FbxAxisSystemTest, ReadsWhatKnownToolsWrite) {
    EXPECT_EQ(systemOf({1, 1, 2, 1, 0, 1}), FbxAxisSystem::MayaYUp);
    EXPECT_EQ(systemOf({2, 1, 1, -1, 0, 1}), FbxAxisSystem::MayaZUp);
    EXPECT_EQ(systemOf({1, 1, 2, 1, 0, -1}), FbxAxisSystem::DirectX);
}

TEST(FbxAxisSystemTest, TakesWhatIsNoSystemForTheDefault) {
    const std::array<int, 6> kWrong[] = {
        {1, 1, 1, 1, 0, 1}, {1, 1, 2, 1, 2, 1}, {3, 1, 2, 1, 0, 1},       {-1, 1, 2, 1, 0, 1},
        {1, 1, 2, 1, 7, 1}, {0, 0, 0, 0, 0, 0}, {INT_MAX, 1, 2, 1, 0, 1}, {INT_MIN, 1, INT_MIN, 1, 0, 1}};
    for (const auto& file : kWrong)
        EXPECT_EQ(systemOf(file), FbxAxisSystem());
    const auto none = static_cast<FbxAxisSystem::EUpVector>(0);
    const auto far = static_cast<FbxAxisSystem::EFrontVector>(3);
    EXPECT_EQ(FbxAxisSystem(none, FbxAxisSystem::eParityOdd, FbxAxisSystem::eRightHanded), FbxAxisSystem());
    EXPECT_EQ(FbxAxisSystem(FbxAxisSystem::eXAxis, far, FbxAxisSystem::eRightHanded), FbxAxisSystem());
}

TEST(FbxAxisSystemTest, TakesAnyNegativeNumberForAMinus) {
    EXPECT_EQ(systemOf({1, INT_MIN, 2, 17, 0, 1}), systemOf({1, -1, 2, 1, 0, 1}));
    EXPECT_EQ(systemOf({1, 0, 2, 0, 0, 0}), systemOf({1, 1, 2, 1, 0, 1}));
}

} // namespace
