// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of channels to properties of the scene: static values, and keys at the exact times of frames.
#pragma once

#include "access/WrittenSpan.h"
#include "calls/MemoryLimit.h"

#include "TnFbxChannel.h"

#include <fbxsdk.h>

#include <array>
#include <cstdint>
#include <functional>
#include <vector>

namespace Tarnell::Fbx::faithful {

/// Whole frames at an exact rate.
struct FrameRange {
    std::int64_t first = 0, last = 0;
    double rate = 24.0;

    std::int64_t count() const { return last - first + 1; }
};

/// Whether the channel has samples that are not all equal.
bool changes(const TnFbxChannel& channel);

/// The value of a constant channel, and that of an animated one apart from its samples.
double staticValue(const TnFbxChannel& channel);

/// Three channels that make up a property, in its own order.
using Channels3 = std::array<const TnFbxChannel*, 3>;
using ValueAt = std::function<double(std::int64_t frame)>;

/// Writes into one layer, and records the span of what it wrote.
class KeyWriter {
public:
    /// `rate`: frames per second of channels that state none.
    KeyWriter(fbxsdk::FbxAnimLayer& layer, double rate) : mLayer(layer), mRate(rate) { mMemory.begin(); }

    /// `factor` times the static value, and the samples as keys. Of equal consecutive samples the first and the last
    /// one become keys.
    void write(fbxsdk::FbxPropertyT<fbxsdk::FbxDouble>& property, const TnFbxChannel& channel, double factor = 1.0);
    void write(fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3>& property, const Channels3& channels);

    /// Keys of a function of the frame; `component` of a property of three numbers, else null. None where the
    /// values are constant.
    void writeKeys(fbxsdk::FbxProperty property, const char* component, const FrameRange& range,
                   const ValueAt& valueAt);

    /// The frames of a channel, and those of some channels together; one frame where none of them changes, and where
    /// their ranges and rates are so far apart that the keys would go beyond the memory limit.
    FrameRange rangeOf(const TnFbxChannel& channel) const;
    FrameRange rangeOf(const std::vector<const TnFbxChannel*>& channels);
    /// The channel at a frame of another range.
    double valueAt(const TnFbxChannel& channel, std::int64_t frame, const FrameRange& range) const;

    detail::WrittenSpan& span() { return mSpan; }
    /// The total memory of the keys of several channels.
    const detail::MemoryAccount& memory() const { return mMemory; }

private:
    void extendSpan(const FrameRange& range);
    void writeKeys(fbxsdk::FbxProperty property, const char* component, const TnFbxChannel& channel, double factor);

    fbxsdk::FbxAnimLayer& mLayer;
    double mRate;
    detail::WrittenSpan mSpan;
    detail::MemoryAccount mMemory;
};

} // namespace Tarnell::Fbx::faithful
