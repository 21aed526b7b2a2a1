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

/// The points of a block, and the names of the group that their first face belongs to.
struct WavefrontBlock {
    std::vector<Point> points;
    std::vector<std::string> names;
};

struct WavefrontFile {
    std::vector<WavefrontBlock> blocks;
    bool inOtherOrder = false; ///< the points are not in the order of the FBX file's
    double tolerance = 0;      ///< a unit of the last digit printed, or the tolerance that the file states
};

WavefrontFile readWavefront(const std::filesystem::path& path);

/// FBXASC and three digits represent a character that the format cannot hold.
std::string decodedName(std::string name);

} // namespace conformance
