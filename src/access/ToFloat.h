// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The scene's doubles as the floats of value objects.
#pragma once

namespace Tarnell::Fbx::detail {

/// Rounds to the nearest float; a value out of range becomes infinite, as in IEEE 754.
inline float toFloat(double value) { return static_cast<float>(value); }

} // namespace Tarnell::Fbx::detail
