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

enum ExitStatus { kSuccess = 0, kUnreadable = 1, kWrongUsage = 2 };

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
};

enum class PointCache { maya, max, none };

struct ConvertOptions {
    std::string input, output;
    int version = 5; ///< as TnFbxWriteInfo counts them
    bool ascii = false;
    std::vector<std::string> kinds;            ///< empty: all
    std::optional<std::pair<int, int>> frames; ///< points of meshes at every whole frame, as point caches
    std::optional<float> fps;
    PointCache cache = PointCache::maya;
    bool local = false;
    bool force = false;
};

/// The names of the kinds that dump knows, in the order in which it prints them.
const std::vector<std::string>& dumpKinds();

int dump(const DumpOptions& options);
int convert(const ConvertOptions& options);
int info(const std::vector<std::string>& files);

/// One line on standard error, as every failure of the tool prints it.
void printError(const std::string& file, const std::string& reason);

/// Runs work on a file, and hands out its exit status. What the work throws is a failure like any other: the reason is
/// printed, and the status is kUnreadable.
int guarded(const std::string& file, const std::function<int()>& work);

} // namespace tool
