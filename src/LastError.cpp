// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The reason of the last failure, one per thread.
#include "LastError.h"

#include "TnFbxError.h"

#include <utility>

namespace Tarnell::Fbx {

namespace {

std::string& lastReason() {
    thread_local std::string reason;
    return reason;
}

} // namespace

const std::string& lastError() { return lastReason(); }

bool detail::fail(std::string reason) {
    lastReason() = std::move(reason);
    return false;
}

bool detail::failAbout(const std::string& fileName, const char* reason, const char* standIn) {
    std::string text = reason != nullptr && *reason != '\0' ? reason : standIn;
    return fail(text.compare(0, fileName.size(), fileName) == 0 ? std::move(text) : fileName + ": " + text);
}

bool detail::succeed() {
    lastReason().clear();
    return true;
}

} // namespace Tarnell::Fbx
