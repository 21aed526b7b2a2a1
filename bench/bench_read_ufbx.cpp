// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reads the same file with ufbx and makes it do the same work: samples at whole frames where ours returns samples.
// UFBX_THREADS=N makes it inflate and parse with N threads.
#include "Measurement.h"

#include "ufbx.h"
#define UFBX_OS_IMPLEMENTATION
#include "ufbx_os.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <string>
#include <vector>

namespace {

constexpr std::size_t kChannels = 9; // position, rotation and scale

/// The whole frames of the first stack's span.
struct Frames {
    explicit Frames(const ufbx_scene& scene) : rate(scene.settings.frames_per_second) {
        if (scene.anim_stacks.count > 0) {
            const ufbx_props& span = scene.anim_stacks.data[0]->props;
            first = frameOf(ufbx_find_int(&span, "LocalStart", 0));
            count = static_cast<std::size_t>(std::max(0.0, frameOf(ufbx_find_int(&span, "LocalStop", 0)) - first)) + 1;
        }
    }
    double frameOf(std::int64_t ticks) const {
        constexpr double kTicksPerSecond = 46186158000.0;
        return std::floor(static_cast<double>(ticks) / kTicksPerSecond * rate + 0.5);
    }
    double timeOf(std::size_t frame) const { return (first + static_cast<double>(frame)) / rate; }

    double rate;
    double first = 0;
    std::size_t count = 1;
};

ufbx_scene* load(const char* fileName, ufbx_os_thread_pool* pool) {
    ufbx_load_opts options = {};
    if (pool != nullptr)
        ufbx_os_init_ufbx_thread_pool(&options.thread_opts.pool, pool);
    ufbx_error error;
    ufbx_scene* scene = ufbx_load_file(fileName, &options, &error);
    if (scene == nullptr)
        std::fprintf(stderr, "bench_read_ufbx: %.*s\n", static_cast<int>(error.description.length),
                     error.description.data);
    return scene;
}

/// All channels of all nodes, channel by channel, as the curves have them.
std::vector<float> sampleLocal(const ufbx_scene& scene, const Frames& frames) {
    static constexpr const char* kProperties[] = {"Lcl Translation", "Lcl Rotation", "Lcl Scaling"};
    std::vector<float> samples(scene.nodes.count * kChannels * frames.count);
    const ufbx_anim_layer& layer = *scene.anim->layers.data[0];
    for (std::size_t node = 0; node < scene.nodes.count; ++node) {
        for (std::size_t property = 0; property < 3; ++property) {
            const ufbx_anim_prop* animated =
                ufbx_find_anim_prop(&layer, &scene.nodes.data[node]->element, kProperties[property]);
            for (std::size_t component = 0; animated != nullptr && component < 3; ++component) {
                const ufbx_anim_curve* curve = animated->anim_value->curves[component];
                float* const out = &samples[(node * kChannels + property * 3 + component) * frames.count];
                for (std::size_t frame = 0; curve != nullptr && frame < frames.count; ++frame)
                    out[frame] = static_cast<float>(ufbx_evaluate_curve(curve, frames.timeOf(frame), 0));
            }
        }
    }
    return samples;
}

/// The same in the world: parents before children, each matrix decomposed again.
std::vector<float> sampleWorld(const ufbx_scene& scene, const Frames& frames) {
    std::vector<float> samples(scene.nodes.count * kChannels * frames.count);
    std::vector<ufbx_matrix> world(scene.nodes.count);
    for (std::size_t frame = 0; frame < frames.count; ++frame) {
        for (std::size_t i = 0; i < scene.nodes.count; ++i) {
            const ufbx_node* node = scene.nodes.data[i];
            const ufbx_transform local = ufbx_evaluate_transform(scene.anim, node, frames.timeOf(frame));
            const ufbx_matrix matrix = ufbx_transform_to_matrix(&local);
            world[i] = node->parent != nullptr ? ufbx_matrix_mul(&world[node->parent->typed_id], &matrix) : matrix;
            const ufbx_transform parts = ufbx_matrix_to_transform(&world[i]);
            const ufbx_vec3 angles = ufbx_quat_to_euler(parts.rotation, UFBX_ROTATION_ORDER_XYZ);
            const double values[kChannels] = {
                parts.translation.x, parts.translation.y, parts.translation.z, angles.x, angles.y, angles.z,
                parts.scale.x,       parts.scale.y,       parts.scale.z};
            for (std::size_t channel = 0; channel < kChannels; ++channel)
                samples[(i * kChannels + channel) * frames.count + frame] = static_cast<float>(values[channel]);
        }
    }
    return samples;
}

void addMeshes(const ufbx_scene& scene, bench::Answer& answer) {
    for (std::size_t i = 0; i < scene.meshes.count; ++i) {
        const ufbx_mesh& mesh = *scene.meshes.data[i];
        answer.count += static_cast<long long>(mesh.num_indices);
        for (std::size_t point = 0; point < mesh.num_vertices; ++point) {
            const ufbx_vec3& place = mesh.vertices.data[point];
            answer.include(place.x, place.y, place.z);
        }
    }
}

void addCameras(const ufbx_scene& scene, bench::Answer& answer) {
    for (std::size_t i = 0; i < scene.cameras.count; ++i) {
        const ufbx_vec3 place = scene.cameras.data[i]->instances.data[0]->local_transform.translation;
        ++answer.count;
        answer.include(place.x, place.y, place.z);
    }
}

/// The nodes below the root, and the bounding box of their positions at the frames with keys.
void addSamples(const ufbx_scene& scene, const Frames& frames, const std::vector<float>& samples,
                bench::Answer& answer) {
    constexpr std::size_t kFramesPerKey = 5;
    for (std::size_t i = 0; i < scene.nodes.count; ++i) {
        if (scene.nodes.data[i]->is_root || scene.nodes.data[i]->attrib_type == UFBX_ELEMENT_CAMERA)
            continue;
        ++answer.count;
        for (std::size_t frame = 0; frame < frames.count; frame += kFramesPerKey) {
            const float* const at = &samples[i * kChannels * frames.count + frame];
            answer.include(static_cast<double>(at[0]), static_cast<double>(at[frames.count]),
                           static_cast<double>(at[2 * frames.count]));
        }
    }
}

} // namespace

int main(int argc, char** argv) {
    if (argc < 3 || argc > 4) {
        std::fputs("usage: bench_read_ufbx mesh|cameras|local|global FILE [REPETITIONS]\n", stderr);
        return 2;
    }
    const std::string mode = argv[1];
    const int repetitions = argc == 4 ? std::atoi(argv[3]) : 1;
    ufbx_os_thread_pool* pool = nullptr;
    if (const char* threads = std::getenv("UFBX_THREADS")) {
        ufbx_os_thread_pool_opts options = {};
        options.max_threads = static_cast<std::size_t>(std::atoi(threads));
        pool = ufbx_os_create_thread_pool(&options);
    }
    bench::Answer answer;
    bench::Cost best;
    for (int i = 0; i < repetitions; ++i) {
        ufbx_scene* scene = nullptr;
        std::vector<float> samples;
        const bench::Cost cost = bench::measure([&] {
            scene = load(argv[2], pool);
            if (scene != nullptr && mode == "local")
                samples = sampleLocal(*scene, Frames(*scene));
            else if (scene != nullptr && mode == "global")
                samples = sampleWorld(*scene, Frames(*scene));
        });
        if (scene == nullptr)
            return 1;
        best = bench::cheaper(best, cost);
        answer = {};
        if (mode == "mesh")
            addMeshes(*scene, answer);
        else if (mode == "cameras")
            addCameras(*scene, answer);
        else
            addSamples(*scene, Frames(*scene), samples, answer);
        ufbx_free_scene(scene);
    }
    bench::print(answer, best);
    ufbx_os_free_thread_pool(pool);
    return 0;
}
