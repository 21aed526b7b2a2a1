// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What a benchmark program prints for compare.py: the answer, to be proven equal, and the time that it took.
#pragma once

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdio>
#include <limits>

namespace bench {

/// A read's answer: how many things, and the box around their numbers.
struct Answer {
    long long count = 0;
    std::array<double, 3> minimum = {kMost, kMost, kMost};
    std::array<double, 3> maximum = {-kMost, -kMost, -kMost};

    void include(double x, double y, double z) {
        const std::array<double, 3> point = {x, y, z};
        for (std::size_t i = 0; i < point.size(); ++i) {
            minimum[i] = std::min(minimum[i], point[i]);
            maximum[i] = std::max(maximum[i], point[i]);
        }
    }

private:
    static constexpr double kMost = std::numeric_limits<double>::max();
};

class Stopwatch {
public:
    [[nodiscard]] double seconds() const {
        return std::chrono::duration<double>(std::chrono::steady_clock::now() - mStart).count();
    }

private:
    std::chrono::steady_clock::time_point mStart = std::chrono::steady_clock::now();
};

inline void print(const Answer& answer, double seconds) {
    std::printf(
        "{\"count\": %lld, \"minimum\": [%.9g, %.9g, %.9g], \"maximum\": [%.9g, %.9g, %.9g], \"seconds\": %.6f}\n",
        answer.count, answer.minimum[0], answer.minimum[1], answer.minimum[2], answer.maximum[0], answer.maximum[1],
        answer.maximum[2], seconds);
}

} // namespace bench
