// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Text for the numbers of a scene.
#include "SceneFacts.h"

#include <charconv>
#include <cmath>
#include <cstdio>
#include <limits>

#include "TerminalText.h"

namespace tool {

std::string numberText(double value) {
    if (std::isnan(value))
        return "nan";
    char text[32];
    std::snprintf(text, sizeof text, "%.10g", value + 0.0); // no minus before a zero
    return text;
}

std::string rateText(double framesPerSecond) {
    return numberText(std::round(framesPerSecond * 1e4) / 1e4) + " frames per second";
}

namespace {

template <class Real>
std::string shortest(Real value) {
    if (std::isnan(value))
        return "nan"; // the sign has no meaning
    // The shortest form by itself would give 100000 as 1e+05.
    constexpr double kSmall = 1e-5, kLarge = 1e15;
    const double size = std::abs(static_cast<double>(value));
    const bool isUsual = (size >= kSmall && size < kLarge) || size == 0.0;
    char digits[64];
    const auto [end, error] = isUsual ? std::to_chars(digits, digits + sizeof digits, value, std::chars_format::fixed)
                                      : std::to_chars(digits, digits + sizeof digits, value);
    return {digits, end};
}

} // namespace

std::string exactText(double value) { return shortest(value); }
std::string exactText(float value) { return shortest(value); }
std::string floatText(double value) {
    const bool fits = std::abs(value) <= static_cast<double>(std::numeric_limits<float>::max());
    return fits ? shortest(static_cast<float>(value) + 0.0F) : shortest(value);
}

std::string sizeText(std::uintmax_t bytes) {
    constexpr double kKibi = 1024.0;
    const auto size = static_cast<double>(bytes);
    if (size < kKibi)
        return std::to_string(bytes) + (bytes == 1 ? " byte" : " bytes");
    const bool isSmall = size < kKibi * kKibi;
    char text[32];
    std::snprintf(text, sizeof text, "%.1f %s", size / (isSmall ? kKibi : kKibi * kKibi), isSmall ? "KiB" : "MiB");
    return text;
}

std::string inQuotes(std::string_view name) { return '"' + terminalText(name) + '"'; }

std::string unitName(double centimetres) {
    constexpr struct {
        double scale;
        const char* name;
    } kUnits[] = {{0.1, "millimetre"}, {1.0, "centimetre"}, {10.0, "decimetre"}, {100.0, "metre"},  {1e5, "kilometre"},
                  {2.54, "inch"},      {30.48, "foot"},     {91.44, "yard"},     {160934.4, "mile"}};
    for (const auto& unit : kUnits)
        if (unit.scale == centimetres)
            return unit.name;
    return numberText(centimetres) + " cm";
}

Axes axesOf(const FbxAxisSystem& system) {
    int upSign = 1, frontSign = 1;
    const int up = static_cast<int>(system.GetUpVector(upSign)) - 1;
    const bool even = system.GetFrontVector(frontSign) == FbxAxisSystem::eParityEven;
    const int others[2] = {up == 0 ? 1 : 0, up == 2 ? 1 : 2};
    const int front = even ? others[0] : others[1];
    const auto name = [](int sign, int axis) { return std::string{sign < 0 ? '-' : '+', "XYZ"[axis]}; };
    return {name(upSign, up), name(frontSign, front), system.GetCoorSystem() == FbxAxisSystem::eRightHanded};
}

const char* kindOf(const FbxNode& node) {
    const FbxNodeAttribute* attribute = node.GetNodeAttribute();
    if (!attribute)
        return "node";
    constexpr struct {
        FbxNodeAttribute::EType type;
        const char* name;
    } kKinds[] = {{FbxNodeAttribute::eNull, "null"},
                  {FbxNodeAttribute::eMarker, "marker"},
                  {FbxNodeAttribute::eSkeleton, "bone"},
                  {FbxNodeAttribute::eMesh, "mesh"},
                  {FbxNodeAttribute::eNurbs, "NURBS"},
                  {FbxNodeAttribute::ePatch, "patch"},
                  {FbxNodeAttribute::eCamera, "camera"},
                  {FbxNodeAttribute::eCameraStereo, "stereo camera"},
                  {FbxNodeAttribute::eCameraSwitcher, "camera switcher"},
                  {FbxNodeAttribute::eLight, "light"},
                  {FbxNodeAttribute::eOpticalReference, "optical reference"},
                  {FbxNodeAttribute::eOpticalMarker, "optical marker"},
                  {FbxNodeAttribute::eNurbsCurve, "NURBS curve"},
                  {FbxNodeAttribute::eTrimNurbsSurface, "trimmed NURBS surface"},
                  {FbxNodeAttribute::eBoundary, "boundary"},
                  {FbxNodeAttribute::eNurbsSurface, "NURBS surface"},
                  {FbxNodeAttribute::eShape, "shape"},
                  {FbxNodeAttribute::eLODGroup, "level-of-detail group"},
                  {FbxNodeAttribute::eSubDiv, "subdivision surface"},
                  {FbxNodeAttribute::eCachedEffect, "cached effect"},
                  {FbxNodeAttribute::eLine, "line"}};
    for (const auto& kind : kKinds)
        if (kind.type == attribute->GetAttributeType())
            return kind.name;
    return "unknown attribute";
}

} // namespace tool
