// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Geometry of a document becomes the content of geometry objects, when somebody first asks for it.
#pragma once

#include <memory>

#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxShape.h>

#include "document/Document.h"
#include "geometry/GeometrySource.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The geometry will read itself from the object's sub-records. Costs nothing until then; keeps the document alive.
void attachSource(FbxGeometryBase& geometry, const std::shared_ptr<const Document>& document,
                  const DocumentObject& object);

// What the classes call on the first access, without the layers. The object is empty then.

/// How many corners named points that there are not.
int readMesh(FbxMesh& mesh, const GeometrySource& source);
/// The base's points, moved by the offsets. Offsets for points that are not there are skipped.
void readShape(FbxShape& shape, const FbxGeometryBase& base, const Record& body);

} // namespace detail
FBXSDK_NAMESPACE_END
