// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Placing.h"

#include <cmath>
#include <cstddef>

namespace tool {
namespace {

using Tarnell::Fbx::TnFbxTransform;

/// Axes in the order of rotation, by the library's numbers.
constexpr std::array<std::array<int, 3>, 6> kTurns = {
    {{0, 1, 2}, {0, 2, 1}, {1, 0, 2}, {1, 2, 0}, {2, 0, 1}, {2, 1, 0}}};

FbxAMatrix rotation(const TnFbxTransform& object, const FbxVector4& angles) {
    FbxAMatrix turned;
    for (const int axis : kTurns[static_cast<std::size_t>(object.getTransformRotationOrder())]) {
        FbxVector4 angle(0.0, 0.0, 0.0);
        angle[axis] = angles[axis];
        FbxAMatrix turn;
        turn.SetR(angle);
        turned = turn * turned;
    }
    return turned;
}

} // namespace

FbxAMatrix placeAt(const TnFbxTransform& object, double frame) {
    const auto vectorAt = [&](TnFbxTransform::EFbxTransformChannelType first) {
        FbxVector4 vector(0.0, 0.0, 0.0);
        for (int i = 0; i < 3; ++i) {
            const auto channel = static_cast<TnFbxTransform::EFbxTransformChannelType>(static_cast<int>(first) + i);
            vector[i] = static_cast<double>(object.getTransformValueAt(channel, static_cast<float>(frame)));
        }
        return vector;
    };
    const FbxVector4 scale = vectorAt(TnFbxTransform::kFbxTransformScaleX);
    const FbxVector4 skew = vectorAt(TnFbxTransform::kFbxTransformSkewX);
    // Rows are the images of the axes.
    FbxAMatrix inner;
    inner[0][0] = scale[0];
    inner[1][0] = skew[0] * scale[1];
    inner[1][1] = scale[1];
    inner[2][0] = skew[1] * scale[2];
    inner[2][1] = skew[2] * scale[2];
    inner[2][2] = scale[2];
    FbxAMatrix place = rotation(object, vectorAt(TnFbxTransform::kFbxTransformRotationX)) * inner;
    place.SetT(vectorAt(TnFbxTransform::kFbxTransformPositionX));
    return place;
}

double lengthOf(const FbxVector4& vector) { return std::hypot(vector[0], vector[1], vector[2]); }

} // namespace tool
