// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A line on standard error that says what is going on, for people who wait.
#pragma once

#include <chrono>
#include <string>

namespace tool {

/// Nothing when standard error is no terminal, and nothing before a second has gone by. Gone when work is done.
class Progress {
public:
    Progress();
    ~Progress() { clear(); }
    Progress(const Progress&) = delete;
    Progress& operator=(const Progress&) = delete;

    /// Replaces the line, at most ten times a second.
    void say(const std::string& text);

private:
    void clear();

    bool mShown;
    std::chrono::steady_clock::time_point mNext;
    std::size_t mLength = 0; ///< columns that the line takes
};

} // namespace tool
