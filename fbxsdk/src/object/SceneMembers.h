// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// All sources of one class in a single pass over the connections.
#pragma once

#include <vector>

#include "object/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

template <class T>
std::vector<T*> objectsIn(const ConnectionList& points) {
    std::vector<T*> found;
    for (const ConnectionPoint* point : points)
        if (point->property < 0 && point->object->Is<T>())
            found.push_back(static_cast<T*>(point->object));
    return found;
}

template <class T>
std::vector<T*> sourcesOf(const FbxObject& object) {
    return objectsIn<T>(object.data().plug.sources);
}

template <class T>
std::vector<T*> sourcesOf(const FbxProperty& property) {
    const FbxObject* object = property.GetFbxObject();
    const PropertyData* data = object ? object->data().property(property.index()) : nullptr;
    return data ? objectsIn<T>(data->plug.sources) : std::vector<T*>();
}

} // namespace detail
FBXSDK_NAMESPACE_END
