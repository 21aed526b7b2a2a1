// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Names from files are escaped, whatever they contain.
#include "DiffPage.h"

#include "CameraOrigins.h"
#include "SceneFacts.h"
#include "TerminalText.h"

namespace tool {
namespace {

constexpr const char* kHead = R"(<!DOCTYPE html>
<html lang="en">
<head>
<meta charset="utf-8">
<meta name="viewport" content="width=device-width">
<title>Differences of two FBX files</title>
<style>
:root { color-scheme: light dark; font: 15px/1.5 system-ui, sans-serif; }
body { margin: 2rem auto; max-width: 75rem; padding: 0 1rem; }
h1 { font-size: 1.3rem; overflow-wrap: anywhere; }
table { border-collapse: collapse; width: 100%; }
th, td { text-align: left; vertical-align: top; padding: .3rem .6rem; border-bottom: 1px solid #8886;
  overflow-wrap: anywhere; }
td.number { text-align: right; font-variant-numeric: tabular-nums; white-space: nowrap; }
tbody tr:hover { background: #8882; }
@media print { body { margin: 0; max-width: none; } thead { display: table-header-group; } }
</style>
</head>
<body>
)";

std::string escaped(const std::string& text) {
    std::string result;
    for (const char character : terminalText(text)) {
        switch (character) {
        case '&':
            result += "&amp;";
            break;
        case '<':
            result += "&lt;";
            break;
        case '>':
            result += "&gt;";
            break;
        case '"':
            result += "&quot;";
            break;
        default:
            result += character;
        }
    }
    return result;
}

std::string amountText(const Difference& difference) {
    if (!difference.amount)
        return {};
    const std::string unit =
        difference.unit.empty() || difference.unit == "°" ? difference.unit : ' ' + difference.unit;
    return significant(*difference.amount, 4) + unit;
}

void writeRow(const Difference& difference, std::ostream& out) {
    out << "<tr><td>" << diffKindName(difference.kind) << "</td><td>" << escaped(difference.object) << "</td><td>"
        << escaped(difference.what);
    if (difference.carried > 0)
        out << " (and " << difference.carried << " below it)";
    out << "</td><td>" << escaped(difference.a) << "</td><td>" << escaped(difference.b) << "</td><td class=\"number\">"
        << escaped(amountText(difference)) << "</td><td class=\"number\">"
        << (difference.frame ? rounded(*difference.frame, 3) : "") << "</td></tr>\n";
}

} // namespace

void writeDiffPage(const DiffPage& page, std::ostream& out) {
    out << kHead << "<h1>" << escaped(page.a) << " → " << escaped(page.b) << "</h1>\n";
    if (page.found.empty()) {
        out << "<p>No difference beyond " << numberText(page.tolerance) << ".</p>\n</body>\n</html>\n";
        return;
    }
    out << "<p>" << page.found.size() << (page.found.size() == 1 ? " difference" : " differences") << " beyond "
        << numberText(page.tolerance)
        << ". Faithful values, in centimetres and with Y up; frames are those of the first "
        << "file.</p>\n<table>\n<thead><tr><th scope=\"col\">Kind</th><th scope=\"col\">Object</th>"
        << "<th scope=\"col\">What</th><th scope=\"col\">First file</th><th scope=\"col\">Second file</th>"
        << "<th scope=\"col\">Difference</th><th scope=\"col\">Frame</th></tr></thead>\n<tbody>\n";
    for (const Difference& each : page.found)
        writeRow(each, out);
    out << "</tbody>\n</table>\n</body>\n</html>\n";
}

} // namespace tool
