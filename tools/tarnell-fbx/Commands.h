// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The commands of the tool. Each returns the process's exit status.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace tool {

enum ExitStatus {
    kSuccess = 0,
    kUnreadable = 1, ///< something could not be read or written
    kWrongUsage = 2,
    kLosses = 3 ///< done, but with --strict something was lost
};

struct DumpOptions {
    std::string file;
    std::vector<std::string> kinds; ///< empty: all
    bool local = false;
    float frame = 0.0F;
    std::optional<std::pair<int, int>> frames; ///< meshes at every whole frame of the range
    std::optional<float> sampleFps;
    bool transformPoints = true;
    bool computeCameraRotation = false;
    std::optional<std::string> name;
    bool samples = true;
    bool pretty = false;
    bool faithful = false;
    std::string stack; ///< of faithful values; empty: the first one
};

enum class PointCache { maya, max, none };

struct ConvertOptions {
    std::string input, output;
    int version = 5; ///< as TnFbxWriteInfo counts them
    bool ascii = false;
    std::vector<std::string> kinds;            ///< empty: all
    std::optional<std::pair<int, int>> frames; ///< points of meshes at every whole frame, as point caches
    std::optional<float> fps;
    std::string stack; ///< empty: the first one
    PointCache cache = PointCache::maya;
    bool local = false;
    bool force = false;
    bool strict = false; ///< losses make the status kLosses
};

enum class Form { text, json, jsonLines, csv, plot, html };

/// The common options of the commands that inspect files.
struct LookOptions {
    std::vector<std::string> files; ///< names and patterns
    Form form = Form::text;
    int jobs = 1; ///< files at the same time
};

struct TreeOptions : LookOptions {
    int depth = 0; ///< levels; 0: all
};

struct PropsOptions : LookOptions {
    std::string object;
    std::string take;
    bool all = false; ///< also those with their default values
};

struct CurveOptions : LookOptions {
    std::string target; ///< NODE or NODE.PROPERTY
    std::string take;
    std::optional<std::pair<int, int>> frames; ///< sampled at every whole frame of the range
};

struct CacheOptions : LookOptions {
    bool verify = false;
    bool samples = false; ///< every sample in the JSON document
};

struct RecordsOptions : LookOptions {
    std::string path; ///< names of records, from the top: "Objects/Model"
    int depth = 0;    ///< levels; 0: all
    int values = 8;   ///< shown of a list; 0: all
};

struct CameraOptions : LookOptions {
    std::string name; ///< empty: all
    std::string take;
    std::optional<std::pair<int, int>> frames; ///< every whole frame of the range
    bool explain = false;
};

struct LintOptions : LookOptions {
    std::vector<std::string> rules; ///< ids; empty: all
    bool list = false;              ///< lists the rules, and reads no file
};

/// Two files instead of any number.
struct DiffOptions : LookOptions {
    std::string a, b;
    std::string take;
    double tolerance = 1e-4;                   ///< relative to the larger of 1 and the numbers
    std::optional<std::pair<int, int>> frames; ///< at which the points of meshes are compared
};

/// The names of the kinds of `dump`, in the order in which it prints them.
const std::vector<std::string>& dumpKinds();

int dump(const DumpOptions& options);
int convert(const ConvertOptions& options);
int info(const LookOptions& options);
int tree(const TreeOptions& options);
int props(const PropsOptions& options);
int camera(const CameraOptions& options);
int curve(const CurveOptions& options);
int cache(const CacheOptions& options);
int diff(const DiffOptions& options);
int lint(const LintOptions& options);
int records(const RecordsOptions& options);

struct ReportOptions : LookOptions {
    std::string output; ///< the page; "-": standard output
    std::string take;
    std::optional<std::pair<int, int>> frames; ///< only these
    bool force = false;                        ///< also over files that are no report
};

int report(const ReportOptions& options); ///< not in builds without npm

/// The text for display: without control characters for terminals.
std::string spoken(const std::string& text);

/// One line on standard error, as every failure of the tool prints it.
void printError(const std::string& file, const std::string& reason);

struct Outcome {
    int status = kSuccess;
    std::string reason; ///< why work ended early; empty when it did not
};
/// Runs work. What it throws is a failure like any other, with the status kUnreadable; OutputFailure is passed on.
Outcome attempt(const std::function<int()>& work);

/// Runs work on a file, and returns its exit status. The reason of a failure is printed.
int guarded(const std::string& file, const std::function<int()>& work);

} // namespace tool
