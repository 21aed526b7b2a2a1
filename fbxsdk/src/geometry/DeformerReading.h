// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deformers of a document: what they keep outside their properties.
#pragma once

#include <memory>

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN
class FbxObject;
namespace detail {

/// For every deformer and sub-deformer, after its properties. Clusters will read their points from the document when
/// somebody asks for them, and keep it alive until then.
void readDeformer(FbxObject& deformer, const std::shared_ptr<const Document>& document, const DocumentObject& object);

} // namespace detail
FBXSDK_NAMESPACE_END
