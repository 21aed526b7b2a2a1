// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "ReportArrays.h"

#include <algorithm>
#include <bit>

namespace tool {

static_assert(std::endian::native == std::endian::little, "arrays are written in the byte order of the machine");

void ReportArrays::write(std::ostream& out) const {
    constexpr const char* kDigits = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    constexpr std::size_t kGroup = 3, kTogether = 1U << 14U;
    std::string text;
    for (std::size_t at = 0; at < mBytes.size(); at += kGroup) {
        const std::size_t count = std::min(kGroup, mBytes.size() - at);
        std::uint32_t bits = 0;
        for (std::size_t i = 0; i < kGroup; ++i)
            bits = bits << 8U | (i < count ? mBytes[at + i] : 0U);
        for (std::size_t i = 0; i < 4; ++i)
            text += i <= count ? kDigits[bits >> (18U - 6U * i) & 63U] : '=';
        if (text.size() >= kTogether) {
            out << text;
            text.clear();
        }
    }
    out << text;
}

} // namespace tool
