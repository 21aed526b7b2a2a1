// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The name of a mesh's point cache.
#pragma once

#include <string>

namespace Tarnell::Fbx::detail {

/// The name of a node as the name of a file, without an extension: the name itself where that is possible everywhere.
///
/// Separators of folders or drives, invalid text, reserved names, and dots and blanks at the end are
/// written as "%" and two hexadecimal digits; so is a "%" that looks like an escape. A name that becomes too long for a
/// file ends with a number that distinguishes it from others.
std::string pointCacheName(const std::string& nodeName);

} // namespace Tarnell::Fbx::detail
