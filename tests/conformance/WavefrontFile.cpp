// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The format has neither units nor axes; each application has its habit, and its signature in the first lines.
#include "WavefrontFile.h"

#include <charconv>
#include <cmath>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string_view>

namespace conformance {
namespace {

struct Habit {
    std::string_view signature;
    bool inFileUnits, inFileAxes;
};

constexpr Habit kHabits[] = {
    {"This file uses centimeters", false, false}, // Maya
    {"Blender v", true, false},
    {"3ds Max Wavefront", true, true},
    {"Max2Obj", true, true},
    {"Created with Kaydara FBX", true, true},
};

constexpr std::string_view kTolerance = "tolerance=";
constexpr std::string_view kOtherOrder = "bad_order";

void readComment(std::string_view line, WavefrontFile& file) {
    for (const Habit& habit : kHabits) {
        if (line.find(habit.signature) == std::string_view::npos)
            continue;
        file.inFileUnits = habit.inFileUnits;
        file.inFileAxes = habit.inFileAxes;
    }
    if (line.find(kOtherOrder) != std::string_view::npos)
        file.inOtherOrder = true;
    if (const std::size_t at = line.find(kTolerance); at != std::string_view::npos) {
        file.tolerance = std::max(file.tolerance, std::stod(std::string(line.substr(at + kTolerance.size()))));
    }
}

/// Half a unit of the last digit of "1.2500" is 0.00005.
double printedPrecision(std::string_view number) {
    const std::size_t point = number.find('.');
    const std::size_t decimals = point == std::string_view::npos ? 0 : number.size() - point - 1;
    return 0.5 * std::pow(10.0, -static_cast<double>(decimals));
}

Point readPoint(std::istringstream& words, WavefrontFile& file) {
    Point point{};
    for (double& coordinate : point) {
        std::string word;
        words >> word;
        coordinate = std::strtod(word.c_str(), nullptr);
        file.tolerance = std::max(file.tolerance, printedPrecision(word));
    }
    return point;
}

std::vector<std::string> readNames(std::istringstream& words) {
    std::vector<std::string> names;
    for (std::string name; words >> name;)
        names.push_back(decodedName(name));
    return names;
}

} // namespace

std::string decodedName(std::string name) {
    constexpr std::string_view kEscape = "FBXASC";
    constexpr std::size_t kDigits = 3;
    for (std::size_t at = name.find(kEscape); at != std::string::npos; at = name.find(kEscape, at + 1)) {
        const char* digits = name.data() + at + kEscape.size();
        unsigned char character = 0;
        if (at + kEscape.size() + kDigits > name.size())
            break;
        if (std::from_chars(digits, digits + kDigits, character).ec != std::errc())
            continue;
        name.replace(at, kEscape.size() + kDigits, 1, static_cast<char>(character));
    }
    return name;
}

WavefrontFile readWavefront(const std::filesystem::path& path) {
    WavefrontFile file;
    std::ifstream stream(path);
    std::vector<std::string> names;
    bool blockHasFaces = true;
    for (std::string line; std::getline(stream, line);) {
        std::istringstream words(line);
        std::string kind;
        words >> kind;
        if (kind.starts_with('#')) {
            readComment(line, file);
        } else if (kind == "v") {
            if (blockHasFaces)
                file.blocks.emplace_back();
            blockHasFaces = false;
            file.blocks.back().points.push_back(readPoint(words, file));
        } else if (kind == "g" || kind == "o") {
            names = readNames(words);
        } else if (kind == "f" && !file.blocks.empty()) {
            if (!blockHasFaces)
                file.blocks.back().names = names;
            blockHasFaces = true;
        }
    }
    return file;
}

} // namespace conformance
