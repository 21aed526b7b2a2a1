// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A node's transform: its local channels as they are keyed, or its global transform, evaluated and decomposed frame
// by frame; and the two numberings of rotation orders.
#include "FbxSdk.h"

#include "GlobalSampler.h"
#include "PropertySampling.h"
#include "ReadScope.h"
#include "access/NodeGeometry.h"
#include "access/RotationOrders.h"
#include "calls/LastError.h"
#include "calls/MemoryLimit.h"

#include <array>
#include <cmath>
#include <optional>

namespace Tarnell::Fbx {

using detail::fail;
using detail::PropertySampler;
using detail::succeed;
using detail::toFloat;

namespace {

/// The local channels and the properties they come from.
struct LocalRow {
    fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3> fbxsdk::FbxNode::*property;
    TnFbxTransform::EFbxTransformChannelType firstChannel;
};
constexpr LocalRow kLocalChannels[] = {
    {&fbxsdk::FbxNode::LclTranslation, TnFbxTransform::kFbxTransformPositionX},
    {&fbxsdk::FbxNode::LclRotation, TnFbxTransform::kFbxTransformRotationX},
    {&fbxsdk::FbxNode::LclScaling, TnFbxTransform::kFbxTransformScaleX},
};

constexpr float kGimbalTolerance = 1e-5f;
constexpr float kHalfPi = 1.57079637f;
constexpr float kDegreesPerRadian = 57.2957802f;

struct EulerAngles {
    float x, y, z;
};

/// The angles, in radians, of a rotation matrix without scale, in single precision throughout.
EulerAngles eulerFromMatrix(const fbxsdk::FbxAMatrix& matrix) {
    const auto m = [&matrix](int row, int column) { return toFloat(matrix.Get(row, column)); };
    const float s = m(2, 1);
    if (std::fabs(std::fabs(s) - 1.0f) < kGimbalTolerance)
        return {std::fabs(s + 1.0f) < kGimbalTolerance ? kHalfPi : -kHalfPi, 0.0f, std::atan2(-m(1, 0), m(0, 0))};
    const float h = std::sqrt(m(2, 2) * m(2, 2) + m(2, 0) * m(2, 0));
    // kept: a vanishing h is its own factor; the result of atan2 is the same as long as the factor is positive
    const float k = std::fabs(h) > kGimbalTolerance ? 1.0f / h : h;
    return {std::atan2(-s, h), std::atan2(m(2, 0) * k, m(2, 2) * k), std::atan2(m(0, 1) * k, m(1, 1) * k)};
}

} // namespace

bool FbxSdk::getTransform(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                          TnFbxTransform& transform, fbxsdk::FbxAMatrix& geometric) {
    if (node == nullptr)
        return fail("no node to read a transform from");
    const detail::ReadScope scope(*this);
    transform.setName(node->GetName());
    if (!global) {
        fbxsdk::FbxEuler::EOrder order = fbxsdk::FbxEuler::eOrderXYZ;
        node->GetRotationOrder(fbxsdk::FbxNode::eSourcePivot, order);
        transform.setTransformRotationOrder(getRotationOrderConstant(order));
        setTransformValues(node, time, useSampleFPS, sampleFPS, &transform);
    } else if (time.getStartFrame() <= time.getEndFrame()) { // an empty range leaves the channels at their defaults
        storeGlobalTransform(time, *node, geometric, transform);
    }
    return scope.finish(succeed());
}

/// The samples in the world: made by a list for all of its nodes together, and by a single node now.
void FbxSdk::storeGlobalTransform(const TnFbxTime& time, fbxsdk::FbxNode& node, fbxsdk::FbxAMatrix& geometric,
                                  TnFbxTransform& transform) {
    detail::GlobalRuns* runs = mGlobals != nullptr ? mGlobals->take(node, geometric) : nullptr;
    std::optional<detail::GlobalSampler> alone;
    if (runs == nullptr) {
        alone.emplace(*this, time);
        alone->add(node, geometric);
        alone->sample(*mSamples);
        runs = alone->take(node, geometric);
    }
    int channel = TnFbxTransform::kFbxTransformPositionX;
    for (detail::SampleRun& run : *runs) {
        TnFbxChannel& target =
            *transform.getTransformChannel(static_cast<TnFbxTransform::EFbxTransformChannelType>(channel++));
        target.setValue(run.first());
        run.moveInto(target, time);
    }
}

bool FbxSdk::setTransformValues(fbxsdk::FbxNode* node, TnFbxTime& time, bool useSampleFPS, float sampleFPS,
                                TnFbxTransform* transform) {
    const detail::ReadScope scope(*this);
    if (node != nullptr && transform != nullptr) {
        PropertySampler properties = sampler(time, useSampleFPS, sampleFPS);
        for (const LocalRow& row : kLocalChannels)
            properties.readIntoTransform(*transform, row.firstChannel, node->*row.property);
    }
    return scope.finish(true);
}

bool FbxSdk::getGlobalPositionRotationScaleValues(TnFbxTime& time, fbxsdk::FbxNode* node, fbxsdk::FbxAMatrix& geometric,
                                                  std::vector<float>& positionX, std::vector<float>& positionY,
                                                  std::vector<float>& positionZ, std::vector<float>& rotationX,
                                                  std::vector<float>& rotationY, std::vector<float>& rotationZ,
                                                  std::vector<float>& scaleX, std::vector<float>& scaleY,
                                                  std::vector<float>& scaleZ) {
    const std::array<std::vector<float>*, 9> channels = {&positionX, &positionY, &positionZ, &rotationX, &rotationY,
                                                         &rotationZ, &scaleX,    &scaleY,    &scaleZ};
    for (std::vector<float>* channel : channels)
        channel->clear();
    if (node == nullptr || time.getStartFrame() > time.getEndFrame())
        return false;

    const detail::ReadScope scope(*this);
    // One float per frame and channel, whether they change or not.
    const detail::SampleRange frames = {time.getStartFrame(), time.getEndFrame()};
    if (!mSamples->take(frames, time.getFrameRate(), channels.size()))
        return scope.finish(true);
    detail::MemoryAccount unlimited;
    detail::SampleAccount account(unlimited);
    detail::GlobalSampler globals(*this, time);
    globals.add(*node, geometric);
    globals.sample(account);
    detail::GlobalRuns& runs = *globals.take(*node, geometric);
    for (std::size_t i = 0; i < channels.size(); ++i)
        *channels[i] = runs[i].takeAll();
    return true;
}

bool FbxSdk::extractMatrixRotation(fbxsdk::FbxAMatrix matrix, float& x, float& y, float& z) {
    const EulerAngles radians = eulerFromMatrix(matrix);
    x = radians.x * kDegreesPerRadian;
    y = radians.y * kDegreesPerRadian;
    z = radians.z * kDegreesPerRadian;
    return true;
}

TnFbxTransform::EFbxTransformRotationOrder FbxSdk::getRotationOrderConstant(fbxsdk::FbxEuler::EOrder order) {
    return detail::rotationOrderOf(order);
}

fbxsdk::FbxEuler::EOrder FbxSdk::getRotationOrderConstant(TnFbxTransform::EFbxTransformRotationOrder order) {
    return detail::rotationOrderOf(order);
}

bool FbxSdk::getGeometricTransformation(fbxsdk::FbxNode* node, fbxsdk::FbxVector4& translation,
                                        fbxsdk::FbxVector4& rotation, fbxsdk::FbxVector4& scaling) {
    if (node != nullptr) {
        translation = node->GetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot);
        rotation = node->GetGeometricRotation(fbxsdk::FbxNode::eSourcePivot);
        scaling = node->GetGeometricScaling(fbxsdk::FbxNode::eSourcePivot);
    }
    return true;
}

fbxsdk::FbxAMatrix FbxSdk::getGeometry(fbxsdk::FbxNode* node) {
    fbxsdk::FbxAMatrix matrix;
    if (node != nullptr) {
        matrix.SetT(node->GetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot));
        matrix.SetR(node->GetGeometricRotation(fbxsdk::FbxNode::eSourcePivot));
        matrix.SetS(node->GetGeometricScaling(fbxsdk::FbxNode::eSourcePivot));
    }
    return matrix;
}

bool FbxSdk::getDefaultAnimTransformation(fbxsdk::FbxNode* node, fbxsdk::FbxVector4& translation,
                                          fbxsdk::FbxVector4& rotation, fbxsdk::FbxVector4& scaling) {
    if (node == nullptr || mCurrentAnimStack == nullptr)
        return fail("no node or no animation stack to read curves from");
    const std::array<fbxsdk::FbxVector4*, 3> vectors = {&translation, &rotation, &scaling};
    for (fbxsdk::FbxAnimLayer* layer : detail::layersOf(mCurrentAnimStack)) {
        for (std::size_t row = 0; row < vectors.size(); ++row) {
            auto& property = node->*kLocalChannels[row].property;
            for (int i = 0; i < 3; ++i)
                if (auto* curve = property.GetCurve(layer, property.GetName(), detail::kComponents[i], false))
                    (*vectors[row])[i] = static_cast<double>(curve->GetValue());
        }
    }
    return succeed();
}

} // namespace Tarnell::Fbx
