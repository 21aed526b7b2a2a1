// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A grid of samples over a surface: points, normals, and the weights of control points in each of them.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <vector>

#include <fbxsdk/FbxGeometry.h>
#include <fbxsdk/FbxVector4.h>

#include "geometry/tessellation/TessellationBasis.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A surface that has more samples with single steps is not tessellated.
inline constexpr std::int64_t kMostSamples = std::int64_t{1} << 22;
/// The sample budget of a control point: eight steps both ways.
inline constexpr std::int64_t kSamplesPerControlPoint = 64;
/// The minimum budget of a surface with few control points …
inline constexpr std::int64_t kSamplesOfAnySurface = std::int64_t{1} << 14;
/// … as long as all surfaces of a scene together, beyond the budget of their control points, do not exceed
/// this.
inline constexpr std::int64_t kSamplesOfAnyScene = std::int64_t{1} << 19;

/// How many samples a surface may have before its steps are made coarser. The cost of a file stays in proportion to its
/// content: to its control points, and to the numbers that deformers will need for each sample.
[[nodiscard]] std::int64_t sampleBudget(std::int64_t controlPoints, std::int64_t sharesPerSample,
                                        std::int64_t numbersPerPoint, std::int64_t fewest = kSamplesOfAnySurface);

/// The properties of a surface's samples before they are computed.
struct TessellationPlan {
    std::int64_t samples = 0;
    bool coarser = false;        ///< than the surface specifies
    bool certainlyFinite = true; ///< every sample is finite
};
/// The plan by which TessellationGrid::of samples the surface; empty when it certainly has none.
[[nodiscard]] std::optional<TessellationPlan> planTessellation(const FbxGeometry& geometry,
                                                               std::int64_t numbersPerPoint, std::int64_t fewest);

/// The vector at length 1; zero for a vector without length, or without a finite one.
[[nodiscard]] FbxVector4 unitVector(const FbxVector4& vector);

/// u runs fastest, in control points and in samples.
class TessellationGrid {
public:
    /// Samples a NURBS surface or a patch; null for other geometry and for inconsistent data: numbers that do not
    /// match, or samples that are not finite. `numbersPerPoint` is the count that deformers will add.
    [[nodiscard]] static std::unique_ptr<TessellationGrid> of(const FbxGeometry& geometry, std::int64_t numbersPerPoint,
                                                              std::int64_t fewest = kSamplesOfAnySurface);

    [[nodiscard]] const SampledDirection& u() const { return mU; }
    [[nodiscard]] const SampledDirection& v() const { return mV; }
    /// Whether the surface's front is the side opposite to du × dv.
    [[nodiscard]] bool flipped() const { return mFlipped; }

    /// Joined samples are one point.
    [[nodiscard]] int pointCount() const { return mU.distinctCount() * mV.distinctCount(); }
    [[nodiscard]] int pointOf(int sampleU, int sampleV) const {
        return (sampleV % mV.distinctCount()) * mU.distinctCount() + sampleU % mU.distinctCount();
    }
    [[nodiscard]] int sampleOf(int sampleU, int sampleV) const { return sampleV * mU.sampleCount() + sampleU; }
    [[nodiscard]] std::span<const FbxVector4> points() const { return mPoints; }
    /// One per sample, of length 1 on the surface's front; zero where the surface has no direction.
    [[nodiscard]] std::span<const FbxVector4> normals() const { return mNormals; }

    /// Adds the numbers of control points, `size` each, to the points in which they have a weight, times the weight.
    /// Takes one control point at a time, so that the cost is proportional to their number.
    template <class Add>
    void spread(int controlPoint, Add&& add) const {
        const int columns = mU.points;
        for (const Share& v : sharesOf(mSharesV, controlPoint / columns)) {
            for (const Share& u : sharesOf(mSharesU, controlPoint % columns)) {
                const int point = v.sample * mU.distinctCount() + u.sample;
                const double weight = weightOf(controlPoint) / mDivisors[static_cast<std::size_t>(point)];
                add(point, u.weight * v.weight * weight);
            }
        }
    }
    [[nodiscard]] int controlPointCount() const { return mU.points * mV.points; }

private:
    /// The samples in which one control point of a direction has a weight.
    struct Share {
        int sample;
        double weight;
    };
    struct Shares {
        std::vector<std::size_t> starts;
        std::vector<Share> all;
    };

    TessellationGrid(SampledDirection u, SampledDirection v, bool flipped, bool rational,
                     std::span<const FbxVector4> controlPoints);

    [[nodiscard]] static Shares invert(const SampledDirection& direction);
    [[nodiscard]] static std::span<const Share> sharesOf(const Shares& shares, int point) {
        const auto index = static_cast<std::size_t>(point);
        return std::span(shares.all).subspan(shares.starts[index], shares.starts[index + 1] - shares.starts[index]);
    }
    [[nodiscard]] double weightOf(int controlPoint) const {
        return mRational ? mControlPoints[static_cast<std::size_t>(controlPoint)][3] : 1.0;
    }
    [[nodiscard]] std::vector<FbxVector4> weightedPoints() const;
    // False when a sample is not finite.
    bool evaluate();
    template <class Sum>
    bool store(int sampleU, int sampleV, const Sum& sum);

    SampledDirection mU, mV;
    Shares mSharesU, mSharesV;
    bool mFlipped, mRational;
    std::vector<FbxVector4> mControlPoints;
    std::vector<FbxVector4> mPoints, mNormals;
    std::vector<double> mDivisors; ///< of the points: the sum of all weights
};

} // namespace detail
FBXSDK_NAMESPACE_END
