// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The bits by which hosts name kinds of nodes.
#pragma once

namespace Tarnell::Fbx::detail::NodeMask {

inline constexpr int kMarkers = 0x1;
inline constexpr int kSkeletons = 0x2;
inline constexpr int kMeshes = 0x4;
inline constexpr int kNurbs = 0x8;
inline constexpr int kPatches = 0x10;
inline constexpr int kCameras = 0x20;
inline constexpr int kLights = 0x40;
inline constexpr int kOpticalReferences = 0x80;
inline constexpr int kOpticalMarkers = 0x100;
inline constexpr int kCameraSwitchers = 0x200;
inline constexpr int kNurbsCurves = 0x800; ///< 0x400 selects nothing
inline constexpr int kTrimmedSurfaces = 0x1000;
inline constexpr int kBoundaries = 0x2000;
inline constexpr int kNulls = 0x4000; ///< and nodes without an attribute; kept: surfaces, too
inline constexpr int kTransforms = kNulls | kMeshes | kMarkers;

} // namespace Tarnell::Fbx::detail::NodeMask
