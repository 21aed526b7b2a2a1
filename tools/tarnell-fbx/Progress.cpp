// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Progress.
#include "Progress.h"

#include <iostream>

#include "TerminalText.h"
#include "Utf8.h"

namespace tool {
namespace {

using Clock = std::chrono::steady_clock;
constexpr auto kPatience = std::chrono::seconds(1);
constexpr auto kBetweenLines = std::chrono::milliseconds(100);
constexpr std::size_t kMostColumns = 78; // a line that breaks cannot be taken back

} // namespace

Progress::Progress() : mShown(isTerminal(stderr)), mNext(Clock::now() + kPatience) {}

void Progress::say(const std::string& text) {
    if (!mShown || Clock::now() < mNext)
        return;
    mNext = Clock::now() + kBetweenLines;
    clear();
    const std::string line = fitted(terminalText(text), kMostColumns);
    std::cerr << line << std::flush;
    mLength = displayWidth(line);
}

void Progress::clear() {
    if (mLength > 0)
        std::cerr << '\r' << std::string(mLength, ' ') << '\r' << std::flush;
    mLength = 0;
}

} // namespace tool
