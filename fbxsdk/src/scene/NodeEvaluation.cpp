// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Evaluation of node transforms.
//
// Hosts read one node after another, each over many times. So every animated node with children caches its global
// transforms by time: a node then costs one local matrix and one product per time, whatever its depth. A node that is
// static, with all of its ancestors, has one transform. The caches of a manager share one bound; beyond it the cache of
// the least recently used node is released.
#include "scene/NodeEvaluation.h"

#include <algorithm>
#include <cmath>

#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>
#include <fbxsdk/extensions/NodeSamples.h>

#include "animation/PropertyEvaluation.h"
#include "core/Rotation.h"
#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The parts of an animated node's transform that are constant, and the three properties that may be animated.
struct TransformBinding {
    AnimatedProperty translation, rotation, scaling;
    Linear preRotation, postRotationInverse;
    FbxVector4 rotationOffset, rotationPivot, scalingOffset, scalingPivot;
    FbxEuler::EOrder order = FbxEuler::eOrderXYZ;
    bool hasPivots = false;
};

namespace {

// ---- Arithmetic on the linear parts of matrices ----

constexpr Linear kIdentity = {{{1, 0, 0}, {0, 1, 0}, {0, 0, 1}}};

/// a after b. The zero at the end is what the fourth row adds in a full product: there is no negative zero in the
/// result.
inline Linear operator*(const Linear& a, const Linear& b) {
    Linear result;
    for (std::size_t i = 0; i < 3; ++i)
        for (std::size_t j = 0; j < 3; ++j)
            result[i][j] = a[0][j] * b[i][0] + a[1][j] * b[i][1] + a[2][j] * b[i][2] + 0.0;
    return result;
}

inline Vector3 imageOf(const Linear& m, const Vector3& translation, const Vector3& point) {
    Vector3 image;
    for (std::size_t j = 0; j < 3; ++j)
        image[j] = point[0] * m[0][j] + point[1] * m[1][j] + point[2] * m[2][j] + translation[j];
    return image;
}

inline Linear transposed(const Linear& m) {
    Linear result;
    for (std::size_t i = 0; i < 3; ++i)
        for (std::size_t j = 0; j < 3; ++j)
            result[i][j] = m[j][i];
    return result;
}

/// Scales first, along the axes from which the matrix comes.
inline Linear scaled(Linear m, const Vector3& scaling) {
    for (std::size_t i = 0; i < 3; ++i)
        for (double& element : m[i])
            element *= scaling[i];
    return m;
}

Vector3 reciprocal(const Vector3& scaling) {
    Vector3 result;
    for (std::size_t i = 0; i < 3; ++i)
        result[i] = scaling[i] != 0.0 ? 1.0 / scaling[i] : 1.0;
    return result;
}

void write(FbxAMatrix& matrix, const Linear& linear, const Vector3& translation) {
    for (std::size_t i = 0; i < 3; ++i) {
        for (std::size_t j = 0; j < 3; ++j)
            matrix.mData[i].mData[j] = linear[i][j];
        matrix.mData[3].mData[i] = translation[i];
    }
}

// ---- Binding: what does not depend on the time ----

bool isZero(const FbxVector4& vector) { return vector[0] == 0.0 && vector[1] == 0.0 && vector[2] == 0.0; }

Linear turnOf(const TransformBinding& binding, const Components& angles) {
    const Linear turn = axesFromEuler(FbxVector4(angles[0], angles[1], angles[2]), binding.order);
    return binding.preRotation * turn * binding.postRotationInverse;
}

LocalTransform localOf(const TransformBinding& binding, const Components& translation, const Linear& turn,
                       const Components& scaling) {
    LocalTransform local = {
        turn, {translation[0], translation[1], translation[2]}, {scaling[0], scaling[1], scaling[2]}};
    if (!binding.hasPivots)
        return local;
    // The image of the origin, from the right: Sp⁻¹, S, Sp, Soff, Rp⁻¹, rotation, Rp, Roff, T.
    Vector3 point;
    for (std::size_t i = 0; i < 3; ++i) {
        const double pivot = binding.scalingPivot.mData[i];
        point[i] = pivot - local.scaling[i] * pivot + binding.scalingOffset.mData[i] - binding.rotationPivot.mData[i];
    }
    point = imageOf(turn, {0.0, 0.0, 0.0}, point);
    for (std::size_t i = 0; i < 3; ++i) {
        local.translation[i] =
            translation[i] + binding.rotationOffset.mData[i] + binding.rotationPivot.mData[i] + point[i];
    }
    return local;
}

Linear axesOf(const FbxVector4& degrees) { return axesFromEuler(degrees, FbxEuler::eOrderXYZ); }

void bindTransform(FbxNode& node, NodeEvaluation& state) {
    TransformBinding binding;
    FbxScene* scene = node.GetScene();
    FbxAnimStack* stack = scene ? scene->GetCurrentAnimationStack() : nullptr;
    binding.translation = bindAnimation(node.LclTranslation, stack);
    binding.rotation = bindAnimation(node.LclRotation, stack);
    binding.scaling = bindAnimation(node.LclScaling, stack);

    // Pre- and post-rotation and the order are used only while rotation is active, unless they serve the limits only.
    binding.preRotation = binding.postRotationInverse = kIdentity;
    if (node.GetRotationActive() && !node.GetRotationSpaceForLimitOnly(FbxNode::eSourcePivot)) {
        binding.preRotation = axesOf(node.GetPreRotation(FbxNode::eSourcePivot));
        binding.postRotationInverse = transposed(axesOf(node.GetPostRotation(FbxNode::eSourcePivot)));
        node.GetRotationOrder(FbxNode::eSourcePivot, binding.order);
    }
    binding.rotationOffset = node.GetRotationOffset(FbxNode::eSourcePivot);
    binding.rotationPivot = node.GetRotationPivot(FbxNode::eSourcePivot);
    binding.scalingOffset = node.GetScalingOffset(FbxNode::eSourcePivot);
    binding.scalingPivot = node.GetScalingPivot(FbxNode::eSourcePivot);
    binding.hasPivots = !isZero(binding.rotationOffset) || !isZero(binding.rotationPivot) ||
                        !isZero(binding.scalingOffset) || !isZero(binding.scalingPivot);

    node.GetTransformationInheritType(state.inherit);
    state.still = localOf(binding, binding.translation.staticValue, turnOf(binding, binding.rotation.staticValue),
                          binding.scaling.staticValue);
    const bool moves = binding.translation.animated() || binding.rotation.animated() || binding.scaling.animated();
    state.animation = moves ? std::make_unique<TransformBinding>(std::move(binding)) : nullptr;
}

} // namespace

EvaluationBudget& evaluationBudgetOf(ManagerData& manager) {
    if (!manager.evaluationBudget)
        manager.evaluationBudget = std::make_shared<EvaluationBudget>();
    return *manager.evaluationBudget;
}

namespace {

/// The node's evaluation state, cleared when the scene has changed since it was filled.
NodeEvaluation& currentState(FbxNode& node) {
    NodeEvaluation& state = node.evaluation();
    ManagerData& manager = node.GetFbxManager()->data();
    if (state.revision != manager.revision) {
        evaluationBudgetOf(manager).release(state);
        bindTransform(node, state);
        state.revision = manager.revision;
        state.chain = Chain::unknown;
        state.hasStillAxes = state.hasStillGlobal = false;
    }
    return state;
}

// ---- Evaluation ----

/// Of a property that is no rotation.
void valuesAt(AnimatedProperty& property, const FbxTime* times, int count, Components* values) {
    if (property.animated())
        evaluateAnimation(property, times, count, FbxEuler::eOrderXYZ, values);
    else
        std::fill_n(values, count, property.staticValue);
}

/// A node's local transforms at some times, at most kMostTimes.
class Locals {
public:
    Locals(NodeEvaluation& state, const FbxTime* times, std::size_t count) : mState(state) {
        if (state.animation)
            evaluate(*state.animation, times, static_cast<int>(count));
    }

    [[nodiscard]] const LocalTransform& at(std::size_t i) const {
        return mState.animation ? mTransforms[i] : mState.still;
    }

private:
    void evaluate(TransformBinding& binding, const FbxTime* times, int count) {
        std::array<Components, kMostTimes> translations, rotations, scalings;
        valuesAt(binding.translation, times, count, translations.data());
        valuesAt(binding.scaling, times, count, scalings.data());
        if (binding.rotation.animated())
            evaluateAnimation(binding.rotation, times, count, binding.order, rotations.data());
        for (std::size_t i = 0; i < static_cast<std::size_t>(count); ++i) {
            const bool isStill = times[i] == FBXSDK_TIME_INFINITE;
            const Linear& turn =
                binding.rotation.animated() && !isStill ? turnOf(binding, rotations[i]) : mState.still.rotation;
            mTransforms[i] = isStill ? mState.still : localOf(binding, translations[i], turn, scalings[i]);
        }
    }

    const NodeEvaluation& mState;
    std::array<LocalTransform, kMostTimes> mTransforms; // not needed of a static node
};

LocalTransform localAt(NodeEvaluation& state, const FbxTime& time) {
    if (!state.animation || time == FBXSDK_TIME_INFINITE)
        return state.still;
    return Locals(state, &time, 1).at(0);
}

/// The linear part of a global matrix; the three inherit types differ in where the parent's scale enters. A node that
/// compensates for its parent's scaling does so before its own rotation.
Linear linearPart(const GlobalTransform& parent, const LocalTransform& local, const Linear& rotation,
                  FbxTransform::EInheritType inherit) {
    switch (inherit) {
    case FbxTransform::eInheritRSrs:
        return parent.matrix * scaled(local.rotation, local.scaling);
    case FbxTransform::eInheritRrs:
        return scaled(parent.matrix, reciprocal(parent.scaling)) * scaled(local.rotation, local.scaling);
    case FbxTransform::eInheritRrSs:
        break;
    }
    // The scale and shear that the child inherits: the parent's matrix without its pure rotation.
    const Linear scale = transposed(parent.rotation) * parent.matrix;
    return rotation * scaled(scale, local.scaling);
}

/// The node's global transform from that of its parent, which is null at the root and may be the result itself.
void combine(const GlobalTransform* parent, const LocalTransform& local, const NodeEvaluation& state,
             GlobalTransform& result) {
    if (!parent) {
        result = {scaled(local.rotation, local.scaling), local.translation, local.rotation, local.scaling};
        return;
    }
    const Vector3 translation = imageOf(parent->matrix, parent->translation, local.translation);
    if (state.hasStillAxes) {
        result = state.stillGlobal;
    } else {
        const Linear rotation = parent->rotation * local.rotation;
        result.matrix = linearPart(*parent, local, rotation, state.inherit);
        result.rotation = rotation;
        result.scaling = local.scaling;
    }
    result.translation = translation;
}

Chain motionOf(const NodeEvaluation& state) {
    if (!state.animation)
        return Chain::isStatic;
    return state.animation->rotation.animated() || state.animation->scaling.animated() ? Chain::animated
                                                                                       : Chain::translated;
}

/// Determines for the node and its ancestors which are static together with all nodes above them: those have one
/// transform for all times. Where nothing rotates or scales, only the translations differ.
NodeEvaluation& stateWithChain(FbxNode& node) {
    NodeEvaluation& asked = currentState(node);
    if (asked.chain != Chain::unknown)
        return asked;
    std::vector<FbxNode*> unknown;
    Chain chain = Chain::isStatic;
    for (FbxNode* each = &node; each; each = each->GetParent()) {
        NodeEvaluation& state = currentState(*each);
        if (state.chain != Chain::unknown) {
            chain = state.chain;
            break;
        }
        unknown.push_back(each);
    }
    for (auto each = unknown.rbegin(); each != unknown.rend(); ++each) {
        NodeEvaluation& state = (*each)->evaluation();
        chain = state.chain = std::max(chain, motionOf(state));
    }
    return asked;
}

/// The node's cached transform at the time of that number; null when it is not cached.
const GlobalTransform* knownTransform(NodeEvaluation& state, EvaluationBudget& budget, std::uint64_t number) {
    return state.hasStillGlobal ? &state.stillGlobal : budget.find(state, number);
}

/// Some times, at most kMostTimes, and their numbers.
struct Moments {
    Moments(const FbxTime* first, int howMany, bool isStatic, EvaluationBudget& budget)
        : times(first), count(static_cast<std::size_t>(howMany)) {
        for (std::size_t i = 0; i < count; ++i)
            numbers[i] = isStatic ? 0 : budget.times.numberOf(times[i].Get());
    }

    const FbxTime* times;
    std::size_t count;
    std::array<std::uint64_t, kMostTimes> numbers; // not needed where nothing moves
};

/// Keeps what does not depend on the time.
void keepStill(NodeEvaluation& state, const GlobalTransform& transform) {
    if (state.chain == Chain::animated || state.hasStillAxes)
        return;
    state.stillGlobal = transform;
    state.hasStillAxes = true;
    state.hasStillGlobal = state.chain == Chain::isStatic;
}

/// The evaluation of a node at some times, and of those above it whose transforms are not cached.
class WayDown {
public:
    /// Goes up to the nearest ancestors with cached transforms, or to the root.
    WayDown(FbxNode& node, const Moments& moments, EvaluationBudget& budget, GlobalTransform* transforms)
        : mMoments(moments), mBudget(budget), mTransforms(transforms) {
        mBudget.path.clear();
        std::fill_n(mStart.begin(), moments.count, kUnknown);
        std::size_t missing = moments.count;
        for (FbxNode* each = &node; each && missing > 0; each = each->GetParent()) {
            missing -= takeKnown(each->evaluation());
            if (missing > 0)
                mBudget.path.push_back(each);
        }
    }

    /// And down again, to the node itself.
    void go() {
        for (std::size_t place = mBudget.path.size(); place-- > 0;)
            step(*mBudget.path[place], place);
    }

private:
    static constexpr std::size_t kUnknown = static_cast<std::size_t>(-1);

    /// Takes what is cached with a node; returns how many.
    std::size_t takeKnown(NodeEvaluation& state) {
        std::size_t taken = 0;
        for (std::size_t i = 0; i < mMoments.count; ++i) {
            if (mStart[i] != kUnknown)
                continue;
            if (const GlobalTransform* known = knownTransform(state, mBudget, mMoments.numbers[i])) {
                mTransforms[i] = *known;
                mStart[i] = mBudget.path.size();
                ++taken;
            }
        }
        return taken;
    }

    /// From the parent's transforms to those of the node at a place of the path.
    void step(FbxNode& node, std::size_t place) {
        std::size_t count = 0;
        for (std::size_t i = 0; i < mMoments.count; ++i) {
            if (mStart[i] <= place)
                continue;
            mIndices[count] = i;
            mTimes[count++] = mMoments.times[i];
        }
        NodeEvaluation& state = node.evaluation();
        const Locals locals(state, mTimes.data(), count);
        for (std::size_t k = 0; k < count; ++k) {
            GlobalTransform& transform = mTransforms[mIndices[k]];
            combine(node.GetParent() ? &transform : nullptr, locals.at(k), state, transform);
            keepStill(state, transform);
            if (!state.hasStillGlobal && node.GetChildCount() > 0)
                mBudget.store(state, mMoments.numbers[mIndices[k]], transform);
        }
    }

    const Moments& mMoments;
    EvaluationBudget& mBudget;
    GlobalTransform* mTransforms;                 ///< at each of the times
    std::array<std::size_t, kMostTimes> mStart;   ///< the place in the path below which each is known
    std::array<std::size_t, kMostTimes> mIndices; ///< of the times of a step
    std::array<FbxTime, kMostTimes> mTimes;       ///< of a step
};

/// At some times, at most kMostTimes, in any order; only the first one of a static node.
void globalsAt(FbxNode& node, NodeEvaluation& state, const FbxTime* times, int count, GlobalTransform* transforms) {
    EvaluationBudget& budget = evaluationBudgetOf(node.GetFbxManager()->data());
    const Moments moments(times, count, state.chain == Chain::isStatic, budget);
    WayDown(node, moments, budget, transforms).go();
}

GlobalTransform globalAt(FbxNode& node, const FbxTime& time) {
    NodeEvaluation& state = stateWithChain(node);
    if (state.hasStillGlobal)
        return state.stillGlobal;
    GlobalTransform transform;
    globalsAt(node, state, &time, 1, &transform);
    return transform;
}

/// The matrices of a node that moves and has no children, where all transforms of its parent are cached; false where
/// they are not.
bool writeBelowKnown(FbxNode& node, NodeEvaluation& state, const FbxTime* times, int count, FbxAMatrix* matrices) {
    FbxNode* const parent = node.GetParent();
    if (!parent || node.GetChildCount() > 0)
        return false;
    EvaluationBudget& budget = evaluationBudgetOf(node.GetFbxManager()->data());
    const Moments moments(times, count, /*isStatic*/ false, budget);
    std::array<const GlobalTransform*, kMostTimes> above;
    for (std::size_t i = 0; i < static_cast<std::size_t>(count); ++i)
        if (above[i] = knownTransform(parent->evaluation(), budget, moments.numbers[i]); !above[i])
            return false;
    const Locals locals(state, times, static_cast<std::size_t>(count));
    for (std::size_t i = 0; i < static_cast<std::size_t>(count); ++i) {
        const LocalTransform& local = locals.at(i);
        if (state.hasStillAxes) {
            write(matrices[i], state.stillGlobal.matrix,
                  imageOf(above[i]->matrix, above[i]->translation, local.translation));
            continue;
        }
        GlobalTransform global;
        combine(above[i], local, state, global);
        keepStill(state, global);
        write(matrices[i], global.matrix, global.translation);
    }
    return true;
}

/// At some times, at most kMostTimes, of a node that moves.
void writeMatrices(FbxNode& node, NodeEvaluation& state, const FbxTime* times, int count, FbxAMatrix* matrices) {
    if (writeBelowKnown(node, state, times, count, matrices))
        return;
    std::array<GlobalTransform, kMostTimes> transforms;
    globalsAt(node, state, times, count, transforms.data());
    for (std::size_t i = 0; i < static_cast<std::size_t>(count); ++i)
        write(matrices[i], transforms[i].matrix, transforms[i].translation);
}

} // namespace

// ---- Caches ----

const GlobalTransform* TransformCache::find(std::uint64_t number) {
    if (mEntries.empty())
        return nullptr;
    Entry& entry = placeOf(number);
    if (entry.number != number || !isOurs(entry))
        return nullptr;
    entry.wasFound = true;
    return &entry.transform;
}

void TransformCache::store(std::uint64_t number, const GlobalTransform& transform, std::uint64_t newest) {
    constexpr std::size_t kFirstPlaces = 8;
    if (mEntries.empty())
        mEntries.resize(kFirstPlaces);
    const auto isNeeded = [&](const Entry& entry) {
        return isOurs(entry) && entry.number != number && !entry.wasFound && newest - entry.number < TimeNumbers::kKept;
    };
    while (isNeeded(placeOf(number)) && mEntries.size() < TimeNumbers::kKept)
        grow();
    Entry& entry = placeOf(number);
    mUsed += isOurs(entry) ? 0U : 1U;
    entry = {number, mGeneration, false, transform};
}

void TransformCache::grow() {
    std::vector<Entry> old = std::move(mEntries);
    mEntries.clear();
    mEntries.resize(old.size() * 2);
    for (const Entry& entry : old)
        if (isOurs(entry))
            placeOf(entry.number) = entry;
}

void TransformCache::reset(TransformCache&& memory, std::uint32_t generation) {
    mEntries = std::move(memory.mEntries);
    memory.mEntries.clear();
    mGeneration = generation;
    mUsed = 0;
}

NodeEvaluation::NodeEvaluation() = default;
NodeEvaluation::~NodeEvaluation() = default;

const GlobalTransform* EvaluationBudget::find(NodeEvaluation& evaluation, std::uint64_t number) {
    const GlobalTransform* found = evaluation.cache.find(number);
    if (found)
        use(evaluation);
    return found;
}

void EvaluationBudget::store(NodeEvaluation& evaluation, std::uint64_t number, const GlobalTransform& transform) {
    if (evaluation.cache.places() == 0) {
        evaluation.cache.reset(std::move(mSpare), ++mGeneration);
        mPlaces += evaluation.cache.places();
    }
    const std::size_t before = evaluation.cache.places();
    evaluation.cache.store(number, transform, times.newest());
    mPlaces += evaluation.cache.places() - before;
    use(evaluation);
    while (mPlaces > kMostPlaces && mOldest != &evaluation)
        release(*mOldest);
}

void EvaluationBudget::release(NodeEvaluation& evaluation) {
    if (evaluation.cache.places() == 0)
        return;
    mPlaces -= evaluation.cache.places();
    unlink(evaluation);
    mSpare = std::move(evaluation.cache);
    evaluation.cache = {};
}

/// Moves the node to the front of the list.
void EvaluationBudget::use(NodeEvaluation& evaluation) {
    if (mLatest == &evaluation)
        return;
    unlink(evaluation);
    evaluation.nextUsed = mLatest;
    (mLatest ? mLatest->previousUsed : mOldest) = &evaluation;
    mLatest = &evaluation;
}

void EvaluationBudget::unlink(NodeEvaluation& evaluation) {
    if (mLatest == &evaluation)
        mLatest = evaluation.nextUsed;
    if (mOldest == &evaluation)
        mOldest = evaluation.previousUsed;
    if (evaluation.previousUsed)
        evaluation.previousUsed->nextUsed = evaluation.nextUsed;
    if (evaluation.nextUsed)
        evaluation.nextUsed->previousUsed = evaluation.previousUsed;
    evaluation.nextUsed = evaluation.previousUsed = nullptr;
}

FbxAMatrix evaluateLocal(FbxNode& node, const FbxTime& time) {
    const LocalTransform local = localAt(currentState(node), time);
    FbxAMatrix matrix;
    write(matrix, scaled(local.rotation, local.scaling), local.translation);
    return matrix;
}

void evaluateGlobal(FbxNode& node, const FbxTime& time, FbxAMatrix& matrix) {
    const GlobalTransform global = globalAt(node, time);
    write(matrix, global.matrix, global.translation);
}

} // namespace detail

FbxAMatrix& FbxNode::EvaluateGlobalTransform(FbxTime pTime, FbxNode::EPivotSet, bool, bool) {
    FbxAMatrix& global = evaluation().global;
    detail::evaluateGlobal(*this, pTime, global);
    return global;
}

void extensions::evaluateGlobalTransforms(FbxNode& node, const FbxTime* times, int count, FbxAMatrix* matrices) {
    detail::NodeEvaluation& state = detail::stateWithChain(node);
    if (state.chain == detail::Chain::isStatic) {
        if (count > 0)
            std::fill_n(matrices, count, node.EvaluateGlobalTransform(times[0]));
        return;
    }
    for (int done = 0; done < count; done += detail::kMostTimes)
        detail::writeMatrices(node, state, times + done, std::min(detail::kMostTimes, count - done), matrices + done);
}

FbxAMatrix& FbxNode::EvaluateLocalTransform(FbxTime pTime, FbxNode::EPivotSet, bool, bool) {
    return evaluation().local = detail::evaluateLocal(*this, pTime);
}

FBXSDK_NAMESPACE_END
