// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// NURBS created by hosts, and trimmed surfaces composed of them.
#include <fbxsdk/FbxNurbs.h>
#include <fbxsdk/FbxTrimNurbsSurface.h>

#include "platform/scene/SceneFixture.h"

namespace fbxsdk {
namespace {

using NurbsSurface = SceneFixture;

TEST_F(NurbsSurface, HasRoomForTheKnotsOfItsForms) {
    auto* surface = make<FbxNurbsSurface>();
    surface->SetOrder(4, 3);
    surface->InitControlPoints(6, FbxNurbsSurface::ePeriodic, 5, FbxNurbsSurface::eClosed);
    EXPECT_EQ(surface->GetControlPointsCount(), 30);
    EXPECT_EQ(surface->GetUKnotCount(), 6 + 2 * 4 - 1);
    EXPECT_EQ(surface->GetVKnotCount(), 5 + 3 + 1);
    EXPECT_EQ(surface->GetUKnotVector()[12], 0.0);
    surface->InitControlPoints(6, FbxNurbsSurface::eOpen, 5, FbxNurbsSurface::eOpen);
    EXPECT_EQ(surface->GetUKnotCount(), 10);
}

TEST_F(NurbsSurface, HasNoKnotsForAnOrderAboveItsCount) {
    auto* surface = make<FbxNurbsSurface>();
    surface->SetOrder(4294967295U, 1);
    surface->InitControlPoints(6, FbxNurbsSurface::eOpen, 5, FbxNurbsSurface::eOpen);
    EXPECT_EQ(surface->GetUKnotVector(), nullptr);
    EXPECT_EQ(surface->GetVKnotVector(), nullptr);
}

TEST_F(NurbsSurface, IsEmptyForCountsWithoutSurface) {
    auto* surface = make<FbxNurbsSurface>();
    const int counts[][2] = {{0, 5}, {-6, 5}, {-6, -5}, {2147483647, 2147483647}};
    for (const auto& count : counts) {
        surface->InitControlPoints(count[0], FbxNurbsSurface::eOpen, count[1], FbxNurbsSurface::eOpen);
        EXPECT_EQ(surface->GetControlPointsCount(), 0);
        EXPECT_EQ(surface->GetUCount(), 0);
        EXPECT_EQ(surface->GetVCount(), 0);
    }
}

TEST_F(NurbsSurface, KeepsWhatIsSet) {
    auto* surface = make<FbxNurbs>();
    EXPECT_EQ(surface->GetUStep(), 4);
    EXPECT_EQ(surface->GetUOrder(), 4);
    surface->SetStep(7, 8);
    surface->SetFlipNormals(true);
    surface->SetSurfaceMode(FbxNurbs::eLow);
    EXPECT_EQ(surface->GetUStep(), 7);
    EXPECT_EQ(surface->GetVStep(), 8);
    EXPECT_TRUE(surface->GetFlipNormals());
    EXPECT_EQ(surface->GetSurfaceMode(), FbxNurbs::eLow);
    EXPECT_EQ(surface->GetAttributeType(), FbxNodeAttribute::eNurbs);
    EXPECT_TRUE(surface->Is<FbxGeometry>());
    EXPECT_FALSE(surface->Is<FbxNurbsSurface>());
}

TEST_F(NurbsSurface, CurvesKeepWhatIsSet) {
    auto* curve = make<FbxNurbsCurve>();
    curve->SetOrder(3);
    curve->SetStep(9);
    curve->SetDimension(FbxNurbsCurve::e2D);
    curve->InitControlPoints(5, FbxNurbsCurve::eClosed);
    EXPECT_EQ(curve->GetControlPointsCount(), 5);
    EXPECT_EQ(curve->GetKnotCount(), 9);
    EXPECT_EQ(curve->GetType(), FbxNurbsCurve::eClosed);
    EXPECT_EQ(curve->GetStep(), 9);
    EXPECT_EQ(curve->GetDimension(), FbxNurbsCurve::e2D);
    curve->InitControlPoints(-1, FbxNurbsCurve::eOpen);
    EXPECT_EQ(curve->GetControlPointsCount(), 0);
    EXPECT_EQ(curve->GetKnotVector(), nullptr);
}

TEST_F(NurbsSurface, ATrimmedOneShowsThePointsOfItsSurface) {
    auto* surface = make<FbxNurbsSurface>();
    surface->InitControlPoints(4, FbxNurbsSurface::eOpen, 4, FbxNurbsSurface::eOpen);
    auto* trimmed = make<FbxTrimNurbsSurface>();
    EXPECT_EQ(trimmed->GetControlPointsCount(), 0);
    EXPECT_EQ(trimmed->GetControlPoints(), nullptr);
    EXPECT_EQ(trimmed->GetControlPointAt(0), FbxVector4());
    trimmed->SetNurbsSurface(surface);
    EXPECT_EQ(trimmed->GetControlPointsCount(), 16);
    trimmed->SetControlPointAt(FbxVector4(1, 2, 3, 4), 15);
    EXPECT_EQ(surface->GetControlPointAt(15), FbxVector4(1, 2, 3, 4));
    EXPECT_EQ(trimmed->GetControlPoints(), surface->GetControlPoints());
}

TEST_F(NurbsSurface, ATrimmedOneHasOneSurfaceAtATime) {
    auto* trimmed = make<FbxTrimNurbsSurface>();
    auto* first = make<FbxNurbsSurface>();
    auto* second = make<FbxNurbsSurface>();
    trimmed->SetNurbsSurface(first);
    trimmed->SetNurbsSurface(second);
    EXPECT_EQ(trimmed->GetNurbsSurface(), second);
    EXPECT_EQ(trimmed->GetSrcObjectCount<FbxNurbsSurface>(), 1);
    trimmed->SetNurbsSurface(nullptr);
    EXPECT_EQ(trimmed->GetNurbsSurface(), nullptr);
}

TEST_F(NurbsSurface, ATrimmedOneHasBoundariesOfCurves) {
    auto* trimmed = make<FbxTrimNurbsSurface>();
    auto* boundary = make<FbxBoundary>();
    auto* curve = make<FbxNurbsCurve>();
    EXPECT_TRUE(trimmed->AddBoundary(boundary));
    EXPECT_FALSE(trimmed->AddBoundary(nullptr));
    boundary->AddCurve(curve);
    EXPECT_EQ(trimmed->GetBoundaryCount(), 1);
    EXPECT_EQ(trimmed->GetBoundary(0), boundary);
    EXPECT_EQ(trimmed->GetBoundary(1), nullptr);
    EXPECT_EQ(boundary->GetCurveCount(), 1);
    EXPECT_EQ(boundary->GetCurve(0), curve);
    EXPECT_EQ(boundary->GetCurve(-1), nullptr);
    EXPECT_EQ(boundary->GetAttributeType(), FbxNodeAttribute::eBoundary);
    EXPECT_EQ(trimmed->GetAttributeType(), FbxNodeAttribute::eTrimNurbsSurface);
}

} // namespace
} // namespace fbxsdk
