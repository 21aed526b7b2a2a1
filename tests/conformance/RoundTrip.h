// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A written copy must agree with the references wherever the file itself does; the exceptions are in rewritten.json.
#pragma once

#include "Expectations.h"

#include <filesystem>
#include <string>
#include <vector>

namespace conformance {

/// One form in which files were written, and what became worse.
class RoundTrip {
public:
    /// `form` as the exceptions name it.
    RoundTrip(const std::filesystem::path& exceptions, std::string form);

    /// The rows of one file before and after; records those in which more values differ after.
    void add(const std::string& file, const Results& before, const Results& after);

    /// A sentence for everything that is worse and no known exception, and for exceptions that no longer apply.
    [[nodiscard]] std::vector<std::string> violations() const;
    void print() const;

private:
    struct Totals {
        std::int64_t compared = 0, agreeing = 0;
        int worseFiles = 0;
    };
    /// Row and file.
    using Place = std::pair<std::string, std::string>;

    std::string mForm;
    std::map<Place, std::string> mKnown; ///< to the reason
    std::set<Place> mWorse;
    std::map<std::string, Totals> mTotals;
};

} // namespace conformance
