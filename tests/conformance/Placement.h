// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Position, rotation and scale as the library returns them, and its decomposition of a matrix, computed independently.
#pragma once

#include "Matrices.h"

namespace conformance {

struct Placement {
    Point position{};
    Point rotation{}; ///< degrees
    Point scale{1, 1, 1};
};

/// A host's composition: scale, then the rotations about X, Y and Z, then position.
Matrix12 rebuilt(const Placement& placement);

/// The library's decomposition of a global matrix. Away from the origin these are the angles X, Y, Z of the normalised
/// axes; of a mirrored matrix all three lengths are negative.
Placement placementBesideOrigin(const Matrix12& matrix);

/// The same where the translation is exactly zero. Kept: the angles are Z, X, Y then, and depend on the lengths of
/// the axes (docs/kept-behaviours.md).
Placement placementAtOrigin(const Matrix12& matrix);

/// Where a host places an object whose global transform is `matrix`.
Matrix12 handedOut(const Matrix12& matrix, bool atOrigin);

} // namespace conformance
