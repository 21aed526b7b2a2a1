// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A node's transform: its local channels as they are keyed, or its place in the world, evaluated and decomposed frame
// by frame; and the two numberings of rotation orders.
#include "FbxSdk.h"

#include "NodeGeometry.h"
#include "PropertySampling.h"
#include "access/RotationOrders.h"
#include "calls/LastError.h"

#include <array>
#include <cmath>

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
    if (std::fabs(std::fabs(s) - 1.0f) < kGimbalTolerance) {
        return {std::fabs(s + 1.0f) < kGimbalTolerance ? kHalfPi : -kHalfPi, 0.0f, std::atan2(-m(1, 0), m(0, 0))};
    }
    const float h = std::sqrt(m(2, 2) * m(2, 2) + m(2, 0) * m(2, 0));
    // kept: a vanishing h is its own factor; atan2 does not mind as long as the factor is positive
    const float k = std::fabs(h) > kGimbalTolerance ? 1.0f / h : h;
    return {std::atan2(-s, h), std::atan2(m(2, 0) * k, m(2, 2) * k), std::atan2(m(0, 1) * k, m(1, 1) * k)};
}

/// Directional and spot lights shine along an axis of their own that is not the node's.
bool shinesAlongAnAxis(fbxsdk::FbxNode& node) {
    auto* light = fbxsdk::FbxCast<fbxsdk::FbxLight>(node.GetNodeAttribute());
    if (light == nullptr) {
        return false;
    }
    const int type = detail::enumNumber(light->LightType);
    return type == fbxsdk::FbxLight::eDirectional || type == fbxsdk::FbxLight::eSpot;
}

fbxsdk::FbxAMatrix lightAxisTurn() {
    fbxsdk::FbxAMatrix turn;
    turn.SetR(fbxsdk::FbxVector4(-90.0, 0.0, 0.0, 1.0));
    return turn;
}

/// Position, rotation in degrees and scale, as the nine channels store them.
using Placement = std::array<float, 9>;

Placement decompose(FbxSdk& sdk, const fbxsdk::FbxAMatrix& matrix) {
    const fbxsdk::FbxVector4 t = matrix.GetT();
    const fbxsdk::FbxVector4 s = matrix.GetS();
    float x = 0.0f, y = 0.0f, z = 0.0f;
    // kept: which decomposition is used hangs on an exactly zero translation; they differ near gimbal lock
    if (t[0] == 0.0 && t[1] == 0.0 && t[2] == 0.0) {
        sdk.extractMatrixRotation(matrix, x, y, z);
    } else {
        const fbxsdk::FbxVector4 r = matrix.GetR();
        x = toFloat(r[0]);
        y = toFloat(r[1]);
        z = toFloat(r[2]);
    }
    return {toFloat(t[0]), toFloat(t[1]), toFloat(t[2]), x, y, z, toFloat(s[0]), toFloat(s[1]), toFloat(s[2])};
}

} // namespace

bool FbxSdk::getTransform(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                          TnFbxTransform& transform, fbxsdk::FbxAMatrix& geometric) {
    if (node == nullptr) {
        return fail("no node to read a transform from");
    }
    transform.setName(node->GetName());
    if (!global) {
        fbxsdk::FbxEuler::EOrder order = fbxsdk::FbxEuler::eOrderXYZ;
        node->GetRotationOrder(fbxsdk::FbxNode::eSourcePivot, order);
        transform.setTransformRotationOrder(getRotationOrderConstant(order));
        setTransformValues(node, time, useSampleFPS, sampleFPS, &transform);
        return succeed();
    }

    std::array<std::vector<float>, 9> values;
    if (getGlobalPositionRotationScaleValues(time, node, geometric, values[0], values[1], values[2], values[3],
                                             values[4], values[5], values[6], values[7], values[8])) {
        for (int i = 0; i < 9; ++i) {
            const auto channel = detail::channelAfter(TnFbxTransform::kFbxTransformPositionX, i);
            std::vector<float>& samples = values[static_cast<std::size_t>(i)];
            transform.setTransformValue(channel, samples.front());
            transform.setTransformValueAt(channel, time, std::move(samples));
        }
    }
    return succeed(); // an empty range leaves the channels at their defaults
}

bool FbxSdk::setTransformValues(fbxsdk::FbxNode* node, TnFbxTime& time, bool useSampleFPS, float sampleFPS,
                                TnFbxTransform* transform) {
    if (node != nullptr && transform != nullptr) {
        PropertySampler properties = sampler(time, useSampleFPS, sampleFPS);
        for (const LocalRow& row : kLocalChannels) {
            properties.readIntoTransform(*transform, row.firstChannel, node->*row.property);
        }
    }
    return true;
}

bool FbxSdk::getGlobalPositionRotationScaleValues(TnFbxTime& time, fbxsdk::FbxNode* node, fbxsdk::FbxAMatrix& geometric,
                                                  std::vector<float>& positionX, std::vector<float>& positionY,
                                                  std::vector<float>& positionZ, std::vector<float>& rotationX,
                                                  std::vector<float>& rotationY, std::vector<float>& rotationZ,
                                                  std::vector<float>& scaleX, std::vector<float>& scaleY,
                                                  std::vector<float>& scaleZ) {
    const std::array<std::vector<float>*, 9> channels = {&positionX, &positionY, &positionZ, &rotationX, &rotationY,
                                                         &rotationZ, &scaleX,    &scaleY,    &scaleZ};
    for (std::vector<float>* channel : channels) {
        channel->clear();
    }
    if (node == nullptr || time.getStartFrame() > time.getEndFrame()) {
        return false;
    }

    const std::int64_t first = time.getStartFrame();
    const std::int64_t asked = detail::frameCount(time.getStartFrame(), time.getEndFrame());
    const std::int64_t count = detail::takeSamples(mSamplesLeft, asked, /*channelCount*/ 9) ? asked : 1;
    for (std::vector<float>* channel : channels) {
        channel->reserve(static_cast<std::size_t>(count));
    }

    const double rate = static_cast<double>(time.getFrameRate());
    const bool turned = shinesAlongAnAxis(*node);
    const fbxsdk::FbxAMatrix turn = lightAxisTurn();
    for (std::int64_t frame = first; frame < first + count; ++frame) {
        fbxsdk::FbxTime moment;
        moment.SetSecondDouble(static_cast<double>(frame) / rate);
        fbxsdk::FbxAMatrix matrix = detail::globalTransform(*node, moment);
        if (turned) {
            matrix = matrix * turn;
        }
        const Placement placement = decompose(*this, matrix * geometric);
        for (std::size_t i = 0; i < channels.size(); ++i) {
            channels[i]->push_back(placement[i]);
        }
    }
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
    if (node == nullptr || mCurrentAnimStack == nullptr) {
        return fail("no node or no animation stack to read curves from");
    }
    const std::array<fbxsdk::FbxVector4*, 3> vectors = {&translation, &rotation, &scaling};
    for (fbxsdk::FbxAnimLayer* layer : detail::layersOf(mCurrentAnimStack)) {
        for (std::size_t row = 0; row < vectors.size(); ++row) {
            auto& property = node->*kLocalChannels[row].property;
            for (int i = 0; i < 3; ++i) {
                if (auto* curve = property.GetCurve(layer, property.GetName(), detail::kComponents[i], false)) {
                    (*vectors[row])[i] = static_cast<double>(curve->GetValue());
                }
            }
        }
    }
    return succeed();
}

} // namespace Tarnell::Fbx
