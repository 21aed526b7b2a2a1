// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Wavefront files as far as points go: one block of points per object.
#pragma once

#include "MeshPoints.h"

#include <filesystem>
#include <string>
#include <vector>

namespace conformance {

/// The points that stand together, and the names of the group that their first face belongs to.
struct WavefrontBlock {
    std::vector<Point> points;
    std::vector<std::string> names;
};

struct WavefrontFile {
    std::vector<WavefrontBlock> blocks;
    bool inOtherOrder = false; ///< the points are not in the order of the FBX file's
    double tolerance = 0;      ///< a unit of the last digit printed, or what the file says of itself
};

WavefrontFile readWavefront(const std::filesystem::path& path);

/// FBXASC and three digits stand for a character that the format has no place for.
std::string decodedName(std::string name);

} // namespace conformance
