// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Property lines, and the blocks around them.
#pragma once

#include <span>

#include "container/RecordSink.h"
#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// `Properties70 { P: name, type, subtype, flags, values }`.
void writeProperties70(RecordSink& sink, std::span<const DocumentProperty> properties);
/// `Property: name, type, flags, values` as lines of `Properties60`.
void writeProperty60(RecordSink& sink, const DocumentProperty& property, std::string_view flags);

} // namespace detail
FBXSDK_NAMESPACE_END
