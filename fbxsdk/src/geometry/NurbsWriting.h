// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The records of geometry that is not a mesh.
#pragma once

#include <fbxsdk/FbxGeometryBase.h>

#include "container/RecordSink.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// NURBS surfaces and curves, trimmed surfaces, boundaries, patches and lines; nothing for other classes.
void writeNurbsRecords(FbxGeometryBase& geometry, RecordSink& sink);
/// What stands behind the layers of a geometry, if its class has any such records.
void writeRecordsBehindLayers(const FbxGeometryBase& geometry, RecordSink& sink);

} // namespace detail
FBXSDK_NAMESPACE_END
