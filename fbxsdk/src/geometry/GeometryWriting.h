// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The records of geometry and of deformers.
#pragma once

#include <fbxsdk/FbxGeometryBase.h>
#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxShape.h>

#include "container/RecordSink.h"
#include "schema/VersionTraits.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Everything after the properties of a geometry: points, polygons, layers.
void writeGeometryRecords(FbxGeometryBase& geometry, const VersionTraits& traits, RecordSink& sink);

/// The records before the properties of a skin, a cluster, a blend shape, one of its channels or a cache deformer …
void writeDeformerVersion(const FbxObject& deformer, const VersionTraits& traits, RecordSink& sink);
/// … and after them.
void writeDeformerRecords(FbxObject& deformer, const VersionTraits& traits, RecordSink& sink);

/// The elements and layers of a geometry. Without edges there are no elements that are mapped by them.
void writeLayers(const FbxLayerContainer& container, bool hasEdges, const VersionTraits& traits, RecordSink& sink);

/// NURBS surfaces and curves, trimmed surfaces, boundaries, patches and lines; nothing for other classes.
void writeNurbsRecords(FbxGeometryBase& geometry, RecordSink& sink);
/// The records after the layers of a geometry, if its class has any.
void writeRecordsBehindLayers(const FbxGeometryBase& geometry, RecordSink& sink);

} // namespace detail
FBXSDK_NAMESPACE_END
