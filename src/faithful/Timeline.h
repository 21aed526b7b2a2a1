// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The frames at which a scene is sampled, and their times.
#pragma once

#include "TnFbxTime.h"

#include <fbxsdk.h>

#include <cstdint>

namespace Tarnell::Fbx::faithful {

/// Whole frames at an exact rate; frame 0 is at time 0.
class Timeline {
public:
    Timeline() = default;
    /// The frames that a span of time lies in.
    Timeline(double rate, const fbxsdk::FbxTimeSpan& span);

    double rate() const { return mRate; }
    std::int64_t first() const { return mFirst; }
    std::int64_t last() const { return mLast; }
    std::int64_t count() const { return mLast - mFirst + 1; }
    fbxsdk::FbxTime at(double frame) const;
    /// The time record of channels with these samples.
    TnFbxTime record(float frame) const;

private:
    double mRate = 24.0;
    std::int64_t mFirst = 0;
    std::int64_t mLast = 0;
};

} // namespace Tarnell::Fbx::faithful
