// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deformed control points: a vertex cache replaces everything, otherwise blend shapes and then skin clusters. And the
// opening and closing of a scene's point caches.
#include "FbxSdk.h"

#include "BlendShapeWeights.h"
#include "LastError.h"
#include "NodeGeometry.h"
#include "PropertySampling.h"

#include <algorithm>
#include <cmath>
#include <memory>
#include <vector>

namespace Tarnell::Fbx {

using detail::fail;

namespace {

using Cluster = fbxsdk::FbxCluster;
using Deformer = fbxsdk::FbxDeformer;
using Matrix = fbxsdk::FbxAMatrix;
using Point = fbxsdk::FbxVector4;

constexpr int kMatrixElements = 16;

/// Weights are compared in double precision with a threshold of single precision.
constexpr double kWeightThreshold = static_cast<double>(1e-5f);

fbxsdk::FbxVertexCacheDeformer* vertexCacheOf(const fbxsdk::FbxGeometry& geometry) {
    return geometry.GetDeformerCount(Deformer::eVertexCache) > 0
               ? fbxsdk::FbxCast<fbxsdk::FbxVertexCacheDeformer>(geometry.GetDeformer(0, Deformer::eVertexCache))
               : nullptr;
}

bool hasActiveVertexCache(const fbxsdk::FbxGeometry& geometry) {
    const fbxsdk::FbxVertexCacheDeformer* deformer = vertexCacheOf(geometry);
    return deformer != nullptr && deformer->Active.Get();
}

/// Calls `visit(cluster)` for every cluster of every skin.
template <class Visit>
void forEachCluster(const fbxsdk::FbxMesh& mesh, Visit&& visit) {
    const int skinCount = mesh.GetDeformerCount(Deformer::eSkin);
    for (int i = 0; i < skinCount; ++i) {
        auto* skin = fbxsdk::FbxCast<fbxsdk::FbxSkin>(mesh.GetDeformer(i, Deformer::eSkin));
        for (int j = 0; skin != nullptr && j < skin->GetClusterCount(); ++j) {
            if (Cluster* cluster = skin->GetCluster(j)) {
                visit(*cluster);
            }
        }
    }
}

bool hasClusters(const fbxsdk::FbxMesh& mesh) {
    bool found = false;
    forEachCluster(mesh, [&found](Cluster&) { found = true; });
    return found;
}

/// The mode of the mesh's first cluster holds for all of them.
Cluster::ELinkMode linkModeOf(const fbxsdk::FbxMesh& mesh) {
    auto* skin = fbxsdk::FbxCast<fbxsdk::FbxSkin>(mesh.GetDeformer(0, Deformer::eSkin));
    const Cluster* first = skin != nullptr && skin->GetClusterCount() > 0 ? skin->GetCluster(0) : nullptr;
    return first != nullptr ? first->GetLinkMode() : Cluster::eNormalize;
}

void scaleElements(Matrix& matrix, double factor) {
    double* elements = matrix;
    for (int i = 0; i < kMatrixElements; ++i) {
        elements[i] *= factor;
    }
}

void addElements(Matrix& matrix, const Matrix& other) {
    double* elements = matrix;
    const double* added = other;
    for (int i = 0; i < kMatrixElements; ++i) {
        elements[i] += added[i];
    }
}

void addToDiagonal(Matrix& matrix, double value) {
    for (int i = 0; i < 4; ++i) {
        matrix[i][i] += value;
    }
}

Matrix zeroMatrix() {
    Matrix matrix;
    scaleElements(matrix, 0.0);
    return matrix;
}

/// From a point of the mesh at rest to where a cluster's link takes it.
Matrix vertexTransform(FbxSdk& sdk, const Matrix& globalPosition, fbxsdk::FbxMesh& mesh, Cluster& cluster,
                       fbxsdk::FbxNode& link, Cluster::ELinkMode mode, const fbxsdk::FbxTime& time) {
    Matrix referenceInit, referenceCurrent, linkInit;
    fbxsdk::FbxNode* associate = mode == Cluster::eAdditive ? cluster.GetAssociateModel() : nullptr;
    if (associate != nullptr) {
        cluster.GetTransformAssociateModelMatrix(referenceInit);
        referenceCurrent = detail::globalTransform(*associate, time) * sdk.getGeometry(associate);
    } else {
        cluster.GetTransformMatrix(referenceInit);
        referenceInit = referenceInit * sdk.getGeometry(mesh.GetNode());
        referenceCurrent = globalPosition;
    }
    cluster.GetTransformLinkMatrix(linkInit);
    const Matrix linkCurrent = detail::globalTransform(link, time);
    return (linkCurrent.Inverse() * referenceCurrent).Inverse() * (linkInit.Inverse() * referenceInit);
}

/// What the clusters of a mesh do to each of its points, summed up.
struct SkinSums {
    std::vector<Matrix> deformations;
    std::vector<double> weights;

    SkinSums(std::size_t pointCount, Cluster::ELinkMode mode)
        : deformations(pointCount, mode == Cluster::eAdditive ? Matrix() : zeroMatrix()), weights(pointCount, 0.0) {}
};

/// Adds one cluster. Indices that are no points of the mesh are passed over.
void addCluster(const Cluster& cluster, const Matrix& transform, Cluster::ELinkMode mode, SkinSums& sums) {
    const int* indices = cluster.GetControlPointIndices();
    const double* weights = cluster.GetControlPointWeights();
    const int count = indices != nullptr && weights != nullptr ? cluster.GetControlPointIndicesCount() : 0;
    for (int i = 0; i < count; ++i) {
        const double weight = weights[i];
        if (std::fabs(weight) < kWeightThreshold || indices[i] < 0 ||
            static_cast<std::size_t>(indices[i]) >= sums.weights.size()) {
            continue;
        }
        const auto point = static_cast<std::size_t>(indices[i]);
        Matrix influence = transform;
        scaleElements(influence, weight);
        if (mode == Cluster::eAdditive) {
            addToDiagonal(influence, 1.0 - weight);
            sums.deformations[point] = influence * sums.deformations[point];
            sums.weights[point] = 1.0;
        } else {
            addElements(sums.deformations[point], influence);
            sums.weights[point] += weight;
        }
    }
}

/// kept: a total of exactly the threshold leaves the point alone, while a weight of exactly the threshold counts
void applySkin(const SkinSums& sums, Cluster::ELinkMode mode, Point* points) {
    for (std::size_t i = 0; i < sums.weights.size(); ++i) {
        const double weight = sums.weights[i];
        if (!(std::fabs(weight) > kWeightThreshold)) {
            continue;
        }
        const Point source = points[i];
        points[i] = sums.deformations[i].MultT(source);
        if (mode == Cluster::eNormalize) {
            points[i] /= weight;
        } else if (mode == Cluster::eTotalOne) {
            points[i] += source * (1.0 - weight);
        }
    }
}

/// Adds the way from the base to a target, times the weight, to every point that both have.
void addTarget(const fbxsdk::FbxShape& shape, const Point* base, int pointCount, double weight, Point* points) {
    const Point* target = shape.GetControlPoints();
    const int count = target != nullptr ? std::min(pointCount, shape.GetControlPointsCount()) : 0;
    for (int i = 0; i < count; ++i) {
        points[i] += (target[i] - base[i]) * weight;
    }
}

/// Adds what one channel does at a weight.
///
/// kept: the weight is a percentage and multiplies the whole difference all the same.
void addChannel(fbxsdk::FbxBlendShapeChannel& channel, double weight, const Point* base, int pointCount,
                Point* points) {
    const int targetCount = channel.GetTargetShapeCount();
    const double* fullWeights = channel.GetTargetShapeFullWeights();
    for (int step = 0; fullWeights != nullptr && step < targetCount; ++step) {
        if (const auto target = detail::targetOfStep(step, weight, fullWeights, targetCount)) {
            if (const fbxsdk::FbxShape* shape = channel.GetTargetShape(*target)) {
                addTarget(*shape, base, pointCount, weight, points);
            }
        }
    }
}

} // namespace

bool FbxSdk::getDeformation(fbxsdk::FbxMesh* mesh) {
    return mesh != nullptr && (hasActiveVertexCache(*mesh) || mesh->GetShapeCount() != 0 || hasClusters(*mesh));
}

void FbxSdk::getDeformedControlPoints(fbxsdk::FbxNode* node, fbxsdk::FbxMesh* mesh, fbxsdk::FbxTime& time,
                                      fbxsdk::FbxAMatrix& globalPosition, fbxsdk::FbxVector4** points) {
    const int count = mesh != nullptr ? mesh->GetControlPointsCount() : 0;
    if (node == nullptr || points == nullptr || count < 1) {
        return;
    }
    const Point* source = mesh->GetControlPoints();
    delete[] * points;
    *points = nullptr;
    *points = new Point[static_cast<std::size_t>(count)];
    std::copy_n(source, count, *points);

    if (hasActiveVertexCache(*mesh)) {
        readVertexCacheData(mesh, time, *points);
        return;
    }
    if (mesh->GetShapeCount() != 0) {
        computeShapeDeformation(node, mesh, time, *points);
    }
    if (hasClusters(*mesh)) {
        computeClusterDeformation(globalPosition, mesh, time, *points);
    }
}

void FbxSdk::readVertexCacheData(fbxsdk::FbxMesh* mesh, fbxsdk::FbxTime& time, fbxsdk::FbxVector4* points) {
    fbxsdk::FbxVertexCacheDeformer* deformer = mesh != nullptr ? vertexCacheOf(*mesh) : nullptr;
    fbxsdk::FbxCache* cache = deformer != nullptr ? deformer->GetCache() : nullptr;
    const int count = mesh != nullptr ? mesh->GetControlPointsCount() : 0;
    if (cache == nullptr || points == nullptr || count < 1) {
        return;
    }

    std::vector<double> buffer(static_cast<std::size_t>(count) * 3);
    const auto pointCount = static_cast<unsigned int>(count);
    bool read = false;
    if (cache->GetCacheFileFormat() == fbxsdk::FbxCache::eMayaCache) {
        const fbxsdk::FbxString channelName = deformer->Channel.Get();
        const int channel = cache->GetChannelIndex(channelName);
        read = channel >= 0 && cache->Read(channel, time, buffer.data(), pointCount);
    } else {
        const auto frame = static_cast<unsigned int>(time.GetFrameCount(fbxsdk::FbxTime::eDefaultMode));
        read = cache->Read(frame, buffer.data(), pointCount);
    }
    for (std::size_t i = 0; read && i < pointCount; ++i) {
        for (int axis = 0; axis < 3; ++axis) {
            points[i][axis] = buffer[3 * i + static_cast<std::size_t>(axis)];
        }
    }
}

void FbxSdk::computeShapeDeformation(fbxsdk::FbxNode* /*node*/, fbxsdk::FbxMesh* mesh, fbxsdk::FbxTime& time,
                                     fbxsdk::FbxVector4* points) {
    if (mesh == nullptr || points == nullptr) {
        return;
    }
    const int pointCount = mesh->GetControlPointsCount();
    const std::vector<Point> base(points, points + pointCount);
    const std::vector<fbxsdk::FbxAnimLayer*> layers = detail::layersOf(mCurrentAnimStack);
    const int deformerCount = mesh->GetDeformerCount(Deformer::eBlendShape);
    for (int b = 0; b < deformerCount; ++b) {
        auto* blendShape = fbxsdk::FbxCast<fbxsdk::FbxBlendShape>(mesh->GetDeformer(b, Deformer::eBlendShape));
        const int channelCount = blendShape != nullptr ? blendShape->GetBlendShapeChannelCount() : 0;
        for (int c = 0; c < channelCount; ++c) {
            fbxsdk::FbxBlendShapeChannel* channel = blendShape->GetBlendShapeChannel(c);
            for (fbxsdk::FbxAnimLayer* layer : layers) { // kept: every layer with a curve adds its own
                fbxsdk::FbxAnimCurve* curve = mesh->GetShapeChannel(b, c, layer, /*pCreateAsNeeded*/ false);
                if (channel != nullptr && curve != nullptr) {
                    addChannel(*channel, static_cast<double>(curve->Evaluate(time)), base.data(), pointCount, points);
                }
            }
        }
    }
}

void FbxSdk::computeClusterDeformation(fbxsdk::FbxAMatrix& globalPosition, fbxsdk::FbxMesh* mesh, fbxsdk::FbxTime& time,
                                       fbxsdk::FbxVector4* points) {
    if (mesh == nullptr || points == nullptr) {
        return;
    }
    const Cluster::ELinkMode mode = linkModeOf(*mesh);
    SkinSums sums(static_cast<std::size_t>(mesh->GetControlPointsCount()), mode);
    forEachCluster(*mesh, [&](Cluster& cluster) {
        if (fbxsdk::FbxNode* link = cluster.GetLink()) {
            const Matrix transform = vertexTransform(*this, globalPosition, *mesh, cluster, *link, mode, time);
            addCluster(cluster, transform, mode, sums);
        }
    });
    applySkin(sums, mode, points);
}

bool FbxSdk::openClosePointCacheData(fbxsdk::FbxScene* scene, bool open) {
    if (scene == nullptr) {
        return fail("no scene to open point caches of");
    }
    const int nodeCount = scene->GetNodeCount();
    for (int i = 0; i < nodeCount; ++i) {
        fbxsdk::FbxNode* node = scene->GetNode(i);
        const fbxsdk::FbxGeometry* geometry = node != nullptr ? node->GetGeometry() : nullptr;
        fbxsdk::FbxVertexCacheDeformer* deformer = geometry != nullptr ? vertexCacheOf(*geometry) : nullptr;
        fbxsdk::FbxCache* cache = deformer != nullptr ? deformer->GetCache() : nullptr;
        if (cache == nullptr || !deformer->Active.Get()) {
            continue;
        }
        if (!open) {
            if (cache->IsOpen()) {
                cache->CloseFile();
            }
        } else if (!cache->IsOpen() && !cache->OpenFileForRead()) { // instances share a cache, which is open then
            deformer->Active.Set(false);                            // the mesh then reads without its cache
        }
    }
    return true; // closing comes after the work, whose failure stays noted
}

void FbxSdk::matrixScale(fbxsdk::FbxAMatrix& matrix, double factor) { scaleElements(matrix, factor); }

void FbxSdk::matrixAddToDiagonal(fbxsdk::FbxAMatrix& matrix, double value) { addToDiagonal(matrix, value); }

void FbxSdk::matrixAdd(fbxsdk::FbxAMatrix& matrix, fbxsdk::FbxAMatrix& other) { addElements(matrix, other); }

} // namespace Tarnell::Fbx
