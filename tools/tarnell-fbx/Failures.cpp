// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Error output of the commands.
#include <exception>
#include <iostream>
#include <new>

#include "Commands.h"
#include "StandardInput.h"
#include "TerminalText.h"

namespace tool {

std::string spoken(const std::string& text) { return terminalText(withoutKeptName(text)); }

void printError(const std::string& file, const std::string& reason) {
    // The library's messages begin with the file already.
    const std::string sentence = spoken(reason), start = spoken(file) + ": ";
    // In one write: several files may fail at once.
    std::cerr << "tarnell-fbx: " + (sentence.rfind(start, 0) == 0 ? "" : start) + sentence + '\n';
}

Outcome attempt(const std::function<int()>& work) {
    try {
        return {work(), {}};
    } catch (const std::bad_alloc&) {
        return {kUnreadable, "not enough memory"};
    } catch (const std::exception& error) {
        return {kUnreadable, error.what()};
    }
}

int guarded(const std::string& file, const std::function<int()>& work) {
    const Outcome outcome = attempt(work);
    if (!outcome.reason.empty())
        printError(file, outcome.reason);
    return outcome.status;
}

} // namespace tool
