// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How the facade and the adapter note the outcome of an operation for `lastError()`.
#pragma once

#include <string>

namespace Tarnell::Fbx::detail {

/// Notes why the operation fails. Always false, so that failing is one line: `return fail("no node");`.
bool fail(std::string reason);

/// Forgets the last failure. Always true.
bool succeed();

} // namespace Tarnell::Fbx::detail
