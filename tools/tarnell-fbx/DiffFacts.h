// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The differences between two files as data for the commands to print. Values are faithful ones, in centimetres and
// with so that the same scene in another unit is the same scene.
#pragma once

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "SceneFile.h"

namespace tool {

enum class DiffKind {
    rate,
    unit,
    axes,
    take,
    added,
    removed,
    renamed,
    moved,
    kind,
    transform,
    optics,
    light,
    curve,
    points,
    topology,
    material,
    texture
};
const char* diffKindName(DiffKind kind);

struct Difference {
    DiffKind kind = DiffKind::rate;
    std::string
        object; ///< name of a node, material or texture, as spelt in the first file that has it; empty for the file
    std::string what;             ///< "position", "focalLength", "Lcl Translation.X"
    std::string a, b;             ///< each file's value; empty where it has none
    std::optional<double> amount; ///< the largest difference, where it is a number
    std::string unit;             ///< of the amount: "cm", "°"
    std::optional<double> frame;  ///< of the first file, at which it is largest
    int carried = 0;              ///< descendants that are moved by just this
};

struct DiffSettings {
    std::string take;                          ///< of both files; empty: the first of each
    double tolerance = 1e-4;                   ///< relative to the larger of 1 and the numbers
    std::optional<std::pair<int, int>> frames; ///< at which mesh points are compared; else the first frame
};

/// A file that is compared, under the name by which it can be read.
struct DiffFile {
    const std::string& name;
    const SceneFile& opened;
};

/// Throws Unreadable.
std::vector<Difference> differencesOf(const DiffFile& a, const DiffFile& b, const DiffSettings& settings);

} // namespace tool
