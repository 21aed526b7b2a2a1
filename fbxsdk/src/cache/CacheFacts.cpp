// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The content of point caches, damaged ones included: reading goes on after a fault.
#include <fbxsdk/extensions/CacheFacts.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <filesystem>
#include <optional>
#include <string_view>
#include <system_error>
#include <unordered_map>

#include <fbxsdk/FbxScene.h>

#include "cache/CacheSearch.h"
#include "cache/MayaCache.h"
#include "container/ByteOrder.h"
#include "container/FileBytes.h"
#include "scene/SceneData.h"

FBXSDK_NAMESPACE_BEGIN
namespace extensions {
namespace {

using detail::FileBytes;

/// The file with all of its bytes in memory; null, and the reason in the status, when it cannot be read.
std::shared_ptr<const FileBytes> wholeFile(const std::string& name, FbxStatus& status) {
    auto file = FileBytes::open(name, status);
    const bool read = file && detail::faultToStatus(status, [&file] {
                          file->fetch(file->bytes());
                          return true;
                      });
    return read ? file : nullptr;
}

constexpr std::string_view kMaxMagic("POINTCACHE2\0", 12);
constexpr std::size_t kMaxHeaderBytes = 32;

/// The byte offset of the first number that is NaN or infinite.
template <class Number>
std::optional<std::size_t> firstNotFinite(std::span<const char> bytes, bool swap) {
    for (std::size_t at = 0; at + sizeof(Number) <= bytes.size(); at += sizeof(Number))
        if (!std::isfinite(detail::loadNumber<Number>(bytes.data() + at, swap)))
            return at;
    return {};
}

/// A limit on the memory for fault texts, each of which may contain the name of a channel.
constexpr std::size_t kMostFaults = 1000;

/// Adds a fault unless there are enough; the last one says so.
void addFault(CacheFacts& facts, const std::string& file, std::uint64_t offset, const std::string& reason) {
    if (facts.faults.size() < kMostFaults) {
        const bool isLast = facts.faults.size() + 1 == kMostFaults;
        facts.faults.push_back({file, offset, isLast ? reason + "; further ones are not listed" : reason});
    }
}

/// The length of a name is taken from the file and is arbitrary.
std::string channelText(std::string_view name) {
    constexpr std::size_t kMostBytes = 200;
    const bool isWhole = name.size() <= kMostBytes;
    return "channel " + std::string(name.substr(0, kMostBytes)) + (isWhole ? "" : "…");
}

std::string pointsOf(std::uint64_t count) { return std::to_string(count) + (count == 1 ? " point" : " points"); }

// ---- Maya ----

class MayaInspection {
public:
    MayaInspection(CacheFacts& facts, bool verify) : mFacts(facts), mVerify(verify) {}

    bool readDescribed(const std::string& descriptionFile, FbxStatus& status) {
        if (!detail::readMayaCacheDescription(descriptionFile, mDescription, status))
            return false;
        mFacts.description = descriptionFile;
        mFacts.oneFile = mDescription.oneFile;
        mFacts.wide = mDescription.wide;
        takeChannels();
        const std::string base = detail::mayaCacheBase(descriptionFile);
        if (mDescription.oneFile)
            readFile(base + mDescription.dataExtension(), {});
        else
            for (const auto& [ticks, file] : detail::mayaFrameFiles(base, mDescription))
                readFile(file, ticks);
        finish();
        const auto times = sampleTimes();
        for (const detail::MayaCacheChannel& channel : mDescription.channels) {
            const auto found = times.find(channel.name);
            checkTimes(channel, found != times.end() ? found->second : std::vector<double>());
        }
        return true;
    }

    /// A data file without description, which would state the frame rate.
    void readAlone(const std::string& dataFile, bool wide) {
        mFacts.wide = wide;
        readFile(dataFile, {});
        finish();
        if (!mFacts.samples.empty()) {
            mFacts.start = mFacts.samples.front().frame;
            mFacts.end = mFacts.samples.back().frame;
        }
    }

private:
    [[nodiscard]] double frameOf(double ticks) const { return ticks / mDescription.ticksPerFrame; }

    void fault(const std::string& file, std::uint64_t offset, const std::string& reason) {
        addFault(mFacts, file, offset, reason);
    }

    void takeChannels() {
        mFacts.frameRate = static_cast<double>(detail::kMayaTicksPerSecond) / mDescription.ticksPerFrame;
        mFacts.start = frameOf(mDescription.start);
        mFacts.end = frameOf(mDescription.end);
        for (const detail::MayaCacheChannel& channel : mDescription.channels) {
            mFacts.channels.push_back({channel.name, channel.type, channel.interpretation, channel.regular,
                                       frameOf(channel.samplingRate), frameOf(channel.start), frameOf(channel.end)});
        }
    }

    void readFile(const std::string& name, std::optional<std::int32_t> ticks) {
        FbxStatus status;
        const auto file = wholeFile(name, status);
        if (!file) {
            fault(name, 0, status.GetErrorString());
            return;
        }
        mFacts.fileNames.push_back(name);
        mFacts.bytes += file->bytes().size();
        const detail::MayaCacheData data = detail::parseMayaCacheData(file->bytes());
        if (data.end < file->bytes().size())
            fault(name, data.end, "truncated or damaged");
        if (data.frames.empty())
            fault(name, 0, "no samples");
        for (const detail::MayaCacheFrame& frame : data.frames) {
            const std::int32_t stated = frame.hasTime ? frame.ticks : mDescription.start;
            addSamples(file->bytes(), frame, ticks.value_or(stated));
            if (ticks) // readers take the first sample of such a file
                break;
        }
    }

    std::uint32_t channelIndex(std::string_view name) {
        const auto next = static_cast<std::uint32_t>(mFacts.channelNames.size());
        const auto [place, isNew] = mChannelIndices.try_emplace(std::string(name), next);
        if (isNew)
            mFacts.channelNames.emplace_back(name);
        return place->second;
    }

    void addSamples(std::span<const char> bytes, const detail::MayaCacheFrame& frame, std::int32_t ticks) {
        const auto file = static_cast<std::uint32_t>(mFacts.fileNames.size() - 1);
        for (const detail::MayaCacheBlock& block : frame.blocks) {
            const auto offset = static_cast<std::uint64_t>(block.bytes.data() - bytes.data());
            mFacts.samples.push_back({frameOf(ticks), file, channelIndex(block.channel), block.elementCount, offset,
                                      block.bytes.size(), static_cast<std::uint8_t>(block.componentCount),
                                      block.doubles});
            if (mVerify)
                checkNumbers(mFacts.fileNames.back(), offset, block);
        }
    }

    void checkNumbers(const std::string& file, std::uint64_t offset, const detail::MayaCacheBlock& block) {
        constexpr bool kSwap = detail::needsSwap(/*bigEndian=*/true);
        const auto bad =
            block.doubles ? firstNotFinite<double>(block.bytes, kSwap) : firstNotFinite<float>(block.bytes, kSwap);
        if (bad)
            fault(file, offset + *bad, channelText(block.channel) + ": a number that is not finite");
    }

    void finish() {
        auto& samples = mFacts.samples;
        std::stable_sort(samples.begin(), samples.end(),
                         [](const CacheSampleFacts& a, const CacheSampleFacts& b) { return a.frame < b.frame; });
        checkCounts();
    }

    /// All samples of a channel have as many points as its first.
    void checkCounts() {
        std::vector<std::optional<std::uint64_t>> counts(mFacts.channelNames.size());
        for (const CacheSampleFacts& sample : mFacts.samples) {
            std::optional<std::uint64_t>& first = counts[sample.channel];
            if (!first)
                first = sample.count;
            if (*first != sample.count)
                fault(mFacts.fileNames[sample.file], sample.offset,
                      channelText(mFacts.channelNames[sample.channel]) + ": " + pointsOf(sample.count) +
                          ", but its first sample has " + std::to_string(*first));
        }
    }

    /// The frames at which each channel has samples, in order.
    [[nodiscard]] std::unordered_map<std::string_view, std::vector<double>> sampleTimes() const {
        std::unordered_map<std::string_view, std::vector<double>> times;
        for (const CacheSampleFacts& sample : mFacts.samples)
            times[mFacts.channelNames[sample.channel]].push_back(sample.frame);
        return times;
    }

    /// Checks that the channel has a sample at every time of the description.
    void checkTimes(const detail::MayaCacheChannel& channel, const std::vector<double>& frames) {
        if (frames.empty()) {
            fault(mFacts.description, 0, channelText(channel.name) + ": no samples");
            return;
        }
        if (!channel.regular || channel.samplingRate < 1)
            return;
        constexpr std::size_t kMostMissing = 100;
        std::size_t missing = 0;
        const double close = frameOf(1) / 2;
        for (std::int64_t ticks = channel.start; ticks <= channel.end && missing < kMostMissing;
             ticks += channel.samplingRate) {
            const double frame = frameOf(static_cast<double>(ticks));
            const auto near = std::lower_bound(frames.begin(), frames.end(), frame - close);
            if (near != frames.end() && *near <= frame + close)
                continue;
            ++missing;
            char text[32];
            std::snprintf(text, sizeof text, "%.6g", frame);
            fault(mFacts.description, 0,
                  channelText(channel.name) + ": no sample at frame " + text +
                      (missing == kMostMissing ? "; further ones are not listed" : ""));
        }
    }

    CacheFacts& mFacts;
    bool mVerify;
    detail::MayaCacheDescription mDescription;
    std::unordered_map<std::string, std::uint32_t> mChannelIndices;
};

// ---- Max ----

void readMaxFacts(const std::string& name, std::span<const char> bytes, bool verify, CacheFacts& facts) {
    constexpr bool kSwap = detail::needsSwap(/*bigEndian=*/false);
    facts.format = FbxCache::eMaxPointCacheV2;
    facts.fileNames = {name};
    facts.channelNames = {""};
    facts.bytes = bytes.size();
    const auto fault = [&](std::uint64_t offset, const std::string& reason) { addFault(facts, name, offset, reason); };
    if (bytes.size() < kMaxHeaderBytes) {
        fault(bytes.size(), "the file ends within its header of 32 bytes");
        return;
    }
    const auto points = detail::loadNumber<std::int32_t>(bytes.data() + 16, kSwap);
    const auto start = static_cast<double>(detail::loadNumber<float>(bytes.data() + 20, kSwap));
    const auto samples = detail::loadNumber<std::int32_t>(bytes.data() + 28, kSwap);
    facts.framesPerSample = static_cast<double>(detail::loadNumber<float>(bytes.data() + 24, kSwap));
    facts.statedSamples = samples > 0 ? static_cast<std::uint64_t>(samples) : 0;
    if (points < 1)
        fault(16, "a cache of " + std::to_string(points) + " points");
    if (samples < 1)
        fault(28, "a cache of " + std::to_string(samples) + " samples");
    if (!std::isfinite(start))
        fault(20, "a start frame that is not finite");
    // Above one, some writers mean the frames per second.
    const bool isStep = facts.framesPerSample > 0.0 && facts.framesPerSample <= 1.0;
    const double step = isStep ? facts.framesPerSample : 1.0;
    if (!isStep)
        fault(24, "frames per sample must be above 0 and at most 1; readers assume one frame per sample");
    facts.start = std::isfinite(start) ? start : 0.0;
    facts.end = facts.start + static_cast<double>(facts.statedSamples > 0 ? facts.statedSamples - 1 : 0) * step;
    if (points < 1)
        return;

    const std::uint64_t sampleBytes = static_cast<std::uint64_t>(points) * 12;
    const std::uint64_t complete = std::min(facts.statedSamples, (bytes.size() - kMaxHeaderBytes) / sampleBytes);
    for (std::uint64_t i = 0; i < complete; ++i) {
        const std::uint64_t offset = kMaxHeaderBytes + i * sampleBytes;
        facts.samples.push_back({facts.start + static_cast<double>(i) * step, 0, 0, static_cast<std::uint64_t>(points),
                                 offset, sampleBytes, 3, /*doubles=*/false});
        const auto bad = verify ? firstNotFinite<float>(bytes.subspan(offset, sampleBytes), kSwap) : std::nullopt;
        if (bad)
            fault(offset + *bad, "a number that is not finite");
    }
    if (complete < facts.statedSamples) {
        fault(kMaxHeaderBytes + complete * sampleBytes, "truncated: " + std::to_string(facts.statedSamples - complete) +
                                                            " of " + std::to_string(facts.statedSamples) +
                                                            " samples are missing");
    } else if (kMaxHeaderBytes + complete * sampleBytes < bytes.size()) {
        fault(kMaxHeaderBytes + complete * sampleBytes,
              std::to_string(bytes.size() - kMaxHeaderBytes - complete * sampleBytes) + " bytes after the last sample");
    }
}

// ---- Detecting the kind ----

/// The description that a data file belongs to: that of its own name, or without "Frame12" at the end.
std::string descriptionOf(const std::string& dataFile) {
    std::string base = detail::mayaCacheBase(dataFile);
    std::error_code ignored;
    if (std::filesystem::exists(base + ".xml", ignored))
        return base + ".xml";
    const std::size_t frame = base.rfind("Frame");
    if (frame == std::string::npos)
        return {};
    base.resize(frame);
    return std::filesystem::exists(base + ".xml", ignored) ? base + ".xml" : std::string();
}

} // namespace

bool readCacheFacts(const char* fileName, bool verify, CacheFacts& facts, FbxStatus& status) {
    facts = {};
    const std::string name = fileName ? fileName : "";
    const auto file = wholeFile(name, status);
    if (!file)
        return false;
    const std::string_view text(file->bytes().data(), file->bytes().size());
    if (text.starts_with(kMaxMagic)) {
        readMaxFacts(name, file->bytes(), verify, facts);
        return true;
    }
    facts.format = FbxCache::eMayaCache;
    MayaInspection inspection(facts, verify);
    const bool isData = text.starts_with("FOR4") || text.starts_with("FOR8");
    const std::string description = isData ? descriptionOf(name) : name;
    if (!description.empty())
        return inspection.readDescribed(description, status);
    inspection.readAlone(name, text.starts_with("FOR8"));
    return true;
}

std::vector<std::string> cachePlaces(const FbxCache& cache) {
    FbxString relative, absolute;
    cache.GetCacheFileName(relative, absolute);
    const FbxScene* scene = cache.GetScene();
    return detail::cacheFileCandidates(scene ? scene->sceneData().fileName() : std::string(), relative.Buffer(),
                                       absolute.Buffer());
}

} // namespace extensions
FBXSDK_NAMESPACE_END
