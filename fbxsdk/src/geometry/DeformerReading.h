// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deformers of a document: what they keep outside their properties.
#pragma once

#include <memory>

#include <fbxsdk/FbxPlainArray.h>

#include "document/Document.h"
#include "geometry/GeometrySource.h"

FBXSDK_NAMESPACE_BEGIN
class FbxObject;
namespace detail {

/// For every deformer and sub-deformer, after its properties. Clusters will read their points from the document when
/// somebody asks for them, and keep it alive until then.
void readDeformer(FbxObject& deformer, const std::shared_ptr<const Document>& document, const DocumentObject& object);

/// Of indices and weights of different number the surplus is dropped.
void readClusterPoints(const Record& body, PlainArray<int>& indices, PlainArray<double>& weights);

} // namespace detail
FBXSDK_NAMESPACE_END
