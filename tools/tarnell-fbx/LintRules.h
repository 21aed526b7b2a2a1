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

struct LintRule {
    const char* id; ///< stable, "keys-between-frames"
    Severity severity;
    const char* reason; ///< why it matters
    const char* remedy; ///< what to do
    void (*check)(const LintContext&, LintReport&);
};

/// All rules, in the order in which findings are reported.
const std::vector<LintRule>& lintRules();

struct Finding {
    const LintRule* rule = nullptr;
    std::string object; ///< the name of the object it is about; empty for the file as a whole
    std::string text;
};

/// The findings of the rules in a file, of all of them or those with the ids. Values are those of a faithful read of
/// the first take.
std::vector<Finding> lintFindings(const std::string& file, const SceneFile& opened,
                                  const std::vector<std::string>& ids = {});

} // namespace tool
