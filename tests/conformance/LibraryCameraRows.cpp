// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Cameras as the facade returns them by default: their placement, their direction, and their lens.
#include "LibraryObjects.h"
#include "Tolerances.h"

#include <array>
#include <cmath>

namespace conformance {
namespace {

using namespace Tarnell::Fbx;
using fbxsdk::FbxNode;
using fbxsdk::FbxNodeAttribute;
using fbxsdk::FbxVector4;

constexpr std::array kCameraTypes = {FbxNodeAttribute::eCamera};

constexpr NumberRow kProjections[] = {{0, TnFbxCamera::kFbxCameraPerspective},
                                      {1, TnFbxCamera::kFbxCameraOrthographic}};

constexpr double kFocalLength = 3; ///< the aperture mode, as stored
constexpr NumberRow kApertureModes[] = {{0, TnFbxCamera::kFbxApertureHorizontalAndVertical}};

/// A camera channel and the stored value that it has.
struct CameraRow {
    const char* what;
    TnFbxCamera::EFbxCameraChannelType channel;
    const char* stored;
};

constexpr CameraRow kCameraValues[] = {
    {"roll", TnFbxCamera::kFbxCameraRoll, "Roll"},
    {"aperture width", TnFbxCamera::kFbxCameraApertureWidth, "FilmWidth"},
    {"aperture height", TnFbxCamera::kFbxCameraApertureHeight, "FilmHeight"},
};

/// Planes are lengths of the scene, and converted to centimetres with it.
constexpr CameraRow kCameraLengths[] = {
    {"near plane", TnFbxCamera::kFbxCameraNearPlane, "NearPlane"},
    {"far plane", TnFbxCamera::kFbxCameraFarPlane, "FarPlane"},
};

void compareValues(std::span<const CameraRow> rows, const ReferenceNode& node, const TnFbxCamera& camera, double factor,
                   Findings& findings) {
    for (const CameraRow& row : rows) {
        const std::optional<double> value = stated(node.camera, row.stored);
        compareNumber(node, row.what, camera.getValue(row.channel), value ? std::optional(*value * factor) : value,
                      findings);
    }
}

/// A direction or position of the file, in axes of which Y is up.
Point turnedUpright(const Point& stored, const std::array<int, 3>& axes) {
    Point result = stored;
    for (std::size_t i = 0; i < result.size(); ++i) {
        const auto axis = static_cast<std::size_t>(axes[i] / 2);
        if (axis < stored.size())
            result[i] = axes[i] % 2 == 0 ? stored[axis] : -stored[axis];
    }
    return result;
}

/// A stored vector in the scene's axes and unit; nothing for what the file does not state.
std::optional<Point> storedVector(const Reference& reference, const ReferenceNode& node, const char* name) {
    const std::array numbers = {stated(node.camera, name, 0), stated(node.camera, name, 1),
                                stated(node.camera, name, 2)};
    if (!numbers[0] || !numbers[1] || !numbers[2])
        return std::nullopt;
    return turnedUpright({*numbers[0], *numbers[1], *numbers[2]}, reference.axes);
}

Point cameraPoint(const TnFbxCamera& camera, int firstChannel) {
    Point point{};
    for (int i = 0; i < 3; ++i) {
        const auto channel = static_cast<TnFbxCamera::EFbxCameraChannelType>(firstChannel + i);
        point[static_cast<std::size_t>(i)] = static_cast<double>(camera.getValue(channel));
    }
    return point;
}

/// What is not stated is not compared.
void comparePoint(const ReferenceNode& node, const std::string& what, const Point& actual,
                  const std::optional<Point>& expected, Findings& findings) {
    if (!expected)
        return;
    bool same = true;
    for (std::size_t axis = 0; axis < actual.size(); ++axis)
        same = same && closeTo(actual[axis], (*expected)[axis], kHandedOutTolerance);
    findings.compare(same, [&] {
        return "\"" + node.name + "\" " + what + ": " + printed(actual.data(), 3) + " instead of " +
               printed(expected->data(), 3);
    });
}

void compareCommonValues(const Reference& reference, const ReferenceNode& node, const TnFbxCamera& camera,
                         Findings& findings) {
    comparePoint(node, "up vector", cameraPoint(camera, TnFbxCamera::kFbxCameraUpPositionX),
                 storedVector(reference, node, "UpVector"), findings);
    compareValues(kCameraValues, node, camera, 1.0, findings);
    constexpr double kCentimetresPerMetre = 100.0;
    compareValues(kCameraLengths, node, camera, reference.fileUnitMeters * kCentimetresPerMetre, findings);
    compareEnum(node, "projection", camera.getProjectionType(), stated(node.camera, "CameraProjectionType"),
                kProjections, TnFbxCamera::kFbxCameraPerspective, findings);
}

/// Kept: an angle that drives the lens leaves the static focal length unchanged, and so do two angles.
void compareLens(const ReferenceNode& node, const TnFbxCamera& camera, Findings& findings) {
    const std::optional<double> mode = stated(node.camera, "ApertureMode");
    if (!mode)
        return;
    compareEnum(node, "aperture mode", camera.getApertureMode(), mode, kApertureModes,
                TnFbxCamera::kFbxApertureFocalLength, findings);
    const auto untouched = static_cast<double>(TnFbxCamera::kDefaultCameraFocalLength);
    compareNumber(node, "focal length", camera.getValue(TnFbxCamera::kFbxCameraFocalLength),
                  *mode == kFocalLength ? stated(node.camera, "FocalLength") : untouched, findings);
}

/// Kept: a property "FilmOffset" copies X to Y.
void compareFilmOffset(const ReferenceNode& node, const TnFbxCamera& camera, const FbxNodeAttribute& attribute,
                       Findings& findings) {
    const bool both = attribute.FindProperty("FilmOffset", true).IsValid();
    compareNumber(node, "film offset X", camera.getValue(TnFbxCamera::kFbxCameraFilmOffsetX),
                  stated(node.camera, "FilmOffsetX"), findings);
    compareNumber(node, "film offset Y", camera.getValue(TnFbxCamera::kFbxCameraFilmOffsetY),
                  stated(node.camera, both ? "FilmOffsetX" : "FilmOffsetY"), findings);
}

constexpr std::array<std::array<std::size_t, 3>, 6> kAxesOfOrders = {
    {{0, 1, 2}, {0, 2, 1}, {1, 0, 2}, {1, 2, 0}, {2, 0, 1}, {2, 1, 0}}};

Matrix12 turnedBy(const TnFbxTransform& transform, const Point& degrees) {
    const auto order = static_cast<std::size_t>(transform.getTransformRotationOrder());
    Matrix12 result = scaled({1, 1, 1});
    for (const std::size_t axis : kAxesOfOrders.at(order)) {
        Point one{};
        one[axis] = degrees[axis];
        result = product(turned(one), result);
    }
    return result;
}

Point asPoint(const FbxVector4& vector) { return {vector[0], vector[1], vector[2]}; }
Point opposite(const Point& point) { return {-point[0], -point[1], -point[2]}; }

/// A node's matrix in its parent's space, of the three local values and the node's pivots.
Matrix12 localMatrix(const FbxNode& node, const Placement& local, const Matrix12& rotation) {
    const Point rotationPivot = asPoint(node.GetRotationPivot(FbxNode::eSourcePivot));
    const Point scalingPivot = asPoint(node.GetScalingPivot(FbxNode::eSourcePivot));
    Matrix12 pre = scaled({1, 1, 1}), post = pre;
    if (node.GetRotationActive()) {
        pre = turned(asPoint(node.GetPreRotation(FbxNode::eSourcePivot)));
        post = inverse(turned(asPoint(node.GetPostRotation(FbxNode::eSourcePivot)))).value();
    }
    const Matrix12 parts[] = {shifted(local.position),
                              shifted(asPoint(node.GetRotationOffset(FbxNode::eSourcePivot))),
                              shifted(rotationPivot),
                              pre,
                              rotation,
                              post,
                              shifted(opposite(rotationPivot)),
                              shifted(asPoint(node.GetScalingOffset(FbxNode::eSourcePivot))),
                              shifted(scalingPivot),
                              scaled(local.scale),
                              shifted(opposite(scalingPivot))};
    Matrix12 result = scaled({1, 1, 1});
    for (const Matrix12& part : parts)
        result = product(result, part);
    return result;
}

/// Whether the library has a sample at that frame, if it has samples.
bool knowsFrame(const TnFbxTransform& transform, const Reference& reference, double frame) {
    for (int i = TnFbxTransform::kFbxTransformPositionX; i <= TnFbxTransform::kFbxTransformScaleZ; ++i) {
        const auto channel = static_cast<TnFbxTransform::EFbxTransformChannelType>(i);
        if (transform.getTransformAnimated(channel) && !isSampled(transform, channel, frame, reference.fps))
            return false;
    }
    return true;
}

Point difference(const Point& from, const Point& to) { return {to[0] - from[0], to[1] - from[1], to[2] - from[2]}; }

Point crossed(const Point& a, const Point& b) {
    return {a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]};
}

/// Of unit length; nothing for one without a length.
std::optional<Point> unit(const Point& vector) {
    const double length = std::hypot(vector[0], vector[1], vector[2]);
    if (length == 0)
        return std::nullopt;
    return Point{vector[0] / length, vector[1] / length, vector[2] / length};
}

/// A producer camera looks at a point: forward is −Z, and the roll turns up toward the right-hand side. Kept: the
/// angles are Z, X, Y, whatever the rotation order.
void compareAim(const ReferenceNode& node, const TnFbxCamera& camera, Findings& findings) {
    const Placement placement = placementAt(camera, 0);
    const Point& degrees = placement.rotation;
    const Matrix12 rotation =
        product(turned({0, degrees[1], 0}), product(turned({degrees[0], 0, 0}), turned({0, 0, degrees[2]})));
    const Point lookAt = cameraPoint(camera, TnFbxCamera::kFbxCameraLookAtPositionX);
    const std::optional<Point> forward = unit(difference(placement.position, lookAt));
    comparePoint(node, "forward", moved(rotation, {0, 0, -1}), forward, findings);
    const Point upVector = cameraPoint(camera, TnFbxCamera::kFbxCameraUpPositionX);
    const std::optional<Point> side = forward ? unit(crossed(*forward, upVector)) : forward;
    if (!side)
        return; // it has no direction, or looks along its up vector
    const Point up = crossed(*side, *forward);
    constexpr double kDegrees = 57.295779513082320877;
    const double roll = static_cast<double>(camera.getValue(TnFbxCamera::kFbxCameraRoll)) / kDegrees;
    Point rolled{};
    for (std::size_t axis = 0; axis < rolled.size(); ++axis)
        rolled[axis] = std::cos(roll) * up[axis] + std::sin(roll) * (*side)[axis];
    comparePoint(node, "up", moved(rotation, {0, 1, 0}), rolled, findings);
}

/// Kept: a camera is read with its local placement, so that pivots, pre- and post-rotation are left to the host. All of
/// it together must be the reference's matrix. Below a parent the parent's matrix comes first.
void comparePlacement(LoadedFile& file, std::size_t nodeIndex, const TnFbxCamera& camera, std::size_t frameIndex,
                      Findings& findings) {
    const Reference& reference = file.reference();
    const ReferenceNode& node = reference.nodes[nodeIndex];
    const Placement local = placementAt(camera, reference.frames[frameIndex]);
    Matrix12 actual = localMatrix(*file.nodeOf(nodeIndex)->node, local, turnedBy(camera, local.rotation));
    if (node.parent >= 0)
        actual = product(reference.nodes[static_cast<std::size_t>(node.parent)].world[frameIndex], actual);
    compareMatrices(reference, node, frameIndex, actual, node.world[frameIndex], findings);
}

void compareCamera(LoadedFile& file, std::size_t nodeIndex, const TnFbxCamera& camera, Findings& findings) {
    const ReferenceNode& node = file.reference().nodes[nodeIndex];
    compareCommonValues(file.reference(), node, camera, findings);
    compareLens(node, camera, findings);
    compareFilmOffset(node, camera, *file.nodeOf(nodeIndex)->node->GetNodeAttribute(), findings);
    for (std::size_t f = 0; f < node.world.size(); ++f)
        if (knowsFrame(camera, file.reference(), file.reference().frames[f]))
            comparePlacement(file, nodeIndex, camera, f, findings);
}

void compareProducer(const Reference& reference, const ReferenceNode& node, const TnFbxCamera& camera,
                     Findings& findings) {
    compareCommonValues(reference, node, camera, findings);
    comparePoint(node, "look-at point", cameraPoint(camera, TnFbxCamera::kFbxCameraLookAtPositionX),
                 storedVector(reference, node, "InterestPosition"), findings);
    comparePoint(node, "position", placementAt(camera, 0).position, storedVector(reference, node, "Position"),
                 findings);
    compareNumber(node, "focal length", camera.getValue(TnFbxCamera::kFbxCameraFocalLength),
                  stated(node.camera, "FocalLength"), findings);
    compareAim(node, camera, findings);
}

} // namespace

void checkLibraryCameras(LoadedFile& file, Findings& findings) {
    const Reference& reference = file.reference();
    if (!file.loaded() || !hasKind(reference, "camera"))
        return;
    TnFbxReadInfo info;
    const auto list = read<TnFbxCamera>(file, info, &Fbx::getCameras, findings);
    const std::size_t ofScene = static_cast<std::size_t>(std::ranges::count_if(
        file.nodes(), [](const SceneNode& entry) { return typeOf(*entry.node) == FbxNodeAttribute::eCamera; }));
    findings.compare(list.count >= ofScene, [] { return "fewer cameras than the scene has"; });
    if (list.count < ofScene)
        return;
    const auto cameras = list.span();
    const auto producers = cameras.first(list.count - ofScene);
    for (const Handed<TnFbxCamera>& handed : matched(file, cameras.last(ofScene), kCameraTypes, findings))
        compareCamera(file, handed.nodeIndex, *handed.object, findings);
    for (std::size_t i = 0; i < reference.nodes.size(); ++i) {
        if (reference.nodes[i].kind != "camera" || !file.besideTree(i))
            continue;
        const auto producer = std::ranges::find(producers, reference.nodes[i].name, &TnFbxCamera::getName);
        findings.compare(producer != producers.end(), [&] { return "no \"" + reference.nodes[i].name + "\""; });
        if (producer != producers.end())
            compareProducer(reference, reference.nodes[i], *producer, findings);
    }
}

} // namespace conformance
