// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// NURBS from the records of a file. Inconsistent numbers (orders, counts of points and knots) give no
// geometry: the object keeps its defaults, without points and knots.
#pragma once

#include <fbxsdk/FbxNurbsCurve.h>
#include <fbxsdk/FbxNurbsSurface.h>

#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN

class FbxBoundary;
class FbxNurbs;
class FbxTrimNurbsSurface;

namespace detail {

/// How many knots a direction has whose first points are repeated that many times after its last one.
[[nodiscard]] constexpr int knotCount(int points, int order, int repeated) { return points + order + repeated; }
/// How many of a direction's first points are repeated after its last one.
[[nodiscard]] constexpr int repeatedPoints(FbxNurbsSurfaceBase::EType type, int order) {
    return type == FbxNurbsSurfaceBase::ePeriodic ? order - 1 : type == FbxNurbsSurfaceBase::eClosed ? 1 : 0;
}
[[nodiscard]] constexpr int repeatedPoints(FbxNurbsCurve::EType type, int order) {
    return type == FbxNurbsCurve::ePeriodic ? order - 1 : type == FbxNurbsCurve::eClosed ? 1 : 0;
}

void readNurbs(FbxNurbs& nurbs, const Record& body);
void readNurbsSurface(FbxNurbsSurface& surface, const Record& body);
void readNurbsCurve(FbxNurbsCurve& curve, const Record& body);
void readTrimNurbsSurface(FbxTrimNurbsSurface& surface, const Record& body);
/// The curves of a boundary are connected to it.
void readBoundary(FbxBoundary& boundary, const Record& body);

} // namespace detail
FBXSDK_NAMESPACE_END
