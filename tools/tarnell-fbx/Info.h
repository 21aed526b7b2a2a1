// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The data of `info`, for documents that contain more.
#pragma once

#include <string>

#include "JsonWriter.h"
#include "SceneFile.h"

namespace tool {

/// The keys that `info --json` adds to an object.
void printInfo(const std::string& file, const SceneFile& opened, JsonWriter& json);

} // namespace tool
