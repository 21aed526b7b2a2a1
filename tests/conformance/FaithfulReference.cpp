// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "FaithfulReference.h"

#include <nlohmann/json.hpp>

#include <fstream>
#include <limits>

namespace conformance {
namespace {

using nlohmann::json;

std::vector<double> numbersOf(const json& value) {
    std::vector<double> result;
    for (const json& element : value)
        result.push_back(element.is_null() ? std::numeric_limits<double>::quiet_NaN() : element.get<double>());
    return result;
}

std::vector<std::vector<double>> perFrame(const json& node, const char* key) {
    std::vector<std::vector<double>> result;
    for (const json& frame : node.value(key, json::array()))
        result.push_back(numbersOf(frame));
    return result;
}

FaithfulNode nodeOf(const json& value) {
    FaithfulNode node;
    node.name = value.at("name");
    node.pointStep = value.value("pointStep", 1);
    node.normalStep = value.value("normalStep", 1);
    node.points = perFrame(value, "points");
    node.normals = perFrame(value, "normals");
    node.mirrored = value.value("mirrored", false);
    node.shaped = value.value("blendShapes", 0) + value.value("caches", 0) > 0;
    node.deformed = node.shaped || value.value("skins", 0) > 0;
    for (const auto& [key, numbers] :
         {std::pair("focalLength", &node.focalLength), std::pair("fovX", &node.fovX), std::pair("fovY", &node.fovY),
          std::pair("apertureWidth", &node.apertureWidth), std::pair("apertureHeight", &node.apertureHeight)})
        *numbers = numbersOf(value.value(key, json::array()));
    node.perspective = value.value("perspective", true);
    node.gateFit = value.value("gateFit", 0);
    return node;
}

} // namespace

std::vector<FaithfulNode> readFaithfulReference(const std::filesystem::path& path) {
    std::vector<FaithfulNode> nodes;
    std::ifstream stream(path);
    if (!stream)
        return nodes;
    const json file = json::parse(stream);
    for (const json& value : file.at("nodes"))
        nodes.push_back(nodeOf(value));
    return nodes;
}

} // namespace conformance
