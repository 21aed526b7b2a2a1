// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The common part of the programs that open our files with a peer: PROGRAM SAMPLES OUT
// Each file of SAMPLES/expected.json is opened; its content goes into OUT, one JSON object per file.
#pragma once

#include <nlohmann/json.hpp>

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <functional>
#include <string>

/// Opens a file and returns its content; null after a message on standard error.
using LookAtFile = std::function<nlohmann::json(const std::filesystem::path& file, const nlohmann::json& expected)>;

/// The exit status of the program: 0 when every file was opened, 1 when one was not, 2 for wrong usage. Files of
/// versions before the peer's oldest one are skipped.
inline int runPeer(int argumentCount, char** arguments, const LookAtFile& look, int oldestVersion = 0) {
    if (argumentCount != 3) {
        std::fprintf(stderr, "usage: %s SAMPLES OUT\n", arguments[0]);
        return 2;
    }
    const std::filesystem::path samples = arguments[1], out = arguments[2];
    nlohmann::json expected;
    std::ifstream(samples / "expected.json") >> expected;
    std::filesystem::create_directories(out);
    bool allSeen = true;
    for (const nlohmann::json& entry : expected["files"]) {
        if (entry["version"] < oldestVersion)
            continue;
        const std::string file = entry["file"];
        const nlohmann::json seen = look(samples / file, expected);
        if (!seen.is_null())
            std::ofstream(out / (file + ".json")) << seen.dump(1) << '\n';
        allSeen = allSeen && !seen.is_null();
    }
    return allSeen ? 0 : 1;
}
