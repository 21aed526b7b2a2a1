// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <optional>
#include <string>
#include <utility>

#include "SceneFile.h"

namespace tool {

/// The times of a file: its rate, and the frames of a take, as a faithful read samples them.
struct TakeFacts {
    std::string name;                        ///< empty without a take
    bool exists = false;                     ///< whether the file has a take at all
    double frameRate = 0.0;                  ///< exact also for the rates of television
    long long firstFrame = 0, lastFrame = 0; ///< the take's own span, widened by its keys
    /// Seconds; nothing where the take states no span, or has no keys.
    std::optional<std::pair<double, double>> span, keys;
};

TakeFacts takeFacts(const SceneFile& file, FbxAnimStack* take);

} // namespace tool
