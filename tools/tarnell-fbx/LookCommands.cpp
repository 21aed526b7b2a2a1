// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Options common to several commands, and those of each command that inspects files.
#include "LookCommands.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <memory>
#include <string_view>
#include <system_error>

#include "Commands.h"
#include "LintRules.h"
#include "Similarity.h"

namespace tool {
namespace {

std::optional<int> wholeNumber(std::string_view text) {
    int number = 0;
    const char* const end = text.data() + text.size();
    const auto [rest, error] = std::from_chars(text.data(), end, number);
    return rest == end && error == std::errc() ? std::optional(number) : std::nullopt;
}

std::string parseFrames(const std::string& text, std::optional<std::pair<int, int>>& frames) {
    const std::size_t colon = text.find(':');
    const std::optional<int> first = wholeNumber(text.substr(0, colon));
    const std::optional<int> last = colon == std::string::npos ? first : wholeNumber(text.substr(colon + 1));
    if (!first || !last)
        return "not a frame range: " + text;
    if (*first > *last)
        return "the range " + text + " ends before it starts";
    frames = {*first, *last};
    return {};
}

/// A whole number from `least` on; the command line's own conversion accepts other texts as well.
void addCount(CLI::App& command, const char* name, int& count, int least, const char* help) {
    command
        .add_option_function<std::string>(
            name,
            [name, &count, least](const std::string& text) {
                const std::optional<int> number = wholeNumber(text);
                if (!number || *number < least)
                    throw CLI::ValidationError(name,
                                               "not a whole number of at least " + std::to_string(least) + ": " + text);
                count = *number;
            },
            help)
        ->type_name("N");
}

void addForm(CLI::App& command, LookOptions& options, const char* name, Form form, const char* help) {
    command.add_flag_callback(
        name,
        [name, form, &options] {
            if (options.form != Form::text)
                throw CLI::ValidationError(name, "only one output format can be selected");
            options.form = form;
        },
        help);
}

void addJson(CLI::App& command, LookOptions& options) {
    addForm(command, options, "--json", Form::json, "Print JSON: one object, or for several files an array of them");
    addForm(command, options, "--jsonl", Form::jsonLines, "Print JSON, one line per file");
}

void addFiles(CLI::App& command, LookOptions& options, const char* help) {
    command.add_option("FILE", options.files, help)->required()->type_name("");
    addJson(command, options);
    addCount(command, "--jobs", options.jobs, 1, "Number of files to read in parallel");
}

void addTake(CLI::App& command, std::string& take) {
    command.add_option("--take,--stack", take, "Name of the take (animation stack); default: the first")
        ->type_name("NAME");
}

/// A command whose options exist as long as it can be run.
template <class Options>
std::pair<CLI::App*, Options*> addCommand(CLI::App& app, std::function<int()>& chosen, const char* name,
                                          const char* help, int (*work)(const Options&)) {
    CLI::App* command = app.add_subcommand(name, help);
    auto options = std::make_shared<Options>();
    command->callback([options, &chosen, work] { chosen = [options, work] { return work(*options); }; });
    return {command, options.get()};
}

void addTree(CLI::App& app, std::function<int()>& chosen) {
    auto [command, options] = addCommand<TreeOptions>(
        app, chosen, "tree", "Show the node hierarchy, with what is attached to each node", tree);
    addFiles(*command, *options, "FBX files, or file name patterns");
    addCount(*command, "--depth", options->depth, 1, "Maximum number of levels");
}

void addProps(CLI::App& app, std::function<int()>& chosen) {
    auto [command, options] = addCommand<PropsOptions>(app, chosen, "props", "Show the properties of an object", props);
    options->files.resize(1);
    command->add_option("FILE", options->files.front(), "The FBX file")->required()->type_name("");
    command->add_option("OBJECT", options->object, "Name of a node or of any other object")->required()->type_name("");
    command->add_flag("--all", options->all,
                      "Include properties that the file does not state, with the defaults of their class");
    addTake(*command, options->take);
    addJson(*command, *options);
}

void addCamera(CLI::App& app, std::function<int()>& chosen) {
    auto [command, options] = addCommand<CameraOptions>(
        app, chosen, "camera", "Show lens, film back, picture and placement of cameras, as in the application", camera);
    addFiles(*command, *options, "FBX files, or file name patterns");
    command->add_option("--name", options->name, "Only cameras with this name")->type_name("NAME");
    addFrames(*command, options->frames, "Values at every whole frame of A:B");
    addTake(*command, options->take);
    command->add_flag("--explain", options->explain, "Explain how each value is derived");
    addForm(*command, *options, "--csv", Form::csv, "Print CSV, one line per camera and frame");
}

void addCurve(CLI::App& app, std::function<int()>& chosen) {
    auto [command, options] =
        addCommand<CurveOptions>(app, chosen, "curve", "Show the keys and samples of animated properties", curve);
    options->files.resize(1);
    command->add_option("FILE", options->files.front(), "The FBX file")->required()->type_name("");
    command
        ->add_option("NODE", options->target,
                     "NODE, NODE.PROPERTY or NODE.PROPERTY.X; a node includes its camera or light")
        ->required()
        ->type_name("");
    addFrames(*command, options->frames, "Samples at every whole frame of A:B");
    addTake(*command, options->take);
    addJson(*command, *options);
    addForm(*command, *options, "--csv", Form::csv, "Print samples as CSV, one line per frame");
    addForm(*command, *options, "--plot", Form::plot, "Plot the curves");
}

void addCache(CLI::App& app, std::function<int()>& chosen) {
    auto [command, options] = addCommand<CacheOptions>(
        app, chosen, "cache", "Show the content of point caches, of an FBX file or given as cache files", cache);
    addFiles(*command, *options, "FBX, .xml, .mc, .mcx and .pc2 files, or file name patterns");
    command->add_flag("--verify", options->verify, "Check every value; exit with status 1 if there is a fault");
    command->add_flag("--samples", options->samples, "List every sample with its file and offset");
}

/// A number from 0 on; the command line's own conversion accepts infinities and NaN.
std::string parseTolerance(const std::string& text, double& tolerance) {
    double number = -1.0;
    const char* const end = text.data() + text.size();
    const auto [rest, error] = std::from_chars(text.data(), end, number);
    if (rest != end || error != std::errc() || !std::isfinite(number) || number < 0.0)
        return "not a number of at least 0: " + text;
    tolerance = number;
    return {};
}

void addDiff(CLI::App& app, std::function<int()>& chosen) {
    auto [command, options] = addCommand<DiffOptions>(app, chosen, "diff", "Compare what two files show", diff);
    command->add_option("A", options->a, "The first FBX file")->required()->type_name("");
    command->add_option("B", options->b, "The second FBX file; one of the two may be - for standard input")
        ->required()
        ->type_name("");
    command
        ->add_option_function<std::string>(
            "--tolerance",
            [&tolerance = options->tolerance](const std::string& text) {
                const std::string complaint = parseTolerance(text, tolerance);
                if (!complaint.empty())
                    throw CLI::ValidationError("--tolerance", complaint);
            },
            "Tolerance relative to the larger of 1 and the magnitude of the values (default: 0.0001)")
        ->type_name("T");
    addFrames(*command, options->frames, "Compare mesh points at every whole frame of A:B (default: the first frame)");
    addTake(*command, options->take);
    addJson(*command, *options);
    addForm(*command, *options, "--html", Form::html, "Print an HTML page");
    command->parse_complete_callback([a = &options->a, b = &options->b] {
        if (*a == "-" && *b == "-")
            throw CLI::ValidationError("B", "only one of the two files can be standard input");
    });
    command->footer("Exit status: 0 no differences; 1 differences, or a file could not be read; 2 invalid usage.\n");
}

std::string unknownRule(const std::string& id) {
    std::vector<std::string> ids;
    for (const LintRule& rule : lintRules())
        ids.emplace_back(rule.id);
    if (std::find(ids.begin(), ids.end(), id) != ids.end())
        return {};
    std::string answer = "unknown rule " + id;
    for (const std::string& similar : mostSimilar(id, ids))
        answer += "; did you mean " + similar + '?';
    return answer;
}

void addLint(CLI::App& app, std::function<int()>& chosen) {
    auto [command, options] = addCommand<LintOptions>(
        app, chosen, "lint", "Report likely problems of a file in other programs, with remedies", lint);
    addFiles(*command, *options, "FBX files, or file name patterns");
    command->get_option("FILE")->required(false);
    command->add_option("--rules", options->rules, "Comma-separated list of the rules to check (default: all)")
        ->delimiter(',')
        ->type_name("LIST")
        ->allow_extra_args(false)
        ->check(unknownRule);
    command->add_flag("--list", options->list, "List the rules");
    command->footer("Exit status: 0 no findings, or notes only; 1 errors or warnings, or a file could not be read; 2 "
                    "invalid usage.\n");
    command->parse_complete_callback([files = &options->files, list = &options->list] {
        if (files->empty() && !*list)
            throw CLI::RequiredError("FILE");
    });
}

void addRecords(CLI::App& app, std::function<int()>& chosen) {
    auto [command, options] = addCommand<RecordsOptions>(
        app, chosen, "records", "Show the records of a file, with their offsets or lines", records);
    addFiles(*command, *options, "FBX files, or file name patterns");
    command
        ->add_option("--path", options->path, "Only records with this path from the top level, such as Objects/Model")
        ->type_name("PATH");
    addCount(*command, "--depth", options->depth, 1, "Maximum number of levels; deeper records are counted");
    addCount(*command, "--values", options->values, 0, "Maximum number of values per list (default: 8; 0: all)");
}

#ifdef TARNELL_FBX_REPORT
void addReport(CLI::App& app, std::function<int()>& chosen) {
    auto [command, options] = addCommand<ReportOptions>(app, chosen, "report", "Write an HTML report of files", report);
    command->add_option("FILE", options->files, "FBX files, or file name patterns")->required()->type_name("");
    command->add_option("-o,--output", options->output, "The HTML file to write; - for standard output")
        ->type_name("PAGE");
    addJson(*command, *options);
    addFrames(*command, options->frames, "Only the frames A to B");
    addTake(*command, options->take);
    command->add_flag("--force", options->force, "Overwrite an existing file that is not a report");
    command->parse_complete_callback([chosenOptions = options] {
        const bool isPage = chosenOptions->form == Form::text;
        if (isPage && chosenOptions->output.empty())
            throw CLI::RequiredError("--output (or --json)");
        if (!isPage && !chosenOptions->output.empty())
            throw CLI::ValidationError("--output", "JSON is printed on standard output");
    });
}
#else
void addReport(CLI::App&, std::function<int()>&) {} // main prints the reason
#endif

} // namespace

void addFrames(CLI::App& command, std::optional<std::pair<int, int>>& frames, const char* help) {
    command
        .add_option_function<std::string>(
            "--frames",
            [&frames](const std::string& text) {
                const std::string complaint = parseFrames(text, frames);
                if (!complaint.empty())
                    throw CLI::ValidationError("--frames", complaint);
            },
            help)
        ->type_name("A:B");
}

void addLookCommands(CLI::App& app, std::function<int()>& chosen) {
    auto [command, options] =
        addCommand<LookOptions>(app, chosen, "info", "Show a summary of a file on one screen", info);
    addFiles(*command, *options, "FBX files, or file name patterns");
    addTree(app, chosen);
    addProps(app, chosen);
    addCamera(app, chosen);
    addCurve(app, chosen);
    addCache(app, chosen);
    addDiff(app, chosen);
    addLint(app, chosen);
    addRecords(app, chosen);
    addReport(app, chosen);
}

} // namespace tool
