// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Skins: linear, by dual quaternions, and between the two.
#include "Decomposition.h"
#include "Deformation.h"
#include "Placement.h"

#include <array>
#include <cmath>
#include <cstddef>
#include <vector>

namespace Tarnell::Fbx::faithful {

namespace {

using Cluster = fbxsdk::FbxCluster;
using Matrix = fbxsdk::FbxAMatrix;
using Point = fbxsdk::FbxVector4;
using Skin = fbxsdk::FbxSkin;
using fbxsdk::FbxTime;

constexpr double kNoWeight = 1e-12;

void addScaled(Matrix& sum, const Matrix& matrix, double weight) {
    for (int row = 0; row < 4; ++row)
        for (int column = 0; column < 3; ++column)
            sum[row][column] += matrix[row][column] * weight;
}

Matrix zeroMatrix() {
    Matrix matrix;
    for (int axis = 0; axis < 3; ++axis)
        matrix[axis][axis] = 0.0;
    return matrix;
}

/// A rotation and a translation as eight numbers that can be blended.
struct DualQuaternion {
    std::array<double, 4> real{}; // x, y, z, w
    std::array<double, 4> dual{};

    void add(const DualQuaternion& other, double weight) {
        for (std::size_t i = 0; i < 4; ++i) {
            real[i] += other.real[i] * weight;
            dual[i] += other.dual[i] * weight;
        }
    }
};

std::array<double, 4> product(const std::array<double, 4>& a, const std::array<double, 4>& b) {
    return {
        a[3] * b[0] + a[0] * b[3] + a[1] * b[2] - a[2] * b[1], a[3] * b[1] - a[0] * b[2] + a[1] * b[3] + a[2] * b[0],
        a[3] * b[2] + a[0] * b[1] - a[1] * b[0] + a[2] * b[3], a[3] * b[3] - a[0] * b[0] - a[1] * b[1] - a[2] * b[2]};
}

DualQuaternion dualQuaternion(const Matrix& rotation, const Vector& translation) {
    const fbxsdk::FbxQuaternion turn = rotation.GetQ();
    DualQuaternion result;
    result.real = {turn[0], turn[1], turn[2], turn[3]};
    result.dual = product({translation[0] / 2.0, translation[1] / 2.0, translation[2] / 2.0, 0.0}, result.real);
    return result;
}

/// The rotation and translation of a blend.
Matrix rigidMotion(const DualQuaternion& blend) {
    const auto& r = blend.real;
    const double square = r[0] * r[0] + r[1] * r[1] + r[2] * r[2] + r[3] * r[3];
    Matrix matrix;
    if (!(square > 0.0))
        return matrix;
    const double length = std::sqrt(square);
    const std::array<double, 4> conjugate = {-r[0], -r[1], -r[2], r[3]};
    const std::array<double, 4> moved = product(blend.dual, conjugate);
    matrix.SetQ(fbxsdk::FbxQuaternion(r[0] / length, r[1] / length, r[2] / length, r[3] / length));
    matrix.SetT(Point(2.0 * moved[0] / square, 2.0 * moved[1] / square, 2.0 * moved[2] / square));
    return matrix;
}

/// The motion of one cluster: as a matrix, and as a stretch followed by a rigid motion.
struct Influence {
    Matrix motion;
    Matrix stretch;
    DualQuaternion rigid;
};

Influence influenceOf(const Matrix& motion) {
    Influence influence;
    influence.motion = motion;
    const Parts parts = decompose(motion, {1.0, 1.0, 1.0});
    influence.stretch = parts.rotation.Transpose() * motion;
    influence.stretch.SetT(Point(0.0, 0.0, 0.0));
    for (int axis = 0; axis < 3; ++axis)
        influence.stretch[3][axis] = 0.0;
    influence.rigid = dualQuaternion(parts.rotation, parts.position);
    return influence;
}

/// The influences of one point.
struct Sum {
    Matrix motion = zeroMatrix();
    Matrix stretch = zeroMatrix();
    DualQuaternion rigid;
    double weight = 0.0;

    void add(const Influence& influence, double share, bool dual) {
        weight += share;
        addScaled(motion, influence.motion, share);
        if (dual) {
            double sameSide = 0.0;
            for (std::size_t i = 0; i < 4; ++i)
                sameSide += rigid.real[i] * influence.rigid.real[i];
            rigid.add(influence.rigid, sameSide < 0.0 ? -share : share);
            addScaled(stretch, influence.stretch, share);
        }
    }
};

/// The common data of all clusters of a mesh.
struct Binding {
    fbxsdk::FbxNode& node;
    Matrix geometric;
    Matrix place; // of the mesh's own space, now
    FbxTime time;
    bool stated; // otherwise the scene's static pose is the bind pose
};

bool statesItsBinding(const Cluster& cluster) {
    Matrix bound, linkBound;
    return !cluster.GetTransformMatrix(bound).IsIdentity() || !cluster.GetTransformLinkMatrix(linkBound).IsIdentity();
}

/// Where a node was when the skin was bound: as the cluster states it, or in the scene's static pose.
Matrix boundPlace(const Matrix& stated, fbxsdk::FbxNode& node, const Binding& binding) {
    return binding.stated ? stated : worldMatrix(node, fbxsdk::FBXSDK_TIME_INFINITE);
}

/// The place of the mesh's own space when it was bound.
Matrix boundMesh(const Cluster& cluster, const Binding& binding) {
    Matrix stated;
    return boundPlace(cluster.GetTransformMatrix(stated), binding.node, binding) * binding.geometric;
}

/// From the mesh's own space to where a cluster's link moves it; without a link to its bind pose.
Matrix motionOf(const Cluster& cluster, const Binding& binding) {
    const Matrix bound = boundMesh(cluster, binding);
    auto* link = const_cast<fbxsdk::FbxNode*>(cluster.GetLink()); // to be evaluated
    if (link == nullptr)
        return bound;
    Matrix stated;
    const Matrix linkBound = boundPlace(cluster.GetTransformLinkMatrix(stated), *link, binding);
    return worldMatrix(*link, binding.time) * linkBound.Inverse() * bound;
}

/// In the mesh's own space: how a link moved since it was bound, relative to the mesh or to an associate model.
Matrix relativeMotionOf(const Cluster& cluster, const Binding& binding) {
    fbxsdk::FbxNode* associate = cluster.GetAssociateModel();
    const Matrix motion = motionOf(cluster, binding);
    if (associate == nullptr)
        return binding.place.Inverse() * motion;
    Matrix stated;
    const Matrix associateBound = boundPlace(cluster.GetTransformAssociateModelMatrix(stated), *associate, binding);
    return boundMesh(cluster, binding).Inverse() * associateBound * worldMatrix(*associate, binding.time).Inverse() *
           motion;
}

/// Calls `visit(point, weight)` for every point that the cluster has a weight for.
template <class Visit>
void forEachWeight(const Cluster& cluster, std::size_t pointCount, const Visit& visit) {
    const int* indices = cluster.GetControlPointIndices();
    const double* weights = cluster.GetControlPointWeights();
    const int count = indices != nullptr && weights != nullptr ? cluster.GetControlPointIndicesCount() : 0;
    for (int i = 0; i < count; ++i)
        if (indices[i] >= 0 && static_cast<std::size_t>(indices[i]) < pointCount && weights[i] != 0.0)
            visit(static_cast<std::size_t>(indices[i]), weights[i]);
}

/// The share of dual quaternions at each point.
std::vector<double> dualShares(const Skin& skin, std::size_t pointCount) {
    const bool dual = skin.GetSkinningType() == Skin::eDualQuaternion;
    std::vector<double> shares(pointCount, dual ? 1.0 : 0.0);
    const int* indices = skin.GetControlPointIndices();
    const double* weights = skin.GetControlPointBlendWeights();
    const bool blended = skin.GetSkinningType() == Skin::eBlend && indices != nullptr && weights != nullptr;
    for (int i = 0; blended && i < skin.GetControlPointIndicesCount(); ++i)
        if (indices[i] >= 0 && static_cast<std::size_t>(indices[i]) < pointCount)
            shares[static_cast<std::size_t>(indices[i])] = weights[i];
    return shares;
}

std::vector<Skin*> skinsOf(const fbxsdk::FbxMesh& mesh) {
    std::vector<Skin*> skins;
    for (int i = 0; i < mesh.GetDeformerCount(fbxsdk::FbxDeformer::eSkin); ++i) {
        auto* skin = fbxsdk::FbxCast<Skin>(mesh.GetDeformer(i, fbxsdk::FbxDeformer::eSkin));
        if (skin != nullptr && skin->GetClusterCount() > 0)
            skins.push_back(skin);
    }
    return skins;
}

template <class Visit>
void forEachCluster(const std::vector<Skin*>& skins, const Visit& visit) {
    for (Skin* skin : skins)
        for (int i = 0; i < skin->GetClusterCount(); ++i)
            visit(*skin->GetCluster(i));
}

/// Each influence moves the point as moved by those before it.
std::vector<Matrix> chainedMotions(const std::vector<Skin*>& skins, const Binding& binding, std::size_t pointCount) {
    std::vector<Matrix> motions(pointCount);
    forEachCluster(skins, [&](const Cluster& cluster) {
        const Matrix motion = relativeMotionOf(cluster, binding);
        forEachWeight(cluster, pointCount, [&](std::size_t point, double weight) {
            Matrix influence = zeroMatrix();
            addScaled(influence, motion, weight);
            addScaled(influence, Matrix(), 1.0 - weight);
            motions[point] = influence * motions[point];
        });
    });
    for (Matrix& motion : motions)
        motion = binding.place * motion;
    return motions;
}

/// The mean of the influences of each point; a point without any follows its node.
std::vector<Matrix> blendedMotions(const std::vector<Skin*>& skins, const Binding& binding, std::size_t pointCount,
                                   Cluster::ELinkMode mode) {
    const std::vector<double> dual = dualShares(*skins.front(), pointCount);
    std::vector<Sum> sums(pointCount);
    forEachCluster(skins, [&](const Cluster& cluster) {
        const Influence influence = influenceOf(motionOf(cluster, binding));
        forEachWeight(cluster, pointCount, [&](std::size_t point, double weight) {
            sums[point].add(influence, weight, dual[point] != 0.0);
        });
    });
    const Influence still = influenceOf(binding.place);
    std::vector<Matrix> motions(pointCount);
    for (std::size_t i = 0; i < pointCount; ++i) {
        Sum& sum = sums[i];
        if (std::fabs(sum.weight) < kNoWeight) {
            motions[i] = binding.place;
            continue;
        }
        if (mode == Cluster::eTotalOne)
            sum.add(still, 1.0 - sum.weight, dual[i] != 0.0);
        Matrix motion = zeroMatrix();
        addScaled(motion, sum.motion, (1.0 - dual[i]) / sum.weight);
        if (dual[i] != 0.0) {
            Matrix stretch = zeroMatrix();
            addScaled(stretch, sum.stretch, 1.0 / sum.weight);
            addScaled(motion, rigidMotion(sum.rigid) * stretch, dual[i]);
        }
        motions[i] = motion;
    }
    return motions;
}

} // namespace

bool applySkins(fbxsdk::FbxNode& node, fbxsdk::FbxMesh& mesh, const FbxTime& time, DeformedMesh& deformed) {
    const std::vector<Skin*> skins = skinsOf(mesh);
    if (skins.empty())
        return false;
    const Matrix geometric = geometricMatrix(node);
    Binding binding{node, geometric, worldMatrix(node, time) * geometric, time, false};
    int clusters = 0;
    forEachCluster(skins, [&](const Cluster& cluster) {
        ++clusters;
        binding.stated = binding.stated || statesItsBinding(cluster);
    });
    binding.stated = binding.stated || clusters < 2; // a single bone may well have been bound at the origin
    const std::size_t count = deformed.points.size();
    const Cluster::ELinkMode mode = skins.front()->GetCluster(0)->GetLinkMode();
    const std::vector<Matrix> motions = mode == Cluster::eAdditive ? chainedMotions(skins, binding, count)
                                                                   : blendedMotions(skins, binding, count, mode);
    double hand = 0.0;
    for (std::size_t i = 0; i < count; ++i) {
        deformed.points[i] = motions[i].MultT(deformed.points[i]);
        hand += handedness(motions[i]);
    }
    deformed.mirrored = hand < 0.0;
    return true;
}

} // namespace Tarnell::Fbx::faithful
