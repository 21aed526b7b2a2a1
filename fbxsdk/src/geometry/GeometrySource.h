// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The source of an object's content until the first access.
#pragma once

#include <memory>

#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

class ArraysAhead;
struct Document;
struct MeshOfSurface;

/// The sub-records of one object of a file. The document is held only to keep the records alive.
struct GeometrySource {
    std::shared_ptr<const Document> document;
    const Record* body = nullptr;
    std::shared_ptr<const MeshOfSurface> surface{}; ///< of a mesh that replaces a surface; there is no document then
    std::shared_ptr<ArraysAhead> ahead{};           ///< null where nothing is inflated in advance
};

} // namespace detail
FBXSDK_NAMESPACE_END
