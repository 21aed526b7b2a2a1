// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Global transforms, frame by frame: evaluated by the platform, decomposed here.
#include "GlobalSampler.h"

#include "NodeGeometry.h"
#include "PropertySampling.h"
#include "model/SameBits.h"

#include <algorithm>
#include <cstring>

namespace Tarnell::Fbx {

using detail::GlobalRuns;
using detail::GlobalSampler;
using detail::toFloat;

namespace {

/// Directional and spot lights shine along an axis of their own that is not the node's.
bool shinesAlongAnAxis(fbxsdk::FbxNode& node) {
    auto* light = fbxsdk::FbxCast<fbxsdk::FbxLight>(node.GetNodeAttribute());
    if (light == nullptr)
        return false;
    const int type = detail::enumNumber(light->LightType);
    return type == fbxsdk::FbxLight::eDirectional || type == fbxsdk::FbxLight::eSpot;
}

fbxsdk::FbxAMatrix lightAxisTurn() {
    fbxsdk::FbxAMatrix turn;
    turn.SetR(fbxsdk::FbxVector4(-90.0, 0.0, 0.0, 1.0));
    return turn;
}

/// Whether anything animates the property on any layer of any stack.
bool hasSources(const fbxsdk::FbxProperty& property) { return property.GetSrcObjectCount() > 0; }

bool isAnimated(const fbxsdk::FbxNode& node) {
    return hasSources(node.LclTranslation) || hasSources(node.LclRotation) || hasSources(node.LclScaling);
}

/// Position, rotation in degrees and scale, as the nine channels store them.
using Placement = std::array<float, 9>;

/// Decomposes matrices. A motion without rotation costs little: rotation and scale of the previous matrix are reused
/// while the first three rows are equal.
class Decomposition {
public:
    explicit Decomposition(FbxSdk& sdk) : mSdk(sdk) {}

    const Placement& of(const fbxsdk::FbxAMatrix& matrix) {
        const fbxsdk::FbxVector4 t = matrix.GetT();
        // kept: an exactly zero translation selects the decomposition; they differ near gimbal lock
        const bool atOrigin = t[0] == 0.0 && t[1] == 0.0 && t[2] == 0.0;
        const auto* elements = static_cast<const double*>(matrix);
        const bool isTurned = !std::equal(mAxes.begin(), mAxes.end(), elements,
                                          [](double a, double b) { return detail::haveSameBits(a, b); });
        if (!mHasLast || atOrigin != mAtOrigin || isTurned) {
            std::memcpy(mAxes.data(), elements, sizeof mAxes);
            mAtOrigin = atOrigin;
            mHasLast = true;
            turnAndScale(matrix);
        }
        for (int i = 0; i < 3; ++i)
            mPlacement[static_cast<std::size_t>(i)] = toFloat(t[i]);
        return mPlacement;
    }

private:
    void turnAndScale(const fbxsdk::FbxAMatrix& matrix) {
        if (mAtOrigin)
            mSdk.extractMatrixRotation(matrix, mPlacement[3], mPlacement[4], mPlacement[5]);
        else
            store(matrix.GetR(), 3);
        store(matrix.GetS(), 6);
    }

    void store(const fbxsdk::FbxVector4& vector, std::size_t firstChannel) {
        for (int i = 0; i < 3; ++i)
            mPlacement[firstChannel + static_cast<std::size_t>(i)] = toFloat(vector[i]);
    }

    FbxSdk& mSdk;
    std::array<double, 12> mAxes{}; // the first three rows
    bool mAtOrigin = false;
    bool mHasLast = false;
    Placement mPlacement{};
};

} // namespace

struct GlobalSampler::MovingNode {
    MovingNode(FbxSdk& sdk, fbxsdk::FbxNode& sampled, const fbxsdk::FbxAMatrix& offset)
        : node(sampled), isTurned(shinesAlongAnAxis(sampled)), geometric(offset), decomposition(sdk) {}

    const Placement& at(const fbxsdk::FbxTime& moment) { return of(globalTransform(node, moment)); }

    /// The placement that the node's global matrix gives.
    const Placement& of(const fbxsdk::FbxAMatrix& matrix) {
        static const fbxsdk::FbxAMatrix turn = lightAxisTurn();
        return decomposition.of(isTurned ? matrix * turn * geometric : matrix * geometric);
    }

    fbxsdk::FbxNode& node;
    bool isTurned;
    fbxsdk::FbxAMatrix geometric;
    Decomposition decomposition;
    GlobalRuns runs;
    std::size_t spreadCount = 0; // of runs that take memory for every frame
};

GlobalSampler::GlobalSampler(FbxSdk& sdk, const TnFbxTime& range) : mSdk(sdk), mRate(range.getFrameRate()) {
    mFrames.include(range.getStartFrame(), range.getEndFrame());
}

GlobalSampler::~GlobalSampler() = default;

void GlobalSampler::add(fbxsdk::FbxNode& node, const fbxsdk::FbxAMatrix& geometric) {
    const Ancestry ancestry = ancestryOf(node);
    mDepth = std::max(mDepth, ancestry.depth);
    const bool moves = !ancestry.isStill && mFrames.first < mFrames.last;
    mNodes.push_back({&node, moves ? std::make_unique<MovingNode>(mSdk, node, geometric) : nullptr});
}

/// Only animation by curves is evaluated, not other drivers of a node such as constraints.
GlobalSampler::Ancestry GlobalSampler::ancestryOf(const fbxsdk::FbxNode& node) {
    std::vector<const fbxsdk::FbxNode*> unknown;
    Ancestry ancestry;
    for (const fbxsdk::FbxNode* each = &node; each != nullptr; each = each->GetParent()) {
        if (const auto known = mAncestries.find(each); known != mAncestries.end()) {
            ancestry = known->second;
            break;
        }
        unknown.push_back(each);
    }
    for (auto each = unknown.rbegin(); each != unknown.rend(); ++each) {
        ancestry = {ancestry.isStill && !isAnimated(**each), ancestry.depth + 1};
        mAncestries.emplace(*each, ancestry);
    }
    return ancestry;
}

fbxsdk::FbxTime GlobalSampler::timeOf(std::int64_t frame) const {
    fbxsdk::FbxTime time;
    time.SetSecondDouble(static_cast<double>(frame) / static_cast<double>(mRate));
    return time;
}

/// Makes the first sample; returns whether there is memory for the others.
bool GlobalSampler::begin(MovingNode& node, SampleAccount& account) const {
    const Placement& first = node.at(timeOf(mFrames.first));
    for (std::size_t i = 0; i < node.runs.size(); ++i) {
        node.runs[i].begin(static_cast<std::size_t>(frameCount(mFrames.first, mFrames.last)));
        node.runs[i].add(first[i]);
    }
    if (account.take(mFrames, mRate, /*channelCount*/ 1))
        return true;
    account.take(mFrames, mRate, node.runs.size() - 1); // how many will change is not known: at most
    return false;
}

/// Adds a sample; returns whether there is memory for it.
bool GlobalSampler::add(MovingNode& node, const fbxsdk::FbxAMatrix& matrix, SampleAccount& account) const {
    const Placement& placement = node.of(matrix);
    for (std::size_t i = 0; i < placement.size(); ++i) {
        SampleRun& run = node.runs[i];
        // The memory of the first channel that changes is reserved already.
        if (run.spreadsWith(placement[i]) && node.spreadCount++ > 0 &&
            !account.take(mFrames, mRate, /*channelCount*/ 1)) {
            account.take(mFrames, mRate, placement.size() - node.spreadCount);
            return false;
        }
        run.add(placement[i]);
    }
    return true;
}

/// Continues by some frames; returns whether there is memory for more.
bool GlobalSampler::goOn(MovingNode& node, std::span<const fbxsdk::FbxTime> times, SampleAccount& account) const {
    std::array<fbxsdk::FbxAMatrix, 64> matrices;
    while (!times.empty()) {
        const std::size_t count = std::min(matrices.size(), times.size());
        globalTransforms(node.node, times.first(count), matrices.data());
        times = times.subspan(count);
        for (std::size_t i = 0; i < count; ++i)
            if (!add(node, matrices[i], account))
                return false;
    }
    return true;
}

void GlobalSampler::sample(SampleAccount& account) {
    std::vector<MovingNode*> moving;
    for (const SampledNode& node : mNodes)
        if (node.moving && begin(*node.moving, account))
            moving.push_back(node.moving.get());
    if (account.exceeded())
        return;

    // Only the transforms of a branch over one portion of the frames have to be cached.
    constexpr std::int64_t kMostRemembered = 1 << 15;
    constexpr std::int64_t kMostFrames = 1024;
    const std::int64_t portion = std::clamp<std::int64_t>(kMostRemembered / mDepth, 1, kMostFrames);
    std::vector<fbxsdk::FbxTime> times;
    for (std::int64_t next = std::int64_t{mFrames.first} + 1; next <= mFrames.last && !moving.empty();) {
        times.clear();
        for (const std::int64_t end = next + portion; next < end && next <= mFrames.last; ++next)
            times.push_back(timeOf(next));
        for (MovingNode* node : moving)
            if (!goOn(*node, times, account))
                return;
    }
    for (const MovingNode* node : moving)
        if (node->spreadCount == 0)
            account.giveBack(mFrames);
}

GlobalRuns* GlobalSampler::take(fbxsdk::FbxNode& node, const fbxsdk::FbxAMatrix& geometric) {
    if (mNext >= mNodes.size() || mNodes[mNext].node != &node)
        return nullptr;
    mTaken = std::move(mNodes[mNext++].moving);
    if (!mTaken) {
        mTaken = std::make_unique<MovingNode>(mSdk, node, geometric);
        const Placement& placement = mTaken->at(timeOf(mFrames.first));
        for (std::size_t i = 0; i < placement.size(); ++i) {
            mTaken->runs[i].begin(static_cast<std::size_t>(frameCount(mFrames.first, mFrames.last)));
            mTaken->runs[i].setConstant(placement[i]);
        }
    }
    return &mTaken->runs;
}

} // namespace Tarnell::Fbx
