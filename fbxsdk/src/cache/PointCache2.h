// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Max point caches, version 2. Little-endian: a header of 32 bytes, then sample after sample of x, y, z floats.
//
//   0 "POINTCACHE2\0" · 12 i32 version 1 · 16 i32 points · 20 f32 start frame · 24 f32 frames per sample · 28 i32
//   samples
#pragma once

#include <memory>
#include <span>
#include <string>

#include "container/FileBytes.h"
#include "container/OutputFile.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

struct PointCacheHeader {
    std::uint32_t pointCount = 0;
    double startFrame = 0;
    double framesPerSample = 1;
    std::uint32_t sampleCount = 0;
};

class PointCacheReader {
public:
    [[nodiscard]] static std::unique_ptr<PointCacheReader> open(const std::string& fileName, FbxStatus& status);
    [[nodiscard]] const PointCacheHeader& header() const { return mHeader; }
    /// The points at a frame: interpolated linearly between samples, the nearest sample outside them. False when the
    /// cache has another number of points. Throws FileFault.
    [[nodiscard]] bool read(double frame, std::span<double> points) const;

private:
    void readSample(std::uint64_t sample, std::span<double> points) const;

    std::shared_ptr<const FileBytes> mFile;
    PointCacheHeader mHeader;
};

/// The file gets its final name in close(), or together with others after complete(), or is removed. After a fault
/// nothing more is written, and close() fails.
class PointCacheWriter {
public:
    [[nodiscard]] static std::unique_ptr<PointCacheWriter> open(const std::string& fileName,
                                                                const PointCacheHeader& header, FbxStatus& status,
                                                                FileOperations& operations = systemFileOperations());
    PointCacheWriter(const std::string& fileName, const PointCacheHeader& header, FileOperations& operations);

    /// Writes the sample of a frame to its place. False without a fault for a frame outside the samples.
    [[nodiscard]] bool write(double frame, const double* points, FbxStatus& status);
    /// Appends missing samples at the end, so that the file has the size stated in its header.
    [[nodiscard]] bool close(FbxStatus& status);
    /// The same, but the file keeps its temporary name.
    [[nodiscard]] bool complete(FbxStatus& status);
    [[nodiscard]] OutputFile& file() { return mFile; }
    [[nodiscard]] const PointCacheHeader& header() const { return mHeader; }

private:
    bool failed(FbxStatus& status) const;
    void put(std::uint64_t offset, std::span<const double> points);

    std::string mFileName;
    OutputFile mFile;
    PointCacheHeader mHeader;
    const char* mFault = nullptr; ///< why a sample was refused
};

} // namespace detail
FBXSDK_NAMESPACE_END
