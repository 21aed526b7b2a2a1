// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Patches from the records of a file. Counts that do not fit the points make no geometry: the patch stays without.
#pragma once

#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN

class FbxPatch;

namespace detail {

void readPatch(FbxPatch& patch, const Record& body);

} // namespace detail
FBXSDK_NAMESPACE_END
