// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Matrices as a textbook has them (column vectors, row by column, sines and cosines, Gauss for the inverse): the
// independent side of the tests of transforms. Deliberately shares nothing with the platform's arithmetic.
#pragma once

#include <algorithm>
#include <array>
#include <cmath>
#include <string>
#include <utility>

#include <fbxsdk/FbxAMatrix.h>
#include <fbxsdk/FbxTypes.h>

namespace plain {

struct Matrix {
    std::array<std::array<double, 4>, 4> at{{{1, 0, 0, 0}, {0, 1, 0, 0}, {0, 0, 1, 0}, {0, 0, 0, 1}}};
};

inline Matrix operator*(const Matrix& a, const Matrix& b) {
    Matrix product;
    for (std::size_t r = 0; r < 4; ++r)
        for (std::size_t c = 0; c < 4; ++c) {
            product.at[r][c] = 0;
            for (std::size_t k = 0; k < 4; ++k)
                product.at[r][c] += a.at[r][k] * b.at[k][c];
        }
    return product;
}

/// Anything with three components by index.
template <class Vector>
Matrix translation(const Vector& v) {
    Matrix m;
    for (int i = 0; i < 3; ++i)
        m.at[static_cast<std::size_t>(i)][3] = v[i];
    return m;
}

template <class Vector>
Matrix scaling(const Vector& v) {
    Matrix m;
    for (int i = 0; i < 3; ++i)
        m.at[static_cast<std::size_t>(i)][static_cast<std::size_t>(i)] = v[i];
    return m;
}

/// The rotation about one axis, counter-clockwise when looking against it.
inline Matrix turn(int axis, double degrees) {
    const double angle = degrees * 3.14159265358979323846 / 180.0;
    const auto u = static_cast<std::size_t>((axis + 1) % 3), v = static_cast<std::size_t>((axis + 2) % 3);
    Matrix m;
    m.at[u][u] = m.at[v][v] = std::cos(angle);
    m.at[u][v] = -std::sin(angle);
    m.at[v][u] = std::sin(angle);
    return m;
}

/// Rotations in the order of the letters, the first one first.
template <class Vector>
Matrix rotation(const Vector& degrees, const std::string& order = "XYZ") {
    Matrix m;
    for (const char axis : order)
        m = turn(axis - 'X', degrees[axis - 'X']) * m;
    return m;
}

inline Matrix linear(Matrix m) {
    for (std::size_t i = 0; i < 3; ++i)
        m.at[i][3] = 0;
    return m;
}

inline Matrix transposed(const Matrix& m) {
    Matrix t;
    for (std::size_t r = 0; r < 4; ++r)
        for (std::size_t c = 0; c < 4; ++c)
            t.at[r][c] = m.at[c][r];
    return t;
}

inline Matrix inverse(Matrix m) {
    Matrix result;
    for (std::size_t c = 0; c < 4; ++c) {
        std::size_t pivot = c;
        for (std::size_t r = c; r < 4; ++r)
            if (std::abs(m.at[r][c]) > std::abs(m.at[pivot][c]))
                pivot = r;
        std::swap(m.at[c], m.at[pivot]);
        std::swap(result.at[c], result.at[pivot]);
        const double lead = m.at[c][c];
        for (std::size_t k = 0; k < 4; ++k) {
            m.at[c][k] /= lead;
            result.at[c][k] /= lead;
        }
        for (std::size_t r = 0; r < 4; ++r) {
            const double factor = r == c ? 0 : m.at[r][c];
            for (std::size_t k = 0; k < 4; ++k) {
                m.at[r][k] -= factor * m.at[c][k];
                result.at[r][k] -= factor * result.at[c][k];
            }
        }
    }
    return result;
}

/// The platform's matrix, whose rows are the images of the axes, as columns.
inline Matrix of(const fbxsdk::FbxAMatrix& source) {
    Matrix m;
    for (int r = 0; r < 4; ++r)
        for (int c = 0; c < 4; ++c)
            m.at[static_cast<std::size_t>(r)][static_cast<std::size_t>(c)] = source.Get(c, r);
    return m;
}

/// The largest difference of any two elements; NaN counts as infinite.
inline double difference(const Matrix& a, const Matrix& b) {
    double largest = 0;
    for (std::size_t r = 0; r < 4; ++r)
        for (std::size_t c = 0; c < 4; ++c) {
            const double d = std::abs(a.at[r][c] - b.at[r][c]);
            largest = d <= largest ? largest : (std::isnan(d) ? INFINITY : d);
        }
    return largest;
}

inline double largest(const Matrix& m) {
    double value = 0;
    for (const auto& row : m.at)
        for (const double each : row)
            value = std::max(value, std::abs(each));
    return value;
}

inline std::string text(const Matrix& m) {
    std::string lines;
    for (const auto& row : m.at) {
        for (const double each : row)
            lines += std::to_string(each) + " ";
        lines += "\n";
    }
    return lines;
}

} // namespace plain
