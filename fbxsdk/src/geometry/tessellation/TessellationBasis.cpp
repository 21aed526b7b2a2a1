// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Basis functions of B-splines by their recurrence, of patches by the matrix of their kind.
#include "geometry/tessellation/TessellationBasis.h"

#include <algorithm>
#include <array>
#include <cmath>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Weights and slopes of the basis functions that are not zero in one knot span.
class SpanBasis {
public:
    explicit SpanBasis(const KnotDirection& direction)
        : mOrder(static_cast<std::size_t>(direction.order)), mKnots(direction.knots) {}

    /// `span` is the index of the knot at the span's start.
    void evaluate(std::size_t span, double parameter) {
        mWeights[0] = 1.0;
        for (std::size_t degree = 1; degree < mOrder; ++degree) {
            if (degree + 1 == mOrder)
                takeSlopes(span, degree);
            raise(span, degree, parameter);
        }
    }
    [[nodiscard]] double weight(std::size_t term) const { return mWeights[term]; }
    [[nodiscard]] double slope(std::size_t term) const { return mSlopes[term]; }

private:
    /// Length of the support that function `term` of the next lower degree has inside this degree's recurrence.
    [[nodiscard]] double support(std::size_t span, std::size_t degree, std::size_t term) const {
        return mKnots[span + term + 1] - mKnots[span + term + 1 - degree];
    }

    /// From the functions of the next lower degree to those of this degree.
    void raise(std::size_t span, std::size_t degree, double parameter) {
        double saved = 0.0;
        for (std::size_t term = 0; term < degree; ++term) {
            const double share = mWeights[term] / support(span, degree, term);
            mWeights[term] = saved + (mKnots[span + term + 1] - parameter) * share;
            saved = (parameter - mKnots[span + term + 1 - degree]) * share;
        }
        mWeights[degree] = saved;
    }

    /// The slopes of the highest degree are differences of the functions one degree below.
    void takeSlopes(std::size_t span, std::size_t degree) {
        double saved = 0.0;
        for (std::size_t term = 0; term < degree; ++term) {
            const double share = static_cast<double>(degree) * mWeights[term] / support(span, degree, term);
            mSlopes[term] = saved - share;
            saved = share;
        }
        mSlopes[degree] = saved;
    }

    std::size_t mOrder;
    std::span<const double> mKnots;
    std::array<double, kHighestOrder> mWeights{};
    std::array<double, kHighestOrder> mSlopes{};
};

/// Index of the knot after the last span.
std::size_t domainEnd(const KnotDirection& direction) {
    return direction.knots.size() - static_cast<std::size_t>(direction.order);
}

bool isUsable(const KnotDirection& direction) {
    if (direction.order < 2 || direction.order > kHighestOrder || direction.order > direction.points)
        return false;
    const auto order = static_cast<std::size_t>(direction.order);
    const std::size_t fewest = static_cast<std::size_t>(direction.points) + order;
    // At most the first order - 1 points are repeated.
    if (direction.knots.size() < fewest || direction.knots.size() >= fewest + order)
        return false;
    const bool finite =
        std::all_of(direction.knots.begin(), direction.knots.end(), [](double knot) { return std::isfinite(knot); });
    return finite && std::is_sorted(direction.knots.begin(), direction.knots.end()) &&
           std::isfinite(direction.knots.back() - direction.knots.front());
}

bool sameTerms(std::span<const BasisTerm> a, std::span<const BasisTerm> b, int points) {
    // Both lists refer to adjacent points; at a knot one of them may start a point later.
    std::vector<double> difference(static_cast<std::size_t>(points), 0.0);
    for (const BasisTerm& term : a)
        difference[static_cast<std::size_t>(term.point)] += term.weight;
    for (const BasisTerm& term : b)
        difference[static_cast<std::size_t>(term.point)] -= term.weight;
    return std::all_of(difference.begin(), difference.end(), [](double each) { return std::abs(each) < 1e-12; });
}

/// Where a direction is closed, its last sample is the first one, and shares its point.
void join(SampledDirection& sampled) {
    sampled.joined = sampled.sampleCount() > 2 &&
                     sameTerms(sampled.termsOf(0), sampled.termsOf(sampled.sampleCount() - 1), sampled.points);
}

/// One segment of a patch: `width` points whose weights are cubics of the parameter within the segment.
struct SegmentKind {
    int width;
    int stride;          ///< points from one segment to the next
    int before;          ///< points of the segment that lie before its start
    double matrix[4][4]; ///< per point: coefficients of 1, t, t², t³
};

constexpr SegmentKind kSegmentKinds[] = {
    /* Bezier */ {4, 3, 0, {{1, -3, 3, -1}, {0, 3, -6, 3}, {0, 0, 3, -3}, {0, 0, 0, 1}}},
    /* BezierQuadric */ {3, 2, 0, {{1, -2, 1, 0}, {0, 2, -2, 0}, {0, 0, 1, 0}, {}}},
    /* Cardinal */ {4, 1, 1, {{0, -0.5, 1, -0.5}, {1, 0, -2.5, 1.5}, {0, 0.5, 2, -1.5}, {0, 0, -0.5, 0.5}}},
    /* BSpline */
    {4, 1, 1, {{1 / 6.0, -0.5, 0.5, -1 / 6.0}, {4 / 6.0, 0, -1, 0.5}, {1 / 6.0, 0.5, 0.5, -0.5}, {0, 0, 0, 1 / 6.0}}},
    /* Linear */ {2, 1, 0, {{1, -1, 0, 0}, {0, 1, 0, 0}, {}, {}}},
};

const SegmentKind& kindOf(const FbxPatch::Direction& direction) {
    return kSegmentKinds[static_cast<std::size_t>(direction.type)];
}

BasisTerm termAt(const double (&coefficients)[4], int point, double t) {
    return {point, coefficients[0] + t * (coefficients[1] + t * (coefficients[2] + t * coefficients[3])),
            coefficients[1] + t * (2.0 * coefficients[2] + t * 3.0 * coefficients[3])};
}

/// Terms of a sample. A cardinal curve passes through its outer points as if it continued straight beyond them: the
/// missing adjacent point of an end is the mirror image of the other one.
void appendTerms(const FbxPatch::Direction& direction, int segment, double t, std::vector<BasisTerm>& terms) {
    const SegmentKind& kind = kindOf(direction);
    const bool mirrors = direction.type == FbxPatch::eCardinal && !direction.closed;
    int first = segment * kind.stride;
    if (mirrors || direction.closed)
        first -= kind.before;
    const std::size_t start = terms.size();
    for (int i = 0; i < kind.width; ++i) {
        const int point = first + i;
        const int wrapped =
            direction.closed ? (point + direction.count) % direction.count : std::clamp(point, 0, direction.count - 1);
        terms.push_back(termAt(kind.matrix[i], wrapped, t));
    }
    if (!mirrors)
        return;
    // Beyond an end the point is 2 · end - adjacent; the clamped term has the end once.
    const auto reflect = [&](std::size_t beyond, std::size_t neighbour) {
        BasisTerm& outer = terms[start + beyond];
        terms[start + neighbour].weight -= outer.weight;
        terms[start + neighbour].slope -= outer.slope;
        outer.weight *= 2.0;
        outer.slope *= 2.0;
    };
    if (first < 0)
        reflect(0, 2);
    if (first + 3 >= direction.count)
        reflect(3, 1);
}

} // namespace

int spanCount(const KnotDirection& direction) {
    if (!isUsable(direction))
        return 0;
    int spans = 0;
    for (auto knot = static_cast<std::size_t>(direction.order) - 1; knot < domainEnd(direction); ++knot)
        spans += direction.knots[knot] < direction.knots[knot + 1] ? 1 : 0;
    return spans;
}

std::optional<SampledDirection> sampleDirection(const KnotDirection& direction, int steps) {
    const int spans = spanCount(direction);
    if (spans == 0)
        return std::nullopt;
    SampledDirection sampled;
    sampled.points = direction.points;
    sampled.width = direction.order;
    const auto degree = static_cast<std::size_t>(direction.order) - 1;
    const std::size_t end = domainEnd(direction);
    const double start = direction.knots[degree];
    const double length = direction.knots[end] - start;
    SpanBasis basis(direction);
    const auto add = [&](std::size_t span, double parameter) {
        basis.evaluate(span, parameter);
        sampled.places.push_back((parameter - start) / length);
        for (std::size_t term = 0; term <= degree; ++term) {
            const auto point = (span - degree + term) % static_cast<std::size_t>(direction.points);
            sampled.terms.push_back({static_cast<int>(point), basis.weight(term), basis.slope(term)});
        }
    };
    std::size_t last = degree;
    for (std::size_t span = degree; span < end; ++span) {
        const double from = direction.knots[span], to = direction.knots[span + 1];
        if (!(from < to))
            continue;
        last = span;
        for (int step = 0; step < steps; ++step)
            add(span, from + (to - from) * step / steps);
    }
    add(last, direction.knots[end]);
    join(sampled);
    return sampled;
}

int segmentCount(const FbxPatch::Direction& direction) {
    const SegmentKind& kind = kindOf(direction);
    const int count = direction.count;
    if (direction.closed)
        return count < 3 ? 0 : count / kind.stride;
    if (direction.type == FbxPatch::eCardinal)
        return std::max(count - 1, 0);
    return count < kind.width ? 0 : (count - kind.width) / kind.stride + 1;
}

std::optional<SampledDirection> sampleDirection(const FbxPatch::Direction& direction, int steps) {
    const int segments = segmentCount(direction);
    if (segments == 0)
        return std::nullopt;
    SampledDirection sampled;
    sampled.points = direction.count;
    sampled.width = kindOf(direction).width;
    const int samples = segments * steps + 1;
    for (int sample = 0; sample < samples; ++sample) {
        const int segment = std::min(sample / steps, segments - 1);
        const double t = static_cast<double>(sample - segment * steps) / steps;
        sampled.places.push_back(static_cast<double>(sample) / (samples - 1));
        appendTerms(direction, segment, t, sampled.terms);
    }
    join(sampled);
    return sampled;
}

} // namespace detail
FBXSDK_NAMESPACE_END
