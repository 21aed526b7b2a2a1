// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How the facade and the adapter record the outcome of an operation for `lastError()` and `lastWarnings()`.
#pragma once

#include <stdexcept>
#include <string>
#include <string_view>

namespace Tarnell::Fbx::detail {

/// Records why the operation fails, with control characters escaped. Always false, so that failing is one line:
/// `return fail("no node");`.
bool fail(const std::string& reason);

/// The same, with the name of the file in front, unless the reason contains it already. `standIn` is the reason when
/// there is none.
bool failAbout(const std::string& fileName, const char* reason, const char* standIn);

/// What `work` returns. A fault that the platform throws makes it fail: a change of the file while it was read may be
/// detected late. std::bad_alloc is passed on to the host.
///
/// kept: so is what the platform throws for a layer element without a direct array
template <class Work>
bool failOnFault(const std::string& fileName, const Work& work) {
    try {
        return work();
    } catch (const std::runtime_error& fault) {
        if (std::string_view(fault.what()) == "FbxLayerElementArrayTemplate - mDirectArray is NULL")
            throw;
        return failAbout(fileName, fault.what(), "cannot be read");
    }
}

/// Clears the last failure. Always true.
bool succeed();

/// Adds a sentence to the warnings of the call, unless it is among them already.
void warn(const std::string& text);

/// One call of the host: the warnings are cleared by the outermost one of a thread.
class CallScope {
public:
    CallScope();
    ~CallScope();
    CallScope(const CallScope&) = delete;
    CallScope& operator=(const CallScope&) = delete;
};

} // namespace Tarnell::Fbx::detail
