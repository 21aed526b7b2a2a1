// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What is written as it was handed over, though no program can make sense of it: the host learns of it.
#pragma once

#include "ObjectWarnings.h"

#include "TnFbxCamera.h"
#include "TnFbxLight.h"
#include "TnFbxMesh.h"
#include "TnFbxTransform.h"

namespace Tarnell::Fbx::detail {

/// A rate that is none, or that the file does not tell.
void warnAboutRate(float framesPerSecond, bool isCustom);

// Of one object that is written; only of what is written of it.

void check(TnFbxTransform& transform, ObjectWarnings& warnings);
void check(TnFbxCamera& camera, ObjectWarnings& warnings);
void check(TnFbxLight& light, ObjectWarnings& warnings);
/// Of a mesh its geometry alone.
void check(const TnFbxMesh& mesh, ObjectWarnings& warnings);

} // namespace Tarnell::Fbx::detail
