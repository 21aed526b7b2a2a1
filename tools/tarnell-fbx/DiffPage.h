// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Differences as sentences, and as a page for a browser.
#pragma once

#include <ostream>
#include <string>
#include <vector>

#include "DiffFacts.h"

namespace tool {

struct DiffPage {
    std::string a, b; ///< names of the files
    double tolerance = 0.0;
    std::vector<Difference> found;
};

/// "position: (0, 0, 0) → (1, 0, 0), 1 cm apart at frame 12".
std::string sentenceOf(const Difference& difference);

/// A self-contained document: no script, no network.
void writeDiffPage(const DiffPage& page, std::ostream& out);

} // namespace tool
