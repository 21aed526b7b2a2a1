// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// All sources of one class in a single pass over the connections.
#pragma once

#include <vector>

#include "scene/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

template <class T>
std::vector<T*> sourcesOf(const FbxObject& object) {
    std::vector<T*> found;
    for (const ConnectionPoint* source : object.data().plug.sources) {
        if (source->property < 0 && source->object->Is<T>())
            found.push_back(static_cast<T*>(source->object));
    }
    return found;
}

} // namespace detail
FBXSDK_NAMESPACE_END
