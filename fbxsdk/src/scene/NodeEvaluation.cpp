// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Evaluation of node transforms.
//
// Hosts read one node after another, each over all frames. So every node with children keeps its global transforms by
// time: a node then costs one local matrix and one product per frame, however deep it hangs. The cache of a manager is
// bounded; when it is full the node that was not asked for longest loses its own.
#include "scene/NodeEvaluation.h"

#include <algorithm>
#include <cmath>

#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>

#include "animation/PropertyEvaluation.h"
#include "core/Rotation.h"
#include "scene/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The parts of a node's transform that do not change with time, and the three properties that may.
struct TransformBinding {
    AnimatedProperty translation, rotation, scaling;
    FbxAMatrix preRotation, postRotationInverse;
    FbxVector4 rotationOffset, rotationPivot, scalingOffset, scalingPivot;
    FbxEuler::EOrder order = FbxEuler::eOrderXYZ;
    FbxTransform::EInheritType inherit = FbxTransform::eInheritRrSs;
    bool animated = false; ///< any of the three has curves
    bool hasPivots = false;
};

namespace {

/// 16 MiB of cached transforms per manager.
constexpr std::size_t kMaximumCachedTransforms = (std::size_t{16} << 20U) / sizeof(GlobalTransform);

/// A node's own matrices at one time.
struct LocalTransform {
    FbxVector4 translation; ///< the translation column of the local matrix, pivots included
    FbxAMatrix rotation;    ///< Rpre R Rpost⁻¹
    FbxVector4 scaling;
};

bool isZero(const FbxVector4& vector) { return vector[0] == 0.0 && vector[1] == 0.0 && vector[2] == 0.0; }

FbxVector4 pointAt(const FbxVector4& vector) { return {vector[0], vector[1], vector[2], 1.0}; }

std::unique_ptr<TransformBinding> bindTransform(FbxNode& node) {
    auto binding = std::make_unique<TransformBinding>();
    FbxScene* scene = node.GetScene();
    FbxAnimStack* stack = scene ? scene->GetCurrentAnimationStack() : nullptr;
    binding->translation = bindAnimation(node.LclTranslation, stack);
    binding->rotation = bindAnimation(node.LclRotation, stack);
    binding->scaling = bindAnimation(node.LclScaling, stack);
    binding->animated = binding->translation.animated() || binding->rotation.animated() || binding->scaling.animated();

    // Pre- and post-rotation and the order are in force only while rotation is active, and not for its limits alone.
    if (node.GetRotationActive() && !node.GetRotationSpaceForLimitOnly(FbxNode::eSourcePivot)) {
        binding->preRotation = rotationMatrix(node.GetPreRotation(FbxNode::eSourcePivot), FbxEuler::eOrderXYZ);
        binding->postRotationInverse =
            rotationMatrix(node.GetPostRotation(FbxNode::eSourcePivot), FbxEuler::eOrderXYZ).Transpose();
        node.GetRotationOrder(FbxNode::eSourcePivot, binding->order);
    }
    binding->rotationOffset = node.GetRotationOffset(FbxNode::eSourcePivot);
    binding->rotationPivot = node.GetRotationPivot(FbxNode::eSourcePivot);
    binding->scalingOffset = node.GetScalingOffset(FbxNode::eSourcePivot);
    binding->scalingPivot = node.GetScalingPivot(FbxNode::eSourcePivot);
    binding->hasPivots = !isZero(binding->rotationOffset) || !isZero(binding->rotationPivot) ||
                         !isZero(binding->scalingOffset) || !isZero(binding->scalingPivot);
    node.GetTransformationInheritType(binding->inherit);
    return binding;
}

std::uint64_t revisionOf(const FbxNode& node) { return node.GetFbxManager()->data().revision; }

/// The node's evaluation state, emptied when the scene has changed since it was filled.
NodeEvaluation& currentState(FbxNode& node) {
    NodeEvaluation& state = node.evaluation();
    const std::uint64_t revision = revisionOf(node);
    if (!state.binding || state.revision != revision) {
        node.GetFbxManager()->data().evaluationBudget.release(state);
        state.binding = bindTransform(node);
        state.revision = revision;
        state.chain = NodeEvaluation::Chain::unknown;
    }
    return state;
}

FbxVector4 valueAt(AnimatedProperty& property, const FbxTime& time, FbxEuler::EOrder order) {
    const bool isStatic = time == FBXSDK_TIME_INFINITE || !property.animated();
    const Components value = isStatic ? property.staticValue : evaluateAnimation(property, time, order);
    return {value[0], value[1], value[2], 1.0};
}

LocalTransform localAt(TransformBinding& binding, const FbxTime& time) {
    LocalTransform local;
    const FbxVector4 translation = valueAt(binding.translation, time, binding.order);
    const FbxVector4 angles = valueAt(binding.rotation, time, binding.order);
    local.scaling = valueAt(binding.scaling, time, binding.order);
    local.rotation = binding.preRotation * rotationMatrix(angles, binding.order) * binding.postRotationInverse;
    local.translation = translation;
    if (binding.hasPivots) {
        // The image of the origin, from the right: Sp⁻¹, S, Sp, Soff, Rp⁻¹, rotation, Rp, Roff, T.
        const FbxVector4& pivot = binding.scalingPivot;
        FbxVector4 point;
        for (int i = 0; i < 3; ++i) {
            point[i] = pivot[i] - local.scaling[i] * pivot[i] + binding.scalingOffset[i] - binding.rotationPivot[i];
        }
        point = local.rotation.MultT(pointAt(point));
        for (int i = 0; i < 3; ++i) {
            local.translation[i] = translation[i] + binding.rotationOffset[i] + binding.rotationPivot[i] + point[i];
        }
    }
    return local;
}

FbxAMatrix scaled(FbxAMatrix matrix, const FbxVector4& scaling) {
    for (int row = 0; row < 3; ++row) {
        for (int column = 0; column < 3; ++column)
            matrix[row][column] *= scaling[row];
    }
    return matrix;
}

FbxAMatrix withoutTranslation(FbxAMatrix matrix) {
    for (int column = 0; column < 3; ++column)
        matrix[3][column] = 0.0;
    return matrix;
}

/// The scale and shear that a parent hands on: its matrix with its pure rotation taken off.
FbxAMatrix inheritedScale(const GlobalTransform& parent) {
    return parent.rotation.Transpose() * withoutTranslation(parent.matrix);
}

FbxVector4 reciprocal(const FbxVector4& scaling) {
    FbxVector4 result(1, 1, 1, 1);
    for (int i = 0; i < 3; ++i)
        result[i] = scaling[i] != 0.0 ? 1.0 / scaling[i] : 1.0;
    return result;
}

/// The linear part of a global matrix; the three inherit types differ in where the parent's scale enters.
FbxAMatrix linearPart(const GlobalTransform& parent, const LocalTransform& local, FbxTransform::EInheritType inherit) {
    if (inherit == FbxTransform::eInheritRSrs) {
        return withoutTranslation(parent.matrix) * scaled(local.rotation, local.scaling);
    }
    FbxAMatrix scale = inheritedScale(parent);
    if (inherit == FbxTransform::eInheritRrs)
        scale = scaled(scale, reciprocal(parent.scaling));
    return parent.rotation * local.rotation * scaled(scale, local.scaling);
}

GlobalTransform combine(const GlobalTransform* parent, const LocalTransform& local,
                        FbxTransform::EInheritType inherit) {
    GlobalTransform global;
    global.scaling = local.scaling;
    FbxVector4 translation = local.translation;
    if (parent) {
        global.matrix = linearPart(*parent, local, inherit);
        global.rotation = parent->rotation * local.rotation;
        translation = parent->matrix.MultT(pointAt(local.translation));
    } else {
        global.matrix = scaled(local.rotation, local.scaling);
        global.rotation = local.rotation;
    }
    for (int i = 0; i < 3; ++i)
        global.matrix[3][i] = translation[i];
    return global;
}

/// Where the time stands in the cache, or would stand; sequential questions are answered without a search.
std::size_t placeOf(NodeEvaluation& state, std::int64_t ticks) {
    const auto& times = state.times;
    if (!times.empty() && times.back() < ticks)
        return times.size();
    for (std::size_t step = 0; step < 2; ++step) {
        const std::size_t index = state.cursor + step;
        if (index < times.size() && times[index] == ticks)
            return index;
    }
    return static_cast<std::size_t>(std::lower_bound(times.begin(), times.end(), ticks) - times.begin());
}

const GlobalTransform* cached(NodeEvaluation& state, std::int64_t ticks) {
    const std::size_t place = placeOf(state, ticks);
    if (place >= state.times.size() || state.times[place] != ticks)
        return nullptr;
    state.cursor = place;
    return &state.transforms[place];
}

void makeRoom(EvaluationBudget& budget, const NodeEvaluation& keep) {
    while (budget.transforms >= kMaximumCachedTransforms) {
        NodeEvaluation* oldest = nullptr;
        for (NodeEvaluation* holder : budget.holders) {
            if (holder != &keep && (!oldest || holder->lastUse < oldest->lastUse))
                oldest = holder;
        }
        if (!oldest)
            return;
        budget.release(*oldest);
    }
}

void store(EvaluationBudget& budget, NodeEvaluation& state, std::int64_t ticks, const GlobalTransform& transform) {
    makeRoom(budget, state);
    if (budget.transforms >= kMaximumCachedTransforms)
        budget.release(state);
    if (state.times.empty()) {
        budget.holders.push_back(&state);
        state.times.swap(budget.spareTimes);
        state.transforms.swap(budget.spareTransforms);
    }
    const std::size_t place = placeOf(state, ticks);
    state.times.insert(state.times.begin() + static_cast<std::ptrdiff_t>(place), ticks);
    state.transforms.insert(state.transforms.begin() + static_cast<std::ptrdiff_t>(place), transform);
    state.cursor = place;
    state.lastUse = ++budget.clock;
    ++budget.transforms;
}

/// True when neither the node nor an ancestor is animated: then it has one transform for every time.
bool isStaticChain(FbxNode& node) {
    std::vector<FbxNode*> unknown;
    bool isStatic = true;
    for (FbxNode* each = &node; each; each = each->GetParent()) {
        NodeEvaluation& state = currentState(*each);
        if (state.chain != NodeEvaluation::Chain::unknown) {
            isStatic = state.chain == NodeEvaluation::Chain::isStatic;
            break;
        }
        unknown.push_back(each);
    }
    for (auto each = unknown.rbegin(); each != unknown.rend(); ++each) {
        NodeEvaluation& state = (*each)->evaluation();
        isStatic = isStatic && !state.binding->animated;
        state.chain = isStatic ? NodeEvaluation::Chain::isStatic : NodeEvaluation::Chain::animated;
    }
    return isStatic;
}

GlobalTransform globalAt(FbxNode& node, FbxTime time) {
    EvaluationBudget& budget = node.GetFbxManager()->data().evaluationBudget;
    if (isStaticChain(node))
        time = FBXSDK_TIME_INFINITE;
    const std::int64_t ticks = time.Get();

    // Up to the nearest ancestor that knows the answer, then down again.
    std::vector<FbxNode*>& path = budget.path;
    path.clear();
    GlobalTransform transform;
    bool known = false;
    for (FbxNode* each = &node; each && !known; each = each->GetParent()) {
        NodeEvaluation& state = currentState(*each);
        if (const GlobalTransform* found = cached(state, ticks)) {
            state.lastUse = ++budget.clock;
            transform = *found;
            known = true;
        } else {
            path.push_back(each);
        }
    }
    for (auto each = path.rbegin(); each != path.rend(); ++each) {
        NodeEvaluation& state = (*each)->evaluation();
        const LocalTransform local = localAt(*state.binding, time);
        transform = combine(known ? &transform : nullptr, local, state.binding->inherit);
        known = true;
        if ((*each)->GetChildCount() > 0 || ticks == FBXSDK_TIME_INFINITE.Get())
            store(budget, state, ticks, transform);
    }
    return transform;
}

} // namespace

NodeEvaluation::NodeEvaluation() = default;
NodeEvaluation::~NodeEvaluation() = default;

void EvaluationBudget::release(NodeEvaluation& evaluation) {
    if (evaluation.times.empty())
        return;
    transforms -= evaluation.times.size();
    std::erase(holders, &evaluation);
    spareTimes = std::move(evaluation.times);
    spareTransforms = std::move(evaluation.transforms);
    spareTimes.clear();
    spareTransforms.clear();
    evaluation.times.clear();
    evaluation.transforms.clear();
    evaluation.cursor = 0;
}

FbxAMatrix evaluateLocal(FbxNode& node, const FbxTime& time) {
    const LocalTransform local = localAt(*currentState(node).binding, time);
    FbxAMatrix matrix = scaled(local.rotation, local.scaling);
    for (int i = 0; i < 3; ++i)
        matrix[3][i] = local.translation[i];
    return matrix;
}

FbxAMatrix evaluateGlobal(FbxNode& node, const FbxTime& time) { return globalAt(node, time).matrix; }

} // namespace detail

FbxAMatrix& FbxNode::EvaluateGlobalTransform(FbxTime pTime, FbxNode::EPivotSet, bool, bool) {
    return evaluation().global = detail::evaluateGlobal(*this, pTime);
}

FbxAMatrix& FbxNode::EvaluateLocalTransform(FbxTime pTime, FbxNode::EPivotSet, bool, bool) {
    return evaluation().local = detail::evaluateLocal(*this, pTime);
}

FBXSDK_NAMESPACE_END
