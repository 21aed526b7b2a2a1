// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Samples at another rate.
#include "Resampling.h"

#include <algorithm>
#include <cmath>
#include <vector>

namespace tool {

using namespace Tarnell::Fbx;

TnFbxTime rangeAt(const TnFbxTime& range, float framesPerSecond) {
    // A frame that falls on a whole one but for rounding counts as that.
    constexpr double kSlack = 1e-4;
    constexpr double kMost = 2e9; // whole frames are ints
    const double ratio = static_cast<double>(framesPerSecond) / static_cast<double>(range.getFrameRate());
    const double start = std::clamp(std::ceil(range.getStartFrame() * ratio - kSlack), -kMost, kMost);
    const double end = std::clamp(std::floor(range.getEndFrame() * ratio + kSlack), start, kMost);
    TnFbxTime result;
    result.setTime(range.getFrame(), static_cast<int>(start), static_cast<int>(end), framesPerSecond);
    return result;
}

void resample(TnFbxChannel& channel, float framesPerSecond) {
    const TnFbxTime old = channel.getTime();
    if (!channel.getAnimated() || !(old.getFrameRate() > 0.0F) || old.getFrameRate() == framesPerSecond)
        return;
    const TnFbxTime range = rangeAt(old, framesPerSecond);
    const double ratio = static_cast<double>(old.getFrameRate()) / static_cast<double>(framesPerSecond);
    std::vector<float> values;
    for (long long frame = range.getStartFrame(); frame <= range.getEndFrame(); ++frame) {
        const double at = std::clamp(static_cast<double>(frame) * ratio, static_cast<double>(old.getStartFrame()),
                                     static_cast<double>(old.getEndFrame()));
        const double before = std::floor(at), part = at - before;
        const double from = static_cast<double>(channel.getAnimatedValue(static_cast<float>(before)));
        const double to = static_cast<double>(channel.getAnimatedValue(
            static_cast<float>(std::min(before + 1.0, static_cast<double>(old.getEndFrame())))));
        values.push_back(static_cast<float>(from + (to - from) * part));
    }
    channel.setAnimatedValues(range, values);
}

} // namespace tool
