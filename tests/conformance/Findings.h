// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What one row of the table finds in one file: how much was compared, how much agreed, and what did not.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace conformance {

class Findings {
public:
    /// Keeps the first `differencesToKeep` differences; all are counted.
    explicit Findings(std::size_t differencesToKeep) : mDifferencesToKeep(differencesToKeep) {}

    /// One comparison. `describe` makes the sentence for a difference and is only called for one.
    template <class Describe>
    void compare(bool agrees, const Describe& describe) {
        ++mCompared;
        if (agrees)
            ++mAgreeing;
        else if (mDifferences.size() < mDifferencesToKeep)
            mDifferences.push_back(describe());
    }

    [[nodiscard]] std::int64_t compared() const { return mCompared; }
    [[nodiscard]] std::int64_t agreeing() const { return mAgreeing; }
    [[nodiscard]] bool differs() const { return mAgreeing < mCompared; }
    [[nodiscard]] const std::vector<std::string>& differences() const { return mDifferences; }

private:
    std::size_t mDifferencesToKeep;
    std::int64_t mCompared = 0;
    std::int64_t mAgreeing = 0;
    std::vector<std::string> mDifferences;
};

/// Numbers as they are printed in differences: nine digits, separated by blanks.
std::string printed(double value);
std::string printed(const double* values, std::size_t count);

} // namespace conformance
