// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The axes of cameras and lights in files relative to those of hosts, and cameras that look at a point.
#pragma once

#include <fbxsdk.h>

namespace Tarnell::Fbx::faithful {

// The angles from the axes of files to those of hosts, where both look along −Z with Y up.

/// Cameras of files look along X with Y up.
inline const fbxsdk::FbxVector4 kCameraTurn(0.0, -90.0, 0.0);
/// Lights of files shine along −Y.
inline const fbxsdk::FbxVector4 kLightTurn(-90.0, 0.0, 0.0);

fbxsdk::FbxAMatrix turnOf(const fbxsdk::FbxVector4& angles);

/// A camera in the axes of hosts, rotated toward the point and rolled, in degrees; unchanged where that has no
/// direction.
fbxsdk::FbxAMatrix aimed(const fbxsdk::FbxAMatrix& camera, const fbxsdk::FbxVector4& point,
                         const fbxsdk::FbxVector4& up, double roll);

} // namespace Tarnell::Fbx::faithful
