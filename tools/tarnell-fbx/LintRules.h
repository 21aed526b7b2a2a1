// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Likely problems of a file in other programs, as data for the commands to print.
#pragma once

#include <string>
#include <vector>

#include "SceneFile.h"

namespace tool {

/// note: worth knowing. warning: programs will differ. error: something is lost or undefined.
enum class Severity { note, warning, error };
const char* severityName(Severity severity);

struct LintContext;
struct LintReport;
using LintCheck = void(const LintContext& context, LintReport& report);

struct LintRule {
    const char* id; ///< stable, "keys-between-frames"
    Severity severity;
    const char* reason;     ///< why it matters
    const char* remedy;     ///< what to do
    LintCheck* check;       ///< of the file; null if the rule depends on the take only
    LintCheck* checkInTake; ///< of each take, once in files without takes; null if the rule does not depend on it
};

/// All rules, in the order in which findings are reported.
const std::vector<LintRule>& lintRules();

struct Finding {
    const LintRule* rule = nullptr;
    std::string object; ///< the name of the object it is about; empty for the file as a whole
    std::string text;
    std::vector<std::string> takes; ///< in which it holds; empty if it does not depend on the take

    /// The text, followed by the takes in which it holds unless these are all `takeCount` of the file.
    [[nodiscard]] std::string sentence(std::size_t takeCount) const;
};

struct LintFindings {
    std::vector<Finding> all; ///< in the order of the rules
    std::size_t takeCount = 0;
};

/// What the rules find in a file, all of them or those with the ids. Values are those of faithful reads of each take,
/// at its first frame where they change.
LintFindings lintFindings(const std::string& file, const SceneFile& opened, const std::vector<std::string>& ids = {});

} // namespace tool
