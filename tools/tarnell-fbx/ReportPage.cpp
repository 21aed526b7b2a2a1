// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "ReportPage.h"

#include <algorithm>

#include "ReportTemplate.h"

namespace tool {
namespace {

void put(std::ostream& out, std::span<const std::string_view> pieces) {
    for (const std::string_view piece : pieces)
        out << piece;
}

/// JSON escaped for HTML: nothing in it ends the element that holds it. "<" occurs in texts only.
std::string withoutMarkup(const std::string& json) {
    std::string text;
    text.reserve(json.size());
    for (const char c : json)
        if (c == '<')
            text += "\\u003c";
        else
            text += c;
    return text;
}

} // namespace

std::string_view ReportPage::mark() { return kReportHead.front().substr(0, kReportHead.front().find('\n')); }

void ReportPage::begin() { put(mOut, kReportHead); }

void ReportPage::addFile(const std::string& document, const ReportArrays& arrays) {
    mOut << R"(<script type="application/json" class="shot">)" << withoutMarkup(document) << "</script>\n"
         << R"(<script type="text/plain" class="arrays">)";
    arrays.write(mOut);
    mOut << "</script>\n";
}

void ReportPage::end() { put(mOut, kReportTail); }

} // namespace tool
