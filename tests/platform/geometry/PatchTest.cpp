// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Patches from records and from hosts.
#include <fbxsdk/FbxPatch.h>

#include "NurbsSamples.h"
#include "geometry/GeometryReading.h"
#include "platform/scene/SceneFixture.h"

namespace fbxsdk::detail {
namespace {

class Patch : public SceneFixture {
protected:
    FbxPatch* read(const std::string& text) {
        auto* patch = make<FbxPatch>();
        readPatch(*patch, RecordsOf(text));
        return patch;
    }
    static void expectNoGeometry(const FbxPatch& patch) {
        EXPECT_EQ(patch.GetControlPointsCount(), 0);
        EXPECT_EQ(patch.GetUCount(), 0);
        EXPECT_EQ(patch.GetVCount(), 0);
    }
};

TEST_F(Patch, IsReadWithTypesFlagsAndPoints) {
    const FbxPatch& patch = *read(R"(
        PatchType: "BSpline","Linear"
        Dimensions: 3,2
        Step: 2,9
        Closed: 1,0
        UCapped: 0,1
        VCapped: 1,0
        Points: *18 { a: 0,1,2,3,4,5,6,7,8,9,10,11,12,13,14,15,16,17 })");
    EXPECT_EQ(patch.GetAttributeType(), FbxNodeAttribute::ePatch);
    EXPECT_EQ(patch.GetPatchUType(), FbxPatch::eBSpline);
    EXPECT_EQ(patch.GetPatchVType(), FbxPatch::eLinear);
    EXPECT_EQ(patch.GetUCount(), 3);
    EXPECT_EQ(patch.GetVCount(), 2);
    EXPECT_EQ(patch.GetUStep(), 2);
    EXPECT_EQ(patch.GetVStep(), 9);
    EXPECT_TRUE(patch.GetUClosed());
    EXPECT_FALSE(patch.GetVClosed());
    EXPECT_FALSE(patch.GetUCappedBottom());
    EXPECT_TRUE(patch.GetUCappedTop());
    EXPECT_TRUE(patch.GetVCappedBottom());
    EXPECT_FALSE(patch.GetVCappedTop());
    ASSERT_EQ(patch.GetControlPointsCount(), 6);
    EXPECT_EQ(patch.GetControlPointAt(5), FbxVector4(15, 16, 17, 1));
}

TEST_F(Patch, TakesTypesByNumberToo) {
    const FbxPatch& patch = *read("PatchType: 2,1\nDimensions: 1,1\nPoints: *3 { a: 1,2,3 }");
    EXPECT_EQ(patch.GetPatchUType(), FbxPatch::eCardinal);
    EXPECT_EQ(patch.GetPatchVType(), FbxPatch::eBezierQuadric);
}

TEST_F(Patch, IsBezierWithFourStepsWhereTheFileSaysNothing) {
    const FbxPatch& patch = *read("PatchType: \"Round\",99\nDimensions: 1,1\nPoints: *3 { a: 1,2,3 }");
    EXPECT_EQ(patch.GetPatchUType(), FbxPatch::eBezier);
    EXPECT_EQ(patch.GetPatchVType(), FbxPatch::eBezier);
    EXPECT_EQ(patch.GetUStep(), 4);
    EXPECT_FALSE(patch.GetUClosed());
}

TEST_F(Patch, TakesPointsOfFourNumbers) {
    const FbxPatch& patch = *read("Dimensions: 1,2\nPoints: *8 { a: 1,2,3,4,5,6,7,8 }");
    ASSERT_EQ(patch.GetControlPointsCount(), 2);
    EXPECT_EQ(patch.GetControlPointAt(1), FbxVector4(5, 6, 7, 8));
}

TEST_F(Patch, HasNoGeometryWhenCountsDoNotFit) {
    const std::string points = "Points: *12 { a: 0,1,2,3,4,5,6,7,8,9,10,11 }\n";
    expectNoGeometry(*read(points));
    expectNoGeometry(*read(""));
    for (const char* dimensions : {"2,3", "5,1", "0,4", "-2,-2", "4", "4294967298,2", "536870912,536870912"})
        expectNoGeometry(*read(points + "Dimensions: " + dimensions));
    expectNoGeometry(*read("Dimensions: 2,2"));
}

TEST_F(Patch, KeepsWhatIsSet) {
    auto* patch = make<FbxPatch>();
    patch->InitControlPoints(4, FbxPatch::eBezier, 5, FbxPatch::eCardinal);
    patch->SetStep(3, 2);
    patch->SetClosed(false, true);
    patch->SetUCapped(true, false);
    patch->SetVCapped(false, true);
    EXPECT_EQ(patch->GetControlPointsCount(), 20);
    EXPECT_EQ(patch->GetPatchVType(), FbxPatch::eCardinal);
    EXPECT_EQ(patch->GetUStep(), 3);
    EXPECT_TRUE(patch->GetVClosed());
    EXPECT_TRUE(patch->GetUCappedBottom());
    EXPECT_TRUE(patch->GetVCappedTop());
    patch->InitControlPoints(2147483647, FbxPatch::eBezier, 5, FbxPatch::eBezier);
    expectNoGeometry(*patch);
}

} // namespace
} // namespace fbxsdk::detail
