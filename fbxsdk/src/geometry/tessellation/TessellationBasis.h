// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// One parameter direction of a surface, sampled: the weights of control points for each sample, in value and in
// slope. All data of a surface (points, normals, skin weights, shapes) are sums over these terms.
#pragma once

#include <cstddef>
#include <optional>
#include <span>
#include <vector>

#include <fbxsdk/FbxPatch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Surfaces of a higher order are not tessellated: the cost grows with the square, and no writer uses such orders.
inline constexpr int kHighestOrder = 64;

struct BasisTerm {
    int point = 0;       ///< control point of the direction
    double weight = 0.0; ///< its weight in the sample …
    double slope = 0.0;  ///< … and the derivative of that by the parameter
};

struct SampledDirection {
    int points = 0;             ///< control points of the direction
    int width = 0;              ///< terms per sample
    bool joined = false;        ///< the last sample is the first one again
    std::vector<double> places; ///< of the samples, 0 at the direction's start and 1 at its end
    std::vector<BasisTerm> terms;

    [[nodiscard]] int sampleCount() const { return static_cast<int>(places.size()); }
    /// Without the last one where that is the first one again.
    [[nodiscard]] int distinctCount() const { return sampleCount() - (joined ? 1 : 0); }
    [[nodiscard]] std::span<const BasisTerm> termsOf(int sample) const {
        const auto size = static_cast<std::size_t>(width);
        return std::span(terms).subspan(static_cast<std::size_t>(sample) * size, size);
    }
};

/// A B-spline direction. The first points are repeated after the last one: as many times as the knots require.
struct KnotDirection {
    int points = 0;
    int order = 0;
    std::span<const double> knots;
};

/// How many spans of the direction have a length; 0 when it defines no curve: an order below 2 or above the
/// number of points, too few knots or too many, knots that descend or are not finite.
[[nodiscard]] int spanCount(const KnotDirection& direction);
/// That many equal steps in each span. Empty when there is no span.
[[nodiscard]] std::optional<SampledDirection> sampleDirection(const KnotDirection& direction, int steps);

/// The segments of a patch's direction; 0 when it has too few points for one.
///
/// Linear, cardinal: from each point to the next. Bezier: from each third point to the next third (quadric: second),
/// and points left over at the end are ignored. B-spline: uniform; an open one does not reach its outer points.
[[nodiscard]] int segmentCount(const FbxPatch::Direction& direction);
[[nodiscard]] std::optional<SampledDirection> sampleDirection(const FbxPatch::Direction& direction, int steps);

} // namespace detail
FBXSDK_NAMESPACE_END
