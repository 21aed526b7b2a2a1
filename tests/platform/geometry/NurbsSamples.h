// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Surfaces whose points are known in closed form, and records for readers.
#pragma once

#include <algorithm>
#include <cmath>
#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <fbxsdk/FbxNurbs.h>
#include <fbxsdk/FbxNurbsSurface.h>
#include <fbxsdk/FbxPatch.h>

#include "container/Record.h"

namespace fbxsdk::detail {

/// Records from text, in a block of their own.
class RecordsOf {
public:
    explicit RecordsOf(const std::string& text)
        : mText("; FBX 7.4.0 project file\nBody: {\n" + text + "\n}\n"),
          mTree(readRecords(std::span(mText.data(), mText.size()), "test.fbx", mStatus)) {
        EXPECT_TRUE(mTree) << mStatus.GetErrorString();
    }
    operator const Record&() const { return *mTree->root.child("Body"); }

private:
    std::string mText;
    FbxStatus mStatus;
    std::unique_ptr<RecordTree> mTree;
};

template <class Surface>
void setKnots(Surface& surface, const std::vector<double>& u, const std::vector<double>& v) {
    ASSERT_EQ(static_cast<std::size_t>(surface.GetUKnotCount()), u.size());
    ASSERT_EQ(static_cast<std::size_t>(surface.GetVKnotCount()), v.size());
    std::copy(u.begin(), u.end(), surface.GetUKnotVector());
    std::copy(v.begin(), v.end(), surface.GetVKnotVector());
}

/// The control points of arcs of 90 degrees in a plane: their w is the weight.
inline std::vector<FbxVector4> arcPoints(int quarters, double startDegrees = 0.0) {
    constexpr double kPi = 3.14159265358979323846;
    std::vector<FbxVector4> points;
    for (int i = 0; i <= 2 * quarters; ++i) {
        const double angle = (startDegrees + 45.0 * i) * kPi / 180.0;
        const double radius = i % 2 == 0 ? 1.0 : std::sqrt(2.0);
        points.emplace_back(radius * std::cos(angle), radius * std::sin(angle), 0.0, i % 2 == 0 ? 1.0 : std::sqrt(0.5));
    }
    return points;
}

inline std::vector<double> arcKnots(int quarters) {
    std::vector<double> knots{0};
    for (int i = 0; i <= quarters; ++i)
        knots.insert(knots.end(), 2, i);
    knots.push_back(quarters);
    return knots;
}

/// Radius 1 around the z axis, from z = 0 to z = 2: u runs around counter-clockwise, v up.
template <class Surface>
void makeCylinder(Surface& surface) {
    surface.SetOrder(3, 2);
    surface.InitControlPoints(9, Surface::eOpen, 2, Surface::eOpen);
    setKnots(surface, arcKnots(4), {0, 0, 1, 1});
    const auto circle = arcPoints(4);
    for (int i = 0; i < 18; ++i) {
        const FbxVector4& point = circle[static_cast<std::size_t>(i % 9)];
        surface.SetControlPointAt(FbxVector4(point[0], point[1], i < 9 ? 0.0 : 2.0, point[3]), i);
    }
}

/// Radius 1 around the origin: u runs around the z axis counter-clockwise, v from the south pole to the north pole.
template <class Surface>
void makeSphere(Surface& surface) {
    surface.SetOrder(3, 3);
    surface.InitControlPoints(9, Surface::eOpen, 5, Surface::eOpen);
    setKnots(surface, arcKnots(4), arcKnots(2));
    const auto circle = arcPoints(4);
    const auto meridian = arcPoints(2, -90.0);
    for (int i = 0; i < 45; ++i) {
        const FbxVector4& around = circle[static_cast<std::size_t>(i % 9)];
        const FbxVector4& up = meridian[static_cast<std::size_t>(i / 9)];
        surface.SetControlPointAt(FbxVector4(around[0] * up[0], around[1] * up[0], up[1], around[3] * up[3]), i);
    }
}

/// Control points at (u, v, height(u, v)).
template <class Surface, class Height>
void setHeights(Surface& surface, Height height) {
    for (int v = 0; v < surface.GetVCount(); ++v)
        for (int u = 0; u < surface.GetUCount(); ++u)
            surface.SetControlPointAt(FbxVector4(u, v, height(u, v)), v * surface.GetUCount() + u);
}

/// Two by two control points on the unit square, heights 0, 1, 2, 5: z = u + 2 v + 2 u v.
inline void makeBilinear(FbxPatch& patch) {
    patch.InitControlPoints(2, FbxPatch::eLinear, 2, FbxPatch::eLinear);
    setHeights(patch, [](int u, int v) { return u + 2 * v + 2 * u * v; });
}

inline void expectNear(const FbxVector4& actual, const FbxVector4& expected, double tolerance = 1e-12) {
    EXPECT_LE(actual.Distance(expected), tolerance)
        << "(" << actual[0] << ", " << actual[1] << ", " << actual[2] << ") is not (" << expected[0] << ", "
        << expected[1] << ", " << expected[2] << ")";
}

} // namespace fbxsdk::detail
