// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reads the same file with assimp, without any post-processing, and prints the same result and the time.
#include "Measurement.h"

#include <assimp/Importer.hpp>
#include <assimp/scene.h>

#include <string>

namespace {

/// Polygon vertices and the bounding box of the points, in the mesh's own space.
void addMeshes(const aiScene& scene, bench::Answer& answer) {
    for (unsigned i = 0; i < scene.mNumMeshes; ++i) {
        const aiMesh& mesh = *scene.mMeshes[i];
        answer.count += mesh.mNumVertices; // one per polygon vertex
        for (unsigned vertex = 0; vertex < mesh.mNumVertices; ++vertex) {
            const aiVector3D& point = mesh.mVertices[vertex];
            answer.include(static_cast<double>(point.x), static_cast<double>(point.y), static_cast<double>(point.z));
        }
    }
}

void addCameras(const aiScene& scene, bench::Answer& answer) {
    for (unsigned i = 0; i < scene.mNumCameras; ++i) {
        ++answer.count;
        const aiNode* node = scene.mRootNode->FindNode(scene.mCameras[i]->mName);
        aiMatrix4x4 matrix;
        for (; node != nullptr; node = node->mParent)
            matrix = node->mTransformation * matrix;
        answer.include(static_cast<double>(matrix.a4), static_cast<double>(matrix.b4), static_cast<double>(matrix.c4));
    }
}

/// The channels that move a node, and the bounding box of their keys.
void addTransforms(const aiScene& scene, bench::Answer& answer) {
    for (unsigned i = 0; i < scene.mNumAnimations; ++i) {
        for (unsigned c = 0; c < scene.mAnimations[i]->mNumChannels; ++c) {
            const aiNodeAnim& channel = *scene.mAnimations[i]->mChannels[c];
            if (channel.mNumPositionKeys < 2)
                continue;
            ++answer.count;
            for (unsigned key = 0; key < channel.mNumPositionKeys; ++key) {
                const aiVector3D& value = channel.mPositionKeys[key].mValue;
                answer.include(static_cast<double>(value.x), static_cast<double>(value.y),
                               static_cast<double>(value.z));
            }
        }
    }
}

} // namespace

int main(int argc, char** argv) {
    if (argc != 3) {
        std::fputs("usage: bench_read_assimp mesh|cameras|local FILE\n", stderr);
        return 2;
    }
    const std::string mode = argv[1];
    Assimp::Importer importer;
    const aiScene* scene = nullptr;
    const bench::Cost cost = bench::measure([&] { scene = importer.ReadFile(argv[2], 0); });
    if (scene == nullptr) {
        std::fprintf(stderr, "bench_read_assimp: %s\n", importer.GetErrorString());
        return 1;
    }
    bench::Answer answer;
    if (mode == "mesh")
        addMeshes(*scene, answer);
    else if (mode == "cameras")
        addCameras(*scene, answer);
    else
        addTransforms(*scene, answer);
    bench::print(answer, cost);
    return 0;
}
