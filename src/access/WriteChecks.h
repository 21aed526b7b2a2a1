// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Warnings about data that is written as passed, though no program can interpret it.
#pragma once

#include "ObjectWarnings.h"

#include "TnFbxCamera.h"
#include "TnFbxLight.h"
#include "TnFbxMesh.h"
#include "TnFbxTransform.h"

namespace Tarnell::Fbx::detail {

/// An invalid rate, or one that the file does not state.
void warnAboutRate(float framesPerSecond, bool isCustom);

// About one object that is written; only about its written data.

void check(TnFbxTransform& transform, ObjectWarnings& warnings);
void check(TnFbxCamera& camera, ObjectWarnings& warnings);
void check(TnFbxLight& light, ObjectWarnings& warnings);
/// Of a mesh its geometry only.
void check(const TnFbxMesh& mesh, ObjectWarnings& warnings);

} // namespace Tarnell::Fbx::detail
