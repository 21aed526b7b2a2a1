// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A point of the mesh is a sum of control points with weights that add up to one. The effect of skins and shapes on the
// control points is applied to the point with the same weights.
#include "geometry/tessellation/TessellationDeformers.h"

#include <algorithm>
#include <string>
#include <vector>

#include <fbxsdk/FbxBlendShape.h>
#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxShape.h>
#include <fbxsdk/FbxSkin.h>
#include <fbxsdk/FbxVertexCacheDeformer.h>

#include "object/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// The sums for the points of the mesh, with a record of which points have any.
template <class Number>
class PointSums {
public:
    explicit PointSums(int points) : mSums(static_cast<std::size_t>(points)), mTouched(mSums.size()) {}

    void add(int point, const Number& number) {
        const auto index = static_cast<std::size_t>(point);
        mSums[index] += number;
        mTouched[index] = true;
    }
    template <class Visit>
    void visit(Visit visitPoint) const {
        for (std::size_t point = 0; point < mSums.size(); ++point)
            if (mTouched[point])
                visitPoint(static_cast<int>(point), mSums[point]);
    }

private:
    std::vector<Number> mSums;
    std::vector<bool> mTouched;
};

/// The destination of control points: weighted points of a grid, or, without a grid, each the point of its own number.
class PointCarrier {
public:
    PointCarrier(const FbxGeometry& from, const FbxMesh& mesh, const TessellationGrid* grid)
        : mFrom(from), mMesh(mesh), mGrid(grid) {}

    [[nodiscard]] bool samePoints() const { return mGrid == nullptr; }

    void carryCluster(const FbxCluster& from, FbxCluster& to) const {
        const int count = from.GetControlPointIndicesCount();
        if (samePoints()) {
            for (int i = 0; i < count; ++i)
                to.AddControlPointIndex(from.GetControlPointIndices()[i], from.GetControlPointWeights()[i]);
            return;
        }
        // A control point that is listed twice is distributed once.
        PointSums<double> weights(mGrid->controlPointCount());
        for (int i = 0; i < count; ++i) {
            const int point = from.GetControlPointIndices()[i];
            if (point >= 0 && point < mGrid->controlPointCount())
                weights.add(point, from.GetControlPointWeights()[i]);
        }
        PointSums<double> spread(mGrid->pointCount());
        weights.visit([&](int controlPoint, double weight) {
            mGrid->spread(
                controlPoint, [&](int point, double share) { spread.add(point, share * weight); });
        });
        spread.visit([&](int point, double weight) { to.AddControlPointIndex(point, weight); });
    }

    void carryShape(const FbxShape& from, FbxShape& to) const {
        const int count = std::min(from.GetControlPointsCount(), mFrom.GetControlPointsCount());
        to.InitControlPoints(mMesh.GetControlPointsCount());
        std::copy_n(mMesh.GetControlPoints(), to.GetControlPointsCount(), to.GetControlPoints());
        for (int i = 0; i < count; ++i) {
            const FbxVector4 offset = from.GetControlPoints()[i] - mFrom.GetControlPoints()[i];
            if (offset.SquareLength() == 0.0)
                continue;
            const auto move = [&](int point, double share) {
                for (int axis = 0; axis < 3; ++axis)
                    to.GetControlPoints()[point][axis] += share * offset[axis];
            };
            if (mGrid)
                mGrid->spread(i, move);
            else
                move(i, 1.0);
        }
    }

private:
    const FbxGeometry& mFrom;
    const FbxMesh& mMesh;
    const TessellationGrid* mGrid;
};

/// A new object of the same class as an object, with the same name and properties.
template <class T>
T* newLike(const T& object) {
    T* made = T::Create(object.GetFbxManager(), object.GetName());
    carryProperties(*made, object);
    return made;
}

void copyBinding(FbxCluster& to, const FbxCluster& from) {
    FbxAMatrix matrix;
    to.SetLinkMode(from.GetLinkMode());
    to.SetTransformMatrix(from.GetTransformMatrix(matrix));
    to.SetTransformLinkMatrix(from.GetTransformLinkMatrix(matrix));
    to.SetTransformAssociateModelMatrix(from.GetTransformAssociateModelMatrix(matrix));
    if (from.IsTransformParentSet())
        to.SetTransformParentMatrix(from.GetTransformParentMatrix(matrix));
    if (from.GetLink())
        to.SetLink(from.GetLink());
    if (FbxNode* associate = from.GetAssociateModel())
        to.SetAssociateModel(associate);
}

FbxDeformer* carrySkin(const FbxSkin& from, const PointCarrier& carrier) {
    FbxSkin* skin = newLike(from);
    skin->SetSkinningType(from.GetSkinningType());
    skin->SetDeformAccuracy(from.GetDeformAccuracy());
    for (int i = 0; i < from.GetClusterCount(); ++i) {
        const FbxCluster& cluster = *from.GetCluster(i);
        FbxCluster* carried = newLike(cluster);
        copyBinding(*carried, cluster);
        carrier.carryCluster(cluster, *carried);
        skin->AddCluster(carried);
    }
    return skin;
}

FbxBlendShapeChannel* carryChannel(FbxBlendShapeChannel& from, const PointCarrier& carrier) {
    FbxBlendShapeChannel* channel = newLike(from);
    const double* fullWeights = from.GetTargetShapeFullWeights();
    for (int i = 0; i < from.GetTargetShapeCount(); ++i) {
        const FbxShape& shape = *from.GetTargetShape(i);
        FbxShape* carried = newLike(shape);
        carrier.carryShape(shape, *carried);
        channel->AddTargetShape(carried, fullWeights[i]);
    }
    return channel;
}

FbxDeformer* carryBlendShape(FbxBlendShape& from, const PointCarrier& carrier) {
    FbxBlendShape* blendShape = newLike(from);
    for (int i = 0; i < from.GetBlendShapeChannelCount(); ++i)
        blendShape->AddBlendShapeChannel(carryChannel(*from.GetBlendShapeChannel(i), carrier));
    return blendShape;
}

void carryAll(FbxMesh& mesh, const FbxGeometry& from, const PointCarrier& carrier) {
    for (int i = 0; i < from.GetDeformerCount(); ++i) {
        FbxDeformer* deformer = from.GetDeformer(i);
        if (const auto* skin = FbxCast<FbxSkin>(deformer))
            mesh.AddDeformer(carrySkin(*skin, carrier));
        else if (auto* blendShape = FbxCast<FbxBlendShape>(deformer))
            mesh.AddDeformer(carryBlendShape(*blendShape, carrier));
        else if (carrier.samePoints())
            mesh.AddDeformer(deformer);
    }
}

/// The parts of a deformer; links are not among them.
void destroyParts(FbxDeformer& deformer) {
    if (auto* skin = FbxCast<FbxSkin>(&deformer))
        while (FbxCluster* cluster = skin->GetCluster(0))
            cluster->Destroy();
    if (auto* blendShape = FbxCast<FbxBlendShape>(&deformer)) {
        while (FbxBlendShapeChannel* channel = blendShape->GetBlendShapeChannel(0)) {
            while (FbxShape* shape = channel->GetTargetShape(0))
                shape->Destroy();
            channel->Destroy();
        }
    }
}

} // namespace

std::int64_t numbersPerPoint(const FbxGeometry& geometry) {
    std::int64_t count = geometry.GetShapeCount();
    for (int i = 0; i < geometry.GetDeformerCount(); ++i)
        if (const auto* skin = FbxCast<FbxSkin>(geometry.GetDeformer(i)))
            count += skin->GetClusterCount();
    return count;
}

void carryDeformers(FbxMesh& mesh, const FbxGeometry& surface, const TessellationGrid& grid) {
    carryAll(mesh, surface, PointCarrier(surface, mesh, &grid));
}

void carryDeformers(FbxMesh& mesh, const FbxGeometry& samePoints) {
    carryAll(mesh, samePoints, PointCarrier(samePoints, mesh, nullptr));
}

void destroyDeformers(FbxGeometry& geometry) {
    while (FbxDeformer* deformer = geometry.GetDeformer(0)) {
        geometry.RemoveDeformer(0);
        if (deformer->GetDstObjectCount<FbxGeometry>() > 0)
            continue;
        destroyParts(*deformer);
        deformer->Destroy();
    }
}

void carryProperties(FbxObject& to, const FbxObject& from) {
    for (const PropertyData* source : from.data().properties()) {
        const FbxProperty named(const_cast<FbxObject*>(&from), source->index);
        const std::string name = named.GetNameAsCStr();
        FbxProperty property = to.FindProperty(name.c_str());
        if (!property.IsValid())
            property = FbxProperty::Create(&to, source->type, name.c_str(), source->label.c_str());
        PropertyData& copy = to.data().materialise(property.index());
        if (copy.type == source->type)
            copy.value = source->value;
        copy.flags = source->flags;
        for (ConnectionPoint* each : source->plug.sources)
            ObjectData::connect(*each, copy.plug);
    }
}

} // namespace detail
FBXSDK_NAMESPACE_END
