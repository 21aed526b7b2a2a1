// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "cache/PointCache2.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <vector>

#include "cache/SampleCheck.h"
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

/// Some writers store frames per second in the field of frames per sample. Values above 1 are taken for such a rate:
/// more than one frame per sample does not occur, nor does a rate of 1 or less.
double framesPerSample(float stored) { return stored > 0.0F && stored <= 1.0F ? static_cast<double>(stored) : 1.0; }

/// Null, or what the header cannot hold.
const char* headerFault(const PointCacheHeader& header) {
    constexpr std::uint64_t kMostCount = INT32_MAX, kMostBytes = INT64_MAX;
    constexpr double kMostFrame = INT32_MAX;
    if (header.pointCount == 0)
        return "the samples have no points";
    if (header.pointCount > kMostCount || header.sampleCount > kMostCount)
        return "more points or samples than point caches can store";
    if (header.sampleCount > 0 && sampleBytes(header) > (kMostBytes - kHeaderBytes) / header.sampleCount)
        return "more samples than a file can store";
    if (!(std::abs(header.startFrame) <= kMostFrame))
        return "the start frame is invalid";
    // Large frame numbers are rounded in the header: every sample would be at another frame.
    constexpr double kHalfFrame = 0.5;
    const auto stored = static_cast<double>(static_cast<float>(header.startFrame));
    return std::abs(stored - header.startFrame) < kHalfFrame ? nullptr : "the start frame is too large";
}

} // namespace

std::unique_ptr<PointCacheReader> PointCacheReader::open(const std::string& fileName, FbxStatus& status) {
    auto reader = std::make_unique<PointCacheReader>();
    reader->mFile = FileBytes::open(fileName, status);
    if (!reader->mFile)
        return nullptr;
    const std::span<const char> bytes = reader->mFile->bytes();
    reader->mFile->fetch(bytes.first(std::min(bytes.size(), kHeaderBytes)));
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

/// Floats are read to the end of the destination, then widened in place from the front.
void PointCacheReader::readSample(std::uint64_t sample, std::span<double> points) const {
    char* const floats = reinterpret_cast<char*>(points.data()) + points.size() * (sizeof(double) - sizeof(float));
    mFile->read(mFile->bytes().subspan(kHeaderBytes + sample * sampleBytes(mHeader), points.size() * sizeof(float)),
                floats);
    for (std::size_t i = 0; i < points.size(); ++i)
        points[i] = static_cast<double>(loadNumber<float>(floats + i * sizeof(float), kSwap));
}

bool PointCacheReader::read(double frame, std::span<double> points) const {
    if (points.size() != std::size_t{mHeader.pointCount} * 3 || std::isnan(frame))
        return false;
    const double last = static_cast<double>(mHeader.sampleCount - 1);
    const double place = std::clamp((frame - mHeader.startFrame) / mHeader.framesPerSample, 0.0, last);
    const auto sample = static_cast<std::uint64_t>(place);
    const double part = place - static_cast<double>(sample);
    readSample(sample, points);
    if (part > 0.0) {
        std::vector<double> next(points.size());
        readSample(sample + 1, next);
        for (std::size_t i = 0; i < points.size(); ++i)
            points[i] += part * (next[i] - points[i]);
    }
    return true;
}

PointCacheWriter::PointCacheWriter(const std::string& fileName, const PointCacheHeader& header,
                                   FileOperations& operations)
    : mFileName(fileName), mFile(fileName, operations), mHeader(header) {}

std::unique_ptr<PointCacheWriter> PointCacheWriter::open(const std::string& fileName, const PointCacheHeader& header,
                                                         FbxStatus& status, FileOperations& operations) {
    if (const char* fault = headerFault(header)) {
        status.SetCode(FbxStatus::eInvalidParameter, "cannot be written: %s", fault);
        return nullptr;
    }
    auto writer = std::make_unique<PointCacheWriter>(fileName, header, operations);
    if (!writer->mFile.open(status)) {
        status.SetCode(FbxStatus::eFailure, "%s", writer->mFile.reason().c_str());
        return nullptr;
    }
    char bytes[kHeaderBytes] = {};
    std::memcpy(bytes, kMagic, sizeof kMagic);
    storeNumber(bytes + 12, std::int32_t{1});
    storeNumber(bytes + 16, header.pointCount);
    storeNumber(bytes + 20, static_cast<float>(header.startFrame));
    storeNumber(bytes + 24, static_cast<float>(header.framesPerSample));
    storeNumber(bytes + 28, header.sampleCount);
    writer->mFile.write(bytes);
    return writer;
}

bool PointCacheWriter::failed(FbxStatus& status) const {
    if (mFault)
        status.SetCode(FbxStatus::eFailure, "%s: cannot be written: %s", mFileName.c_str(), mFault);
    else if (mFile.failed())
        mFile.report(status);
    return mFault || mFile.failed();
}

bool PointCacheWriter::write(double frame, const double* points, FbxStatus& status) {
    if (failed(status))
        return false;
    const double slot = std::round(frame - mHeader.startFrame);
    if (!(slot >= 0.0) || slot >= static_cast<double>(mHeader.sampleCount)) {
        status.SetCode(FbxStatus::eIndexOutOfRange, "%s: the frame is outside the range of the samples",
                       mFileName.c_str());
        return false;
    }
    const std::span<const double> sample(points, std::size_t{mHeader.pointCount} * 3);
    mFault = sampleFault(sample, /*asFloats=*/true);
    if (failed(status))
        return false;
    put(kHeaderBytes + static_cast<std::uint64_t>(slot) * sampleBytes(mHeader), sample);
    return !failed(status);
}

void PointCacheWriter::put(std::uint64_t offset, std::span<const double> points) {
    std::array<char, std::size_t{1} << 15U> bytes;
    constexpr std::size_t kPiece = bytes.size() / sizeof(float);
    mFile.extend(offset);
    while (!points.empty()) {
        const std::span<const double> piece = points.first(std::min(kPiece, points.size()));
        for (std::size_t i = 0; i < piece.size(); ++i)
            storeNumber(bytes.data() + i * sizeof(float), static_cast<float>(piece[i]));
        const std::span<const char> stored(bytes.data(), piece.size() * sizeof(float));
        // A sample is either completely beyond the end of the file so far or completely before it.
        if (offset < mFile.size())
            mFile.overwrite(offset, stored);
        else
            mFile.write(stored);
        offset += stored.size();
        points = points.subspan(piece.size());
    }
}

bool PointCacheWriter::complete(FbxStatus& status) {
    if (failed(status))
        return false;
    mFile.extend(kHeaderBytes + sampleBytes(mHeader) * mHeader.sampleCount);
    return mFile.complete(status);
}

bool PointCacheWriter::close(FbxStatus& status) { return complete(status) && mFile.commit(status); }

} // namespace detail
FBXSDK_NAMESPACE_END
