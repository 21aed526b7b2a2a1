// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <bit>
#include <cstdint>

namespace Tarnell::Fbx::detail {

// Equality to the bit: 0 and −0 differ, and a NaN is equal to itself.

inline bool haveSameBits(float a, float b) {
    return std::bit_cast<std::uint32_t>(a) == std::bit_cast<std::uint32_t>(b);
}
inline bool haveSameBits(double a, double b) {
    return std::bit_cast<std::uint64_t>(a) == std::bit_cast<std::uint64_t>(b);
}

} // namespace Tarnell::Fbx::detail
