// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The numbers of the scenes that both programs write: a hilly grid of quads, and nodes that circle.
#pragma once

#include <array>
#include <cmath>

namespace bench {

constexpr int kGridColumns = 1000, kGridRows = 500; ///< quads; four polygon vertices each, two million in all
constexpr int kGridQuads = kGridColumns * kGridRows;
constexpr int kGridPoints = (kGridColumns + 1) * (kGridRows + 1);

constexpr int kWrittenNodes = 500;
constexpr int kWrittenFrames = 2000;
constexpr int kWrittenFramesPerSecond = 24;

/// The place of a point in the grid, row by row.
inline std::array<float, 3> gridPoint(int point) {
    const auto x = static_cast<float>(point % (kGridColumns + 1)), z = static_cast<float>(point / (kGridColumns + 1));
    return {x * 0.1f, std::sin(x * 0.013f) * std::cos(z * 0.017f) * 7.0f, z * 0.1f};
}

/// The point at a corner of a quad.
inline int gridCorner(int quad, int corner) {
    constexpr std::array<int, 4> kSteps = {0, kGridColumns + 1, kGridColumns + 2, 1};
    return quad / kGridColumns * (kGridColumns + 1) + quad % kGridColumns + kSteps[static_cast<std::size_t>(corner)];
}

inline std::array<float, 3> gridNormal(int point) {
    const std::array<float, 3> place = gridPoint(point);
    const float x = std::cos(place[0]) * 0.3f, z = std::sin(place[2]) * 0.3f;
    return {x, std::sqrt(1.0f - x * x - z * z), z};
}

inline std::array<float, 2> gridTextureCoordinate(int point) {
    const std::array<float, 3> place = gridPoint(point);
    return {place[0] / (0.1f * kGridColumns), place[2] / (0.1f * kGridRows)};
}

inline std::array<float, 3> nodePosition(int node, int frame) {
    const float angle = static_cast<float>(frame) * 0.01f + static_cast<float>(node);
    return {std::cos(angle) * 100.0f, static_cast<float>(node) * 0.5f, std::sin(angle) * 100.0f};
}

/// About the Y axis, in degrees.
inline float nodeTurn(int node, int frame) {
    return static_cast<float>(frame % 360) * 0.4f + static_cast<float>(node % 7);
}

} // namespace bench
