// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Affine matrices: three axes and a translation.
#include "Matrices.h"

#include "Tolerances.h"

namespace conformance {
namespace {

constexpr std::size_t kAxes = 9; ///< numbers of the axes; those of the translation follow
constexpr double kPi = 3.14159265358979323846;

Point rowOf(const Matrix12& m, std::size_t row) { return {m[3 * row], m[3 * row + 1], m[3 * row + 2]}; }

Point linear(const Matrix12& m, const Point& p) {
    Point result{};
    for (std::size_t j = 0; j < result.size(); ++j)
        result[j] = p[0] * m[j] + p[1] * m[3 + j] + p[2] * m[6 + j];
    return result;
}

Point cross(const Point& a, const Point& b) {
    return {a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]};
}

double dot(const Point& a, const Point& b) { return a[0] * b[0] + a[1] * b[1] + a[2] * b[2]; }

/// The rotation of the axis `next` toward the one after it.
Matrix12 turnedAbout(std::size_t axis, double degrees) {
    const double angle = degrees * kPi / 180.0;
    const std::size_t from = (axis + 1) % 3, to = (axis + 2) % 3;
    Matrix12 matrix = scaled({1, 1, 1});
    matrix[3 * from + from] = std::cos(angle);
    matrix[3 * from + to] = std::sin(angle);
    matrix[3 * to + from] = -std::sin(angle);
    matrix[3 * to + to] = std::cos(angle);
    return matrix;
}

double largest(const Matrix12& m, std::size_t begin, std::size_t end) {
    double value = 0;
    for (std::size_t i = begin; i < end; ++i)
        value = std::fmax(value, std::abs(m[i]));
    return value;
}

} // namespace

Point moved(const Matrix12& matrix, const Point& point) {
    Point result = linear(matrix, point);
    for (std::size_t j = 0; j < result.size(); ++j)
        result[j] += matrix[kAxes + j];
    return result;
}

Matrix12 product(const Matrix12& outer, const Matrix12& inner) {
    Matrix12 result{};
    for (std::size_t row = 0; row < 4; ++row) {
        const Point image = row < 3 ? linear(outer, rowOf(inner, row)) : moved(outer, rowOf(inner, row));
        for (std::size_t j = 0; j < image.size(); ++j)
            result[3 * row + j] = image[j];
    }
    return result;
}

std::optional<Matrix12> inverse(const Matrix12& matrix) {
    const Point x = rowOf(matrix, 0), y = rowOf(matrix, 1), z = rowOf(matrix, 2);
    const std::array<Point, 3> columns = {cross(y, z), cross(z, x), cross(x, y)};
    const double determinant = dot(x, columns[0]);
    if (determinant == 0)
        return std::nullopt;
    Matrix12 result{};
    for (std::size_t i = 0; i < 3; ++i)
        for (std::size_t j = 0; j < 3; ++j)
            result[3 * i + j] = columns[j][i] / determinant;
    const Point back = linear(result, rowOf(matrix, 3));
    for (std::size_t j = 0; j < back.size(); ++j)
        result[kAxes + j] = -back[j];
    return result;
}

Matrix12 turned(const Point& degrees) {
    return product(turnedAbout(2, degrees[2]), product(turnedAbout(1, degrees[1]), turnedAbout(0, degrees[0])));
}

Matrix12 scaled(const Point& factors) { return {factors[0], 0, 0, 0, factors[1], 0, 0, 0, factors[2], 0, 0, 0}; }

Matrix12 shifted(const Point& offset) { return {1, 0, 0, 0, 1, 0, 0, 0, 1, offset[0], offset[1], offset[2]}; }

bool sameMatrix(const Matrix12& actual, const Matrix12& expected, double tolerance) {
    const double axes = largest(expected, 0, kAxes);
    const double translation = largest(expected, kAxes, expected.size());
    for (std::size_t i = 0; i < expected.size(); ++i)
        if (!closeTo(actual[i], expected[i], tolerance, i < kAxes ? axes : translation))
            return false;
    return true;
}

} // namespace conformance
