// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The description of a Maya cache: the .xml file with its channels, their start and end, and the names and
// layout of the data files.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Times of Maya caches count in these per second.
inline constexpr int kMayaTicksPerSecond = 6000;

struct MayaCacheChannel {
    std::string name;
    std::string type =
        "DoubleVectorArray"; ///< FloatArray, DoubleArray, Int32Array, FloatVectorArray, DoubleVectorArray
    std::string interpretation = "positions";
    bool regular = true;
    int samplingRate = 250; ///< ticks between samples
    int start = 0, end = 0; ///< ticks
};

struct MayaCacheDescription {
    bool oneFile = true;    ///< else one data file per sample
    bool wide = false;      ///< 64-bit chunks (.mcx), else 32-bit ones (.mc)
    int start = 0, end = 0; ///< ticks
    int ticksPerFrame = 250;
    std::vector<MayaCacheChannel> channels;

    [[nodiscard]] const char* dataExtension() const { return wide ? ".mcx" : ".mc"; }
};

/// False when the file is missing, is no XML, nests too deeply or is no cache description.
[[nodiscard]] bool readMayaCacheDescription(const std::string& fileName, MayaCacheDescription& description,
                                            FbxStatus& status);
/// The text of the description file.
[[nodiscard]] std::string mayaCacheDescriptionText(const MayaCacheDescription& description);

} // namespace detail
FBXSDK_NAMESPACE_END
