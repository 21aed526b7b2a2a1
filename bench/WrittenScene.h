// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The numbers of the scenes that both programs write: a hilly grid of quads, and nodes that circle.
#pragma once

#include <algorithm>
#include <array>
#include <cmath>

namespace bench {

constexpr int kWrittenFramesPerSecond = 24;

/// A grid of quads with four polygon vertices each, two million in all.
struct Grid {
    int columns = 1000;
    int rows = 500;

    int quads() const { return columns * rows; }
    int points() const { return (columns + 1) * (rows + 1); }

    /// The position of a point in the grid, row by row.
    std::array<float, 3> point(int index) const {
        const auto x = static_cast<float>(index % (columns + 1)), z = static_cast<float>(index / (columns + 1));
        return {x * 0.1f, std::sin(x * 0.013f) * std::cos(z * 0.017f) * 7.0f, z * 0.1f};
    }

    /// The point at a corner of a quad.
    int corner(int quad, int corner) const {
        const std::array<int, 4> steps = {0, columns + 1, columns + 2, 1};
        return quad / columns * (columns + 1) + quad % columns + steps[static_cast<std::size_t>(corner)];
    }

    std::array<float, 3> normal(int index) const {
        const std::array<float, 3> place = point(index);
        const float x = std::cos(place[0]) * 0.3f, z = std::sin(place[2]) * 0.3f;
        return {x, std::sqrt(1.0f - x * x - z * z), z};
    }

    std::array<float, 2> textureCoordinate(int index) const {
        const std::array<float, 3> place = point(index);
        return {place[0] / (0.1f * static_cast<float>(columns)), place[2] / (0.1f * static_cast<float>(rows))};
    }
};

/// Nodes side by side, each with a position and a rotation on every frame.
struct CirclingNodes {
    int nodes = 500;
    int frames = 2000;

    static std::array<float, 3> position(int node, int frame) {
        const float angle = static_cast<float>(frame) * 0.01f + static_cast<float>(node);
        return {std::cos(angle) * 100.0f, static_cast<float>(node) * 0.5f, std::sin(angle) * 100.0f};
    }

    /// About the Y axis, in degrees.
    static float turn(int node, int frame) {
        return static_cast<float>(frame % 360) * 0.4f + static_cast<float>(node % 7);
    }
};

/// 1 is what the tables show; smaller scales are for counting instructions.
inline int scaled(int number, double scale) { return std::max(2, static_cast<int>(number * scale)); }
inline Grid scaledGrid(double scale) {
    const Grid full;
    return {scaled(full.columns, std::sqrt(scale)), scaled(full.rows, std::sqrt(scale))};
}
inline CirclingNodes scaledNodes(double scale) {
    const CirclingNodes full;
    return {scaled(full.nodes, std::sqrt(scale)), scaled(full.frames, std::sqrt(scale))};
}

} // namespace bench
