// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What ufbx reads from the files. It opens every version in both encodings, and evaluates scenes.
#include <ufbx.h>

#include "PeerProgram.h"

#include <cmath>
#include <cstdio>
#include <filesystem>
#include <memory>
#include <string>

using nlohmann::json;

namespace {

constexpr double kMillimetresPerInch = 25.4;

struct Release {
    void operator()(ufbx_scene* scene) const { ufbx_free_scene(scene); }
};
using Scene = std::unique_ptr<ufbx_scene, Release>;

std::string textOf(const ufbx_string& text) { return {text.data, text.length}; }

json listed(const ufbx_vec3& v) { return {v.x, v.y, v.z}; }

json normalised(const ufbx_vec3& v) {
    const double length = std::sqrt(v.x * v.x + v.y * v.y + v.z * v.z);
    return {v.x / length, v.y / length, v.z / length};
}

/// Along which of its axes a node looks: cameras along X, lights down, others as the library's objects do.
ufbx_vec3 forwardOf(const ufbx_node& node) {
    if (node.camera)
        return {1, 0, 0};
    return node.light ? ufbx_vec3{0, -1, 0} : ufbx_vec3{0, 0, -1};
}

const char* kindOf(const ufbx_node& node) {
    return node.camera ? "camera" : node.light ? "light" : node.mesh ? "mesh" : "null";
}

const char* typeOf(const ufbx_light& light) {
    switch (light.type) {
    case UFBX_LIGHT_POINT:
        return "point";
    case UFBX_LIGHT_DIRECTIONAL:
        return "directional";
    case UFBX_LIGHT_SPOT:
        return "spot";
    default:
        return "other";
    }
}

void describeMesh(const ufbx_node& node, json& object) {
    const ufbx_mesh& mesh = *node.mesh;
    object["polygons"] = mesh.num_faces;
    object["polygonVertices"] = mesh.num_indices;
    for (std::size_t i = 0; i < mesh.num_vertices; ++i)
        object["points"].push_back(listed(ufbx_transform_position(&node.geometry_to_world, mesh.vertices.data[i])));
    for (std::size_t i = 0; mesh.vertex_uv.exists && i < mesh.num_indices; ++i) {
        const ufbx_vec2 uv = ufbx_get_vertex_vec2(&mesh.vertex_uv, i);
        object["uvs"].push_back({uv.x, uv.y});
    }
}

/// The values that do not depend on the time.
json describe(const ufbx_node& node) {
    json object = {{"name", textOf(node.name)}, {"kind", kindOf(node)}};
    if (node.camera) {
        object["filmWidth"] = node.camera->film_size_inch.x * kMillimetresPerInch;
        object["filmHeight"] = node.camera->film_size_inch.y * kMillimetresPerInch;
        object["filmOffset"] = ufbx_find_real(&node.camera->props, "FilmOffsetX", 0.0) * kMillimetresPerInch;
    } else if (node.light) {
        object["type"] = typeOf(*node.light);
        object["colour"] = listed(node.light->color);
        object["intensity"] = node.light->intensity;
        if (node.light->type == UFBX_LIGHT_SPOT)
            object["coneAngle"] = node.light->outer_angle;
    } else if (node.mesh) {
        describeMesh(node, object);
    }
    return object;
}

/// The node's placement and other values, in a scene that was evaluated at the frame.
void describeAt(const ufbx_node& node, const std::string& frame, json& object) {
    if (const ufbx_mesh* const mesh = node.mesh) {
        json& placed = object["placed"][frame];
        json& cached = object["cached"][frame];
        const ufbx_vec3_list& points = mesh->skinned_position.values;
        for (std::size_t i = 0; i < points.count; ++i) {
            const ufbx_vec3 point = points.data[i];
            cached.push_back(listed(point));
            placed.push_back(
                listed(mesh->skinned_is_local ? ufbx_transform_position(&node.geometry_to_world, point) : point));
        }
        return;
    }
    object["positions"][frame] = listed(ufbx_transform_position(&node.node_to_world, {0, 0, 0}));
    object["directions"][frame] = normalised(ufbx_transform_direction(&node.node_to_world, forwardOf(node)));
    if (node.camera)
        object["focalLengths"][frame] = node.camera->focal_length_mm;
}

/// Null, and the reason on standard error, when ufbx fails.
Scene told(ufbx_scene* scene, const std::string& file, const ufbx_error& error) {
    if (!scene)
        std::fprintf(stderr, "%s: %s\n", file.c_str(), error.description.data);
    return Scene(scene);
}

bool evaluate(const ufbx_scene& scene, const std::string& file, const json& expected, json& objects) {
    for (int frame = expected["frames"][0]; frame <= expected["frames"][1].get<int>(); ++frame) {
        ufbx_evaluate_opts options = {};
        options.evaluate_skinning = options.evaluate_caches = options.load_external_files = true;
        ufbx_error error = {};
        const double seconds = frame / expected["rate"].get<double>();
        const Scene there = told(ufbx_evaluate_scene(&scene, scene.anim, seconds, &options, &error), file, error);
        if (!there)
            return false;
        std::size_t at = 0;
        for (const ufbx_node* const node : there->nodes)
            if (!node->is_root)
                describeAt(*node, std::to_string(frame), objects[at++]);
    }
    return true;
}

json look(const std::filesystem::path& path, const json& expected) {
    ufbx_load_opts options = {};
    options.load_external_files = options.ignore_missing_external_files = true; // compatible files name some
    ufbx_error error = {};
    const std::string file = path.filename().string();
    const Scene scene = told(ufbx_load_file(path.c_str(), &options, &error), file, error);
    if (!scene)
        return {};
    json objects = json::array(), warnings = json::array();
    for (const ufbx_node* const node : scene->nodes)
        if (!node->is_root)
            objects.push_back(describe(*node));
    for (const ufbx_warning& warning : scene->metadata.warnings)
        warnings.push_back(textOf(warning.description));
    json seen = {{"rate", scene->settings.frames_per_second}, {"warnings", warnings}, {"stacks", json::array()}};
    for (const ufbx_anim_stack* const stack : scene->anim_stacks)
        seen["stacks"].push_back(textOf(stack->name));
    if (!evaluate(*scene, file, expected, objects))
        return {};
    seen["objects"] = objects;
    return seen;
}

} // namespace

int main(int argumentCount, char** arguments) { return runPeer(argumentCount, arguments, look); }
