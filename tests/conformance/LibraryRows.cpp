// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The same files through the facade, as the scene has them: local samples, and meshes whose points were not moved.
#include "LibraryObjects.h"
#include "Matrices.h"
#include "Tolerances.h"

#include <array>

namespace conformance {
namespace {

using namespace Tarnell::Fbx;
using fbxsdk::FbxNodeAttribute;

constexpr std::array kMeshTypes = {FbxNodeAttribute::eMesh};
constexpr std::array kTransformTypes = {FbxNodeAttribute::eUnknown, FbxNodeAttribute::eNull, FbxNodeAttribute::eMarker,
                                        FbxNodeAttribute::eMesh};

struct TransformChannel {
    TnFbxTransform::EFbxTransformChannelType channel;
    const char* curve;
    bool conversionChanges; ///< on nodes that the conversion moves
};

constexpr TransformChannel kTransformChannels[] = {
    {TnFbxTransform::kFbxTransformPositionX, "Lcl Translation X", true},
    {TnFbxTransform::kFbxTransformPositionY, "Lcl Translation Y", true},
    {TnFbxTransform::kFbxTransformPositionZ, "Lcl Translation Z", true},
    {TnFbxTransform::kFbxTransformRotationX, "Lcl Rotation X", false},
    {TnFbxTransform::kFbxTransformRotationY, "Lcl Rotation Y", false},
    {TnFbxTransform::kFbxTransformRotationZ, "Lcl Rotation Z", false},
    {TnFbxTransform::kFbxTransformScaleX, "Lcl Scaling X", true},
    {TnFbxTransform::kFbxTransformScaleY, "Lcl Scaling Y", true},
    {TnFbxTransform::kFbxTransformScaleZ, "Lcl Scaling Z", true},
};

bool isConstant(const std::vector<double>& values) {
    return std::ranges::all_of(
        values, [&](double value) { return closeTo(value, values[0], kHandedOutTolerance); });
}

void compareSamples(const Reference& reference, const ReferenceNode& node, const TnFbxTransform& transform,
                    const TransformChannel& row, const std::vector<double>& expected, Findings& findings) {
    if (!transform.getTransformAnimated(row.channel)) {
        const auto value = static_cast<double>(transform.getTransformValue(row.channel));
        findings.compare(isConstant(expected), [&] {
            return "\"" + node.name + "\" " + row.curve + " has no samples, only " + printed(value);
        });
        return;
    }
    for (std::size_t f = 0; f < expected.size(); ++f) {
        if (!isSampled(transform, row.channel, reference.frames[f], reference.fps))
            continue;
        const float value = transform.getTransformValueAt(row.channel, static_cast<float>(reference.frames[f]));
        findings.compare(closeTo(static_cast<double>(value), expected[f], kHandedOutTolerance), [&] {
            return "\"" + node.name + "\" " + row.curve + " at frame " + printed(reference.frames[f]) + ": " +
                   printed(static_cast<double>(value)) + " instead of " + printed(expected[f]);
        });
    }
}

struct MeshSums {
    long long sizes = 0, indices = 0;
};

MeshSums sumsOf(const TnFbxMesh& mesh) {
    constexpr int kFactors = 97;
    MeshSums sums;
    for (int i = 0; i < mesh.getNumberOfPolygons(); ++i)
        sums.sizes += mesh.getPolygonVertexSize(i) * (i % kFactors + 1);
    for (int i = 0; i < mesh.getNumberOfPolygonVertices(); ++i)
        sums.indices += mesh.getPointIndex(i) * (i % kFactors + 1);
    return sums;
}

bool sameCount(long long actual, long long expected) {
    return closeTo(static_cast<double>(actual), static_cast<double>(expected), kCountTolerance);
}

/// The library's points, placed by the reference's matrices, against the reference's points.
void compareMeshPoints(const ReferenceNode& node, const TnFbxMesh& mesh, Findings& findings) {
    const std::vector<double>& expected = node.mesh->worldPoints[0];
    double largest = 0;
    for (const double coordinate : expected)
        largest = std::fmax(largest, std::abs(coordinate));
    for (std::size_t i = 0; i < expected.size() / 3; ++i) {
        float x = 0, y = 0, z = 0;
        const auto index = static_cast<int>(i) * node.mesh->sampleStep;
        const bool has = mesh.getControlPoint(index, x, y, z);
        const Point local{static_cast<double>(x), static_cast<double>(y), static_cast<double>(z)};
        const Point placed = moved(node.world[0], moved(node.geometric, local));
        bool same = has;
        for (std::size_t axis = 0; axis < placed.size(); ++axis)
            same = same && closeTo(placed[axis], expected[3 * i + axis], kHandedOutTolerance, largest);
        findings.compare(same, [&] {
            return "\"" + node.name + "\" point " + std::to_string(index) + ": " + printed(placed.data(), 3) +
                   " instead of " + printed(&expected[3 * i], 3);
        });
    }
}

} // namespace

void checkLibraryMeshes(LoadedFile& file, Findings& findings) {
    if (!file.loaded())
        return;
    TnFbxReadInfo info;
    info.setTransformPoints(false);
    const auto list = read<TnFbxMesh>(file, info, &Fbx::getMeshes, findings);
    for (const Handed<TnFbxMesh>& handed : matched(file, list.span(), kMeshTypes, findings)) {
        const ReferenceNode& node = file.reference().nodes[handed.nodeIndex];
        if (!node.mesh)
            continue; // converted from a NURBS surface
        const ReferenceMesh& expected = *node.mesh;
        const TnFbxMesh& mesh = *handed.object;
        const MeshSums sums = sumsOf(mesh);
        findings.compare(mesh.getNumberOfControlPoints() == expected.points &&
                             mesh.getNumberOfPolygons() == expected.polygons &&
                             mesh.getNumberOfPolygonVertices() == expected.polygonVertices &&
                             sameCount(sums.sizes, expected.sizeSum) && sameCount(sums.indices, expected.indexSum),
                         [&] { return "\"" + node.name + "\" has other points or polygons"; });
        if (expected.skins + expected.blendShapes + expected.caches == 0)
            compareMeshPoints(node, mesh, findings);
    }
}

void checkLibraryLocalSamples(LoadedFile& file, Findings& findings) {
    if (!file.loaded())
        return;
    TnFbxReadInfo info;
    info.setGlobalTransform(false);
    const auto list = read<TnFbxTransform>(file, info, &Fbx::getTransforms, findings);
    for (const Handed<TnFbxTransform>& handed : matched(file, list.span(), kTransformTypes, findings)) {
        const ReferenceNode& node = file.reference().nodes[handed.nodeIndex];
        const bool moved = file.nodeOf(handed.nodeIndex)->conversionMoves;
        for (const TransformChannel& row : kTransformChannels) {
            const auto curve = node.curves.find(row.curve);
            if (curve == node.curves.end() || (moved && row.conversionChanges))
                continue;
            compareSamples(file.reference(), node, *handed.object, row, curve->second, findings);
        }
    }
}

} // namespace conformance
