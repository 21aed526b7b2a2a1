// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The sampler: the sum of a property's curves over all layers of the current stack, frame by frame.
#include "PropertySampling.h"

#include "FbxSdk.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <functional>
#include <span>

#ifndef TARNELL_FBX_EXTERNAL_FBXSDK
#include <fbxsdk/extensions/CurveSamples.h>
#endif

namespace Tarnell::Fbx {

using detail::PropertySampler;

namespace {

/// Whether the curve passes a key, with equal adjacent values, without a slope: only user tangents give one.
bool isFlatAt(const fbxsdk::FbxAnimCurve& curve, int key) {
    constexpr int kSlopesOfUsers =
        fbxsdk::FbxAnimCurveDef::eTangentUser | fbxsdk::FbxAnimCurveDef::eTangentGenericBreak;
    return curve.KeyGetInterpolation(key) != fbxsdk::FbxAnimCurveDef::eInterpolationCubic ||
           (curve.KeyGetTangentMode(key) & kSlopesOfUsers) == 0;
}

/// Whether every key of a curve has the same value and no slope. Then it has that value everywhere, except for the sign
/// of a zero.
bool isLevel(const fbxsdk::FbxAnimCurve& curve) {
    const int keyCount = curve.KeyGetCount();
    if (keyCount < 2)
        return true;
    const float value = curve.KeyGetValue(0);
    if (!std::isfinite(value) || (value == 0.0f && std::signbit(value)))
        return false;
    const auto hasTheValue = [&curve, value](int key) {
        return curve.KeyGetValue(key) == value && std::signbit(curve.KeyGetValue(key)) == std::signbit(value);
    };
    for (int key = 0; key < keyCount; ++key)
        if (!hasTheValue(key) || !isFlatAt(curve, key))
            return false;
    return true;
}

/// The curve's values at the times; another platform than ours is asked for each.
void evaluateEach(fbxsdk::FbxAnimCurve& curve, std::span<const fbxsdk::FbxTime> times, float* values) {
#ifdef TARNELL_FBX_EXTERNAL_FBXSDK
    int lastKey = 0; // the next sample is close to it
    std::transform(times.begin(), times.end(), values,
                   [&](const fbxsdk::FbxTime& time) { return curve.Evaluate(time, &lastKey); });
#else
    fbxsdk::extensions::evaluate(curve, times.data(), static_cast<int>(times.size()), values);
#endif
}

} // namespace

std::vector<fbxsdk::FbxAnimLayer*> detail::layersOf(fbxsdk::FbxAnimStack* stack) {
    std::vector<fbxsdk::FbxAnimLayer*> layers;
    if (stack == nullptr)
        return layers;
    const fbxsdk::FbxCriteria isLayer = fbxsdk::FbxCriteria::ObjectType(fbxsdk::FbxAnimLayer::ClassId);
    const int count = stack->GetSrcObjectCount(isLayer);
    for (int i = 0; i < count; ++i)
        if (auto* layer = fbxsdk::FbxCast<fbxsdk::FbxAnimLayer>(stack->GetSrcObject(isLayer, i)))
            layers.push_back(layer);
    return layers;
}

PropertySampler::PropertySampler(fbxsdk::FbxScene* scene, fbxsdk::FbxAnimStack* stack, const TnFbxTime& requested,
                                 bool useSampleRate, float sampleRate, SampleAccount& account, FrameTimes& frameTimes)
    : mTimeModeScope(scene), mLayers(layersOf(stack)),
      mTimeMode(scene != nullptr ? scene->GetGlobalSettings().GetTimeMode() : fbxsdk::FbxTime::eDefaultMode),
      mRate(toFloat(fbxsdk::FbxTime::GetFrameRate(mTimeMode))), mRequested(requested),
      mConvert(useSampleRate && sampleRate > 0.0f), mSampleRate(sampleRate), mAccount(account),
      mFrameTimes(frameTimes) {}

void PropertySampler::collectCurves(const fbxsdk::FbxProperty& property, const char* component) {
    mCurves.clear();
    fbxsdk::FbxProperty animated = property;
    const fbxsdk::FbxString name = property.GetName();
    for (fbxsdk::FbxAnimLayer* layer : mLayers)
        if (fbxsdk::FbxAnimCurve* curve = animated.GetCurve(layer, name, component, /*pCreate*/ false))
            mCurves.push_back(curve);
}

detail::SampleRange PropertySampler::keyedRange() const {
    SampleRange range;
    for (const fbxsdk::FbxAnimCurve* curve : mCurves) {
        const int keyCount = curve->KeyGetCount();
        if (keyCount < 1)
            continue;
        int first = narrowFrame(curve->KeyGetTime(0).GetFrameCount(mTimeMode));
        int last = narrowFrame(curve->KeyGetTime(keyCount - 1).GetFrameCount(mTimeMode));
        if (mConvert) {
            first = convertFrame(first, mRate, mSampleRate);
            last = convertFrame(last, mRate, mSampleRate);
        }
        range.include(std::min(first, mRequested.getStartFrame()), std::max(last, mRequested.getEndFrame()));
    }
    return range;
}

float PropertySampler::valueAt(const fbxsdk::FbxTime& moment) const {
    float value = 0.0f;
    for (fbxsdk::FbxAnimCurve* curve : mCurves)
        value += curve->Evaluate(moment);
    return value;
}

bool PropertySampler::isConstant() const {
    return std::all_of(
        mCurves.begin(), mCurves.end(), [](const fbxsdk::FbxAnimCurve* curve) { return isLevel(*curve); });
}

/// The samples of a range that fits an `int`; false when there is not enough memory for them.
bool PropertySampler::sampleFrames(const SampleRange& range) {
    const std::int64_t count = frameCount(range.first, range.last);
    mSamples.begin(static_cast<std::size_t>(count));
    mFrameTimes.begin(range.first,
                      static_cast<double>(mRate)); // kept: the scene's rate, also of frames converted to another one
    if (isConstant()) {
        mSamples.setConstant(valueAt(mFrameTimes.at(range.first)));
        return true;
    }
    if (!mAccount.take(range, mRate, /*channelCount*/ 1))
        return false;
    std::array<float, kMostTogether> sums, values;
    mFrameTimes.inPortions(count, [&](std::int64_t /*frame*/, std::span<const fbxsdk::FbxTime> times) {
        sums.fill(0.0f);
        for (fbxsdk::FbxAnimCurve* curve : mCurves) {
            evaluateEach(*curve, times, values.data());
            std::transform(sums.begin(), sums.begin() + times.size(), values.begin(), sums.begin(), std::plus<>());
        }
        mSamples.add(sums.data(), times.size());
        return true;
    });
    if (mSamples.isOneValue())
        mAccount.giveBack(range);
    return true;
}

bool PropertySampler::sample(const fbxsdk::FbxProperty& property, const char* component) {
    mTime.initTime();
    mSamples.begin(0);
    collectCurves(property, component);
    const SampleRange range = keyedRange();
    if (!range.isAnimation())
        return false;

    if (frameCount(range.first, range.last) > 0 && !sampleFrames(range))
        return false;
    mTime = sampledTime(range, mRate);
    return true;
}

void PropertySampler::readIntoTransform(TnFbxTransform& transform,
                                        TnFbxTransform::EFbxTransformChannelType firstChannel,
                                        const fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3>& property) {
    const fbxsdk::FbxDouble3 value = property.Get();
    for (int i = 0; i < 3; ++i) {
        const auto channel = channelAfter(firstChannel, i);
        transform.setTransformValue(channel, toFloat(value[i]));
        sampleInto(transform, channel, property, kComponents[i]);
    }
}

detail::PropertySampler FbxSdk::sampler(const TnFbxTime& time, bool useSampleFPS, float sampleFPS) {
    return PropertySampler(mScene, mCurrentAnimStack, time, useSampleFPS, sampleFPS, *mSamples, *mFrameTimes);
}

} // namespace Tarnell::Fbx
