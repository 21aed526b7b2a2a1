// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx report: files as one self-contained page for a browser.
#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <sstream>
#include <system_error>

#include "Commands.h"
#include "FileList.h"
#include "Progress.h"
#include "ReportPage.h"
#include "ShowFiles.h"

namespace tool {
namespace {

namespace filesystem = std::filesystem;

/// Why the page must not be written; empty when it may. An existing report is replaced.
std::string refusal(const ReportOptions& options, const std::vector<std::string>& files) {
    std::error_code ignored;
    for (const std::string& file : files)
        if (filesystem::equivalent(file, options.output, ignored))
            return "is also an input file";
    if (options.force || !filesystem::exists(options.output, ignored))
        return {};
    std::string start(ReportPage::mark().size(), '\0');
    std::ifstream(options.output, std::ios::binary).read(start.data(), static_cast<std::streamsize>(start.size()));
    return start == ReportPage::mark() ? "" : "exists and is not a report; --force overwrites it";
}

/// A file that appears under its name when it is complete, or not at all.
class PageFile {
public:
    explicit PageFile(const std::string& name) : mName(name), mPart(name + ".part") {
        std::error_code ignored;
        while (filesystem::exists(mPart, ignored)) // it may belong to another program
            mPart += '~';
        mStream.open(mPart, std::ios::binary | std::ios::trunc);
        if (!mStream)
            fail("cannot be written");
    }
    ~PageFile() {
        std::error_code ignored;
        if (!mFinished)
            filesystem::remove(mPart, ignored);
    }
    PageFile(const PageFile&) = delete;
    PageFile& operator=(const PageFile&) = delete;

    [[nodiscard]] std::ostream& stream() { return mStream; }

    void finish() {
        mStream.close();
        std::error_code error;
        if (mStream)
            filesystem::rename(mPart, mName, error);
        if (!mStream || error)
            fail("cannot be written" + (error ? ": " + error.message() : std::string()));
        mFinished = true;
    }

private:
    [[noreturn]] void fail(const std::string& reason) { throw Unreadable(mName + ": " + reason); }

    std::string mName, mPart;
    std::ofstream mStream;
    bool mFinished = false;
};

class Report {
public:
    explicit Report(const ReportOptions& options) : mOptions(options) {}

    int run() {
        const FileList list = expandFiles(mOptions.files);
        for (const std::string& pattern : list.unmatched)
            lose(pattern, "no file matches the pattern");
        const std::string refused = mOptions.output == "-" ? "" : refusal(mOptions, list.files);
        if (!refused.empty()) {
            printError(mOptions.output, refused);
            return kWrongUsage;
        }
        if (list.files.empty())
            return mStatus;
        if (mOptions.output == "-") {
            write(list.files, std::cout);
            return mStatus;
        }
        const Outcome outcome = attempt([&]() -> int {
            PageFile page(mOptions.output);
            if (write(list.files, page.stream()))
                page.finish();
            return mStatus;
        });
        if (!outcome.reason.empty())
            lose(mOptions.output, outcome.reason);
        return mStatus;
    }

private:
    void lose(const std::string& file, const std::string& reason) {
        mProgress.hide();
        printError(file, reason);
        mStatus = kUnreadable;
    }

    /// False when no file could be read: there is no page then.
    bool write(const std::vector<std::string>& files, std::ostream& out) {
        ReportPage page(out);
        bool begun = false;
        for (const std::string& file : files) {
            mProgress.say("reading " + file);
            std::ostringstream document;
            ReportArrays arrays;
            const Outcome outcome = attempt([&]() -> int {
                JsonWriter json(document, /*pretty=*/false);
                json.beginObject();
                json.text("format", "tarnell-fbx report page 1");
                json.text("file", spoken(file));
                printReport(file, ReportScene(file, {mOptions.take, mOptions.frames}), &arrays, json);
                json.endObject();
                return kSuccess;
            });
            if (!outcome.reason.empty()) {
                lose(file, outcome.reason);
                continue;
            }
            if (!begun)
                page.begin();
            begun = true;
            page.addFile(document.str(), arrays);
        }
        if (begun)
            page.end();
        mProgress.hide();
        return begun;
    }

    const ReportOptions& mOptions;
    Progress mProgress;
    int mStatus = kSuccess;
};

} // namespace

int report(const ReportOptions& options) {
    if (options.form == Form::text)
        return Report(options).run();
    return showFiles(options, "report", [&options](Page& page) -> int {
        const ReportScene scene(page.file(), {options.take, options.frames});
        page.json("report", [&](JsonWriter& json) { printReport(page.file(), scene, nullptr, json); });
        return kSuccess;
    });
}

} // namespace tool
