// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The hand-written files of tests/data/sdk, read through the facade, and what tests compare of the objects.
#pragma once

#include "support/FacadeReads.h"
#include "support/SceneBuilders.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace Tarnell::Fbx::test {

using Samples = std::vector<float>;
using Names = std::vector<std::string>;

inline std::string fixture(const char* name) { return std::string(TARNELL_TEST_DATA "/sdk/") + name; }

/// Global transforms, points unchanged.
inline TnFbxReadInfo worldRead(const char* name) {
    TnFbxReadInfo info = localRead(fixture(name));
    info.setGlobalTransform(true);
    return info;
}

/// Meshes at a frame, their points unchanged.
inline TnFbxReadInfo readAtFrame(const char* name, float frame) {
    TnFbxReadInfo info = localRead(fixture(name));
    info.setFrame(frame);
    return info;
}

/// The static values of a channel and the two after it.
inline Samples vectorOf(const TnFbxTransform& object, TnFbxTransform::EFbxTransformChannelType first) {
    Samples vector;
    for (int i = 0; i < 3; ++i) {
        const auto channel = static_cast<TnFbxTransform::EFbxTransformChannelType>(first + i);
        vector.push_back(object.getTransformValue(channel));
    }
    return vector;
}
inline Samples positionOf(const TnFbxTransform& object) {
    return vectorOf(object, TnFbxTransform::kFbxTransformPositionX);
}
inline Samples rotationOf(const TnFbxTransform& object) {
    return vectorOf(object, TnFbxTransform::kFbxTransformRotationX);
}
inline Samples scaleOf(const TnFbxTransform& object) { return vectorOf(object, TnFbxTransform::kFbxTransformScaleX); }

/// All control points in one row.
inline Samples pointsOf(const TnFbxMesh& mesh) {
    Samples points;
    for (int i = 0; i < mesh.getNumberOfControlPoints(); ++i) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        EXPECT_TRUE(mesh.getControlPoint(i, x, y, z));
        points.insert(points.end(), {x, y, z});
    }
    return points;
}

/// The control points of the polygon vertices, one polygon after the other.
inline std::vector<int> pointIndicesOf(const TnFbxMesh& mesh) {
    std::vector<int> indices;
    for (int i = 0; i < mesh.getNumberOfPolygonVertices(); ++i)
        indices.push_back(mesh.getPointIndex(i));
    return indices;
}

/// Values that differ only by the rounding of single precision are equal.
inline auto isNear(const Samples& expected) { return testing::Pointwise(testing::FloatNear(1e-5f), expected); }

} // namespace Tarnell::Fbx::test
