// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Polygons and points of meshes, as they are deformed at a frame.
#include <cmath>

#include "CameraOrigins.h"
#include "DiffSides.h"

namespace tool {

using Tarnell::Fbx::TnFbxMesh;

namespace {

using MeshOf = std::unordered_map<const FbxNode*, const TnFbxMesh*>;

/// Surfaces are read as meshes; those that cannot be converted are skipped.
bool mayBeMesh(FbxNode& node) {
    const FbxNodeAttribute* attribute = node.GetNodeAttribute();
    switch (attribute ? attribute->GetAttributeType() : FbxNodeAttribute::eUnknown) {
    case FbxNodeAttribute::eMesh:
    case FbxNodeAttribute::eNurbs:
    case FbxNodeAttribute::ePatch:
    case FbxNodeAttribute::eNurbsSurface:
        return true;
    default:
        return false;
    }
}

FaithfulObjects<TnFbxMesh> meshesAt(const DiffSide& side, double frame, MeshOf& meshOf) {
    Tarnell::Fbx::TnFbxReadInfo info = faithfulInfo(side.file.name, side.takeName);
    info.setFrame(static_cast<float>(frame));
    info.setTransformPoints(false);
    auto read = readFaithfully<TnFbxMesh>(info, &Tarnell::Fbx::Fbx::getMeshes);
    std::size_t next = 0;
    for (FbxNode* node : nodesOfTree(side.file.opened.scene()))
        if (next < read.count && mayBeMesh(*node) && read.objects.get()[next].getName() == node->GetName())
            meshOf[node] = read.objects.get() + next++;
    return read;
}

std::string yesNo(bool there) { return there ? "yes" : "no"; }

class MeshComparison {
public:
    MeshComparison(Comparison& comparison, std::string object, const TnFbxMesh& a, const TnFbxMesh& b)
        : mComparison(comparison), mObject(std::move(object)), mA(a), mB(b) {}

    void topology() {
        counts("points", mA.getNumberOfControlPoints(), mB.getNumberOfControlPoints());
        counts("polygons", mA.getNumberOfPolygons(), mB.getNumberOfPolygons());
        counts("corners", mA.getNumberOfPolygonVertices(), mB.getNumberOfPolygonVertices());
        polygons();
        texts("normals", yesNo(mA.getValidNormals()), yesNo(mB.getValidNormals()));
        texts("texture coordinates", yesNo(mA.getValidUVs()), yesNo(mB.getValidUVs()));
        texts("colours", yesNo(mA.getValidColours()), yesNo(mB.getValidColours()));
    }

    /// The point that is furthest off, in centimetres of the node's own space.
    void points(double frame) {
        if (mA.getNumberOfControlPoints() != mB.getNumberOfControlPoints())
            return;
        int moved = 0, worst = 0;
        double most = -1.0;
        for (int i = 0; i < mA.getNumberOfControlPoints(); ++i) {
            const Vector3 a = pointOf(mA, i, mComparison.a.unit), b = pointOf(mB, i, mComparison.b.unit);
            if (!mComparison.differ(a[0], b[0]) && !mComparison.differ(a[1], b[1]) && !mComparison.differ(a[2], b[2]))
                continue;
            ++moved;
            const double apart = std::hypot(a[0] - b[0], a[1] - b[1], a[2] - b[2]);
            worst = most < 0.0 || apart > most ? i : worst;
            most = most < 0.0 || apart > most ? apart : most;
        }
        if (moved == 0 || most <= mMost)
            return;
        mMost = most;
        mWorst = {DiffKind::points,
                  mObject,
                  std::to_string(moved) + " of " + std::to_string(mA.getNumberOfControlPoints()) +
                      " points, largest difference at point " + std::to_string(worst),
                  vectorText(pointOf(mA, worst, mComparison.a.unit), 4),
                  vectorText(pointOf(mB, worst, mComparison.b.unit), 4),
                  most,
                  "cm",
                  frame,
                  0};
    }

    /// The largest difference of all frames so far.
    std::optional<Difference> worst() const { return mMost < 0.0 ? std::nullopt : std::optional(mWorst); }

private:
    static Vector3 pointOf(const TnFbxMesh& mesh, int index, double unit) {
        std::array<float, 3> point{};
        mesh.getControlPoint(index, point[0], point[1], point[2]);
        return {static_cast<double>(point[0]) * unit, static_cast<double>(point[1]) * unit,
                static_cast<double>(point[2]) * unit};
    }

    void texts(const char* what, const std::string& a, const std::string& b) {
        if (a != b)
            mComparison.add(DiffKind::topology, mObject, what, a, b);
    }
    void counts(const char* what, int a, int b) { texts(what, std::to_string(a), std::to_string(b)); }

    /// The first polygon that has other corners, where there are as many.
    void polygons() {
        if (mA.getNumberOfPolygons() != mB.getNumberOfPolygons() ||
            mA.getNumberOfPolygonVertices() != mB.getNumberOfPolygonVertices())
            return;
        int corner = 0;
        for (int polygon = 0; polygon < mA.getNumberOfPolygons(); ++polygon) {
            const int size = mA.getPolygonVertexSize(polygon);
            bool same = size == mB.getPolygonVertexSize(polygon);
            for (int i = 0; same && i < size; ++i)
                same = mA.getPointIndex(corner + i) == mB.getPointIndex(corner + i);
            if (!same)
                return mComparison.add(DiffKind::topology, mObject, "vertices of polygon " + std::to_string(polygon),
                                       cornersText(mA, corner, size),
                                       cornersText(mB, corner, mB.getPolygonVertexSize(polygon)));
            corner += size;
        }
    }

    static std::string cornersText(const TnFbxMesh& mesh, int first, int size) {
        constexpr int kMostShown = 8;
        std::string text;
        for (int i = 0; i < std::min(size, kMostShown); ++i)
            text += (i == 0 ? "" : ", ") + std::to_string(mesh.getPointIndex(first + i));
        return size > kMostShown ? text + ", …" : text;
    }

    Comparison& mComparison;
    std::string mObject;
    const TnFbxMesh &mA, &mB;
    double mMost = -1.0;
    Difference mWorst;
};

std::vector<DiffMoment> momentsOf(const Comparison& comparison) {
    if (!comparison.settings.frames)
        return {comparison.moments[0]};
    std::vector<DiffMoment> moments;
    for (int frame = comparison.settings.frames->first; frame <= comparison.settings.frames->second; ++frame) {
        const double seconds = static_cast<double>(frame) / comparison.a.take.frameRate;
        moments.push_back({static_cast<double>(frame), seconds * comparison.b.take.frameRate});
        if (frame == comparison.settings.frames->second)
            break;
    }
    return moments;
}

} // namespace

void compareMeshes(Comparison& comparison) {
    std::unordered_map<const FbxNode*, Difference> worst;
    bool isFirst = true;
    for (const DiffMoment& moment : momentsOf(comparison)) {
        MeshOf meshA, meshB;
        const auto readA = meshesAt(comparison.a, moment.a, meshA), readB = meshesAt(comparison.b, moment.b, meshB);
        for (const auto& [nodeA, nodeB] : comparison.pairs) {
            const auto a = meshA.find(nodeA), b = meshB.find(nodeB);
            if (a == meshA.end() || b == meshB.end())
                continue;
            MeshComparison meshes(comparison, nodeA->GetName(), *a->second, *b->second);
            if (isFirst)
                meshes.topology();
            meshes.points(moment.a);
            const std::optional<Difference> found = meshes.worst();
            const auto known = worst.find(nodeA);
            if (found && (known == worst.end() || *found->amount > *known->second.amount))
                worst[nodeA] = *found;
        }
        isFirst = false;
    }
    for (const NodePair& pair : comparison.pairs) {
        const auto found = worst.find(pair.a);
        if (found != worst.end())
            comparison.found.push_back(found->second);
    }
}

} // namespace tool
