// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Layer elements and layers of a geometry's record.
#pragma once

#include <fbxsdk/FbxLayer.h>

#include "geometry/GeometrySource.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Adds the layers and elements of the record to a container without any. The elements' arrays stay in the file until
/// somebody asks for them.
void readLayers(FbxLayerContainer& container, const GeometrySource& source);

} // namespace detail
FBXSDK_NAMESPACE_END
