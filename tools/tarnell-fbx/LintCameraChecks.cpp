// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Checks of cameras: lens, film and placement.
#include <algorithm>
#include <cmath>

#include <fbxsdk/extensions/FileFacts.h>

#include "CameraOrigins.h"
#include "LintChecks.h"
#include "SceneFacts.h"

namespace tool {
namespace {

CameraMoment firstMoment(const LintContext& context, const CameraFacts& camera) {
    return camera.at(static_cast<double>(context.take.firstFrame));
}

const FbxCamera& attributeOf(const CameraFacts& camera) { return *camera.node->GetCamera(); }

bool isPositive(double number) { return std::isfinite(number) && number > 0.0; }

} // namespace

void lensOutOfRange(const LintContext& context, LintReport& report) {
    for (const CameraFacts& camera : context.cameras->cameras) {
        const CameraMoment moment = firstMoment(context, camera);
        if (!isPositive(moment.focalLength) && !camera.orthographic)
            report.add(camera.name, "the focal length is " + significant(moment.focalLength, 6) + " mm");
        if (!isPositive(moment.film.width) || !isPositive(moment.film.height))
            report.add(camera.name, "the film is " + filmText(moment.film));
    }
}

void lensValuesDisagree(const LintContext& context, LintReport& report) {
    constexpr double kDegrees = 0.01, kMillimetres = 0.01;
    for (const CameraFacts& camera : context.cameras->cameras) {
        if (camera.orthographic)
            continue;
        const CameraMoment moment = firstMoment(context, camera);
        const FbxCamera& source = attributeOf(camera);
        const struct {
            FbxProperty property;
            double inForce, tolerance;
            const char* unit;
        } rows[] = {{source.FocalLength, moment.focalLength, kMillimetres, " mm"},
                    {source.FieldOfViewX, moment.fovX, kDegrees, "°"},
                    {source.FieldOfViewY, moment.fovY, kDegrees, "°"}};
        for (const auto& row : rows) {
            const double stated = row.property.Get<FbxDouble>();
            if (extensions::isStated(row.property) && !isInForce(camera, row.property) && !isAnimated(row.property) &&
                !camera.lensChanges && std::abs(stated - row.inForce) > row.tolerance)
                report.add(camera.name, std::string(row.property.GetName().Buffer()) + " is " + rounded(stated, 4) +
                                            row.unit + ", but the lens, driven by " + driverText(camera.driver) +
                                            ", has " + rounded(row.inForce, 4) + row.unit);
        }
    }
}

void filmShapeDiffers(const LintContext& context, LintReport& report) {
    constexpr double kTolerance = 0.005;
    for (const CameraFacts& camera : context.cameras->cameras) {
        const CameraMoment moment = firstMoment(context, camera);
        const double film = moment.film.aspect();
        if (camera.orthographic || !camera.resolutionStated || camera.pictureAspect <= 0.0 || !isPositive(film) ||
            std::abs(camera.pictureAspect / film - 1.0) <= kTolerance)
            continue;
        const std::string shapes =
            "the film is " + rounded(film, 4) + ":1, the picture " + rounded(camera.pictureAspect, 4) + ":1; gate fit ";
        if (camera.gateFit == GateFit::none) {
            report.add(camera.name, shapes + "none does not define which angle is kept");
            continue;
        }
        report.add(camera.name, shapes + gateFitName(camera.gateFit) + " changes " + inDecimals(moment.fovX, 3) +
                                    "° × " + inDecimals(moment.fovY, 3) + "° to " + inDecimals(moment.pictureFovX, 3) +
                                    "° × " + inDecimals(moment.pictureFovY, 3) + "°");
    }
}

void filmFormatDisagrees(const LintContext& context, LintReport& report) {
    for (const CameraFacts& camera : context.cameras->cameras) {
        for (const IdleValue& idle : camera.idle) {
            const FbxProperty property = attributeOf(camera).FindProperty(idle.property.c_str());
            if ((idle.property == "FilmFormatIndex" || idle.property == "FilmAspectRatio") &&
                extensions::isStated(property))
                report.add(camera.name, idle.property + " is " + idle.shortValue + ", but " + idle.reason);
        }
    }
}

void squeezedFilm(const LintContext& context, LintReport& report) {
    for (const CameraFacts& camera : context.cameras->cameras)
        if (camera.squeeze != 1.0)
            report.add(camera.name, "the squeeze ratio is " + rounded(camera.squeeze, 4));
}

void filmOffset(const LintContext& context, LintReport& report) {
    for (const CameraFacts& camera : context.cameras->cameras) {
        const CameraMoment moment = firstMoment(context, camera);
        if (moment.offsetX != 0.0 || moment.offsetY != 0.0)
            report.add(camera.name, "the film is shifted by " + rounded(moment.offsetX, 6) + " × " +
                                        rounded(moment.offsetY, 6) + " in");
    }
}

void clipPlanes(const LintContext& context, LintReport& report) {
    for (const CameraFacts& camera : context.cameras->cameras) {
        const CameraMoment moment = firstMoment(context, camera);
        const bool nearIsOne = camera.orthographic ? std::isfinite(moment.nearPlane) : isPositive(moment.nearPlane);
        if (!nearIsOne || !(moment.farPlane > moment.nearPlane))
            report.add(camera.name, "near plane " + significant(moment.nearPlane, 6) + " cm, far plane " +
                                        significant(moment.farPlane, 6) + " cm");
    }
}

void clipPlanesFarApart(const LintContext& context, LintReport& report) {
    // A float has 24 bits: with planes further apart most of its precision is used close to the camera.
    constexpr double kMostRatio = 16777216.0;
    for (const CameraFacts& camera : context.cameras->cameras) {
        const CameraMoment moment = firstMoment(context, camera);
        if (!camera.orthographic && isPositive(moment.nearPlane) && moment.farPlane / moment.nearPlane > kMostRatio)
            report.add(camera.name, "the far plane is " + significant(moment.farPlane / moment.nearPlane, 3) +
                                        " times as far away as the near plane");
    }
}

void cameraScale(const LintContext& context, LintReport& report) {
    constexpr double kTolerance = 1e-3;
    for (const CameraFacts& camera : context.cameras->cameras) {
        const auto [least, most] = std::minmax_element(camera.scale.begin(), camera.scale.end());
        if (*least < 0.0 || *most - *least > kTolerance * std::abs(*most))
            report.add(camera.name, "it is scaled by " + vectorText(camera.scale, 4));
    }
}

void rollWithoutTarget(const LintContext& context, LintReport& report) {
    for (const CameraFacts& camera : context.cameras->cameras) {
        if (!camera.hasTarget && attributeOf(camera).Roll.Get() != 0.0)
            report.add(camera.name, "a roll of " + rounded(attributeOf(camera).Roll.Get(), 4) +
                                        "°, but no target: the node rotates the camera");
    }
}

void interestElsewhere(const LintContext& context, LintReport& report) {
    for (const CameraFacts& camera : context.cameras->cameras) {
        const CameraMoment moment = firstMoment(context, camera);
        if (!camera.hasTarget && extensions::isStated(attributeOf(camera).InterestPosition) &&
            !moment.looksAtInterest())
            report.add(camera.name, "the point of interest lies " + rounded(moment.interestAngle(), 2) +
                                        "° off the viewing direction");
    }
}

void imageShiftNotRead(const LintContext& context, LintReport& report) {
    const std::string shifting[] = {"OpticalCenterX", "OpticalCenterY", "FilmTranslateX",
                                    "FilmTranslateY", "FilmRollValue",  "PreScale"};
    for (const CameraFacts& camera : context.cameras->cameras) {
        for (const IdleValue& idle : camera.idle)
            if (std::find(std::begin(shifting), std::end(shifting), idle.property) != std::end(shifting))
                report.add(camera.name, idle.property + " is " + idle.shortValue);
    }
}

void noResolution(const LintContext& context, LintReport& report) {
    for (const CameraFacts& camera : context.cameras->cameras) {
        if (camera.pictureAspect <= 0.0) {
            report.add(camera.name, "the resolution is " + rounded(camera.resolution[0], 3) + " × " +
                                        rounded(camera.resolution[1], 3));
        } else if (!camera.resolutionStated) {
            report.add(camera.name, "the file states no resolution; the default of the format is 320 × 200");
        }
    }
}

} // namespace tool
