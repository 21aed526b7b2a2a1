// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A progress line on standard error.
#pragma once

#include <condition_variable>
#include <cstddef>
#include <mutex>
#include <stop_token>
#include <string>
#include <thread>

namespace tool {

/// Nothing is shown when standard error is no terminal, and within the first second, however long a single step
/// takes. Removed with the object.
class Progress {
public:
    Progress();
    ~Progress();
    Progress(const Progress&) = delete;
    Progress& operator=(const Progress&) = delete;

    /// The current step.
    void say(const std::string& text);
    /// Removes the line until the next message, for other output to the terminal.
    void hide();

private:
    void work(const std::stop_token& stop);
    void show();

    std::mutex mMutex;
    std::condition_variable_any mChanged;
    std::string mText, mShown;
    std::jthread mThread; ///< null where nothing is shown
};

} // namespace tool
