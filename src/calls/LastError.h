// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How the facade and the adapter note the outcome of an operation for `lastError()` and `lastWarnings()`.
#pragma once

#include <string>

namespace Tarnell::Fbx::detail {

/// Notes why the operation fails. Always false, so that failing is one line: `return fail("no node");`.
bool fail(std::string reason);

/// The same, with the name of the file in front, unless the reason names it already. `standIn` is the reason when there
/// is none.
bool failAbout(const std::string& fileName, const char* reason, const char* standIn);

/// Forgets the last failure. Always true.
bool succeed();

/// Adds a sentence to the warnings of the call, unless it is among them already.
void warn(std::string sentence);

/// One call of the host's: the warnings start anew with the outermost one of a thread.
class CallScope {
public:
    CallScope();
    ~CallScope();
    CallScope(const CallScope&) = delete;
    CallScope& operator=(const CallScope&) = delete;
};

} // namespace Tarnell::Fbx::detail
