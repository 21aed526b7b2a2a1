// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The arithmetic of lenses and film: angles, gate fit, and film backs with names.
#pragma once

#include <optional>
#include <string>

namespace tool {

constexpr double kMillimetresPerInch = 25.4;

/// A rectangle on the film plane, inches.
struct FilmSize {
    double width = 0.0, height = 0.0;
    [[nodiscard]] double aspect() const { return width / height; }
};

/// How film and picture are fitted where their shapes differ, numbered as in FBX.
enum class GateFit { none, vertical, horizontal, fill, overscan, stretch };
/// "none", "vertical", …; an unknown number counts as none.
GateFit gateFitOf(int number);
const char* gateFitName(GateFit fit);

/// The part of the film plane in a picture of that aspect: one side is the film's, the other follows. All of the film
/// without a fit, and where the film is stretched.
FilmSize pictureGate(const FilmSize& film, double pictureAspect, GateFit fit);

/// The angle, in degrees, over a side of the film.
double angleOver(double inches, double focalLengthMillimetres);

/// The name of a film back or sensor of that size, to about a thousandth of an inch; empty when it has none.
std::string knownGate(const FilmSize& film);

/// Size and squeeze of a camera's film format; nothing for "custom" and for numbers that are no format.
struct NamedFormat {
    const char* name;
    FilmSize film;
    double squeeze;
};
std::optional<NamedFormat> filmFormat(int number);

} // namespace tool
