// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A line on standard error that says what is going on, for people who wait.
#pragma once

#include <condition_variable>
#include <cstddef>
#include <mutex>
#include <stop_token>
#include <string>
#include <thread>

namespace tool {

/// Nothing when standard error is no terminal, and nothing before a second has gone by, however long a single step
/// takes. Gone when the object is.
class Progress {
public:
    Progress();
    ~Progress();
    Progress(const Progress&) = delete;
    Progress& operator=(const Progress&) = delete;

    /// What is being done from now on.
    void say(const std::string& text);
    /// Takes the line away until something is said again, for others who write on the terminal.
    void hide();

private:
    void work(const std::stop_token& stop);
    void show();

    std::mutex mMutex;
    std::condition_variable_any mChanged;
    std::string mText, mShown;
    std::jthread mThread; ///< none where nothing is shown
};

} // namespace tool
