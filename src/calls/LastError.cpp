// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The outcome of the last call, one per thread.
#include "LastError.h"
#include "Printable.h"

#include "TnFbxError.h"

#include <algorithm>
#include <utility>

namespace Tarnell::Fbx {

namespace {

struct Outcome {
    std::string reason;
    std::vector<std::string> warnings;
    int callDepth = 0;
};

Outcome& outcome() {
    thread_local Outcome last;
    return last;
}

} // namespace

const std::string& lastError() { return outcome().reason; }

const std::vector<std::string>& lastWarnings() { return outcome().warnings; }

bool detail::fail(const std::string& reason) {
    outcome().reason = printable(reason);
    return false;
}

bool detail::failAbout(const std::string& fileName, const char* reason, const char* standIn) {
    const std::string text = reason != nullptr && *reason != '\0' ? reason : standIn;
    return fail(text.compare(0, fileName.size(), fileName) == 0 ? text : fileName + ": " + text);
}

bool detail::succeed() {
    outcome().reason.clear();
    return true;
}

void detail::warn(const std::string& text) {
    std::string sentence = printable(text);
    std::vector<std::string>& warnings = outcome().warnings;
    if (std::find(warnings.begin(), warnings.end(), sentence) == warnings.end())
        warnings.push_back(std::move(sentence));
}

detail::CallScope::CallScope() {
    if (outcome().callDepth++ == 0)
        outcome().warnings.clear();
}

detail::CallScope::~CallScope() { --outcome().callDepth; }

} // namespace Tarnell::Fbx
