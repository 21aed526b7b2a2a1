// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Global transforms, frame by frame: evaluated by the platform, decomposed here.
#include "GlobalSampler.h"

#include "PropertySampling.h"
#include "access/FrameTimes.h"
#include "access/NodeGeometry.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstring>
#include <tuple>

namespace Tarnell::Fbx {

using detail::GlobalRuns;
using detail::GlobalSampler;
using detail::kMostTogether;
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

/// The first three rows of a matrix.
using Rows = std::array<double, 12>;

/// To the bit, as haveSameBits. Without leaving the loop early: so elements are compared several at a time.
bool areSame(const Rows& rows, const double* elements) {
    std::uint64_t different = 0;
    for (std::size_t i = 0; i < rows.size(); ++i)
        different |= std::bit_cast<std::uint64_t>(rows[i]) ^ std::bit_cast<std::uint64_t>(elements[i]);
    return different == 0;
}

bool isWithoutPerspective(const fbxsdk::FbxAMatrix& matrix) {
    return matrix.Get(0, 3) == 0.0 && matrix.Get(1, 3) == 0.0 && matrix.Get(2, 3) == 0.0;
}

/// Multiplies matrices by an offset. The first three rows of a product depend on all of the matrix but the amounts of
/// its translation.
class Offset {
public:
    explicit Offset(const fbxsdk::FbxAMatrix& offset) : mOffset(offset), mIsPlain(isWithoutPerspective(offset)) {}

    fbxsdk::FbxAMatrix product(const fbxsdk::FbxAMatrix& matrix) const { return matrix * mOffset; }

    /// Whether the first three rows of the product are the same, to the bit, as those for the last matrix for which
    /// this was false.
    bool keepsAxes(const fbxsdk::FbxAMatrix& matrix) {
        // The translation is multiplied by zero: its sign is the sign of a sum that is zero, infinities make it NaN.
        unsigned signs = 0;
        bool isFinite = true;
        for (int i = 0; i < 3; ++i) {
            signs = 2 * signs + (std::signbit(matrix.Get(3, i)) ? 1 : 0);
            isFinite &= std::isfinite(matrix.Get(3, i));
        }
        const auto* elements = static_cast<const double*>(matrix);
        if (mAreKnown && isFinite && signs == mSigns && areSame(mRows, elements) && matrix.Get(3, 3) == 1.0)
            return true;
        std::memcpy(mRows.data(), elements, sizeof mRows);
        mSigns = signs;
        mAreKnown = mIsPlain && isFinite && matrix.Get(3, 3) == 1.0;
        return false;
    }

    /// A coordinate of the product's translation.
    double translation(const fbxsdk::FbxAMatrix& matrix, int i) const {
        return matrix.Get(0, i) * mOffset.Get(3, 0) + matrix.Get(1, i) * mOffset.Get(3, 1) +
               matrix.Get(2, i) * mOffset.Get(3, 2) + matrix.Get(3, i) * mOffset.Get(3, 3);
    }

private:
    fbxsdk::FbxAMatrix mOffset;
    bool mIsPlain;
    bool mAreKnown = false;
    Rows mRows{};
    unsigned mSigns = 0;
};

/// Decomposes the matrices of a node with an offset. A motion without rotation costs little: rotation and scale of the
/// previous matrix are reused while the first three rows are equal.
class Decomposition {
public:
    Decomposition(FbxSdk& sdk, bool isTurned, const fbxsdk::FbxAMatrix& offset)
        : mSdk(sdk), mIsTurned(isTurned), mOffset(offset) {}

    /// The placement that the node's global matrix gives.
    const Placement& of(const fbxsdk::FbxAMatrix& matrix) {
        static const fbxsdk::FbxAMatrix turn = lightAxisTurn();
        if (mIsTurned)
            return ofProduct(mOffset.product(matrix * turn));
        if (!mOffset.keepsAxes(matrix))
            return ofProduct(mOffset.product(matrix));
        const std::array<double, 3> translation = {mOffset.translation(matrix, 0), mOffset.translation(matrix, 1),
                                                   mOffset.translation(matrix, 2)};
        return isAtOrigin(translation) == mAtOrigin ? place(translation) : ofProduct(mOffset.product(matrix));
    }

private:
    const Placement& ofProduct(const fbxsdk::FbxAMatrix& matrix) {
        const std::array<double, 3> translation = {matrix.Get(3, 0), matrix.Get(3, 1), matrix.Get(3, 2)};
        const auto* elements = static_cast<const double*>(matrix);
        const bool isTurned = !areSame(mRows, elements);
        if (!mHasLast || isAtOrigin(translation) != mAtOrigin || isTurned) {
            std::memcpy(mRows.data(), elements, sizeof mRows);
            mAtOrigin = isAtOrigin(translation);
            mHasLast = true;
            turnAndScale(matrix);
        }
        return place(translation);
    }

    // kept: an exactly zero translation selects the decomposition; they differ near gimbal lock
    static bool isAtOrigin(const std::array<double, 3>& t) { return t[0] == 0.0 && t[1] == 0.0 && t[2] == 0.0; }

    const Placement& place(const std::array<double, 3>& translation) {
        std::transform(translation.begin(), translation.end(), mPlacement.begin(), toFloat);
        return mPlacement;
    }

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
    bool mIsTurned;
    Offset mOffset;
    Rows mRows{}; // of the product that was decomposed last
    bool mAtOrigin = false;
    bool mHasLast = false;
    Placement mPlacement{};
};

} // namespace

struct GlobalSampler::MovingNode {
    MovingNode(FbxSdk& sdk, fbxsdk::FbxNode& sampled, const fbxsdk::FbxAMatrix& offset)
        : node(sampled), decomposition(sdk, shinesAlongAnAxis(sampled), offset) {}

    const Placement& at(const fbxsdk::FbxTime& moment) { return decomposition.of(globalTransform(node, moment)); }

    fbxsdk::FbxNode& node;
    Decomposition decomposition;
    GlobalRuns runs;
    std::size_t spreadCount = 0; // of runs that take memory for every frame
};

GlobalSampler::GlobalSampler(FbxSdk& sdk, const TnFbxTime& range) : mSdk(sdk), mRate(range.getFrameRate()) {
    mFrames.include(range.getStartFrame(), range.getEndFrame());
}

GlobalSampler::~GlobalSampler() = default;

void GlobalSampler::clear() {
    mNodes.clear();
    mNext = 0;
    mTaken.reset();
    mDepth = 1;
}

void GlobalSampler::add(fbxsdk::FbxNode& node, const fbxsdk::FbxAMatrix& geometric) {
    const Ancestry ancestry = ancestryOf(node);
    mDepth = std::max(mDepth, ancestry.depth);
    const bool moves = !ancestry.isStill && mFrames.first < mFrames.last;
    mNodes.push_back({&node, moves ? std::make_unique<MovingNode>(mSdk, node, geometric) : nullptr});
}

/// Only animation by curves is evaluated, not other drivers of a node such as constraints.
GlobalSampler::Ancestry GlobalSampler::ancestryOf(const fbxsdk::FbxNode& node) {
    mUnknown.clear();
    Ancestry ancestry;
    for (const fbxsdk::FbxNode* each = &node; each != nullptr; each = each->GetParent()) {
        if (const auto known = mAncestries.find(each); known != mAncestries.end()) {
            ancestry = known->second;
            break;
        }
        mUnknown.push_back(each);
    }
    for (auto each = mUnknown.rbegin(); each != mUnknown.rend(); ++each) {
        ancestry = {ancestry.isStill && !isAnimated(**each), ancestry.depth + 1};
        if ((*each)->GetChildCount() > 0)
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

/// Adds some samples, at most kMostTogether; returns whether there is memory for them.
bool GlobalSampler::add(MovingNode& node, std::span<const fbxsdk::FbxAMatrix> matrices, SampleAccount& account) const {
    std::array<std::array<float, kMostTogether>, std::tuple_size_v<Placement>> channels;
    for (std::size_t frame = 0; frame < matrices.size(); ++frame) {
        const Placement& placement = node.decomposition.of(matrices[frame]);
        for (std::size_t i = 0; i < channels.size(); ++i)
            channels[i][frame] = placement[i];
    }
    for (std::size_t i = 0; i < channels.size(); ++i) {
        SampleRun& run = node.runs[i];
        // The memory of the first channel that changes is reserved already.
        if (run.spreadsWith(channels[i].data(), matrices.size()) && node.spreadCount++ > 0 &&
            !account.take(mFrames, mRate, /*channelCount*/ 1)) {
            account.take(mFrames, mRate, channels.size() - node.spreadCount);
            return false;
        }
        run.add(channels[i].data(), matrices.size());
    }
    return true;
}

/// Continues by some frames; returns whether there is memory for more.
bool GlobalSampler::goOn(MovingNode& node, std::span<const fbxsdk::FbxTime> times, SampleAccount& account) {
    mMatrices.resize(kMostTogether);
    while (!times.empty()) {
        const std::size_t count = std::min(kMostTogether, times.size());
        globalTransforms(node.node, times.first(count), mMatrices.data());
        times = times.subspan(count);
        if (!add(node, std::span(mMatrices).first(count), account))
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
    if (mTaken)
        return &mTaken->runs;
    Decomposition decomposition(mSdk, shinesAlongAnAxis(node), geometric);
    const Placement& placement = decomposition.of(globalTransform(node, timeOf(mFrames.first)));
    for (std::size_t i = 0; i < placement.size(); ++i) {
        mStillRuns[i].begin(static_cast<std::size_t>(frameCount(mFrames.first, mFrames.last)));
        mStillRuns[i].setConstant(placement[i]);
    }
    return &mStillRuns;
}

} // namespace Tarnell::Fbx
