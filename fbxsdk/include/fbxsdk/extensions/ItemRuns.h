// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An extension of this platform, not part of the documented API, and not included by <fbxsdk.h>: the items of large
// arrays as the numbers that the file stores, without a call for each of them.
#pragma once

#include <fbxsdk/FbxGeometryBase.h>
#include <fbxsdk/FbxLayer.h>
#include <fbxsdk/FbxPlainArray.h>

FBXSDK_NAMESPACE_BEGIN
namespace extensions {

/// Consecutive items, which begin with their components: x, y and z of a vector of four, whose fourth number follows
/// only if the array is in memory, both numbers of a vector of two, four of a colour, as doubles; an int.
/// `itemBytes` lie between two items. The bytes have no alignment.
using ItemRun = detail::ItemRun;

/// Some items of the array, among them the one at the index; none when there is no such item. Valid until the next
/// access to the array. Throws std::runtime_error when the items are still in a file that has been changed.
template <class T>
[[nodiscard]] ItemRun itemRun(FbxLayerElementArrayTemplate<T>& array, int index) {
    const detail::PlainArray<T>& items = array.items();
    return items.contains(index) ? items.run(index) : ItemRun{};
}

/// The same for the control points of a geometry.
[[nodiscard]] FBXSDK_DLL ItemRun controlPointRun(FbxGeometryBase& geometry, int index);

} // namespace extensions
FBXSDK_NAMESPACE_END
