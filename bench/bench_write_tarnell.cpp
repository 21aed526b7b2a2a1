// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Fills value objects as a host does, writes them through the facade and prints how long the write took.
#include "Measurement.h"
#include "WrittenScene.h"

#include <Fbx.h>
#include <TnFbxError.h>
#include <TnFbxMesh.h>
#include <TnFbxTransform.h>
#include <TnFbxWriteInfo.h>

#include <cstdlib>
#include <string>
#include <vector>

namespace {

using namespace Tarnell::Fbx;

void fill(TnFbxMesh& mesh, const bench::Grid& grid) {
    mesh.setName("grid");
    mesh.allocateGeometryData(grid.quads(), grid.points(), grid.quads() * 4);
    for (int i = 0; i < grid.points(); ++i) {
        const auto point = grid.point(i);
        mesh.setControlPoint(i, point[0], point[1], point[2]);
    }
    for (int quad = 0; quad < grid.quads(); ++quad) {
        mesh.setPolygonVertexSize(quad, 4);
        for (int corner = 0; corner < 4; ++corner) {
            const int at = quad * 4 + corner, point = grid.corner(quad, corner);
            const auto normal = grid.normal(point);
            const auto uv = grid.textureCoordinate(point);
            mesh.setPointIndex(at, point);
            mesh.setNormal(at, normal[0], normal[1], normal[2]);
            mesh.setUV(at, uv[0], uv[1]);
        }
    }
    mesh.setValidNormals(true);
    mesh.setValidUVs(true);
}

/// Positions and rotations with a sample per frame, scaling without.
void fill(TnFbxTransform& transform, int node, int frames) {
    transform.setName("node" + std::to_string(node));
    std::array<std::vector<float>, 6> samples;
    for (int frame = 0; frame < frames; ++frame) {
        const auto position = bench::CirclingNodes::position(node, frame);
        for (std::size_t i = 0; i < 3; ++i)
            samples[i].push_back(position[i]);
        samples[3].push_back(0.0f);
        samples[4].push_back(bench::CirclingNodes::turn(node, frame));
        samples[5].push_back(0.0f);
    }
    TnFbxTime time;
    time.setTime(0.0f, 0, frames - 1, static_cast<float>(bench::kWrittenFramesPerSecond));
    for (int i = 0; i < 6; ++i)
        transform.setTransformValueAt(static_cast<TnFbxTransform::EFbxTransformChannelType>(i), time,
                                      samples[static_cast<std::size_t>(i)]);
}

} // namespace

int main(int argc, char** argv) {
    if (argc < 3 || argc > 4) {
        std::fputs("usage: bench_write_tarnell mesh|meshAscii|nodes|nodesAscii FILE [SCALE]\n", stderr);
        return 2;
    }
    const std::string mode = argv[1];
    const double scale = argc == 4 ? std::strtod(argv[3], nullptr) : 1.0;
    const bench::CirclingNodes circling = bench::scaledNodes(scale);
    TnFbxMesh mesh;
    std::vector<TnFbxTransform> nodes;
    std::vector<TnFbxMesh*> meshes;
    std::vector<TnFbxTransform*> transforms;
    if (mode.starts_with("mesh")) {
        fill(mesh, bench::scaledGrid(scale));
        meshes = {&mesh};
    } else {
        nodes.resize(static_cast<std::size_t>(circling.nodes));
        for (int i = 0; i < circling.nodes; ++i) {
            fill(nodes[static_cast<std::size_t>(i)], i, circling.frames);
            transforms.push_back(&nodes[static_cast<std::size_t>(i)]);
        }
    }
    TnFbxWriteInfo info;
    info.setFileName(argv[2]);
    info.setAnimationStackName("Take 001");
    info.setFileFormat(mode.ends_with("Ascii"));
    info.setCompatibilityVersion(TnFbxWriteInfo::kFbxVersion2014); // the version that the peer writes
    info.setFPS(static_cast<float>(bench::kWrittenFramesPerSecond));
    info.setStartFrame(0.0f);
    info.setEndFrame(static_cast<float>(circling.frames - 1));
    info.setAnimateMeshVertices(false);

    bool written = false;
    const bench::Cost cost = bench::measure([&] { written = Fbx().writeFile(info, {}, {}, transforms, {}, meshes); });
    if (!written) {
        std::fprintf(stderr, "bench_write_tarnell: %s\n", lastError().c_str());
        return 1;
    }
    std::fputs("{", stdout);
    bench::print(cost);
    return 0;
}
