// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Point caches as objects of a scene: names, format, and the files while they are open.
#include <fbxsdk/FbxCache.h>

#include <algorithm>
#include <cmath>
#include <utility>

#include <fbxsdk/FbxPathUtils.h>
#include <fbxsdk/FbxScene.h>

#include "cache/CacheSearch.h"
#include "cache/MayaCache.h"
#include "cache/PointCache2.h"
#include "object/ManagerData.h"
#include "scene/SceneData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxCache, FbxObject, detail::kCacheRows)

namespace detail {

/// The reader or writer of an open cache: exactly one of the four is set.
class CacheFile {
public:
    std::unique_ptr<MayaCacheReader> mayaReader;
    std::unique_ptr<MayaCacheWriter> mayaWriter;
    std::unique_ptr<PointCacheReader> pointReader;
    std::unique_ptr<PointCacheWriter> pointWriter;

    [[nodiscard]] const MayaCacheDescription* description() const {
        if (mayaReader)
            return &mayaReader->description();
        return mayaWriter ? &mayaWriter->description() : nullptr;
    }
    [[nodiscard]] const PointCacheHeader* header() const {
        if (pointReader)
            return &pointReader->header();
        return pointWriter ? &pointWriter->header() : nullptr;
    }

    /// Flushes what was written to the medium, under its final name or, when it waits for the scene, a temporary one.
    bool finish(bool waits, FbxStatus& status) {
        if (mayaWriter)
            return waits ? mayaWriter->complete(status) : mayaWriter->close(status);
        if (pointWriter)
            return waits ? pointWriter->complete(status) : pointWriter->close(status);
        return true;
    }
    [[nodiscard]] std::vector<OutputFile*> files() const {
        if (pointWriter)
            return {&pointWriter->file()};
        if (!mayaWriter)
            return {};
        const auto both = mayaWriter->files();
        return {both.begin(), both.end()};
    }
};

namespace {

/// A local status, copied to the optional status of the caller at the end of the scope.
class Outcome {
public:
    explicit Outcome(FbxStatus* target) : mTarget(target) {}
    Outcome(const Outcome&) = delete;
    Outcome& operator=(const Outcome&) = delete;
    ~Outcome() {
        if (mTarget)
            *mTarget = std::move(status);
    }
    bool fail(FbxStatus::EStatusCode code, const char* sentence) {
        status.SetCode(code, "%s", sentence);
        return false;
    }
    FbxStatus status;

private:
    FbxStatus* mTarget;
};

struct DataTypeName {
    FbxCache::EMCDataType type;
    const char* name;
};
constexpr DataTypeName kDataTypes[] = {{FbxCache::eDoubleArray, "DoubleArray"},
                                       {FbxCache::eDoubleVectorArray, "DoubleVectorArray"},
                                       {FbxCache::eInt32Array, "Int32Array"},
                                       {FbxCache::eFloatArray, "FloatArray"},
                                       {FbxCache::eFloatVectorArray, "FloatVectorArray"}};

int roundedTicks(double perSecond) {
    const double ticks = perSecond > 0.0 ? std::round(kMayaTicksPerSecond / perSecond) : 0.0;
    return ticks >= 1.0 && ticks <= 1e9 ? static_cast<int>(ticks) : 1;
}

/// Negative frame numbers are passed as unsigned ones; undoes the conversion.
double frameOf(unsigned int index) { return static_cast<double>(static_cast<std::int32_t>(index)); }

/// The path to write to. Unlike the path to read from it is not searched for.
std::string writtenName(const FbxCache& cache) {
    FbxString relative, absolute;
    cache.GetCacheFileName(relative, absolute);
    return (absolute.IsEmpty() ? relative : absolute).Buffer();
}

/// Whether the files of the cache are to appear with that of its scene.
bool appearsWithScene(const FbxCache& cache) {
    const FbxProperty property = cache.FindProperty("AppearWithScene");
    return property.IsValid() && property.Get<FbxBool>();
}

const char* const kNotOpen = "the cache is not open";
const char* const kNotMaya = "the open cache is not a Maya cache";
const char* const kNotMax = "the open cache is not a Max point cache";

} // namespace
} // namespace detail

using detail::Outcome;

FbxCache::FbxCache(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxObject(pManager, pInfo) {}
FbxCache::~FbxCache() = default;

void FbxCache::SetCacheFileFormat(EFileFormat pFileFormat, FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    if (mFile) {
        outcome.fail(FbxStatus::eFailure, "the format of an open cache cannot change");
        return;
    }
    FindProperty("CacheFileType").Set(static_cast<FbxEnum>(pFileFormat));
}

FbxCache::EFileFormat FbxCache::GetCacheFileFormat() const {
    const FbxEnum format = FindProperty("CacheFileType").Get<FbxEnum>();
    return format >= eUnknownFileFormat && format <= eAlembic ? static_cast<EFileFormat>(format) : eUnknownFileFormat;
}

void FbxCache::SetCacheFileName(const char* pRelativeFileName_UTF8, const char* pAbsoluteFileName_UTF8,
                                FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    if (mFile) {
        outcome.fail(FbxStatus::eFailure, "the name of an open cache cannot change");
        return;
    }
    FindProperty("CacheFileName").Set(FbxString(pRelativeFileName_UTF8));
    FindProperty("CacheAbsoluteFileName").Set(FbxString(pAbsoluteFileName_UTF8));
}

void FbxCache::GetCacheFileName(FbxString& pRelativeFileName_UTF8, FbxString& pAbsoluteFileName_UTF8) const {
    pRelativeFileName_UTF8 = FindProperty("CacheFileName").Get<FbxString>();
    pAbsoluteFileName_UTF8 = FindProperty("CacheAbsoluteFileName").Get<FbxString>();
}

bool FbxCache::OpenFileForRead(FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    if (mFile)
        return outcome.fail(FbxStatus::eFailure, "the cache is already open");
    FbxString relative, absolute;
    GetCacheFileName(relative, absolute);
    const FbxScene* scene = GetScene();
    const std::string fbxFile = scene ? scene->sceneData().fileName() : std::string();
    const EFileFormat format = GetCacheFileFormat();
    if (format != eMayaCache && format != eMaxPointCacheV2)
        return outcome.fail(FbxStatus::eInvalidParameter, "the format of the cache is not supported");
    const auto places = detail::cacheFileCandidates(fbxFile, relative.Buffer(), absolute.Buffer());
    if (places.empty())
        return outcome.fail(FbxStatus::eInvalidParameter, "the cache has no file name");
    for (const std::string& place : places) {
        auto file = std::make_unique<detail::CacheFile>();
        FbxStatus status;
        detail::faultToStatus(status, [&] {
            if (format == eMayaCache)
                file->mayaReader = detail::MayaCacheReader::open(place, status);
            else
                file->pointReader = detail::PointCacheReader::open(place, status);
            return true;
        });
        if (file->mayaReader || file->pointReader) {
            mFile = std::move(file);
            outcome.status.Clear();
            return true;
        }
        // Damage is reported in preference to a missing file, and the first candidate in preference to later ones.
        const bool isDamage = status.GetCode() == FbxStatus::eInvalidFile;
        const bool knowsDamage = outcome.status.GetCode() == FbxStatus::eInvalidFile;
        if (!outcome.status.Error() || (isDamage && !knowsDamage))
            outcome.status = status;
    }
    return false;
}

bool FbxCache::IsOpen(FbxStatus* pStatus) const {
    Outcome outcome(pStatus);
    return mFile != nullptr;
}

bool FbxCache::CloseFile(FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    if (!mFile)
        return outcome.fail(FbxStatus::eFailure, detail::kNotOpen);
    std::unique_ptr<detail::CacheFile> file = std::move(mFile);
    const bool waits = !file->files().empty() && detail::appearsWithScene(*this);
    const bool finished = file->finish(waits, outcome.status);
    if (waits)
        mWaiting = finished ? std::move(file) : nullptr;
    return finished;
}

std::vector<detail::OutputFile*> FbxCache::waitingFiles() const {
    return mWaiting ? mWaiting->files() : std::vector<detail::OutputFile*>();
}

void FbxCache::forgetWaitingFiles() { mWaiting.reset(); }

double FbxCache::GetSamplingFrameRate(FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    const auto* description = mFile ? mFile->description() : nullptr;
    if (description)
        return static_cast<double>(detail::kMayaTicksPerSecond) / description->ticksPerFrame;
    if (mFile)
        return FbxTime::GetFrameRate(FbxTime::eDefaultMode) / mFile->header()->framesPerSample;
    outcome.fail(FbxStatus::eFailure, detail::kNotOpen);
    return 0.0;
}

FbxTime FbxCache::GetCacheTimePerFrame(FbxStatus* pStatus) {
    const double rate = GetSamplingFrameRate(pStatus);
    FbxTime time;
    if (rate > 0.0)
        time.SetSecondDouble(1.0 / rate);
    return time;
}

int FbxCache::GetChannelCount(FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    const auto* description = mFile ? mFile->description() : nullptr;
    if (!description)
        outcome.fail(FbxStatus::eFailure, mFile ? detail::kNotMaya : detail::kNotOpen);
    return description ? static_cast<int>(description->channels.size()) : 0;
}

bool FbxCache::GetChannelName(int pChannelIndex, FbxString& pChannelName, FbxStatus* pStatus) {
    if (pChannelIndex < 0 || pChannelIndex >= GetChannelCount(pStatus))
        return Outcome(pStatus).fail(FbxStatus::eIndexOutOfRange, "there is no channel with that index");
    pChannelName = mFile->description()->channels[static_cast<std::size_t>(pChannelIndex)].name.c_str();
    return true;
}

bool FbxCache::GetChannelDataType(int pChannelIndex, EMCDataType& pChannelType, FbxStatus* pStatus) {
    if (pChannelIndex < 0 || pChannelIndex >= GetChannelCount(pStatus))
        return Outcome(pStatus).fail(FbxStatus::eIndexOutOfRange, "there is no channel with that index");
    const std::string& type = mFile->description()->channels[static_cast<std::size_t>(pChannelIndex)].type;
    pChannelType = eUnknownData;
    for (const auto& row : detail::kDataTypes)
        if (type == row.name)
            pChannelType = row.type;
    return true;
}

int FbxCache::GetChannelIndex(const char* pChannelName, FbxStatus* pStatus) {
    const int count = GetChannelCount(pStatus);
    for (int i = 0; pChannelName && i < count; ++i)
        if (mFile->description()->channels[static_cast<std::size_t>(i)].name == pChannelName)
            return i;
    return -1;
}

bool FbxCache::OpenFileForWrite(EMCFileCount pFileCount, double pSamplingFrameRate, const char* pChannelName,
                                EMCBinaryFormat pBinaryFormat, EMCDataType pMCDataType, const char* pInterpretation,
                                FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    if (mFile)
        return outcome.fail(FbxStatus::eFailure, "the cache is already open");
    if (GetCacheFileFormat() != eMayaCache)
        return outcome.fail(FbxStatus::eFailure, "the cache is not a Maya cache");
    if (pFileCount != eMCOneFile)
        return outcome.fail(FbxStatus::eFailure, "only caches with one data file can be written");
    if (!(pSamplingFrameRate > 0.0))
        return outcome.fail(FbxStatus::eInvalidParameter, "the frame rate is not positive");

    detail::MayaCacheDescription description;
    description.wide = pBinaryFormat == eMCX;
    description.ticksPerFrame = detail::roundedTicks(pSamplingFrameRate);
    auto file = std::make_unique<detail::CacheFile>();
    file->mayaWriter = detail::MayaCacheWriter::open(detail::writtenName(*this), description, outcome.status);
    if (!file->mayaWriter)
        return false;
    mFile = std::move(file);
    unsigned int channel = 0;
    return AddChannel(pChannelName, pMCDataType, pInterpretation, channel, nullptr);
}

bool FbxCache::AddChannel(const char* pChannelName, EMCDataType pMCDataType, const char* pInterpretation,
                          unsigned int& pChannelIndex, FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    if (!mFile || !mFile->mayaWriter)
        return outcome.fail(FbxStatus::eFailure, "no Maya cache is open for writing");
    detail::MayaCacheDescription& description = mFile->mayaWriter->description();
    detail::MayaCacheChannel channel;
    channel.name = pChannelName ? pChannelName : "";
    channel.interpretation = pInterpretation ? pInterpretation : "";
    channel.samplingRate = description.ticksPerFrame;
    for (const auto& row : detail::kDataTypes)
        if (row.type == pMCDataType)
            channel.type = row.name;
    pChannelIndex = static_cast<unsigned int>(description.channels.size());
    description.channels.push_back(std::move(channel));
    return true;
}

bool FbxCache::Read(int pChannelIndex, FbxTime& pTime, double* pBuffer, unsigned int pPointCount, FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    if (!mFile || !mFile->mayaReader)
        return outcome.fail(FbxStatus::eFailure, detail::kNotMaya);
    const auto& channels = mFile->mayaReader->description().channels;
    if (pChannelIndex < 0 || static_cast<std::size_t>(pChannelIndex) >= channels.size() || !pBuffer)
        return outcome.fail(FbxStatus::eIndexOutOfRange, "there is no channel with that index");
    const std::string& channel = channels[static_cast<std::size_t>(pChannelIndex)].name;
    return detail::faultToStatus(outcome.status, [&] {
        return mFile->mayaReader->read(channel, pTime.GetSecondDouble(), {pBuffer, std::size_t{pPointCount} * 3},
                                       outcome.status);
    });
}

bool FbxCache::Read(int pChannelIndex, FbxTime& pTime, float* pBuffer, unsigned int pPointCount, FbxStatus* pStatus) {
    if (!pBuffer)
        return Outcome(pStatus).fail(FbxStatus::eInvalidParameter, "no buffer");
    std::vector<double> points(std::size_t{pPointCount} * 3);
    if (!Read(pChannelIndex, pTime, points.data(), pPointCount, pStatus))
        return false;
    std::transform(points.begin(), points.end(), pBuffer, [](double value) { return static_cast<float>(value); });
    return true;
}

bool FbxCache::BeginWriteAt(FbxTime&, FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    return mFile && mFile->mayaWriter ? true : outcome.fail(FbxStatus::eFailure, "no Maya cache is open for writing");
}

bool FbxCache::EndWriteAt(FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    return mFile && mFile->mayaWriter ? true : outcome.fail(FbxStatus::eFailure, "no Maya cache is open for writing");
}

bool FbxCache::Write(int pChannelIndex, FbxTime& pTime, double* pBuffer, unsigned int pPointCount, FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    if (!mFile || !mFile->mayaWriter)
        return outcome.fail(FbxStatus::eFailure, "no Maya cache is open for writing");
    if (pChannelIndex < 0 || !pBuffer)
        return outcome.fail(FbxStatus::eInvalidParameter, "no channel or no buffer");
    const std::span<const double> points(pBuffer, std::size_t{pPointCount} * 3);
    return mFile->mayaWriter->write(static_cast<std::size_t>(pChannelIndex), pTime.GetSecondDouble(), points,
                                    outcome.status);
}

bool FbxCache::Write(int pChannelIndex, FbxTime& pTime, float* pBuffer, unsigned int pPointCount, FbxStatus* pStatus) {
    if (!pBuffer)
        return Outcome(pStatus).fail(FbxStatus::eInvalidParameter, "no buffer");
    std::vector<double> points(pBuffer, pBuffer + std::size_t{pPointCount} * 3);
    return Write(pChannelIndex, pTime, points.data(), pPointCount, pStatus);
}

bool FbxCache::GetAnimationRange(int pChannelIndex, FbxTime& pTimeStart, FbxTime& pTimeEnd, FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    std::int32_t first = 0, last = 0;
    if (!mFile || !mFile->mayaReader)
        return outcome.fail(FbxStatus::eFailure, detail::kNotMaya);
    const auto& channels = mFile->mayaReader->description().channels;
    if (pChannelIndex < 0 || static_cast<std::size_t>(pChannelIndex) >= channels.size())
        return outcome.fail(FbxStatus::eIndexOutOfRange, "there is no channel with that index");
    if (!mFile->mayaReader->sampleRange(first, last))
        return outcome.fail(FbxStatus::eFailure, "no samples");
    pTimeStart.SetSecondDouble(static_cast<double>(first) / detail::kMayaTicksPerSecond);
    pTimeEnd.SetSecondDouble(static_cast<double>(last) / detail::kMayaTicksPerSecond);
    return true;
}

bool FbxCache::OpenFileForWrite(double pFrameStartOffset, double, unsigned int pSampleCount, unsigned int pPointCount,
                                FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    if (mFile)
        return outcome.fail(FbxStatus::eFailure, "the cache is already open");
    if (GetCacheFileFormat() != eMaxPointCacheV2)
        return outcome.fail(FbxStatus::eFailure, "the cache is not a Max point cache");
    // The header's rate is frames per sample, whatever the frames per second are: one sample for every frame.
    const detail::PointCacheHeader header{pPointCount, pFrameStartOffset, 1.0, pSampleCount};
    auto file = std::make_unique<detail::CacheFile>();
    file->pointWriter = detail::PointCacheWriter::open(detail::writtenName(*this), header, outcome.status);
    if (!file->pointWriter)
        return false;
    mFile = std::move(file);
    return true;
}

unsigned int FbxCache::GetSampleCount(FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    const auto* header = mFile ? mFile->header() : nullptr;
    if (!header)
        outcome.fail(FbxStatus::eFailure, detail::kNotMax);
    return header ? header->sampleCount : 0;
}

unsigned int FbxCache::GetPointCount(FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    const auto* header = mFile ? mFile->header() : nullptr;
    if (!header)
        outcome.fail(FbxStatus::eFailure, detail::kNotMax);
    return header ? header->pointCount : 0;
}

double FbxCache::GetFrameStartOffset(FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    const auto* header = mFile ? mFile->header() : nullptr;
    if (!header)
        outcome.fail(FbxStatus::eFailure, detail::kNotMax);
    return header ? header->startFrame : 0.0;
}

bool FbxCache::Read(unsigned int pFrameIndex, double* pBuffer, unsigned int pPointCount, FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    if (!mFile || !mFile->pointReader || !pBuffer)
        return outcome.fail(FbxStatus::eFailure, detail::kNotMax);
    return detail::faultToStatus(outcome.status, [&] {
        return mFile->pointReader->read(detail::frameOf(pFrameIndex), {pBuffer, std::size_t{pPointCount} * 3}) ||
               outcome.fail(FbxStatus::eInvalidParameter, "the cache has a different number of points");
    });
}

bool FbxCache::Write(unsigned int pFrameIndex, double* pBuffer, FbxStatus* pStatus) {
    Outcome outcome(pStatus);
    if (!mFile || !mFile->pointWriter || !pBuffer)
        return outcome.fail(FbxStatus::eFailure, detail::kNotMax);
    return mFile->pointWriter->write(detail::frameOf(pFrameIndex), pBuffer, outcome.status);
}

FBXSDK_NAMESPACE_END
