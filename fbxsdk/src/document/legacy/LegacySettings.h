// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Settings that older files keep in records of their own: take times, light, fog, frame rate, default camera.
#pragma once

#include <vector>

#include "document/DocumentBuilder.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The names and times of the takes, and which one is current (unless the document already says so).
void readTakeTimes(DocumentBuilder& builder, const Record& takes);

/// Adds the times that the take has as properties of its animation stack.
void addTakeTimes(DocumentBuilder& builder, const DocumentTake& take, std::vector<DocumentProperty>& properties);

/// What stands in Version5 of a 6.x file and at the top level of older ones. Only fills what is not said yet.
void readLegacySettings(DocumentBuilder& builder, const Record& parent);

} // namespace detail
FBXSDK_NAMESPACE_END
