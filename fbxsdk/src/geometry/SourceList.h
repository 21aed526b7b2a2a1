// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An object's sources of one class, cached in order of connection, so that access by index needs no search.
#pragma once

#include <algorithm>
#include <vector>

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

template <class T>
[[nodiscard]] T* sourceAt(const std::vector<T*>& sources, int index) {
    return index >= 0 && static_cast<std::size_t>(index) < sources.size() ? sources[static_cast<std::size_t>(index)]
                                                                          : nullptr;
}

/// -1 when it is not in the list.
template <class T>
[[nodiscard]] int indexOf(const std::vector<T*>& sources, const FbxObject* object) {
    // The last additions are looked up most often: search from the back.
    const auto found =
        std::find_if(sources.rbegin(), sources.rend(), [object](const T* source) { return source == object; });
    return static_cast<int>(sources.rend() - found) - 1;
}

/// To be called from connectionChanged of the destination. Returns the index of a removed source; -1 when none
/// was.
template <class T>
int followConnection(std::vector<T*>& sources, FbxObject& source, bool connected) {
    if (!source.Is<T>())
        return -1;
    if (connected) {
        sources.push_back(static_cast<T*>(&source)); // objects are connected once
        return -1;
    }
    const int index = indexOf(sources, &source);
    if (index >= 0)
        sources.erase(sources.begin() + index);
    return index;
}

/// Connects when it is not connected already.
template <class T>
bool addSource(FbxObject& destination, T* source) {
    return source && destination.ConnectSrcObject(source);
}

template <class T>
T* removeSource(FbxObject& destination, const std::vector<T*>& sources, T* source) {
    return source && indexOf(sources, source) >= 0 && destination.DisconnectSrcObject(source) ? source : nullptr;
}

/// Moves the object from every destination of the class to this one; null only removes it.
template <class T>
bool moveToDestination(FbxObject& object, T* destination) {
    while (T* former = object.GetDstObject<T>()) {
        if (former == destination && object.GetDstObjectCount<T>() == 1)
            return true;
        if (!former->DisconnectSrcObject(&object))
            return false;
    }
    return !destination || destination->ConnectSrcObject(&object);
}

} // namespace detail
FBXSDK_NAMESPACE_END
