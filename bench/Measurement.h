// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What a benchmark program prints for the scripts: the result, to be compared, and its cost.
#pragma once

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdint>
#include <cstdio>
#include <limits>

namespace bench {

/// A read's result: how many objects, and their bounding box.
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

/// The cost of one call.
struct Cost {
    double seconds = std::numeric_limits<double>::infinity();
    std::uint64_t allocations = 0; ///< calls of malloc, realloc and related functions, by anything in the process
};

/// Allocations of the process so far. The benchmark programs define malloc and related functions for this
/// (Allocations.cpp).
std::uint64_t allocationCount();

/// The most resident memory that the program has had, in KiB. What the system reports to the parent of a process
/// includes that of the parent when it started the process. 0 where /proc does not have it.
long long peakKilobytes();

/// From here to the end of the scope, valgrind's callgrind counts instructions; without it there is no effect.
class CountedInstructions {
public:
    CountedInstructions();
    ~CountedInstructions();
    CountedInstructions(const CountedInstructions&) = delete;
    CountedInstructions& operator=(const CountedInstructions&) = delete;
};

class Stopwatch {
public:
    [[nodiscard]] double seconds() const {
        return std::chrono::duration<double>(std::chrono::steady_clock::now() - mStart).count();
    }

private:
    std::chrono::steady_clock::time_point mStart = std::chrono::steady_clock::now();
};

/// The cost of the work, from start to end.
template <class Work>
Cost measure(const Work& work) {
    const std::uint64_t allocated = allocationCount();
    const Stopwatch watch;
    {
        const CountedInstructions counted;
        work();
    }
    return {watch.seconds(), allocationCount() - allocated};
}

/// The less expensive of two runs of the same work: noise only ever adds to the cost.
inline Cost cheaper(const Cost& a, const Cost& b) { return a.seconds <= b.seconds ? a : b; }

inline void print(const Cost& cost) {
    std::printf("\"seconds\": %.6f, \"allocations\": %llu, \"peakKilobytes\": %lld}\n", cost.seconds,
                static_cast<unsigned long long>(cost.allocations), peakKilobytes());
}

inline void print(const Answer& answer, const Cost& cost) {
    std::printf("{\"count\": %lld, \"minimum\": [%.9g, %.9g, %.9g], \"maximum\": [%.9g, %.9g, %.9g], ", answer.count,
                answer.minimum[0], answer.minimum[1], answer.minimum[2], answer.maximum[0], answer.maximum[1],
                answer.maximum[2]);
    print(cost);
}

} // namespace bench
