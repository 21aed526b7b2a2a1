// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What the facade returns by default: global transforms, and meshes whose points are in the world.
#include "KeptPoints.h"
#include "LibraryObjects.h"
#include "Tolerances.h"

#include <array>

namespace conformance {
namespace {

using namespace Tarnell::Fbx;
using fbxsdk::FbxNodeAttribute;

constexpr std::array kMeshTypes = {FbxNodeAttribute::eMesh};
constexpr std::array kTransformTypes = {FbxNodeAttribute::eUnknown, FbxNodeAttribute::eNull, FbxNodeAttribute::eMarker,
                                        FbxNodeAttribute::eMesh};

const Matrix12 kNoTurn = scaled({1, 1, 1});

/// A run of coordinates as references have it.
Point pointAt(const std::vector<double>& coordinates, std::size_t i) {
    return {coordinates[3 * i], coordinates[3 * i + 1], coordinates[3 * i + 2]};
}

/// A mesh of the reference at one of its frames.
struct MeshMoment {
    LoadedFile& file;
    std::size_t nodeIndex, frameIndex;

    [[nodiscard]] const ReferenceNode& node() const { return file.reference().nodes[nodeIndex]; }
    [[nodiscard]] double frame() const { return file.reference().frames[frameIndex]; }
    [[nodiscard]] fbxsdk::FbxMesh& mesh() const { return *file.nodeOf(nodeIndex)->node->GetMesh(); }
};

/// Every `sampleStep`-th point as it should be returned. Kept: the points are transformed by the position, rotation and
/// scale that the host reads; also points of a skin, which are in the world before.
std::vector<Point> bakedPoints(const MeshMoment& moment, const Matrix12& bake) {
    std::vector<Point> result;
    const ReferenceMesh& mesh = *moment.node().mesh;
    const std::vector<double>& world = mesh.worldPoints[moment.frameIndex];
    const auto toMesh = inverse(contentInWorld(moment.node(), moment.frameIndex, kNoTurn));
    const std::set<int> skinned = mesh.caches == 0 ? skinnedPoints(moment.mesh()) : std::set<int>();
    for (std::size_t i = 0; i < world.size() / 3; ++i) {
        const Point point = pointAt(world, i);
        if (skinned.contains(static_cast<int>(i) * mesh.sampleStep))
            result.push_back(moved(bake, point));
        else
            result.push_back(toMesh ? moved(bake, moved(*toMesh, point)) : point);
    }
    return result;
}

/// The same for blend shapes, which the library weights in its own way.
std::vector<Point> bakedBlend(const MeshMoment& moment, const Matrix12& bake) {
    std::vector<Point> result;
    const fbxsdk::FbxTime time = timeOfSeconds(moment.file.reference().seconds(moment.frameIndex));
    for (const Point& point : blendedPoints(moment.mesh(), moment.file.firstStack(), time))
        result.push_back(moved(bake, point));
    return result;
}

void comparePoints(const MeshMoment& moment, const TnFbxMesh& mesh, const std::vector<Point>& expected, int step,
                   Findings& findings) {
    double largest = 0;
    for (const Point& point : expected)
        largest = std::max({largest, std::abs(point[0]), std::abs(point[1]), std::abs(point[2])});
    for (std::size_t i = 0; i < expected.size(); ++i) {
        float x = 0, y = 0, z = 0;
        const int index = static_cast<int>(i) * step;
        bool same = mesh.getControlPoint(index, x, y, z);
        const Point actual{static_cast<double>(x), static_cast<double>(y), static_cast<double>(z)};
        for (std::size_t axis = 0; axis < actual.size(); ++axis)
            same = same && closeTo(actual[axis], expected[i][axis], kHandedOutTolerance, largest);
        findings.compare(same, [&] {
            return "\"" + moment.node().name + "\" point " + std::to_string(index) + " at frame " +
                   printed(moment.frame()) + ": " + printed(actual.data(), 3) + " instead of " +
                   printed(expected[i].data(), 3);
        });
    }
}

void compareBaked(const MeshMoment& moment, const TnFbxMesh& mesh, Findings& findings) {
    const Placement placement = placementAt(mesh, moment.frame());
    const Matrix12 bake = handedOut(contentInWorld(moment.node(), moment.frameIndex, kNoTurn), atOrigin(placement));
    const ReferenceMesh& reference = *moment.node().mesh;
    if (reference.blendShapes == 0)
        comparePoints(moment, mesh, bakedPoints(moment, bake), reference.sampleStep, findings);
    else if (reference.skins + reference.caches == 0)
        comparePoints(moment, mesh, bakedBlend(moment, bake), 1, findings);
}

std::string text(const CornerContent& content) {
    return std::string(content.normals ? "" : "no ") + "normals, " + (content.uvs ? "" : "no ") +
           "texture coordinates, " + (content.colours ? "" : "no ") + "colours";
}

void compareContent(const MeshMoment& moment, const TnFbxMesh& mesh, Findings& findings) {
    const ReferenceMesh& reference = *moment.node().mesh;
    const CornerContent actual{mesh.getValidNormals(), mesh.getValidUVs(), mesh.getValidColours()};
    const CornerContent expected = readContent(moment.mesh(), {reference.normals, reference.uvs, reference.colours});
    findings.compare(actual == expected, [&] {
        return "\"" + moment.node().name + "\" has " + text(actual) + " instead of " + text(expected);
    });
}

void compareMeshes(LoadedFile& file, std::size_t frameIndex, Findings& findings) {
    const Reference& reference = file.reference();
    TnFbxReadInfo info;
    info.setFrame(static_cast<float>(reference.frames[frameIndex]));
    const auto list = read<TnFbxMesh>(file, info, &Fbx::getMeshes, findings);
    for (const Handed<TnFbxMesh>& handed : matched(file, list.span(), kMeshTypes, findings)) {
        if (!reference.nodes[handed.nodeIndex].mesh)
            continue; // converted from a NURBS surface
        const MeshMoment moment{file, handed.nodeIndex, frameIndex};
        if (frameIndex == 0)
            compareContent(moment, *handed.object, findings);
        if (isSampled(*handed.object, TnFbxTransform::kFbxTransformPositionX, moment.frame(), reference.fps))
            compareBaked(moment, *handed.object, findings);
    }
}

} // namespace

void checkLibraryWorldTransforms(LoadedFile& file, Findings& findings) {
    if (!file.loaded())
        return;
    TnFbxReadInfo info;
    const auto list = read<TnFbxTransform>(file, info, &Fbx::getTransforms, findings);
    for (const Handed<TnFbxTransform>& handed : matched(file, list.span(), kTransformTypes, findings))
        compareInWorld(file.reference(), file.reference().nodes[handed.nodeIndex], *handed.object, kNoTurn, findings);
}

void checkLibraryBakedMeshes(LoadedFile& file, Findings& findings) {
    if (!file.loaded() || !hasKind(file.reference(), "mesh"))
        return;
    for (std::size_t f = 0; f < file.reference().frames.size(); ++f)
        compareMeshes(file, f, findings);
}

} // namespace conformance
