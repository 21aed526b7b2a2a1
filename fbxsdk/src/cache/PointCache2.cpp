// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Max point caches.
#include "cache/PointCache2.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstring>
#include <vector>

#include "container/ByteOrder.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr char kMagic[12] = {'P', 'O', 'I', 'N', 'T', 'C', 'A', 'C', 'H', 'E', '2', '\0'};
constexpr std::size_t kHeaderBytes = 32;
constexpr bool kSwap = needsSwap(/*bigEndian=*/false);

std::uint64_t sampleBytes(const PointCacheHeader& header) { return std::uint64_t{header.pointCount} * 12; }

template <class Number>
void storeNumber(char* bytes, Number number) {
    const auto bits = std::bit_cast<BitsOf<Number>>(number);
    const auto ordered = kSwap ? swapBytes(bits) : bits;
    std::memcpy(bytes, &ordered, sizeof ordered);
}

/// Some writers put a rate in frames per second where frames per sample belong: more than one frame per sample is
/// unheard of, a rate at or below one is.
double framesPerSample(float stored) { return stored > 0.0F && stored <= 1.0F ? static_cast<double>(stored) : 1.0; }

} // namespace

std::unique_ptr<PointCacheReader> PointCacheReader::open(const std::string& fileName, FbxStatus& status) {
    auto reader = std::make_unique<PointCacheReader>();
    reader->mFile = MappedFile::open(fileName, status);
    if (!reader->mFile)
        return nullptr;
    const std::span<const char> bytes = reader->mFile->bytes();
    if (bytes.size() < kHeaderBytes || std::memcmp(bytes.data(), kMagic, sizeof kMagic) != 0) {
        status.SetCode(FbxStatus::eInvalidFile, "%s: offset 0: not a point cache", fileName.c_str());
        return nullptr;
    }
    const auto points = loadNumber<std::int32_t>(bytes.data() + 16, kSwap);
    const auto samples = loadNumber<std::int32_t>(bytes.data() + 28, kSwap);
    const float start = loadNumber<float>(bytes.data() + 20, kSwap);
    PointCacheHeader& header = reader->mHeader;
    header.pointCount = points > 0 ? static_cast<std::uint32_t>(points) : 0;
    header.sampleCount = samples > 0 ? static_cast<std::uint32_t>(samples) : 0;
    header.startFrame = std::isfinite(start) ? static_cast<double>(start) : 0.0;
    header.framesPerSample = framesPerSample(loadNumber<float>(bytes.data() + 24, kSwap));
    if (header.pointCount == 0 || header.sampleCount == 0 ||
        sampleBytes(header) > (bytes.size() - kHeaderBytes) / header.sampleCount) {
        status.SetCode(FbxStatus::eInvalidFile, "%s: offset 16: %d points and %d samples do not fit %zu bytes",
                       fileName.c_str(), points, samples, bytes.size());
        return nullptr;
    }
    return reader;
}

float PointCacheReader::number(std::uint64_t sample, std::size_t index) const {
    return loadNumber<float>(mFile->bytes().data() + kHeaderBytes + sample * sampleBytes(mHeader) + index * 4, kSwap);
}

bool PointCacheReader::read(double frame, std::span<double> points) const {
    if (points.size() != std::size_t{mHeader.pointCount} * 3 || std::isnan(frame))
        return false;
    const double last = static_cast<double>(mHeader.sampleCount - 1);
    const double place = std::clamp((frame - mHeader.startFrame) / mHeader.framesPerSample, 0.0, last);
    const auto sample = static_cast<std::uint64_t>(place);
    const double part = place - static_cast<double>(sample);
    for (std::size_t i = 0; i < points.size(); ++i) {
        const auto value = static_cast<double>(number(sample, i));
        points[i] = part > 0.0 ? value + part * (static_cast<double>(number(sample + 1, i)) - value) : value;
    }
    return true;
}

std::unique_ptr<PointCacheWriter> PointCacheWriter::open(const std::string& fileName, const PointCacheHeader& header,
                                                         FbxStatus& status) {
    auto writer = std::make_unique<PointCacheWriter>();
    writer->mFileName = fileName;
    writer->mHeader = header;
    char bytes[kHeaderBytes] = {};
    std::memcpy(bytes, kMagic, sizeof kMagic);
    storeNumber(bytes + 12, std::int32_t{1});
    storeNumber(bytes + 16, header.pointCount);
    storeNumber(bytes + 20, static_cast<float>(header.startFrame));
    storeNumber(bytes + 24, static_cast<float>(header.framesPerSample));
    storeNumber(bytes + 28, header.sampleCount);
    writer->mFile.open(fileName, std::ios::binary | std::ios::trunc | std::ios::in | std::ios::out);
    writer->mFile.write(bytes, sizeof bytes);
    if (writer->mFile)
        return writer;
    status.SetCode(FbxStatus::eFailure, "%s: cannot be written", fileName.c_str());
    return nullptr;
}

bool PointCacheWriter::write(double frame, const double* points) {
    const double slot = std::round(frame - mHeader.startFrame);
    if (!(slot >= 0.0) || slot >= static_cast<double>(mHeader.sampleCount))
        return false;
    std::vector<char> bytes(sampleBytes(mHeader));
    for (std::size_t i = 0; i < std::size_t{mHeader.pointCount} * 3; ++i) {
        storeNumber(bytes.data() + i * 4, static_cast<float>(points[i]));
    }
    mFile.seekp(static_cast<std::streamoff>(kHeaderBytes + static_cast<std::uint64_t>(slot) * sampleBytes(mHeader)));
    mFile.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    mFailed = mFailed || !mFile;
    return !mFailed;
}

bool PointCacheWriter::close(FbxStatus& status) {
    const std::uint64_t whole = kHeaderBytes + sampleBytes(mHeader) * mHeader.sampleCount;
    mFile.seekp(0, std::ios::end);
    if (mFile && static_cast<std::uint64_t>(mFile.tellp()) < whole) {
        mFile.seekp(static_cast<std::streamoff>(whole - 1));
        mFile.put('\0');
    }
    mFile.close();
    if (!mFailed && mFile)
        return true;
    status.SetCode(FbxStatus::eFailure, "%s: could not be written whole", mFileName.c_str());
    return false;
}

} // namespace detail
FBXSDK_NAMESPACE_END
