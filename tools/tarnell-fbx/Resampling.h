// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Samples at another rate.
#pragma once

#include "TnFbxChannel.h"
#include "TnFbxTime.h"

namespace tool {

/// The whole frames of the new rate that lie within the range; at least one.
Tarnell::Fbx::TnFbxTime rangeAt(const Tarnell::Fbx::TnFbxTime& range, float framesPerSecond);

/// Replaces the samples by those at the new rate, linear between two old ones. Channels without samples stay.
void resample(Tarnell::Fbx::TnFbxChannel& channel, float framesPerSecond);

} // namespace tool
