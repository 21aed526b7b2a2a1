// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Local and global matrices of nodes at any time, with the cache that makes a node's cost independent of its depth.
//
//   local  = T Roff Rp Rpre R Rpost⁻¹ Rp⁻¹ Soff Sp S Sp⁻¹
//   global = the parent's, with the parent's scale entering as the node's inherit type says
#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <vector>

#include <fbxsdk/FbxAMatrix.h>
#include <fbxsdk/FbxTime.h>
#include <fbxsdk/FbxTransform.h>

#include "scene/TimeNumbers.h"

FBXSDK_NAMESPACE_BEGIN
class FbxNode;
namespace detail {

class ManagerData;

using Vector3 = std::array<double, 3>;
/// The images of the three axes, as the first rows of an FbxAMatrix hold them.
using Linear = std::array<Vector3, 3>;

/// A node's local transform at one time, decomposed.
struct LocalTransform {
    Linear rotation;     ///< Rpre R Rpost⁻¹
    Vector3 translation; ///< the translation column of the local matrix, pivots included
    Vector3 scaling;
};

/// What the children of a node inherit from its global transform.
struct GlobalTransform {
    Linear matrix;
    Vector3 translation;
    Linear rotation; ///< the pure rotation accumulated from the root
    Vector3 scaling; ///< the node's own local scaling
};

/// Global transforms of one node by the numbers of their times (see TimeNumbers).
///
/// A direct-mapped table that is indexed by the low bits of the number. An entry that is still needed (recent, and not
/// yet found) makes the table grow on a collision; any other is overwritten. So a host that evaluates node after node
/// at all times finds all of them, and one that takes the times in portions needs memory for a portion only.
class TransformCache {
public:
    [[nodiscard]] const GlobalTransform* find(std::uint64_t number);
    /// `newest` is the number that was given last; those too far behind are forgotten.
    void store(std::uint64_t number, const GlobalTransform& transform, std::uint64_t newest);
    /// Clears the cache and takes over the memory of another one. `generation` must differ from those of all caches
    /// that the memory belonged to, so that their entries are invalid.
    void reset(TransformCache&& memory, std::uint32_t generation);
    [[nodiscard]] std::size_t places() const { return mEntries.size(); }
    [[nodiscard]] std::size_t used() const { return mUsed; } ///< places that hold a transform

private:
    struct Entry {
        std::uint64_t number = 0;
        std::uint32_t generation = 0; ///< of the cache that stored it
        bool wasFound = false;
        GlobalTransform transform{};
    };
    [[nodiscard]] Entry& placeOf(std::uint64_t number) { return mEntries[number & (mEntries.size() - 1)]; }
    [[nodiscard]] bool isOurs(const Entry& entry) const { return entry.generation == mGeneration; }
    void grow();

    std::vector<Entry> mEntries; ///< a power of two of them, or none
    std::uint32_t mGeneration = 0;
    std::size_t mUsed = 0;
};

struct TransformBinding;

/// How a node moves in the world, with the nodes above it.
enum class Chain : std::uint8_t {
    unknown,
    isStatic,
    translated, ///< translations are animated, and nothing else
    animated
};

/// The evaluation state that a node owns.
struct NodeEvaluation {
    NodeEvaluation();
    ~NodeEvaluation();

    FbxAMatrix local, global; ///< what EvaluateLocalTransform and EvaluateGlobalTransform return references to

    std::uint64_t revision = UINT64_MAX;         ///< of the manager, when what follows was filled
    LocalTransform still{};                      ///< of the static values
    std::unique_ptr<TransformBinding> animation; ///< null when nothing animates the node itself
    FbxTransform::EInheritType inherit = FbxTransform::eInheritRrSs;

    Chain chain = Chain::unknown;
    bool hasStillAxes = false;   ///< all of what follows but the translation, of a node that is translated at most
    bool hasStillGlobal = false; ///< all of it, of a static one
    GlobalTransform stillGlobal{};

    TransformCache cache; ///< of a node that has children and moves
    // Links of the list of nodes with a cache, most recently used first.
    NodeEvaluation* nextUsed = nullptr;
    NodeEvaluation* previousUsed = nullptr;
};

/// The nodes of one manager that hold cached transforms, and the total number of their entries.
class EvaluationBudget {
public:
    /// The transforms of all caches, in entries of about 200 bytes each: 13 MiB.
    static constexpr std::size_t kMostPlaces = std::size_t{1} << 16U;

    TimeNumbers times;
    std::vector<FbxNode*> path; ///< of one evaluation; a member to reuse its memory

    [[nodiscard]] const GlobalTransform* find(NodeEvaluation& evaluation, std::uint64_t number);
    void store(NodeEvaluation& evaluation, std::uint64_t number, const GlobalTransform& transform);
    void release(NodeEvaluation& evaluation);
    [[nodiscard]] std::size_t places() const { return mPlaces; }

private:
    void use(NodeEvaluation& evaluation);
    void unlink(NodeEvaluation& evaluation);

    NodeEvaluation* mLatest = nullptr;
    NodeEvaluation* mOldest = nullptr;
    std::size_t mPlaces = 0;
    std::uint32_t mGeneration = 0; ///< that was given last
    TransformCache mSpare;         ///< of the node that was released last, reused by the next one
};

/// Created when a manager's first node is evaluated.
[[nodiscard]] EvaluationBudget& evaluationBudgetOf(ManagerData& manager);

/// The node's matrix relative to its parent, at the time (or of the static values at FBXSDK_TIME_INFINITE).
FbxAMatrix evaluateLocal(FbxNode& node, const FbxTime& time);
/// The node's global matrix.
void evaluateGlobal(FbxNode& node, const FbxTime& time, FbxAMatrix& matrix);

} // namespace detail
FBXSDK_NAMESPACE_END
