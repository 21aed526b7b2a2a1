// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include "TnFbxCamera.h"

#include <cmath>

namespace Tarnell::Fbx::faithful {

inline constexpr double kMillimetresPerInch = 25.4;
inline constexpr double kRadiansPerDegree = 0.017453292519943295769;

/// Focal length, film and angles of a camera, which must be consistent.
struct Lens {
    double focalLength;                             // millimetres
    double width, height;                           // of the film, inches
    double fieldOfView, fieldOfViewX, fieldOfViewY; // degrees
};

inline bool isAngle(double degrees) { return degrees > 0.0 && degrees < 180.0; }

inline double focalLengthOf(double inches, double degrees) {
    return inches * kMillimetresPerInch / 2.0 / std::tan(degrees / 2.0 * kRadiansPerDegree);
}

inline double angleOf(double inches, double focalLength) {
    return 2.0 * std::atan2(inches * kMillimetresPerInch / 2.0, focalLength) / kRadiansPerDegree;
}

/// The value that the mode names drives the lens, and the rest follows from it and from the film.
inline Lens agreeing(Lens lens, TnFbxCamera::EFbxCameraApertureMode mode) {
    if (mode == TnFbxCamera::kFbxApertureHorizontal && isAngle(lens.fieldOfView)) {
        lens.focalLength = focalLengthOf(lens.width, lens.fieldOfView);
    } else if (mode == TnFbxCamera::kFbxApertureVertical && isAngle(lens.fieldOfView)) {
        lens.focalLength = focalLengthOf(lens.height, lens.fieldOfView);
    } else if (mode == TnFbxCamera::kFbxApertureHorizontalAndVertical && isAngle(lens.fieldOfViewX) &&
               isAngle(lens.fieldOfViewY)) {
        // Two angles give the film its shape; its width is kept, and its height where they differ by rounding only.
        constexpr double kRounding = 1e-6;
        lens.focalLength = focalLengthOf(lens.width, lens.fieldOfViewX);
        const double height =
            2.0 * lens.focalLength * std::tan(lens.fieldOfViewY / 2.0 * kRadiansPerDegree) / kMillimetresPerInch;
        lens.height = std::fabs(height - lens.height) < kRounding * lens.height ? lens.height : height;
    }
    lens.fieldOfViewX = angleOf(lens.width, lens.focalLength);
    lens.fieldOfViewY = angleOf(lens.height, lens.focalLength);
    lens.fieldOfView = mode == TnFbxCamera::kFbxApertureVertical ? lens.fieldOfViewY : lens.fieldOfViewX;
    return lens;
}

} // namespace Tarnell::Fbx::faithful
