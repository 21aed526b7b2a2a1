// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The content of geometry and deformers from the records of a file. Inconsistent numbers give no geometry:
// the object stays without points.
#pragma once

#include <memory>

#include <fbxsdk/FbxLayer.h>
#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxShape.h>

#include "container/Record.h"
#include "document/Document.h"
#include "geometry/GeometrySource.h"

FBXSDK_NAMESPACE_BEGIN

class FbxLine;
class FbxObject;
class FbxPatch;

namespace detail {

/// The geometry will read itself from the object's sub-records. Trivial until then; shares ownership of the document.
void attachSource(FbxGeometryBase& geometry, const std::shared_ptr<const Document>& document,
                  const DocumentObject& object);

// Called by the classes on the first access, except for the layers. The object is empty then.

/// How many corners refer to points that do not exist.
int readMesh(FbxMesh& mesh, const GeometrySource& source);
/// The base's points, moved by the offsets. Offsets for points that do not exist are skipped.
void readShape(FbxShape& shape, const FbxGeometryBase& base, const Record& body);

/// Adds the layers and elements of the record to a container without any. The elements' arrays stay in the file until
/// they are accessed.
void readLayers(FbxLayerContainer& container, const GeometrySource& source);

/// Points beyond the last whole triple are dropped; indices of points that do not exist become the first point, and
/// without points there are no indices.
void readLine(FbxLine& line, const Record& body);

void readPatch(FbxPatch& patch, const Record& body);

/// For every deformer and sub-deformer, after its properties. Clusters read their points from the document on the
/// first access, and share ownership of it until then.
void readDeformer(FbxObject& deformer, const std::shared_ptr<const Document>& document, const DocumentObject& object);

} // namespace detail
FBXSDK_NAMESPACE_END
