// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Static values are compared at every frame of the references, samples wherever a frame is a whole one.
#include "FaithfulRows.h"

#include "FaithfulReference.h"
#include "Tolerances.h"
#include "Utf8.h"

#include <Fbx.h>
#include <TnFbxCamera.h>
#include <TnFbxError.h>
#include <TnFbxMesh.h>
#include <TnFbxReadInfo.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <map>
#include <memory>

namespace conformance {
namespace {

using namespace Tarnell::Fbx;
using fbxsdk::FbxAMatrix;
using fbxsdk::FbxVector4;

constexpr double kMillimetresPerInch = 25.4;
constexpr double kRadians = 3.14159265358979323846 / 180.0;

// ---- Reading ----

template <class Object>
using Reader = bool (Fbx::*)(TnFbxReadInfo&, Object**, int&) const;

template <class Object>
struct List {
    std::unique_ptr<Object[]> objects;
    int count = 0;
    std::map<std::size_t, Object*> ofNode; ///< by the index in the reference
};

/// Clips that last for days are read at fewer frames per second: their samples are not compared.
constexpr double kLongClip = 100'000;

double slownessOf(const Reference& reference) {
    double frames = 0;
    for (const double frame : reference.frames)
        frames = std::max(frames, std::abs(frame));
    return frames > kLongClip ? kLongClip : 1.0;
}

TnFbxReadInfo infoOf(const LoadedFile& file, double frame) {
    const double slowness = slownessOf(file.reference());
    TnFbxReadInfo info;
    info.setFileName(file.file().path.string());
    info.setFidelity(kFbxFidelityFaithful);
    info.setFrame(static_cast<float>(frame / slowness));
    if (slowness > 1.0) {
        info.setUseSampleFPS(true);
        info.setSampleFPS(static_cast<float>(file.reference().fps / slowness));
    }
    return info;
}

/// The kinds whose nodes are returned in a list, as the reference names them.
bool isMesh(const fbxsdk::FbxNode& node) {
    const fbxsdk::FbxNodeAttribute* attribute = node.GetNodeAttribute();
    return attribute && attribute->GetAttributeType() == fbxsdk::FbxNodeAttribute::eMesh;
}
bool isCamera(const fbxsdk::FbxNode& node) {
    const fbxsdk::FbxNodeAttribute* attribute = node.GetNodeAttribute();
    return attribute && (attribute->GetAttributeType() == fbxsdk::FbxNodeAttribute::eCamera ||
                         attribute->GetAttributeType() == fbxsdk::FbxNodeAttribute::eCameraStereo);
}
bool isLight(const fbxsdk::FbxNode& node) {
    const fbxsdk::FbxNodeAttribute* attribute = node.GetNodeAttribute();
    return attribute && attribute->GetAttributeType() == fbxsdk::FbxNodeAttribute::eLight;
}
bool isAny(const fbxsdk::FbxNode& /*node*/) { return true; }

/// Reads all objects of a kind. The library returns parents before their children, as the scene has them.
template <class Object>
List<Object> read(LoadedFile& file, TnFbxReadInfo info, Reader<Object> reader, bool (*isOfKind)(const fbxsdk::FbxNode&),
                  Findings& findings) {
    List<Object> list;
    if (!file.loaded())
        return list;
    Object* objects = nullptr;
    const bool success = (Fbx().*reader)(info, &objects, list.count);
    list.objects.reset(objects);
    findings.compare(success, [] { return "not read: " + lastError(); });
    if (!success)
        return list;
    file.sdk().convertNurbsAndPatch(file.scene()->GetFbxManager(), file.scene());
    std::map<const SceneNode*, std::size_t> referenceIndex;
    for (std::size_t i = 0; i < file.reference().nodes.size(); ++i)
        referenceIndex[file.nodeOf(i)] = i;
    int next = 0;
    for (const SceneNode& entry : file.nodes()) {
        if (!isOfKind(*entry.node))
            continue;
        Object* object = next < list.count ? &objects[next] : nullptr;
        ++next;
        findings.compare(object && object->getName() == entry.node->GetName(),
                         [&] { return std::string("no object of \"") + entry.node->GetName() + '"'; });
        const auto found = referenceIndex.find(&entry);
        if (object && found != referenceIndex.end())
            list.ofNode[found->second] = object;
    }
    findings.compare(next == list.count,
                     [&] { return std::to_string(list.count) + " objects instead of " + std::to_string(next); });
    return list;
}

// ---- Matrices ----

using ValueOf = std::function<double(TnFbxTransform::EFbxTransformChannelType)>;

FbxAMatrix turnAbout(int axis, double degrees) {
    FbxVector4 angles(0, 0, 0);
    angles[axis] = degrees;
    FbxAMatrix matrix;
    matrix.SetR(angles);
    return matrix;
}

/// As docs/faithful.md has it: T · R · H · S.
FbxAMatrix matrixOf(const TnFbxTransform& object, const ValueOf& value) {
    const auto three = [&](int first) {
        std::array<double, 3> values{};
        for (int i = 0; i < 3; ++i)
            values[static_cast<std::size_t>(i)] =
                value(static_cast<TnFbxTransform::EFbxTransformChannelType>(first + i));
        return values;
    };
    const auto position = three(TnFbxTransform::kFbxTransformPositionX);
    const auto angles = three(TnFbxTransform::kFbxTransformRotationX);
    const auto scale = three(TnFbxTransform::kFbxTransformScaleX);
    const auto skew = three(TnFbxTransform::kFbxTransformSkewX);
    constexpr std::array<std::array<int, 3>, 6> kOrders = {
        {{0, 1, 2}, {0, 2, 1}, {1, 0, 2}, {1, 2, 0}, {2, 0, 1}, {2, 1, 0}}};
    const auto& order = kOrders.at(static_cast<std::size_t>(object.getTransformRotationOrder()));
    const auto turn = [&](int i) {
        const int axis = order.at(static_cast<std::size_t>(i));
        return turnAbout(axis, angles.at(static_cast<std::size_t>(axis)));
    };
    const FbxAMatrix rotation = turn(2) * turn(1) * turn(0);
    FbxAMatrix shear;
    shear[1][0] = skew[0];
    shear[2][0] = skew[1];
    shear[2][1] = skew[2];
    FbxAMatrix matrix = rotation * shear;
    for (int axis = 0; axis < 3; ++axis) {
        for (int component = 0; component < 3; ++component)
            matrix[axis][component] *= scale[static_cast<std::size_t>(axis)];
        matrix[3][axis] = position[static_cast<std::size_t>(axis)];
    }
    return matrix;
}

FbxAMatrix staticMatrixOf(const TnFbxTransform& object) {
    return matrixOf(
        object, [&object](auto channel) { return static_cast<double>(object.getTransformValue(channel)); });
}

FbxAMatrix fromMatrix12(const Matrix12& numbers) {
    FbxAMatrix matrix;
    for (int row = 0; row < 4; ++row)
        for (int column = 0; column < 3; ++column)
            matrix[row][column] = numbers[static_cast<std::size_t>(3 * row + column)];
    return matrix;
}

/// The axes within the tolerance of the longest, the position of the larger of 1 and itself.
bool sameMatrix(const FbxAMatrix& actual, const FbxAMatrix& expected, double sizeOfScene) {
    double axes = 0, position = sizeOfScene;
    for (int row = 0; row < 4; ++row) {
        for (int column = 0; column < 3; ++column) {
            double& size = row < 3 ? axes : position;
            size = std::max(size, std::abs(expected.Get(row, column)));
        }
    }
    for (int row = 0; row < 4; ++row) {
        for (int column = 0; column < 3; ++column)
            if (!closeTo(actual.Get(row, column), expected.Get(row, column), kHandedOutTolerance,
                         row < 3 ? axes : position))
                return false;
    }
    return true;
}

std::string printedMatrix(const FbxAMatrix& matrix) {
    const Matrix12 numbers = asMatrix12(matrix);
    return printed(numbers.data(), numbers.size());
}

void compareMatrices(const ReferenceNode& node, double frame, const FbxAMatrix& actual, const FbxAMatrix& expected,
                     double sizeOfScene, Findings& findings) {
    findings.compare(
        sameMatrix(actual, expected, sizeOfScene),
        [&] {
            return "\"" + node.name + "\" at frame " + printed(frame) + ": " + printedMatrix(actual) + " instead of " +
                   printedMatrix(expected);
        });
}

double sizeOf(const FbxAMatrix& matrix) {
    return std::max({1.0, std::abs(matrix.Get(3, 0)), std::abs(matrix.Get(3, 1)), std::abs(matrix.Get(3, 2))});
}

// ---- Cameras ----

struct Gate {
    double width, height;
};

/// The part of the film that is in the picture.
Gate fitted(double width, double height, double aspect, int gateFit) {
    const double film = width / height;
    switch (gateFit) {
    case 1: // vertical
        return {height * aspect, height};
    case 2: // horizontal
        return {width, width / aspect};
    case 3: // fill
        return aspect > film ? Gate{width, width / aspect} : Gate{height * aspect, height};
    case 4: // overscan
        return aspect > film ? Gate{height * aspect, height} : Gate{width, width / aspect};
    default:
        return {width, height};
    }
}

double angleOf(double inches, double focalLength) {
    return 2.0 * std::atan(inches * kMillimetresPerInch / 2.0 / focalLength) / kRadians;
}

std::filesystem::path faithfulReferenceOf(const LoadedFile& file) {
    return file.file().reference->parent_path().parent_path() / "refs-faithful" / (file.file().name + ".json");
}

/// The nodes that both references have, by their index in the first.
std::map<std::size_t, const FaithfulNode*> matchNodes(const Reference& reference,
                                                      const std::vector<FaithfulNode>& faithful) {
    std::map<std::size_t, const FaithfulNode*> result;
    std::size_t next = 0;
    for (std::size_t i = 0; i < reference.nodes.size() && next < faithful.size(); ++i) {
        const ReferenceNode& node = reference.nodes[i];
        if ((node.mesh || node.kind == "camera") && node.name == faithful[next].name)
            result[i] = &faithful[next++];
    }
    return result;
}

// ---- Meshes ----

/// Calls `check(frameIndex, node, faithful, mesh)` for every mesh at every frame.
template <class Check>
void forEachMesh(LoadedFile& file, Findings& findings, const Check& check) {
    const std::vector<FaithfulNode> faithful = readFaithfulReference(faithfulReferenceOf(file));
    const auto nodes = matchNodes(file.reference(), faithful);
    for (std::size_t f = 0; f < file.reference().frames.size(); ++f) {
        if (!file.compares(f))
            continue;
        const auto list =
            read<TnFbxMesh>(file, infoOf(file, file.reference().frames[f]), &Fbx::getMeshes, isMesh, findings);
        for (const auto& [index, mesh] : list.ofNode) {
            const auto found = nodes.find(index);
            if (found != nodes.end() && f < found->second->points.size())
                check(f, file.reference().nodes[index], *found->second, *mesh, file.nodeOf(index)->node->GetMesh());
        }
    }
}

double largestOf(const std::vector<double>& numbers) {
    double largest = 1.0;
    for (const double number : numbers)
        largest = std::isfinite(number) ? std::max(largest, std::abs(number)) : largest;
    return largest;
}

/// Our index of a corner of the file: the polygons of mirrored meshes are reversed.
std::vector<int> placesOfCorners(fbxsdk::FbxMesh& source, const TnFbxMesh& mesh) {
    std::vector<int> places(static_cast<std::size_t>(std::max(source.GetPolygonVertexCount(), 0)), -1);
    int ours = 0;
    for (int polygon = 0; polygon < source.GetPolygonCount(); ++polygon) {
        const int size = source.GetPolygonSize(polygon);
        const int start = source.GetPolygonVertexIndex(polygon);
        bool straight = true;
        for (int i = 0; i < size; ++i)
            straight = straight && mesh.getPointIndex(ours + i) == source.GetPolygonVertex(polygon, i);
        for (int i = 0; i < size; ++i)
            places[static_cast<std::size_t>(start + i)] = ours + (straight || i == 0 ? i : size - i);
        ours += size;
    }
    return places;
}

} // namespace

void checkFaithfulLoads(LoadedFile& file, Findings& findings) {
    TnFbxReadInfo info = infoOf(file, 0);
    TnFbxCamera* cameras = nullptr;
    int count = 0;
    const bool loads = Fbx().getCameras(info, &cameras, count);
    const std::unique_ptr<TnFbxCamera[]> owner(cameras);
    findings.compare(loads == file.reference().loads,
                     [&] { return loads ? std::string("loads") : "does not load: " + lastError(); });
}

void checkFaithfulTransforms(LoadedFile& file, Findings& findings) {
    const Reference& reference = file.reference();
    for (std::size_t f = 0; f < reference.frames.size(); ++f) {
        if (!file.compares(f))
            continue;
        const auto list =
            read<TnFbxTransform>(file, infoOf(file, reference.frames[f]), &Fbx::getTransforms, isAny, findings);
        for (const auto& [index, object] : list.ofNode) {
            const ReferenceNode& node = reference.nodes[index];
            compareMatrices(node, reference.frames[f], staticMatrixOf(*object), fromMatrix12(node.world[f]), 1.0,
                            findings);
        }
    }
}

/// The global transform of a parent and the local one of its child give the child's global transform.
void checkFaithfulLocals(LoadedFile& file, Findings& findings) {
    const Reference& reference = file.reference();
    for (std::size_t f = 0; f < reference.frames.size(); ++f) {
        if (!file.compares(f))
            continue;
        TnFbxReadInfo info = infoOf(file, reference.frames[f]);
        info.setGlobalTransform(false);
        const auto list = read<TnFbxTransform>(file, info, &Fbx::getTransforms, isAny, findings);
        for (const auto& [index, object] : list.ofNode) {
            const ReferenceNode& node = reference.nodes[index];
            const FbxAMatrix parent =
                node.parent < 0 ? FbxAMatrix()
                                : fromMatrix12(reference.nodes[static_cast<std::size_t>(node.parent)].world[f]);
            compareMatrices(node, reference.frames[f], parent * staticMatrixOf(*object), fromMatrix12(node.world[f]),
                            sizeOf(parent), findings);
        }
    }
}

void checkFaithfulSamples(LoadedFile& file, Findings& findings) {
    const Reference& reference = file.reference();
    if (slownessOf(reference) > 1.0)
        return;
    const auto list = read<TnFbxTransform>(file, infoOf(file, 0), &Fbx::getTransforms, isAny, findings);
    for (const auto& [index, object] : list.ofNode) {
        const ReferenceNode& node = reference.nodes[index];
        const TnFbxTransform& transform = *object;
        for (std::size_t f = 0; f < reference.frames.size(); ++f) {
            if (!file.compares(f))
                continue;
            const double frame = reference.frames[f];
            bool inRange = frame == std::floor(frame);
            for (int i = 0; i <= TnFbxTransform::kFbxTransformSkewZ; ++i) {
                const auto channel = static_cast<TnFbxTransform::EFbxTransformChannelType>(i);
                const TnFbxTime time = transform.getTransformTime(channel);
                inRange = inRange && (!transform.getTransformAnimated(channel) ||
                                      (frame >= time.getStartFrame() && frame <= time.getEndFrame()));
            }
            if (!inRange)
                continue;
            const FbxAMatrix actual = matrixOf(transform, [&](auto channel) {
                return static_cast<double>(transform.getTransformValueAt(channel, static_cast<float>(frame)));
            });
            compareMatrices(node, frame, actual, fromMatrix12(node.world[f]), 1.0, findings);
        }
    }
}

/// Where only the curves move a node, its local channels are those curves, including full turns.
void checkFaithfulCurves(LoadedFile& file, Findings& findings) {
    const Reference& reference = file.reference();
    if (!reference.stacks.empty() && reference.stacks[0].layers > 1)
        return; // layers do more than add up
    constexpr std::array<const char*, 9> kCurves = {"Lcl Translation X", "Lcl Translation Y", "Lcl Translation Z",
                                                    "Lcl Rotation X",    "Lcl Rotation Y",    "Lcl Rotation Z",
                                                    "Lcl Scaling X",     "Lcl Scaling Y",     "Lcl Scaling Z"};
    for (std::size_t f = 0; f < reference.frames.size(); ++f) {
        if (!file.compares(f))
            continue;
        TnFbxReadInfo info = infoOf(file, reference.frames[f]);
        info.setGlobalTransform(false);
        const auto list = read<TnFbxTransform>(file, info, &Fbx::getTransforms, isAny, findings);
        for (const auto& [index, object] : list.ofNode) {
            const SceneNode& entry = *file.nodeOf(index);
            const fbxsdk::FbxNode& node = *entry.node;
            constexpr auto kSource = fbxsdk::FbxNode::eSourcePivot;
            bool plain = !entry.conversionMoves && reference.nodes[index].inherit == 0;
            for (const FbxVector4& offset :
                 {node.GetPreRotation(kSource), node.GetPostRotation(kSource), node.GetRotationOffset(kSource),
                  node.GetRotationPivot(kSource), node.GetScalingOffset(kSource), node.GetScalingPivot(kSource)})
                plain = plain && offset[0] == 0.0 && offset[1] == 0.0 && offset[2] == 0.0;
            for (std::size_t i = 0; plain && i < kCurves.size(); ++i) {
                const auto curve = reference.nodes[index].curves.find(kCurves[i]);
                if (curve == reference.nodes[index].curves.end())
                    continue;
                const auto actual = static_cast<double>(
                    object->getTransformValue(static_cast<TnFbxTransform::EFbxTransformChannelType>(i)));
                findings.compare(closeTo(actual, curve->second[f], kHandedOutTolerance), [&, node = index] {
                    return "\"" + reference.nodes[node].name + "\" " + kCurves[i] + " at frame " +
                           printed(reference.frames[f]) + ": " + printed(actual) + " instead of " +
                           printed(curve->second[f]);
                });
            }
        }
    }
}

/// Cameras look along X with Y up in files, and along −Z for hosts.
void checkFaithfulCameras(LoadedFile& file, Findings& findings) {
    const Reference& reference = file.reference();
    const FbxAMatrix turn = turnAbout(1, -90.0);
    for (std::size_t f = 0; f < reference.frames.size(); ++f) {
        if (!file.compares(f))
            continue;
        const auto list =
            read<TnFbxCamera>(file, infoOf(file, reference.frames[f]), &Fbx::getCameras, isCamera, findings);
        for (const auto& [index, camera] : list.ofNode) {
            if (file.nodeOf(index)->node->GetTarget())
                continue; // matrices of references do not follow targets
            const ReferenceNode& node = reference.nodes[index];
            compareMatrices(node, reference.frames[f], staticMatrixOf(*camera), fromMatrix12(node.world[f]) * turn, 1.0,
                            findings);
        }
    }
}

/// Lights shine along −Y in files, and along −Z for hosts.
void checkFaithfulLights(LoadedFile& file, Findings& findings) {
    const Reference& reference = file.reference();
    const FbxAMatrix turn = turnAbout(0, -90.0);
    for (std::size_t f = 0; f < reference.frames.size(); ++f) {
        if (!file.compares(f))
            continue;
        const auto list = read<TnFbxLight>(file, infoOf(file, reference.frames[f]), &Fbx::getLights, isLight, findings);
        for (const auto& [index, light] : list.ofNode) {
            const ReferenceNode& node = reference.nodes[index];
            compareMatrices(node, reference.frames[f], staticMatrixOf(*light), fromMatrix12(node.world[f]) * turn, 1.0,
                            findings);
        }
    }
}

/// References state angles and film as a picture of the file's size shows them.
void checkFaithfulLenses(LoadedFile& file, Findings& findings) {
    const Reference& reference = file.reference();
    const std::vector<FaithfulNode> faithful = readFaithfulReference(faithfulReferenceOf(file));
    const auto nodes = matchNodes(reference, faithful);
    for (std::size_t f = 0; f < reference.frames.size(); ++f) {
        if (!file.compares(f))
            continue;
        const auto list =
            read<TnFbxCamera>(file, infoOf(file, reference.frames[f]), &Fbx::getCameras, isCamera, findings);
        for (const auto& [index, camera] : list.ofNode) {
            const auto found = nodes.find(index);
            if (found == nodes.end() || !found->second->perspective || f >= found->second->focalLength.size())
                continue;
            const FaithfulNode& expected = *found->second;
            const auto value = [&read = *camera](auto channel) { return static_cast<double>(read.getValue(channel)); };
            const double focalLength = value(TnFbxCamera::kFbxCameraFocalLength);
            const double width = value(TnFbxCamera::kFbxCameraApertureWidth);
            const double height = value(TnFbxCamera::kFbxCameraApertureHeight);
            const Gate gate =
                fitted(width, height, expected.apertureWidth[f] / expected.apertureHeight[f], expected.gateFit);
            const std::array<std::array<double, 2>, 7> pairs = {
                {{focalLength, expected.focalLength[f]},
                 {gate.width, expected.apertureWidth[f]},
                 {gate.height, expected.apertureHeight[f]},
                 {angleOf(gate.width, focalLength), expected.fovX[f]},
                 {angleOf(gate.height, focalLength), expected.fovY[f]},
                 {value(TnFbxCamera::kFbxCameraFieldOfViewX), angleOf(width, focalLength)},
                 {value(TnFbxCamera::kFbxCameraFieldOfViewY), angleOf(height, focalLength)}}};
            for (const auto& [actual, wanted] : pairs) {
                findings.compare(
                    closeTo(actual, wanted, kHandedOutTolerance),
                    [&, a = actual, w = wanted] {
                        return "\"" + expected.name + "\" at frame " + printed(reference.frames[f]) + ": " +
                               printed(a) + " instead of " + printed(w);
                    });
            }
        }
    }
}

void checkFaithfulPoints(LoadedFile& file, Findings& findings) {
    forEachMesh(
        file, findings,
        [&](std::size_t f, const ReferenceNode& node, const FaithfulNode& expected, const TnFbxMesh& mesh,
            fbxsdk::FbxMesh* /*source*/) {
            const std::vector<double>& points = expected.points[f];
            const double largest = largestOf(points);
            for (std::size_t i = 0; i < points.size() / 3; ++i) {
                std::array<float, 3> point{};
                const int index = static_cast<int>(i) * expected.pointStep;
                bool same = mesh.getControlPoint(index, point[0], point[1], point[2]);
                for (std::size_t axis = 0; axis < 3; ++axis)
                    same = same && closeTo(static_cast<double>(point[axis]), points[3 * i + axis], kHandedOutTolerance,
                                           largest);
                findings.compare(
                    same,
                    [&] {
                        const std::array<double, 3> actual = {static_cast<double>(point[0]),
                                                              static_cast<double>(point[1]),
                                                              static_cast<double>(point[2])};
                        return "\"" + node.name + "\" at frame " + printed(file.reference().frames[f]) + " point " +
                               std::to_string(index) + ": " + printed(actual.data(), 3) + " instead of " +
                               printed(&points[3 * i], 3);
                    });
            }
        });
}

void checkFaithfulNormals(LoadedFile& file, Findings& findings) {
    forEachMesh(
        file, findings,
        [&](std::size_t f, const ReferenceNode& node, const FaithfulNode& expected, const TnFbxMesh& mesh,
            fbxsdk::FbxMesh* source) {
            if (f >= expected.normals.size() || source == nullptr)
                return;
            const std::vector<int> places = placesOfCorners(*source, mesh);
            const std::vector<double>& normals = expected.normals[f];
            for (std::size_t i = 0; i < normals.size() / 3; ++i) {
                std::array<float, 3> normal{};
                const std::size_t corner = i * static_cast<std::size_t>(expected.normalStep);
                bool same = corner < places.size() && mesh.getValidNormals() &&
                            mesh.getNormal(places[corner], normal[0], normal[1], normal[2]);
                for (std::size_t axis = 0; axis < 3; ++axis)
                    same = same && closeTo(static_cast<double>(normal[axis]), normals[3 * i + axis], 1e-4);
                findings.compare(
                    same,
                    [&] {
                        const std::array<double, 3> actual = {static_cast<double>(normal[0]),
                                                              static_cast<double>(normal[1]),
                                                              static_cast<double>(normal[2])};
                        return "\"" + node.name + "\" at frame " + printed(file.reference().frames[f]) + " corner " +
                               std::to_string(corner) + ": " + printed(actual.data(), 3) + " instead of " +
                               printed(&normals[3 * i], 3);
                    });
            }
        });
}

void checkFaithfulWavefront(LoadedFile& file, Findings& findings) {
    for (const WavefrontSibling& sibling : file.file().wavefront) {
        const double frame = secondsOf(sibling, file.reference()) * file.reference().fps;
        if (!file.comparesFrame(frame))
            continue;
        const auto list = read<TnFbxMesh>(file, infoOf(file, frame), &Fbx::getMeshes, isMesh, findings);
        const PointSource pointsOf = [&](std::size_t nodeIndex) {
            std::vector<Point> points;
            const auto found = list.ofNode.find(nodeIndex);
            for (int i = 0; found != list.ofNode.end() && i < found->second->getNumberOfControlPoints(); ++i) {
                float x = 0, y = 0, z = 0;
                found->second->getControlPoint(i, x, y, z);
                points.push_back({static_cast<double>(x), static_cast<double>(y), static_cast<double>(z)});
            }
            return points;
        };
        compareWithWavefront(file, sibling, pointsOf, findings);
    }
}

std::span<const Row> faithfulRows() {
    static constexpr Row kRows[] = {
        {"loads", "the file loads, or is refused", checkFaithfulLoads},
        {"worldMatrices", "transforms of all nodes in the world at all frames", checkFaithfulTransforms},
        {"worldSamples", "their samples", checkFaithfulSamples},
        {"localMatrices", "transforms of all nodes as seen from their parents", checkFaithfulLocals},
        {"curves", "local channels of nodes that nothing but curves moves", checkFaithfulCurves},
        {"cameras", "where cameras are and look", checkFaithfulCameras},
        {"lights", "where lights are and shine", checkFaithfulLights},
        {"lenses", "focal length, film and angles of cameras", checkFaithfulLenses},
        {"points", "points of all meshes in the world, deformed", checkFaithfulPoints},
        {"normals", "normals of all meshes in the world", checkFaithfulNormals},
        {"wavefront", "points of all meshes against Wavefront files", checkFaithfulWavefront},
    };
    return kRows;
}

bool survivesConversion(const Row& row) { return row.check != checkFaithfulLocals && row.check != checkFaithfulCurves; }

bool deforms(const CorpusFile& file) {
    const std::vector<FaithfulNode> nodes =
        readFaithfulReference(file.reference->parent_path().parent_path() / "refs-faithful" / (file.name + ".json"));
    return std::any_of(nodes.begin(), nodes.end(), [](const FaithfulNode& node) { return node.deformed; });
}

bool isLongClip(const Reference& reference) { return slownessOf(reference) > 1.0; }

} // namespace conformance
