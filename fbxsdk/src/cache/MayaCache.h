// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Open Maya caches: one for reading, one for writing.
#pragma once

#include <array>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "cache/MayaCacheData.h"
#include "cache/MayaCacheDescription.h"
#include "container/FileBytes.h"
#include "container/OutputFile.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The path of a cache without the extension of its description: data files are named after it.
[[nodiscard]] std::string mayaCacheBase(const std::string& descriptionFile);
/// The data files of a cache with a file per sample, by tick.
[[nodiscard]] std::map<std::int32_t, std::string> mayaFrameFiles(const std::string& base,
                                                                 const MayaCacheDescription& description);

/// Samples by time over one data file or over one file per sample.
class MayaCacheReader {
public:
    /// Null when the description, the only data file or every one of them is missing or damaged.
    [[nodiscard]] static std::unique_ptr<MayaCacheReader> open(const std::string& descriptionFile, FbxStatus& status);

    [[nodiscard]] const MayaCacheDescription& description() const { return mDescription; }
    /// The channel's points at a time in seconds: interpolated linearly between samples, the nearest sample outside
    /// them.
    [[nodiscard]] bool read(const std::string& channel, double seconds, std::span<double> points, FbxStatus& status);
    /// Times of the first and last sample in ticks. False when there is none.
    [[nodiscard]] bool sampleRange(std::int32_t& first, std::int32_t& last) const;

private:
    struct Sample {
        std::string file;     ///< of caches with a file per sample; empty otherwise
        MayaCacheFrame frame; ///< of caches in one file
    };

    void openOneFile(const std::string& base, FbxStatus& status);
    bool readSample(const Sample& sample, const std::string& channel, std::span<double> points, FbxStatus& status);

    MayaCacheDescription mDescription;
    std::map<std::int32_t, Sample> mSamples; ///< by tick
    std::shared_ptr<const FileBytes> mData;  ///< of caches in one file
};

/// A cache in one file, of one or more channels. Its two files get their final names in close(), or together with
/// others after complete(), or are removed. After a fault nothing more is written, and close() fails.
class MayaCacheWriter {
public:
    [[nodiscard]] static std::unique_ptr<MayaCacheWriter> open(const std::string& descriptionFile,
                                                               const MayaCacheDescription& description,
                                                               FbxStatus& status,
                                                               FileOperations& operations = systemFileOperations());
    MayaCacheWriter(const std::string& descriptionFile, const MayaCacheDescription& description,
                    FileOperations& operations);

    /// Appends a sample. Times must ascend for readers that do not sort. False without a fault for a channel that does
    /// not exist.
    [[nodiscard]] bool write(std::size_t channel, double seconds, std::span<const double> points, FbxStatus& status);
    /// Completes the data file and the description.
    [[nodiscard]] bool close(FbxStatus& status);
    /// The same, but the files keep their temporary names.
    [[nodiscard]] bool complete(FbxStatus& status);
    /// In the order in which they should be renamed. The description is last, since readers open it first.
    [[nodiscard]] std::array<OutputFile*, 2> files() { return {&mData, &mText}; }
    [[nodiscard]] MayaCacheDescription& description() { return mDescription; }

private:
    const char* faultOf(const MayaCacheChannel& channel, double seconds, std::span<const double> points) const;
    void extendRange(MayaCacheChannel& channel, std::int32_t ticks);
    bool failed(FbxStatus& status) const;

    std::string mDataFile;
    MayaCacheDescription mDescription;
    OutputFile mData, mText;
    const char* mFault = nullptr; ///< why a sample was refused
    bool mAnySample = false;
};

} // namespace detail
FBXSDK_NAMESPACE_END
