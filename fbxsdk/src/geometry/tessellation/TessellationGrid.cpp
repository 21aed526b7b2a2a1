// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Rational surfaces, sampled row by row: first the control points of a row are blended along v, then those of the
// result along u.
#include "geometry/tessellation/TessellationGrid.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include <fbxsdk/FbxNurbsSurface.h>
#include <fbxsdk/FbxPatch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

using Vector = FbxVector4;

/// A sample times its weight, with derivatives; w is the weight.
struct Homogeneous {
    Vector value{0, 0, 0, 0}, byU{0, 0, 0, 0}, byV{0, 0, 0, 0}, byUV{0, 0, 0, 0};
};

/// A sample with its derivatives.
struct SurfaceSample {
    Vector point, byU, byV, byUV;

    explicit SurfaceSample(const Homogeneous& from) {
        const double w = from.value[3];
        point = from.value / w;
        byU = (from.byU - point * from.byU[3]) / w;
        byV = (from.byV - point * from.byV[3]) / w;
        byUV = (from.byUV - byU * from.byV[3] - byV * from.byU[3] - point * from.byUV[3]) / w;
    }
};

Vector xyz(const Vector& vector) { return {vector[0], vector[1], vector[2], 0.0}; }

bool isFinite(const Vector& point) {
    return std::isfinite(point[0]) && std::isfinite(point[1]) && std::isfinite(point[2]);
}

/// The direction of a derivative. Where it vanishes, as at the pole of a sphere, that of the adjacent ones: they grow
/// with the mixed derivative on the way inwards, which leads up at the start of the other direction and down at its
/// end.
Vector directionOf(const Vector& derivative, const Vector& mixed, double scale, double place) {
    constexpr double kVanishing = 1e-9;
    if (xyz(derivative).Length() > kVanishing * scale)
        return unitVector(derivative);
    return unitVector(place > 0.5 ? -mixed : mixed);
}

Vector normalOf(const SurfaceSample& sample, double placeU, double placeV) {
    const double scale = std::max({xyz(sample.byU).Length(), xyz(sample.byV).Length(), xyz(sample.byUV).Length()});
    const Vector alongU = directionOf(sample.byU, sample.byUV, scale, placeV);
    const Vector alongV = directionOf(sample.byV, sample.byUV, scale, placeU);
    const Vector normal = xyz(alongU.CrossProduct(alongV));
    constexpr double kParallel = 1e-12;
    return normal.Length() > kParallel ? unitVector(normal) : Vector(0, 0, 0, 0);
}

/// The control points of the u direction, blended along v for one row of samples.
class BlendedRow {
public:
    explicit BlendedRow(const SampledDirection& u)
        : mPoints(static_cast<std::size_t>(u.points), Vector(0, 0, 0, 0)), mSlopes(mPoints) {
        std::vector<bool> used(mPoints.size());
        for (const BasisTerm& term : u.terms)
            used[static_cast<std::size_t>(term.point)] = true;
        for (std::size_t column = 0; column < used.size(); ++column)
            if (used[column])
                mUsed.push_back(column);
    }

    void blend(const std::vector<Vector>& controlPoints, std::span<const BasisTerm> v) {
        for (const std::size_t column : mUsed) {
            Vector point(0, 0, 0, 0), slope(0, 0, 0, 0);
            for (const BasisTerm& term : v) {
                const Vector& from = controlPoints[static_cast<std::size_t>(term.point) * mPoints.size() + column];
                point += from * term.weight;
                slope += from * term.slope;
            }
            mPoints[column] = point;
            mSlopes[column] = slope;
        }
    }

    [[nodiscard]] Homogeneous sum(std::span<const BasisTerm> u) const {
        Homogeneous sum;
        for (const BasisTerm& term : u) {
            const auto column = static_cast<std::size_t>(term.point);
            sum.value += mPoints[column] * term.weight;
            sum.byU += mPoints[column] * term.slope;
            sum.byV += mSlopes[column] * term.weight;
            sum.byUV += mSlopes[column] * term.slope;
        }
        return sum;
    }

private:
    std::vector<Vector> mPoints, mSlopes;
    std::vector<std::size_t> mUsed; ///< those with a weight in any sample: knots may exclude most of them
};

std::optional<std::pair<int, int>> stepsWithin(int spansU, int spansV, int stepU, int stepV, std::int64_t budget) {
    const auto samples = [&] { return (1.0 * spansU * stepU + 1.0) * (1.0 * spansV * stepV + 1.0); };
    if (spansU == 0 || spansV == 0)
        return std::nullopt;
    stepU = std::max(stepU, 1);
    stepV = std::max(stepV, 1);
    while (samples() > static_cast<double>(budget) && (stepU > 1 || stepV > 1))
        (stepU > stepV ? stepU : stepV) /= 2;
    if (samples() > static_cast<double>(kMostSamples))
        return std::nullopt;
    return std::pair(stepU, stepV);
}

struct SampledSurface {
    SampledDirection u, v;
    bool coarser = false;
    bool flipped = false;
    bool rational = false;
};

template <class Direction>
std::optional<SampledSurface> sampleBoth(const Direction& u, const Direction& v, int spansU, int spansV,
                                         std::pair<int, int> wanted, std::int64_t budget) {
    const auto steps = stepsWithin(spansU, spansV, wanted.first, wanted.second, budget);
    if (!steps)
        return std::nullopt;
    auto sampledU = sampleDirection(u, steps->first);
    auto sampledV = sampleDirection(v, steps->second);
    if (!sampledU || !sampledV)
        return std::nullopt;
    const bool coarser = steps->first < wanted.first || steps->second < wanted.second;
    return SampledSurface{std::move(*sampledU), std::move(*sampledV), coarser, false, false};
}

std::optional<SampledSurface> sampleNurbs(const FbxNurbsSurfaceBase& surface, std::int64_t budget) {
    const auto knots = [](const double* first, int count) {
        return std::span(first, first ? static_cast<std::size_t>(count) : 0);
    };
    const KnotDirection u{surface.GetUCount(), surface.GetUOrder(),
                          knots(surface.GetUKnotVector(), surface.GetUKnotCount())};
    const KnotDirection v{surface.GetVCount(), surface.GetVOrder(),
                          knots(surface.GetVKnotVector(), surface.GetVKnotCount())};
    auto sampled = sampleBoth(u, v, spanCount(u), spanCount(v), {surface.GetUStep(), surface.GetVStep()}, budget);
    if (sampled) {
        sampled->flipped = surface.GetFlipNormals();
        sampled->rational = true;
    }
    return sampled;
}

FbxPatch::Direction directionOf(const FbxPatch& patch, bool v) {
    FbxPatch::Direction direction;
    direction.count = v ? patch.GetVCount() : patch.GetUCount();
    direction.type = v ? patch.GetPatchVType() : patch.GetPatchUType();
    direction.closed = v ? patch.GetVClosed() : patch.GetUClosed();
    return direction;
}

std::optional<SampledSurface> samplePatch(const FbxPatch& patch, std::int64_t budget) {
    const FbxPatch::Direction u = directionOf(patch, false), v = directionOf(patch, true);
    return sampleBoth(u, v, segmentCount(u), segmentCount(v), {patch.GetUStep(), patch.GetVStep()}, budget);
}

std::optional<SampledSurface> sampleGeometry(const FbxGeometry& geometry, std::int64_t numbersPerPoint,
                                             std::int64_t fewest) {
    const std::int64_t controlPoints = geometry.GetControlPointsCount();
    if (const auto* patch = FbxCast<FbxPatch>(&geometry))
        return samplePatch(*patch, sampleBudget(controlPoints, 16, numbersPerPoint, fewest));
    const FbxNodeAttribute::EType type = geometry.GetAttributeType();
    if (type != FbxNodeAttribute::eNurbs && type != FbxNodeAttribute::eNurbsSurface)
        return std::nullopt;
    const auto& surface = static_cast<const FbxNurbsSurfaceBase&>(geometry);
    const std::int64_t shares = std::int64_t{surface.GetUOrder()} * surface.GetVOrder();
    return sampleNurbs(surface, sampleBudget(controlPoints, shares, numbersPerPoint, fewest));
}

/// Whether the counts of control points and knots match.
bool fits(const SampledSurface& sampled, const FbxGeometry& geometry) {
    return geometry.GetControlPoints() &&
           std::int64_t{sampled.u.points} * sampled.v.points == std::int64_t{geometry.GetControlPointsCount()};
}

/// Whether every sample is a mean of control points: weights that are not negative and add up to about 1.
bool isBlend(const SampledDirection& direction) {
    for (int sample = 0; sample < direction.sampleCount(); ++sample) {
        double sum = 0.0;
        for (const BasisTerm& term : direction.termsOf(sample)) {
            if (!(term.weight >= 0.0))
                return false;
            sum += term.weight;
        }
        if (!(sum > 0.5 && sum < 2.0))
            return false;
    }
    return true;
}

/// Whether every mean of the points is finite.
bool areModerate(const Vector* points, const SampledSurface& surface) {
    constexpr double kLargest = 1e90, kSmallestWeight = 1e-90;
    return std::all_of(points, points + std::ptrdiff_t{surface.u.points} * surface.v.points, [&](const Vector& point) {
        const bool weighted = !surface.rational || (point[3] >= kSmallestWeight && point[3] <= kLargest);
        return weighted && std::abs(point[0]) <= kLargest && std::abs(point[1]) <= kLargest &&
               std::abs(point[2]) <= kLargest;
    });
}

} // namespace

FbxVector4 unitVector(const FbxVector4& vector) {
    // Scaled first, so that neither tiny nor huge vectors lose their length.
    const double largest = std::max({std::abs(vector[0]), std::abs(vector[1]), std::abs(vector[2])});
    if (!(largest > 0.0) || !std::isfinite(largest))
        return {0, 0, 0, 0};
    FbxVector4 result = FbxVector4(vector[0], vector[1], vector[2], 0.0) / largest;
    result.Normalize();
    return result;
}

std::int64_t sampleBudget(std::int64_t controlPoints, std::int64_t sharesPerSample, std::int64_t numbersPerPoint,
                          std::int64_t fewest) {
    constexpr std::int64_t kUsual = std::int64_t{1} << 20;
    constexpr std::int64_t kMostShares = std::int64_t{1} << 28;
    const std::int64_t bySize =
        std::clamp(controlPoints, fewest / kSamplesPerControlPoint, kUsual / kSamplesPerControlPoint);
    const std::int64_t byShares = kMostShares / std::max<std::int64_t>(sharesPerSample, 1) / (1 + numbersPerPoint);
    return std::min(bySize * kSamplesPerControlPoint, byShares);
}

std::optional<TessellationPlan> planTessellation(const FbxGeometry& geometry, std::int64_t numbersPerPoint,
                                                 std::int64_t fewest) {
    const auto sampled = sampleGeometry(geometry, numbersPerPoint, fewest);
    if (!sampled || !fits(*sampled, geometry))
        return std::nullopt;
    const bool finite =
        isBlend(sampled->u) && isBlend(sampled->v) && areModerate(geometry.GetControlPoints(), *sampled);
    return TessellationPlan{std::int64_t{sampled->u.sampleCount()} * sampled->v.sampleCount(), sampled->coarser,
                            finite};
}

std::unique_ptr<TessellationGrid> TessellationGrid::of(const FbxGeometry& geometry, std::int64_t numbersPerPoint,
                                                       std::int64_t fewest) {
    auto sampled = sampleGeometry(geometry, numbersPerPoint, fewest);
    if (!sampled || !fits(*sampled, geometry))
        return nullptr;
    const FbxVector4* points = geometry.GetControlPoints();
    const std::span controlPoints(points, static_cast<std::size_t>(geometry.GetControlPointsCount()));
    std::unique_ptr<TessellationGrid> grid(new TessellationGrid(std::move(sampled->u), std::move(sampled->v),
                                                                sampled->flipped, sampled->rational, controlPoints));
    return grid->evaluate() ? std::move(grid) : nullptr;
}

TessellationGrid::TessellationGrid(SampledDirection u, SampledDirection v, bool flipped, bool rational,
                                   std::span<const FbxVector4> controlPoints)
    : mU(std::move(u)), mV(std::move(v)), mSharesU(invert(mU)), mSharesV(invert(mV)), mFlipped(flipped),
      mRational(rational), mControlPoints(controlPoints.begin(), controlPoints.end()) {}

TessellationGrid::Shares TessellationGrid::invert(const SampledDirection& direction) {
    Shares shares;
    shares.starts.assign(static_cast<std::size_t>(direction.points) + 1, 0);
    const auto terms =
        std::span(direction.terms)
            .first(static_cast<std::size_t>(direction.distinctCount()) * static_cast<std::size_t>(direction.width));
    for (const BasisTerm& term : terms)
        ++shares.starts[static_cast<std::size_t>(term.point) + 1];
    for (std::size_t point = 1; point < shares.starts.size(); ++point)
        shares.starts[point] += shares.starts[point - 1];
    shares.all.resize(terms.size());
    std::vector<std::size_t> next(shares.starts.begin(), shares.starts.end() - 1);
    for (int sample = 0; sample < direction.distinctCount(); ++sample)
        for (const BasisTerm& term : direction.termsOf(sample))
            shares.all[next[static_cast<std::size_t>(term.point)]++] = {sample, term.weight};
    return shares;
}

std::vector<FbxVector4> TessellationGrid::weightedPoints() const {
    std::vector<Vector> weighted(mControlPoints);
    for (int i = 0; i < controlPointCount(); ++i) {
        Vector& point = weighted[static_cast<std::size_t>(i)];
        const double weight = weightOf(i);
        point = Vector(point[0] * weight, point[1] * weight, point[2] * weight, weight);
    }
    return weighted;
}

bool TessellationGrid::evaluate() {
    const std::vector<Vector> weighted = weightedPoints();
    mPoints.resize(static_cast<std::size_t>(pointCount()));
    mDivisors.resize(mPoints.size());
    mNormals.resize(static_cast<std::size_t>(mU.sampleCount()) * static_cast<std::size_t>(mV.sampleCount()));
    BlendedRow row(mU);
    for (int sampleV = 0; sampleV < mV.sampleCount(); ++sampleV) {
        row.blend(weighted, mV.termsOf(sampleV));
        for (int sampleU = 0; sampleU < mU.sampleCount(); ++sampleU) {
            const Homogeneous sum = row.sum(mU.termsOf(sampleU));
            if (!store(sampleU, sampleV, sum))
                return false;
        }
    }
    return true;
}

template <class Sum>
bool TessellationGrid::store(int sampleU, int sampleV, const Sum& sum) {
    const SurfaceSample sample(sum);
    if (!isFinite(sample.point))
        return false;
    const Vector normal =
        normalOf(sample, mU.places[static_cast<std::size_t>(sampleU)], mV.places[static_cast<std::size_t>(sampleV)]);
    mNormals[static_cast<std::size_t>(sampleOf(sampleU, sampleV))] = mFlipped ? -normal : normal;
    if (sampleU < mU.distinctCount() && sampleV < mV.distinctCount()) {
        const auto point = static_cast<std::size_t>(pointOf(sampleU, sampleV));
        mPoints[point] = Vector(sample.point[0], sample.point[1], sample.point[2]);
        mDivisors[point] = sum.value[3];
    }
    return true;
}

} // namespace detail
FBXSDK_NAMESPACE_END
