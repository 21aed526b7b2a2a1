// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Writes the same scenes with assimp's exporter and prints how long that took.
#include "Measurement.h"
#include "WrittenScene.h"

#include <assimp/Exporter.hpp>
#include <assimp/material.h>
#include <assimp/scene.h>

#include <memory>
#include <string>

namespace {

constexpr bench::Grid kGrid;
constexpr bench::CirclingNodes kNodes;

aiVector3D vector(const std::array<float, 3>& numbers) { return {numbers[0], numbers[1], numbers[2]}; }

/// A mesh as assimp has it: a vertex for every corner.
aiMesh* gridMesh() {
    auto mesh = std::make_unique<aiMesh>();
    mesh->mName = "grid";
    mesh->mPrimitiveTypes = aiPrimitiveType_POLYGON;
    mesh->mNumVertices = static_cast<unsigned>(kGrid.quads()) * 4;
    mesh->mVertices = new aiVector3D[mesh->mNumVertices];
    mesh->mNormals = new aiVector3D[mesh->mNumVertices];
    mesh->mTextureCoords[0] = new aiVector3D[mesh->mNumVertices];
    mesh->mNumUVComponents[0] = 2;
    mesh->mNumFaces = static_cast<unsigned>(kGrid.quads());
    mesh->mFaces = new aiFace[mesh->mNumFaces];
    for (int quad = 0; quad < kGrid.quads(); ++quad) {
        aiFace& face = mesh->mFaces[quad];
        face.mNumIndices = 4;
        face.mIndices = new unsigned[4];
        for (int corner = 0; corner < 4; ++corner) {
            const int at = quad * 4 + corner, point = kGrid.corner(quad, corner);
            const auto uv = kGrid.textureCoordinate(point);
            mesh->mVertices[at] = vector(kGrid.point(point));
            mesh->mNormals[at] = vector(kGrid.normal(point));
            mesh->mTextureCoords[0][at] = {uv[0], uv[1], 0.0f};
            face.mIndices[corner] = static_cast<unsigned>(at);
        }
    }
    return mesh.release();
}

aiNode* newNode(const std::string& name, aiNode* parent) {
    auto* node = new aiNode(name);
    node->mParent = parent;
    return node;
}

void addMesh(aiScene& scene) {
    scene.mNumMeshes = 1;
    scene.mMeshes = new aiMesh* [1] { gridMesh() };
    aiNode& root = *scene.mRootNode;
    root.mNumChildren = 1;
    root.mChildren = new aiNode* [1] { newNode("grid", &root) };
    root.mChildren[0]->mNumMeshes = 1;
    root.mChildren[0]->mMeshes = new unsigned[1]{0};
}

aiNodeAnim* movement(int node) {
    auto channel = std::make_unique<aiNodeAnim>();
    channel->mNodeName = "node" + std::to_string(node);
    channel->mNumPositionKeys = channel->mNumRotationKeys = static_cast<unsigned>(kNodes.frames);
    channel->mPositionKeys = new aiVectorKey[channel->mNumPositionKeys];
    channel->mRotationKeys = new aiQuatKey[channel->mNumRotationKeys];
    channel->mNumScalingKeys = 1;
    channel->mScalingKeys = new aiVectorKey[1]{{0.0, {1.0f, 1.0f, 1.0f}}};
    for (int frame = 0; frame < kNodes.frames; ++frame) {
        constexpr float kHalfDegree = static_cast<float>(M_PI / 360.0);
        const float half = bench::CirclingNodes::turn(node, frame) * kHalfDegree;
        channel->mPositionKeys[frame] = {static_cast<double>(frame),
                                         vector(bench::CirclingNodes::position(node, frame))};
        channel->mRotationKeys[frame] = {static_cast<double>(frame), {std::cos(half), 0.0f, std::sin(half), 0.0f}};
    }
    return channel.release();
}

void addNodes(aiScene& scene) {
    aiNode& root = *scene.mRootNode;
    root.mNumChildren = static_cast<unsigned>(kNodes.nodes);
    root.mChildren = new aiNode*[kNodes.nodes];
    auto animation = std::make_unique<aiAnimation>();
    animation->mName = "Take 001";
    animation->mTicksPerSecond = bench::kWrittenFramesPerSecond;
    animation->mDuration = kNodes.frames - 1;
    animation->mNumChannels = static_cast<unsigned>(kNodes.nodes);
    animation->mChannels = new aiNodeAnim*[kNodes.nodes];
    for (int i = 0; i < kNodes.nodes; ++i) {
        root.mChildren[i] = newNode("node" + std::to_string(i), &root);
        animation->mChannels[i] = movement(i);
    }
    scene.mNumAnimations = 1;
    scene.mAnimations = new aiAnimation* [1] { animation.release() };
}

} // namespace

int main(int argc, char** argv) {
    if (argc != 3) {
        std::fputs("usage: bench_write_assimp mesh|meshAscii|nodes|nodesAscii FILE\n", stderr);
        return 2;
    }
    const std::string mode = argv[1];
    aiScene scene;
    scene.mRootNode = new aiNode("root");
    scene.mNumMaterials = 1;
    scene.mMaterials = new aiMaterial* [1] { new aiMaterial };
    if (mode.starts_with("mesh"))
        addMesh(scene);
    else
        addNodes(scene);

    Assimp::Exporter exporter;
    aiReturn result = aiReturn_FAILURE;
    const bench::Cost cost =
        bench::measure([&] { result = exporter.Export(&scene, mode.ends_with("Ascii") ? "fbxa" : "fbx", argv[2]); });
    if (result != aiReturn_SUCCESS) {
        std::fprintf(stderr, "bench_write_assimp: %s\n", exporter.GetErrorString());
        return 1;
    }
    std::fputs("{", stdout);
    bench::print(cost);
    return 0;
}
