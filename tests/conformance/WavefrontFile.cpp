// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Lines of points and faces, and comments about order and precision.
#include "WavefrontFile.h"

#include <charconv>
#include <cmath>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string_view>

namespace conformance {
namespace {

/// 3ds Max renumbers points; other files state that their order differs.
constexpr std::string_view kSignsOfOtherOrder[] = {"3ds Max Wavefront", "Max2Obj", "bad_order"};
constexpr std::string_view kTolerance = "tolerance=";

void readComment(std::string_view line, WavefrontFile& file) {
    for (const std::string_view sign : kSignsOfOtherOrder)
        if (line.find(sign) != std::string_view::npos)
            file.inOtherOrder = true;
    if (const std::size_t at = line.find(kTolerance); at != std::string_view::npos)
        file.tolerance = std::max(file.tolerance, std::stod(std::string(line.substr(at + kTolerance.size()))));
}

/// A unit of the last digit: 0.0001 for "1.2500". Half of it is lost here, and the FBX file's number was rounded too.
double printedPrecision(std::string_view number) {
    const std::size_t point = number.find('.');
    const std::size_t decimals = point == std::string_view::npos ? 0 : number.size() - point - 1;
    return std::pow(10.0, -static_cast<double>(decimals));
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
