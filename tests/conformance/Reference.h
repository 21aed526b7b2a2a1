// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The data of a file as found by an independent reader, in centimetres, Y up and right-handed. An unknown number
// is NaN here.
#pragma once

#include <array>
#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <vector>

namespace conformance {

/// The X, Y and Z axes and the translation, three numbers each.
using Matrix12 = std::array<double, 12>;
using NamedNumbers = std::map<std::string, std::vector<double>>;

struct ReferenceMesh {
    long long points = 0, polygons = 0, polygonVertices = 0;
    long long skins = 0, blendShapes = 0, caches = 0;
    bool normals = false, uvs = false, colours = false;
    long long sizeSum = 0, indexSum = 0;
    int sampleStep = 1;
    std::vector<std::vector<double>> worldPoints; ///< per frame: x, y, z of every `sampleStep`-th control point
};

struct ReferenceNode {
    std::string name;
    std::string kind;
    int parent = -1;
    int inherit = 0; ///< 0 the usual kind, 1 ignores the parent's scale, 2 component-wise scale
    int rotationOrder = 0;
    Matrix12 geometric{};
    std::vector<Matrix12> world; ///< per frame
    NamedNumbers curves;         ///< per frame
    NamedNumbers camera, light;  ///< one number or three
    std::optional<ReferenceMesh> mesh;
};

struct ReferenceStack {
    std::string name;
    double begin = 0, end = 0; ///< seconds
    int layers = 0;
};

struct Reference {
    bool loads = false;
    double fps = 0;
    double fileUnitMeters = 0;
    std::array<int, 3> axes{}; ///< right, up, front: 0 +X, 1 −X, 2 +Y, 3 −Y, 4 +Z, 5 −Z, 6 unknown
    std::vector<ReferenceStack> stacks;
    std::vector<double> frames;
    std::vector<ReferenceNode> nodes; ///< without the root, parents before their children

    [[nodiscard]] double seconds(std::size_t frameIndex) const { return frames[frameIndex] / fps; }
};

Reference readReference(const std::filesystem::path& path);

} // namespace conformance
