// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Position, rotation and scale as the library hands them out, and what it makes of a matrix, worked out on its own.
#pragma once

#include "Matrices.h"

namespace conformance {

struct Placement {
    Point position{};
    Point rotation{}; ///< degrees
    Point scale{1, 1, 1};
};

/// What a host makes of it: scale, then the turns about X, Y and Z, then position.
Matrix12 rebuilt(const Placement& placement);

/// What the library makes of a matrix in the world. Beside the origin these are the angles X, Y, Z of the axes without
/// their lengths; of a mirrored matrix all three lengths are negative.
Placement placementBesideOrigin(const Matrix12& matrix);

/// The same where the translation is exactly zero. Kept: the angles are Z, X, Y then, and the lengths of the axes take
/// part in them (docs/kept-behaviours.md).
Placement placementAtOrigin(const Matrix12& matrix);

/// Where a host sees what stands at `matrix` in the world.
Matrix12 handedOut(const Matrix12& matrix, bool atOrigin);

} // namespace conformance
