// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Shear.h"

#include <array>
#include <cmath>
#include <cstddef>

namespace Tarnell::Fbx::faithful {

namespace {

using Columns = std::array<Vector, 3>;

Columns columnsOf(const fbxsdk::FbxAMatrix& matrix) {
    Columns columns{};
    for (int axis = 0; axis < 3; ++axis)
        for (int component = 0; component < 3; ++component)
            columns[static_cast<std::size_t>(axis)][static_cast<std::size_t>(component)] = matrix.Get(axis, component);
    return columns;
}

fbxsdk::FbxAMatrix matrixOf(const Columns& columns) {
    fbxsdk::FbxAMatrix matrix;
    for (int axis = 0; axis < 3; ++axis)
        for (int component = 0; component < 3; ++component)
            matrix[axis][component] = columns[static_cast<std::size_t>(axis)][static_cast<std::size_t>(component)];
    return matrix;
}

double dot(const Vector& a, const Vector& b) { return a[0] * b[0] + a[1] * b[1] + a[2] * b[2]; }

/// a · c − b · s, and a · s + b · c.
void turnPair(Vector& a, Vector& b, double c, double s) {
    for (std::size_t i = 0; i < 3; ++i) {
        const double x = a[i], y = b[i];
        a[i] = x * c - y * s;
        b[i] = x * s + y * c;
    }
}

} // namespace

/// One-sided Jacobi: the basis is rotated, by less than 45 degrees at a time, until its images are perpendicular.
ShearParts partsOfShear(const Vector& skew, const fbxsdk::FbxAMatrix& nearBasis) {
    Columns basis = columnsOf(nearBasis);
    Columns images{};
    for (std::size_t i = 0; i < 3; ++i) {
        const Vector& axis = basis[i];
        images[i] = {axis[0] + skew[0] * axis[1] + skew[1] * axis[2], axis[1] + skew[2] * axis[2], axis[2]};
    }
    constexpr int kMostSweeps = 30; // a few are enough
    for (int sweep = 0; sweep < kMostSweeps; ++sweep) {
        bool perpendicular = true;
        for (std::size_t i = 0; i < 2; ++i) {
            for (std::size_t j = i + 1; j < 3; ++j) {
                const double product = dot(images[i], images[j]);
                const double first = dot(images[i], images[i]), second = dot(images[j], images[j]);
                if (std::fabs(product) <= 1e-15 * std::sqrt(first * second))
                    continue;
                perpendicular = false;
                const double zeta = (second - first) / (2.0 * product);
                const double t = (zeta < 0.0 ? -1.0 : 1.0) / (std::fabs(zeta) + std::sqrt(1.0 + zeta * zeta));
                const double c = 1.0 / std::sqrt(1.0 + t * t);
                turnPair(images[i], images[j], c, c * t);
                turnPair(basis[i], basis[j], c, c * t);
            }
        }
        if (perpendicular)
            break;
    }
    ShearParts parts;
    for (std::size_t i = 0; i < 3; ++i) {
        parts.stretch[i] = std::sqrt(dot(images[i], images[i]));
        for (double& component : images[i])
            component /= parts.stretch[i];
    }
    parts.turn = matrixOf(images);
    parts.basis = matrixOf(basis);
    return parts;
}

} // namespace Tarnell::Fbx::faithful
