// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The page of a report: the build output of tools/report, with the data of files inserted.
#pragma once

#include <ostream>
#include <string>

#include "JsonWriter.h"
#include "ReportArrays.h"
#include "ReportScene.h"

namespace tool {

/// The keys of one file's document. Its long arrays are added to `arrays`, and the document has their offsets; without
/// `arrays` they are inline.
void printReport(const std::string& file, const ReportScene& scene, ReportArrays* arrays, JsonWriter& json);

/// Writes a page: begin, then for each file its document and its arrays, then end.
class ReportPage {
public:
    explicit ReportPage(std::ostream& out) : mOut(out) {}
    void begin();
    void addFile(const std::string& document, const ReportArrays& arrays);
    void end();

    /// The first bytes of every report page.
    static std::string_view mark();

private:
    std::ostream& mOut;
};

} // namespace tool
