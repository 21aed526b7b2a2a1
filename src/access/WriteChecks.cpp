// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Warnings about values that are not finite, invalid rates, and inconsistent meshes.
#include "WriteChecks.h"

#include "FrameTimes.h"
#include "calls/LastError.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <span>

namespace Tarnell::Fbx {

namespace {

using detail::kMostTogether;
using detail::ObjectWarnings;

constexpr const char* kNoNumbers = "values that are not finite are written unchanged, in ASCII files as 0";
constexpr const char* kNoRate = "samples with an invalid frame rate are written as keys with invalid times";

bool isRate(float framesPerSecond) { return std::isfinite(framesPerSecond) && framesPerSecond > 0.0f; }

bool hasFiniteSamples(const TnFbxChannel& channel) {
    const TnFbxTime range = channel.getTime();
    if (channel.isConstant())
        return std::isfinite(channel.getAnimatedValue(static_cast<float>(range.getStartFrame())));
    std::array<float, kMostTogether> values;
    for (std::int64_t frame = range.getStartFrame(); frame <= range.getEndFrame();) {
        const auto left = static_cast<std::size_t>(range.getEndFrame() - frame + 1);
        const std::span<float> some = std::span(values).first(std::min(left, values.size()));
        channel.getAnimatedValues(static_cast<int>(frame), some.size(), some.data());
        if (!std::all_of(some.begin(), some.end(), [](float value) { return std::isfinite(value); }))
            return false;
        frame += static_cast<std::int64_t>(some.size());
    }
    return true;
}

/// The faults of the channels of one object, each once.
class ChannelCheck {
public:
    void visit(const TnFbxChannel* channel) {
        if (channel == nullptr)
            return;
        mFinite = mFinite && std::isfinite(channel->getValue());
        if (channel->getAnimated()) {
            mRate = mRate && isRate(channel->getTime().getFrameRate());
            mFinite = mFinite && hasFiniteSamples(*channel);
        }
    }
    void report(const std::string& object, ObjectWarnings& warnings) const {
        if (!mFinite)
            warnings.add(object, kNoNumbers);
        if (!mRate)
            warnings.add(object, kNoRate);
    }

private:
    bool mFinite = true, mRate = true;
};

void visitPlacement(ChannelCheck& check, TnFbxTransform& transform) {
    for (int i = TnFbxTransform::kFbxTransformPositionX; i <= TnFbxTransform::kFbxTransformScaleZ; ++i)
        check.visit(transform.getTransformChannel(static_cast<TnFbxTransform::EFbxTransformChannelType>(i)));
}

void visitLens(ChannelCheck& check, TnFbxCamera& camera) {
    switch (camera.getApertureMode()) {
    case TnFbxCamera::kFbxApertureHorizontalAndVertical:
        check.visit(camera.getCameraChannel(TnFbxCamera::kFbxCameraFieldOfViewX));
        check.visit(camera.getCameraChannel(TnFbxCamera::kFbxCameraFieldOfViewY));
        break;
    case TnFbxCamera::kFbxApertureHorizontal:
    case TnFbxCamera::kFbxApertureVertical:
        check.visit(camera.getCameraChannel(TnFbxCamera::kFbxCameraFieldOfView));
        break;
    case TnFbxCamera::kFbxApertureFocalLength:
        check.visit(camera.getCameraChannel(TnFbxCamera::kFbxCameraFocalLength));
        break;
    default: // a number that is no mode writes no lens
        break;
    }
}

/// Whether all of `count` triples are finite; `get` fills one.
template <class Get>
bool areFinite(int count, const Get& get) {
    for (int i = 0; i < count; ++i) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        get(i, x, y, z);
        if (!std::isfinite(x) || !std::isfinite(y) || !std::isfinite(z))
            return false;
    }
    return true;
}

bool hasFiniteNumbers(const TnFbxMesh& mesh) {
    const int corners = mesh.getNumberOfPolygonVertices();
    const auto point = [&mesh](int i, float& x, float& y, float& z) { mesh.getControlPoint(i, x, y, z); };
    const auto normal = [&mesh](int i, float& x, float& y, float& z) { mesh.getNormal(i, x, y, z); };
    const auto uv = [&mesh](int i, float& x, float& y, float&) { mesh.getUV(i, x, y); };
    const auto colour = [&mesh](int i, float& x, float& y, float& z) {
        float alpha = 0.0f;
        mesh.getColour(i, x, y, z, alpha);
        z += alpha * 0.0f; // not finite when the alpha is not
    };
    return areFinite(mesh.getNumberOfControlPoints(), point) &&
           (!mesh.getValidNormals() || areFinite(corners, normal)) && (!mesh.getValidUVs() || areFinite(corners, uv)) &&
           (!mesh.getValidColours() || areFinite(corners, colour));
}

void checkPolygons(const TnFbxMesh& mesh, ObjectWarnings& warnings) {
    std::int64_t corners = 0;
    bool anyEmpty = false;
    for (int polygon = 0; polygon < mesh.getNumberOfPolygons(); ++polygon) {
        const int size = mesh.getPolygonVertexSize(polygon);
        anyEmpty = anyEmpty || size < 1;
        corners += size > 0 ? size : 0;
    }
    if (anyEmpty)
        warnings.add(mesh.getName(), "polygons without polygon vertices are left out");
    if (corners > mesh.getNumberOfPolygonVertices()) {
        warnings.add(
            mesh.getName(),
            "the polygons have more polygon vertices than the mesh; the missing ones are written as control point 0");
    }
}

bool namesItsPointsOnly(const TnFbxMesh& mesh) {
    const int points = mesh.getNumberOfControlPoints();
    for (int corner = 0; corner < mesh.getNumberOfPolygonVertices(); ++corner) {
        const int point = mesh.getPointIndex(corner);
        if (point < 0 || point >= points)
            return false;
    }
    return true;
}

} // namespace

void detail::warnAboutRate(float framesPerSecond, bool isCustom) {
    char rate[32];
    std::snprintf(rate, sizeof rate, "%.9g", static_cast<double>(framesPerSecond));
    if (!isRate(framesPerSecond)) {
        warn(std::string(rate) + " frames per second is not a valid frame rate; readers will use a different one");
    } else if (isCustom) {
        warn(std::string(rate) +
             " frames per second is written as a custom frame rate without its value: times are exact, but frame "
             "numbers depend on the reader");
    }
}

void detail::check(TnFbxTransform& transform, ObjectWarnings& warnings) {
    ChannelCheck check;
    visitPlacement(check, transform);
    check.report(transform.getName(), warnings);
}

void detail::check(TnFbxCamera& camera, ObjectWarnings& warnings) {
    ChannelCheck check;
    visitPlacement(check, camera);
    for (const auto channel :
         {TnFbxCamera::kFbxCameraApertureWidth, TnFbxCamera::kFbxCameraApertureHeight, TnFbxCamera::kFbxCameraNearPlane,
          TnFbxCamera::kFbxCameraFarPlane, TnFbxCamera::kFbxCameraFilmOffsetX, TnFbxCamera::kFbxCameraFilmOffsetY})
        check.visit(camera.getCameraChannel(channel));
    visitLens(check, camera);
    check.report(camera.getName(), warnings);
}

void detail::check(TnFbxLight& light, ObjectWarnings& warnings) {
    ChannelCheck check;
    visitPlacement(check, light);
    for (const auto channel : {TnFbxLight::kFbxLightRed, TnFbxLight::kFbxLightGreen, TnFbxLight::kFbxLightBlue,
                               TnFbxLight::kFbxLightIntensity})
        check.visit(light.getLightChannel(channel));
    if (light.getLightType() == TnFbxLight::kFbxLightSpot)
        check.visit(light.getLightChannel(TnFbxLight::kFbxLightConeAngle));
    check.report(light.getName(), warnings);
}

void detail::check(const TnFbxMesh& mesh, ObjectWarnings& warnings) {
    checkPolygons(mesh, warnings);
    if (!namesItsPointsOnly(mesh))
        warnings.add(mesh.getName(), "polygons refer to control points that do not exist");
    if (!hasFiniteNumbers(mesh))
        warnings.add(mesh.getName(), kNoNumbers);
}

} // namespace Tarnell::Fbx
