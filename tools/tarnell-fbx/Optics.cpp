// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Optics.h"

#include <array>
#include <cmath>

namespace tool {
namespace {

constexpr double kRadians = 0.017453292519943295769;

/// In the order in which files number them, from 1 on. Sizes are those of the film, before the squeeze.
constexpr std::array<NamedFormat, 11> kFormats = {{{"16 mm theatrical", {0.404, 0.295}, 1.0},
                                                   {"Super 16", {0.493, 0.292}, 1.0},
                                                   {"35 mm academy", {0.864, 0.630}, 1.0},
                                                   {"35 mm TV projection", {0.816, 0.612}, 1.0},
                                                   {"35 mm full aperture", {0.980, 0.735}, 1.0},
                                                   {"35 mm 1.85 projection", {0.825, 0.446}, 1.0},
                                                   {"35 mm anamorphic", {0.864, 0.732}, 2.0},
                                                   {"70 mm projection", {2.066, 0.906}, 1.0},
                                                   {"VistaVision", {1.485, 0.991}, 1.0},
                                                   {"Dynavision", {2.080, 1.480}, 1.0},
                                                   {"IMAX", {2.772, 2.072}, 1.0}}};

struct Sensor {
    const char* name;
    double width, height; // millimetres
};
constexpr std::array<Sensor, 4> kSensors = {{{"35 mm still, full frame", 36.0, 24.0},
                                             {"Four Thirds", 17.3, 13.0},
                                             {"ALEXA open gate", 28.25, 18.17},
                                             {"ALEXA LF open gate", 36.70, 25.54}}};

/// Programs round sizes to three decimals of an inch, or to hundredths of a millimetre.
constexpr double kGateTolerance = 0.0012;

bool isSize(const FilmSize& film, double width, double height) {
    return std::abs(film.width - width) < kGateTolerance && std::abs(film.height - height) < kGateTolerance;
}

} // namespace

GateFit gateFitOf(int number) {
    return number >= 0 && number <= static_cast<int>(GateFit::stretch) ? static_cast<GateFit>(number) : GateFit::none;
}

const char* gateFitName(GateFit fit) {
    constexpr std::array<const char*, 6> kNames = {"none", "vertical", "horizontal", "fill", "overscan", "stretch"};
    return kNames[static_cast<std::size_t>(fit)];
}

FilmSize pictureGate(const FilmSize& film, double pictureAspect, GateFit fit) {
    const FilmSize keepsWidth{film.width, film.width / pictureAspect};
    const FilmSize keepsHeight{film.height * pictureAspect, film.height};
    const bool pictureIsWider = pictureAspect > film.aspect();
    switch (fit) {
    case GateFit::vertical:
        return keepsHeight;
    case GateFit::horizontal:
        return keepsWidth;
    case GateFit::fill:
        return pictureIsWider ? keepsWidth : keepsHeight;
    case GateFit::overscan:
        return pictureIsWider ? keepsHeight : keepsWidth;
    case GateFit::none:
    case GateFit::stretch:
        break;
    }
    return film;
}

double angleOver(double inches, double focalLengthMillimetres) {
    return 2.0 * std::atan2(inches * kMillimetresPerInch / 2.0, focalLengthMillimetres) / kRadians;
}

std::string knownGate(const FilmSize& film) {
    for (const NamedFormat& format : kFormats)
        if (isSize(film, format.film.width, format.film.height))
            return format.name;
    for (const Sensor& sensor : kSensors)
        if (isSize(film, sensor.width / kMillimetresPerInch, sensor.height / kMillimetresPerInch))
            return sensor.name;
    return {};
}

std::optional<NamedFormat> filmFormat(int number) {
    if (number < 1 || number > static_cast<int>(kFormats.size()))
        return std::nullopt;
    return kFormats[static_cast<std::size_t>(number) - 1];
}

} // namespace tool
