// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "schema/PropertyFlags.h"

#include <charconv>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

unsigned letterFlag(char letter) {
    for (unsigned bit = 0; bit < kFlagLetters.size(); ++bit)
        if (letter == kFlagLetters[bit])
            return 1U << bit;
    return 0;
}

/// The components whose number the text starts with.
unsigned componentFlags(const ComponentFlagRow& row, std::string_view text) {
    unsigned mask = 0;
    std::from_chars(text.data(), text.data() + text.size(), mask);
    return (mask & kComponentMask) << row.firstBit;
}

} // namespace

unsigned propertyFlags(std::string_view text) {
    unsigned flags = 0;
    for (std::size_t i = 0; i < text.size(); ++i) {
        flags |= letterFlag(text[i]);
        for (const ComponentFlagRow& row : kComponentFlags)
            if (text[i] == row.letter)
                flags |= componentFlags(row, text.substr(i + 1));
    }
    return flags;
}

std::string propertyFlagText(unsigned flags) {
    std::string text;
    for (unsigned bit = 0; bit < kFlagLetters.size(); ++bit)
        if (kFlagLetters[bit] != 0 && (flags >> bit & 1U) != 0)
            text += kFlagLetters[bit];
    for (const ComponentFlagRow& row : kComponentFlags)
        if (const unsigned mask = flags >> row.firstBit & kComponentMask; mask != 0)
            text += row.letter + std::to_string(mask);
    return text;
}

} // namespace detail
FBXSDK_NAMESPACE_END
