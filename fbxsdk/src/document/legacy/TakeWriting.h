// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Takes of files before 7.0: the mirror of LegacyTakes.
#pragma once

#include "document/legacy/LegacyLayout.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The section with all takes and their animation.
void writeLegacyTakes(const LegacyLayout& layout, const VersionTraits& traits, RecordSink& sink);

} // namespace detail
FBXSDK_NAMESPACE_END
