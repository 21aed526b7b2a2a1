// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Pages that are a list of facts.
#pragma once

#include <algorithm>
#include <ostream>
#include <string>
#include <string_view>

#include "Terminal.h"

namespace tool {

/// Prints "  Label         text". The text contains no control characters.
class Lines {
public:
    Lines(std::ostream& out, const Terminal& terminal) : mOut(out), mTerminal(terminal) {}

    void line(std::string_view label, const std::string& text) {
        constexpr std::size_t kColumn = 14;
        mOut << "  " << mTerminal.paint(Ink::faint, label)
             << std::string(kColumn - std::min(kColumn, label.size()), ' ') << text << '\n';
    }

private:
    std::ostream& mOut;
    const Terminal& mTerminal;
};

} // namespace tool
