// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Random numbers that are the same on every platform and in every run.
#pragma once

#include <random>

#include <fbxsdk/FbxTypes.h>
#include <fbxsdk/FbxVector4.h>

class SeededRandom {
public:
    explicit SeededRandom(unsigned seed) : mEngine(seed) {}

    /// Between the bounds; the engine is standard, distributions are not.
    double real(double low, double high) {
        return low + (high - low) * (static_cast<double>(mEngine()) / 4294967295.0);
    }
    int whole(int count) { return static_cast<int>(mEngine() % static_cast<unsigned>(count)); }
    bool chance(int oneIn) { return whole(oneIn) == 0; }

    fbxsdk::FbxVector4 vector(double low, double high) {
        const double x = real(low, high), y = real(low, high), z = real(low, high);
        return {x, y, z, 1.0};
    }
    fbxsdk::FbxDouble3 triple(double low, double high) {
        const fbxsdk::FbxVector4 v = vector(low, high);
        return {v[0], v[1], v[2]};
    }

private:
    std::mt19937 mEngine;
};
