// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Points, normals and weights of surfaces that are known in closed form.
#include "geometry/tessellation/TessellationGrid.h"

#include <limits>

#include <fbxsdk/FbxMesh.h>

#include "platform/geometry/NurbsSamples.h"
#include "platform/scene/SceneFixture.h"

namespace fbxsdk::detail {
namespace {

class TessellationGridOf : public SceneFixture {
protected:
    template <class Surface>
    std::unique_ptr<TessellationGrid> gridOf(const Surface& surface) {
        return TessellationGrid::of(surface, 0);
    }
    static FbxVector4 normalAt(const TessellationGrid& grid, int u, int v) {
        return grid.normals()[static_cast<std::size_t>(grid.sampleOf(u, v))];
    }
    static FbxVector4 pointAt(const TessellationGrid& grid, int u, int v) {
        return grid.points()[static_cast<std::size_t>(grid.pointOf(u, v))];
    }
};

TEST_F(TessellationGridOf, ACylinderIsRoundWithOutwardNormals) {
    auto* surface = make<FbxNurbsSurface>();
    makeCylinder(*surface);
    surface->SetStep(5, 3);
    const auto grid = gridOf(*surface);
    ASSERT_TRUE(grid);
    EXPECT_EQ(grid->u().sampleCount(), 21);
    EXPECT_EQ(grid->v().sampleCount(), 4);
    for (int v = 0; v < 4; ++v) {
        for (int u = 0; u < 21; ++u) {
            const FbxVector4 point = pointAt(*grid, u, v);
            EXPECT_NEAR(std::hypot(point[0], point[1]), 1.0, 1e-12);
            EXPECT_NEAR(point[2], 2.0 * v / 3.0, 1e-12);
            EXPECT_EQ(point[3], 1.0);
            expectNear(normalAt(*grid, u, v), FbxVector4(point[0], point[1], 0.0), 1e-9);
        }
    }
}

TEST_F(TessellationGridOf, ASphereIsRoundWithOutwardNormalsAtThePolesToo) {
    auto* surface = make<FbxNurbs>();
    makeSphere(*surface);
    const auto grid = gridOf(*surface);
    ASSERT_TRUE(grid);
    for (int v = 0; v < grid->v().sampleCount(); ++v) {
        for (int u = 0; u < grid->u().sampleCount(); ++u) {
            const FbxVector4 point = pointAt(*grid, u, v);
            EXPECT_NEAR(point.Length(), 1.0, 1e-12);
            expectNear(normalAt(*grid, u, v), point, 1e-9);
        }
    }
    expectNear(normalAt(*grid, 3, 0), FbxVector4(0, 0, -1), 1e-9);
    expectNear(normalAt(*grid, 3, grid->v().sampleCount() - 1), FbxVector4(0, 0, 1), 1e-9);
}

TEST_F(TessellationGridOf, AClampedCircleKeepsBothEndsOfItsSeam) {
    auto* surface = make<FbxNurbsSurface>();
    makeCylinder(*surface);
    surface->SetStep(2, 1);
    const auto grid = gridOf(*surface);
    ASSERT_TRUE(grid);
    // Its last control point is a separate point that happens to coincide with the first.
    EXPECT_FALSE(grid->u().joined);
    EXPECT_EQ(grid->pointCount(), 9 * 2);
}

TEST_F(TessellationGridOf, APeriodicDirectionSharesThePointsOfItsSeam) {
    auto* surface = make<FbxNurbsSurface>();
    surface->SetOrder(4, 2);
    surface->InitControlPoints(6, FbxNurbsSurface::ePeriodic, 2, FbxNurbsSurface::eOpen);
    ASSERT_EQ(surface->GetUKnotCount(), 13);
    for (int i = 0; i < 13; ++i)
        surface->GetUKnotVector()[i] = i - 3;
    std::copy_n(std::vector<double>{0, 0, 1, 1}.data(), 4, surface->GetVKnotVector());
    for (int i = 0; i < 12; ++i)
        surface->SetControlPointAt(
            FbxVector4(std::cos(1.0471975511965976 * i), std::sin(1.0471975511965976 * i), i / 6), i);
    surface->SetStep(4, 1);
    const auto grid = gridOf(*surface);
    ASSERT_TRUE(grid);
    EXPECT_EQ(grid->u().sampleCount(), 25);
    EXPECT_EQ(grid->pointCount(), 24 * 2);
    EXPECT_EQ(grid->pointOf(24, 1), grid->pointOf(0, 1));
    // The blend at a knot of adjacent points at 60 degrees: (1 + 4 + 1) / 6 with cosines 1/2, 1, 1/2.
    expectNear(pointAt(*grid, 0, 0), FbxVector4(5.0 / 6.0 * 0.5, 5.0 / 6.0 * std::sqrt(0.75), 0.0), 1e-12);
    expectNear(normalAt(*grid, 0, 0), normalAt(*grid, 24, 0), 1e-12);
}

TEST_F(TessellationGridOf, ABilinearPatchFollowsItsFormula) {
    auto* patch = make<FbxPatch>();
    makeBilinear(*patch);
    patch->SetStep(4, 2);
    const auto grid = gridOf(*patch);
    ASSERT_TRUE(grid);
    ASSERT_EQ(grid->pointCount(), 15);
    for (int j = 0; j <= 2; ++j) {
        for (int i = 0; i <= 4; ++i) {
            const double u = i / 4.0, v = j / 2.0;
            expectNear(pointAt(*grid, i, j), FbxVector4(u, v, u + 2 * v + 2 * u * v));
            FbxVector4 normal(-(1 + 2 * v), -(2 + 2 * u), 1);
            normal.Normalize();
            expectNear(normalAt(*grid, i, j), normal);
        }
    }
}

TEST_F(TessellationGridOf, ABezierPatchReachesItsCorners) {
    auto* patch = make<FbxPatch>();
    patch->InitControlPoints(4, FbxPatch::eBezier, 4, FbxPatch::eBezier);
    setHeights(*patch, [](int u, int v) { return u == 0 || u == 3 || v == 0 || v == 3 ? 0.0 : 9.0; });
    patch->SetStep(2, 2);
    const auto grid = gridOf(*patch);
    ASSERT_TRUE(grid);
    expectNear(pointAt(*grid, 0, 0), FbxVector4(0, 0, 0));
    expectNear(pointAt(*grid, 2, 0), FbxVector4(3, 0, 0));
    expectNear(pointAt(*grid, 0, 2), FbxVector4(0, 3, 0));
    expectNear(pointAt(*grid, 2, 2), FbxVector4(3, 3, 0));
    expectNear(pointAt(*grid, 1, 1), FbxVector4(1.5, 1.5, 9.0 * 0.75 * 0.75));
}

TEST_F(TessellationGridOf, APatchIgnoresTheWeightsOfItsPoints) {
    auto* patch = make<FbxPatch>();
    makeBilinear(*patch);
    patch->SetControlPointAt(FbxVector4(0, 0, 0, 17), 0);
    patch->SetStep(2, 2);
    const auto grid = gridOf(*patch);
    ASSERT_TRUE(grid);
    expectNear(pointAt(*grid, 1, 1), FbxVector4(0.5, 0.5, 2.0));
}

TEST_F(TessellationGridOf, FlippedNormalsPointToTheOtherSide) {
    auto* surface = make<FbxNurbsSurface>();
    makeCylinder(*surface);
    surface->SetFlipNormals(true);
    const auto grid = gridOf(*surface);
    ASSERT_TRUE(grid);
    EXPECT_TRUE(grid->flipped());
    expectNear(normalAt(*grid, 0, 0), FbxVector4(-1, 0, 0), 1e-9);
}

TEST_F(TessellationGridOf, ControlPointsHaveRationalSharesThatAddUpToOne) {
    auto* surface = make<FbxNurbsSurface>();
    makeSphere(*surface);
    const auto grid = gridOf(*surface);
    ASSERT_TRUE(grid);
    std::vector<double> sums(static_cast<std::size_t>(grid->pointCount()));
    std::vector<FbxVector4> points(sums.size(), FbxVector4(0, 0, 0));
    for (int i = 0; i < grid->controlPointCount(); ++i) {
        grid->spread(
            i,
            [&](int point, double share) {
                sums[static_cast<std::size_t>(point)] += share;
                points[static_cast<std::size_t>(point)] += surface->GetControlPointAt(i) * share;
            });
    }
    for (std::size_t i = 0; i < sums.size(); ++i) {
        EXPECT_NEAR(sums[i], 1.0, 1e-12);
        expectNear(points[i], grid->points()[i], 1e-12);
    }
}

TEST_F(TessellationGridOf, StepsBelowOneCountAsOne) {
    auto* patch = make<FbxPatch>();
    makeBilinear(*patch);
    patch->SetStep(0, -2147483647 - 1);
    const auto grid = gridOf(*patch);
    ASSERT_TRUE(grid);
    EXPECT_EQ(grid->pointCount(), 4);
}

TEST_F(TessellationGridOf, HugeStepsAreMadeCoarser) {
    auto* patch = make<FbxPatch>();
    makeBilinear(*patch);
    patch->SetStep(2147483647, 2147483647);
    const auto grid = gridOf(*patch);
    ASSERT_TRUE(grid);
    EXPECT_GT(grid->pointCount(), 4000);
    EXPECT_LE(grid->pointCount(), sampleBudget(4, 16, 0));
}

TEST_F(TessellationGridOf, DeformersLeaveLessRoomForSamples) {
    EXPECT_EQ(sampleBudget(4, 16, 0), 16384);
    EXPECT_EQ(sampleBudget(1000, 16, 0), 64000);
    EXPECT_EQ(sampleBudget(1000000000, 16, 0), 1048576);
    EXPECT_EQ(sampleBudget(1000000000, 16, 1023), 16384);
    EXPECT_EQ(sampleBudget(4, 16, 1000000000), 0);
    auto* patch = make<FbxPatch>();
    makeBilinear(*patch);
    const auto grid = TessellationGrid::of(*patch, 1000000000);
    ASSERT_TRUE(grid);
    EXPECT_EQ(grid->pointCount(), 4);
}

TEST_F(TessellationGridOf, RepeatedKnotsDoNotMakeUnusedColumnsCost) {
    // 100 000 control points of which a single span uses four, times many rows.
    constexpr int kCount = 100000;
    auto* surface = make<FbxNurbsSurface>();
    surface->SetOrder(4, 2);
    surface->InitControlPoints(kCount, FbxNurbsSurface::eOpen, 2, FbxNurbsSurface::eOpen);
    std::fill_n(surface->GetUKnotVector(), kCount, 0.0);
    std::fill_n(surface->GetUKnotVector() + kCount, 4, 1.0);
    std::copy_n(std::vector<double>{0, 0, 1, 1}.data(), 4, surface->GetVKnotVector());
    setHeights(*surface, [](int, int) { return 0.0; });
    surface->SetStep(1, 200000);
    const auto grid = gridOf(*surface);
    ASSERT_TRUE(grid);
    expectNear(pointAt(*grid, 1, 0), FbxVector4(kCount - 1, 0, 0), 1e-6);
}

TEST_F(TessellationGridOf, NothingIsMadeOfASurfaceWithoutPlace) {
    constexpr double kNan = std::numeric_limits<double>::quiet_NaN();
    auto* surface = make<FbxNurbsSurface>();
    EXPECT_FALSE(gridOf(*surface)) << "no points";
    makeCylinder(*surface);
    for (int i = 0; i < 18; ++i) {
        FbxVector4 point = surface->GetControlPointAt(i);
        point[3] = 0.0;
        surface->SetControlPointAt(point, i);
    }
    EXPECT_FALSE(gridOf(*surface)) << "weights of zero";
    makeCylinder(*surface);
    surface->SetControlPointAt(FbxVector4(0, kNan, 0), 4);
    EXPECT_FALSE(gridOf(*surface)) << "no number";
    makeCylinder(*surface);
    surface->SetOrder(12, 2);
    EXPECT_FALSE(gridOf(*surface)) << "order above the number of points";
    makeCylinder(*surface);
    static_cast<FbxGeometryBase*>(surface)->InitControlPoints(17);
    EXPECT_FALSE(gridOf(*surface)) << "points taken away";
    EXPECT_FALSE(TessellationGrid::of(*make<FbxMesh>(), 0)) << "no surface";
}

TEST_F(TessellationGridOf, ASurfaceShrunkToAPointHasNoDirection) {
    auto* patch = make<FbxPatch>();
    patch->InitControlPoints(2, FbxPatch::eLinear, 2, FbxPatch::eLinear);
    const auto grid = gridOf(*patch);
    ASSERT_TRUE(grid);
    for (const FbxVector4& normal : grid->normals())
        EXPECT_EQ(normal.SquareLength(), 0.0);
}

} // namespace
} // namespace fbxsdk::detail
