// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Placement.h"

#include "Sampling.h"
#include "access/NodeGeometry.h"
#include "access/RotationOrders.h"

#include <array>
#include <cstdint>
#include <span>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::faithful {

namespace {

using Matrix = fbxsdk::FbxAMatrix;
using fbxsdk::FbxNode;
using fbxsdk::FbxTime;

constexpr auto kSource = FbxNode::eSourcePivot;

RotationOrder orderInForce(const FbxNode& node) {
    fbxsdk::FbxEuler::EOrder order = fbxsdk::FbxEuler::eOrderXYZ;
    if (node.GetRotationActive())
        node.GetRotationOrder(kSource, order);
    return detail::rotationOrderOf(order);
}

Vector asVector(const fbxsdk::FbxDouble3& value) { return {value[0], value[1], value[2]}; }

Vector valueAt(fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3>& property, const FbxTime& time) {
    return asVector(property.EvaluateValue(time));
}

constexpr std::size_t kChannels = 12;
constexpr std::array<TransformChannel, kChannels / 3> kFirstChannels = {
    TnFbxTransform::kFbxTransformPositionX, TnFbxTransform::kFbxTransformRotationX, TnFbxTransform::kFbxTransformScaleX,
    TnFbxTransform::kFbxTransformSkewX};

TransformChannel channelAt(std::size_t i) {
    return static_cast<TransformChannel>(static_cast<int>(kFirstChannels[i / 3]) + static_cast<int>(i % 3));
}

/// Position, angles, scale and skew, as the channels are filled.
using Values = std::array<double, kChannels>;

Values valuesOf(const Parts& parts, const Vector& angles) {
    Values values{};
    for (std::size_t i = 0; i < 3; ++i) {
        values[i] = parts.position[i];
        values[3 + i] = angles[i];
        values[6 + i] = parts.scale[i];
        values[9 + i] = parts.skew[i];
    }
    return values;
}

Parts partsAt(const Placement& placement, const FbxTime& time) {
    Matrix matrix;
    placement.matricesAt({&time, 1}, &matrix);
    return decompose(matrix, valueAt(placement.node.LclScaling, time));
}

/// The angles of a rotation. Those of the frame before stay where it has axes without scale, and they turn the others
/// as it does: what shrinks to nothing does not turn.
Vector anglesOf(const Parts& parts, RotationOrder order, const Vector& before) {
    const bool isFlat = parts.scale[0] == 0.0 || parts.scale[1] == 0.0 || parts.scale[2] == 0.0;
    return isFlat && turnsLike(rotationOf(before, order), parts) ? before : anglesNear(parts.rotation, order, before);
}

/// The node's own angles, which include full turns, where they give its rotation.
class OwnAngles {
public:
    OwnAngles(const Placement& placement, RotationOrder order)
        : mNode(placement.node), mOrder(order), mFit(placement.ownAngles) {}

    bool fit() const { return mFit; }
    Vector at(const FbxTime& time) const { return valueAt(mNode.LclRotation, time); }
    /// They are not used once they give another rotation.
    void compare(const Vector& angles, const Parts& parts) {
        mFit = mFit && turnsLike(rotationOf(angles, mOrder), parts);
    }

private:
    FbxNode& mNode;
    RotationOrder mOrder;
    bool mFit;
};

void setStill(TnFbxTransform& object, const Values& values) {
    for (std::size_t i = 0; i < kChannels; ++i)
        object.setTransformValue(channelAt(i), toFloat(values[i]));
}

void readStill(Scene& scene, const Placement& placement, RotationOrder order, TnFbxTransform& object) {
    const Parts parts = partsAt(placement, scene.now());
    OwnAngles own(placement, order);
    const Vector hint = own.at(scene.now());
    own.compare(hint, parts);
    const Vector near = placement.nearOwn ? hint : Vector{};
    setStill(object, valuesOf(parts, own.fit() ? hint : anglesOf(parts, order, near)));
}

/// Whether two matrices are equal except for their translation.
bool standAlike(const Matrix& a, const Matrix& b) {
    for (int axis = 0; axis < 3; ++axis) {
        for (int component = 0; component < 3; ++component)
            if (!(a.Get(axis, component) == b.Get(axis, component)))
                return false;
    }
    return true;
}

/// What the placement of a node at some times is computed from.
struct Portion {
    Portion(const Placement& placement, std::span<const FbxTime> times) {
        placement.matricesAt(times, matrices.data());
        detail::vectorsAt(placement.node.LclRotation, times, angles.data());
        detail::vectorsAt(placement.node.LclScaling, times, scales.data());
    }

    std::array<Matrix, detail::kMostTogether> matrices;
    std::array<fbxsdk::FbxDouble3, detail::kMostTogether> angles, scales; // the node's own
};

/// The placement at one frame after the other. A rotation and scale that do not change are decomposed once.
class MovingPlacement {
public:
    MovingPlacement(Scene& scene, const Placement& placement, RotationOrder order)
        : mPlacement(placement), mOrder(order), mOwn(placement, order),
          mOwnChanges(scene.isKeyed(placement.node.LclRotation) || scene.isKeyed(placement.node.LclScaling)) {}

    void begin(const FbxTime& time) {
        mOwnAngles = mOwn.at(time);
        mAngles = mPlacement.nearOwn ? mOwnAngles : Vector{};
    }

    /// At a place in the portion, one after the other.
    Values at(const Portion& portion, std::size_t place) {
        const Matrix& matrix = portion.matrices[place];
        if (mAny && !mOwnChanges && standAlike(matrix, mMatrix)) {
            for (int i = 0; i < 3; ++i)
                mParts.position[static_cast<std::size_t>(i)] = matrix.Get(3, i);
            return valuesOf(mParts, mAngles);
        }
        mAny = true;
        mMatrix = matrix;
        mParts = decompose(matrix, asVector(portion.scales[place]));
        mAngles = anglesOf(mParts, mOrder, mAngles);
        if (mOwn.fit()) {
            mOwnAngles = asVector(portion.angles[place]);
            mOwn.compare(mOwnAngles, mParts);
        }
        return valuesOf(mParts, mAngles);
    }

    const Vector& angles() const { return mAngles; }
    const OwnAngles& own() const { return mOwn; }
    const Vector& ownAngles() const { return mOwnAngles; }

private:
    const Placement& mPlacement;
    RotationOrder mOrder;
    OwnAngles mOwn;
    bool mOwnChanges;
    bool mAny = false;
    Matrix mMatrix;
    Parts mParts;
    Vector mAngles{}, mOwnAngles{};
};

bool readMoving(Scene& scene, const Placement& placement, RotationOrder order, TnFbxTransform& object) {
    const Timeline& timeline = scene.timeline();
    if (!scene.grantSamples(0))
        return false;
    Runs<kChannels> samples(scene);
    Runs<3> ownAngles(scene);
    MovingPlacement moving(scene, placement, order);
    moving.begin(timeline.at(static_cast<double>(timeline.first())));
    Vector nearNow = moving.angles();
    const auto addPortion = [&](std::int64_t frame, std::span<const FbxTime> times) {
        const Portion portion(placement, times);
        Columns<kChannels> columns;
        Columns<3> ownColumns;
        for (std::size_t i = 0; i < times.size(); ++i) {
            columns.add(moving.at(portion, i));
            if (static_cast<double>(frame++) <= static_cast<double>(scene.frame()))
                nearNow = moving.angles();
            if (moving.own().fit())
                ownColumns.add(moving.ownAngles());
        }
        return samples.add(columns) && ownAngles.add(ownColumns);
    };
    if (!scene.inPortions(addPortion))
        return false;
    const bool isOwn = moving.own().fit();
    const Parts now = partsAt(placement, scene.now());
    setStill(object, valuesOf(now, isOwn ? moving.own().at(scene.now()) : anglesOf(now, order, nearNow)));
    for (std::size_t i = 0; i < kChannels; ++i) {
        detail::SampleRun& run = isOwn && i >= 3 && i < 6 ? ownAngles[i - 3] : samples[i];
        if (!run.isOneValue())
            run.moveInto(*object.getTransformChannel(channelAt(i)), timeline.record(scene.frame()));
    }
    return true;
}

/// Relative to the parent.
void localMatrices(FbxNode& node, std::span<const FbxTime> times, Matrix* matrices) {
    std::vector<Matrix> parents(times.size());
    if (FbxNode* parent = node.GetParent())
        detail::globalTransforms(*parent, times, parents.data());
    detail::globalTransforms(node, times, matrices);
    for (std::size_t i = 0; i < times.size(); ++i)
        if (handedness(parents[i]) == 0.0) // a flattened space has no inverse
            matrices[i] = node.EvaluateLocalTransform(times[i], kSource, /*pApplyTarget*/ false, /*pForceEval*/ false);
        else
            matrices[i] = parents[i].Inverse() * matrices[i];
}

} // namespace

Matrix worldMatrix(FbxNode& node, const FbxTime& time) { return detail::globalTransform(node, time); }

Matrix parentMatrix(FbxNode& node, const FbxTime& time) {
    FbxNode* parent = node.GetParent();
    return parent != nullptr ? worldMatrix(*parent, time) : Matrix();
}

Matrix localMatrix(FbxNode& node, const FbxTime& time) {
    Matrix matrix;
    localMatrices(node, {&time, 1}, &matrix);
    return matrix;
}

Matrix geometricMatrix(const FbxNode& node) { return detail::geometricTransform(node); }

Placement placementOf(Scene& scene, FbxNode& node, bool global) {
    const auto matricesAt = global ? detail::globalTransforms : localMatrices;
    return {
        node,
        [&node, matricesAt](std::span<const FbxTime> times, Matrix* matrices) { matricesAt(node, times, matrices); },
        scene.moves(node), true, true};
}

MatricesAt rotatedFirst(MatricesAt matricesAt, const Matrix& turn) {
    return [place = std::move(matricesAt), turn](std::span<const FbxTime> times, Matrix* matrices) {
        place(times, matrices);
        for (std::size_t i = 0; i < times.size(); ++i)
            matrices[i] = matrices[i] * turn;
    };
}

bool readPlacement(Scene& scene, const Placement& placement, TnFbxTransform& object) {
    const RotationOrder order = orderInForce(placement.node);
    object.setTransformRotationOrder(order);
    if (placement.moves)
        return readMoving(scene, placement, order, object);
    readStill(scene, placement, order, object);
    return true;
}

} // namespace Tarnell::Fbx::faithful
