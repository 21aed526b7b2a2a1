// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A mesh at one frame: its points, the order of its polygons' corners, and the values of its layers at the corners.
#include "Decomposition.h"
#include "Deformation.h"
#include "MeshLayers.h"
#include "Placement.h"
#include "Reading.h"
#include "Sampling.h"

#include "access/CornerWarnings.h"
#include "calls/LastError.h"
#include "model/MeshArrays.h"
#include "model/MeshInstances.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <limits>
#include <map>
#include <stdexcept>
#include <string>
#include <tuple>
#include <vector>

namespace Tarnell::Fbx::faithful {

namespace {

using detail::Corner;
using detail::MeshArrays;
using detail::MeshInstances;
using fbxsdk::FbxAMatrix;
using fbxsdk::FbxMesh;
using fbxsdk::FbxNode;
using fbxsdk::FbxTime;
using fbxsdk::FbxVector4;

/// The space of the returned points.
struct Space {
    FbxAMatrix fromMesh;  // for points in the mesh's own space
    FbxAMatrix fromWorld; // for points in the world
    bool isFlat = false;  // there is no way to it from the world
};

Space spaceOf(const TnFbxReadInfo& info, FbxNode& node, const FbxTime& time) {
    const FbxAMatrix geometric = geometricMatrix(node);
    if (info.getTransformPoints() && info.getGlobalTransform())
        return {worldMatrix(node, time) * geometric, FbxAMatrix()};
    const bool own = !info.getTransformPoints(); // the object's transform applies to them
    const FbxAMatrix space = own ? worldMatrix(node, time) : parentMatrix(node, time);
    return {own ? geometric : localMatrix(node, time) * geometric, space.Inverse(), handedness(space) == 0.0};
}

/// The transform of a mesh's points to the returned space, and that of its normals.
class PlacedMesh {
public:
    PlacedMesh(DeformedMesh&& deformed, const Space& space) : mDeformed(std::move(deformed)), mSpace(space) {
        const FbxAMatrix& place = mDeformed.inWorld ? mSpace.fromWorld : mSpace.fromMesh;
        for (FbxVector4& point : mDeformed.points)
            point = place.MultT(point);
        mMirrored = (handedness(place) < 0.0) != mDeformed.mirrored;
    }

    const std::vector<FbxVector4>& points() const { return mDeformed.points; }
    bool mirrored() const { return mMirrored; }
    bool reshaped() const { return mDeformed.reshaped; }

    FbxVector4 normal(const FbxVector4& stored, const Corner& corner) const {
        const auto place = static_cast<std::size_t>(corner.polygonVertex);
        const bool cached = corner.polygonVertex >= 0 && place < mDeformed.normals.size();
        return transformedNormal(mSpace.fromMesh, cached ? mDeformed.normals[place] : stored);
    }

private:
    DeformedMesh mDeformed;
    Space mSpace;
    bool mMirrored = false;
};

/// The points of a node's mesh, now.
PlacedMesh placedMesh(Scene& scene, const TnFbxReadInfo& info, FbxNode& node, FbxMesh& source) {
    const FbxTime time = scene.now();
    const Space space = spaceOf(info, node, time);
    DeformedMesh deformed = deformedPoints(scene, node, source, time);
    if (deformed.inWorld && space.isFlat) {
        detail::warn(scene.fileName() + ": the points that the skin of \"" + node.GetName() +
                     "\" moves stay in the world: the transform that they are to be relative to has no inverse");
    }
    return {std::move(deformed), space};
}

// ---- Polygons ----

/// The corners in the returned order: the polygons of mirrored meshes are reversed,
/// starting at the same corner.
class Corners {
public:
    Corners(FbxMesh& mesh, bool reversed) : mMesh(mesh), mReversed(reversed) {}

    std::int64_t count() const {
        std::int64_t count = 0;
        for (int polygon = 0; polygon < mMesh.GetPolygonCount(); ++polygon)
            count += std::max(mMesh.GetPolygonSize(polygon), 0);
        return count;
    }

    template <class Visit>
    void forEach(const Visit& visit) const {
        const int* vertices = mMesh.GetPolygonVertices();
        for (int polygon = 0; polygon < mMesh.GetPolygonCount(); ++polygon) {
            const int size = mMesh.GetPolygonSize(polygon);
            const int start = mMesh.GetPolygonVertexIndex(polygon);
            for (int i = 0; i < size; ++i) {
                const int vertex = start + (mReversed && i > 0 ? size - i : i);
                visit(Corner{polygon, vertex, vertices != nullptr && start >= 0 ? vertices[vertex] : -1});
            }
        }
    }

private:
    FbxMesh& mMesh;
    bool mReversed;
};

void fillLayout(FbxMesh& source, const Corners& corners, MeshArrays& arrays) {
    for (int polygon = 0; polygon < source.GetPolygonCount(); ++polygon)
        arrays.addPolygonVertexSize(source.GetPolygonSize(polygon));
    corners.forEach([&arrays](const Corner& corner) { arrays.addPointIndex(corner.controlPoint); });
}

// ---- Normals ----

/// Corners of one point that shared a normal share a new one, when the points of their mesh have moved.
class ReshapedNormals {
public:
    ReshapedNormals(FbxMesh& mesh, const Corners& corners, const MappedValues<FbxVector4>& stored,
                    const std::vector<FbxVector4>& points)
        : mStored(stored), mPolygonNormals(static_cast<std::size_t>(std::max(mesh.GetPolygonCount(), 0))) {
        addPolygonNormals(corners, points);
        corners.forEach([this](const Corner& corner) {
            FbxVector4& sum = mSums[keyOf(corner)];
            const FbxVector4& normal = mPolygonNormals[static_cast<std::size_t>(corner.polygon)];
            for (int axis = 0; axis < 3; ++axis)
                sum[axis] += normal[axis];
        });
    }

    FbxVector4 at(const Corner& corner) const {
        const FbxVector4& sum = mSums.at(keyOf(corner));
        const double length = std::sqrt(sum[0] * sum[0] + sum[1] * sum[1] + sum[2] * sum[2]);
        return length > 0.0 ? FbxVector4(sum[0] / length, sum[1] / length, sum[2] / length) : sum;
    }

private:
    using Key = std::tuple<int, double, double, double>;

    Key keyOf(const Corner& corner) const {
        const FbxVector4 stored = mStored.at(corner).value_or(FbxVector4(0.0, 0.0, 0.0));
        return {corner.controlPoint, stored[0], stored[1], stored[2]};
    }

    /// With a length of twice the area.
    void addPolygonNormals(const Corners& corners, const std::vector<FbxVector4>& points) {
        int polygon = -1;
        FbxVector4 first, last;
        corners.forEach([&](const Corner& corner) {
            const auto index = static_cast<std::size_t>(corner.controlPoint);
            const FbxVector4 point = corner.controlPoint >= 0 && index < points.size() ? points[index] : FbxVector4();
            if (corner.polygon != polygon) {
                polygon = corner.polygon;
                first = last = point;
                mPolygonNormals[static_cast<std::size_t>(polygon)] = FbxVector4(0.0, 0.0, 0.0);
                return;
            }
            FbxVector4& normal = mPolygonNormals[static_cast<std::size_t>(polygon)];
            for (int axis = 0; axis < 3; ++axis) {
                const int b = (axis + 1) % 3;
                const int c = (axis + 2) % 3;
                normal[axis] +=
                    (last[b] - first[b]) * (point[c] - first[c]) - (last[c] - first[c]) * (point[b] - first[b]);
            }
            last = point;
        });
    }

    const MappedValues<FbxVector4>& mStored;
    std::vector<FbxVector4> mPolygonNormals;
    std::map<Key, FbxVector4> mSums;
};

/// Whether there are any.
bool fillNormals(FbxMesh& source, const Corners& corners, const PlacedMesh& placed, MeshArrays& arrays) {
    const MappedValues<FbxVector4> stored = meshNormals(source);
    if (!stored.found())
        return false;
    if (placed.reshaped()) {
        const ReshapedNormals normals(source, corners, stored, placed.points());
        corners.forEach([&](const Corner& corner) {
            const FbxVector4 normal = normals.at(corner);
            arrays.addNormal({toFloat(normal[0]), toFloat(normal[1]), toFloat(normal[2])});
        });
        return true;
    }
    bool found = false;
    corners.forEach([&](const Corner& corner) {
        const std::optional<FbxVector4> value = stored.at(corner);
        found = found || value.has_value();
        const FbxVector4 normal = value ? placed.normal(*value, corner) : FbxVector4(0.0, 0.0, 0.0);
        arrays.addNormal({toFloat(normal[0]), toFloat(normal[1]), toFloat(normal[2])});
    });
    return found;
}

bool fillUVs(FbxMesh& source, const Corners& corners, MeshArrays& arrays) {
    const MappedValues<fbxsdk::FbxVector2> stored = meshUVs(source);
    if (!stored.found())
        return false;
    bool found = false;
    corners.forEach([&](const Corner& corner) {
        const std::optional<fbxsdk::FbxVector2> value = stored.at(corner);
        found = found || value.has_value();
        const fbxsdk::FbxVector2 uv = value.value_or(fbxsdk::FbxVector2(0.0, 0.0));
        arrays.addUV({toFloat(uv[0]), toFloat(uv[1])});
    });
    return found;
}

bool fillColours(FbxMesh& source, const FbxNode& node, const Corners& corners, MeshArrays& arrays) {
    const MeshColours stored(source, node);
    if (!stored.found())
        return false;
    bool found = false;
    auto* next = arrays.colours();
    corners.forEach([&](const Corner& corner) {
        if (const std::optional<detail::Colour> colour = stored.at(corner)) {
            found = true;
            *next = {colour->red, colour->green, colour->blue, colour->alpha};
        }
        ++next;
    });
    return found;
}

/// The values of layers, in the layout that is filled, too, unless it is that of another node's mesh.
void fillCorners(FbxMesh& source, const FbxNode& node, const PlacedMesh& placed, bool isAlike, MeshArrays& arrays,
                 TnFbxMesh& mesh) {
    const Corners corners(source, placed.mirrored());
    if (!isAlike)
        fillLayout(source, corners, arrays);
    mesh.setValidNormals(fillNormals(source, corners, placed, arrays));
    mesh.setValidUVs(isAlike ? mesh.getValidUVs() : fillUVs(source, corners, arrays));
    mesh.setValidColours(fillColours(source, node, corners, arrays));
}

/// `alike` is the result for the mesh of another node with the same source; null when there is none.
void fillMesh(FbxMesh& source, const FbxNode& node, const PlacedMesh& placed, std::int64_t cornerCount,
              const MeshInstances::Geometry* alike, TnFbxMesh& mesh) {
    MeshArrays arrays(mesh);
    bool hasPolygons = true;
    if (alike != nullptr) {
        arrays.allocateLike(*alike);
    } else if (!arrays.allocate(source.GetPolygonCount(), static_cast<int>(placed.points().size()),
                                static_cast<int>(cornerCount))) {
        arrays.allocatePoints(static_cast<int>(placed.points().size()));
        hasPolygons = false;
    }
    for (const FbxVector4& point : placed.points())
        arrays.addControlPoint({toFloat(point[0]), toFloat(point[1]), toFloat(point[2])});
    if (hasPolygons)
        fillCorners(source, node, placed, alike != nullptr, arrays, mesh);
}

/// The memory of a mesh's arrays: for each corner an index, a normal, a texture coordinate and a colour.
std::uint64_t bytesOf(const FbxMesh& source, std::int64_t cornerCount) {
    constexpr std::uint64_t perPoint = 3 * sizeof(float);
    constexpr std::uint64_t perCorner = sizeof(int) + (3 + 2 + 4) * sizeof(float);
    return static_cast<std::uint64_t>(std::max(source.GetControlPointsCount(), 0)) * perPoint +
           static_cast<std::uint64_t>(std::max(source.GetPolygonCount(), 0)) * sizeof(int) +
           static_cast<std::uint64_t>(cornerCount) * perCorner;
}

/// The same for the mesh of one more node.
std::uint64_t bytesOfAnother(const FbxMesh& source, std::int64_t cornerCount) {
    return std::min(bytesOf(source, cornerCount),
                    MeshArrays::bytesOfAnother(source.GetControlPointsCount(), cornerCount));
}

/// The result for another node with the same mesh; null when there is none, or none that matches.
const MeshInstances::Geometry* findAlike(Scene& scene, const MeshInstances::Source& source, std::size_t pointCount) {
    const MeshInstances::Geometry* found = scene.instances().find(source);
    return found != nullptr && found->controlPoints.size() == pointCount ? found : nullptr;
}

} // namespace

bool readNode(Scene& scene, const TnFbxReadInfo& info, FbxNode& node, TnFbxMesh& mesh) {
    FbxMesh& source = *node.GetMesh();
    const std::int64_t cornerCount = Corners(source, false).count();
    if (cornerCount > std::numeric_limits<int>::max()) {
        return detail::fail(scene.fileName() + ": the mesh of \"" + node.GetName() +
                            "\" has too many polygon vertices");
    }
    detail::noteRepairedCorners(scene.fileName(), node, source, scene.warnings());
    // Whether the corners are reversed is known later: there may be no match after all.
    const MeshInstances::Source straight = {&source, false}, reversed = {&source, true};
    const bool isKnown = scene.instances().find(straight) != nullptr || scene.instances().find(reversed) != nullptr;
    const std::uint64_t all = bytesOf(source, cornerCount);
    const std::uint64_t granted = isKnown ? bytesOfAnother(source, cornerCount) : all;
    if (!scene.grantBytes(granted) || !readNode(scene, info, node, static_cast<TnFbxTransform&>(mesh)))
        return false;
    const PlacedMesh placed = placedMesh(scene, info, node, source);
    const MeshInstances::Source& kept = placed.mirrored() ? reversed : straight;
    const MeshInstances::Geometry* alike = findAlike(scene, kept, placed.points().size());
    if (alike == nullptr && !scene.grantBytes(all - granted))
        return false;
    try {
        fillMesh(source, node, placed, cornerCount, alike, mesh);
        mesh.setPointsPlaced(info.getTransformPoints());
        if (source.GetNodeCount() > 1)
            scene.giveBackBytes(scene.instances().keep(kept, mesh));
        return true;
    } catch (const std::runtime_error& error) { // the platform's message about a layer element without its array
        mesh.initMesh();
        return detail::fail(scene.fileName() + ": the layer elements of \"" + node.GetName() + "\" are damaged (" +
                            error.what() + ")");
    }
}

bool addPoints(Scene& scene, const TnFbxReadInfo& info, FbxNode& node, TnFbxMesh& mesh) {
    FbxMesh& source = *node.GetMesh();
    // Points that are shared so far become the mesh's own.
    const int sets = 1 + (MeshArrays::sharesPoints(mesh) ? mesh.getNumberOfControlPointSets() : 0);
    if (!scene.grantBytes(static_cast<std::uint64_t>(mesh.getNumberOfControlPoints()) * 3 * sizeof(float) *
                          static_cast<std::uint64_t>(sets)))
        return false;
    const PlacedMesh placed = placedMesh(scene, info, node, source);
    if (placed.points().size() != static_cast<std::size_t>(mesh.getNumberOfControlPoints())) {
        return detail::fail(scene.fileName() + ": \"" + node.GetName() +
                            "\" has a different number of control points than before");
    }
    mesh.addControlPointSet();
    for (const FbxVector4& point : placed.points())
        mesh.addControlPoint(toFloat(point[0]), toFloat(point[1]), toFloat(point[2]));
    return true;
}

} // namespace Tarnell::Fbx::faithful
