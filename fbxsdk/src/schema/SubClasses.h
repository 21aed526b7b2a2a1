// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The sub-classes of objects as 7.x files spell them; before 7.0 they are kinds of Models. Those of skeletons and
// markers are in Spellings.h.
#pragma once

#include <string_view>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail::SubClass {

// of node attributes
inline constexpr std::string_view kNull = "Null";
inline constexpr std::string_view kCamera = "Camera";
inline constexpr std::string_view kCameraStereo = "CameraStereo";
inline constexpr std::string_view kCameraSwitcher = "CameraSwitcher";
inline constexpr std::string_view kLight = "Light";
inline constexpr std::string_view kLodGroup = "LodGroup";
inline constexpr std::string_view kOpticalReference = "OpticalReference";
inline constexpr std::string_view kCachedEffect = "CachedEffect";

// of geometry
inline constexpr std::string_view kMesh = "Mesh";
inline constexpr std::string_view kShape = "Shape";
inline constexpr std::string_view kNurbsSurface = "NurbsSurface";
inline constexpr std::string_view kNurbsCurve = "NurbsCurve";
inline constexpr std::string_view kTrimNurbsSurface = "TrimNurbsSurface";
inline constexpr std::string_view kBoundary = "Boundary";
inline constexpr std::string_view kNurb = "Nurb";
inline constexpr std::string_view kPatch = "Patch";
inline constexpr std::string_view kLine = "Line";

// of deformers
inline constexpr std::string_view kSkin = "Skin";
inline constexpr std::string_view kCluster = "Cluster";
inline constexpr std::string_view kBlendShape = "BlendShape";
inline constexpr std::string_view kBlendShapeChannel = "BlendShapeChannel";
inline constexpr std::string_view kVertexCacheDeformer = "VertexCacheDeformer";

// of videos
inline constexpr std::string_view kClip = "Clip";

} // namespace detail::SubClass
FBXSDK_NAMESPACE_END
