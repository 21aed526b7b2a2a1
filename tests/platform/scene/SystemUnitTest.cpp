// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Units as values.
#include <gtest/gtest.h>

#include <fbxsdk/FbxSystemUnit.h>

namespace {

using namespace fbxsdk;

TEST(FbxSystemUnitTest, CountsCentimetres) {
    const struct {
        const FbxSystemUnit& unit;
        double centimetres;
    } kUnits[] = {{FbxSystemUnit::mm, 0.1},     {FbxSystemUnit::cm, 1.0},      {FbxSystemUnit::dm, 10.0},
                  {FbxSystemUnit::m, 100.0},    {FbxSystemUnit::km, 100000.0}, {FbxSystemUnit::Inch, 2.54},
                  {FbxSystemUnit::Foot, 30.48}, {FbxSystemUnit::Yard, 91.44},  {FbxSystemUnit::Mile, 160934.4}};
    for (const auto& row : kUnits) {
        EXPECT_EQ(row.unit.GetScaleFactor(), row.centimetres);
        EXPECT_EQ(row.unit.GetMultiplier(), 1.0);
    }
}

TEST(FbxSystemUnitTest, IsCentimetresByDefault) {
    EXPECT_EQ(FbxSystemUnit(), FbxSystemUnit::cm);
    EXPECT_EQ(FbxSystemUnit().GetMultiplier(), 1.0);
}

TEST(FbxSystemUnitTest, ConvertsByTheQuotientOfTheScales) {
    EXPECT_EQ(FbxSystemUnit::m.GetConversionFactorTo(FbxSystemUnit::cm), 100.0);
    EXPECT_EQ(FbxSystemUnit::cm.GetConversionFactorTo(FbxSystemUnit::m), 0.01);
    EXPECT_EQ(FbxSystemUnit::cm.GetConversionFactorFrom(FbxSystemUnit::m), 100.0);
    EXPECT_DOUBLE_EQ(FbxSystemUnit::Foot.GetConversionFactorTo(FbxSystemUnit::Inch), 12.0);
    EXPECT_EQ(FbxSystemUnit(2.5).GetConversionFactorTo(FbxSystemUnit(2.5)), 1.0);
}

TEST(FbxSystemUnitTest, LeavesTheMultiplierOutOfConversions) {
    const FbxSystemUnit odd(1.0, 10.0);

    EXPECT_EQ(odd.GetMultiplier(), 10.0);
    EXPECT_EQ(odd.GetConversionFactorTo(FbxSystemUnit::cm), 1.0);
    EXPECT_NE(odd, FbxSystemUnit::cm);
}

TEST(FbxSystemUnitTest, ConvertsEverythingByDefault) {
    const FbxSystemUnit::ConversionOptions& options = FbxSystemUnit::DefaultConversionOptions;

    EXPECT_TRUE(options.mConvertRrsNodes);
    EXPECT_TRUE(options.mConvertLimits);
    EXPECT_TRUE(options.mConvertClusters);
    EXPECT_TRUE(options.mConvertLightIntensity);
    EXPECT_TRUE(options.mConvertPhotometricLProperties);
    EXPECT_TRUE(options.mConvertCameraClipPlanes);
}

} // namespace
