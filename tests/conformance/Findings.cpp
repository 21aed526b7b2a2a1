// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Numbers in sentences.
#include "Findings.h"

#include <array>
#include <cstdio>

namespace conformance {

std::string printed(double value) {
    std::array<char, 32> text{};
    std::snprintf(text.data(), text.size(), "%.9g", value);
    return text.data();
}

std::string printed(const double* values, std::size_t count) {
    std::string text;
    for (std::size_t i = 0; i < count; ++i)
        text += (i == 0 ? "" : " ") + printed(values[i]);
    return text;
}

} // namespace conformance
