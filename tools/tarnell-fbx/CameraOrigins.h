// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The origin of a camera's numbers: the properties of the file that determine them, and those without effect.
#pragma once

#include <string>
#include <vector>

#include <fbxsdk.h>

#include "CameraFacts.h"

namespace tool {

/// Whether what the camera shows depends on the property of the camera or its node.
bool isInForce(const CameraFacts& facts, const FbxProperty& property);

/// The viewing direction, at rotation 0, of a camera with these pre- and post-rotations, in the space of its parent: an
/// axis, or a direction.
std::string restDirection(const CameraFacts& facts);

std::vector<IdleValue> idleValues(const CameraFacts& facts);

std::vector<Origin> originsOf(const CameraFacts& facts, const CameraMoment& moment, const SceneFile& file);

// Numbers as printed on pages about cameras.
std::string inDecimals(double number, int decimals);         ///< "27.280"
std::string rounded(double number, int decimals);            ///< without trailing zeros: "27.28"
std::string significant(double number, int digits);          ///< "1.41732"
std::string vectorText(const Vector3& vector, int decimals); ///< "(0, −0.671, −0.742)"
std::string filmText(const FilmSize& film);                  ///< "1.41732 × 0.94488 in"

} // namespace tool
