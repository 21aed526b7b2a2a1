// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The entry points of faithful writes for the facade, and the writers of single objects.
#pragma once

#include "WrittenScene.h"

#include "TnFbxCamera.h"
#include "TnFbxLight.h"
#include "TnFbxMesh.h"
#include "TnFbxNull.h"
#include "TnFbxTransform.h"
#include "TnFbxWriteInfo.h"

#include <vector>

namespace Tarnell::Fbx::faithful {

/// Writes the file and its point caches: all of them, or none, with the reason noted. Null pointers are skipped.
bool writeObjects(const TnFbxWriteInfo& info, const std::vector<TnFbxCamera*>& cameras,
                  const std::vector<TnFbxLight*>& lights, const std::vector<TnFbxTransform*>& transforms,
                  const std::vector<TnFbxNull*>& nulls, const std::vector<TnFbxMesh*>& meshes);

// One object as a node below the root. They are only read: channels are returned by objects that may change.
void addObject(WrittenScene& scene, TnFbxCamera& source);
void addObject(WrittenScene& scene, TnFbxLight& source);
void addObject(WrittenScene& scene, TnFbxTransform& source);
void addObject(WrittenScene& scene, TnFbxNull& source);
void addObject(WrittenScene& scene, TnFbxMesh& source);

} // namespace Tarnell::Fbx::faithful
