// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Text for the numbers of a scene, the same in every command.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include <fbxsdk.h>

namespace tool {

/// At most ten significant digits, without trailing zeros.
std::string numberText(double value);
/// The fewest digits that read back as the same float: for what files keep as floats.
std::string floatText(double value);
/// "23.976 frames per second", to four decimals.
std::string rateText(double framesPerSecond);
/// The fewest digits that read back as the same number.
std::string exactText(double value);
std::string exactText(float value);
/// "512 bytes", "24.3 KiB", "1.5 MiB".
std::string sizeText(std::uintmax_t bytes);
/// A name for display: in quotes, on one line, without control characters.
std::string inQuotes(std::string_view name);

/// "metre", or the number of centimetres.
std::string unitName(double centimetres);

struct Axes {
    std::string up, toViewer; ///< "+Y"
    bool rightHanded;
};
Axes axesOf(const FbxAxisSystem& system);

/// The kind of a node, by its attribute: "mesh", "camera", "null"; "node" when it has none.
const char* kindOf(const FbxNode& node);

} // namespace tool
