// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx: options and commands.
#include <algorithm>
#include <cstdio>
#include <exception>
#include <iostream>
#include <map>
#include <sstream>

#include <CLI/CLI.hpp>

#include "Commands.h"

namespace {

/// "A:B", or a single frame.
std::string parseFrames(const std::string& text, std::optional<std::pair<int, int>>& frames) {
    int first = 0, last = 0;
    int used = 0;
    const char* const end = text.c_str() + text.size();
    if (std::sscanf(text.c_str(), "%d:%d%n", &first, &last, &used) == 2 && text.c_str() + used == end) {
        if (first > last)
            return "the range " + text + " ends before it starts";
    } else if (std::sscanf(text.c_str(), "%d%n", &first, &used) == 1 && text.c_str() + used == end) {
        last = first;
    } else {
        return "not a range of frames: " + text;
    }
    frames = {first, last};
    return {};
}

std::vector<std::string> parseKinds(const std::string& text, const std::vector<std::string>& known) {
    std::vector<std::string> kinds;
    std::istringstream list(text);
    for (std::string kind; std::getline(list, kind, ',');) {
        if (std::find(known.begin(), known.end(), kind) == known.end()) {
            throw CLI::ValidationError("--kind", "no such kind: " + kind);
        }
        kinds.push_back(kind);
    }
    return kinds;
}

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

void addDump(CLI::App& app, tool::DumpOptions& options) {
    CLI::App* dump = app.add_subcommand("dump", "Print what the library reads as one JSON document");
    dump->add_option("FILE", options.file, "The FBX file")->required();
    dump->add_option_function<std::string>(
            "--kind", [&options](const std::string& text) { options.kinds = parseKinds(text, tool::dumpKinds()); },
            "Comma list of cameras, lights, markers, nulls, transforms, meshes (default: all six)")
        ->type_name("LIST");
    dump->add_flag("--local", options.local, "Local transforms instead of global ones");
    dump->add_option("--frame", options.frame, "Frame at which static values and meshes are read");
    addFrames(*dump, options.frames, "A:B, meshes are read at every whole frame of the range");
    dump->add_option("--sample-fps", options.sampleFps, "Sample at this many frames per second");
    dump->add_flag_callback(
        "--no-transform-points", [&options] { options.transformPoints = false; },
        "Leave mesh points in the node's space, those of skins in the world");
    dump->add_flag("--compute-camera-rotation", options.computeCameraRotation,
                   "Compute the rotation of cameras without target from their interest");
    dump->add_option("--name", options.name, "Only the object of that name");
    dump->add_flag_callback(
        "--no-samples", [&options] { options.samples = false; }, "Leave the sample arrays out");
    dump->add_flag("--pretty", options.pretty, "Indented");
}

void addConvert(CLI::App& app, tool::ConvertOptions& options) {
    CLI::App* convert = app.add_subcommand("convert", "Write what the library reads into another FBX file");
    convert->add_option("IN", options.input, "The FBX file to read")->required();
    convert->add_option("OUT", options.output, "The FBX file to write")->required();
    convert
        ->add_option_function<std::string>(
            "--version",
            [&options](const std::string& text) {
                const std::vector<std::string> years = {"2010", "2011", "2012", "2013", "2014", "2016"};
                const auto found = std::find(years.begin(), years.end(), text);
                if (found == years.end())
                    throw CLI::ValidationError("--version", "no such version: " + text);
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
            "Comma list of cameras, lights, nulls, transforms, meshes (default: all)")
        ->type_name("LIST");
    addFrames(*convert, options.frames, "Points of meshes at every whole frame of A:B, as point caches");
    convert->add_option("--fps", options.fps, "Sample and write at this many frames per second")
        ->check(CLI::PositiveNumber);
    const std::map<std::string, tool::PointCache> caches = {
        {"maya", tool::PointCache::maya}, {"max", tool::PointCache::max}, {"none", tool::PointCache::none}};
    convert->add_option("--cache", options.cache, "Form of the point caches: maya (default), max, none")
        ->transform(CLI::CheckedTransformer(caches).description(""))
        ->type_name("FORM");
    convert->add_flag("--local", options.local, "Local transforms instead of global ones");
    convert->add_flag("--force", options.force, "Overwrite what is there already");
}

int run(int argc, char** argv) {
    std::ios::sync_with_stdio(false);
    CLI::App app("Looks into FBX files and writes them", "tarnell-fbx");
    app.require_subcommand(1);
    tool::DumpOptions dumpOptions;
    addDump(app, dumpOptions);
    tool::ConvertOptions convertOptions;
    addConvert(app, convertOptions);
    std::vector<std::string> infoFiles;
    CLI::App* info = app.add_subcommand("info", "Show on one screen what a file holds");
    info->add_option("FILE", infoFiles, "FBX files")->required();

    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& error) {
        const bool asked = error.get_exit_code() == 0; // --help
        app.exit(error, std::cout, std::cerr);
        return asked ? tool::kSuccess : tool::kWrongUsage;
    }
    if (*info)
        return tool::info(infoFiles);
    return app.got_subcommand("convert") ? tool::convert(convertOptions) : tool::dump(dumpOptions);
}

} // namespace

int main(int argc, char** argv) {
    try {
        return run(argc, argv);
    } catch (const std::exception& error) { // mostly that there is no memory left
        std::fprintf(stderr, "tarnell-fbx: %s\n", error.what());
        return tool::kUnreadable;
    }
}
