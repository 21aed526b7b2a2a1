// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Global transforms, frame by frame, of all the nodes of a list together.
#pragma once

#include "SampleAccount.h"
#include "access/SampleRun.h"

#include "FbxSdk.h"

#include <fbxsdk.h>

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <unordered_map>
#include <vector>

namespace Tarnell::Fbx::detail {

/// Position, rotation (degrees) and scale, three channels each.
using GlobalRuns = std::array<SampleRun, 9>;

/// Evaluates nodes over a range of frames, and returns their samples in the order in which they were added.
///
/// The frames are taken in portions, and in each portion node after node: of a branch the platform then needs to
/// cache the transforms of one portion only, however long the range and however deep the tree. A static node, with
/// static ancestors, is evaluated once.
class GlobalSampler {
public:
    /// The range must not be inverted.
    GlobalSampler(FbxSdk& sdk, const TnFbxTime& range);
    ~GlobalSampler();
    GlobalSampler(const GlobalSampler&) = delete;
    GlobalSampler& operator=(const GlobalSampler&) = delete;

    /// Forgets the nodes that were added. What is known of their ancestors serves the next ones.
    void clear();

    /// Parents before their children. `geometric` is multiplied from the right.
    void add(fbxsdk::FbxNode& node, const fbxsdk::FbxAMatrix& geometric);

    /// Makes the samples of every node added. Once the account refuses some no more are made; runs are incomplete
    /// then.
    void sample(SampleAccount& account);

    /// The samples of the node that was added next, until the next call; null when the node is another one, or none.
    /// The first sample exists also in an incomplete run.
    GlobalRuns* take(fbxsdk::FbxNode& node, const fbxsdk::FbxAMatrix& geometric);

private:
    struct MovingNode;
    struct SampledNode {
        fbxsdk::FbxNode* node;
        std::unique_ptr<MovingNode> moving; // null: one sample is enough
    };
    struct Ancestry {
        bool isStill = true;
        int depth = 0;
    };

    Ancestry ancestryOf(const fbxsdk::FbxNode& node);
    fbxsdk::FbxTime timeOf(std::int64_t frame) const;
    bool begin(MovingNode& node, SampleAccount& account) const;
    bool goOn(MovingNode& node, std::span<const fbxsdk::FbxTime> times, SampleAccount& account);
    bool add(MovingNode& node, std::span<const fbxsdk::FbxAMatrix> matrices, SampleAccount& account) const;

    FbxSdk& mSdk;
    SampleRange mFrames;
    float mRate;
    std::vector<SampledNode> mNodes;
    std::size_t mNext = 0; // to be returned
    std::unique_ptr<MovingNode> mTaken;
    GlobalRuns mStillRuns; // of the node that was taken last, if it does not move
    std::unordered_map<const fbxsdk::FbxNode*, Ancestry> mAncestries; // of nodes with children
    std::vector<const fbxsdk::FbxNode*> mUnknown;
    int mDepth = 1;
    std::vector<fbxsdk::FbxAMatrix> mMatrices; // of some frames
};

} // namespace Tarnell::Fbx::detail
