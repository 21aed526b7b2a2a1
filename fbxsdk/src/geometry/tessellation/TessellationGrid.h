// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A grid of samples over a surface: points, normals, and the shares that control points have in each of them.
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
/// Every control point is good for so many samples: eight steps both ways.
inline constexpr std::int64_t kSamplesPerControlPoint = 64;
/// A surface of few control points may have so many all the same …
inline constexpr std::int64_t kSamplesOfAnySurface = std::int64_t{1} << 14;
/// … as long as those of all surfaces of a scene, beyond what their control points are good for, are not more than
/// this.
inline constexpr std::int64_t kSamplesOfAnyScene = std::int64_t{1} << 19;

/// How many samples a surface may have before its steps are made coarser. What a file costs stays in proportion to what
/// stands in it: to its control points, and to the numbers that deformers will need for each sample.
[[nodiscard]] std::int64_t sampleBudget(std::int64_t controlPoints, std::int64_t sharesPerSample,
                                        std::int64_t numbersPerPoint, std::int64_t fewest = kSamplesOfAnySurface);

/// What the samples of a surface will be.
struct TessellationPlan {
    std::int64_t samples = 0;
    bool coarser = false;        ///< than the surface asks for
    bool certainlyFinite = true; ///< no sample can turn out to have no finite place
};
/// The plan by which TessellationGrid::of samples the surface; empty when it has none for certain.
[[nodiscard]] std::optional<TessellationPlan> planTessellation(const FbxGeometry& geometry,
                                                               std::int64_t numbersPerPoint, std::int64_t fewest);

/// The vector at length 1; zero for a vector without length, or without a finite one.
[[nodiscard]] FbxVector4 unitVector(const FbxVector4& vector);

/// u runs fastest, in control points and in samples.
class TessellationGrid {
public:
    /// Samples a NURBS surface or a patch; null for other geometry and for one that has no surface: numbers that do not
    /// fit together, or samples without a finite place. `numbersPerPoint` is what deformers will add.
    [[nodiscard]] static std::unique_ptr<TessellationGrid> of(const FbxGeometry& geometry, std::int64_t numbersPerPoint,
                                                              std::int64_t fewest = kSamplesOfAnySurface);

    [[nodiscard]] const SampledDirection& u() const { return mU; }
    [[nodiscard]] const SampledDirection& v() const { return mV; }
    /// Whether the surface's front is the side that du × dv points away from.
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

    /// Adds what control points have, `size` numbers each, to the points they have a share in, times the share.
    /// Takes one control point at a time, so that few of them cost little.
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
    /// The samples that one control point of a direction counts in.
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
