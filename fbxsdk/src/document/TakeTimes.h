// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The times of takes and stacks: those of the Takes section apply where the stack itself states none.
#pragma once

#include <vector>

#include "document/DocumentBuilder.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The names and times of the takes, and which one is current (unless the document already says so).
void readTakeTimes(DocumentBuilder& builder, const Record& takes);

/// Adds the times that the take has as properties of its animation stack.
void addTakeTimes(DocumentBuilder& builder, const DocumentTake& take, std::vector<DocumentProperty>& properties);

/// Gives every stack without times of its own those of the take with its name.
void fillStackTimes(DocumentBuilder& builder);

/// One for every stack of the document, with its times; of a file that lists takes and has no stacks, those.
[[nodiscard]] std::vector<DocumentTake> listTakes(const Document& document);

} // namespace detail
FBXSDK_NAMESPACE_END
