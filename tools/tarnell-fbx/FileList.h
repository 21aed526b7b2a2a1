// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The files of a command line.
#pragma once

#include <string>
#include <vector>

namespace tool {

struct FileList {
    std::vector<std::string> files;
    std::vector<std::string> unmatched; ///< patterns that match no file
};

/// Patterns ("shots/*.fbx") are replaced by the files that they match, in the order of their names; a name that is
/// a file, and one without *, ? and [, stays as it is. "-" is standard input.
FileList expandFiles(const std::vector<std::string>& names);

} // namespace tool
