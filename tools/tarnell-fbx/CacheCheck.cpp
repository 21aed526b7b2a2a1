// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The same steps as in reading meshes: open the file, find the channel, read the points of each frame. The first
// failing step gives the reason.
#include "CacheCheck.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <vector>

namespace tool {
namespace {

/// The check takes little time, also for a very long cache.
constexpr std::int64_t kMostSamplesRead = 1000;

/// Open for the lifetime of the object.
class OpenCache {
public:
    explicit OpenCache(FbxCache& cache) : mCache(cache), mIsOpen(cache.OpenFileForRead(&mStatus)) {}
    ~OpenCache() {
        if (mIsOpen)
            mCache.CloseFile();
    }
    OpenCache(const OpenCache&) = delete;
    OpenCache& operator=(const OpenCache&) = delete;

    [[nodiscard]] bool isOpen() const { return mIsOpen; }
    [[nodiscard]] std::string fault() const { return mStatus.GetErrorString(); }

private:
    FbxCache& mCache;
    FbxStatus mStatus;
    bool mIsOpen;
};

std::string channelList(FbxCache& cache) {
    std::string list;
    for (int i = 0; i < cache.GetChannelCount(); ++i) {
        FbxString name;
        if (cache.GetChannelName(i, name))
            list += std::string(list.empty() ? "" : ", ") + '"' + name.Buffer() + '"';
    }
    return list.empty() ? "none" : list;
}

bool allFinite(const std::vector<double>& numbers) {
    return std::all_of(
        numbers.begin(), numbers.end(), [](double number) { return std::isfinite(number); });
}

std::string atFrame(std::int64_t frame, const std::string& fault) {
    return "frame " + std::to_string(frame) + ": " + fault;
}

constexpr const char* kNotFinite = "points that are not finite";

std::string mayaFault(FbxCache& cache, const char* channelName, unsigned int pointCount, FbxTime::EMode mode) {
    const int channel = cache.GetChannelIndex(channelName);
    if (channel < 0)
        return std::string("it has no channel \"") + channelName + "\"; its channels: " + channelList(cache);
    FbxStatus status;
    FbxTime start, stop;
    if (!cache.GetAnimationRange(channel, start, stop, &status))
        return status.GetErrorString();
    const std::int64_t step = std::max<std::int64_t>(cache.GetCacheTimePerFrame().Get(), 1);
    const std::int64_t samples = std::min((stop.Get() - start.Get()) / step + 1, kMostSamplesRead);
    std::vector<double> points(std::size_t{pointCount} * 3);
    for (std::int64_t i = 0; i < samples; ++i) {
        FbxTime time(start.Get() + i * step);
        if (!cache.Read(channel, time, points.data(), pointCount, &status))
            return atFrame(time.GetFrameCount(mode), status.GetErrorString());
        if (!allFinite(points))
            return atFrame(time.GetFrameCount(mode), kNotFinite);
    }
    return {};
}

std::string maxFault(FbxCache& cache, unsigned int pointCount) {
    if (cache.GetPointCount() != pointCount)
        return "it has " + std::to_string(cache.GetPointCount()) + " points, but the mesh has " +
               std::to_string(pointCount);
    // Frames before zero cannot be requested.
    constexpr double kLargestFrame = INT32_MAX;
    const auto first =
        static_cast<std::int64_t>(std::clamp(std::ceil(cache.GetFrameStartOffset()), 0.0, kLargestFrame));
    const std::int64_t samples = std::min<std::int64_t>(cache.GetSampleCount(), kMostSamplesRead);
    std::vector<double> points(std::size_t{pointCount} * 3);
    for (std::int64_t i = 0; i < samples && first + i <= INT32_MAX; ++i) {
        FbxStatus status;
        if (!cache.Read(static_cast<unsigned int>(first + i), points.data(), pointCount, &status))
            return atFrame(first + i, status.GetErrorString());
        if (!allFinite(points))
            return atFrame(first + i, kNotFinite);
    }
    return {};
}

} // namespace

std::string cacheFault(FbxMesh& mesh) {
    auto* deformer = FbxCast<FbxVertexCacheDeformer>(mesh.GetDeformer(0, FbxDeformer::eVertexCache));
    if (!deformer)
        return {};
    if (!deformer->Active.Get())
        return "it is switched off";
    FbxCache* cache = deformer->GetCache();
    if (!cache)
        return "the file does not specify a cache";
    const OpenCache open(*cache);
    if (!open.isOpen())
        return open.fault();
    if (mesh.GetControlPointsCount() < 1)
        return "the mesh has no points";
    const auto pointCount = static_cast<unsigned int>(mesh.GetControlPointsCount());
    if (cache->GetCacheFileFormat() != FbxCache::eMayaCache)
        return maxFault(*cache, pointCount);
    const FbxString channel = deformer->Channel.Get();
    return mayaFault(*cache, channel.Buffer(), pointCount, mesh.GetScene()->GetGlobalSettings().GetTimeMode());
}

} // namespace tool
