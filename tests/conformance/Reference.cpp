// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// References as JSON. They are part of the corpus and trusted: a damaged one throws.
#include "Reference.h"

#include <nlohmann/json.hpp>

#include <fstream>
#include <limits>

namespace conformance {
namespace {

using nlohmann::json;

double number(const json& value) {
    return value.is_null() ? std::numeric_limits<double>::quiet_NaN() : value.get<double>();
}

std::vector<double> numbers(const json& value) {
    if (!value.is_array())
        return {number(value)};
    std::vector<double> result;
    for (const json& element : value)
        result.push_back(number(element));
    return result;
}

Matrix12 matrix(const json& value) {
    Matrix12 result{};
    for (std::size_t i = 0; i < result.size(); ++i)
        result[i] = number(value.at(i));
    return result;
}

NamedNumbers namedNumbers(const json& node, const char* key) {
    NamedNumbers result;
    if (!node.contains(key))
        return result;
    for (const auto& [name, value] : node.at(key).items())
        result[name] = numbers(value);
    return result;
}

ReferenceMesh mesh(const json& value) {
    ReferenceMesh result;
    value.at("points").get_to(result.points);
    value.at("polygons").get_to(result.polygons);
    value.at("polygonVertices").get_to(result.polygonVertices);
    value.at("skins").get_to(result.skins);
    value.at("blendShapes").get_to(result.blendShapes);
    value.at("caches").get_to(result.caches);
    value.at("normals").get_to(result.normals);
    value.at("uvs").get_to(result.uvs);
    value.at("colours").get_to(result.colours);
    value.at("sizeSum").get_to(result.sizeSum);
    value.at("indexSum").get_to(result.indexSum);
    value.at("sampleStep").get_to(result.sampleStep);
    for (const json& frame : value.at("worldPoints"))
        result.worldPoints.push_back(numbers(frame));
    return result;
}

ReferenceNode node(const json& value) {
    ReferenceNode result;
    value.at("name").get_to(result.name);
    value.at("kind").get_to(result.kind);
    value.at("parent").get_to(result.parent);
    value.at("inherit").get_to(result.inherit);
    value.at("rotationOrder").get_to(result.rotationOrder);
    result.geometric = matrix(value.at("geometric"));
    for (const json& frame : value.at("world"))
        result.world.push_back(matrix(frame));
    result.curves = namedNumbers(value, "curves");
    result.camera = namedNumbers(value, "camera");
    result.light = namedNumbers(value, "light");
    if (value.contains("mesh"))
        result.mesh = mesh(value.at("mesh"));
    return result;
}

} // namespace

Reference readReference(const std::filesystem::path& path) {
    std::ifstream stream(path);
    const json file = json::parse(stream);
    Reference result;
    file.at("loads").get_to(result.loads);
    if (!result.loads)
        return result;

    file.at("fps").get_to(result.fps);
    file.at("fileUnitMeters").get_to(result.fileUnitMeters);
    file.at("axes").get_to(result.axes);
    for (const json& stack : file.at("stacks")) {
        result.stacks.push_back(
            {stack.at("name"), number(stack.at("begin")), number(stack.at("end")), stack.at("layers")});
    }
    result.frames = numbers(file.at("frames"));
    for (const json& value : file.at("nodes"))
        result.nodes.push_back(node(value));
    return result;
}

} // namespace conformance
