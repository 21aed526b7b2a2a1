// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deviations with a reason.
#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace conformance {

class Explanations {
public:
    /// Those of the file for this form: a list of {reason, forms, deviations}, where `*` in a deviation
    /// matches anything. Throws std::runtime_error when one has no reason.
    Explanations(const std::filesystem::path& path, const std::string& form);

    /// Whether one of them explains the deviation.
    bool explain(const std::string& deviation);
    /// Patterns that have explained nothing so far.
    [[nodiscard]] std::vector<std::string> unused() const;

private:
    struct Pattern {
        std::string text;
        bool used = false;
    };
    std::vector<Pattern> mPatterns;
};

} // namespace conformance
