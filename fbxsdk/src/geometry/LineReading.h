// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Polylines from the records of a file.
#pragma once

#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN

class FbxLine;

namespace detail {

/// Points beyond the last whole triple are dropped; indices of points that do not exist become the first point, and
/// without points there are no indices.
void readLine(FbxLine& line, const Record& body);

} // namespace detail
FBXSDK_NAMESPACE_END
