// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files of any number of one kind of object or connection.
#pragma once

#include <string>
#include <vector>

namespace growth {

struct Kind {
    const char* name;
    std::string (*file)(int count); ///< an ASCII file of 7.4
};

/// Every kind of object, and every way in which many of them can be connected to one.
const std::vector<Kind>& kinds();

} // namespace growth
