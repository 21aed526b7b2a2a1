// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Local and global matrices of nodes at any time, with the cache that makes a node's cost independent of its depth.
//
//   local  = T Roff Rp Rpre R Rpost⁻¹ Rp⁻¹ Soff Sp S Sp⁻¹
//   global = the parent's, with the parent's scale entering as the node's inherit type says
#pragma once

#include <cstdint>
#include <memory>
#include <vector>

#include <fbxsdk/FbxAMatrix.h>
#include <fbxsdk/FbxTime.h>

FBXSDK_NAMESPACE_BEGIN
class FbxNode;
namespace detail {

/// What a node's global transform hands on to its children.
struct GlobalTransform {
    FbxAMatrix matrix;
    FbxAMatrix rotation;            ///< the pure rotation accumulated from the root
    FbxVector4 scaling{1, 1, 1, 1}; ///< the node's own local scaling
};

struct TransformBinding;

/// The evaluation state that a node owns.
struct NodeEvaluation {
    NodeEvaluation();
    ~NodeEvaluation();

    FbxAMatrix local, global; ///< what EvaluateLocalTransform and EvaluateGlobalTransform return references to

    std::uint64_t revision = 0; ///< of the manager, when what follows was filled
    std::unique_ptr<TransformBinding> binding;
    enum class Chain : std::uint8_t { unknown, isStatic, animated };
    Chain chain = Chain::unknown;            ///< whether the node or any ancestor is animated
    std::vector<std::int64_t> times;         ///< ascending ticks
    std::vector<GlobalTransform> transforms; ///< one per time
    std::size_t cursor = 0;
    std::uint64_t lastUse = 0;
};

/// The nodes of one manager that hold cached transforms, and how many there are in all.
struct EvaluationBudget {
    std::vector<NodeEvaluation*> holders;
    std::size_t transforms = 0;
    std::uint64_t clock = 0;

    // The memory of the node that was released last, for the next one: most have as many transforms.
    std::vector<std::int64_t> spareTimes;
    std::vector<GlobalTransform> spareTransforms;

    std::vector<FbxNode*> path; ///< of one evaluation; here to keep its memory

    void release(NodeEvaluation& evaluation);
};

/// The node's matrix relative to its parent, at the time (or of the static values at FBXSDK_TIME_INFINITE).
FbxAMatrix evaluateLocal(FbxNode& node, const FbxTime& time);
/// The node's matrix in the world.
FbxAMatrix evaluateGlobal(FbxNode& node, const FbxTime& time);

} // namespace detail
FBXSDK_NAMESPACE_END
