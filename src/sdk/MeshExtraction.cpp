// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A mesh at one frame: layout, points, and the values of its layers at every corner of its polygons.
#include "FbxSdk.h"

#include "TnFbxLimits.h"

#include "LayerReading.h"
#include "PropertySampling.h"
#include "ReadScope.h"
#include "access/CornerWarnings.h"
#include "access/ItemReader.h"
#include "calls/LastError.h"
#include "calls/MemoryLimit.h"

#include "model/MeshArrays.h"
#include "model/MeshInstances.h"

#include <algorithm>
#include <array>
#include <limits>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace Tarnell::Fbx {

using detail::channelAfter;
using detail::Corner;
using detail::fail;
using detail::MeshArrays;
using detail::succeed;
using detail::toFloat;

namespace {

/// The transform of points and normals.
struct BakeMatrices {
    fbxsdk::FbxAMatrix points;
    fbxsdk::FbxAMatrix normals; // the rotation only
};

fbxsdk::FbxVector4 vectorAt(const TnFbxTransform& transform, TnFbxTransform::EFbxTransformChannelType firstChannel,
                            bool animated, float frame) {
    std::array<double, 3> value{};
    for (int i = 0; i < 3; ++i) {
        const auto channel = channelAfter(firstChannel, i);
        value[static_cast<std::size_t>(i)] = static_cast<double>(
            animated ? transform.getTransformValueAt(channel, frame) : transform.getTransformValue(channel));
    }
    return {value[0], value[1], value[2]};
}

/// kept: points read in the world leave the geometric transform out, which is in the world transform already
BakeMatrices bakeMatrices(const TnFbxTransform& transform, bool atFrame, float frame, bool global,
                          const fbxsdk::FbxAMatrix& geometric) {
    BakeMatrices bake;
    bake.points.SetTRS(vectorAt(transform, TnFbxTransform::kFbxTransformPositionX, atFrame, frame),
                       vectorAt(transform, TnFbxTransform::kFbxTransformRotationX, atFrame, frame),
                       vectorAt(transform, TnFbxTransform::kFbxTransformScaleX, atFrame, frame));
    if (!global)
        bake.points = bake.points * geometric;
    bake.normals.SetTRS(fbxsdk::FbxVector4(0.0, 0.0, 0.0, 1.0), bake.points.GetR(),
                        fbxsdk::FbxVector4(1.0, 1.0, 1.0, 1.0));
    return bake;
}

std::int64_t polygonVertexCount(const fbxsdk::FbxMesh& source) {
    std::int64_t count = 0;
    for (int polygon = 0; polygon < source.GetPolygonCount(); ++polygon)
        count += source.GetPolygonSize(polygon);
    return count;
}

/// Appends the polygons' sizes; returns whether their vertices follow one another in the array, from its beginning on.
bool fillSizes(const fbxsdk::FbxMesh& source, std::vector<int>& sizes) {
    const int polygonCount = source.GetPolygonCount();
    bool areContiguous = true;
    int end = 0;
    for (int polygon = 0; polygon < polygonCount; ++polygon) {
        const int size = source.GetPolygonSize(polygon);
        areContiguous = areContiguous && source.GetPolygonVertexIndex(polygon) == end;
        end += size;
        sizes.push_back(size);
    }
    return areContiguous && end <= source.GetPolygonVertexCount();
}

void fillLayout(const fbxsdk::FbxMesh& source, int cornerCount, MeshArrays& arrays) {
    const int* vertices = source.GetPolygonVertices();
    const bool areContiguous = fillSizes(source, arrays.polygonVertexSizes());
    if (vertices != nullptr && areContiguous) {
        arrays.addPointIndices(vertices, static_cast<std::size_t>(cornerCount));
        return;
    }
    const int polygonCount = source.GetPolygonCount();
    for (int polygon = 0; polygon < polygonCount; ++polygon) {
        const int size = source.GetPolygonSize(polygon);
        const int start = source.GetPolygonVertexIndex(polygon);
        for (int i = 0; i < size; ++i)
            arrays.addPointIndex(vertices != nullptr && start >= 0 ? vertices[start + i] : -1);
    }
}

/// Calls `visit(corner)` for every vertex of every polygon, in order. The layout must be filled.
template <class Visit>
void forEachCorner(const MeshArrays& arrays, int polygonCount, Visit&& visit) {
    const int* const sizes = arrays.addedPolygonVertexSizes();
    const int* const pointIndices = arrays.addedPointIndices();
    int polygonVertex = 0;
    for (int polygon = 0; polygon < polygonCount; ++polygon)
        for (const int end = polygonVertex + sizes[polygon]; polygonVertex < end; ++polygonVertex)
            visit(Corner{polygon, polygonVertex, pointIndices[polygonVertex]});
}

/// Values on their way to a mesh: as many as stay in the processor's nearest memory.
constexpr int kBlockSize = 256;

/// Passes on what `convert` makes of each corner's value, or of `missing`, in blocks; returns whether any corner has a
/// value.
template <class Element, class Value, class Convert, class HandOn>
[[gnu::noinline]] bool convertCorners(const detail::CornerValues<Value>& stored, const Value& missing, int cornerCount,
                                      int polygonCount, MeshArrays& arrays, const Convert& convert,
                                      const HandOn& handOn) {
    std::array<Element, kBlockSize> elements;
    const auto put = [&](int i, const Value& value) { elements[static_cast<std::size_t>(i)] = convert(value); };
    if (stored.areInOrder(cornerCount)) { // the case of most normals
        for (int first = 0; first < cornerCount; first += kBlockSize) {
            const int count = std::min(kBlockSize, cornerCount - first);
            stored.forEach(first, count, put);
            handOn(elements.data(), static_cast<std::size_t>(count));
        }
        return cornerCount > 0;
    }
    bool found = false;
    if (stored.areIndexed(cornerCount)) { // of most texture coordinates
        for (int first = 0; first < cornerCount; first += kBlockSize) {
            const int count = std::min(kBlockSize, cornerCount - first);
            stored.forEachIndexed(first, count, [&](int i, const Value* value) {
                found = found || value != nullptr;
                put(i, value != nullptr ? *value : missing);
            });
            handOn(elements.data(), static_cast<std::size_t>(count));
        }
        return found;
    }
    int count = 0;
    forEachCorner(arrays, polygonCount, [&](const Corner& corner) {
        Value value = missing;
        found = stored.read(corner, value) || found;
        put(count, value);
        if (++count == kBlockSize) {
            handOn(elements.data(), static_cast<std::size_t>(count));
            count = 0;
        }
    });
    handOn(elements.data(), static_cast<std::size_t>(count));
    return found;
}

constexpr auto narrow = [](const fbxsdk::FbxVector4& vector) {
    return MeshArrays::Vector{toFloat(vector[0]), toFloat(vector[1]), toFloat(vector[2])};
};

/// The normals of a layer; returns whether it has any.
bool fillNormals(const fbxsdk::FbxMesh& source, const detail::CornerValues<fbxsdk::FbxVector4>& stored,
                 const fbxsdk::FbxAMatrix* bake, int cornerCount, MeshArrays& arrays) {
    const fbxsdk::FbxVector4 missing(static_cast<double>(TnFbxMesh::kDefaultMeshNX),
                                     static_cast<double>(TnFbxMesh::kDefaultMeshNY),
                                     static_cast<double>(TnFbxMesh::kDefaultMeshNZ));
    const auto handOn = [&arrays](const MeshArrays::Vector* normals, std::size_t count) {
        arrays.addNormals(normals, count);
    };
    if (bake != nullptr) {
        const auto baked = [bake](const fbxsdk::FbxVector4& normal) { return narrow(bake->MultT(normal)); };
        return convertCorners<MeshArrays::Vector>(stored, missing, cornerCount, source.GetPolygonCount(), arrays, baked,
                                                  handOn);
    }
    return convertCorners<MeshArrays::Vector>(stored, missing, cornerCount, source.GetPolygonCount(), arrays, narrow,
                                              handOn);
}

/// The texture coordinates of a layer; returns whether it has any.
bool fillUVs(const fbxsdk::FbxMesh& source, fbxsdk::FbxLayer& layer, int cornerCount, MeshArrays& arrays) {
    using Coordinate = MeshArrays::TextureCoordinate;
    const fbxsdk::FbxVector2 missing(static_cast<double>(TnFbxMesh::kDefaultMeshU),
                                     static_cast<double>(TnFbxMesh::kDefaultMeshV));
    return convertCorners<Coordinate>(
        detail::layerUVs(layer), missing, cornerCount, source.GetPolygonCount(), arrays,
        [](const fbxsdk::FbxVector2& uv) {
            return Coordinate{toFloat(uv[0]), toFloat(uv[1])};
        },
        [&arrays](const Coordinate* uvs, std::size_t count) { arrays.addUVs(uvs, count); });
}

constexpr detail::Colour kDefaultColour = {TnFbxMesh::kDefaultMeshRed, TnFbxMesh::kDefaultMeshGreen,
                                           TnFbxMesh::kDefaultMeshBlue, TnFbxMesh::kDefaultMeshAlpha};

/// The colours of all layers; returns whether any has some.
///
/// kept: every layer overwrites the ones before it, so the last layer wins, also where it has no colour.
bool fillColours(fbxsdk::FbxMesh& source, MeshArrays& arrays) {
    const auto materials = detail::materialColours(source, kDefaultColour);
    bool found = false;
    for (int i = 0; i < source.GetLayerCount(); ++i) {
        fbxsdk::FbxLayer* layer = source.GetLayer(i);
        if (layer == nullptr)
            continue;
        const detail::LayerColours colours(*layer, materials);
        if (!found && !colours.hasAny())
            continue; // the defaults are sufficient
        auto* const target = arrays.colours();
        forEachCorner(arrays, source.GetPolygonCount(), [&](const Corner& corner) {
            const std::optional<detail::Colour> stored = colours.at(corner);
            found = found || stored.has_value();
            const detail::Colour colour = stored.value_or(kDefaultColour);
            target[corner.polygonVertex] = {colour.red, colour.green, colour.blue, colour.alpha};
        });
    }
    return found;
}

/// The values of all layers, in the layout that is filled, too, unless it is that of another node's mesh.
void fillCorners(fbxsdk::FbxMesh& source, const fbxsdk::FbxAMatrix* bake, int cornerCount, bool isAlike,
                 MeshArrays& arrays, TnFbxMesh& mesh) {
    if (!isAlike)
        fillLayout(source, cornerCount, arrays);
    bool normals = false, uvs = isAlike && mesh.getValidUVs();
    if (fbxsdk::FbxLayer* first = source.GetLayer(0)) {
        const detail::CornerValues<fbxsdk::FbxVector4> stored =
            detail::layerNormals(*first); // throws where it has no array
        // The largest array, which takes the least memory as the first one. But where another thread inflates it, it is
        // ready last.
        const bool normalsFirst = maximumThreads() == 1;
        if (normalsFirst)
            normals = fillNormals(source, stored, bake, cornerCount, arrays);
        uvs = isAlike ? uvs : fillUVs(source, *first, cornerCount, arrays);
        if (!normalsFirst)
            normals = fillNormals(source, stored, bake, cornerCount, arrays);
    }
    const bool colours = fillColours(source, arrays);
    // At the end: if a damaged layer leaves the mesh partly filled, nothing is valid.
    mesh.setValidNormals(normals);
    mesh.setValidUVs(uvs);
    mesh.setValidColours(colours);
}

} // namespace

bool FbxSdk::getMesh(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                     bool transformPoints, TnFbxMesh& mesh, fbxsdk::FbxAMatrix& geometric) {
    auto* source = fbxsdk::FbxCast<fbxsdk::FbxMesh>(node != nullptr ? node->GetNodeAttribute() : nullptr);
    if (source == nullptr)
        return fail("no node with a mesh to read");
    const detail::ReadScope scope(*this);
    mesh.setName(node->GetName());
    if (!getTransform(time, global, useSampleFPS, sampleFPS, node, mesh, geometric))
        return false;
    const BakeMatrices bake = bakeMatrices(mesh, transformPoints, time.getFrame(), global, geometric);
    const fbxsdk::FbxAMatrix* pointBake = transformPoints ? &bake.points : nullptr;
    const fbxsdk::FbxAMatrix* normalBake = transformPoints ? &bake.normals : nullptr;

    const detail::MeshInstances::Source instanced = {source, /*isReversed*/ false};
    const bool isInstance = source->GetNodeCount() > 1;
    detail::noteRepairedCorners(mFileName, *node, *source, *mWarnings);
    MeshArrays arrays(mesh);
    const std::int64_t cornerCount = polygonVertexCount(*source);
    // Without enough memory it is counted only, and makes the call fail.
    const bool isFirst = !isInstance || mInstances->isFirst(instanced);
    if (!mMemory->take(
            isFirst ? MeshArrays::bytesOf(source->GetPolygonCount(), source->GetControlPointsCount(), cornerCount)
                    : MeshArrays::bytesOfAnother(source->GetControlPointsCount(), cornerCount))) {
        mesh.initMesh();
        return scope.finish(succeed());
    }
    const auto* alike = isFirst ? nullptr : mInstances->find(instanced);
    if (alike != nullptr)
        arrays.allocateLike(*alike);
    else if (cornerCount > std::numeric_limits<int>::max() ||
             !arrays.allocate(source->GetPolygonCount(), source->GetControlPointsCount(),
                              static_cast<int>(cornerCount)))
        return fail(std::string("the mesh of \"") + node->GetName() + "\" has no polygons or no points");
    setControlPoints(time, *node, *source, pointBake, arrays);
    fillCorners(*source, normalBake, static_cast<int>(cornerCount), alike != nullptr, arrays, mesh);
    if (isInstance) {
        arrays.complete();
        mMemory->giveBack(mInstances->keep(instanced, mesh));
    }
    return scope.finish(succeed());
}

/// The points at the time's frame, deformed if anything deforms them; a deformer that yields no points leaves them
/// unset.
void FbxSdk::setControlPoints(TnFbxTime& time, fbxsdk::FbxNode& node, fbxsdk::FbxMesh& source,
                              const fbxsdk::FbxAMatrix* bake, detail::MeshArrays& arrays) {
    std::unique_ptr<fbxsdk::FbxVector4[]> deformed;
    const bool isDeformed = getDeformation(&source);
    if (isDeformed) {
        fbxsdk::FbxTime moment;
        moment.SetSecondDouble(static_cast<double>(time.getTime()));
        fbxsdk::FbxAMatrix identity;
        fbxsdk::FbxVector4* made = nullptr;
        getDeformedControlPoints(&node, &source, moment, identity, &made);
        deformed.reset(made);
        if (made == nullptr)
            return;
    }
    // In blocks: points that are still in a file need not all be in memory.
    const int count = source.GetControlPointsCount();
    std::array<MeshArrays::Vector, kBlockSize> points;
    const auto put = [&](int i, const fbxsdk::FbxVector4& point) {
        points[static_cast<std::size_t>(i)] = narrow(bake != nullptr ? bake->MultT(point) : point);
    };
    for (int first = 0; first < count; first += kBlockSize) {
        const int size = std::min(kBlockSize, count - first);
        if (!isDeformed)
            detail::forEachControlPoint(source, first, size, put);
        for (int i = 0; isDeformed && i < size; ++i)
            put(i, deformed[static_cast<std::size_t>(first) + static_cast<std::size_t>(i)]);
        arrays.addControlPoints(points.data(), static_cast<std::size_t>(size));
    }
}

} // namespace Tarnell::Fbx
