// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Cameras: where they look, what drives their lens, and the film behind it, all of it worked out at every frame.
#include "Placement.h"
#include "Reading.h"
#include "Sampling.h"

#include <array>
#include <cmath>
#include <optional>

namespace Tarnell::Fbx::faithful {

namespace {

using fbxsdk::FbxAMatrix;
using fbxsdk::FbxCamera;
using fbxsdk::FbxNode;
using fbxsdk::FbxTime;
using fbxsdk::FbxVector4;

constexpr double kMillimetresPerInch = 25.4;
constexpr double kRadians = 0.017453292519943295769;
constexpr std::size_t kChannels = TnFbxCamera::kFbxCameraFilmOffsetY + 1;

// ---- Lens and film ----

struct Lens {
    double focalLength;                             // millimetres
    double width, height;                           // of the film, inches
    double fieldOfView, fieldOfViewX, fieldOfViewY; // degrees
};

bool isAngle(double degrees) { return degrees > 0.0 && degrees < 180.0; }

double focalLengthOf(double inches, double degrees) {
    return inches * kMillimetresPerInch / 2.0 / std::tan(degrees / 2.0 * kRadians);
}

double angleOf(double inches, double focalLength) {
    return 2.0 * std::atan2(inches * kMillimetresPerInch / 2.0, focalLength) / kRadians;
}

/// The focal length, both angles and the film agree: what the mode says drives the lens, and the rest follows.
Lens lensAt(FbxCamera& source, TnFbxCamera::EFbxCameraApertureMode mode, const FbxTime& time) {
    Lens lens{};
    lens.width = source.FilmWidth.EvaluateValue(time) * source.FilmSqueezeRatio.EvaluateValue(time);
    lens.height = source.FilmHeight.EvaluateValue(time);
    lens.focalLength = source.FocalLength.EvaluateValue(time);
    const double angle = source.FieldOfView.EvaluateValue(time);
    const double angleX = source.FieldOfViewX.EvaluateValue(time);
    const double angleY = source.FieldOfViewY.EvaluateValue(time);
    if (mode == TnFbxCamera::kFbxApertureHorizontal && isAngle(angle)) {
        lens.focalLength = focalLengthOf(lens.width, angle);
    } else if (mode == TnFbxCamera::kFbxApertureVertical && isAngle(angle)) {
        lens.focalLength = focalLengthOf(lens.height, angle);
    } else if (mode == TnFbxCamera::kFbxApertureHorizontalAndVertical && isAngle(angleX) && isAngle(angleY)) {
        // Two angles give the film its shape; its width is believed.
        lens.focalLength = focalLengthOf(lens.width, angleX);
        lens.height = 2.0 * lens.focalLength * std::tan(angleY / 2.0 * kRadians) / kMillimetresPerInch;
    }
    lens.fieldOfViewX = angleOf(lens.width, lens.focalLength);
    lens.fieldOfViewY = angleOf(lens.height, lens.focalLength);
    lens.fieldOfView = mode == TnFbxCamera::kFbxApertureVertical ? lens.fieldOfViewY : lens.fieldOfViewX;
    return lens;
}

TnFbxCamera::EFbxCameraApertureMode apertureModeOf(const FbxCamera& source) {
    switch (source.ApertureMode.Get<fbxsdk::FbxEnum>()) {
    case FbxCamera::eHorizAndVert:
        return TnFbxCamera::kFbxApertureHorizontalAndVertical;
    case FbxCamera::eHorizontal:
        return TnFbxCamera::kFbxApertureHorizontal;
    case FbxCamera::eVertical:
        return TnFbxCamera::kFbxApertureVertical;
    default:
        return TnFbxCamera::kFbxApertureFocalLength;
    }
}

// ---- Where it looks ----

FbxVector4 asVector(const fbxsdk::FbxDouble3& value) { return {value[0], value[1], value[2]}; }

FbxVector4 minus(const FbxVector4& a, const FbxVector4& b) { return {a[0] - b[0], a[1] - b[1], a[2] - b[2]}; }

FbxVector4 crossProduct(const FbxVector4& a, const FbxVector4& b) {
    return {a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]};
}

double lengthOf(const FbxVector4& a) { return std::sqrt(a[0] * a[0] + a[1] * a[1] + a[2] * a[2]); }

/// Of unit length; nothing where there is none.
std::optional<FbxVector4> direction(const FbxVector4& a) {
    const double length = lengthOf(a);
    if (!(length > 1e-12) || !std::isfinite(length)) {
        return std::nullopt;
    }
    return FbxVector4(a[0] / length, a[1] / length, a[2] / length);
}

/// Cameras of files look along X with Y up, those of hosts along −Z.
FbxAMatrix cameraAxes() {
    FbxAMatrix turn;
    turn.SetR(FbxVector4(0.0, -90.0, 0.0));
    return turn;
}

/// What a camera looks at, in the world.
class Aim {
public:
    explicit Aim(FbxNode& node) : mNode(node), mCamera(*node.GetCamera()) {}

    bool hasTarget() const { return mNode.GetTarget() != nullptr; }

    FbxVector4 pointAt(const FbxTime& time) const {
        if (FbxNode* target = mNode.GetTarget()) {
            return worldMatrix(*target, time).GetT();
        }
        return asVector(mCamera.InterestPosition.EvaluateValue(time));
    }

    /// Toward the node above it where there is one.
    FbxVector4 upAt(const FbxTime& time) const {
        if (FbxNode* above = mNode.GetTargetUp()) {
            return minus(worldMatrix(*above, time).GetT(), worldMatrix(mNode, time).GetT());
        }
        return asVector(mCamera.UpVector.EvaluateValue(time));
    }

    /// The camera in the world, turned toward the point and rolled; the node's own turn where that has no direction.
    FbxAMatrix matrixAt(const FbxTime& time) const {
        FbxAMatrix matrix = worldMatrix(mNode, time) * cameraAxes();
        const std::optional<FbxVector4> back = direction(minus(matrix.GetT(), pointAt(time)));
        if (!back) {
            return matrix;
        }
        std::optional<FbxVector4> right = direction(crossProduct(upAt(time), *back));
        if (!right) {
            right = direction(crossProduct(matrix.GetRow(1), *back));
        }
        if (!right) {
            return matrix;
        }
        const FbxVector4 up = crossProduct(*back, *right);
        const FbxVector4 axes[3] = {*right, up, *back};
        FbxAMatrix roll;
        roll.SetR(FbxVector4(0.0, 0.0, -mCamera.Roll.EvaluateValue(time)));
        FbxAMatrix turned;
        for (int axis = 0; axis < 3; ++axis) {
            for (int component = 0; component < 3; ++component) {
                turned[axis][component] = axes[axis][component];
            }
        }
        turned = turned * roll;
        for (int axis = 0; axis < 3; ++axis) {
            const double size = lengthOf(matrix.GetRow(axis));
            for (int component = 0; component < 3; ++component) {
                matrix[axis][component] = turned[axis][component] * size;
            }
        }
        return matrix;
    }

private:
    FbxNode& mNode;
    FbxCamera& mCamera;
};

Placement cameraPlacement(Scene& scene, FbxNode& node, const TnFbxReadInfo& info) {
    const Aim aim(node);
    const bool global = info.getGlobalTransform();
    const bool looksAt = aim.hasTarget() || info.getComputeCameraRotation();
    Placement placement = placementOf(scene, node, global);
    placement.ownAngles = false;
    if (!looksAt) {
        placement.matrixAt = [place = placement.matrixAt, turn = cameraAxes()](const FbxTime& time) {
            return place(time) * turn;
        };
        return placement;
    }
    placement.matrixAt = [aim, global, &node](const FbxTime& time) {
        return global ? aim.matrixAt(time) : parentMatrix(node, time).Inverse() * aim.matrixAt(time);
    };
    FbxNode* target = node.GetTarget();
    FbxNode* above = node.GetTargetUp();
    placement.moves = placement.moves || (target != nullptr && scene.moves(*target)) ||
                      (above != nullptr && scene.moves(*above)) || scene.isKeyed(*node.GetCamera());
    return placement;
}

/// The aim as the channels have it: from the camera's parent when the placement is.
struct AimValues {
    FbxVector4 point, up;
};

AimValues aimAt(const Aim& aim, FbxNode& node, bool global, const FbxTime& time) {
    AimValues values{aim.pointAt(time), aim.upAt(time)};
    if (!global) {
        FbxAMatrix fromWorld = parentMatrix(node, time).Inverse();
        values.point = fromWorld.MultT(values.point);
        fromWorld.SetT(FbxVector4(0.0, 0.0, 0.0));
        values.up = fromWorld.MultT(values.up);
    }
    return values;
}

} // namespace

bool readNode(Scene& scene, const TnFbxReadInfo& info, FbxNode& node, TnFbxCamera& camera) {
    FbxCamera& source = *node.GetCamera();
    const bool orthographic = source.ProjectionType.Get<fbxsdk::FbxEnum>() == FbxCamera::eOrthogonal;
    camera.setProjectionType(orthographic ? TnFbxCamera::kFbxCameraOrthographic : TnFbxCamera::kFbxCameraPerspective);
    const auto mode = apertureModeOf(source);
    camera.setApertureMode(mode);

    const Aim aim(node);
    const bool global = info.getGlobalTransform();
    const auto valuesAt = [&](const FbxTime& time) -> std::array<double, kChannels> {
        const AimValues looks = aimAt(aim, node, global, time);
        const Lens lens = lensAt(source, mode, time);
        return {looks.point[0],
                looks.point[1],
                looks.point[2],
                looks.up[0],
                looks.up[1],
                looks.up[2],
                source.Roll.EvaluateValue(time),
                lens.focalLength,
                lens.width,
                lens.height,
                source.NearPlane.EvaluateValue(time),
                source.FarPlane.EvaluateValue(time),
                lens.fieldOfView,
                lens.fieldOfViewX,
                lens.fieldOfViewY,
                source.FilmOffsetX.EvaluateValue(time),
                source.FilmOffsetY.EvaluateValue(time)};
    };
    const Placement placement = cameraPlacement(scene, node, info);
    const bool aimMoves = placement.moves && (aim.hasTarget() || !global);
    return readPlacement(scene, placement, camera) &&
           fillChannels<kChannels>(scene, aimMoves || scene.isKeyed(source), camera,
                                   TnFbxCamera::kFbxCameraLookAtPositionX, valuesAt);
}

} // namespace Tarnell::Fbx::faithful
