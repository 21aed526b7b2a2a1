// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Where converted objects stand and how they are turned.
#include "Placement.h"

#include <array>
#include <cmath>
#include <memory>
#include <utility>
#include <vector>

namespace tool {
namespace {

using namespace Tarnell::Fbx;
using Channel = TnFbxTransform::EFbxTransformChannelType;

/// x, y and z, each with a value per frame.
using Curves = std::array<std::vector<float>, 3>;

void append(Curves& curves, const FbxVector4& value) {
    for (int axis = 0; axis < 3; ++axis)
        curves[static_cast<std::size_t>(axis)].push_back(static_cast<float>(value[axis]));
}

void store(TnFbxTransform& object, Channel first, const TnFbxTime& range, Curves curves) {
    for (int axis = 0; axis < 3; ++axis) {
        const auto channel = static_cast<Channel>(first + axis);
        std::vector<float>& values = curves[static_cast<std::size_t>(axis)];
        object.setTransformValue(channel, values.front());
        object.setTransformValueAt(channel, range, std::move(values));
    }
}

/// The angle plus full turns that is nearest to the other one.
double nearestTurn(double angle, double other) { return angle + 360.0 * std::round((other - angle) / 360.0); }

/// Of all XYZ angles that turn alike, those nearest to the ones before.
FbxVector4 continued(const FbxVector4& angles, const FbxVector4& before) {
    const FbxVector4 other(angles[0] + 180.0, 180.0 - angles[1], angles[2] + 180.0);
    FbxVector4 best;
    double least = HUGE_VAL;
    for (const FbxVector4& candidate : {angles, other}) {
        FbxVector4 turned;
        double distance = 0.0;
        for (int i = 0; i < 3; ++i) {
            turned[i] = nearestTurn(candidate[i], before[i]);
            distance += std::abs(turned[i] - before[i]);
        }
        if (distance < least) {
            least = distance;
            best = turned;
        }
    }
    return best;
}

FbxAMatrix turned(const FbxVector4& angles) {
    FbxAMatrix matrix;
    matrix.SetR(angles);
    return matrix;
}

/// The library decomposes into XYZ, but into ZXY where an object is exactly at the origin.
struct Rotation {
    double x = 0.0, y = 0.0, z = 0.0;
    bool atOrigin = false;

    bool operator==(const Rotation&) const = default;
};

Rotation rotationAt(const TnFbxTransform& object, float frame) {
    const auto value = [&](int channel) {
        return static_cast<double>(object.getTransformValueAt(static_cast<Channel>(channel), frame));
    };
    const bool atOrigin = value(TnFbxTransform::kFbxTransformPositionX) == 0.0 &&
                          value(TnFbxTransform::kFbxTransformPositionY) == 0.0 &&
                          value(TnFbxTransform::kFbxTransformPositionZ) == 0.0;
    return {value(TnFbxTransform::kFbxTransformRotationX), value(TnFbxTransform::kFbxTransformRotationY),
            value(TnFbxTransform::kFbxTransformRotationZ), atOrigin};
}

FbxAMatrix matrixOf(const Rotation& rotation) {
    const auto& [x, y, z, atOrigin] = rotation;
    if (!atOrigin)
        return turned({x, y, z});
    return turned({0, y, 0}) * turned({x, 0, 0}) * turned({0, 0, z});
}

TnFbxChannel& channelOf(TnFbxTransform& object, int channel) {
    return *object.getTransformChannel(static_cast<Channel>(channel));
}

/// Whether neither the position nor the rotation changes.
bool standsStill(TnFbxTransform& object) {
    for (int channel = TnFbxTransform::kFbxTransformPositionX; channel <= TnFbxTransform::kFbxTransformRotationZ;
         ++channel) {
        if (!channelOf(object, channel).isConstant())
            return false;
    }
    return true;
}

} // namespace

FbxTime timeAt(const TnFbxTime& range, long long frame) {
    FbxTime time;
    time.SetSecondDouble(static_cast<double>(frame) / static_cast<double>(range.getFrameRate()));
    return time;
}

FbxAMatrix MeshPlacement::placeOf(FbxNode& node, FbxTime time) const {
    return (mLocal ? node.EvaluateLocalTransform(time) : node.EvaluateGlobalTransform(time)) * mSdk.getGeometry(&node);
}

std::vector<FbxVector4> MeshPlacement::pointsOf(FbxNode& node, FbxTime time) const {
    FbxMesh& mesh = *node.GetMesh();
    const FbxVector4* points = mesh.GetControlPoints();
    std::unique_ptr<FbxVector4[]> deformed;
    if (mSdk.getDeformation(&mesh)) {
        FbxAMatrix inWorld = node.EvaluateGlobalTransform(time) * mSdk.getGeometry(&node);
        FbxVector4* made = nullptr;
        mSdk.getDeformedControlPoints(&node, &mesh, time, inWorld, &made);
        deformed.reset(made);
        points = made ? made : points;
    }
    const FbxAMatrix place = placeOf(node, time);
    std::vector<FbxVector4> placed;
    placed.reserve(static_cast<std::size_t>(mesh.GetControlPointsCount()));
    for (int i = 0; i < mesh.GetControlPointsCount(); ++i)
        placed.push_back(place.MultT(points[i]));
    return placed;
}

void MeshPlacement::place(TnFbxMesh& mesh, FbxNode& node, FbxTime time) const {
    const std::vector<FbxVector4> points = pointsOf(node, time);
    for (std::size_t i = 0; i < points.size(); ++i)
        mesh.setControlPoint(static_cast<int>(i), static_cast<float>(points[i][0]), static_cast<float>(points[i][1]),
                             static_cast<float>(points[i][2]));
    FbxAMatrix rotation;
    rotation.SetR(placeOf(node, time).GetR());
    for (int i = 0; i < mesh.getNumberOfPolygonVertices(); ++i) {
        float x = 0.0F, y = 0.0F, z = 0.0F;
        mesh.getNormal(i, x, y, z);
        const FbxVector4 normal =
            rotation.MultT({static_cast<double>(x), static_cast<double>(y), static_cast<double>(z)});
        mesh.setNormal(i, static_cast<float>(normal[0]), static_cast<float>(normal[1]), static_cast<float>(normal[2]));
    }
}

void MeshPlacement::addPoints(TnFbxMesh& mesh, FbxNode& node, FbxTime time) const {
    mesh.addControlPointSet();
    for (const FbxVector4& point : pointsOf(node, time))
        mesh.addControlPoint(static_cast<float>(point[0]), static_cast<float>(point[1]), static_cast<float>(point[2]));
}

void placeCamera(TnFbxCamera& camera, FbxNode& node, const TnFbxTime& range) {
    // What is written is turned by a further quarter, so that the view axis of hosts becomes that of files.
    const FbxAMatrix quarter = turned({0, -90, 0});
    Curves positions, rotations;
    FbxVector4 angles;
    for (long long frame = range.getStartFrame(); frame <= range.getEndFrame(); ++frame) {
        const FbxAMatrix& world = node.EvaluateGlobalTransform(timeAt(range, frame));
        append(positions, world.GetT());
        FbxAMatrix rotation;
        rotation.SetQ(world.GetQ());
        const FbxVector4 now = (rotation * quarter).GetR();
        angles = rotations[0].empty() ? now : continued(now, angles);
        append(rotations, angles);
    }
    if (rotations[0].empty())
        return;
    store(camera, Channel::kFbxTransformPositionX, range, std::move(positions));
    store(camera, Channel::kFbxTransformRotationX, range, std::move(rotations));
    camera.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderXYZ);
}

void expressInXyz(TnFbxTransform& object) {
    const TnFbxTime range = object.getTransformTime(TnFbxTransform::kFbxTransformRotationX);
    if (!object.getTransformAnimated(TnFbxTransform::kFbxTransformRotationX))
        return;
    if (standsStill(object)) {
        const FbxVector4 angles = matrixOf(rotationAt(object, static_cast<float>(range.getStartFrame()))).GetR();
        for (int axis = 0; axis < 3; ++axis) {
            TnFbxChannel& channel = channelOf(object, TnFbxTransform::kFbxTransformRotationX + axis);
            channel.setConstantValues(range, static_cast<float>(angles[axis]));
            channel.setValue(static_cast<float>(angles[axis]));
        }
        object.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderXYZ);
        return;
    }
    Curves rotations;
    FbxVector4 angles;
    Rotation last;
    for (long long frame = range.getStartFrame(); frame <= range.getEndFrame(); ++frame) {
        const Rotation now = rotationAt(object, static_cast<float>(frame));
        if (rotations[0].empty()) {
            angles = matrixOf(now).GetR();
        } else if (!(now == last)) {
            angles = continued(matrixOf(now).GetR(), angles);
        }
        last = now;
        append(rotations, angles);
    }
    store(object, Channel::kFbxTransformRotationX, range, std::move(rotations));
    object.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderXYZ);
}

} // namespace tool
