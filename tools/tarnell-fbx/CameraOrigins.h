// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Why a camera's numbers are what they are: which properties of the file they come from, and which have no say.
#pragma once

#include <string>
#include <vector>

#include <fbxsdk.h>

#include "CameraFacts.h"

namespace tool {

/// Whether what the camera shows depends on the property of the camera or its node.
bool isInForce(const CameraFacts& facts, const FbxProperty& property);

/// Where a camera with the pre- and post-rotations of these facts looks at rotation 0, in the space of its parent: an
/// axis, or a direction.
std::string restDirection(const CameraFacts& facts);

std::vector<IdleValue> idleValues(const CameraFacts& facts);

std::vector<Origin> originsOf(const CameraFacts& facts, const CameraMoment& moment, const SceneFile& file);

// Numbers as pages about cameras have them.
std::string inDecimals(double number, int decimals);         ///< "27.280"
std::string rounded(double number, int decimals);            ///< without useless zeros: "27.28"
std::string significant(double number, int digits);          ///< "1.41732"
std::string vectorText(const Vector3& vector, int decimals); ///< "(0, −0.671, −0.742)"
std::string filmText(const FilmSize& film);                  ///< "1.41732 × 0.94488 in"

} // namespace tool
