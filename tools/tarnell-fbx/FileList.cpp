// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Patterns of file names. A shell expands most of them; quoted ones, and those in job files and render queues, remain.
#include "FileList.h"

#include <filesystem>
#include <system_error>

#include <glob.h>

#include "StandardInput.h"

namespace tool {

FileList expandFiles(const std::vector<std::string>& names) {
    FileList list;
    for (const std::string& name : names) {
        std::error_code ignored;
        if (name == "-") {
            list.files.push_back(keepStandardInput());
            continue;
        }
        if (name.find_first_of("*?[") == std::string::npos || std::filesystem::exists(name, ignored)) {
            list.files.push_back(name);
            continue;
        }
        glob_t found{};
        if (glob(name.c_str(), 0, nullptr, &found) == 0)
            list.files.insert(list.files.end(), found.gl_pathv, found.gl_pathv + found.gl_pathc);
        else
            list.unmatched.push_back(name);
        globfree(&found);
    }
    return list;
}

} // namespace tool
