// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The effect of a mesh's skin clusters on its points, block by block of points, so that the sums of a block stay in
// the cache until they are applied. The link mode determines how a point's influences add up.
#include "FbxSdk.h"

#include "SkinClusters.h"
#include "access/NodeGeometry.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <functional>
#include <limits>
#include <numeric>
#include <vector>

namespace Tarnell::Fbx {

namespace {

using Cluster = fbxsdk::FbxCluster;
using Matrix = fbxsdk::FbxAMatrix;
using Point = fbxsdk::FbxVector4;

constexpr int kMatrixElements = 16;

/// Weights are compared in double precision with a threshold of single precision.
constexpr double kWeightThreshold = static_cast<double>(1e-5f);

/// The sums of this many points stay in a core's own cache, and each cluster has enough influences for one pass.
constexpr std::size_t kBlockPoints = 1024;

void scaleElements(Matrix& matrix, double factor) {
    double* elements = matrix;
    for (int i = 0; i < kMatrixElements; ++i)
        elements[i] *= factor;
}

void addElements(Matrix& matrix, const Matrix& other) {
    double* elements = matrix;
    const double* added = other;
    for (int i = 0; i < kMatrixElements; ++i)
        elements[i] += added[i];
}

void addToDiagonal(Matrix& matrix, double value) {
    for (int i = 0; i < 4; ++i)
        matrix[i][i] += value;
}

/// The mode of the mesh's first cluster applies to all of them.
Cluster::ELinkMode linkModeOf(const fbxsdk::FbxMesh& mesh) {
    auto* skin = fbxsdk::FbxCast<fbxsdk::FbxSkin>(mesh.GetDeformer(0, fbxsdk::FbxDeformer::eSkin));
    const Cluster* first = skin != nullptr && skin->GetClusterCount() > 0 ? skin->GetCluster(0) : nullptr;
    return first != nullptr ? first->GetLinkMode() : Cluster::eNormalize;
}

/// From a point of the mesh at rest to where a cluster's link moves it.
Matrix vertexTransform(FbxSdk& sdk, const Matrix& globalPosition, fbxsdk::FbxMesh& mesh, Cluster& cluster,
                       fbxsdk::FbxNode& link, Cluster::ELinkMode mode, const fbxsdk::FbxTime& time) {
    Matrix referenceInit, referenceCurrent, linkInit;
    fbxsdk::FbxNode* associate = mode == Cluster::eAdditive ? cluster.GetAssociateModel() : nullptr;
    if (associate != nullptr) {
        cluster.GetTransformAssociateModelMatrix(referenceInit);
        referenceCurrent = detail::globalTransform(*associate, time) * sdk.getGeometry(associate);
    } else {
        cluster.GetTransformMatrix(referenceInit);
        referenceInit = referenceInit * sdk.getGeometry(mesh.GetNode());
        referenceCurrent = globalPosition;
    }
    cluster.GetTransformLinkMatrix(linkInit);
    const Matrix linkCurrent = detail::globalTransform(link, time);
    return (linkCurrent.Inverse() * referenceCurrent).Inverse() * (linkInit.Inverse() * referenceInit);
}

/// The influences of one point in the modes that average them.
class BlendedSum {
public:
    /// The part of a matrix that moves a point: three columns of four rows.
    class Motion {
    public:
        Motion() = default;
        explicit Motion(const Matrix& matrix) {
            for (std::size_t i = 0; i < mElements.size(); ++i)
                mElements[i] = matrix.Get(static_cast<int>(i / 3), static_cast<int>(i % 3));
        }

        void add(const Motion& other, double weight) {
            for (std::size_t i = 0; i < mElements.size(); ++i)
                mElements[i] += other.mElements[i] * weight;
        }

        /// As the whole matrix's MultT does, sum by sum.
        [[nodiscard]] Point apply(const Point& point) const {
            const auto component = [&](std::size_t j) {
                return point[0] * mElements[j] + point[1] * mElements[3 + j] + point[2] * mElements[6 + j] +
                       mElements[9 + j];
            };
            return {component(0), component(1), component(2), point[3]};
        }

    private:
        std::array<double, 12> mElements{};
    };

    void add(const Motion& motion, double weight) {
        mMotion.add(motion, weight);
        mWeight += weight;
    }

    /// kept: a total of exactly the threshold leaves the point unchanged, a weight of exactly the threshold counts
    void apply(Cluster::ELinkMode mode, Point& point) const {
        if (!(std::fabs(mWeight) > kWeightThreshold))
            return;
        const Point source = point;
        point = mMotion.apply(source);
        if (mode == Cluster::eNormalize)
            point /= mWeight;
        else if (mode == Cluster::eTotalOne)
            point += source * (1.0 - mWeight);
    }

private:
    Motion mMotion;
    double mWeight = 0.0;
};

/// The influences of one point in the additive mode, where each one moves the point as moved by those before it.
class ChainedSum {
public:
    using Motion = Matrix;

    void add(const Motion& motion, double weight) {
        Matrix influence = motion;
        scaleElements(influence, weight);
        addToDiagonal(influence, 1.0 - weight);
        mMotion = influence * mMotion;
        mMoved = true;
    }

    void apply(Cluster::ELinkMode /*mode*/, Point& point) const {
        if (mMoved)
            point = mMotion.MultT(point);
    }

private:
    Matrix mMotion;
    bool mMoved = false;
};

/// One cluster's influences, of which those before `next` have been added.
template <class Sum>
struct Influences {
    typename Sum::Motion motion;
    const int* indices;
    const double* weights;
    std::ptrdiff_t count;
    std::ptrdiff_t next = 0;

    Influences(const Cluster& cluster, const Matrix& transform)
        : motion(transform), indices(cluster.GetControlPointIndices()), weights(cluster.GetControlPointWeights()),
          count(indices != nullptr && weights != nullptr ? cluster.GetControlPointIndicesCount() : 0) {}

    /// Counts the descents, which is vectorised, rather than to look for the first one.
    [[nodiscard]] bool isAscending() const {
        return count < 2 ||
               std::inner_product(indices + 1, indices + count, indices, 0, std::plus<>(), std::less<>()) == 0;
    }

    /// Adds those to the next index above `lastIndex`. Indices outside of the block are skipped.
    void addUpTo(int lastIndex, std::size_t firstPoint, std::vector<Sum>& sums) {
        const typename Sum::Motion moved = motion; // a local copy, so that it can stay in registers
        for (; next < count && indices[next] <= lastIndex; ++next) {
            const double weight = weights[next];
            // a negative index becomes a large one
            const std::size_t point = static_cast<std::size_t>(indices[next]) - firstPoint;
            if (!(std::fabs(weight) < kWeightThreshold) && point < sums.size())
                sums[point].add(moved, weight);
        }
    }
};

/// Every point's influences are added in the order of the clusters, and within a cluster in that of its list, which
/// makes the result the same for every size of a block.
template <class Sum>
void deform(std::vector<Influences<Sum>>& clusters, Cluster::ELinkMode mode, std::size_t pointCount, Point* points) {
    // Ascending lists, the usual case, are processed in one pass through all blocks. Others would have
    // to be searched for every block: the whole mesh is one block then.
    const bool ascending =
        std::all_of(clusters.begin(), clusters.end(), [](const auto& cluster) { return cluster.isAscending(); });
    const std::size_t blockSize = ascending ? kBlockPoints : pointCount;
    std::vector<Sum> sums;
    for (std::size_t first = 0; first < pointCount; first += blockSize) {
        const std::size_t end = std::min(first + blockSize, pointCount);
        sums.assign(end - first, Sum());
        const int lastIndex = end < pointCount ? static_cast<int>(end - 1) : std::numeric_limits<int>::max();
        for (Influences<Sum>& cluster : clusters)
            cluster.addUpTo(lastIndex, first, sums);
        for (std::size_t i = first; i < end; ++i)
            sums[i - first].apply(mode, points[i]);
    }
}

template <class Sum>
void deformBySkins(FbxSdk& sdk, const Matrix& globalPosition, fbxsdk::FbxMesh& mesh, Cluster::ELinkMode mode,
                   const fbxsdk::FbxTime& time, Point* points) {
    std::vector<Influences<Sum>> clusters;
    detail::forEachCluster(mesh, [&](Cluster& cluster) {
        if (fbxsdk::FbxNode* link = cluster.GetLink())
            clusters.emplace_back(cluster, vertexTransform(sdk, globalPosition, mesh, cluster, *link, mode, time));
    });
    deform(clusters, mode, static_cast<std::size_t>(mesh.GetControlPointsCount()), points);
}

} // namespace

void FbxSdk::computeClusterDeformation(fbxsdk::FbxAMatrix& globalPosition, fbxsdk::FbxMesh* mesh, fbxsdk::FbxTime& time,
                                       fbxsdk::FbxVector4* points) {
    if (mesh == nullptr || points == nullptr)
        return;
    const Cluster::ELinkMode mode = linkModeOf(*mesh);
    const auto deformInMode = mode == Cluster::eAdditive ? deformBySkins<ChainedSum> : deformBySkins<BlendedSum>;
    deformInMode(*this, globalPosition, *mesh, mode, time, points);
}

void FbxSdk::matrixScale(fbxsdk::FbxAMatrix& matrix, double factor) { scaleElements(matrix, factor); }

void FbxSdk::matrixAddToDiagonal(fbxsdk::FbxAMatrix& matrix, double value) { addToDiagonal(matrix, value); }

void FbxSdk::matrixAdd(fbxsdk::FbxAMatrix& matrix, fbxsdk::FbxAMatrix& other) { addElements(matrix, other); }

} // namespace Tarnell::Fbx
