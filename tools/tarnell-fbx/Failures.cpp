// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How the commands say that something went wrong.
#include <exception>
#include <iostream>
#include <new>

#include "Commands.h"

namespace tool {

void printError(const std::string& file, const std::string& reason) {
    // The library's sentences begin with the file already.
    const bool named = reason.rfind(file + ": ", 0) == 0;
    std::cerr << "tarnell-fbx: " << (named ? "" : file + ": ") << reason << '\n';
}

int guarded(const std::string& file, const std::function<int()>& work) {
    try {
        return work();
    } catch (const std::bad_alloc&) {
        printError(file, "there is not enough memory");
    } catch (const std::exception& error) {
        printError(file, error.what());
    }
    return kUnreadable;
}

} // namespace tool
