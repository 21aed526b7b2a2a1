// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An extension of this platform, not part of the documented API, and not included by <fbxsdk.h>: what a file states
// about its objects beyond the API. Programs that also compile against another SDK do without it.
#pragma once

#include <cstdint>
#include <vector>

#include <fbxsdk/FbxObject.h>
#include <fbxsdk/FbxProperty.h>
#include <fbxsdk/FbxScene.h>

FBXSDK_NAMESPACE_BEGIN
/// Facts that this platform has beyond the documented API. `<fbxsdk.h>` does not include it.
namespace extensions {

/// The number by which the file names the object in its connections; 0 when the object comes from no file. Files before
/// 7.0 identify objects by name: numbers are generated for theirs.
[[nodiscard]] FBXSDK_DLL std::int64_t fileIdOf(const FbxObject& object);

/// Whether the property has a value of its own: the file or its templates state it, it was set, or it is connected or
/// animated. Otherwise it has the default of its class. False for an invalid property.
[[nodiscard]] FBXSDK_DLL bool isStated(const FbxProperty& property);

/// Whether any property of the object has the flag `eUserDefined`, without a look at each of them.
[[nodiscard]] FBXSDK_DLL bool hasUserDefinedProperties(const FbxObject& object);

/// Whether the file that was read into the scene states a frame rate: its time mode is not the application's default,
/// and a custom one comes with a rate. The rate of another custom one is derived from the times of the file, or
/// assumed. False for a scene that was made in memory.
[[nodiscard]] FBXSDK_DLL bool statesFrameRate(const FbxScene& scene);

/// All objects of the scene, in the order of their entry: what GetSrcObject returns one by one, in one pass.
[[nodiscard]] FBXSDK_DLL std::vector<FbxObject*> objectsOf(const FbxScene& scene);

} // namespace extensions
FBXSDK_NAMESPACE_END
