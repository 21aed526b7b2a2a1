// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Blend shapes of versions before 7.2 stand inside their geometry: the mirror of InlineShapes.
#pragma once

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Replaces the chain of deformers below each geometry by Shape records in the geometry, and the channels' weights by
/// properties of it. Of a channel with several targets the last one stays, which is reached at the full weight: there
/// is no place for the others.
void moveShapesInline(Document& document);

} // namespace detail
FBXSDK_NAMESPACE_END
