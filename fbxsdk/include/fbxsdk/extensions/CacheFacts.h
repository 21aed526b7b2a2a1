// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An extension of this platform, not part of the documented API, and not included by <fbxsdk.h>: what point caches
// hold, sample by sample, with the place of each, and what is wrong with them. FbxCache opens a valid cache;
// this inspects any.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include <fbxsdk/FbxCache.h>
#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN
namespace extensions {

/// A channel as described by a Maya cache. Times are frames at the rate of the cache.
struct CacheChannelFacts {
    std::string name,    ///< UTF-8
        type,            ///< "DoubleVectorArray" and so on
        interpretation;  ///< what the numbers are, usually "Points" or "positions"
    bool regular = true; ///< samples at equal distances
    double step = 1.0;   ///< frames between samples
    double start = 0.0,  ///< frame of the first sample
        end = 0.0;       ///< frame of the last sample
};

/// The numbers of one channel at one time. Small: their number is limited only by the size of the file.
struct CacheSampleFacts {
    /// At the rate of the cache; of a Max cache at that of the scene, of a data file without description at 24.
    double frame = 0.0;
    std::uint32_t file = 0;      ///< index into CacheFacts::fileNames
    std::uint32_t channel = 0;   ///< index into CacheFacts::channelNames
    std::uint64_t count = 0;     ///< points, or numbers of a channel that has no vectors
    std::uint64_t offset = 0,    ///< of the numbers, in the file
        bytes = 0;               ///< that the numbers take
    std::uint8_t components = 3; ///< numbers for each point
    bool doubles = true;         ///< else floats or whole numbers
};

/// A defect of a cache.
struct CacheFaultFacts {
    std::string file;         ///< its name
    std::uint64_t offset = 0; ///< where in the file
    std::string reason;       ///< what is wrong, one sentence
};

/// The content of a cache.
struct CacheFacts {
    FbxCache::EFileFormat format = FbxCache::eUnknownFileFormat; ///< by the content of the file
    std::string description;                                     ///< the .xml file; empty where there is none
    bool oneFile = true;                                         ///< else a data file per sample
    bool wide = false;                                           ///< 64-bit chunks (.mcx)
    double frameRate = 0.0;                                      ///< frames per second; 0: not stated by the cache
    double start = 0.0,                                          ///< frame of the first sample
        end = 0.0;                                               ///< frame of the last sample
    double framesPerSample = 1.0;                                ///< as a Max cache has it
    std::uint64_t statedSamples = 0;                             ///< by a Max cache's header
    std::uint64_t bytes = 0;                                     ///< of all data files
    std::vector<std::string> fileNames;                          ///< of the existing data files
    std::vector<std::string> channelNames;   ///< that samples have; one without letters for a Max cache
    std::vector<CacheChannelFacts> channels; ///< of the description
    std::vector<CacheSampleFacts> samples;   ///< by time
    std::vector<CacheFaultFacts> faults;     ///< what is wrong; empty for a valid cache
};

/// Inspects a cache: a description, a data file, or a Max point cache, detected by content. A data file is taken
/// as part of the cache of the description next to it, when there is one. With `verify` every number is read. False
/// when the file is no cache at all; the defects of a cache are in `faults`.
[[nodiscard]] FBXSDK_DLL bool readCacheFacts(const char* fileName, bool verify, CacheFacts& facts, FbxStatus& status);

/// The paths where the cache's file is looked for, best first.
[[nodiscard]] FBXSDK_DLL std::vector<std::string> cachePlaces(const FbxCache& cache);

} // namespace extensions
FBXSDK_NAMESPACE_END
