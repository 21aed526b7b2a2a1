// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curves, and the channels that every object has: position, rotation and scale of its node. Nulls have no others.
#include "CurveWriting.h"

#include "PropertySampling.h"
#include "calls/LastError.h"
#include "model/FrameArithmetic.h"

#include <algorithm>
#include <array>
#include <span>

#ifndef TARNELL_FBX_EXTERNAL_FBXSDK
#include <fbxsdk/extensions/CurveSamples.h>
#endif

namespace Tarnell::Fbx {

using detail::channelAfter;
using detail::ChannelWriter;
using detail::fail;
using detail::kComponents;
using detail::succeed;

namespace {

/// The memory of a key in the scene: its time, its value, and the index of its attributes. A channel whose samples are
/// all equal has one of them in memory, and as many keys as frames.
constexpr std::uint64_t kKeyBytes = 16;

bool mayAddKeys(const TnFbxTime& range, detail::MemoryAccount& memory) {
    const std::int64_t frames = detail::frameCount(range.getStartFrame(), range.getEndFrame());
    return memory.take(static_cast<std::uint64_t>(frames > 0 ? frames : 0) * kKeyBytes);
}

/// Linear keys; another platform than ours is given each.
void addLinearKeys(fbxsdk::FbxAnimCurve& curve, std::span<const fbxsdk::FbxTime> times, const float* values) {
#ifdef TARNELL_FBX_EXTERNAL_FBXSDK
    for (const fbxsdk::FbxTime& time : times)
        curve.KeySet(curve.KeyAdd(time), time, *values++, fbxsdk::FbxAnimCurveDef::eInterpolationLinear);
#else
    fbxsdk::extensions::addLinearKeys(curve, times.data(), values, static_cast<int>(times.size()));
#endif
}

void addKeys(fbxsdk::FbxAnimCurve& curve, const TnFbxChannel& channel, float scale, detail::FrameTimes& frameTimes) {
    const TnFbxTime range = channel.getTime();
    const std::int64_t count = detail::frameCount(range.getStartFrame(), range.getEndFrame());
    frameTimes.begin(range.getStartFrame(), static_cast<double>(range.getFrameRate()));
    std::array<float, detail::kMostTogether> values;
    frameTimes.inPortions(count, [&](std::int64_t frame, std::span<const fbxsdk::FbxTime> times) {
        channel.getAnimatedValues(static_cast<int>(frame), times.size(), values.data());
        for (std::size_t i = 0; i < times.size(); ++i)
            values[i] *= scale;
        addLinearKeys(curve, times, values.data());
        return true;
    });
}

using LocalProperty = fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3> fbxsdk::FbxNode::*;

struct LocalRow {
    LocalProperty property;
    TnFbxTransform::EFbxTransformChannelType firstChannel;
};

constexpr LocalRow kLocalRows[] = {
    {&fbxsdk::FbxNode::LclTranslation, TnFbxTransform::kFbxTransformPositionX},
    {&fbxsdk::FbxNode::LclRotation, TnFbxTransform::kFbxTransformRotationX},
    {&fbxsdk::FbxNode::LclScaling, TnFbxTransform::kFbxTransformScaleX},
};

fbxsdk::FbxDouble3 staticValues(const TnFbxTransform& transform, TnFbxTransform::EFbxTransformChannelType first) {
    fbxsdk::FbxDouble3 values;
    for (int i = 0; i < 3; ++i)
        values[i] = static_cast<double>(transform.getTransformValue(channelAfter(first, i)));
    return values;
}

} // namespace

bool detail::writeCurve(fbxsdk::FbxAnimCurve* curve, const TnFbxChannel* channel, float scale, FrameTimes& times,
                        MemoryAccount& memory) {
    if (curve == nullptr || channel == nullptr)
        return fail("no curve or no channel to write");
    curve->SetValue(channel->getValue(), /*pCurveNodeIndex*/ 0); // kept: not scaled, although the keys are
    if (channel->getAnimated()) {
        if (!mayAddKeys(channel->getTime(), memory))
            return fail(memory.describe("keys"));
        curve->KeyModifyBegin();
        addKeys(*curve, *channel, scale, times);
        curve->KeyModifyEnd();
    }
    return succeed();
}

bool FbxSdk::setCurveValues(fbxsdk::FbxAnimCurve* curve, TnFbxChannel* channel, float scale) const {
    return detail::writeCurve(curve, channel, scale, *mFrameTimes, *mMemory);
}

/// The layer to write into; null without a stack or layer.
fbxsdk::FbxAnimLayer* FbxSdk::currentLayer() const {
    return mCurrentAnimStack != nullptr ? mCurrentAnimStack->GetSrcObject<fbxsdk::FbxAnimLayer>(0) : nullptr;
}

// kept: skew and pivot are not written
bool FbxSdk::setTransformCurveValues(fbxsdk::FbxNode* node, TnFbxTransform* transform) {
    if (node == nullptr || transform == nullptr)
        return fail("no node or no transform to write");
    for (const LocalRow& row : kLocalRows)
        (node->*row.property).Set(staticValues(*transform, row.firstChannel));
    ChannelWriter writer(currentLayer(), *mFrameTimes, *mMemory);
    for (const LocalRow& row : kLocalRows) {
        for (int i = 0; i < 3; ++i) {
            TnFbxChannel* channel = transform->getTransformChannel(channelAfter(row.firstChannel, i));
            writer.key(node->*row.property, kComponents[i], channel);
        }
    }
    node->SetRotationOrder(fbxsdk::FbxNode::eSourcePivot,
                           getRotationOrderConstant(transform->getTransformRotationOrder()));
    return succeed();
}

bool FbxSdk::setNullCurveValues(fbxsdk::FbxNode* node, TnFbxNull* null) {
    fbxsdk::FbxNull* target = node != nullptr ? node->GetNull() : nullptr;
    if (target == nullptr || null == nullptr)
        return fail("no node with a null, or no null to write");
    if (!setTransformCurveValues(node, null))
        return false;
    switch (null->getNullLookType()) {
    case TnFbxNull::kFbxNullLookNone:
        target->Look.Set(fbxsdk::FbxNull::eNone);
        break;
    case TnFbxNull::kFbxNullLookCross:
        target->Look.Set(fbxsdk::FbxNull::eCross);
        break;
    default: // a number that is no look: the null keeps its look
        break;
    }
    target->Size.Set(static_cast<double>(null->getNullSize()));
    return succeed();
}

} // namespace Tarnell::Fbx
