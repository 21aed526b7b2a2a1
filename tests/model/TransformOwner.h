// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A recognisable transform part, for the rule that objects keep theirs.
#pragma once

#include "TnFbxTransform.h"

#include "ModelValues.h"

#include <string>

namespace Tarnell::Fbx::test {

/// Gives an object a name, a position of `value`, animated in Y, a rotation of `value`, and the order XYZ.
inline void markTransform(TnFbxTransform& object, const std::string& name, float value) {
    object.setName(name);
    object.setTransformValue(TnFbxTransform::kFbxTransformPositionX, value);
    object.setTransformValueAt(TnFbxTransform::kFbxTransformPositionY, range(1, 2), {value, value});
    object.setTransformValue(TnFbxTransform::kFbxTransformRotationZ, value);
    object.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderXYZ);
}

inline void expectMarkedTransform(const TnFbxTransform& object, const std::string& name, float value) {
    EXPECT_EQ(object.getName(), name);
    EXPECT_EQ(object.getTransformValue(TnFbxTransform::kFbxTransformPositionX), value);
    EXPECT_EQ(object.getTransformValueAt(TnFbxTransform::kFbxTransformPositionY, 1.0f), value);
    EXPECT_EQ(object.getTransformValue(TnFbxTransform::kFbxTransformRotationZ), value);
    EXPECT_EQ(object.getTransformRotationOrder(), TnFbxTransform::kFbxRotationOrderXYZ);
}

} // namespace Tarnell::Fbx::test
