// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx: options and commands.
#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <functional>
#include <iostream>
#include <map>
#include <sstream>
#include <string_view>
#include <system_error>

#include <unistd.h>

#include <CLI/CLI.hpp>

#include "Commands.h"
#include "Fbx.h"
#include "LookCommands.h"
#include "Manual.h"
#include "Similarity.h"
#include "StandardInput.h"
#include "StandardOutput.h"
#include "TerminalText.h"

namespace {

/// The number that is the whole of the text.
template <class Number>
std::optional<Number> parse(std::string_view text) {
    Number number = 0;
    const char* const end = text.data() + text.size();
    const auto [rest, error] = std::from_chars(text.data(), end, number);
    return rest == end && error == std::errc() ? std::optional(number) : std::nullopt;
}

/// For options with a number where the command line's own conversion also accepts empty text, NaN or infinity.
std::string refuseUnlessFinite(const std::string& text) {
    const std::optional<float> number = parse<float>(text);
    return number && std::isfinite(*number) ? "" : "not a number: " + text;
}

std::vector<std::string> parseKinds(const std::string& text, const std::vector<std::string>& known) {
    std::vector<std::string> kinds;
    for (std::size_t start = 0; start <= text.size();) { // also where nothing is between or after commas
        const std::size_t end = std::min(text.find(',', start), text.size());
        const std::string kind = text.substr(start, end - start);
        if (std::find(known.begin(), known.end(), kind) == known.end())
            throw CLI::ValidationError("--kind", "unknown kind: \"" + kind + '"');
        kinds.push_back(kind);
        start = end + 1;
    }
    return kinds;
}

void addDump(CLI::App& app, tool::DumpOptions& options) {
    CLI::App* dump = app.add_subcommand("dump", "Print what the library reads as one JSON document");
    dump->add_option("FILE", options.file, "The FBX file; - for standard input")->required();
    dump->add_option_function<std::string>(
            "--kind", [&options](const std::string& text) { options.kinds = parseKinds(text, tool::dumpKinds()); },
            "Comma-separated list of cameras, lights, markers, nulls, transforms, meshes (default: all)")
        ->type_name("LIST");
    dump->add_flag("--local", options.local, "Local instead of global transforms");
    dump->add_option("--frame", options.frame, "Frame at which static values and meshes are read")
        ->check(refuseUnlessFinite);
    tool::addFrames(*dump, options.frames, "Read meshes at every whole frame of A:B");
    dump->add_option("--sample-fps", options.sampleFps, "Sample rate in frames per second")
        ->check(refuseUnlessFinite)
        ->check(CLI::PositiveNumber);
    dump->add_flag_callback(
        "--no-transform-points", [&options] { options.transformPoints = false; },
        "Keep mesh points in the space of their node, skinned ones in world space");
    dump->add_flag("--compute-camera-rotation", options.computeCameraRotation,
                   "Compute the rotation of cameras without target from their point of interest");
    dump->add_option("--name", options.name, "Only the object with this name");
    dump->add_flag_callback(
        "--no-samples", [&options] { options.samples = false; }, "Omit the sample arrays");
    dump->add_flag("--pretty", options.pretty, "Indent the output");
    CLI::Option* faithful =
        dump->add_flag("--faithful", options.faithful,
                       "Read what the application shows, not the compatible values that older hosts rely on");
    dump->add_option("--take,--stack", options.stack, "Name of the take (animation stack); default: the first")
        ->needs(faithful);
}

void addConvert(CLI::App& app, tool::ConvertOptions& options) {
    CLI::App* convert = app.add_subcommand("convert", "Convert a file to another version, encoding or frame rate");
    convert->add_option("IN", options.input, "The FBX file to read; - for standard input")->required();
    convert->add_option("OUT", options.output, "The FBX file to write; - for standard output")->required();
    convert
        ->add_option_function<std::string>(
            "--version",
            [&options](const std::string& text) {
                const std::vector<std::string> years = {"2010", "2011", "2012", "2013", "2014", "2016"};
                const auto found = std::find(years.begin(), years.end(), text);
                if (found == years.end())
                    throw CLI::ValidationError("--version", "unknown version: " + text);
                options.version = static_cast<int>(found - years.begin());
            },
            "2010, 2011, 2012, 2013, 2014 or 2016 (default)")
        ->type_name("YEAR");
    CLI::Option* ascii = convert->add_flag("--ascii", options.ascii, "Write an ASCII file");
    convert
        ->add_flag_callback(
            "--binary", [&options] { options.ascii = false; }, "Write a binary file (default)")
        ->excludes(ascii);
    convert
        ->add_option_function<std::string>(
            "--kind",
            [&options](const std::string& text) {
                options.kinds = parseKinds(text, {"cameras", "lights", "nulls", "transforms", "meshes"});
            },
            "Comma-separated list of cameras, lights, nulls, transforms, meshes (default: all)")
        ->type_name("LIST");
    convert->add_option("--take,--stack", options.stack, "Name of the take (animation stack); default: the first");
    tool::addFrames(*convert, options.frames, "Write the points of meshes at every whole frame of A:B as point caches");
    convert->add_option("--fps", options.fps, "Frame rate to sample and write at, in frames per second")
        ->check(refuseUnlessFinite)
        ->check(CLI::PositiveNumber);
    const std::map<std::string, tool::PointCache> caches = {
        {"maya", tool::PointCache::maya}, {"max", tool::PointCache::max}, {"none", tool::PointCache::none}};
    convert->add_option("--cache", options.cache, "Point cache format: maya (default), max, none")
        ->transform(CLI::CheckedTransformer(caches).description(""))
        ->type_name("FORM");
    convert->add_flag("--local", options.local, "Local instead of global transforms");
    convert->add_flag("--force", options.force, "Overwrite existing files");
    convert->add_flag("--strict", options.strict, "Exit with status 3 if anything is lost");
}

constexpr const char* kStatuses = "Exit status: 0 success; 1 something could not be read or written, lint found errors "
                                  "or warnings, diff found differences, or cache found faults while verifying; 2 "
                                  "invalid usage; 3 with --strict: the file was written, but something was lost.\n";

/// The first word, when it is no option; an unknown command gets a message of its own.
std::string unknownCommand(const CLI::App& app, const std::string& word) {
    std::vector<std::string> names{"help"};
    for (const CLI::App* command : app.get_subcommands([](const CLI::App*) { return true; }))
        names.push_back(command->get_name());
    if (word.empty() || word.front() == '-' || std::find(names.begin(), names.end(), word) != names.end())
        return {};
    if (word == "report")
        return "report is not available: the tool was built without npm";
    std::string answer = "unknown command \"" + word + '"';
    const std::vector<std::string> similar = tool::mostSimilar(word, names);
    for (std::size_t i = 0; i < similar.size(); ++i)
        answer += (i == 0 ? "; did you mean " : " or ") + similar[i];
    return answer + (similar.empty() ? "; see tarnell-fbx help" : "?");
}

/// Prints the help of the tool, or of the command in the second word.
int help(CLI::App& app, const std::string& command) {
    if (command.empty()) {
        std::cout << app.help();
        return tool::kSuccess;
    }
    const std::string unknown = unknownCommand(app, command);
    if (!unknown.empty()) {
        std::cerr << "tarnell-fbx: " << tool::terminalText(unknown) << '\n';
        return tool::kWrongUsage;
    }
    std::cout << (command == "help" ? app.help() : app.get_subcommand(command)->help("tarnell-fbx"));
    return tool::kSuccess;
}

/// Adds the options for the build, which are not in the help.
void addSources(CLI::App& app, std::function<int()>& chosen) {
    CLI::App* manual = app.add_subcommand("manual", "Print the manual page, for man")->group("");
    manual->callback([&app, &chosen] {
        chosen = [&app]() -> int {
            tool::writeManual(app, std::cout);
            return tool::kSuccess;
        };
    });
    CLI::App* completion = app.add_subcommand("completion", "Print the completion script for a shell");
    completion
        ->add_option_function<std::string>(
            "SHELL",
            [&app, &chosen](const std::string& shell) {
                std::ostringstream text;
                if (!tool::writeCompletion(app, shell, text))
                    throw CLI::ValidationError("SHELL", "no completions for " + shell + "; supported: bash, zsh, fish");
                chosen = [text = std::move(text).str()]() -> int {
                    std::cout << text;
                    return tool::kSuccess;
                };
            },
            "bash, zsh or fish")
        ->required()
        ->type_name("");
}

/// The argument where a file is "-".
void takeStandardInput(std::string& file) {
    if (file == "-")
        file = tool::keepStandardInput();
}

int run(int argc, char** argv) {
    CLI::App app("Inspect, compare and convert FBX files", "tarnell-fbx");
    app.require_subcommand(1);
    app.footer(kStatuses);
    app.set_version_flag("--version", std::string("tarnell-fbx ") + TARNELL_FBX_VERSION);
    std::function<int()> chosen;
    tool::addLookCommands(app, chosen);
    tool::DumpOptions dumpOptions;
    addDump(app, dumpOptions);
    tool::ConvertOptions convertOptions;
    addConvert(app, convertOptions);
    addSources(app, chosen);

    const std::vector<std::string> words(argv + 1, argv + argc);
    if (!words.empty() && words[0] == "help")
        return help(app, words.size() > 1 ? words[1] : "");
    const std::string unknown = words.empty() ? "" : unknownCommand(app, words[0]);
    if (!unknown.empty()) {
        std::cerr << "tarnell-fbx: " << tool::terminalText(unknown) << '\n';
        return tool::kWrongUsage;
    }
    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& error) {
        const bool asked = error.get_exit_code() == 0; // --help, --version
        app.exit(error, std::cout, std::cerr);
        return asked ? tool::kSuccess : tool::kWrongUsage;
    }
    if (chosen)
        return chosen();
    for (std::string* file : {&dumpOptions.file, &convertOptions.input})
        takeStandardInput(*file);
    if (app.got_subcommand("convert"))
        return tool::guarded(
            convertOptions.input, [&] { return tool::convert(convertOptions); });
    return tool::guarded(dumpOptions.file, [&] { return tool::dump(dumpOptions); });
}

/// Runs, and ensures that all output is written.
int runToTheEnd(int argc, char** argv) {
    try {
        tool::CheckedOutput output(std::cout, STDOUT_FILENO);
        const int status = run(argc, argv);
        output.finish();
        return status;
    } catch (const tool::OutputFailure& failure) { // the stream is the default one again
        if (!failure.readerLeft())
            tool::printError("standard output", std::generic_category().message(failure.systemError()));
        return tool::kUnreadable;
    }
}

} // namespace

int main(int argc, char** argv) {
    try {
        if (std::getenv("TARNELL_FBX_THREADS") == nullptr)
            Tarnell::Fbx::setMaximumThreads(0);
        return runToTheEnd(argc, argv);
    } catch (const std::exception& error) { // before a command had a file
        std::fprintf(stderr, "tarnell-fbx: %s\n", error.what());
        return tool::kUnreadable;
    }
}
