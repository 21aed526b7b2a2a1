// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Caches and blend shapes, and the order of the deformers.
#include "Deformation.h"

#include "calls/LastError.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <limits>
#include <string>
#include <string_view>
#include <utility>

namespace Tarnell::Fbx::faithful {

namespace {

using Deformer = fbxsdk::FbxDeformer;
using Point = fbxsdk::FbxVector4;
using fbxsdk::FbxTime;

/// Keeps a cache's file open for the lifetime of the object.
class OpenCache {
public:
    explicit OpenCache(fbxsdk::FbxCache& cache) : mCache(cache), mOpen(cache.OpenFileForRead()) {}
    ~OpenCache() {
        if (mOpen)
            mCache.CloseFile();
    }
    OpenCache(const OpenCache&) = delete;
    OpenCache& operator=(const OpenCache&) = delete;
    bool isOpen() const { return mOpen; }

private:
    fbxsdk::FbxCache& mCache;
    bool mOpen;
};

/// Maya does not state what a channel holds; its exporter names channels of normals so.
constexpr std::string_view kNormalsEnding = "_normals";

int typeOf(const fbxsdk::FbxVertexCacheDeformer& deformer) {
    const fbxsdk::FbxString channel = deformer.Channel.Get();
    const std::string_view name(channel.Buffer());
    const bool normals =
        name.size() > kNormalsEnding.size() && name.substr(name.size() - kNormalsEnding.size()) == kNormalsEnding;
    const int type = deformer.Type.Get();
    return normals && type == fbxsdk::FbxVertexCacheDeformer::ePositions ? fbxsdk::FbxVertexCacheDeformer::eNormals
                                                                         : type;
}

/// The first one that holds the requested data.
fbxsdk::FbxVertexCacheDeformer* activeCacheOf(const fbxsdk::FbxMesh& mesh, int type) {
    for (int i = 0; i < mesh.GetDeformerCount(Deformer::eVertexCache); ++i) {
        auto* deformer = fbxsdk::FbxCast<fbxsdk::FbxVertexCacheDeformer>(mesh.GetDeformer(i, Deformer::eVertexCache));
        if (deformer != nullptr && deformer->Active.Get() && deformer->GetCache() != nullptr &&
            typeOf(*deformer) == type)
            return deformer;
    }
    return nullptr;
}

bool readMayaCache(fbxsdk::FbxCache& cache, const fbxsdk::FbxString& channelName, FbxTime time,
                   std::vector<double>& buffer) {
    const int channel = cache.GetChannelIndex(channelName);
    return channel >= 0 && cache.Read(channel, time, buffer.data(), static_cast<unsigned int>(buffer.size() / 3));
}

/// Linear interpolation between two frames; those before frame 0 are passed as unsigned numbers, too.
bool readMaxCache(fbxsdk::FbxCache& cache, double frame, std::vector<double>& buffer) {
    constexpr double most = std::numeric_limits<int>::max() - 1;
    const double held = std::fmin(std::fmax(frame, -most), most);
    const double whole = std::floor(held + 1e-4);
    const double rest = std::fmax(held - whole, 0.0);
    const auto points = static_cast<unsigned int>(buffer.size() / 3);
    const auto number = static_cast<unsigned int>(static_cast<int>(whole));
    if (!cache.Read(number, buffer.data(), points))
        return false;
    if (rest < 1e-4)
        return true;
    std::vector<double> next(buffer.size());
    if (!cache.Read(number + 1, next.data(), points))
        return false;
    for (std::size_t i = 0; i < buffer.size(); ++i)
        buffer[i] += (next[i] - buffer[i]) * rest;
    return true;
}

// ---- Blend shapes ----

constexpr double kFullPercent = 100.0;

/// The effective percentage of a channel's target.
struct TargetShare {
    int target;
    double share;
};

/// A weight and the target that is fully reached there; −1 is the mesh itself.
using Knot = std::pair<double, int>;

/// In the order of their weights, with the mesh itself at 0.
std::vector<Knot> knotsOf(fbxsdk::FbxBlendShapeChannel& channel) {
    const int count = channel.GetTargetShapeCount();
    const double* full = count > 0 ? channel.GetTargetShapeFullWeights() : nullptr;
    std::vector<Knot> knots = {{0.0, -1}};
    for (int i = 0; full != nullptr && i < count; ++i) {
        // A target at 0 would always be fully reached: some exporters write weights of points here.
        knots.emplace_back(full[i] != 0.0 ? full[i] : kFullPercent, i);
    }
    std::stable_sort(knots.begin(), knots.end(), [](const Knot& a, const Knot& b) { return a.first < b.first; });
    return knots;
}

/// The two targets that a weight lies between; beyond the ends it is extrapolated.
std::array<TargetShare, 2> sharesAt(fbxsdk::FbxBlendShapeChannel& channel, double weight) {
    const std::vector<Knot> knots = knotsOf(channel);
    std::size_t upper = 1;
    while (upper + 1 < knots.size() && weight > knots[upper].first)
        ++upper;
    if (upper >= knots.size())
        return {TargetShare{-1, 1.0}, TargetShare{-1, 0.0}};
    const auto [below, lowerTarget] = knots[upper - 1];
    const auto [above, upperTarget] = knots[upper];
    const double share = above > below ? (weight - below) / (above - below) : 1.0;
    return {TargetShare{lowerTarget, 1.0 - share}, TargetShare{upperTarget, share}};
}

bool addTarget(const fbxsdk::FbxShape& shape, const std::vector<Point>& base, double share,
               std::vector<Point>& points) {
    const Point* target = shape.GetControlPoints();
    const auto count = static_cast<std::size_t>(std::max(shape.GetControlPointsCount(), 0));
    if (target == nullptr || share == 0.0)
        return false;
    for (std::size_t i = 0; i < std::min(count, points.size()); ++i)
        for (int axis = 0; axis < 3; ++axis)
            points[i][axis] += (target[i][axis] - base[i][axis]) * share;
    return true;
}

} // namespace

bool applyPointCache(Scene& scene, fbxsdk::FbxNode& node, fbxsdk::FbxMesh& mesh, const FbxTime& time,
                     std::vector<Point>& points) {
    fbxsdk::FbxVertexCacheDeformer* deformer = activeCacheOf(mesh, fbxsdk::FbxVertexCacheDeformer::ePositions);
    if (deformer == nullptr)
        return false;
    fbxsdk::FbxCache& cache = *deformer->GetCache();
    const OpenCache open(cache);
    std::vector<double> buffer(points.size() * 3);
    const bool maya = cache.GetCacheFileFormat() == fbxsdk::FbxCache::eMayaCache;
    const bool read = open.isOpen() && (maya ? readMayaCache(cache, deformer->Channel.Get(), time, buffer)
                                             : readMaxCache(cache, time.GetSecondDouble() * scene.fileRate(), buffer));
    if (!read) {
        detail::warn(scene.fileName() + ": the point cache of \"" + node.GetName() +
                     "\" cannot be read; the mesh is read without it");
        return false;
    }
    for (std::size_t i = 0; i < points.size(); ++i)
        for (int axis = 0; axis < 3; ++axis)
            points[i][axis] = buffer[3 * i + static_cast<std::size_t>(axis)];
    return true;
}

std::vector<Point> cachedNormals(const fbxsdk::FbxMesh& mesh, const FbxTime& time) {
    fbxsdk::FbxVertexCacheDeformer* deformer = activeCacheOf(mesh, fbxsdk::FbxVertexCacheDeformer::eNormals);
    if (deformer == nullptr || deformer->GetCache()->GetCacheFileFormat() != fbxsdk::FbxCache::eMayaCache)
        return {};
    const OpenCache open(*deformer->GetCache());
    std::vector<double> buffer(static_cast<std::size_t>(std::max(mesh.GetPolygonVertexCount(), 0)) * 3);
    std::vector<Point> normals;
    if (open.isOpen() && readMayaCache(*deformer->GetCache(), deformer->Channel.Get(), time, buffer)) {
        normals.reserve(buffer.size() / 3);
        for (std::size_t i = 0; i + 2 < buffer.size(); i += 3)
            normals.emplace_back(buffer[i], buffer[i + 1], buffer[i + 2]);
    }
    return normals;
}

bool applyBlendShapes(fbxsdk::FbxMesh& mesh, const FbxTime& time, std::vector<Point>& points) {
    if (mesh.GetShapeCount() == 0)
        return false;
    const std::vector<Point> base = points;
    bool moved = false;
    for (int i = 0; i < mesh.GetDeformerCount(Deformer::eBlendShape); ++i) {
        auto* blendShape = fbxsdk::FbxCast<fbxsdk::FbxBlendShape>(mesh.GetDeformer(i, Deformer::eBlendShape));
        for (int c = 0; blendShape != nullptr && c < blendShape->GetBlendShapeChannelCount(); ++c) {
            fbxsdk::FbxBlendShapeChannel* channel = blendShape->GetBlendShapeChannel(c);
            if (channel == nullptr)
                continue;
            for (const TargetShare& part : sharesAt(*channel, channel->DeformPercent.EvaluateValue(time))) {
                const fbxsdk::FbxShape* shape = part.target >= 0 ? channel->GetTargetShape(part.target) : nullptr;
                moved = (shape != nullptr && addTarget(*shape, base, part.share, points)) || moved;
            }
        }
    }
    return moved;
}

DeformedMesh deformedPoints(Scene& scene, fbxsdk::FbxNode& node, fbxsdk::FbxMesh& mesh, const FbxTime& time) {
    DeformedMesh deformed;
    const auto count = static_cast<std::size_t>(std::max(mesh.GetControlPointsCount(), 0));
    deformed.points.reserve(count);
    for (std::size_t i = 0; i < count; ++i)
        deformed.points.push_back(mesh.GetControlPointAt(static_cast<int>(i)));
    if (count > 0 && applyPointCache(scene, node, mesh, time, deformed.points)) {
        deformed.normals = cachedNormals(mesh, time);
        deformed.reshaped = deformed.normals.empty();
        return deformed;
    }
    const bool shaped = applyBlendShapes(mesh, time, deformed.points);
    deformed.inWorld = applySkins(node, mesh, time, deformed);
    deformed.reshaped = shaped || deformed.inWorld;
    return deformed;
}

} // namespace Tarnell::Fbx::faithful
