// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Progress, printed on a thread of its own: work may take long between two messages.
#include "Progress.h"

#include <chrono>
#include <iostream>

#include "TerminalText.h"
#include "Utf8.h"

namespace tool {
namespace {

constexpr auto kPatience = std::chrono::seconds(1);
constexpr auto kBetweenLines = std::chrono::milliseconds(100);
constexpr std::size_t kMostColumns = 78; // a wrapped line cannot be erased

} // namespace

Progress::Progress() {
    if (isTerminal(stderr))
        mThread = std::jthread([this](const std::stop_token& stop) { work(stop); });
}

Progress::~Progress() {
    mThread = {}; // stops and joins
    hide();
}

void Progress::say(const std::string& text) {
    const std::lock_guard lock(mMutex);
    mText = fitted(terminalText(text), kMostColumns);
}

void Progress::hide() {
    const std::lock_guard lock(mMutex);
    mText.clear();
    show();
}

void Progress::work(const std::stop_token& stop) {
    std::unique_lock lock(mMutex);
    const auto never = [] { return false; };
    mChanged.wait_for(lock, stop, kPatience, never);
    while (!stop.stop_requested()) {
        show();
        mChanged.wait_for(lock, stop, kBetweenLines, never);
    }
}

/// Replaces the displayed line. The mutex is held.
void Progress::show() {
    if (mText == mShown)
        return;
    const std::string blanks(displayWidth(mShown), ' ');
    std::cerr << (blanks.empty() ? "" : '\r' + blanks + '\r') + mText << std::flush;
    mShown = mText;
}

} // namespace tool
