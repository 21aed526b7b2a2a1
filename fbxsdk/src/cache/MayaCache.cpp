// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reading samples of Maya caches by time, and appending samples.
#include "cache/MayaCache.h"

#include <algorithm>
#include <cerrno>
#include <charconv>
#include <cmath>
#include <filesystem>
#include <new>

#include <dirent.h>

#include "cache/SampleCheck.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

namespace fs = std::filesystem;

/// The names in a folder; none when it cannot be read. Not std::filesystem's iterator, which terminates the process
/// when memory runs out.
class Folder {
public:
    explicit Folder(const char* path) : mFolder(::opendir(path)) {
        if (!mFolder && errno == ENOMEM)
            throw std::bad_alloc();
    }
    Folder(const Folder&) = delete;
    Folder& operator=(const Folder&) = delete;
    ~Folder() {
        if (mFolder)
            ::closedir(mFolder);
    }
    /// Null after the last one.
    [[nodiscard]] const char* next() {
        const dirent* const entry = mFolder ? ::readdir(mFolder) : nullptr;
        return entry ? entry->d_name : nullptr;
    }

private:
    DIR* mFolder;
};

constexpr std::string_view kFloatVectors = "FloatVectorArray";

/// The number at the front of the text, which is removed from it. False when there is none.
bool takeNumber(std::string_view& text, std::int64_t& number) {
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (error != std::errc())
        return false;
    text.remove_prefix(static_cast<std::size_t>(end - text.data()));
    return true;
}

/// "<base>Frame12" or "<base>Frame12Tick80" → ticks.
bool frameFileTicks(std::string_view name, std::string_view base, std::int64_t ticksPerFrame, std::int32_t& ticks) {
    constexpr std::string_view kFrame = "Frame", kTick = "Tick";
    if (!name.starts_with(base))
        return false;
    name.remove_prefix(base.size());
    if (!name.starts_with(kFrame))
        return false;
    name.remove_prefix(kFrame.size());
    std::int64_t frame = 0, tick = 0;
    if (!takeNumber(name, frame))
        return false;
    if (name.starts_with(kTick)) {
        name.remove_prefix(kTick.size());
        if (!takeNumber(name, tick))
            return false;
    }
    constexpr std::int64_t kMaximumFrame = 1 << 20;
    if (!name.empty() || std::abs(frame) > kMaximumFrame || tick < 0 || tick >= ticksPerFrame)
        return false;
    const std::int64_t all = frame * ticksPerFrame + tick;
    if (std::abs(all) > INT32_MAX)
        return false;
    ticks = static_cast<std::int32_t>(all);
    return true;
}

} // namespace

std::string mayaCacheBase(const std::string& descriptionFile) {
    fs::path path(descriptionFile);
    return path.replace_extension().string();
}

std::map<std::int32_t, std::string> mayaFrameFiles(const std::string& base, const MayaCacheDescription& description) {
    std::map<std::int32_t, std::string> files;
    const fs::path basePath(base);
    const fs::path folder = basePath.parent_path().empty() ? "." : basePath.parent_path();
    Folder entries(folder.c_str());
    while (const char* name = entries.next()) {
        const fs::path file(name);
        std::int32_t ticks = 0;
        if (file.extension() != description.dataExtension())
            continue;
        if (frameFileTicks(file.stem().string(), basePath.filename().string(), description.ticksPerFrame, ticks))
            files.try_emplace(ticks, (folder / file).string());
    }
    return files;
}

std::unique_ptr<MayaCacheReader> MayaCacheReader::open(const std::string& descriptionFile, FbxStatus& status) {
    auto reader = std::make_unique<MayaCacheReader>();
    if (!readMayaCacheDescription(descriptionFile, reader->mDescription, status))
        return nullptr;
    const std::string base = mayaCacheBase(descriptionFile);
    if (reader->mDescription.oneFile)
        reader->openOneFile(base, status);
    else
        for (auto& [ticks, file] : mayaFrameFiles(base, reader->mDescription))
            reader->mSamples.try_emplace(ticks, Sample{std::move(file), {}});
    if (!reader->mSamples.empty())
        return reader;
    if (!status.Error())
        status.SetCode(FbxStatus::eInvalidFile, "%s: no samples in its data files", descriptionFile.c_str());
    return nullptr;
}

void MayaCacheReader::openOneFile(const std::string& base, FbxStatus& status) {
    const std::string file = base + mDescription.dataExtension();
    mData = FileBytes::open(file, status);
    if (!mData)
        return;
    MayaCacheData data = parseMayaCacheData(mData->bytes(), mData.get());
    // Samples that are missing would be read as the last one that exists.
    if (data.end < mData->bytes().size()) {
        status.SetCode(FbxStatus::eInvalidFile, "%s: offset %zu: truncated or damaged", file.c_str(), data.end);
        return;
    }
    for (MayaCacheFrame& frame : data.frames) {
        const std::int32_t ticks = frame.hasTime ? frame.ticks : mDescription.start;
        mSamples.try_emplace(ticks, Sample{{}, std::move(frame)}); // of equal times the first counts
    }
}

bool MayaCacheReader::readSample(const Sample& sample, const std::string& channel, std::span<double> points,
                                 FbxStatus& status) {
    std::shared_ptr<const FileBytes> file = mData;
    std::vector<MayaCacheFrame> frames;
    const MayaCacheFrame* frame = &sample.frame;
    if (!sample.file.empty()) {
        file = FileBytes::open(sample.file, status);
        if (!file)
            return false;
        frames = parseMayaCacheData(file->bytes(), file.get()).frames;
        if (frames.empty()) {
            status.SetCode(FbxStatus::eInvalidFile, "%s: no samples", sample.file.c_str());
            return false;
        }
        frame = &frames.front();
    }
    for (const MayaCacheBlock& block : frame->blocks) {
        if (block.channel != channel)
            continue;
        if (readMayaCacheBlock(block, points, file.get()))
            return true;
        status.SetCode(FbxStatus::eInvalidParameter, "channel %s has %llu points, not %zu", channel.c_str(),
                       static_cast<unsigned long long>(block.elementCount), points.size() / 3);
        return false;
    }
    status.SetCode(FbxStatus::eInvalidFile, "the sample has no channel %s", channel.c_str());
    return false;
}

bool MayaCacheReader::read(const std::string& channel, double seconds, std::span<double> points, FbxStatus& status) {
    const double ticks = seconds * kMayaTicksPerSecond;
    if (std::isnan(ticks))
        return false;
    const auto after =
        mSamples.upper_bound(static_cast<std::int32_t>(std::clamp(std::floor(ticks), -2147483648.0, 2147483647.0)));
    if (after == mSamples.begin())
        return readSample(after->second, channel, points, status);
    const auto before = std::prev(after);
    if (!readSample(before->second, channel, points, status))
        return false;
    if (after == mSamples.end())
        return true;

    const double span = static_cast<double>(after->first) - static_cast<double>(before->first);
    const double part = (ticks - static_cast<double>(before->first)) / span;
    // Times come in single precision: within this tolerance of a sample they mean that sample.
    constexpr double kSameSample = 1e-3;
    if (part * span < kSameSample)
        return true;
    std::vector<double> next(points.size());
    if (!readSample(after->second, channel, next, status))
        return false;
    for (std::size_t i = 0; i < points.size(); ++i)
        points[i] += part * (next[i] - points[i]);
    return true;
}

bool MayaCacheReader::sampleRange(std::int32_t& first, std::int32_t& last) const {
    if (mSamples.empty())
        return false;
    first = mSamples.begin()->first;
    last = mSamples.rbegin()->first;
    return true;
}

MayaCacheWriter::MayaCacheWriter(const std::string& descriptionFile, const MayaCacheDescription& description,
                                 FileOperations& operations)
    : mDataFile(mayaCacheBase(descriptionFile) + description.dataExtension()), mDescription(description),
      mData(mDataFile, operations), mText(descriptionFile, operations) {}

std::unique_ptr<MayaCacheWriter> MayaCacheWriter::open(const std::string& descriptionFile,
                                                       const MayaCacheDescription& description, FbxStatus& status,
                                                       FileOperations& operations) {
    auto writer = std::make_unique<MayaCacheWriter>(descriptionFile, description, operations);
    if (writer->mDataFile == descriptionFile) {
        status.SetCode(FbxStatus::eInvalidParameter, "the cache description has the name of its data file");
        return nullptr;
    }
    for (OutputFile* const file : {&writer->mData, &writer->mText}) {
        if (!file->open(status)) {
            status.SetCode(FbxStatus::eFailure, "%s", file->reason().c_str());
            return nullptr;
        }
    }
    // As other writers of one-file caches do: the actual range is in the description.
    writer->mData.write(mayaCacheHeader(description.wide, 0, 1));
    return writer;
}

const char* MayaCacheWriter::faultOf(const MayaCacheChannel& channel, double seconds,
                                     std::span<const double> points) const {
    if (!(std::abs(seconds * kMayaTicksPerSecond) <= static_cast<double>(INT32_MAX)))
        return "a sample is at a time that Maya caches cannot store";
    if (channel.name.size() > kMostMayaChannelName)
        return "a channel name is too long";
    const bool doubles = channel.type != kFloatVectors;
    if (const char* fault = mayaCacheSampleFault(mDescription.wide, points.size() / 3, doubles))
        return fault;
    return sampleFault(points, /*asFloats=*/!doubles);
}

bool MayaCacheWriter::failed(FbxStatus& status) const {
    if (mFault)
        status.SetCode(FbxStatus::eFailure, "%s: cannot be written: %s", mDataFile.c_str(), mFault);
    else if (mData.failed())
        mData.report(status);
    return mFault || mData.failed();
}

bool MayaCacheWriter::write(std::size_t channel, double seconds, std::span<const double> points, FbxStatus& status) {
    if (failed(status))
        return false;
    if (channel >= mDescription.channels.size()) {
        status.SetCode(FbxStatus::eIndexOutOfRange, "%s: there is no channel with that index", mDataFile.c_str());
        return false;
    }
    MayaCacheChannel& target = mDescription.channels[channel];
    mFault = faultOf(target, seconds, points);
    if (failed(status))
        return false;
    const auto ticks = static_cast<std::int32_t>(std::round(seconds * kMayaTicksPerSecond));
    const MayaCacheWriteBlock block{target.name, points, target.type != kFloatVectors};
    mData.write(mayaCacheFrame(mDescription.wide, &ticks, {&block, 1}));
    extendRange(target, ticks);
    return !failed(status);
}

void MayaCacheWriter::extendRange(MayaCacheChannel& channel, std::int32_t ticks) {
    for (auto* start : {&mDescription.start, &channel.start})
        *start = mAnySample ? std::min(*start, ticks) : ticks;
    for (auto* end : {&mDescription.end, &channel.end})
        *end = mAnySample ? std::max(*end, ticks) : ticks;
    mAnySample = true;
}

bool MayaCacheWriter::complete(FbxStatus& status) {
    if (failed(status))
        return false;
    mText.write(mayaCacheDescriptionText(mDescription));
    return mData.complete(status) && mText.complete(status);
}

bool MayaCacheWriter::close(FbxStatus& status) {
    return complete(status) && OutputFile::commitTogether(files(), status);
}

} // namespace detail
FBXSDK_NAMESPACE_END
