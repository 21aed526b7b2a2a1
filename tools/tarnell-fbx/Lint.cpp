// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx lint: likely problems of a file in other programs.
#include <algorithm>
#include <iostream>
#include <map>

#include "Commands.h"
#include "LintRules.h"
#include "SceneFacts.h"
#include "ShowFiles.h"
#include "Table.h"
#include "TerminalText.h"

namespace tool {
namespace {

Ink inkOf(Severity severity) { return severity == Severity::note ? Ink::faint : Ink::warning; }

std::size_t countOf(const std::vector<Finding>& findings, Severity severity) {
    return static_cast<std::size_t>(std::count_if(
        findings.begin(), findings.end(), [severity](const Finding& each) { return each.rule->severity == severity; }));
}

/// Notes by themselves are not a failure.
int statusOf(const std::vector<Finding>& findings) {
    return countOf(findings, Severity::note) == findings.size() ? kSuccess : kUnreadable;
}

std::string summary(const std::vector<Finding>& findings) {
    std::string text;
    for (const Severity severity : {Severity::error, Severity::warning, Severity::note}) {
        const std::size_t count = countOf(findings, severity);
        if (count > 0)
            text += (text.empty() ? "" : ", ") + std::to_string(count) + ' ' + severityName(severity) +
                    (count == 1 ? "" : "s");
    }
    return text.empty() ? "no findings" : text;
}

// ---- Text ----

/// Of a rule that finds more, the rest are counted.
constexpr std::size_t kMostShown = 20;

void printRule(const LintRule& rule, const LintFindings& findings, std::ostream& out, const Terminal& terminal) {
    out << "  " << terminal.paint(inkOf(rule.severity), severityName(rule.severity)) << "  "
        << terminal.paint(Ink::name, rule.id) << '\n';
    std::size_t count = 0;
    for (const Finding& finding : findings.all) {
        if (finding.rule != &rule || ++count > kMostShown)
            continue;
        out << "    " << (finding.object.empty() ? "" : inQuotes(finding.object) + ": ")
            << terminalText(finding.sentence(findings.takeCount)) << '\n';
    }
    if (count > kMostShown)
        out << "    … and " << count - kMostShown << " more; --json lists all\n";
    out << "    " << terminal.paint(Ink::faint, rule.reason) << "\n    → " << rule.remedy << '\n';
}

void printText(const LintFindings& findings, Page& page) {
    std::ostream& out = page.begin();
    out << page.terminal().paint(Ink::heading, spoken(page.file())) << "  " << summary(findings.all) << '\n';
    for (const Severity severity : {Severity::error, Severity::warning, Severity::note}) {
        for (const LintRule& rule : lintRules()) {
            const bool found = std::any_of(findings.all.begin(), findings.all.end(),
                                           [&](const Finding& each) { return each.rule == &rule; });
            if (found && rule.severity == severity)
                printRule(rule, findings, out, page.terminal());
        }
    }
}

// ---- JSON ----

void printRule(const LintRule& rule, JsonWriter& json) {
    json.text("rule", rule.id);
    json.text("severity", severityName(rule.severity));
    json.text("reason", rule.reason);
    json.text("remedy", rule.remedy);
}

void printJson(const std::vector<Finding>& findings, JsonWriter& json) {
    json.integer("errors", static_cast<long long>(countOf(findings, Severity::error)));
    json.integer("warnings", static_cast<long long>(countOf(findings, Severity::warning)));
    json.integer("notes", static_cast<long long>(countOf(findings, Severity::note)));
    json.key("findings");
    json.beginArray();
    for (const Finding& finding : findings) {
        json.beginObject();
        printRule(*finding.rule, json);
        json.key("object");
        if (finding.object.empty())
            json.null();
        else
            json.text(finding.object);
        json.text("text", finding.text);
        json.key("takes");
        json.beginArray();
        for (const std::string& take : finding.takes)
            json.text(take);
        json.endArray();
        json.endObject();
    }
    json.endArray();
}

int listRules(Form form) {
    if (form == Form::text) {
        Table table({{"Rule", Table::Align::left, Ink::name}, {"Severity"}, {"Reason"}});
        for (const LintRule& rule : lintRules())
            table.addRow({rule.id, severityName(rule.severity), rule.reason});
        table.print(std::cout, standardTerminal(), 0);
        return kSuccess;
    }
    JsonWriter json(std::cout, form == Form::json);
    json.beginArray();
    for (const LintRule& rule : lintRules()) {
        json.beginObject();
        printRule(rule, json);
        json.endObject();
    }
    json.endArray();
    std::cout << '\n';
    return kSuccess;
}

} // namespace

int lint(const LintOptions& options) {
    if (options.list)
        return listRules(options.form);
    return showFiles(options, "lint", [&options](Page& page) -> int {
        const SceneFile opened(page.file());
        const LintFindings findings = lintFindings(page.file(), opened, options.rules);
        if (page.isJson())
            page.json("lint", [&](JsonWriter& json) { printJson(findings.all, json); });
        else
            printText(findings, page);
        return statusOf(findings.all);
    });
}

} // namespace tool
