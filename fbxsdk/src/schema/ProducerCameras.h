// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The names of the application's views, which files before 7.0 hold outside of the node tree.
#pragma once

#include <array>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace ProducerCamera {
enum Place : std::size_t { perspective, top, bottom, front, back, right, left };
}
inline constexpr std::array<const char*, 7> kProducerCameraNames = {
    "Producer Perspective", "Producer Top",   "Producer Bottom", "Producer Front",
    "Producer Back",        "Producer Right", "Producer Left",
};
inline constexpr const char* kCameraSwitcherName = "Camera Switcher";

} // namespace detail
FBXSDK_NAMESPACE_END
