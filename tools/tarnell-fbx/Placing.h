// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of the channels of a faithful transform to its matrix.
#pragma once

#include <array>

#include <fbxsdk.h>

#include "TnFbxTransform.h"

namespace tool {

/// Position · rotation · shear · scale at a frame, the rightmost applied first.
FbxAMatrix placeAt(const Tarnell::Fbx::TnFbxTransform& object, double frame);

double lengthOf(const FbxVector4& vector);

} // namespace tool
