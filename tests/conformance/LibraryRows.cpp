// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The same files through the facade: what a host gets. References have no more than the values at their frames, so
// that samples are compared at those of their frames that the library sampled.
#include "MeshPoints.h"
#include "Rows.h"
#include "Tolerances.h"

#include <Fbx.h>
#include <TnFbxError.h>

#include <algorithm>
#include <array>
#include <map>
#include <memory>
#include <span>

namespace conformance {
namespace {

using namespace Tarnell::Fbx;
using fbxsdk::FbxNodeAttribute;

/// An object of the library and the reference's node that it was read from.
template <class Object>
struct Handed {
    const Object* object;
    std::size_t nodeIndex;
};

template <class Object>
struct HandedList {
    std::unique_ptr<Object[]> objects;
    std::vector<Handed<Object>> matched;
};

template <class Object>
using Reader = bool (Fbx::*)(TnFbxReadInfo&, Object**, int&) const;

constexpr std::array kMeshTypes = {FbxNodeAttribute::eMesh};
constexpr std::array kTransformTypes = {FbxNodeAttribute::eUnknown, FbxNodeAttribute::eNull, FbxNodeAttribute::eMarker,
                                        FbxNodeAttribute::eMesh};

/// Of a node without an attribute: unknown.
FbxNodeAttribute::EType typeOf(const fbxsdk::FbxNode& node) {
    const FbxNodeAttribute* attribute = node.GetNodeAttribute();
    return attribute ? attribute->GetAttributeType() : FbxNodeAttribute::eUnknown;
}

/// Reads all objects of a kind. The library hands out parents before their children, which is the scene's order once
/// it has made meshes of NURBS and patches.
template <class Object>
HandedList<Object> read(LoadedFile& file, TnFbxReadInfo& info, Reader<Object> reader,
                        std::span<const FbxNodeAttribute::EType> types, Findings& findings) {
    info.setFileName(file.file().path.string());
    info.setAnimationStackName("any"); // only has to be there
    Object* objects = nullptr;
    int count = 0;
    const bool success = (Fbx().*reader)(info, &objects, count);
    HandedList<Object> result{std::unique_ptr<Object[]>(objects), {}};
    findings.compare(success, [] { return "not read: " + lastError(); });
    if (!success)
        return result;

    file.sdk().convertNurbsAndPatch(file.scene()->GetFbxManager(), file.scene());
    std::map<const SceneNode*, std::size_t> referenceIndex;
    for (std::size_t i = 0; i < file.reference().nodes.size(); ++i)
        referenceIndex[file.nodeOf(i)] = i;
    int next = 0;
    for (const SceneNode& entry : file.nodes()) {
        if (std::ranges::find(types, typeOf(*entry.node)) == types.end())
            continue;
        const Object* object = next < count ? &objects[next] : nullptr;
        ++next;
        findings.compare(object && object->getName() == entry.node->GetName(), [&] {
            return std::string("no object of \"") + entry.node->GetName() + "\" at " + std::to_string(next - 1);
        });
        const auto found = referenceIndex.find(&entry);
        if (object && found != referenceIndex.end())
            result.matched.push_back({object, found->second});
    }
    return result;
}

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

/// Whether the channel has a sample for that frame of the reference.
bool isSampled(const TnFbxTransform& transform, TnFbxTransform::EFbxTransformChannelType channel, double frame,
               double fps) {
    if (!transform.getTransformAnimated(channel))
        return false;
    const TnFbxTime time = transform.getTransformTime(channel);
    return static_cast<double>(time.getFrameRate()) == fps && frame == std::floor(frame) &&
           frame >= time.getStartFrame() && frame <= time.getEndFrame();
}

bool isConstant(const std::vector<double>& values) {
    return std::ranges::all_of(values, [&](double value) { return closeTo(value, values[0], kHandedOutTolerance); });
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

double multiplied(const Matrix12& m, const Point& point, std::size_t axis) {
    return m[axis] * point[0] + m[3 + axis] * point[1] + m[6 + axis] * point[2] + m[9 + axis];
}

Point multiplied(const Matrix12& m, const Point& point) {
    return {multiplied(m, point, 0), multiplied(m, point, 1), multiplied(m, point, 2)};
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
        const Point placed = multiplied(node.world[0], multiplied(node.geometric, local));
        bool same = has;
        for (std::size_t axis = 0; axis < placed.size(); ++axis) {
            same = same && closeTo(placed[axis], expected[3 * i + axis], kHandedOutTolerance, largest);
        }
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
    info.setGlobalTransform(false);
    info.setTransformPoints(false);
    const auto list = read<TnFbxMesh>(file, info, &Fbx::getMeshes, kMeshTypes, findings);
    for (const Handed<TnFbxMesh>& handed : list.matched) {
        const ReferenceNode& node = file.reference().nodes[handed.nodeIndex];
        if (!node.mesh)
            continue; // made of a NURBS surface
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
    const auto list = read<TnFbxTransform>(file, info, &Fbx::getTransforms, kTransformTypes, findings);
    for (const Handed<TnFbxTransform>& handed : list.matched) {
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

void checkLibraryPositions(LoadedFile& file, Findings& findings) {
    if (!file.loaded())
        return;
    const Reference& reference = file.reference();
    TnFbxReadInfo info;
    const auto list = read<TnFbxTransform>(file, info, &Fbx::getTransforms, kTransformTypes, findings);
    for (const Handed<TnFbxTransform>& handed : list.matched) {
        const ReferenceNode& node = reference.nodes[handed.nodeIndex];
        const Point origin{node.geometric[9], node.geometric[10], node.geometric[11]};
        for (std::size_t f = 0; f < node.world.size(); ++f) {
            if (!isSampled(*handed.object, TnFbxTransform::kFbxTransformPositionX, reference.frames[f],
                           reference.fps)) {
                continue;
            }
            const Point expected = multiplied(node.world[f], origin);
            Point actual{};
            bool same = true;
            for (std::size_t axis = 0; axis < actual.size(); ++axis) {
                const TransformChannel& row = kTransformChannels[axis];
                const auto frame = static_cast<float>(reference.frames[f]);
                actual[axis] = static_cast<double>(handed.object->getTransformValueAt(row.channel, frame));
                const double largest = std::max({std::abs(expected[0]), std::abs(expected[1]), std::abs(expected[2])});
                same = same && closeTo(actual[axis], expected[axis], kHandedOutTolerance, largest);
            }
            findings.compare(same, [&] {
                return "\"" + node.name + "\" at frame " + printed(reference.frames[f]) + ": " +
                       printed(actual.data(), 3) + " instead of " + printed(expected.data(), 3);
            });
        }
    }
}

} // namespace conformance
