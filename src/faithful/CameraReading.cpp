// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Cameras: their direction, lens and film, computed at every frame.
#include "Aim.h"
#include "Decomposition.h"
#include "Lens.h"
#include "Placement.h"
#include "Reading.h"
#include "Sampling.h"

#include <algorithm>
#include <array>
#include <span>
#include <utility>

namespace Tarnell::Fbx::faithful {

namespace {

using fbxsdk::FbxAMatrix;
using fbxsdk::FbxCamera;
using fbxsdk::FbxNode;
using fbxsdk::FbxTime;
using fbxsdk::FbxVector4;

constexpr std::size_t kChannels = TnFbxCamera::kFbxCameraFilmOffsetY + 1;

// ---- Lens and film ----

/// The focal length, both angles and the film are consistent: the value that the mode names drives the lens, and the
/// rest follows.
Lens lensAt(FbxCamera& source, TnFbxCamera::EFbxCameraApertureMode mode, const FbxTime& time) {
    Lens lens{};
    lens.width = source.FilmWidth.EvaluateValue(time) * source.FilmSqueezeRatio.EvaluateValue(time);
    lens.height = source.FilmHeight.EvaluateValue(time);
    lens.focalLength = source.FocalLength.EvaluateValue(time);
    lens.fieldOfView = source.FieldOfView.EvaluateValue(time);
    lens.fieldOfViewX = source.FieldOfViewX.EvaluateValue(time);
    lens.fieldOfViewY = source.FieldOfViewY.EvaluateValue(time);
    return agreeing(lens, mode);
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

// ---- Direction ----

FbxVector4 asVector(const fbxsdk::FbxDouble3& value) { return {value[0], value[1], value[2]}; }

FbxVector4 minus(const FbxVector4& a, const FbxVector4& b) { return {a[0] - b[0], a[1] - b[1], a[2] - b[2]}; }

/// The point that a camera looks at, in the world.
class Aim {
public:
    Aim(const Scene& scene, FbxNode& node) : mNode(node), mCamera(*node.GetCamera()), mUnit(scene.unit()) {}

    bool hasTarget() const { return mNode.GetTarget() != nullptr; }

    FbxVector4 pointAt(const FbxTime& time) const {
        if (FbxNode* target = mNode.GetTarget())
            return worldMatrix(*target, time).GetT();
        FbxVector4 point = asVector(mCamera.InterestPosition.EvaluateValue(time));
        for (int i = 0; i < 3; ++i)
            point[i] *= mUnit; // nodes were scaled to centimetres, the attribute's point was not
        return point;
    }

    /// Toward the parent where there is one.
    FbxVector4 upAt(const FbxTime& time) const {
        if (FbxNode* above = mNode.GetTargetUp())
            return minus(worldMatrix(*above, time).GetT(), worldMatrix(mNode, time).GetT());
        return asVector(mCamera.UpVector.EvaluateValue(time));
    }

    /// The camera in the world, rotated toward the point and rolled; with the node's own rotation where that has no
    /// direction.
    FbxAMatrix matrixAt(const FbxTime& time) const {
        return aimed(worldMatrix(mNode, time) * turnOf(kCameraTurn), pointAt(time), upAt(time),
                     mCamera.Roll.EvaluateValue(time));
    }

private:
    FbxNode& mNode;
    FbxCamera& mCamera;
    double mUnit;
};

Placement cameraPlacement(Scene& scene, FbxNode& node, const TnFbxReadInfo& info) {
    const Aim aim(scene, node);
    const bool global = info.getGlobalTransform();
    const bool looksAt = aim.hasTarget() || info.getComputeCameraRotation();
    Placement placement = placementOf(scene, node, global);
    placement.ownAngles = !looksAt; // they are the angles of cameras that the library writes
    placement.nearOwn = false;
    if (!looksAt) {
        placement.matricesAt = rotatedFirst(std::move(placement.matricesAt), turnOf(kCameraTurn));
        return placement;
    }
    placement.matricesAt = [aim, global, &node](std::span<const FbxTime> times, FbxAMatrix* matrices) {
        std::transform(times.begin(), times.end(), matrices, [&](const FbxTime& time) {
            if (global)
                return aim.matrixAt(time);
            const FbxAMatrix parent = parentMatrix(node, time);
            return handedness(parent) == 0.0 // a flattened space does not have the direction to the point
                       ? localMatrix(node, time) * turnOf(kCameraTurn)
                       : parent.Inverse() * aim.matrixAt(time);
        });
    };
    FbxNode* target = node.GetTarget();
    FbxNode* above = node.GetTargetUp();
    placement.moves = placement.moves || (target != nullptr && scene.moves(*target)) ||
                      (above != nullptr && scene.moves(*above)) || scene.isKeyed(*node.GetCamera());
    return placement;
}

/// The aim as the channels have it: relative to the camera's parent when the placement is.
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

    const Aim aim(scene, node);
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
