// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The level that each row has reached, and the files that are known to differ, each with its reason.
#pragma once

#include <cstdint>
#include <filesystem>
#include <map>
#include <set>
#include <string>
#include <vector>

namespace conformance {

/// The findings of a run for a row over all files.
struct RowResult {
    std::int64_t compared = 0;
    std::int64_t agreeing = 0;
    int files = 0; ///< in which anything was compared
    std::set<std::string> differingFiles;
};

using Results = std::map<std::string, RowResult>;

struct ExpectedRow {
    std::int64_t compared = 0;
    std::int64_t agreeing = 0;
    std::map<std::string, std::string> reasons; ///< by the name of a differing file
};

class Expectations {
public:
    explicit Expectations(const std::filesystem::path& path);

    /// A sentence for everything that is worse than expected, or better without being recorded.
    [[nodiscard]] std::vector<std::string> violations(const Results& results) const;
    /// Why a file differs in a row; empty when no reason is recorded.
    [[nodiscard]] std::string reasonOf(const std::string& row, const std::string& file) const;
    /// Records the numbers. Files that agree now are dropped, new ones are added without a reason, which violates.
    void update(const Results& results);
    void write() const;

private:
    std::filesystem::path mPath;
    std::map<std::string, ExpectedRow> mRows;
};

} // namespace conformance
