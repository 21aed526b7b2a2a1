// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "PlacementWriting.h"

#include "Aim.h"
#include "Decomposition.h"
#include "Shear.h"
#include "access/RotationOrders.h"

#include <algorithm>
#include <string>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::faithful {

namespace {

using fbxsdk::FbxAMatrix;
using fbxsdk::FbxNode;
using Channel = TnFbxTransform::EFbxTransformChannelType;

constexpr auto kSource = FbxNode::eSourcePivot;
constexpr const char* kComponents[] = {"X", "Y", "Z"};
constexpr const char* kPivots = "pivots are not written: whether they apply to rotation or scale is not specified";

bool anySet(const Channels3& channels) {
    return std::any_of(
        channels.begin(), channels.end(),
        [](const TnFbxChannel* channel) { return changes(*channel) || staticValue(*channel) != 0.0; });
}

Vector valuesAt(const KeyWriter& keys, const Channels3& channels, std::int64_t frame, const FrameRange& range) {
    return {keys.valueAt(*channels[0], frame, range), keys.valueAt(*channels[1], frame, range),
            keys.valueAt(*channels[2], frame, range)};
}

/// Order and rotation of a node, both active.
void setOrder(FbxNode& node, RotationOrder order, const NodeAxes& axes) {
    node.SetRotationOrder(kSource, detail::rotationOrderOf(order));
    if (axes.turn != nullptr) {
        node.SetPostRotation(kSource, *axes.turn);
        node.SetRotationActive(true);
    }
    detail::enforceRotationOrder(node);
}

/// Three numbers for each frame of a range, as a property has them.
class FrameVectors {
public:
    void add(const Vector& values) { mValues.push_back(values); }
    void write(KeyWriter& keys, fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3>& property, const FrameRange& range) const {
        property.Set(fbxsdk::FbxDouble3(mValues[0][0], mValues[0][1], mValues[0][2]));
        for (std::size_t i = 0; i < 3; ++i) {
            keys.writeKeys(
                property, kComponents[i], range,
                [&](std::int64_t frame) { return mValues[static_cast<std::size_t>(frame - range.first)][i]; });
        }
    }

private:
    std::vector<Vector> mValues;
};

/// The rotation and shear of an object, shared by two nodes: the upper rotates and stretches, the lower rotates.
void writeSkewed(KeyWriter& keys, TnFbxTransform& object, FbxNode& upper, FbxNode& lower) {
    const Channels3 rotation = channelsFrom(object, TnFbxTransform::kFbxTransformRotationX);
    const Channels3 skew = channelsFrom(object, TnFbxTransform::kFbxTransformSkewX);
    std::vector<const TnFbxChannel*> involved(rotation.begin(), rotation.end());
    involved.insert(involved.end(), skew.begin(), skew.end());
    const FrameRange range = keys.rangeOf(involved);
    const RotationOrder order = object.getTransformRotationOrder();
    FrameVectors upperAngles, stretches, lowerAngles;
    FbxAMatrix basis;
    Vector lastUpper{}, lastLower{};
    for (std::int64_t frame = range.first; frame <= range.last; ++frame) {
        const ShearParts shear = partsOfShear(valuesAt(keys, skew, frame, range), basis);
        basis = shear.basis;
        const FbxAMatrix turn = rotationOf(valuesAt(keys, rotation, frame, range), order) * shear.turn;
        lastUpper = anglesNear(turn, TnFbxTransform::kFbxRotationOrderXYZ, lastUpper);
        lastLower = anglesNear(shear.basis.Transpose(), order, lastLower);
        upperAngles.add(lastUpper);
        stretches.add(shear.stretch);
        lowerAngles.add(lastLower);
    }
    upperAngles.write(keys, upper.LclRotation, range);
    stretches.write(keys, upper.LclScaling, range);
    lowerAngles.write(keys, lower.LclRotation, range);
}

FbxAMatrix composed(const Vector& position, const FbxAMatrix& rotation, const Vector& scale, const Vector& skew) {
    FbxAMatrix shear;
    shear[1][0] = skew[0];
    shear[2][0] = skew[1];
    shear[2][1] = skew[2];
    FbxAMatrix matrix = rotation * shear;
    for (int axis = 0; axis < 3; ++axis) {
        for (int component = 0; component < 3; ++component)
            matrix[axis][component] *= scale[static_cast<std::size_t>(axis)];
        matrix[3][axis] = position[static_cast<std::size_t>(axis)];
    }
    return matrix;
}

/// `valueOf(channels)` gives three numbers.
template <class ValueOf>
FbxAMatrix composedOf(TnFbxTransform& object, const ValueOf& valueOf) {
    const auto at = [&](Channel first) { return valueOf(channelsFrom(object, first)); };
    return composed(at(TnFbxTransform::kFbxTransformPositionX),
                    rotationOf(at(TnFbxTransform::kFbxTransformRotationX), object.getTransformRotationOrder()),
                    at(TnFbxTransform::kFbxTransformScaleX), at(TnFbxTransform::kFbxTransformSkewX));
}

} // namespace

const NodeAxes kSameAxes = {nullptr, {0, 1, 2}};
const NodeAxes kCameraAxes = {&kCameraTurn, {2, 1, 0}};
const NodeAxes kLightAxes = {&kLightTurn, {0, 2, 1}};

Channels3 channelsFrom(TnFbxTransform& object, Channel first) {
    const auto at = [&](int i) {
        return object.getTransformChannel(static_cast<Channel>(static_cast<int>(first) + i));
    };
    return {at(0), at(1), at(2)};
}

FbxAMatrix matrixAt(const KeyWriter& keys, TnFbxTransform& object, std::int64_t frame, const FrameRange& range) {
    return composedOf(
        object, [&](const Channels3& channels) { return valuesAt(keys, channels, frame, range); });
}

FbxAMatrix staticMatrixOf(const TnFbxTransform& object) {
    TnFbxTransform copy(object); // channels are returned by objects that may change
    return composedOf(copy, [](const Channels3& channels) -> Vector {
        return {static_cast<double>(channels[0]->getValue()), static_cast<double>(channels[1]->getValue()),
                static_cast<double>(channels[2]->getValue())};
    });
}

FbxNode& addPlacedNode(WrittenScene& scene, TnFbxTransform& object, const NodeAxes& axes) {
    KeyWriter& keys = scene.keys();
    if (anySet(channelsFrom(object, TnFbxTransform::kFbxTransformPivotX)))
        scene.warnings().add(object.getName(), kPivots);
    const bool skewed = anySet(channelsFrom(object, TnFbxTransform::kFbxTransformSkewX));
    FbxNode* upper = skewed ? &scene.addNode(object.getName() + " skew") : nullptr;
    FbxNode& node = scene.addNode(object.getName(), upper);
    setOrder(node, object.getTransformRotationOrder(), axes);
    keys.write((upper != nullptr ? *upper : node).LclTranslation,
               channelsFrom(object, TnFbxTransform::kFbxTransformPositionX));
    if (upper != nullptr) {
        node.SetTransformationInheritType(fbxsdk::FbxTransform::eInheritRSrs); // the scale above it skews
        writeSkewed(keys, object, *upper, node);
    } else {
        keys.write(node.LclRotation, channelsFrom(object, TnFbxTransform::kFbxTransformRotationX));
    }
    const Channels3 scale = channelsFrom(object, TnFbxTransform::kFbxTransformScaleX);
    keys.write(node.LclScaling, {scale[axes.scaleFrom[0]], scale[axes.scaleFrom[1]], scale[axes.scaleFrom[2]]});
    return node;
}

} // namespace Tarnell::Fbx::faithful
