// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What the application shows of meshes and cameras, as an independent reader found it.
#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace conformance {

struct FaithfulNode {
    std::string name;
    // Meshes: per frame x, y and z of every `pointStep`-th control point and of the normal of every `normalStep`-th
    // corner.
    int pointStep = 1, normalStep = 1;
    std::vector<std::vector<double>> points, normals;
    bool mirrored = false; ///< the node's matrix turns the mesh inside out
    bool deformed = false; ///< by skins, blend shapes or caches
    bool shaped = false;   ///< by blend shapes or caches
    // Cameras: per frame.
    std::vector<double> focalLength;                   ///< millimetres
    std::vector<double> fovX, fovY;                    ///< degrees, after gate fit
    std::vector<double> apertureWidth, apertureHeight; ///< inches, after gate fit
    bool perspective = true;
    int gateFit = 0;
};

/// Those with a mesh or a camera, in the order of the tree. Empty when there is no such file.
std::vector<FaithfulNode> readFaithfulReference(const std::filesystem::path& path);

} // namespace conformance
