// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What a mesh's point cache is called.
#pragma once

#include <string>

namespace Tarnell::Fbx::detail {

/// The name of a node as the name of a file, without an extension: the name itself where that is possible everywhere.
///
/// What separates folders or drives, what is no text, what a system reserves, and dots and blanks at the end are
/// written as "%" and two hexadecimal digits; so is a "%" that reads like one. A name that becomes too long for a file
/// ends with a number that tells it from others.
std::string pointCacheName(const std::string& nodeName);

} // namespace Tarnell::Fbx::detail
